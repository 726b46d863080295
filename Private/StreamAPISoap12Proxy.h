// StreamAPISoap12Proxy: the proxy of the store's streaming service "StreamAPI.asmx" (binding VL2,
// StreamAPISoap12). One operation per service operation, in the order of the service's interface;
// each takes the request and the response record (both allocated in this context) and returns
// the gSOAP error code. The call sequence is VLSoapProxy's; StreamAPI adds the endpoint and the
// header blocks.
#ifndef STREAMAPISOAP12PROXY_H
#define STREAMAPISOAP12PROXY_H

#include "VLSoapProxy.h"

class StreamAPISoap12Proxy : public VLSoapProxy {
 public:
  StreamAPISoap12Proxy();
  virtual ~StreamAPISoap12Proxy();

  // Sets the input and output modes, clears the endpoint, registers the "soap_proxy" area and
  // installs the namespace table.
  virtual void StreamAPISoap12Proxy_init(int imode, int omode);

  virtual int getStreamingNavigation(_VL1__getStreamingNavigation* request, _VL1__getStreamingNavigationResponse* response);
  virtual int searchForTitle(_VL1__searchForTitle* request, _VL1__searchForTitleResponse* response);
  virtual int getGenreLabel(_VL1__getGenreLabel* request, _VL1__getGenreLabelResponse* response);
  virtual int getTitlesByGenreCSV(_VL1__getTitlesByGenreCSV* request, _VL1__getTitlesByGenreCSVResponse* response);
  virtual int getTitlesByGenreArray(_VL1__getTitlesByGenreArray* request, _VL1__getTitlesByGenreArrayResponse* response);
  virtual int getTitlesByStreamingNavigation(_VL1__getTitlesByStreamingNavigation* request, _VL1__getTitlesByStreamingNavigationResponse* response);
  virtual int getTitleListing(_VL1__getTitleListing* request, _VL1__getTitleListingResponse* response);
  virtual int getTvEpisodeListByTitleID(_VL1__getTvEpisodeListByTitleID* request, _VL1__getTvEpisodeListByTitleIDResponse* response);
  virtual int getTvEpisodeListing(_VL1__getTvEpisodeListing* request, _VL1__getTvEpisodeListingResponse* response);
  virtual int getAllTvEpisodeListings(_VL1__getAllTvEpisodeListings* request, _VL1__getAllTvEpisodeListingsResponse* response);
  virtual int shouldUpdateCache(_VL1__shouldUpdateCache* request, _VL1__shouldUpdateCacheResponse* response);
  virtual int getLastCacheLoadTimeUTC(_VL1__getLastCacheLoadTimeUTC* request, _VL1__getLastCacheLoadTimeUTCResponse* response);
  virtual int authorizeDevice(_VL1__authorizeDevice* request, _VL1__authorizeDeviceResponse* response);
  virtual int doPurchaseSavedbilling(_VL1__doPurchaseSavedbilling* request, _VL1__doPurchaseSavedbillingResponse* response);
  virtual int getMyStreamingVideos(_VL1__getMyStreamingVideos* request, _VL1__getMyStreamingVideosResponse* response);
  virtual int getTitleListingsPurchasedForPasses(_VL1__getTitleListingsPurchasedForPasses* request, _VL1__getTitleListingsPurchasedForPassesResponse* response);
  virtual int getTitleListingPurchasedForPass(_VL1__getTitleListingPurchasedForPass* request, _VL1__getTitleListingPurchasedForPassResponse* response);
  virtual int checkRentalExpiration(_VL1__checkRentalExpiration* request, _VL1__checkRentalExpirationResponse* response);
  virtual int checkForPurchasedStreamByTitleID(_VL1__checkForPurchasedStreamByTitleID* request, _VL1__checkForPurchasedStreamByTitleIDResponse* response);
  virtual int checkForPurchasedStream(_VL1__checkForPurchasedStream* request, _VL1__checkForPurchasedStreamResponse* response);
  virtual int getBillingInfo(_VL1__getBillingInfo* request, _VL1__getBillingInfoResponse* response);
  virtual int showPrePaidCardBalance(_VL1__showPrePaidCardBalance* request, _VL1__showPrePaidCardBalanceResponse* response);
  virtual int getBillingInfoAndPPCBalance(_VL1__getBillingInfoAndPPCBalance* request, _VL1__getBillingInfoAndPPCBalanceResponse* response);
  virtual int getEmailAddress(_VL1__getEmailAddress* request, _VL1__getEmailAddressResponse* response);
  virtual int getSettingsPageInfo(_VL1__getSettingsPageInfo* request, _VL1__getSettingsPageInfoResponse* response);
  virtual int assignGiftCertificateToUser(_VL1__assignGiftCertificateToUser* request, _VL1__assignGiftCertificateToUserResponse* response);
  virtual int manageStreamInstanceStatus(_VL1__manageStreamInstanceStatus* request, _VL1__manageStreamInstanceStatusResponse* response);
  virtual int getStreamingAssetLocation(_VL1__getStreamingAssetLocation* request, _VL1__getStreamingAssetLocationResponse* response);
  virtual int getBonusAssetLocation(_VL1__getBonusAssetLocation* request, _VL1__getBonusAssetLocationResponse* response);
  virtual int loadLastStreamingAssetLocationForPass(_VL1__loadLastStreamingAssetLocationForPass* request, _VL1__loadLastStreamingAssetLocationForPassResponse* response);
  virtual int getWishlistItems(_VL1__getWishlistItems* request, _VL1__getWishlistItemsResponse* response);
  virtual int removeItemFromWishList(_VL1__removeItemFromWishList* request, _VL1__removeItemFromWishListResponse* response);
  virtual int removeAllItemsFromWishList(_VL1__removeAllItemsFromWishList* request, _VL1__removeAllItemsFromWishListResponse* response);
  virtual int addItemToWishlist(_VL1__addItemToWishlist* request, _VL1__addItemToWishlistResponse* response);
  virtual int checkAdultVerificationEnabled(_VL1__checkAdultVerificationEnabled* request, _VL1__checkAdultVerificationEnabledResponse* response);
  virtual int checkAdultVerificationPin(_VL1__checkAdultVerificationPin* request, _VL1__checkAdultVerificationPinResponse* response);
  virtual int getConfig(_VL1__getConfig* request, _VL1__getConfigResponse* response);
  virtual int deactivateDevice(_VL1__deactivateDevice* request, _VL1__deactivateDeviceResponse* response);
  virtual int removeAllMyPurchases(_VL1__removeAllMyPurchases* request, _VL1__removeAllMyPurchasesResponse* response);
  virtual int checkAuthToken(_VL1__checkAuthToken* request, _VL1__checkAuthTokenResponse* response);
  virtual int ReturnError(_VL1__ReturnError* request, _VL1__ReturnErrorResponse* response);
  virtual int ReturnTimeout(_VL1__ReturnTimeout* request, _VL1__ReturnTimeoutResponse* response);
  virtual int calcOrderTax(_VL1__calcOrderTax* request, _VL1__calcOrderTaxResponse* response);
  virtual int GetCountryID(_VL1__GetCountryID* request, _VL1__GetCountryIDResponse* response);
  virtual int getAudioDefaultProperty(_VL1__getAudioDefaultProperty* request, _VL1__getAudioDefaultPropertyResponse* response);
  virtual int setAudioDefaultProperty(_VL1__setAudioDefaultProperty* request, _VL1__setAudioDefaultPropertyResponse* response);
  virtual int getTHXMediaDirector(_VL1__getTHXMediaDirector* request, _VL1__getTHXMediaDirectorResponse* response);
  virtual int getTHXMediaDirectorBonusAsset(_VL1__getTHXMediaDirectorBonusAsset* request, _VL1__getTHXMediaDirectorBonusAssetResponse* response);
};

#endif  // STREAMAPISOAP12PROXY_H
