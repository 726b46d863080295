// Freshness of a handle's cache: the store's last catalogue load time and the refresh of the
// cached kinds of data.
#include "VLRecord.h"
#include "VLUtilities.h"
#include "VLWSAELog.h"
#include "VL_WS.h"
#include "VL_WS_Client.h"

namespace {
VLLogArea s_Log(VLWSAELOG_AREA_NAME);
}  // namespace

extern "C" VL_WS_Status VL_WS_getLastCacheLoadTimeUTC(VL_WS_Handle* handle, VL_WS_String* utcTime) {
  if (utcTime == 0) return VL_WS_E_INVALID_ARGUMENT;
  VLRecordInit(*utcTime);
  VL_WS_Client* client = VLClientOf(handle);
  if (client == 0) return VL_WS_E_INVALID_ARGUMENT;

  RealTimeBrowse& service = client->m_RealTimeBrowse;
  _VL1__getLastCacheLoadTimeUTC* request = soap_new__VL1__getLastCacheLoadTimeUTC(&service);
  _VL1__getLastCacheLoadTimeUTCResponse* response = soap_new__VL1__getLastCacheLoadTimeUTCResponse(&service);
  int soapError = request && response ? service.Setup("getLastCacheLoadTimeUTC") : SOAP_EOM;
  if (soapError == SOAP_OK) soapError = service.getLastCacheLoadTimeUTC(request, response);
  if (soapError == SOAP_OK) VLRecordSetString(*utcTime, response->getLastCacheLoadTimeUTCResult);
  VLEndCall(service);
  VLLogOutputwithConfig({s_Log.Id(), 4}, "%s, ret:%d,utctime:%s\n", "VL_WS_getLastCacheLoadTimeUTC", soapError,
                        utcTime->Text ? utcTime->Text : "");
  return VLUtilities::To_VL_WS_Status(soapError);
}

extern "C" VL_WS_Status VL_WS_updateLocalCache(VL_WS_Handle* handle, int dataKinds) {
  VL_WS_Client* client = VLClientOf(handle);
  if (client == 0) return VL_WS_E_INVALID_ARGUMENT;
  CacheInterface* cache = client->m_Cache;
  const int kinds = dataKinds & client->m_Params.CacheParam.CacheData;
  if (cache == 0 || client->m_Params.CacheParam.CacheType == 0 || kinds == 0) return VL_WS_OK;

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
