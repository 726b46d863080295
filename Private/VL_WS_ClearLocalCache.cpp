// VL_WS_clearLocalCache: wipes a cache folder's files without a handle.
#include "VLFile.h"
#include "VL_WS.h"

VL_WS_Status VL_WS_clearLocalCache(const char* folder) {
  if (folder == 0 || *folder == 0) return VL_WS_E_INVALID_ARGUMENT;
  VLString prefix(folder);
  if (prefix[prefix.length() - 1] != VLFile::PATH_SEPERATOR) prefix += VLFile::PATH_SEPERATOR;
  // Box-art images, cache databases, then the temporary files of interrupted downloads.
  static const char* const kPatterns[] = {"*.jpg", "*.vl", "vlws*"};
  for (const char* pattern : kPatterns) {
    if (!VLFile::RemoveWithWildcard((prefix + pattern).c_str())) return VL_WS_E_FILE;
  }
  return VL_WS_OK;
}
