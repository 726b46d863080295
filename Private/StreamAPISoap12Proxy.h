// StreamAPISoap12Proxy: the proxy of the store's streaming service "StreamAPI.asmx" (binding VL2,
// StreamAPISoap12). One operation per service operation (VL_STREAMAPI_OPERATIONS);
// each takes the request and the response record (both allocated in this context) and returns
// the gSOAP error code. The call sequence is VLSoapProxy's; StreamAPI adds the endpoint and the
// header blocks.
#ifndef STREAMAPISOAP12PROXY_H
#define STREAMAPISOAP12PROXY_H

#include "VLSoapProxy.h"

// The streaming service's operations, in the order of its interface: OP(name, Type), name the
// operation, Type the generated record name part (the operation with "_" written "_USCORE").
#define VL_STREAMAPI_OPERATIONS(OP)                                                                           \
  OP(getStreamingNavigation, getStreamingNavigation)                                                          \
  OP(searchForTitle, searchForTitle)                                                                          \
  OP(getGenreLabel, getGenreLabel)                                                                            \
  OP(getTitlesByGenreCSV, getTitlesByGenreCSV)                                                                \
  OP(getTitlesByGenreArray, getTitlesByGenreArray)                                                            \
  OP(getTitlesByStreamingNavigation, getTitlesByStreamingNavigation)                                          \
  OP(getTitleListing, getTitleListing)                                                                        \
  OP(getTvEpisodeListByTitleID, getTvEpisodeListByTitleID)                                                    \
  OP(getTvEpisodeListing, getTvEpisodeListing)                                                                \
  OP(getAllTvEpisodeListings, getAllTvEpisodeListings)                                                        \
  OP(shouldUpdateCache, shouldUpdateCache)                                                                    \
  OP(getLastCacheLoadTimeUTC, getLastCacheLoadTimeUTC)                                                        \
  OP(authorizeDevice, authorizeDevice)                                                                        \
  OP(doPurchaseSavedbilling, doPurchaseSavedbilling)                                                          \
  OP(getMyStreamingVideos, getMyStreamingVideos)                                                              \
  OP(getTitleListingsPurchasedForPasses, getTitleListingsPurchasedForPasses)                                  \
  OP(getTitleListingPurchasedForPass, getTitleListingPurchasedForPass)                                        \
  OP(checkRentalExpiration, checkRentalExpiration)                                                            \
  OP(checkForPurchasedStreamByTitleID, checkForPurchasedStreamByTitleID)                                      \
  OP(checkForPurchasedStream, checkForPurchasedStream)                                                        \
  OP(getBillingInfo, getBillingInfo)                                                                          \
  OP(showPrePaidCardBalance, showPrePaidCardBalance)                                                          \
  OP(getBillingInfoAndPPCBalance, getBillingInfoAndPPCBalance)                                                \
  OP(getEmailAddress, getEmailAddress)                                                                        \
  OP(getSettingsPageInfo, getSettingsPageInfo)                                                                \
  OP(assignGiftCertificateToUser, assignGiftCertificateToUser)                                                \
  OP(manageStreamInstanceStatus, manageStreamInstanceStatus)                                                  \
  OP(getStreamingAssetLocation, getStreamingAssetLocation)                                                    \
  OP(getBonusAssetLocation, getBonusAssetLocation)                                                            \
  OP(loadLastStreamingAssetLocationForPass, loadLastStreamingAssetLocationForPass)                            \
  OP(getWishlistItems, getWishlistItems)                                                                      \
  OP(removeItemFromWishList, removeItemFromWishList)                                                          \
  OP(removeAllItemsFromWishList, removeAllItemsFromWishList)                                                  \
  OP(addItemToWishlist, addItemToWishlist)                                                                    \
  OP(checkAdultVerificationEnabled, checkAdultVerificationEnabled)                                            \
  OP(checkAdultVerificationPin, checkAdultVerificationPin)                                                    \
  OP(getConfig, getConfig)                                                                                    \
  OP(deactivateDevice, deactivateDevice)                                                                      \
  OP(removeAllMyPurchases, removeAllMyPurchases)                                                              \
  OP(checkAuthToken, checkAuthToken)                                                                          \
  OP(ReturnError, ReturnError)                                                                                \
  OP(ReturnTimeout, ReturnTimeout)                                                                            \
  OP(calcOrderTax, calcOrderTax)                                                                              \
  OP(GetCountryID, GetCountryID)                                                                              \
  OP(getAudioDefaultProperty, getAudioDefaultProperty)                                                        \
  OP(setAudioDefaultProperty, setAudioDefaultProperty)                                                        \
  OP(getTHXMediaDirector, getTHXMediaDirector)                                                                \
  OP(getTHXMediaDirectorBonusAsset, getTHXMediaDirectorBonusAsset)

class StreamAPISoap12Proxy : public VLSoapProxy {
 public:
  StreamAPISoap12Proxy();
  virtual ~StreamAPISoap12Proxy();

  // Sets the input and output modes, clears the endpoint, registers the "soap_proxy" area and
  // installs the namespace table.
  virtual void StreamAPISoap12Proxy_init(int imode, int omode);

  VL_STREAMAPI_OPERATIONS(VL_SOAP_DECLARE)
};

#endif  // STREAMAPISOAP12PROXY_H
