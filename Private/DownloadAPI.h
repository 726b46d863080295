// DownloadAPI: the store's download service object: DownloadAPISoap12Proxy bound to the client handle's settings,
// sending to ServiceBaseURL + "DownloadAPI.asmx" with the device-settings header block
// "VL1:DownloadDeviceRequestSettings". SetParams and Setup are VLServiceObject's.
#ifndef DOWNLOADAPI_H
#define DOWNLOADAPI_H

#include "DownloadAPISoap12Proxy.h"
#include "VLServiceObject.h"

class DownloadAPI : public VLServiceObject<DownloadAPISoap12Proxy, VL1__DownloadDeviceRequestSettings, soap_new_set_VL1__DownloadDeviceRequestSettings,
                                  &SOAP_ENV__Header::VL1__DownloadDeviceRequestSettings_> {
 public:
  DownloadAPI();
  virtual ~DownloadAPI();
};

#endif  // DOWNLOADAPI_H
