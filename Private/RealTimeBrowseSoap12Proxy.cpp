#include "RealTimeBrowseSoap12Proxy.h"

#include "VLStoreHosts.h"

// Used only while no endpoint is set, which does not happen once the service object is bound.
#define VL_FALLBACK_ENDPOINT "http://" VL_STORE_STAGING_API_HOST "/api/RealTimeBrowse.asmx"

RealTimeBrowseSoap12Proxy::RealTimeBrowseSoap12Proxy() : VLSoapProxy("RealTimeBrowseSoap12Proxy", VL_FALLBACK_ENDPOINT) {
  RealTimeBrowseSoap12Proxy_init(SOAP_C_UTFSTRING, SOAP_C_UTFSTRING);
}

RealTimeBrowseSoap12Proxy::~RealTimeBrowseSoap12Proxy() {}

void RealTimeBrowseSoap12Proxy::RealTimeBrowseSoap12Proxy_init(int imode, int omode) { Init(imode, omode); }

#define VL_DEFINE(name, Type) VL_SOAP_OPERATION(RealTimeBrowseSoap12Proxy, name, Type)
VL_REALTIMEBROWSE_OPERATIONS(VL_DEFINE)
