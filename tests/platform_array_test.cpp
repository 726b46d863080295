// AEArray growth, insertion and removal; AEString sizes; the SDK's error constants.
#include <gtest/gtest.h>

#include <cstring>
#include <string>

#include "AEArray.h"
#include "AEError.h"
#include "AEString.h"

namespace {

TEST(AEArray, GrowsToTheLeastMultipleOfTwiceTheCapacityThatExceedsTheNewSize) {
  EXPECT_EQ(5u, AEArray<int>::GrownCapacity(0, 5));  // from nothing: exactly the new size
  EXPECT_EQ(16u, AEArray<int>::GrownCapacity(8, 9));
  EXPECT_EQ(32u, AEArray<int>::GrownCapacity(8, 16));
  EXPECT_EQ(48u, AEArray<int>::GrownCapacity(8, 40));

  AEArray<int> grown;
  EXPECT_EQ(0u, grown.Capacity());
  grown.Append(1);
  EXPECT_EQ(1u, grown.Capacity());
  grown.Append(2);
  EXPECT_EQ(4u, grown.Capacity());  // 2 * 1 does not exceed 2; 4 does
  AEArray<int> eight(8);
  for (int i = 0; i < 8; ++i) eight.Append(i);
  EXPECT_EQ(8u, eight.Capacity());
  eight.Append(8);
  EXPECT_EQ(16u, eight.Capacity());
  EXPECT_EQ(9u, eight.Size());
}

TEST(AEArray, InsertShiftsTheTailAndRemoveClosesTheGap) {
  AEArray<std::string> a;
  EXPECT_TRUE(a.Append("b"));
  EXPECT_TRUE(a.Insert(0, "a"));
  EXPECT_TRUE(a.Insert(2, "d"));
  EXPECT_TRUE(a.Insert(2, "c"));
  EXPECT_FALSE(a.Insert(5, "beyond the end"));
  ASSERT_EQ(4u, a.Size());
  EXPECT_EQ("abcd", a[0] + a[1] + a[2] + a[3]);
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
  EXPECT_EQ(3u, copy.Size());
  EXPECT_EQ("c", copy[2]);
  const char* more[] = {"x", "y"};
  AEArray<const char*> names;
  names.Append("first");
  EXPECT_TRUE(names.Append(more, 2));
  EXPECT_STREQ("y", names[2]);
}

TEST(AEArrayDeathTest, IndexBeyondTheSizeIsAFailedCheck) {
  AEArray<int> a;
  a.Append(1);
  EXPECT_DEATH(a[1], "Check failed: index < Size\\(\\)");
}

TEST(AEString, SizeCountsTheTerminatingNulAndEmptyIsZero) {
  AEString empty;
  EXPECT_EQ(0u, empty.Size());
  EXPECT_STREQ("", empty.CString());
  AEString fromNull(nullptr);
  EXPECT_EQ(0u, fromNull.Size());
  AEString abc("abc");
  EXPECT_EQ(4u, abc.Size());
  EXPECT_EQ(3u, abc.Length());
  EXPECT_STREQ("abc", abc.CString());
  AEString withNul("a\0b", 3);
  EXPECT_EQ(4u, withNul.Size());
  EXPECT_EQ(0, memcmp("a\0b", withNul.CString(), 4));
  EXPECT_NE(withNul, AEString("a"));
  AEString copy = abc;
  abc.Set("");
  EXPECT_EQ(0u, abc.Size());
  EXPECT_EQ(AEString("abc"), copy);
  copy.Set(&copy.CString()[1], copy.Length() - 1);  // from its own bytes
  EXPECT_STREQ("bc", copy.CString());

  AEArray<AEString> prefixes(8);
  prefixes.Append(AEString("second"));
  prefixes.Insert(0, AEString("first"));
  prefixes.Remove(1);
  ASSERT_EQ(1u, prefixes.Size());
  EXPECT_STREQ("first", prefixes[0].CString());
}

TEST(AEError, StandardConstants) {
  const AEError all[] = {AEError_OK,       AEError_NoMemory, AEError_Timeout,          AEError_Generic,
                         AEError_NotFound, AEError_Usage,    AEError_InvalidParameters};
  const char* names[] = {"AEError_OK",       "AEError_NoMemory", "AEError_Timeout",          "AEError_Generic",
                         "AEError_NotFound", "AEError_Usage",    "AEError_InvalidParameters"};
  for (int i = 0; i < 7; ++i) {
    EXPECT_EQ(i, all[i].code);
    EXPECT_STREQ(names[i], all[i].name);
  }
}

}  // namespace
