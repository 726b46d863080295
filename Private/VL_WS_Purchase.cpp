// Purchase operations of the client: buying with saved billing data, tax, billing data and
// prepaid balance, gift certificates, and the account's videos, purchased titles and rentals.
#include "VLUtilities.h"
#include "VL_WS.h"
#include "VL_WS_Call.h"

namespace {

// A required text argument: given and not empty.
bool Given(const char* text) { return text != 0 && *text != 0; }

}  // namespace

extern "C" VL_WS_Status VL_WS_doPurchaseSavedBilling(VL_WS_Handle* handle, int skuID, const char* ipAddress,
                                                     bool usePrePaidFunds, VL_WS_PurchaseResponse* answer) {
  VL_WS_Client* client = VLClientFor(handle, answer);
  if (client == 0 || !Given(ipAddress)) return VL_WS_E_INVALID_ARGUMENT;
  bool answered = false;
  int soapError = VLServiceCall(
      *client, client->m_StreamDownloadAPI, VL_SERVICE_OPERATION(StreamDownloadAPI, doPurchaseSavedbilling),
      [&](_VL1__doPurchaseSavedbilling& request) {
        request.SkuID = skuID;
        request.IPAddress = const_cast<char*>(ipAddress);
        request.UsePrePaidFunds = const_cast<char*>(usePrePaidFunds ? "yes" : "no");
      },
      VLInto(VLUtilities::VL1__PurchaseResponse2VL_WS_PurchaseResponse, *answer, &answered));
  // The store takes a bought title off the wishlist: the cached pages and flags are out of date.
  CacheInterface* cache = VLUserData(client);
  if (VLSucceeded(soapError, answered, answer->ResponseCode) && cache != 0) {
    cache->PurgeUserData("getWishlistItems");
    cache->RemoveAllWishlistFlags();
  }
  return VLFoldedStatus("VL_WS_doPurchaseSavedBilling", soapError, answer->ResponseCode);
}

extern "C" VL_WS_Status VL_WS_calcOrderTax(VL_WS_Handle* handle, int skuID, VL_WS_OrderTaxResponse* tax) {
  VL_WS_Client* client = VLClientFor(handle, tax);
  if (client == 0) return VL_WS_E_INVALID_ARGUMENT;
  int soapError = VLServiceCall(
      *client, client->m_StreamAPI, VL_SERVICE_OPERATION(StreamAPI, calcOrderTax),
      [skuID](_VL1__calcOrderTax& request) { request.SKUID = skuID; },
      VLInto(VLUtilities::VL1__CalcOrderTaxResponse2VL_WS_OrderTaxResponse, *tax));
  return VLUtilities::To_VL_WS_Status(soapError, tax->ResponseCode, "VL_WS_calcOrderTax");
}

// Kept as user data, one answer per cache: the Key is empty.
extern "C" VL_WS_Status VL_WS_getBillingInfo(VL_WS_Handle* handle, VL_WS_BillingInfoResponse* info) {
  VL_WS_Client* client = VLClientFor(handle, info);
  if (client == 0) return VL_WS_E_INVALID_ARGUMENT;
  return VLKeptRecord(*client, client->m_StreamDownloadAPI, VL_SERVICE_OPERATION(StreamDownloadAPI, getBillingInfo),
                      {VLCacheKind::kUserData, "getBillingInfo", VLString()}, VLNoFields(),
                      VLUtilities::VL1__BillingInfoResponse2VL_WS_BillingInfoResponse, *info, "VL_WS_getBillingInfo",
                      VLFoldedStatus);
}

extern "C" VL_WS_Status VL_WS_getBillingInfoAndPPCBalance(VL_WS_Handle* handle, VL_WS_BillingInfoAndPPCBalance* info) {
  VL_WS_Client* client = VLClientFor(handle, info);
  if (client == 0) return VL_WS_E_INVALID_ARGUMENT;
  int soapError = VLServiceCall(
      *client, client->m_StreamAPI, VL_SERVICE_OPERATION(StreamAPI, getBillingInfoAndPPCBalance), VLNoFields(),
      VLInto(VLUtilities::VL1__BillingInfoAndPPCBalanceResponse2VL_WS_BillingInfoAndPPCBalance, *info));
  return VLUtilities::To_VL_WS_Status(soapError, info->BillingInfo.ResponseCode, "");
}

extern "C" VL_WS_Status VL_WS_getPrePaidCardBalance(VL_WS_Handle* handle, VL_WS_PrePaidCardBalanceResponse* balance) {
  VL_WS_Client* client = VLClientFor(handle, balance);
  if (client == 0) return VL_WS_E_INVALID_ARGUMENT;
  int soapError = VLServiceCall(
      *client, client->m_StreamDownloadAPI, VL_SERVICE_OPERATION(StreamDownloadAPI, showPrePaidCardBalance),
      VLNoFields(), VLInto(VLUtilities::VL1__PPCardBalanceResponse2VL_WS_PrePaidCardBalanceResponse, *balance));
  return VLFoldedStatus("VL_WS_getPrePaidCardBalance", soapError, balance->ResponseCode);
}

extern "C" VL_WS_Status VL_WS_assignGiftCertificateToUser(VL_WS_Handle* handle, const char* code,
                                                          VL_WS_GiftCertificateResponse* answer) {
  VL_WS_Client* client = VLClientFor(handle, answer);
  if (client == 0 || !Given(code)) return VL_WS_E_INVALID_ARGUMENT;
  int soapError = VLServiceCall(
      *client, client->m_StreamDownloadAPI, VL_SERVICE_OPERATION(StreamDownloadAPI, assignGiftCertificateToUser),
      [code](_VL1__assignGiftCertificateToUser& request) { request.GiftCertificateCode = const_cast<char*>(code); },
      VLInto(VLUtilities::VL1__GiftCertificateResponse2VL_WS_GiftCertificateResponse, *answer));
  return VLFoldedStatus("VL_WS_assignGiftCertificateToUser", soapError, answer->ResponseCode);
}

extern "C" VL_WS_Status VL_WS_getMyVideos(VL_WS_Handle* handle, int currentPageNumber, int itemsPerPage,
                                          int purchaseType, int titleType, int watchStatusFilter,
                                          VL_WS_MyVideosResponse* videos) {
  VL_WS_Client* client = VLClientFor(handle, videos);
  if (client == 0 || !VLPageFits(currentPageNumber, itemsPerPage)) return VL_WS_E_INVALID_ARGUMENT;
  auto fill = [=](auto& request) {
    request.CurrentPageNumber = currentPageNumber;
    request.ItemsPerPage = itemsPerPage;
    request.PurchaseType = static_cast<VL1__StreamAPIPurchaseType>(purchaseType);
    request.TitleType = static_cast<VL1__TitleTypeFilter>(titleType);
    request.WatchStatusFilter = static_cast<VL1__WatchStatus>(watchStatusFilter);
  };
  auto convert = VLKeptInto(VLUtilities::VL1__GetMyVideosResponse2VL_WS_MyVideosResponse, *videos);
  // The handle's access type as it stands chooses the service; only the streaming service's
  // answers are kept.
  int soapError;
  if (client->m_Params.AccessType == DOWNLOAD) {
    soapError =
        VLServiceCall(*client, client->m_DownloadAPI, VL_SERVICE_OPERATION(DownloadAPI, getMyVideos), fill, convert);
  } else {
    VLCacheEntry entry = {
        VLCacheKind::kUserData, "getMyVideos",
        VLCacheKey("%d,%d,%d,%d,%d", currentPageNumber, itemsPerPage, purchaseType, titleType, watchStatusFilter)};
    soapError = VLCachedCall(*client, client->m_StreamAPI, VL_SERVICE_OPERATION(StreamAPI, getMyStreamingVideos),
                             &entry, fill, convert);
  }
  return VLFoldedStatus("VL_WS_getMyVideos", soapError, videos->ResponseCode);
}

extern "C" VL_WS_Status VL_WS_checkRentalExpiration(VL_WS_Handle* handle, int passID,
                                                    VL_WS_RentalExpirationResponse* answer) {
  VL_WS_Client* client = VLClientFor(handle, answer);
  if (client == 0) return VL_WS_E_INVALID_ARGUMENT;
  int soapError = VLServiceCall(
      *client, client->m_StreamDownloadAPI, VL_SERVICE_OPERATION(StreamDownloadAPI, checkRentalExpiration),
      [passID](_VL1__checkRentalExpiration& request) { request.PassId = passID; },
      VLInto(VLUtilities::VL1__CheckRentalExpirationResponse2VL_WS_RentalExpirationResponse, *answer));
  return VLFoldedStatus("VL_WS_checkRentalExpiration", soapError, answer->ResponseCode);
}

extern "C" VL_WS_Status VL_WS_checkForPurchasedTitle(VL_WS_Handle* handle, int titleID, bool* purchased) {
  VL_WS_Client* client = VLClientFor(handle, purchased);
  if (client == 0) return VL_WS_E_INVALID_ARGUMENT;
  auto fill = [titleID](auto& request) { request.TitleID = titleID; };
  auto read = [purchased](const xsd__boolean& result) { *purchased = result == true_; };
  // The handle's access type as it stands (VL_WS_getFileType may have changed it) chooses.
  int soapError = client->m_Params.AccessType == DOWNLOAD
                      ? VLServiceCall(*client, client->m_DownloadAPI,
                                      VL_SERVICE_OPERATION(DownloadAPI, checkForPurchasedTitle), fill, read)
                      : VLServiceCall(*client, client->m_StreamAPI,
                                      VL_SERVICE_OPERATION(StreamAPI, checkForPurchasedStreamByTitleID), fill, read);
  return VLBoolStatus("VL_WS_checkForPurchasedTitle", soapError, *purchased);
}

extern "C" VL_WS_Status VL_WS_checkForPurchasedSku(VL_WS_Handle* handle, int skuID, bool* purchased) {
  VL_WS_Client* client = VLClientFor(handle, purchased);
  if (client == 0) return VL_WS_E_INVALID_ARGUMENT;
  int soapError = VLServiceCall(
      *client, client->m_StreamAPI, VL_SERVICE_OPERATION(StreamAPI, checkForPurchasedStream),
      [skuID](_VL1__checkForPurchasedStream& request) { request.SkuID = skuID; },
      [purchased](const xsd__boolean& result) { *purchased = result == true_; });
  return VLBoolStatus("VL_WS_checkForPurchasedSku", soapError, *purchased);
}

extern "C" VL_WS_Status VL_WS_removeAllMyPurchases(VL_WS_Handle* handle, const char* password,
                                                   VL_WS_StandardResponse* answer) {
  VL_WS_Client* client = VLClientFor(handle, answer);
  if (client == 0 || !Given(password)) return VL_WS_E_INVALID_ARGUMENT;
  int soapError = VLServiceCall(
      *client, client->m_StreamAPI, VL_SERVICE_OPERATION(StreamAPI, removeAllMyPurchases),
      [password](_VL1__removeAllMyPurchases& request) { request.password = const_cast<char*>(password); },
      VLInto(VLUtilities::VL1__StandardResponse2VL_WS_StandardResponse, *answer));
  return VLUtilities::To_VL_WS_Status(soapError, answer->ResponseCode, "");
}

extern "C" VL_WS_Status VL_WS_getTitleListingPurchaseds(VL_WS_Handle* handle, int count, const int* passIDs,
                                                        VL_WS_TitleListingPurchasedForPassArray* titles) {
  VL_WS_Client* client = VLClientFor(handle, titles);
  if (client == 0 || passIDs == 0 || count < 1) return VL_WS_E_INVALID_ARGUMENT;
  VL1__ArrayOfInt passes;
  passes.__sizeint = count;
  passes.int_ = const_cast<int*>(passIDs);
  int soapError = VLServiceCall(
      *client, client->m_StreamAPI, VL_SERVICE_OPERATION(StreamAPI, getTitleListingsPurchasedForPasses),
      [&passes](_VL1__getTitleListingsPurchasedForPasses& request) { request.Passes = &passes; },
      VLInto(VLUtilities::VL1__ArrayOfTitleListingPurchasedForPass2VL_WS_TitleListingPurchasedForPassArray, *titles));
  return VLUtilities::To_VL_WS_Status(soapError);
}
