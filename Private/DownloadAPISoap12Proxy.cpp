#include "DownloadAPISoap12Proxy.h"

#include "VLStoreHosts.h"

// Used only while no endpoint is set, which does not happen once the service object is bound.
#define VL_FALLBACK_ENDPOINT "http://" VL_STORE_STAGING_API_HOST "/api/DownloadAPI.asmx"

DownloadAPISoap12Proxy::DownloadAPISoap12Proxy() : VLSoapProxy("DownloadAPISoap12Proxy", VL_FALLBACK_ENDPOINT) {
  DownloadAPISoap12Proxy_init(SOAP_C_UTFSTRING, SOAP_C_UTFSTRING);
}

DownloadAPISoap12Proxy::~DownloadAPISoap12Proxy() {}

void DownloadAPISoap12Proxy::DownloadAPISoap12Proxy_init(int imode, int omode) { Init(imode, omode); }

#define VL_DEFINE(name, Type) VL_SOAP_OPERATION(DownloadAPISoap12Proxy, name, Type)
VL_DOWNLOADAPI_OPERATIONS(VL_DEFINE, VL_DEFINE)
