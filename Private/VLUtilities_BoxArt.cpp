// Box art and images: the size words of box-art images and the names of their cache files.
#include "VLAssert.h"
#include "VLFile.h"
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
