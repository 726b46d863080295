// Streaming operations of the client: where a purchased title or a bonus asset streams from, the
// state reports of a stream instance, THX media director settings and the account's default
// audio profile. They always go to the streaming service, whatever the handle's access type.
#include "VLUtilities.h"
#include "VLWSAELog.h"
#include "VL_WS.h"
#include "VL_WS_Call.h"

namespace {

VLLogArea s_Log(VLWSAELOG_AREA_NAME);

}  // namespace

extern "C" VL_WS_Status VL_WS_getStreamingAssetLocation(VL_WS_Handle* handle, int passID, int fileProfile,
                                                        VL_WS_StreamingAssetLocationResponse* location) {
  VL_WS_Client* client = VLClientFor(handle, location);
  if (client == 0) return VL_WS_E_INVALID_ARGUMENT;
  int soapError = VLServiceCall(
      *client, client->m_StreamAPI, VL_SERVICE_OPERATION(StreamAPI, getStreamingAssetLocation),
      [=](_VL1__getStreamingAssetLocation& request) {
        request.PassID = passID;
        request.FileProfile = static_cast<VL1__FileProfile>(fileProfile);
      },
      VLInto(VLUtilities::VL1__GetStreamingAssetLocationResponse2VL_WS_StreamingAssetLocationResponse, *location));
  return VLUtilities::To_VL_WS_Status(soapError, location->ResponseCode, "");
}

extern "C" VL_WS_Status VL_WS_getStreamingBonusAssetLocation(VL_WS_Handle* handle, int bonusAssetID,
                                                             VL_WS_StreamingAssetLocationResponse* location) {
  VL_WS_Client* client = VLClientFor(handle, location);
  if (client == 0) return VL_WS_E_INVALID_ARGUMENT;
  int soapError = VLServiceCall(
      *client, client->m_StreamAPI, VL_SERVICE_OPERATION(StreamAPI, getBonusAssetLocation),
      [=](_VL1__getBonusAssetLocation& request) { request.BonusAssetID = bonusAssetID; },
      VLInto(VLUtilities::VL1__GetStreamingAssetLocationResponse2VL_WS_StreamingAssetLocationResponse, *location));
  return VLUtilities::To_VL_WS_Status(soapError, location->ResponseCode, "");
}

extern "C" VL_WS_Status VL_WS_loadLastStreamingAssetLocation(VL_WS_Handle* handle, int passID, int fileProfile,
                                                             VL_WS_StreamingAssetLocationResponse* location) {
  VL_WS_Client* client = VLClientFor(handle, location);
  if (client == 0) return VL_WS_E_INVALID_ARGUMENT;
  int soapError = VLServiceCall(
      *client, client->m_StreamAPI, VL_SERVICE_OPERATION(StreamAPI, loadLastStreamingAssetLocationForPass),
      [=](_VL1__loadLastStreamingAssetLocationForPass& request) {
        request.PassID = passID;
        request.FileProfile = static_cast<VL1__FileProfile>(fileProfile);
      },
      VLInto(VLUtilities::VL1__GetStreamingAssetLocationResponse2VL_WS_StreamingAssetLocationResponse, *location));
  return VLUtilities::To_VL_WS_Status(soapError, location->ResponseCode, "");
}

extern "C" VL_WS_Status VL_WS_manageStreamingInstanceStatus(VL_WS_Handle* handle, const char* streamID, int status,
                                                            int stopTimeSeconds, VL_WS_StandardResponse* answer) {
  VL_WS_Client* client = VLClientFor(handle, answer);
  if (client == 0 || streamID == 0 || *streamID == 0) return VL_WS_E_INVALID_ARGUMENT;
  int soapError = VLServiceCall(
      *client, client->m_StreamAPI, VL_SERVICE_OPERATION(StreamAPI, manageStreamInstanceStatus),
      [=](_VL1__manageStreamInstanceStatus& request) {
        request.StreamID = const_cast<char*>(streamID);
        request.Status = static_cast<VL1__StreamStatus>(status);
        request.StopTimeSeconds = stopTimeSeconds;
      },
      VLInto(VLUtilities::VL1__StandardResponse2VL_WS_StandardResponse, *answer));
  return VLUtilities::To_VL_WS_Status(soapError, answer->ResponseCode, "");
}

extern "C" VL_WS_Status VL_WS_getTHXMediaDirector(VL_WS_Handle* handle, int passID, int fileProfile, int audioProfile,
                                                  VL_WS_THXMediaDirectorResponse* settings) {
  VL_WS_Client* client = VLClientFor(handle, settings);
  if (client == 0) return VL_WS_E_INVALID_ARGUMENT;
  int soapError = VLServiceCall(
      *client, client->m_StreamAPI, VL_SERVICE_OPERATION(StreamAPI, getTHXMediaDirector),
      [=](_VL1__getTHXMediaDirector& request) {
        request.PassID = passID;
        request.FileProfile = static_cast<VL1__FileProfile>(fileProfile);
        request.AudioSetting = static_cast<VL1__AudioProfile>(audioProfile);
      },
      VLInto(VLUtilities::VL1__THXMediaDirectorResponse2VL_WS_THXMediaDirectorResponse, *settings));
  return VLUtilities::To_VL_WS_Status(soapError);
}

extern "C" VL_WS_Status VL_WS_getTHXMediaDirectorBonusAsset(VL_WS_Handle* handle, int bonusAssetID, int fileProfile,
                                                            int bonusAssetType,
                                                            VL_WS_THXMediaDirectorResponse* settings) {
  VL_WS_Client* client = VLClientFor(handle, settings);
  if (client == 0) return VL_WS_E_INVALID_ARGUMENT;
  int soapError = VLServiceCall(
      *client, client->m_StreamAPI, VL_SERVICE_OPERATION(StreamAPI, getTHXMediaDirectorBonusAsset),
      [=](_VL1__getTHXMediaDirectorBonusAsset& request) {
        request.BonusAssetID = bonusAssetID;
        request.FileProfile = static_cast<VL1__FileProfile>(fileProfile);
        request.BonusAssetType = static_cast<VL1__BonusAssetType>(bonusAssetType);
      },
      VLInto(VLUtilities::VL1__THXMediaDirectorResponse2VL_WS_THXMediaDirectorResponse, *settings));
  return VLUtilities::To_VL_WS_Status(soapError);
}

extern "C" VL_WS_Status VL_WS_setAudioDefaultProperty(VL_WS_Handle* handle, int audioProfile,
                                                      VL_WS_StandardResponse* answer) {
  VL_WS_Client* client = VLClientFor(handle, answer);
  if (client == 0) return VL_WS_E_INVALID_ARGUMENT;
  int soapError = VLServiceCall(
      *client, client->m_StreamAPI, VL_SERVICE_OPERATION(StreamAPI, setAudioDefaultProperty),
      [=](_VL1__setAudioDefaultProperty& request) {
        request.AudioSetting = static_cast<VL1__AudioProfile>(audioProfile);
      },
      VLInto(VLUtilities::VL1__StandardResponse2VL_WS_StandardResponse, *answer));
  return VLSoapStatus("VL_WS_setAudioDefaultProperty", soapError, answer->ResponseCode);
}

extern "C" VL_WS_Status VL_WS_getAudioDefaultProperty(VL_WS_Handle* handle, int* audioProfile) {
  VL_WS_Client* client = VLClientFor(handle, audioProfile);
  if (client == 0) return VL_WS_E_INVALID_ARGUMENT;
  int soapError =
      VLServiceCall(*client, client->m_StreamAPI, VL_SERVICE_OPERATION(StreamAPI, getAudioDefaultProperty),
                    VLNoFields(), [audioProfile](const VL1__AudioProfile& result) { *audioProfile = result; });
  VLLogOutputwithConfig({s_Log.Id(), 4}, "%s, ret:%d,audioprofile:%d\n", "VL_WS_getAudioDefaultProperty", soapError,
                        *audioProfile);
  return VLUtilities::To_VL_WS_Status(soapError);
}
