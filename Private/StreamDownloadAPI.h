// StreamDownloadAPI: the dispatcher of the account operations that both the streaming and the
// download service offer with identical messages. Access type DOWNLOAD (1) selects the handle's
// DownloadAPI object; every other value (UNKNOWN, STREAM, anything else) its StreamAPI object.
// Initialised once per handle, after the access type is resolved; it borrows both objects.
#ifndef STREAMDOWNLOADAPI_H
#define STREAMDOWNLOADAPI_H

#include "DownloadAPI.h"
#include "StreamAPI.h"
#include "VLString.h"
#include "VL_WS_Types.h"

class StreamDownloadAPI {
 public:
  StreamDownloadAPI();

  // Both objects must be given.
  void Init(StreamAPI* stapi, DownloadAPI* dlapi, VL_WS_AccessType type);

  // Setup of the selected object (requires Init).
  int Setup(const VLString& operation);

  // The selected object's context (requires Init): callers allocate and free the call's records
  // in it and end the call with it.
  operator soap&();

  // The dispatched operations: each calls the same operation of the selected object.
  int authorizeDevice(_VL1__authorizeDevice* request, _VL1__authorizeDeviceResponse* response);
  int doPurchaseSavedbilling(_VL1__doPurchaseSavedbilling* request, _VL1__doPurchaseSavedbillingResponse* response);
  int checkRentalExpiration(_VL1__checkRentalExpiration* request, _VL1__checkRentalExpirationResponse* response);
  int getBillingInfo(_VL1__getBillingInfo* request, _VL1__getBillingInfoResponse* response);
  int showPrePaidCardBalance(_VL1__showPrePaidCardBalance* request, _VL1__showPrePaidCardBalanceResponse* response);
  int getEmailAddress(_VL1__getEmailAddress* request, _VL1__getEmailAddressResponse* response);
  int getSettingsPageInfo(_VL1__getSettingsPageInfo* request, _VL1__getSettingsPageInfoResponse* response);
  int assignGiftCertificateToUser(_VL1__assignGiftCertificateToUser* request, _VL1__assignGiftCertificateToUserResponse* response);
  int getWishlistItems(_VL1__getWishlistItems* request, _VL1__getWishlistItemsResponse* response);
  int removeItemFromWishList(_VL1__removeItemFromWishList* request, _VL1__removeItemFromWishListResponse* response);
  int removeAllItemsFromWishList(_VL1__removeAllItemsFromWishList* request, _VL1__removeAllItemsFromWishListResponse* response);
  int addItemToWishlist(_VL1__addItemToWishlist* request, _VL1__addItemToWishlistResponse* response);
  int checkAdultVerificationEnabled(_VL1__checkAdultVerificationEnabled* request, _VL1__checkAdultVerificationEnabledResponse* response);
  int checkAdultVerificationPin(_VL1__checkAdultVerificationPin* request, _VL1__checkAdultVerificationPinResponse* response);
  int getConfig(_VL1__getConfig* request, _VL1__getConfigResponse* response);
  int deactivateDevice(_VL1__deactivateDevice* request, _VL1__deactivateDeviceResponse* response);
  int checkAuthToken(_VL1__checkAuthToken* request, _VL1__checkAuthTokenResponse* response);
  int GetCountryID(_VL1__GetCountryID* request, _VL1__GetCountryIDResponse* response);

 private:
  bool Download() const { return m_AccessType == DOWNLOAD; }

  StreamAPI* m_StreamAPI;
  DownloadAPI* m_DownloadAPI;
  VL_WS_AccessType m_AccessType;
};

#endif  // STREAMDOWNLOADAPI_H
