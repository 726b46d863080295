// The steps that the store operations share: results, statuses and their log line.
#include "VL_WS_Call.h"

#include "VLUtilities.h"
#include "VLWSAELog.h"

namespace {

VLLogArea s_Log(VLWSAELOG_AREA_NAME);

void LogResult(const char* name, int soapError, const VL_WS_StandardResponse& record) {
  VLLogOutputwithConfig({s_Log.Id(), 4}, "%s, ret:%d,responseCode:%d\n", name, soapError, record.ResponseCode);
}

}  // namespace

VL_WS_Client* VLBeginCall(VL_WS_Handle* handle, bool* value) {
  if (value == 0) return 0;
  *value = false;
  return VLClientOf(handle);
}

VL_WS_Client* VLBeginCall(VL_WS_Handle* handle, int* value) {
  if (value == 0) return 0;
  *value = 0;
  return VLClientOf(handle);
}

VL_WS_Status VLFoldedStatus(const char* name, int soapError, const VL_WS_StandardResponse& record,
                            const char* statusRow) {
  LogResult(name, soapError, record);
  return VLUtilities::To_VL_WS_Status(soapError, record.ResponseCode, statusRow);
}

VL_WS_Status VLSoapStatus(const char* name, int soapError, const VL_WS_StandardResponse& record) {
  LogResult(name, soapError, record);
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
