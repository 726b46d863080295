// The steps of the call sequence (VL_WS_Call.h) that are not templates: the first step of
// operations that answer a bool or an int, the page check, the two kinds of cached data, cache
// Keys, the result lines and the statuses.
#include "VL_WS_Call.h"

#include <limits.h>
#include <stdarg.h>
#include <stdio.h>

#include <vector>

#include "VLUtilities.h"
#include "VLWSAELog.h"

namespace {

VLLogArea s_Log(VLWSAELOG_AREA_NAME);

// The result line "<name>, ret:<soapError>,responseCode:<responseCode>" to "VL_WSAE" at level 4.
void LogCallResult(const char* name, int soapError, int responseCode) {
  VLLogOutputwithConfig({s_Log.Id(), 4}, "%s, ret:%d,responseCode:%d\n", name, soapError, responseCode);
}

}  // namespace

VL_WS_Client* VLClientFor(const VL_WS_Handle* handle, bool* value) {
  if (value == 0) return 0;
  *value = false;
  return VLClientOf(handle);
}

VL_WS_Client* VLClientFor(const VL_WS_Handle* handle, int* value) {
  if (value == 0) return 0;
  *value = 0;
  return VLClientOf(handle);
}

bool VLPageFits(int currentPageNumber, int itemsPerPage) {
  for (int value : {currentPageNumber, itemsPerPage})
    if (value < SHRT_MIN || value > SHRT_MAX) return false;
  return true;
}

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

void VLLogCacheHit(const char* name) {
  VLLogOutputwithConfig({s_Log.Id(), 4}, "%s, answered from the cache\n", name);
}

VL_WS_Status VLFoldedStatus(const char* name, int soapError, int responseCode) {
  LogCallResult(name, soapError, responseCode);
  return VLUtilities::To_VL_WS_Status(soapError, responseCode, name);
}

VL_WS_Status VLSoapStatus(const char* name, int soapError, int responseCode) {
  LogCallResult(name, soapError, responseCode);
  return VLUtilities::To_VL_WS_Status(soapError);
}

void VLLogBoolResult(const char* name, bool value) {
  VLLogOutputwithConfig({s_Log.Id(), 4}, "%s, result:%d\n", name, value);
}

VL_WS_Status VLBoolStatus(const char* name, int soapError, bool value) {
  VLLogBoolResult(name, value);
  return VLUtilities::To_VL_WS_Status(soapError);
}

CacheInterface* VLUserData(VL_WS_Client* client) {
  if (client->m_Params.CacheParam.CacheData & VL_WS_CacheParam::CACHE_USERDATA) return client->m_Cache;
  return 0;
}
