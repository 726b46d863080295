// Box-art size words and image file names.
#include <gtest/gtest.h>

#include <string>

#include "VLUtilities.h"

namespace {

TEST(BoxArtSizeWords, EverySizeHasItsWords) {
  const char* expected[] = {"95",  "175", "65",  "77",  "102", "126", "135",
                            "137", "153", "177", "203", "269", "321"};
  for (int size = VL_WS_BOXART_95; size <= VL_WS_BOXART_321; ++size) {
    VL_WS_BoxArtSize s = static_cast<VL_WS_BoxArtSize>(size);
    EXPECT_STREQ(expected[size], VLUtilities::BoxArtSize2ImageSize(s)) << size;
    // Only 135s names its folder differently from its images.
    EXPECT_STREQ(size == VL_WS_BOXART_135S ? "135s" : expected[size],
                 VLUtilities::BoxArtSize2FolderSize(s))
        << size;
  }
}

TEST(BoxArtSizeWords, OtherValuesHaveNone) {
  EXPECT_STREQ("", VLUtilities::BoxArtSize2FolderSize(static_cast<VL_WS_BoxArtSize>(13)));
  EXPECT_STREQ("", VLUtilities::BoxArtSize2ImageSize(static_cast<VL_WS_BoxArtSize>(13)));
  EXPECT_STREQ("", VLUtilities::BoxArtSize2FolderSize(static_cast<VL_WS_BoxArtSize>(-1)));
  EXPECT_STREQ("", VLUtilities::BoxArtSize2ImageSize(static_cast<VL_WS_BoxArtSize>(-1)));
}

std::string FileName(const char* path, const char* prefix, VL_WS_BoxArtSize size) {
  return VLUtilities::GetBoxArtImageFileName(path, prefix, size).c_str();
}

TEST(BoxArtImageFileName, LivesBesideTheCacheDatabase) {
  EXPECT_EQ("/data/c/abc135.jpg", FileName("/data/c/x.vl", "abc", VL_WS_BOXART_135S));
  EXPECT_EQ("/data/c/abc321.jpg", FileName("/data/c/", "abc", VL_WS_BOXART_321));
  // The prefix is kept as it is, not URL-encoded.
  EXPECT_EQ("/c/a b95.jpg", FileName("/c/x.vl", "a b", VL_WS_BOXART_95));
  // A path without a folder part is taken as the folder.
  EXPECT_EQ("cache/t175.jpg", FileName("cache", "t", VL_WS_BOXART_175));
  EXPECT_EQ("./t175.jpg", FileName("", "t", VL_WS_BOXART_175));
}

TEST(BoxArtImageFileNameDeathTest, NeedsPathAndPrefix) {
  GTEST_FLAG_SET(death_test_style, "threadsafe");
  EXPECT_DEATH(VLUtilities::GetBoxArtImageFileName(nullptr, "a", VL_WS_BOXART_95),
               "\\(path != 0\\) && \\(boxartprefix != 0\\)");
  EXPECT_DEATH(VLUtilities::GetBoxArtImageFileName("/c/x.vl", nullptr, VL_WS_BOXART_95),
               "\\(path != 0\\) && \\(boxartprefix != 0\\)");
}

}  // namespace
