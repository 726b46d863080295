// Account operations of the client: the store's file type of the device, which also decides the
// access type of the handle; linking the device to an account and its token; the account's
// settings and the store's configuration for the device.
#include "VLUtilities.h"
#include "VLWSAELog.h"
#include "VL_WS.h"
#include "VL_WS_Call.h"

static VLLogArea s_Log(VLWSAELOG_AREA_NAME);

extern "C" VL_WS_Status VL_WS_getFileType(VL_WS_Handle* handle, VL_WS_FileType* fileType) {
  VL_WS_Client* client = VLClientFor(handle, fileType);
  if (client == 0) return VL_WS_E_INVALID_ARGUMENT;

  int soapError = VLServiceCall(
      *client, client->m_RealTimeBrowse, VL_SERVICE_OPERATION(RealTimeBrowse, getFileType), VLNoFields(),
      [&](const VL1__FileType& answer) {
        fileType->File_DRMProvider = answer.File_USCOREDRMProvider;
        fileType->File_AccessType = answer.File_USCOREAccessType;
        fileType->File_FileProfile = answer.File_USCOREFileProfile;
        fileType->File_VideoFormat = answer.File_USCOREVideoFormat;
        fileType->File_FileExtension = answer.File_USCOREFileExtension;
        // Read by the operations that choose their service themselves; the dispatcher keeps the
        // type it was made with.
        client->m_Params.AccessType = static_cast<VL_WS_AccessType>(answer.File_USCOREAccessType);
      });
  VLLogOutputwithConfig({s_Log.Id(), 4}, "%s, ret:%d\n", "VL_WS_getFileType", soapError);
  return VLUtilities::To_VL_WS_Status(soapError);
}

extern "C" VL_WS_Status VL_WS_authorizeDevice(VL_WS_Handle* handle, int pin, VL_WS_AuthorizeDeviceResponse* answer) {
  VL_WS_Client* client = VLClientFor(handle, answer);
  if (client == 0) return VL_WS_E_INVALID_ARGUMENT;
  bool answered = false;
  int soapError = VLServiceCall(
      *client, client->m_StreamDownloadAPI, VL_SERVICE_OPERATION(StreamDownloadAPI, authorizeDevice),
      [pin](_VL1__authorizeDevice& request) { request.Pin = pin; },
      VLInto(VLUtilities::VL1__AuthorizeDeviceResponse2VL_WS_AuthorizeDeviceResponse, *answer, &answered));
  if (VLSucceeded(soapError, answered, answer->ResponseCode)) {
    // The next request speaks for the new account; nothing of the previous user's data may stay.
    client->m_Params.AuthToken = answer->AuthToken;
    if (CacheInterface* cache = VLUserData(client)) cache->PurgeUserData(VLString());
  }
  return VLFoldedStatus("VL_WS_authorizeDevice", soapError, answer->ResponseCode);
}

extern "C" VL_WS_Status VL_WS_deactivateDevice(VL_WS_Handle* handle, VL_WS_StandardResponse* answer) {
  VL_WS_Client* client = VLClientFor(handle, answer);
  if (client == 0) return VL_WS_E_INVALID_ARGUMENT;
  bool answered = false;
  int soapError = VLServiceCall(*client, client->m_StreamDownloadAPI,
                                VL_SERVICE_OPERATION(StreamDownloadAPI, deactivateDevice), VLNoFields(),
                                VLInto(VLUtilities::VL1__StandardResponse2VL_WS_StandardResponse, *answer, &answered));
  if (VLSucceeded(soapError, answered, answer->ResponseCode)) {
    client->m_Params.AuthToken = VLString();
    if (CacheInterface* cache = VLUserData(client)) cache->PurgeUserData(VLString());
  }
  return VLFoldedStatus("VL_WS_deactivateDevice", soapError, answer->ResponseCode);
}

extern "C" VL_WS_Status VL_WS_checkAuthToken(VL_WS_Handle* handle, bool* valid) {
  VL_WS_Client* client = VLClientFor(handle, valid);
  if (client == 0) return VL_WS_E_INVALID_ARGUMENT;
  int soapError =
      VLServiceCall(*client, client->m_StreamDownloadAPI, VL_SERVICE_OPERATION(StreamDownloadAPI, checkAuthToken),
                    VLNoFields(), [valid](const xsd__boolean& result) { *valid = result == true_; });
  // The user data belong to the token's account: they go when the token turns valid or invalid.
  CacheInterface* cache = VLUserData(client);
  if (soapError == SOAP_OK && cache != 0 && *valid != client->m_Params.AuthTokenValid) {
    client->m_Params.AuthTokenValid = *valid;
    cache->PurgeUserData(VLString());
  }
  return VLBoolStatus("VL_WS_checkAuthToken", soapError, *valid);
}

// The account's e-mail address and settings page are kept as user data, one answer per cache:
// the Key is empty.
extern "C" VL_WS_Status VL_WS_getEmailAddress(VL_WS_Handle* handle, VL_WS_EmailAddressResponse* answer) {
  VL_WS_Client* client = VLClientFor(handle, answer);
  if (client == 0) return VL_WS_E_INVALID_ARGUMENT;
  return VLKeptRecord(*client, client->m_StreamDownloadAPI, VL_SERVICE_OPERATION(StreamDownloadAPI, getEmailAddress),
                      {VLCacheKind::kUserData, "getEmailAddress", VLString()}, VLNoFields(),
                      VLUtilities::VL1__GetEmailAddressResponse2VL_WS_EmailAddressResponse, *answer,
                      "VL_WS_getEmailAddress", VLFoldedStatus);
}

extern "C" VL_WS_Status VL_WS_getSettingsPageInfo(VL_WS_Handle* handle, VL_WS_SettingsPageResponse* answer) {
  VL_WS_Client* client = VLClientFor(handle, answer);
  if (client == 0) return VL_WS_E_INVALID_ARGUMENT;
  return VLKeptRecord(*client, client->m_StreamDownloadAPI,
                      VL_SERVICE_OPERATION(StreamDownloadAPI, getSettingsPageInfo),
                      {VLCacheKind::kUserData, "getSettingsPageInfo", VLString()}, VLNoFields(),
                      VLUtilities::VL1__SettingsPageInfo2VL_WS_SettingsPageResponse, *answer,
                      "VL_WS_getSettingsPageInfo", VLFoldedStatus);
}

extern "C" VL_WS_Status VL_WS_getConfig(VL_WS_Handle* handle, VL_WS_ConfigResponse* config) {
  VL_WS_Client* client = VLClientFor(handle, config);
  if (client == 0) return VL_WS_E_INVALID_ARGUMENT;
  int soapError =
      VLServiceCall(*client, client->m_StreamDownloadAPI, VL_SERVICE_OPERATION(StreamDownloadAPI, getConfig),
                    VLNoFields(), VLInto(VLUtilities::VL1__GetConfigResponse2VL_WS_ConfigResponse, *config));
  return VLFoldedStatus("VL_WS_getConfig", soapError, config->ResponseCode);
}

extern "C" VL_WS_Status VL_WS_getCountryID(VL_WS_Handle* handle, int* countryID) {
  VL_WS_Client* client = VLClientFor(handle, countryID);
  if (client == 0) return VL_WS_E_INVALID_ARGUMENT;
  int soapError =
      VLServiceCall(*client, client->m_StreamDownloadAPI, VL_SERVICE_OPERATION(StreamDownloadAPI, GetCountryID),
                    VLNoFields(), [countryID](const int& result) { *countryID = result; });
  VLLogOutputwithConfig({s_Log.Id(), 4}, "%s, ret:%d,countryid:%d\n", "VL_WS_getCountryID", soapError, *countryID);
  return VLUtilities::To_VL_WS_Status(soapError);
}

extern "C" VL_WS_Status VL_WS_checkAdultVerificationEnabled(VL_WS_Handle* handle,
                                                            VL_WS_AdultVerificationEnabledResponse* answer) {
  VL_WS_Client* client = VLClientFor(handle, answer);
  if (client == 0) return VL_WS_E_INVALID_ARGUMENT;
  int soapError = VLServiceCall(
      *client, client->m_StreamDownloadAPI, VL_SERVICE_OPERATION(StreamDownloadAPI, checkAdultVerificationEnabled),
      VLNoFields(),
      VLInto(VLUtilities::VL1__CheckAdultVerificationEnabledResponse2VL_WS_AdultVerificationEnabledResponse, *answer));
  return VLFoldedStatus("VL_WS_checkAdultVerificationEnabled", soapError, answer->ResponseCode);
}

extern "C" VL_WS_Status VL_WS_checkAdultVerificationPin(VL_WS_Handle* handle, int pin,
                                                        VL_WS_AdultVerificationPinResponse* answer) {
  VL_WS_Client* client = VLClientFor(handle, answer);
  if (client == 0) return VL_WS_E_INVALID_ARGUMENT;
  // The store compares texts: PIN 7 is "0007".
  char text[16];
  VLUtilities::safe_snprintf(text, sizeof(text), "%04d", pin);
  int soapError = VLServiceCall(
      *client, client->m_StreamDownloadAPI, VL_SERVICE_OPERATION(StreamDownloadAPI, checkAdultVerificationPin),
      [&text](_VL1__checkAdultVerificationPin& request) { request.Pin = text; },
      VLInto(VLUtilities::VL1__CheckAdultVerificationPinResponse2VL_WS_AdultVerificationPinResponse, *answer));
  return VLFoldedStatus("VL_WS_checkAdultVerificationPin", soapError, answer->ResponseCode);
}

extern "C" VL_WS_Status VL_WS_returnError(VL_WS_Handle* handle, VL_WS_StandardResponse* answer) {
  VL_WS_Client* client = VLClientFor(handle, answer);
  if (client == 0) return VL_WS_E_INVALID_ARGUMENT;
  int soapError =
      VLServiceCall(*client, client->m_StreamAPI, VL_SERVICE_OPERATION(StreamAPI, ReturnError), VLNoFields(),
                    VLInto(VLUtilities::VL1__StandardResponse2VL_WS_StandardResponse, *answer));
  return VLUtilities::To_VL_WS_Status(soapError, answer->ResponseCode, "");
}

extern "C" VL_WS_Status VL_WS_returnTimeout(VL_WS_Handle* handle, VL_WS_StandardResponse* answer) {
  VL_WS_Client* client = VLClientFor(handle, answer);
  if (client == 0) return VL_WS_E_INVALID_ARGUMENT;
  int soapError =
      VLServiceCall(*client, client->m_StreamAPI, VL_SERVICE_OPERATION(StreamAPI, ReturnTimeout), VLNoFields(),
                    VLInto(VLUtilities::VL1__StandardResponse2VL_WS_StandardResponse, *answer));
  return VLUtilities::To_VL_WS_Status(soapError, answer->ResponseCode, "");
}
