// Test helpers for files: a fresh temporary directory per test, a scoped change of the current
// directory, whole files, and SQL on a cache file from outside.
#ifndef VLTESTDIR_H
#define VLTESTDIR_H

#include <set>
#include <string>

// A new empty directory below testing::TempDir(), removed with everything in it at the end of
// the scope. path() ends in "/".
class VLTestDir {
 public:
  VLTestDir();
  ~VLTestDir();
  VLTestDir(const VLTestDir&) = delete;
  VLTestDir& operator=(const VLTestDir&) = delete;

  const std::string& path() const { return m_Path; }
  // path() + name
  std::string operator/(const std::string& name) const { return m_Path + name; }

 private:
  std::string m_Path;
};

// Makes dir the current directory for the scope, then returns to the previous one.
class VLScopedCurrentDir {
 public:
  explicit VLScopedCurrentDir(const std::string& dir);
  ~VLScopedCurrentDir();
  VLScopedCurrentDir(const VLScopedCurrentDir&) = delete;
  VLScopedCurrentDir& operator=(const VLScopedCurrentDir&) = delete;

 private:
  std::string m_Previous;
};

// The names of everything in a folder, "." and ".." left out (none when it cannot be read).
std::set<std::string> VLFolderFiles(const std::string& folder);

// Whole content of a file ("" when it cannot be read).
std::string VLReadFile(const std::string& path);
// Writes content to path (created or truncated); false on failure.
bool VLWriteFile(const std::string& path, const std::string& content);

// The cache databases in a folder: the names of the files that end in ".vl".
std::set<std::string> VLCacheFilesIn(const std::string& folder);
// The cache database in a folder: the first of them as a path ("" when there is none).
std::string VLCacheFileIn(const std::string& folder);

// Runs statements on an SQLite file from outside, as another program would. The rows they give,
// columns separated by "|" (a null as ""), rows by a line end after all but the last.
std::string VLRunSql(const std::string& path, const std::string& sql);

#endif  // VLTESTDIR_H
