#include "VLTestDir.h"

#include <dirent.h>
#include <ftw.h>
#include <gtest/gtest.h>
#include <limits.h>
#include <sqlite3.h>
#include <stdlib.h>
#include <unistd.h>

#include <fstream>
#include <sstream>

namespace {

int RemoveEntry(const char* path, const struct stat*, int, struct FTW*) { return remove(path); }

}  // namespace

VLTestDir::VLTestDir() {
  std::string base = testing::TempDir();
  if (base.empty() || base.back() != '/') base += '/';
  std::string pattern = base + "vltest_XXXXXX";
  if (!mkdtemp(&pattern[0])) {
    ADD_FAILURE() << "cannot create a temporary directory below " << base;
    return;
  }
  m_Path = pattern + "/";
}

VLTestDir::~VLTestDir() {
  if (!m_Path.empty()) nftw(m_Path.c_str(), RemoveEntry, 16, FTW_DEPTH | FTW_PHYS);
}

VLScopedCurrentDir::VLScopedCurrentDir(const std::string& dir) {
  char previous[PATH_MAX];
  if (getcwd(previous, sizeof previous)) m_Previous = previous;
  if (chdir(dir.c_str()) != 0) ADD_FAILURE() << "cannot enter " << dir;
}

VLScopedCurrentDir::~VLScopedCurrentDir() {
  if (!m_Previous.empty() && chdir(m_Previous.c_str()) != 0) ADD_FAILURE() << "cannot return to " << m_Previous;
}

std::string VLReadFile(const std::string& path) {
  std::ifstream in(path, std::ios::binary);
  std::stringstream content;
  content << in.rdbuf();
  return content.str();
}

bool VLWriteFile(const std::string& path, const std::string& content) {
  std::ofstream out(path, std::ios::binary | std::ios::trunc);
  out << content;
  out.close();
  return static_cast<bool>(out);
}

std::set<std::string> VLFolderFiles(const std::string& folder) {
  std::set<std::string> names;
  DIR* dir = opendir(folder.c_str());
  while (dirent* entry = dir ? readdir(dir) : nullptr) {
    std::string name = entry->d_name;
    if (name != "." && name != "..") names.insert(name);
  }
  if (dir) closedir(dir);
  return names;
}

std::set<std::string> VLCacheFilesIn(const std::string& folder) {
  std::set<std::string> names;
  for (const std::string& name : VLFolderFiles(folder))
    if (name.size() > 3 && name.compare(name.size() - 3, 3, ".vl") == 0) names.insert(name);
  return names;
}

std::string VLCacheFileIn(const std::string& folder) {
  std::set<std::string> names = VLCacheFilesIn(folder);
  return names.empty() ? std::string() : folder + *names.begin();
}

std::string VLRunSql(const std::string& path, const std::string& sql) {
  sqlite3* db = nullptr;
  std::string rows;
  EXPECT_EQ(SQLITE_OK, sqlite3_open(path.c_str(), &db)) << path;
  auto append = [](void* out, int columns, char** values, char**) {
    std::string& text = *static_cast<std::string*>(out);
    if (!text.empty()) text += "\n";
    for (int c = 0; c < columns; ++c) text += std::string(c ? "|" : "") + (values[c] ? values[c] : "");
    return 0;
  };
  EXPECT_EQ(SQLITE_OK, sqlite3_exec(db, sql.c_str(), append, &rows, nullptr)) << sql;
  sqlite3_close(db);
  return rows;
}
