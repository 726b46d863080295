#include "DownloadAPISoap12Proxy.h"

#include "VLStoreHosts.h"

// Used only while no endpoint is set, which does not happen once the service object is bound.
#define VL_FALLBACK_ENDPOINT "http://" VL_STORE_STAGING_API_HOST "/api/DownloadAPI.asmx"

DownloadAPISoap12Proxy::DownloadAPISoap12Proxy() : VLSoapProxy("DownloadAPISoap12Proxy", VL_FALLBACK_ENDPOINT) {
  DownloadAPISoap12Proxy_init(SOAP_C_UTFSTRING, SOAP_C_UTFSTRING);
}

DownloadAPISoap12Proxy::~DownloadAPISoap12Proxy() {}

void DownloadAPISoap12Proxy::DownloadAPISoap12Proxy_init(int imode, int omode) { Init(imode, omode); }

VL_SOAP_OPERATION(DownloadAPISoap12Proxy, authorizeDevice, authorizeDevice)
VL_SOAP_OPERATION(DownloadAPISoap12Proxy, doPurchaseSavedbilling, doPurchaseSavedbilling)
VL_SOAP_OPERATION(DownloadAPISoap12Proxy, getMyVideos, getMyVideos)
VL_SOAP_OPERATION(DownloadAPISoap12Proxy, checkForPurchasedTitle, checkForPurchasedTitle)
VL_SOAP_OPERATION(DownloadAPISoap12Proxy, getBillingInfo, getBillingInfo)
VL_SOAP_OPERATION(DownloadAPISoap12Proxy, showPrePaidCardBalance, showPrePaidCardBalance)
VL_SOAP_OPERATION(DownloadAPISoap12Proxy, getEmailAddress, getEmailAddress)
VL_SOAP_OPERATION(DownloadAPISoap12Proxy, getSettingsPageInfo, getSettingsPageInfo)
VL_SOAP_OPERATION(DownloadAPISoap12Proxy, assignGiftCertificateToUser, assignGiftCertificateToUser)
VL_SOAP_OPERATION(DownloadAPISoap12Proxy, getWishlistItems, getWishlistItems)
VL_SOAP_OPERATION(DownloadAPISoap12Proxy, removeItemFromWishList, removeItemFromWishList)
VL_SOAP_OPERATION(DownloadAPISoap12Proxy, removeAllItemsFromWishList, removeAllItemsFromWishList)
VL_SOAP_OPERATION(DownloadAPISoap12Proxy, addItemToWishlist, addItemToWishlist)
VL_SOAP_OPERATION(DownloadAPISoap12Proxy, checkAdultVerificationEnabled, checkAdultVerificationEnabled)
VL_SOAP_OPERATION(DownloadAPISoap12Proxy, checkAdultVerificationPin, checkAdultVerificationPin)
VL_SOAP_OPERATION(DownloadAPISoap12Proxy, deactivateDevice, deactivateDevice)
VL_SOAP_OPERATION(DownloadAPISoap12Proxy, getConfig, getConfig)
VL_SOAP_OPERATION(DownloadAPISoap12Proxy, checkAuthToken, checkAuthToken)
VL_SOAP_OPERATION(DownloadAPISoap12Proxy, GetCountryID, GetCountryID)
VL_SOAP_OPERATION(DownloadAPISoap12Proxy, checkRentalExpiration, checkRentalExpiration)
