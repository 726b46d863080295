#include "VLSimBoxArt.h"

#include <jpeglib.h>

#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <vector>

#include "VLSimHttp.h"

namespace {

const char kRoot[] = "/images/boxart/";

struct SizeWords {
  const char* folder;
  const char* image;
};

// By size number; only size 6 has a folder word that differs from its image word.
const SizeWords kSizes[] = {{"95", "95"},   {"175", "175"}, {"65", "65"},   {"77", "77"},   {"102", "102"},
                            {"126", "126"}, {"135s", "135"}, {"137", "137"}, {"153", "153"}, {"177", "177"},
                            {"203", "203"}, {"269", "269"}, {"321", "321"}};
const int kSizeCount = sizeof kSizes / sizeof kSizes[0];

}  // namespace

bool VLSimParseBoxArtPath(const std::string& path, std::string* prefix, int* size) {
  if (path.compare(0, strlen(kRoot), kRoot) != 0) return false;
  std::string rest = path.substr(strlen(kRoot));
  size_t slash = rest.find('/');
  if (slash == std::string::npos) return false;
  std::string folder = rest.substr(0, slash);
  std::string file = VLSimURLDecode(rest.substr(slash + 1), false);
  for (int i = 0; i < kSizeCount; ++i) {
    if (folder != kSizes[i].folder) continue;
    std::string suffix = std::string(kSizes[i].image) + ".jpg";
    if (file.size() <= suffix.size() || file.compare(file.size() - suffix.size(), suffix.size(), suffix) != 0)
      return false;
    *prefix = file.substr(0, file.size() - suffix.size());
    *size = i;
    return true;
  }
  return false;
}

std::string VLSimBoxArtPath(const std::string& prefix, int size) {
  std::string encoded;
  for (unsigned char c : prefix) {
    if (isalnum(c) || strchr("-_.!~*'()", c)) {
      encoded += static_cast<char>(c);
    } else {
      char hex[4];
      snprintf(hex, sizeof hex, "%%%02X", c);
      encoded += hex;
    }
  }
  return std::string(kRoot) + kSizes[size].folder + "/" + encoded + kSizes[size].image + ".jpg";
}

std::string VLSimBoxArtJpeg(const std::string& prefix, int size, int version) {
  unsigned int hash = 2166136261u;
  for (unsigned char c : prefix) hash = (hash ^ c) * 16777619u;
  hash += static_cast<unsigned int>(version) * 2654435761u;
  const int width = atoi(kSizes[size].image);
  const int height = width * 3 / 2;

  jpeg_compress_struct info;
  jpeg_error_mgr errors;
  info.err = jpeg_std_error(&errors);
  jpeg_create_compress(&info);
  unsigned char* buffer = nullptr;
  unsigned long length = 0;
  jpeg_mem_dest(&info, &buffer, &length);
  info.image_width = width;
  info.image_height = height;
  info.input_components = 3;
  info.in_color_space = JCS_RGB;
  jpeg_set_defaults(&info);
  jpeg_set_quality(&info, 75, TRUE);
  jpeg_start_compress(&info, TRUE);
  std::string comment = "vlstore-sim box art " + prefix + " size " + kSizes[size].image + " version " +
                        std::to_string(version);
  jpeg_write_marker(&info, JPEG_COM, reinterpret_cast<const JOCTET*>(comment.data()),
                    static_cast<unsigned int>(comment.size()));
  // A vertical gradient of the prefix's colour, darker towards the bottom.
  std::vector<JSAMPLE> row(width * 3);
  for (int y = 0; y < height; ++y) {
    int shade = 255 - y * 160 / height;
    for (int x = 0; x < width; ++x)
      for (int c = 0; c < 3; ++c) row[x * 3 + c] = static_cast<JSAMPLE>(((hash >> (c * 8)) & 0xFF) * shade / 255);
    JSAMPROW rows[1] = {row.data()};
    jpeg_write_scanlines(&info, rows, 1);
  }
  jpeg_finish_compress(&info);
  jpeg_destroy_compress(&info);
  std::string jpeg(reinterpret_cast<char*>(buffer), length);
  free(buffer);
  return jpeg;
}
