// Account operations of the client: the store's file type of the device, which also decides the
// access type of the handle.
#include "VLRecord.h"
#include "VLUtilities.h"
#include "VLWSAELog.h"
#include "VL_WS.h"
#include "VL_WS_Client.h"

namespace {
VLLogArea s_Log(VLWSAELOG_AREA_NAME);
}  // namespace

extern "C" VL_WS_Status VL_WS_getFileType(VL_WS_Handle* handle, VL_WS_FileType* fileType) {
  if (fileType == 0) return VL_WS_E_INVALID_ARGUMENT;
  VLRecordInit(*fileType);
  VL_WS_Client* client = VLClientOf(handle);
  if (client == 0) return VL_WS_E_INVALID_ARGUMENT;

  RealTimeBrowse& service = client->m_RealTimeBrowse;
  _VL1__getFileType* request = soap_new__VL1__getFileType(&service);
  _VL1__getFileTypeResponse* response = soap_new__VL1__getFileTypeResponse(&service);
  int soapError = request && response ? service.Setup("getFileType") : SOAP_EOM;
  if (soapError == SOAP_OK) soapError = service.getFileType(request, response);
  if (soapError == SOAP_OK && response->getFileTypeResult != 0) {
    const VL1__FileType& answer = *response->getFileTypeResult;
    fileType->File_DRMProvider = answer.File_USCOREDRMProvider;
    fileType->File_AccessType = answer.File_USCOREAccessType;
    fileType->File_FileProfile = answer.File_USCOREFileProfile;
    fileType->File_VideoFormat = answer.File_USCOREVideoFormat;
    fileType->File_FileExtension = answer.File_USCOREFileExtension;
    // Read by the operations that choose their service themselves; the dispatcher keeps the
    // type it was made with.
    client->m_Params.AccessType = static_cast<VL_WS_AccessType>(answer.File_USCOREAccessType);
  }
  VLEndCall(service);
  VLLogOutputwithConfig({s_Log.Id(), 4}, "%s, ret:%d\n", "VL_WS_getFileType", soapError);
  return VLUtilities::To_VL_WS_Status(soapError);
}
