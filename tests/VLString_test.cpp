// VLString: allocation sizes, embedded 0 bytes, bounds of find/substr, trim, comparisons, and the
// assertion texts of its preconditions.
#include <gtest/gtest.h>

#include <string>

#include "VLString.h"

namespace {

std::string Bytes(const VLString& s) { return std::string(s.c_str(), s.length()); }

TEST(VLString, AllocationFollowsMultiplesOfEight) {
  VLString s;
  EXPECT_EQ(0u, s.length());
  EXPECT_EQ(7u, s.capacity());
  EXPECT_STREQ("", s.c_str());

  const char* oldBuffer = s.c_str();
  s.assign("1234567", 7);
  EXPECT_EQ(7u, s.capacity());
  EXPECT_EQ(oldBuffer, s.c_str());
  s.assign("12345678", 8);
  EXPECT_EQ(15u, s.capacity());  // 7 + 7/2 = 10 -> 16 bytes

  std::string hundred(100, 'x');
  s.assign(hundred.data(), 100);  // 15/2 = 7 is not above 100/3 = 33: exactly 100 -> 104 bytes
  EXPECT_EQ(103u, s.capacity());
  EXPECT_EQ(hundred, Bytes(s));

  VLString wide(std::string(195, 'y').c_str());
  EXPECT_EQ(199u, wide.capacity());  // 195 -> 200 bytes
  const char* wideBuffer = wide.c_str();
  wide.assign(hundred.data(), 100);
  EXPECT_EQ(wideBuffer, wide.c_str());
  EXPECT_EQ(199u, wide.capacity());

  VLString grownByHalf(std::string(40, 'z').c_str());  // capacity 47
  grownByHalf.assign(std::string(60, 'q').c_str(), 60);  // 23 > 20: 47 + 23 = 70 -> 72 bytes
  EXPECT_EQ(71u, grownByHalf.capacity());

  VLString copy(wide);  // sized to the source's length, not its capacity
  EXPECT_EQ(103u, copy.capacity());
  EXPECT_EQ(Bytes(wide), Bytes(copy));
}

TEST(VLString, AppendGrowsByHalfOrToTheExactFit) {
  VLString s("abcde");
  EXPECT_EQ(7u, s.capacity());
  s.append("fg", 2);
  EXPECT_EQ(7u, s.capacity());
  s.append("h", 1);
  EXPECT_EQ(15u, s.capacity());
  s.append("ijklmnopq", 9);  // 15 + 7 = 22 -> 24 bytes
  EXPECT_EQ(23u, s.capacity());
  s.append(std::string(40, 'r').c_str(), 40);  // 57 is more than half as much again: exactly 64 bytes
  EXPECT_EQ(63u, s.capacity());
  s.assign("abcdefghijklmnopq", 17);
  EXPECT_EQ("abcdefghijklmnopq", Bytes(s));
  const char* before = s.c_str();
  s.append(nullptr, 0);
  EXPECT_EQ(before, s.c_str());
  EXPECT_EQ(17u, s.length());

  s += '!';
  s += "?";
  s += VLString("x\0y", 3);
  EXPECT_EQ(std::string("abcdefghijklmnopq!?x\0y", 22), Bytes(s));
}

// A text built a character at a time is copied a logarithmic number of times, not once every
// eight characters.
TEST(VLString, GrowingACharacterAtATimeCopiesRarely) {
  VLString s;
  int copies = 0;
  for (int i = 0; i < 65536; ++i) {
    const char* before = s.c_str();
    s += static_cast<char>('a' + i % 26);
    copies += s.c_str() != before;
  }
  EXPECT_EQ(65536u, s.length());
  EXPECT_EQ('z', s[25 + 26 * 100]);
  EXPECT_LT(copies, 40);
}

TEST(VLString, SourcesInsideTheStringItself) {
  VLString s("abcdef");
  s.append(s.c_str(), s.length());  // reallocates while reading from the old buffer
  EXPECT_EQ("abcdefabcdef", Bytes(s));
  s += s;
  EXPECT_EQ("abcdefabcdefabcdefabcdef", Bytes(s));
  s.assign(s.c_str() + 3, 5);  // overlapping copy in place
  EXPECT_EQ("defab", Bytes(s));
  s = s;
  EXPECT_EQ("defab", Bytes(s));
}

TEST(VLString, EmbeddedZeroBytes) {
  VLString a("ab\0cd", 5), b("ab\0ce", 5);
  EXPECT_EQ(5u, a.length());
  EXPECT_EQ('\0', a.c_str()[5]);
  EXPECT_FALSE(a == b);
  EXPECT_TRUE(a != b);
  // Against a C text the comparison stops at the first 0 byte.
  EXPECT_TRUE(a == "ab");
  EXPECT_TRUE("ab" == b);
  EXPECT_FALSE(a != "ab");
  EXPECT_EQ(2u, a.find('\0'));
  EXPECT_EQ(std::string("\0cd", 3), Bytes(a.substr(2, 10)));
  VLString copy(a), assigned;
  assigned = a;
  EXPECT_TRUE(copy == a);
  EXPECT_EQ(Bytes(a), Bytes(assigned));
}

TEST(VLString, FindAndSubstrBounds) {
  VLString s("hello");
  const struct {
    char ch;
    size_t pos, expected;
  } finds[] = {{'l', 0, 2}, {'l', 3, 3}, {'l', 4, VLString::npos}, {'x', 10, VLString::npos}, {'h', 5, VLString::npos}};
  for (const auto& f : finds) EXPECT_EQ(f.expected, s.find(f.ch, f.pos)) << f.ch << " from " << f.pos;
  EXPECT_EQ(VLString::npos, VLString().find('\0'));
  EXPECT_EQ(4294967295u, VLString::npos);

  const struct {
    size_t pos, n;
    const char* expected;
  } substrs[] = {{5, 3, ""},    {100, VLString::npos, ""},    {3, 100, "lo"},
                 {1, 3, "ell"}, {0, VLString::npos, "hello"}, {2, 0, ""}};
  for (const auto& c : substrs) EXPECT_EQ(c.expected, Bytes(s.substr(c.pos, c.n))) << c.pos << ", " << c.n;
  EXPECT_EQ("hello", Bytes(s.substr(0)));
}

TEST(VLString, TrimRemovesOnlySpaces) {
  const struct {
    std::string text, expected;
  } cases[] = {
      {"  a b  ", "a b"}, {"\ta ", "\ta"}, {"   ", ""}, {"", ""}, {" x\r\n", "x\r\n"},
      {std::string(" a\0b ", 5), "a"},  // trim ends the text at the inner 0 byte
  };
  for (const auto& c : cases) {
    VLString s(c.text.data(), c.text.size());
    s.trim();
    EXPECT_EQ(c.expected, Bytes(s)) << "\"" << c.text << "\"";
  }
}

TEST(VLString, OrderingAndConcatenation) {
  VLString a("apple"), b("banana");
  EXPECT_TRUE(a < b);
  EXPECT_TRUE(b > a);
  EXPECT_TRUE(a <= b);
  EXPECT_TRUE(a <= VLString("apple"));
  EXPECT_TRUE(b >= a);
  EXPECT_FALSE(a > b);
  EXPECT_FALSE(a >= b);
  EXPECT_EQ("applebanana", Bytes(a + b));
  EXPECT_EQ("apple pie", Bytes(a + " pie"));
  EXPECT_EQ("green apple", Bytes("green " + a));

  a.swap(b);
  EXPECT_EQ("banana", Bytes(a));
  EXPECT_EQ("apple", Bytes(b));
  a = "kiwi";
  a[0] = 'K';
  EXPECT_EQ('K', static_cast<const VLString&>(a)[0]);
  EXPECT_EQ("Kiwi", Bytes(a));
}

TEST(VLStringDeathTest, PreconditionsReportTheirCondition) {
  GTEST_FLAG_SET(death_test_style, "threadsafe");
  const char* null = nullptr;
  VLString s("abc");
  EXPECT_DEATH(VLString{null}, "str != 0");
  EXPECT_DEATH(VLString(null, 3), "buf != 0");
  EXPECT_DEATH(s[3], "idx < length\\(\\)");
  EXPECT_DEATH(static_cast<const VLString&>(s)[7], "idx < length\\(\\)");
  EXPECT_DEATH(s.assign(null, 2), "buf != 0");
  EXPECT_DEATH(s.append(null, 2), "buf != 0");
  EXPECT_DEATH(s = null, "buf != 0");
  EXPECT_DEATH((void)(s == null), "b != 0");
  EXPECT_DEATH((void)(null != s), "b != 0");
  EXPECT_DEATH(s + null, "b != 0");
  EXPECT_DEATH(null + s, "a != 0");
}

}  // namespace
