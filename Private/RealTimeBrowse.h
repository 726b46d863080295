// RealTimeBrowse: the store's catalogue service object: RealTimeBrowseSoap12Proxy bound to the client handle's settings,
// sending to ServiceBaseURL + "RealTimeBrowse.asmx" with the device-settings header block
// "VL1:DeviceSettings". SetParams and Setup are VLServiceObject's.
#ifndef REALTIMEBROWSE_H
#define REALTIMEBROWSE_H

#include "RealTimeBrowseSoap12Proxy.h"
#include "VLServiceObject.h"

class RealTimeBrowse : public VLServiceObject<RealTimeBrowseSoap12Proxy, VL1__DeviceSettings, soap_new_set_VL1__DeviceSettings,
                                  &SOAP_ENV__Header::VL1__DeviceSettings_> {
 public:
  RealTimeBrowse();
  virtual ~RealTimeBrowse();
};

#endif  // REALTIMEBROWSE_H
