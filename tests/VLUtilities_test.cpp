// Basic utilities: URL encoding, bounded formatting, time texts, the hash
// values other stored data depends on, random bytes and the device identifier.
#include <gtest/gtest.h>

#include <dirent.h>
#include <sys/time.h>

#include <cctype>
#include <cstring>
#include <regex>
#include <set>
#include <string>

#include "VLTestDir.h"
#include "VLUtilities.h"

namespace {

std::string Str(const VLString& s) { return std::string(s.c_str(), s.length()); }

TEST(VLUtilities, URLEncodeEscapesAllButUnreservedBytes) {
  EXPECT_EQ("AZaz09-_.!~*'()a%20b", Str(VLUtilities::URLEncode("AZaz09-_.!~*'()a b")));
  EXPECT_EQ("%2F%3F%26%3D%2B%25%09%0A", Str(VLUtilities::URLEncode("/?&=+%\t\n")));
  EXPECT_EQ("caf%E9", Str(VLUtilities::URLEncode("caf\xE9")));
  EXPECT_EQ("%C3%A9%FF%80%7F", Str(VLUtilities::URLEncode("\xC3\xA9\xFF\x80\x7F")));
  EXPECT_TRUE(VLUtilities::URLEncode("").empty());
  EXPECT_TRUE(VLUtilities::URLEncode(nullptr).empty());
}

TEST(VLUtilities, SafeSnprintfTruncatesAndTerminates) {
  char buf[16];
  memset(buf, 'z', sizeof buf);
  EXPECT_EQ(buf, VLUtilities::safe_snprintf(buf, 5, "%s-%d", "abcdef", 42));
  EXPECT_STREQ("abcd", buf);
  EXPECT_EQ('z', buf[5]);  // nothing written past bufsize
  VLUtilities::safe_snprintf(buf, sizeof buf, "%d/%s", 7, "ok");
  EXPECT_STREQ("7/ok", buf);
  VLUtilities::safe_snprintf(buf, 2, "xyz");
  EXPECT_STREQ("x", buf);
}

TEST(VLUtilitiesDeathTest, SafeSnprintfPreconditions) {
  GTEST_FLAG_SET(death_test_style, "threadsafe");
  char buf[8];
  const char* pattern = "\\(buf != 0\\) && \\(format != 0\\) && \\(bufsize > 1\\)";
  EXPECT_DEATH(VLUtilities::safe_snprintf(buf, 1, "x"), pattern);
}

TEST(VLUtilities, TimeTexts) {
  tm t = {};
  t.tm_year = 2011 - 1900;
  t.tm_mon = 2;
  t.tm_mday = 5;
  t.tm_hour = 14;
  t.tm_min = 7;
  t.tm_sec = 9;
  EXPECT_EQ("2011/03/05 14:07:09", Str(VLUtilities::TM2Str(t)));
  t.tm_year = 12000 - 1900;  // does not fit the 19 characters
  EXPECT_TRUE(VLUtilities::TM2Str(t).empty());

  struct timeval now;
  gettimeofday(&now, nullptr);
  unsigned int expected = static_cast<unsigned int>(now.tv_sec * 1000ULL + now.tv_usec / 1000);
  unsigned int ms = VLUtilities::MillisecondTime();
  EXPECT_LT(ms - expected, 1000u);  // unsigned: also right across the 2^32 wrap
}

TEST(VLUtilities, HashValuesAreFixed) {
  EXPECT_EQ(2230358368u, VLUtilities::Hash(0, "abc", 3));
  EXPECT_EQ(97u, VLUtilities::Hash(0, "a", 1));
  EXPECT_EQ(0u, VLUtilities::Hash(0, "abc", 0));
  EXPECT_EQ(7u, VLUtilities::Hash(7, nullptr, 0));
  EXPECT_EQ(VLUtilities::Hash(0, "ab", 2), VLUtilities::Hash(0, "ab\0cd", 2));
  EXPECT_NE(VLUtilities::Hash(0, "ab\0c", 4), VLUtilities::Hash(0, "ab\0d", 4));
  // Bytes above 127 enter as unsigned values: ((0 * p) ^ 0xFF) * p ^ 0x01
  EXPECT_EQ((255u * 16777619u) ^ 1u, VLUtilities::Hash(0, "\xFF\x01", 2));
}

TEST(VLUtilities, RandomBytesFillTheWholeBuffer) {
  unsigned char a[64] = {0}, b[64] = {0};
  ASSERT_EQ(1, VLUtilities::RandomBytes(reinterpret_cast<char*>(a), sizeof a));
  ASSERT_EQ(1, VLUtilities::RandomBytes(reinterpret_cast<char*>(b), sizeof b));
  EXPECT_NE(0, memcmp(a, b, sizeof a));
  std::set<unsigned char> distinct(a, a + sizeof a);
  EXPECT_GT(distinct.size(), 16u);
  EXPECT_EQ(1, VLUtilities::RandomBytes(reinterpret_cast<char*>(a), 0));
}

// Hardware addresses of this machine's interfaces in the identifier's format, zero ones left out.
std::set<std::string> InterfaceAddresses() {
  std::set<std::string> addresses;
  DIR* dir = opendir("/sys/class/net");
  if (!dir) return addresses;
  while (struct dirent* entry = readdir(dir)) {
    std::string text = VLReadFile(std::string("/sys/class/net/") + entry->d_name + "/address");
    if (text.size() < 17) continue;
    text.resize(17);
    for (char& c : text) c = (c == ':') ? '-' : static_cast<char>(toupper(static_cast<unsigned char>(c)));
    if (text != "00-00-00-00-00-00") addresses.insert(text);
  }
  closedir(dir);
  return addresses;
}

TEST(VLUtilities, UniqueIdentifierIsARealHardwareAddress) {
  std::string id = Str(VLUtilities::GetUniqueIdentifier());
  EXPECT_TRUE(std::regex_match(id, std::regex("([0-9A-F]{2}-){5}[0-9A-F]{2}"))) << id;
  EXPECT_NE("00-00-00-00-00-00", id);  // loopback, listed first, is passed over
  std::set<std::string> addresses = InterfaceAddresses();
  if (addresses.empty()) GTEST_SKIP() << "no interface with a hardware address on this machine";
  EXPECT_EQ(1u, addresses.count(id)) << id;
  EXPECT_EQ(id, Str(VLUtilities::GetUniqueIdentifier()));
}

}  // namespace
