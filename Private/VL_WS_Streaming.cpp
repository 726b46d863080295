// Streaming operations of the client: where a purchased title or a bonus asset streams from, the
// state reports of a stream instance, THX media director settings and the account's default
// audio profile. They always go to the streaming service, whatever the handle's access type.
#include "VLRecord.h"
#include "VLUtilities.h"
#include "VLWSAELog.h"
#include "VL_WS.h"
#include "VL_WS_Call.h"
#include "VL_WS_Client.h"

namespace {

VLLogArea s_Log(VLWSAELOG_AREA_NAME);

}  // namespace

extern "C" VL_WS_Status VL_WS_getStreamingAssetLocation(VL_WS_Handle* handle, int passID, int fileProfile,
                                                        VL_WS_StreamingAssetLocationResponse* location) {
  VL_WS_Client* client = VLBeginCall(handle, location);
  if (client == 0) return VL_WS_E_INVALID_ARGUMENT;
  int error = VLCallInto(client->m_StreamAPI, "getStreamingAssetLocation", &StreamAPI::getStreamingAssetLocation,
                         [=](_VL1__getStreamingAssetLocation& request) {
                           request.PassID = passID;
                           request.FileProfile = static_cast<VL1__FileProfile>(fileProfile);
                         },
                         &_VL1__getStreamingAssetLocationResponse::getStreamingAssetLocationResult,
                         VLUtilities::VL1__GetStreamingAssetLocationResponse2VL_WS_StreamingAssetLocationResponse,
                         *location);
  return VLUtilities::To_VL_WS_Status(error, location->ResponseCode, "");
}

extern "C" VL_WS_Status VL_WS_getStreamingBonusAssetLocation(VL_WS_Handle* handle, int bonusAssetID,
                                                             VL_WS_StreamingAssetLocationResponse* location) {
  VL_WS_Client* client = VLBeginCall(handle, location);
  if (client == 0) return VL_WS_E_INVALID_ARGUMENT;
  int error = VLCallInto(client->m_StreamAPI, "getBonusAssetLocation", &StreamAPI::getBonusAssetLocation,
                         [=](_VL1__getBonusAssetLocation& request) { request.BonusAssetID = bonusAssetID; },
                         &_VL1__getBonusAssetLocationResponse::getBonusAssetLocationResult,
                         VLUtilities::VL1__GetStreamingAssetLocationResponse2VL_WS_StreamingAssetLocationResponse,
                         *location);
  return VLUtilities::To_VL_WS_Status(error, location->ResponseCode, "");
}

extern "C" VL_WS_Status VL_WS_loadLastStreamingAssetLocation(VL_WS_Handle* handle, int passID, int fileProfile,
                                                             VL_WS_StreamingAssetLocationResponse* location) {
  VL_WS_Client* client = VLBeginCall(handle, location);
  if (client == 0) return VL_WS_E_INVALID_ARGUMENT;
  int error = VLCallInto(client->m_StreamAPI, "loadLastStreamingAssetLocationForPass",
                         &StreamAPI::loadLastStreamingAssetLocationForPass,
                         [=](_VL1__loadLastStreamingAssetLocationForPass& request) {
                           request.PassID = passID;
                           request.FileProfile = static_cast<VL1__FileProfile>(fileProfile);
                         },
                         &_VL1__loadLastStreamingAssetLocationForPassResponse::loadLastStreamingAssetLocationForPassResult,
                         VLUtilities::VL1__GetStreamingAssetLocationResponse2VL_WS_StreamingAssetLocationResponse,
                         *location);
  return VLUtilities::To_VL_WS_Status(error, location->ResponseCode, "");
}

extern "C" VL_WS_Status VL_WS_manageStreamingInstanceStatus(VL_WS_Handle* handle, const char* streamID, int status,
                                                            int stopTimeSeconds, VL_WS_StandardResponse* answer) {
  VL_WS_Client* client = VLBeginCall(handle, answer);
  if (client == 0 || streamID == 0 || *streamID == 0) return VL_WS_E_INVALID_ARGUMENT;
  int error = VLCallInto(client->m_StreamAPI, "manageStreamInstanceStatus", &StreamAPI::manageStreamInstanceStatus,
                         [=](_VL1__manageStreamInstanceStatus& request) {
                           request.StreamID = const_cast<char*>(streamID);
                           request.Status = static_cast<VL1__StreamStatus>(status);
                           request.StopTimeSeconds = stopTimeSeconds;
                         },
                         &_VL1__manageStreamInstanceStatusResponse::manageStreamInstanceStatusResult,
                         VLUtilities::VL1__StandardResponse2VL_WS_StandardResponse, *answer);
  return VLUtilities::To_VL_WS_Status(error, answer->ResponseCode, "");
}

extern "C" VL_WS_Status VL_WS_getTHXMediaDirector(VL_WS_Handle* handle, int passID, int fileProfile, int audioProfile,
                                                  VL_WS_THXMediaDirectorResponse* settings) {
  VL_WS_Client* client = VLBeginCall(handle, settings);
  if (client == 0) return VL_WS_E_INVALID_ARGUMENT;
  int error = VLCallInto(client->m_StreamAPI, "getTHXMediaDirector", &StreamAPI::getTHXMediaDirector,
                         [=](_VL1__getTHXMediaDirector& request) {
                           request.PassID = passID;
                           request.FileProfile = static_cast<VL1__FileProfile>(fileProfile);
                           request.AudioSetting = static_cast<VL1__AudioProfile>(audioProfile);
                         },
                         &_VL1__getTHXMediaDirectorResponse::getTHXMediaDirectorResult,
                         VLUtilities::VL1__THXMediaDirectorResponse2VL_WS_THXMediaDirectorResponse, *settings);
  return VLUtilities::To_VL_WS_Status(error);
}

extern "C" VL_WS_Status VL_WS_getTHXMediaDirectorBonusAsset(VL_WS_Handle* handle, int bonusAssetID, int fileProfile,
                                                            int bonusAssetType,
                                                            VL_WS_THXMediaDirectorResponse* settings) {
  VL_WS_Client* client = VLBeginCall(handle, settings);
  if (client == 0) return VL_WS_E_INVALID_ARGUMENT;
  int error = VLCallInto(client->m_StreamAPI, "getTHXMediaDirectorBonusAsset",
                         &StreamAPI::getTHXMediaDirectorBonusAsset,
                         [=](_VL1__getTHXMediaDirectorBonusAsset& request) {
                           request.BonusAssetID = bonusAssetID;
                           request.FileProfile = static_cast<VL1__FileProfile>(fileProfile);
                           request.BonusAssetType = static_cast<VL1__BonusAssetType>(bonusAssetType);
                         },
                         &_VL1__getTHXMediaDirectorBonusAssetResponse::getTHXMediaDirectorBonusAssetResult,
                         VLUtilities::VL1__THXMediaDirectorResponse2VL_WS_THXMediaDirectorResponse, *settings);
  return VLUtilities::To_VL_WS_Status(error);
}

extern "C" VL_WS_Status VL_WS_setAudioDefaultProperty(VL_WS_Handle* handle, int audioProfile,
                                                      VL_WS_StandardResponse* answer) {
  VL_WS_Client* client = VLBeginCall(handle, answer);
  if (client == 0) return VL_WS_E_INVALID_ARGUMENT;
  int error = VLCallInto(client->m_StreamAPI, "setAudioDefaultProperty", &StreamAPI::setAudioDefaultProperty,
                         [=](_VL1__setAudioDefaultProperty& request) {
                           request.AudioSetting = static_cast<VL1__AudioProfile>(audioProfile);
                         },
                         &_VL1__setAudioDefaultPropertyResponse::setAudioDefaultPropertyResult,
                         VLUtilities::VL1__StandardResponse2VL_WS_StandardResponse, *answer);
  return VLSoapStatus("VL_WS_setAudioDefaultProperty", error, *answer);
}

extern "C" VL_WS_Status VL_WS_getAudioDefaultProperty(VL_WS_Handle* handle, int* audioProfile) {
  VL_WS_Client* client = VLBeginCall(handle, audioProfile);
  if (client == 0) return VL_WS_E_INVALID_ARGUMENT;
  int error = VLCall(client->m_StreamAPI, "getAudioDefaultProperty", &StreamAPI::getAudioDefaultProperty, VLNoFields(),
                     [audioProfile](const _VL1__getAudioDefaultPropertyResponse& response) {
                       *audioProfile = response.getAudioDefaultPropertyResult;
                     });
  VLLogOutputwithConfig({s_Log.Id(), 4}, "%s, ret:%d,audioprofile:%d\n", "VL_WS_getAudioDefaultProperty", error,
                        *audioProfile);
  return VLUtilities::To_VL_WS_Status(error);
}
