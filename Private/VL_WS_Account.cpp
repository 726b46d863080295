// Account operations of the client: the store's file type of the device, which also decides the
// access type of the handle; linking the device to an account and its token; the account's
// settings and the store's configuration for the device.
#include "VLUtilities.h"
#include "VLWSAELog.h"
#include "VL_WS.h"
#include "VL_WS_Call.h"
#include "VL_WS_Client.h"

static VLLogArea s_Log(VLWSAELOG_AREA_NAME);

extern "C" VL_WS_Status VL_WS_getFileType(VL_WS_Handle* handle, VL_WS_FileType* fileType) {
  VL_WS_Client* client = VLClientFor(handle, fileType);
  if (client == 0) return VL_WS_E_INVALID_ARGUMENT;

  int soapError = VLPlainCall(client->m_RealTimeBrowse, "getFileType", soap_new__VL1__getFileType,
                              soap_new__VL1__getFileTypeResponse, &RealTimeBrowse::getFileType,
                              [&](const _VL1__getFileTypeResponse& response) {
                                if (response.getFileTypeResult == 0) return;
                                const VL1__FileType& answer = *response.getFileTypeResult;
                                fileType->File_DRMProvider = answer.File_USCOREDRMProvider;
                                fileType->File_AccessType = answer.File_USCOREAccessType;
                                fileType->File_FileProfile = answer.File_USCOREFileProfile;
                                fileType->File_VideoFormat = answer.File_USCOREVideoFormat;
                                fileType->File_FileExtension = answer.File_USCOREFileExtension;
                                // Read by the operations that choose their service themselves;
                                // the dispatcher keeps the type it was made with.
                                client->m_Params.AccessType = static_cast<VL_WS_AccessType>(answer.File_USCOREAccessType);
                              });
  VLLogOutputwithConfig({s_Log.Id(), 4}, "%s, ret:%d\n", "VL_WS_getFileType", soapError);
  return VLUtilities::To_VL_WS_Status(soapError);
}

extern "C" VL_WS_Status VL_WS_authorizeDevice(VL_WS_Handle* handle, int pin, VL_WS_AuthorizeDeviceResponse* answer) {
  VL_WS_Client* client = VLBeginCall(handle, answer);
  if (client == 0) return VL_WS_E_INVALID_ARGUMENT;
  bool answered = false;
  int error = VLCallInto(client->m_StreamDownloadAPI, "authorizeDevice", &StreamDownloadAPI::authorizeDevice,
                         [pin](_VL1__authorizeDevice& request) { request.Pin = pin; },
                         &_VL1__authorizeDeviceResponse::authorizeDeviceResult,
                         VLUtilities::VL1__AuthorizeDeviceResponse2VL_WS_AuthorizeDeviceResponse, *answer, &answered);
  if (VLSucceeded(error, answered, answer->ResponseCode)) {
    // The next request speaks for the new account; nothing of the previous user's data may stay.
    client->m_Params.AuthToken = answer->AuthToken;
    if (CacheInterface* cache = VLUserData(client)) cache->PurgeUserData(VLString());
  }
  return VLFoldedStatus("VL_WS_authorizeDevice", error, *answer, "VL_WS_authorizeDevice");
}

extern "C" VL_WS_Status VL_WS_deactivateDevice(VL_WS_Handle* handle, VL_WS_StandardResponse* answer) {
  VL_WS_Client* client = VLBeginCall(handle, answer);
  if (client == 0) return VL_WS_E_INVALID_ARGUMENT;
  bool answered = false;
  int error = VLCallInto(client->m_StreamDownloadAPI, "deactivateDevice", &StreamDownloadAPI::deactivateDevice,
                         VLNoFields(), &_VL1__deactivateDeviceResponse::deactivateDeviceResult,
                         VLUtilities::VL1__StandardResponse2VL_WS_StandardResponse, *answer, &answered);
  if (VLSucceeded(error, answered, answer->ResponseCode)) {
    client->m_Params.AuthToken = VLString();
    if (CacheInterface* cache = VLUserData(client)) cache->PurgeUserData(VLString());
  }
  return VLFoldedStatus("VL_WS_deactivateDevice", error, *answer);
}

extern "C" VL_WS_Status VL_WS_checkAuthToken(VL_WS_Handle* handle, bool* valid) {
  VL_WS_Client* client = VLBeginCall(handle, valid);
  if (client == 0) return VL_WS_E_INVALID_ARGUMENT;
  int error = VLCall(client->m_StreamDownloadAPI, "checkAuthToken", &StreamDownloadAPI::checkAuthToken, VLNoFields(),
                     [valid](const _VL1__checkAuthTokenResponse& response) {
                       *valid = response.checkAuthTokenResult == true_;
                     });
  // The user data belong to the token's account: they go when the token turns valid or invalid.
  CacheInterface* cache = VLUserData(client);
  if (error == SOAP_OK && cache != 0 && *valid != client->m_Params.AuthTokenValid) {
    client->m_Params.AuthTokenValid = *valid;
    cache->PurgeUserData(VLString());
  }
  return VLBoolStatus("VL_WS_checkAuthToken", error, *valid);
}

extern "C" VL_WS_Status VL_WS_getConfig(VL_WS_Handle* handle, VL_WS_ConfigResponse* config) {
  VL_WS_Client* client = VLBeginCall(handle, config);
  if (client == 0) return VL_WS_E_INVALID_ARGUMENT;
  int error = VLCallInto(client->m_StreamDownloadAPI, "getConfig", &StreamDownloadAPI::getConfig, VLNoFields(),
                         &_VL1__getConfigResponse::getConfigResult,
                         VLUtilities::VL1__GetConfigResponse2VL_WS_ConfigResponse, *config);
  return VLFoldedStatus("VL_WS_getConfig", error, *config);
}

extern "C" VL_WS_Status VL_WS_getCountryID(VL_WS_Handle* handle, int* countryID) {
  VL_WS_Client* client = VLBeginCall(handle, countryID);
  if (client == 0) return VL_WS_E_INVALID_ARGUMENT;
  int error = VLCall(client->m_StreamDownloadAPI, "GetCountryID", &StreamDownloadAPI::GetCountryID, VLNoFields(),
                     [countryID](const _VL1__GetCountryIDResponse& response) {
                       *countryID = response.GetCountryIDResult;
                     });
  VLLogOutputwithConfig({s_Log.Id(), 4}, "%s, ret:%d,countryid:%d\n", "VL_WS_getCountryID", error, *countryID);
  return VLUtilities::To_VL_WS_Status(error);
}

extern "C" VL_WS_Status VL_WS_checkAdultVerificationEnabled(VL_WS_Handle* handle,
                                                            VL_WS_AdultVerificationEnabledResponse* answer) {
  VL_WS_Client* client = VLBeginCall(handle, answer);
  if (client == 0) return VL_WS_E_INVALID_ARGUMENT;
  int error = VLCallInto(
      client->m_StreamDownloadAPI, "checkAdultVerificationEnabled", &StreamDownloadAPI::checkAdultVerificationEnabled,
      VLNoFields(), &_VL1__checkAdultVerificationEnabledResponse::checkAdultVerificationEnabledResult,
      VLUtilities::VL1__CheckAdultVerificationEnabledResponse2VL_WS_AdultVerificationEnabledResponse, *answer);
  return VLFoldedStatus("VL_WS_checkAdultVerificationEnabled", error, *answer);
}

extern "C" VL_WS_Status VL_WS_checkAdultVerificationPin(VL_WS_Handle* handle, int pin,
                                                        VL_WS_AdultVerificationPinResponse* answer) {
  VL_WS_Client* client = VLBeginCall(handle, answer);
  if (client == 0) return VL_WS_E_INVALID_ARGUMENT;
  // The store compares texts: PIN 7 is "0007".
  char text[16];
  VLUtilities::safe_snprintf(text, sizeof(text), "%04d", pin);
  int error = VLCallInto(client->m_StreamDownloadAPI, "checkAdultVerificationPin",
                         &StreamDownloadAPI::checkAdultVerificationPin,
                         [&text](_VL1__checkAdultVerificationPin& request) { request.Pin = text; },
                         &_VL1__checkAdultVerificationPinResponse::checkAdultVerificationPinResult,
                         VLUtilities::VL1__CheckAdultVerificationPinResponse2VL_WS_AdultVerificationPinResponse,
                         *answer);
  return VLFoldedStatus("VL_WS_checkAdultVerificationPin", error, *answer);
}

extern "C" VL_WS_Status VL_WS_returnError(VL_WS_Handle* handle, VL_WS_StandardResponse* answer) {
  VL_WS_Client* client = VLBeginCall(handle, answer);
  if (client == 0) return VL_WS_E_INVALID_ARGUMENT;
  int error = VLCallInto(client->m_StreamAPI, "ReturnError", &StreamAPI::ReturnError, VLNoFields(),
                         &_VL1__ReturnErrorResponse::ReturnErrorResult,
                         VLUtilities::VL1__StandardResponse2VL_WS_StandardResponse, *answer);
  return VLUtilities::To_VL_WS_Status(error, answer->ResponseCode, "");
}

extern "C" VL_WS_Status VL_WS_returnTimeout(VL_WS_Handle* handle, VL_WS_StandardResponse* answer) {
  VL_WS_Client* client = VLBeginCall(handle, answer);
  if (client == 0) return VL_WS_E_INVALID_ARGUMENT;
  int error = VLCallInto(client->m_StreamAPI, "ReturnTimeout", &StreamAPI::ReturnTimeout, VLNoFields(),
                         &_VL1__ReturnTimeoutResponse::ReturnTimeoutResult,
                         VLUtilities::VL1__StandardResponse2VL_WS_StandardResponse, *answer);
  return VLUtilities::To_VL_WS_Status(error, answer->ResponseCode, "");
}
