#include "RealTimeBrowseSoap12Proxy.h"

#include "VLStoreHosts.h"

// Used only while no endpoint is set, which does not happen once the service object is bound.
#define VL_FALLBACK_ENDPOINT "http://" VL_STORE_STAGING_API_HOST "/api/RealTimeBrowse.asmx"

RealTimeBrowseSoap12Proxy::RealTimeBrowseSoap12Proxy() : VLSoapProxy("RealTimeBrowseSoap12Proxy", VL_FALLBACK_ENDPOINT) {
  RealTimeBrowseSoap12Proxy_init(SOAP_C_UTFSTRING, SOAP_C_UTFSTRING);
}

RealTimeBrowseSoap12Proxy::~RealTimeBrowseSoap12Proxy() {}

void RealTimeBrowseSoap12Proxy::RealTimeBrowseSoap12Proxy_init(int imode, int omode) { Init(imode, omode); }

VL_SOAP_OPERATION(RealTimeBrowseSoap12Proxy, getFileType, getFileType)
VL_SOAP_OPERATION(RealTimeBrowseSoap12Proxy, getNavigation, getNavigation)
VL_SOAP_OPERATION(RealTimeBrowseSoap12Proxy, searchForTitle, searchForTitle)
VL_SOAP_OPERATION(RealTimeBrowseSoap12Proxy, searchForTitleDetail, searchForTitleDetail)
VL_SOAP_OPERATION(RealTimeBrowseSoap12Proxy, getGenreLabel, getGenreLabel)
VL_SOAP_OPERATION(RealTimeBrowseSoap12Proxy, getTitlesByNavigation, getTitlesByNavigation)
VL_SOAP_OPERATION(RealTimeBrowseSoap12Proxy, getTitlesByGenreArray, getTitlesByGenreArray)
VL_SOAP_OPERATION(RealTimeBrowseSoap12Proxy, getTitleListing, getTitleListing)
VL_SOAP_OPERATION(RealTimeBrowseSoap12Proxy, getTitleListingByAsset, getTitleListingByAsset)
VL_SOAP_OPERATION(RealTimeBrowseSoap12Proxy, getTvEpisodeListByTitleID, getTvEpisodeListByTitleID)
VL_SOAP_OPERATION(RealTimeBrowseSoap12Proxy, getTvEpisodeListing, getTvEpisodeListing)
VL_SOAP_OPERATION(RealTimeBrowseSoap12Proxy, getAllTvEpisodeListings, getAllTvEpisodeListings)
VL_SOAP_OPERATION(RealTimeBrowseSoap12Proxy, translateTivoExternalId, translateTivoExternalId)
VL_SOAP_OPERATION(RealTimeBrowseSoap12Proxy, translateSkuId, translateSkuId)
VL_SOAP_OPERATION(RealTimeBrowseSoap12Proxy, shouldUpdateCache, shouldUpdateCache)
VL_SOAP_OPERATION(RealTimeBrowseSoap12Proxy, getLastCacheLoadTimeUTC, getLastCacheLoadTimeUTC)
VL_SOAP_OPERATION(RealTimeBrowseSoap12Proxy, getRecommendedTitles, getRecommendedTitles)
VL_SOAP_OPERATION(RealTimeBrowseSoap12Proxy, getRecommendedTitles_SpecifyOutput, getRecommendedTitles_USCORESpecifyOutput)
