// Freshness of a handle's cache: the store's last catalogue load time and the refresh of the
// cached kinds of data.
#include "VLRecord.h"
#include "VLUtilities.h"
#include "VLWSAELog.h"
#include "VL_WS.h"
#include "VL_WS_Call.h"

static VLLogArea s_Log(VLWSAELOG_AREA_NAME);

extern "C" VL_WS_Status VL_WS_getLastCacheLoadTimeUTC(VL_WS_Handle* handle, VL_WS_String* utcTime) {
  VL_WS_Client* client = VLClientFor(handle, utcTime);
  if (client == 0) return VL_WS_E_INVALID_ARGUMENT;

  // A text result reaches the converter as its first character.
  int soapError = VLServiceCall(*client, client->m_RealTimeBrowse,
                                VL_SERVICE_OPERATION(RealTimeBrowse, getLastCacheLoadTimeUTC), VLNoFields(),
                                [&](const char& text) { VLRecordSetString(*utcTime, &text); });
  VLLogOutputwithConfig({s_Log.Id(), 4}, "%s, ret:%d,utctime:%s\n", "VL_WS_getLastCacheLoadTimeUTC", soapError,
                        utcTime->Text ? utcTime->Text : "");
  return VLUtilities::To_VL_WS_Status(soapError);
}

extern "C" VL_WS_Status VL_WS_updateLocalCache(VL_WS_Handle* handle, int dataKinds) {
  VL_WS_Client* client = VLClientOf(handle);
  if (client == 0) return VL_WS_E_INVALID_ARGUMENT;
  CacheInterface* cache = client->m_Cache;
  const int kinds = dataKinds & client->m_Params.CacheParam.CacheData;
  if (cache == 0 || client->m_Params.CacheParam.CacheType == kNoCache || kinds == 0) return VL_WS_OK;

  if (kinds & VL_WS_CacheParam::CACHE_METADATA) {
    // Cached answers go when the store's catalogue was loaded since; when the time cannot be
    // had they stay as they are.
    VL_WS_String time;
    if (VL_WS_getLastCacheLoadTimeUTC(handle, &time) == VL_WS_OK)
      cache->UpdateLastCacheLoadTime(VLString(time.Text, time.Length));
    VL_WS_release(&time);
  }
  if (kinds & VL_WS_CacheParam::CACHE_BOXART) cache->SetBoxArtNeedUpdate();
  if (kinds & VL_WS_CacheParam::CACHE_USERDATA) cache->PurgeUserData(VLString());
  return VL_WS_OK;
}

extern "C" VL_WS_Status VL_WS_shouldUpdateCache(VL_WS_Handle* handle, const char* utcTime, bool* update) {
  VL_WS_Client* client = VLClientFor(handle, update);
  if (client == 0 || utcTime == 0 || *utcTime == 0) return VL_WS_E_INVALID_ARGUMENT;
  int soapError = VLServiceCall(
      *client, client->m_RealTimeBrowse, VL_SERVICE_OPERATION(RealTimeBrowse, shouldUpdateCache),
      [&](_VL1__shouldUpdateCache& request) { request.UTCTime = const_cast<char*>(utcTime); },
      [&](int result) { *update = result == 1; });
  return VLBoolStatus("VL_WS_shouldUpdateCache", soapError, *update);
}
