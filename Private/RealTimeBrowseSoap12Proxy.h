// RealTimeBrowseSoap12Proxy: the proxy of the store's catalogue service "RealTimeBrowse.asmx" (binding VL3,
// RealTimeBrowseSoap12). One operation per service operation (VL_REALTIMEBROWSE_OPERATIONS);
// each takes the request and the response record (both allocated in this context) and returns
// the gSOAP error code. The call sequence is VLSoapProxy's; RealTimeBrowse adds the endpoint and the
// header blocks.
#ifndef REALTIMEBROWSESOAP12PROXY_H
#define REALTIMEBROWSESOAP12PROXY_H

#include "VLSoapProxy.h"

// The catalogue service's operations, in the order of its interface: OP(name, Type), name the
// operation, Type the generated record name part (the operation with "_" written "_USCORE").
#define VL_REALTIMEBROWSE_OPERATIONS(OP)                                                                      \
  OP(getFileType, getFileType)                                                                                \
  OP(getNavigation, getNavigation)                                                                            \
  OP(searchForTitle, searchForTitle)                                                                          \
  OP(searchForTitleDetail, searchForTitleDetail)                                                              \
  OP(getGenreLabel, getGenreLabel)                                                                            \
  OP(getTitlesByNavigation, getTitlesByNavigation)                                                            \
  OP(getTitlesByGenreArray, getTitlesByGenreArray)                                                            \
  OP(getTitleListing, getTitleListing)                                                                        \
  OP(getTitleListingByAsset, getTitleListingByAsset)                                                          \
  OP(getTvEpisodeListByTitleID, getTvEpisodeListByTitleID)                                                    \
  OP(getTvEpisodeListing, getTvEpisodeListing)                                                                \
  OP(getAllTvEpisodeListings, getAllTvEpisodeListings)                                                        \
  OP(translateTivoExternalId, translateTivoExternalId)                                                        \
  OP(translateSkuId, translateSkuId)                                                                          \
  OP(shouldUpdateCache, shouldUpdateCache)                                                                    \
  OP(getLastCacheLoadTimeUTC, getLastCacheLoadTimeUTC)                                                        \
  OP(getRecommendedTitles, getRecommendedTitles)                                                              \
  OP(getRecommendedTitles_SpecifyOutput, getRecommendedTitles_USCORESpecifyOutput)

class RealTimeBrowseSoap12Proxy : public VLSoapProxy {
 public:
  RealTimeBrowseSoap12Proxy();
  virtual ~RealTimeBrowseSoap12Proxy();

  // Sets the input and output modes, clears the endpoint, registers the "soap_proxy" area and
  // installs the namespace table.
  virtual void RealTimeBrowseSoap12Proxy_init(int imode, int omode);

  VL_REALTIMEBROWSE_OPERATIONS(VL_SOAP_DECLARE)
};

#endif  // REALTIMEBROWSESOAP12PROXY_H
