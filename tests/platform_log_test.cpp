// The logging stand-in: only active areas print, targets switch, observers see what is written.
#include <gtest/gtest.h>

#include <cstdio>
#include <fstream>
#include <sstream>
#include <string>
#include <vector>

#include "VL_Log.h"

namespace {

struct Seen {
  std::vector<std::string> lines;
};

void Observe(void* ctx, const char* area, int level, const char* text, size_t len) {
  static_cast<Seen*>(ctx)->lines.push_back(std::string(area) + ":" + std::to_string(level) + ":" +
                                           std::string(text, len));
}

TEST(PlatformLog, OnlyActiveAreasReachTheTarget) {
  Seen seen;
  VL_LogSetObserver(Observe, &seen);
  int a = -1, b = -1, again = -1;
  ASSERT_EQ(0, VL_LogRegisterArea("test_a", &a));
  ASSERT_EQ(0, VL_LogRegisterArea("test_b", &b));
  ASSERT_EQ(0, VL_LogRegisterArea("test_a", &again));
  EXPECT_EQ(a, again);
  EXPECT_NE(a, b);
  EXPECT_EQ(0, VL_LogActivateArea(a, 1));
  EXPECT_EQ(0, VL_LogOutput(a, 4, "hello %d\n", 7));
  EXPECT_EQ(1, VL_LogOutput(b, 4, "muted"));
  EXPECT_EQ(1, VL_LogOutput(-1, 4, "unregistered"));
  const char raw[] = {'x', '\0', 'y'};
  EXPECT_EQ(0, VL_LogOutputwithLen(a, 8, raw, 3));
  VL_LogSetObserver(nullptr, nullptr);
  ASSERT_EQ(2u, seen.lines.size());
  EXPECT_EQ("test_a:4:hello 7", seen.lines[0]);
  EXPECT_EQ(std::string("test_a:8:x\0y", 12), seen.lines[1]);
}

TEST(PlatformLog, FileTargetReceivesLinesWithAreaAndLevel) {
  std::string path = testing::TempDir() + "vl_log_target.txt";
  std::remove(path.c_str());
  uintptr_t t1 = 0, t2 = 0;
  EXPECT_EQ(1, VL_LogGetFileTarget("", &t1, &t2, 0, 1));
  EXPECT_EQ(2, VL_LogGetFileTarget("/nonexistent-dir/x/log.txt", &t1, &t2, 0, 1));
  ASSERT_EQ(0, VL_LogGetFileTarget(path.c_str(), &t1, &t2, 0, 1));
  ASSERT_EQ(0, VL_LogSetTarget(t1, t2));
  int id = -1;
  ASSERT_EQ(0, VL_LogRegisterArea("test_file", &id));
  VL_LogActivateArea(id, 1);
  VL_LogOutput(id, 1, "to the file");
  ASSERT_EQ(0, VL_LogGetConsoleTarget(&t1, &t2));
  ASSERT_EQ(0, VL_LogSetTarget(t1, t2));
  VL_LogOutput(id, 1, "to the console");
  std::ifstream in(path);
  std::stringstream content;
  content << in.rdbuf();
  EXPECT_EQ("[test_file:1] to the file\n", content.str());
}

}  // namespace
