// DownloadAPISoap12Proxy: the proxy of the store's download service "DownloadAPI.asmx" (binding VL4,
// DownloadAPISoap12). One operation per service operation (VL_DOWNLOADAPI_OPERATIONS);
// each takes the request and the response record (both allocated in this context) and returns
// the gSOAP error code. The call sequence is VLSoapProxy's; DownloadAPI adds the endpoint and the
// header blocks.
#ifndef DOWNLOADAPISOAP12PROXY_H
#define DOWNLOADAPISOAP12PROXY_H

#include "VLSoapProxy.h"

// The download service's operations, in the order of its interface: OP(name, Type) for its own,
// SHARED(name, Type) for the account operations that the streaming service offers with
// identical messages, which StreamDownloadAPI dispatches by access type. name is the
// operation, Type the generated record name part (the operation with "_" written "_USCORE").
#define VL_DOWNLOADAPI_OPERATIONS(OP, SHARED)                                                                 \
  SHARED(authorizeDevice, authorizeDevice)                                                                    \
  SHARED(doPurchaseSavedbilling, doPurchaseSavedbilling)                                                      \
  OP(getMyVideos, getMyVideos)                                                                                \
  OP(checkForPurchasedTitle, checkForPurchasedTitle)                                                          \
  SHARED(getBillingInfo, getBillingInfo)                                                                      \
  SHARED(showPrePaidCardBalance, showPrePaidCardBalance)                                                      \
  SHARED(getEmailAddress, getEmailAddress)                                                                    \
  SHARED(getSettingsPageInfo, getSettingsPageInfo)                                                            \
  SHARED(assignGiftCertificateToUser, assignGiftCertificateToUser)                                            \
  SHARED(getWishlistItems, getWishlistItems)                                                                  \
  SHARED(removeItemFromWishList, removeItemFromWishList)                                                      \
  SHARED(removeAllItemsFromWishList, removeAllItemsFromWishList)                                              \
  SHARED(addItemToWishlist, addItemToWishlist)                                                                \
  SHARED(checkAdultVerificationEnabled, checkAdultVerificationEnabled)                                        \
  SHARED(checkAdultVerificationPin, checkAdultVerificationPin)                                                \
  SHARED(deactivateDevice, deactivateDevice)                                                                  \
  SHARED(getConfig, getConfig)                                                                                \
  SHARED(checkAuthToken, checkAuthToken)                                                                      \
  SHARED(GetCountryID, GetCountryID)                                                                          \
  SHARED(checkRentalExpiration, checkRentalExpiration)

class DownloadAPISoap12Proxy : public VLSoapProxy {
 public:
  DownloadAPISoap12Proxy();
  virtual ~DownloadAPISoap12Proxy();

  // Sets the input and output modes, clears the endpoint, registers the "soap_proxy" area and
  // installs the namespace table.
  virtual void DownloadAPISoap12Proxy_init(int imode, int omode);

  VL_DOWNLOADAPI_OPERATIONS(VL_SOAP_DECLARE, VL_SOAP_DECLARE)
};

#endif  // DOWNLOADAPISOAP12PROXY_H
