#include "VLTestTranscript.h"

#include <gtest/gtest.h>

#include <filesystem>
#include <sstream>

#include "VLTestDir.h"
#include "VLTestSimulator.h"

std::string VLReceivedLines(VLSimServer& sim) {
  std::string lines;
  for (const VLSimRequest& r : VLRequestsByConnection(sim)) {
    // A connection that failed before its request (a refused certificate) may be logged after
    // the client has moved on: it has no line, and the client's status tells the failure.
    if (r.method.empty()) continue;
    lines += "> " + (r.service.empty() ? r.method + " " + r.host + r.path : r.service + " " + r.operation);
    lines += (r.hasAuthToken ? " token=" + r.authToken : "") + "\n";
  }
  sim.ClearRequests();
  return lines;
}

std::string VLCacheChanges(const std::string& folder, std::set<std::string>* kept) {
  std::set<std::string> now;
  for (const std::string& name : VLCacheFilesIn(folder)) {
    now.insert("file " + name);
    std::istringstream rows(VLRunSql(folder + "/" + name,
                                     "SELECT 'Service', Name, Key FROM Service UNION ALL "
                                     "SELECT 'Userdata', Name, Key FROM Userdata UNION ALL "
                                     "SELECT 'BoxArt', Prefix, Dim FROM BoxArt"));
    for (std::string row; std::getline(rows, row);) now.insert(row);
  }
  std::string lines;
  for (const std::string& row : now)
    if (!kept->count(row)) lines += "+ " + row + "\n";
  for (const std::string& row : *kept)
    if (!now.count(row)) lines += "- " + row + "\n";
  *kept = now;
  return lines;
}

std::vector<std::string> VLTranscriptsIn(const std::string& folder) {
  std::vector<std::string> names;
  for (const std::string& file : VLFolderFiles(folder)) {
    if (file.size() > 4 && file.compare(file.size() - 4, 4, ".txt") == 0) names.push_back(file.substr(0, file.size() - 4));
  }
  return names;  // a set's order
}

std::string VLTranscriptTestName(const testing::TestParamInfo<std::string>& info) {
  std::string name = info.param;
  for (char& c : name) c = c == '-' ? '_' : c;
  return name;
}

void VLExpectTranscript(const std::string& expectedFile, const std::string& transcript) {
  const std::string expectedPath = VL_SOURCE_DIR "/tests/data/" + expectedFile;
  if (transcript == VLReadFile(expectedPath)) return;
  const std::string actualPath = VL_BINARY_DIR "/tests/" + expectedFile;
  std::error_code error;
  std::filesystem::create_directories(std::filesystem::path(actualPath).parent_path(), error);
  ASSERT_TRUE(VLWriteFile(actualPath, transcript));
  ADD_FAILURE() << "the transcript differs from " << expectedPath << "; what the test got is in " << actualPath
                << " (copy it over the expected one if the change is intended):\n  diff " << expectedPath << " "
                << actualPath;
}
