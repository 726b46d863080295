// The parts of the shared call sequence that are not templates: the two kinds of cached data,
// cache Keys and the result line.
#include "VLCachedCall.h"

#include <stdarg.h>
#include <stdio.h>

#include <vector>

#include "VLWSAELog.h"

namespace {
VLLogArea s_Log(VLWSAELOG_AREA_NAME);
}  // namespace

const VLCacheKind VLCacheKind::kMetaData = {&CacheInterface::ReadMetaData, &CacheInterface::WriteMetaData,
                                            VL_WS_CacheParam::CACHE_METADATA};
const VLCacheKind VLCacheKind::kUserData = {&CacheInterface::ReadUserData, &CacheInterface::WriteUserData,
                                            VL_WS_CacheParam::CACHE_USERDATA};

VLString VLCacheKey(const char* format, ...) {
  char small[256];
  va_list args;
  va_start(args, format);
  int length = vsnprintf(small, sizeof(small), format, args);
  va_end(args);
  if (length < 0) return VLString();
  if (static_cast<size_t>(length) < sizeof(small)) return VLString(small, static_cast<size_t>(length));

  std::vector<char> large(static_cast<size_t>(length) + 1);
  va_start(args, format);
  vsnprintf(large.data(), large.size(), format, args);
  va_end(args);
  return VLString(large.data(), static_cast<size_t>(length));
}

void VLLogCallResult(const char* name, int soapError, int responseCode) {
  VLLogOutputwithConfig({s_Log.Id(), 4}, "%s, ret:%d,responseCode:%d\n", name, soapError, responseCode);
}

void VLLogCacheHit(const char* name) {
  VLLogOutputwithConfig({s_Log.Id(), 4}, "%s, answered from the cache\n", name);
}
