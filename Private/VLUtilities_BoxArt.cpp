// Box art and images: the size words of box-art images, where the image host serves them, the
// names of their cache files, and the image record.
#include <limits.h>
#include <stdio.h>
#include <string.h>

#include "VLAssert.h"
#include "VLFile.h"
#include "VLStoreHosts.h"
#include "VLUtilities.h"

namespace {

// The words of each VL_WS_BoxArtSize in image URLs and file names, indexed by the size's value.
struct SizeWords {
  const char* folder;
  const char* image;
};

const SizeWords kSizeWords[] = {
    {"95", "95"},   {"175", "175"}, {"65", "65"},   {"77", "77"},   {"102", "102"},
    {"126", "126"}, {"135s", "135"}, {"137", "137"}, {"153", "153"}, {"177", "177"},
    {"203", "203"}, {"269", "269"}, {"321", "321"},
};

const SizeWords* WordsOf(VL_WS_BoxArtSize size) {
  int index = static_cast<int>(size);
  if (index < 0 || index >= static_cast<int>(sizeof(kSizeWords) / sizeof(kSizeWords[0]))) return 0;
  return &kSizeWords[index];
}

}  // namespace

const char* VLUtilities::BoxArtSize2FolderSize(VL_WS_BoxArtSize size) {
  const SizeWords* words = WordsOf(size);
  return words != 0 ? words->folder : "";
}

const char* VLUtilities::BoxArtSize2ImageSize(VL_WS_BoxArtSize size) {
  const SizeWords* words = WordsOf(size);
  return words != 0 ? words->image : "";
}

VLString VLUtilities::GetBoxArtImageFileName(const char* path, const char* boxartprefix,
                                             VL_WS_BoxArtSize size) {
  VL_ASSERT((path != 0) && (boxartprefix != 0));
  VLString name = VLFile::GetFolderName(path);
  name += boxartprefix;
  name += BoxArtSize2ImageSize(size);
  name += ".jpg";
  return name;
}

VLString VLUtilities::GetBoxArtImagePath(const char* boxartprefix, VL_WS_BoxArtSize size) {
  VLString path("/images/boxart/");
  path += BoxArtSize2FolderSize(size);
  path += "/";
  path += URLEncode(boxartprefix);
  path += BoxArtSize2ImageSize(size);
  path += ".jpg";
  return path;
}

VLString VLUtilities::GetBoxArtImageURL(const char* boxartprefix, VL_WS_BoxArtSize size) {
  return "http://" VL_STORE_IMAGE_HOST + GetBoxArtImagePath(boxartprefix, size);
}

namespace {

// The markers of a JPEG stream: start of image (with the first byte of the next marker) and end
// of image.
const unsigned char kJpegHead[] = {0xFF, 0xD8, 0xFF};
const unsigned char kJpegTail[] = {0xFF, 0xD9};

bool IsJpeg(const void* head, const void* tail) {
  return memcmp(head, kJpegHead, sizeof kJpegHead) == 0 && memcmp(tail, kJpegTail, sizeof kJpegTail) == 0;
}

}  // namespace

bool VLUtilities::IsJpegImage(const VLString& bytes) {
  return bytes.length() >= sizeof kJpegHead + sizeof kJpegTail &&
         IsJpeg(bytes.c_str(), bytes.c_str() + bytes.length() - sizeof kJpegTail);
}

bool VLUtilities::IsJpegFile(const VLString& filename) {
  const vl_int64 headLength = sizeof kJpegHead, tailLength = sizeof kJpegTail;
  unsigned char head[sizeof kJpegHead], tail[sizeof kJpegTail];
  VLFile file;
  return file.Open(filename.c_str(), "rb") && file.GetSize() >= headLength + tailLength &&
         file.Read(head, headLength) == headLength && file.Seek(-tailLength, SEEK_END) &&
         file.Read(tail, tailLength) == tailLength && IsJpeg(head, tail);
}

namespace {

// Frees the image's bytes: kind 0, no bytes.
void ClearImage(VL_WS_Image& image) {
  delete[] image.Data;
  image.Data = 0;
  image.Length = 0;
  image.Kind = 0;
}

}  // namespace

void VLUtilities::SetImageByData(VL_WS_Image& image, const VLString& data) {
  ClearImage(image);
  if (data.empty()) return;
  image.Data = new char[data.length()];
  memcpy(image.Data, data.c_str(), data.length());
  image.Length = static_cast<int>(data.length());
}

bool VLUtilities::SetImageByFile(VL_WS_Image& image, const VLString& filename) {
  ClearImage(image);
  VLFile file;
  if (!file.Open(filename.c_str(), "rb")) return false;
  vl_int64 size = file.GetSize();
  if (size < 1 || size > INT_MAX) return false;
  char* data = new char[size];
  if (file.Read(data, size) != size) {
    delete[] data;
    return false;
  }
  image.Data = data;
  image.Length = static_cast<int>(size);
  return true;
}
