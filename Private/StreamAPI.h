// StreamAPI: the store's streaming service object: StreamAPISoap12Proxy bound to the client handle's settings,
// sending to ServiceBaseURL + "StreamAPI.asmx" with the device-settings header block
// "VL1:StreamDeviceRequestSettings". SetParams and Setup are VLServiceObject's.
#ifndef STREAMAPI_H
#define STREAMAPI_H

#include "StreamAPISoap12Proxy.h"
#include "VLServiceObject.h"

class StreamAPI : public VLServiceObject<StreamAPISoap12Proxy, VL1__StreamDeviceRequestSettings, soap_new_set_VL1__StreamDeviceRequestSettings,
                                  &SOAP_ENV__Header::VL1__StreamDeviceRequestSettings_> {
 public:
  StreamAPI();
  virtual ~StreamAPI();
};

#endif  // STREAMAPI_H
