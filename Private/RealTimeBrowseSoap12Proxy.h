// RealTimeBrowseSoap12Proxy: the proxy of the store's catalogue service "RealTimeBrowse.asmx" (binding VL3,
// RealTimeBrowseSoap12). One operation per service operation, in the order of the service's interface;
// each takes the request and the response record (both allocated in this context) and returns
// the gSOAP error code. The call sequence is VLSoapProxy's; RealTimeBrowse adds the endpoint and the
// header blocks.
#ifndef REALTIMEBROWSESOAP12PROXY_H
#define REALTIMEBROWSESOAP12PROXY_H

#include "VLSoapProxy.h"

class RealTimeBrowseSoap12Proxy : public VLSoapProxy {
 public:
  RealTimeBrowseSoap12Proxy();
  virtual ~RealTimeBrowseSoap12Proxy();

  // Sets the input and output modes, clears the endpoint, registers the "soap_proxy" area and
  // installs the namespace table.
  virtual void RealTimeBrowseSoap12Proxy_init(int imode, int omode);

  virtual int getFileType(_VL1__getFileType* request, _VL1__getFileTypeResponse* response);
  virtual int getNavigation(_VL1__getNavigation* request, _VL1__getNavigationResponse* response);
  virtual int searchForTitle(_VL1__searchForTitle* request, _VL1__searchForTitleResponse* response);
  virtual int searchForTitleDetail(_VL1__searchForTitleDetail* request, _VL1__searchForTitleDetailResponse* response);
  virtual int getGenreLabel(_VL1__getGenreLabel* request, _VL1__getGenreLabelResponse* response);
  virtual int getTitlesByNavigation(_VL1__getTitlesByNavigation* request, _VL1__getTitlesByNavigationResponse* response);
  virtual int getTitlesByGenreArray(_VL1__getTitlesByGenreArray* request, _VL1__getTitlesByGenreArrayResponse* response);
  virtual int getTitleListing(_VL1__getTitleListing* request, _VL1__getTitleListingResponse* response);
  virtual int getTitleListingByAsset(_VL1__getTitleListingByAsset* request, _VL1__getTitleListingByAssetResponse* response);
  virtual int getTvEpisodeListByTitleID(_VL1__getTvEpisodeListByTitleID* request, _VL1__getTvEpisodeListByTitleIDResponse* response);
  virtual int getTvEpisodeListing(_VL1__getTvEpisodeListing* request, _VL1__getTvEpisodeListingResponse* response);
  virtual int getAllTvEpisodeListings(_VL1__getAllTvEpisodeListings* request, _VL1__getAllTvEpisodeListingsResponse* response);
  virtual int translateTivoExternalId(_VL1__translateTivoExternalId* request, _VL1__translateTivoExternalIdResponse* response);
  virtual int translateSkuId(_VL1__translateSkuId* request, _VL1__translateSkuIdResponse* response);
  virtual int shouldUpdateCache(_VL1__shouldUpdateCache* request, _VL1__shouldUpdateCacheResponse* response);
  virtual int getLastCacheLoadTimeUTC(_VL1__getLastCacheLoadTimeUTC* request, _VL1__getLastCacheLoadTimeUTCResponse* response);
  virtual int getRecommendedTitles(_VL1__getRecommendedTitles* request, _VL1__getRecommendedTitlesResponse* response);
  virtual int getRecommendedTitles_SpecifyOutput(_VL1__getRecommendedTitles_USCORESpecifyOutput* request, _VL1__getRecommendedTitles_USCORESpecifyOutputResponse* response);
};

#endif  // REALTIMEBROWSESOAP12PROXY_H
