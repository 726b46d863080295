#include "StreamAPISoap12Proxy.h"

#include "VLStoreHosts.h"

// Used only while no endpoint is set, which does not happen once the service object is bound.
#define VL_FALLBACK_ENDPOINT "http://" VL_STORE_STAGING_API_HOST "/api/StreamAPI.asmx"

StreamAPISoap12Proxy::StreamAPISoap12Proxy() : VLSoapProxy("StreamAPISoap12Proxy", VL_FALLBACK_ENDPOINT) {
  StreamAPISoap12Proxy_init(SOAP_C_UTFSTRING, SOAP_C_UTFSTRING);
}

StreamAPISoap12Proxy::~StreamAPISoap12Proxy() {}

void StreamAPISoap12Proxy::StreamAPISoap12Proxy_init(int imode, int omode) { Init(imode, omode); }

#define VL_DEFINE(name, Type) VL_SOAP_OPERATION(StreamAPISoap12Proxy, name, Type)
VL_STREAMAPI_OPERATIONS(VL_DEFINE)
