// Box-art image file names and locations, and the image record.
#include <gtest/gtest.h>

#include <string>

#include "VLRecord.h"
#include "VLTestDir.h"
#include "VLUtilities.h"
#include "VL_WS.h"

namespace {

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

// An image record takes a copy of bytes or of a whole file; nothing leaves it empty.
TEST(ImageRecord, TakesBytesOrAWholeFileOrNothing) {
  VLTestDir dir;
  std::string jpeg("\xFF\xD8\0\x01", 4);
  ASSERT_TRUE(VLWriteFile(dir / "a.jpg", jpeg));
  ASSERT_TRUE(VLWriteFile(dir / "empty.jpg", ""));
  VL_WS_Image image;
  VLRecordInit(image);
  VLUtilities::SetImageByData(image, VLString(jpeg.data(), jpeg.size()));
  EXPECT_EQ(jpeg, Bytes(image));
  EXPECT_EQ(0, image.Kind);
  VLUtilities::SetImageByData(image, "");
  EXPECT_EQ("(null)", Bytes(image));
  ASSERT_TRUE(VLWriteFile(dir / "b.jpg", "xy"));
  EXPECT_TRUE(VLUtilities::SetImageByFile(image, (dir / "b.jpg").c_str()));
  EXPECT_EQ("xy", Bytes(image));
  EXPECT_FALSE(VLUtilities::SetImageByFile(image, (dir / "empty.jpg").c_str()));
  EXPECT_EQ("(null)", Bytes(image));
  EXPECT_EQ(0, image.Length);
  EXPECT_TRUE(VLUtilities::SetImageByFile(image, (dir / "a.jpg").c_str()));
  EXPECT_FALSE(VLUtilities::SetImageByFile(image, (dir / "missing.jpg").c_str()));
  EXPECT_EQ("(null)", Bytes(image));
  EXPECT_EQ(VL_WS_OK, VL_WS_release(&image));
}

}  // namespace
