#include "StreamDownloadAPI.h"

#include "VLAssert.h"

StreamDownloadAPI::StreamDownloadAPI() : m_StreamAPI(0), m_DownloadAPI(0), m_AccessType(UNKNOWN) {}

void StreamDownloadAPI::Init(StreamAPI* stapi, DownloadAPI* dlapi, VL_WS_AccessType type) {
  VL_ASSERT(stapi != 0);
  VL_ASSERT(dlapi != 0);
  m_StreamAPI = stapi;
  m_DownloadAPI = dlapi;
  m_AccessType = type;
}

int StreamDownloadAPI::Setup(const VLString& operation) {
  VL_ASSERT((m_StreamAPI != 0) && (m_DownloadAPI != 0));
  return Download() ? m_DownloadAPI->Setup(operation) : m_StreamAPI->Setup(operation);
}

StreamDownloadAPI::operator soap&() {
  VL_ASSERT((m_StreamAPI != 0) && (m_DownloadAPI != 0));
  if (Download()) return *m_DownloadAPI;
  return *m_StreamAPI;
}

#define VL_DISPATCH(name)                                                                          \
  int StreamDownloadAPI::name(_VL1__##name* request, _VL1__##name##Response* response) {         \
    return Download() ? m_DownloadAPI->name(request, response) : m_StreamAPI->name(request, response); \
  }

VL_DISPATCH(authorizeDevice)
VL_DISPATCH(doPurchaseSavedbilling)
VL_DISPATCH(checkRentalExpiration)
VL_DISPATCH(getBillingInfo)
VL_DISPATCH(showPrePaidCardBalance)
VL_DISPATCH(getEmailAddress)
VL_DISPATCH(getSettingsPageInfo)
VL_DISPATCH(assignGiftCertificateToUser)
VL_DISPATCH(getWishlistItems)
VL_DISPATCH(removeItemFromWishList)
VL_DISPATCH(removeAllItemsFromWishList)
VL_DISPATCH(addItemToWishlist)
VL_DISPATCH(checkAdultVerificationEnabled)
VL_DISPATCH(checkAdultVerificationPin)
VL_DISPATCH(getConfig)
VL_DISPATCH(deactivateDevice)
VL_DISPATCH(checkAuthToken)
VL_DISPATCH(GetCountryID)
