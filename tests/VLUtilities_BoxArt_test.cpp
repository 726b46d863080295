// Box-art size words and image file names.
#include <gtest/gtest.h>

#include <string>

#include "VLRecord.h"
#include "VLTestDir.h"
#include "VLUtilities.h"
#include "VL_WS.h"

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

TEST(BoxArtImageLocation, PathHasTheFolderWordAndTheEncodedPrefix) {
  EXPECT_EQ("/images/boxart/135s/abc135.jpg", VLUtilities::GetBoxArtImagePath("abc", VL_WS_BOXART_135S));
  EXPECT_EQ("http://images.ostrel.example/images/boxart/95/a%20b%2F%25c95.jpg",
            VLUtilities::GetBoxArtImageURL("a b/%c", VL_WS_BOXART_95));
}

std::string Bytes(const VL_WS_Image& image) { return image.Data ? std::string(image.Data, image.Length) : "(null)"; }

TEST(ImageRecord, TakesACopyOfTheBytes) {
  VL_WS_Image image;
  VLRecordInit(image);
  std::string jpeg("\xFF\xD8\0\x01", 4);
  VLUtilities::SetImageByData(image, VLString(jpeg.data(), jpeg.size()));
  EXPECT_EQ(jpeg, Bytes(image));
  EXPECT_EQ(0, image.Kind);
  // New bytes replace the old ones; no bytes leave none.
  VLUtilities::SetImageByData(image, "xy");
  EXPECT_EQ("xy", Bytes(image));
  VLUtilities::SetImageByData(image, "");
  EXPECT_EQ("(null)", Bytes(image));
  EXPECT_EQ(0, image.Length);
  EXPECT_EQ(VL_WS_OK, VL_WS_release(&image));
}

TEST(ImageRecord, TakesAWholeFileOrNothing) {
  VLTestDir dir;
  std::string jpeg("\xFF\xD8\0\x01", 4);
  ASSERT_TRUE(VLWriteFile(dir / "a.jpg", jpeg));
  ASSERT_TRUE(VLWriteFile(dir / "empty.jpg", ""));
  VL_WS_Image image;
  VLRecordInit(image);
  EXPECT_TRUE(VLUtilities::SetImageByFile(image, (dir / "a.jpg").c_str()));
  EXPECT_EQ(jpeg, Bytes(image));
  EXPECT_FALSE(VLUtilities::SetImageByFile(image, (dir / "empty.jpg").c_str()));
  EXPECT_EQ("(null)", Bytes(image));
  EXPECT_EQ(0, image.Length);
  EXPECT_TRUE(VLUtilities::SetImageByFile(image, (dir / "a.jpg").c_str()));
  EXPECT_FALSE(VLUtilities::SetImageByFile(image, (dir / "missing.jpg").c_str()));
  EXPECT_EQ("(null)", Bytes(image));
  EXPECT_EQ(VL_WS_OK, VL_WS_release(&image));
}

TEST(BoxArtImageFileNameDeathTest, NeedsPathAndPrefix) {
  GTEST_FLAG_SET(death_test_style, "threadsafe");
  EXPECT_DEATH(VLUtilities::GetBoxArtImageFileName(nullptr, "a", VL_WS_BOXART_95),
               "\\(path != 0\\) && \\(boxartprefix != 0\\)");
  EXPECT_DEATH(VLUtilities::GetBoxArtImageFileName("/c/x.vl", nullptr, VL_WS_BOXART_95),
               "\\(path != 0\\) && \\(boxartprefix != 0\\)");
}

}  // namespace
