// The logging stand-in: tests that a secret is never logged read what the observer sees, so only
// active areas may print and every line written must reach the observer, bytes and all.
#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "VL_Log.h"

namespace {

void Observe(void* ctx, const char* area, int level, const char* text, size_t len) {
  static_cast<std::vector<std::string>*>(ctx)->push_back(std::string(area) + ":" + std::to_string(level) + ":" +
                                                         std::string(text, len));
}

TEST(PlatformLog, OnlyActiveAreasReachTheObserver) {
  std::vector<std::string> seen;
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
  ASSERT_EQ(2u, seen.size());
  EXPECT_EQ("test_a:4:hello 7", seen[0]);
  EXPECT_EQ(std::string("test_a:8:x\0y", 12), seen[1]);
}

}  // namespace
