// AEArray, which the store's classes use for their queues: insertion and removal in place (an
// element of the array itself inserted while it grows), copies, and the bounds check.
#include <gtest/gtest.h>

#include <string>

#include "AEArray.h"

namespace {

TEST(AEArray, InsertShiftsTheTailAndRemoveClosesTheGap) {
  AEArray<std::string> a;
  EXPECT_TRUE(a.Append("b"));
  EXPECT_TRUE(a.Insert(0, "a"));
  EXPECT_TRUE(a.Insert(2, "d"));
  EXPECT_TRUE(a.Insert(2, "c"));
  EXPECT_FALSE(a.Insert(5, "beyond the end"));
  ASSERT_EQ(4u, a.Size());
  EXPECT_TRUE(a.Insert(1, a[3]));  // an element of the array itself, while the array grows
  EXPECT_EQ("adbcd", a[0] + a[1] + a[2] + a[3] + a[4]);
  EXPECT_TRUE(a.Remove(0));
  EXPECT_TRUE(a.Remove(3));
  EXPECT_FALSE(a.Remove(3));
  ASSERT_EQ(3u, a.Size());
  EXPECT_EQ("dbc", a[0] + a[1] + a[2]);

  AEArray<std::string> copy(a);
  a.Clear();
  EXPECT_TRUE(a.IsEmpty());
  EXPECT_EQ("c", copy[2]);
}

TEST(AEArrayDeathTest, IndexBeyondTheSizeIsAFailedCheck) {
  AEArray<int> a;
  a.Append(1);
  EXPECT_DEATH(a[1], "Check failed: index < Size\\(\\)");
}

}  // namespace
