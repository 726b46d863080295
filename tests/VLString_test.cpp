// VLString: growth that copies rarely, sources inside the string itself, embedded 0 bytes, bounds of find/substr, trim, comparisons, and the
// assertion texts of its preconditions.
#include <gtest/gtest.h>

#include <string>

#include "VLString.h"

namespace {

std::string Bytes(const VLString& s) { return std::string(s.c_str(), s.length()); }

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
  s += VLString("x\0y", 3);
  EXPECT_EQ(std::string("defabx\0y", 8), Bytes(s));
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
  VLString copy(a);
  EXPECT_TRUE(copy == a);
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
  EXPECT_TRUE(a <= VLString("apple"));
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
  EXPECT_DEATH(s.append(null, 2), "buf != 0");
  EXPECT_DEATH((void)(s == null), "b != 0");
}

}  // namespace
