// DownloadAPISoap12Proxy: the proxy of the store's download service "DownloadAPI.asmx" (binding VL4,
// DownloadAPISoap12). One operation per service operation, in the order of the service's interface;
// each takes the request and the response record (both allocated in this context) and returns
// the gSOAP error code. The call sequence is VLSoapProxy's; DownloadAPI adds the endpoint and the
// header blocks.
#ifndef DOWNLOADAPISOAP12PROXY_H
#define DOWNLOADAPISOAP12PROXY_H

#include "VLSoapProxy.h"

class DownloadAPISoap12Proxy : public VLSoapProxy {
 public:
  DownloadAPISoap12Proxy();
  virtual ~DownloadAPISoap12Proxy();

  // Sets the input and output modes, clears the endpoint, registers the "soap_proxy" area and
  // installs the namespace table.
  virtual void DownloadAPISoap12Proxy_init(int imode, int omode);

  virtual int authorizeDevice(_VL1__authorizeDevice* request, _VL1__authorizeDeviceResponse* response);
  virtual int doPurchaseSavedbilling(_VL1__doPurchaseSavedbilling* request, _VL1__doPurchaseSavedbillingResponse* response);
  virtual int getMyVideos(_VL1__getMyVideos* request, _VL1__getMyVideosResponse* response);
  virtual int checkForPurchasedTitle(_VL1__checkForPurchasedTitle* request, _VL1__checkForPurchasedTitleResponse* response);
  virtual int getBillingInfo(_VL1__getBillingInfo* request, _VL1__getBillingInfoResponse* response);
  virtual int showPrePaidCardBalance(_VL1__showPrePaidCardBalance* request, _VL1__showPrePaidCardBalanceResponse* response);
  virtual int getEmailAddress(_VL1__getEmailAddress* request, _VL1__getEmailAddressResponse* response);
  virtual int getSettingsPageInfo(_VL1__getSettingsPageInfo* request, _VL1__getSettingsPageInfoResponse* response);
  virtual int assignGiftCertificateToUser(_VL1__assignGiftCertificateToUser* request, _VL1__assignGiftCertificateToUserResponse* response);
  virtual int getWishlistItems(_VL1__getWishlistItems* request, _VL1__getWishlistItemsResponse* response);
  virtual int removeItemFromWishList(_VL1__removeItemFromWishList* request, _VL1__removeItemFromWishListResponse* response);
  virtual int removeAllItemsFromWishList(_VL1__removeAllItemsFromWishList* request, _VL1__removeAllItemsFromWishListResponse* response);
  virtual int addItemToWishlist(_VL1__addItemToWishlist* request, _VL1__addItemToWishlistResponse* response);
  virtual int checkAdultVerificationEnabled(_VL1__checkAdultVerificationEnabled* request, _VL1__checkAdultVerificationEnabledResponse* response);
  virtual int checkAdultVerificationPin(_VL1__checkAdultVerificationPin* request, _VL1__checkAdultVerificationPinResponse* response);
  virtual int deactivateDevice(_VL1__deactivateDevice* request, _VL1__deactivateDeviceResponse* response);
  virtual int getConfig(_VL1__getConfig* request, _VL1__getConfigResponse* response);
  virtual int checkAuthToken(_VL1__checkAuthToken* request, _VL1__checkAuthTokenResponse* response);
  virtual int GetCountryID(_VL1__GetCountryID* request, _VL1__GetCountryIDResponse* response);
  virtual int checkRentalExpiration(_VL1__checkRentalExpiration* request, _VL1__checkRentalExpirationResponse* response);
};

#endif  // DOWNLOADAPISOAP12PROXY_H
