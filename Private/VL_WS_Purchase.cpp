// Purchase operations of the client: buying with saved billing data, tax, billing data and
// prepaid balance, gift certificates, and the account's purchased titles and rentals.
#include "VLRecord.h"
#include "VLUtilities.h"
#include "VL_WS.h"
#include "VL_WS_Call.h"
#include "VL_WS_Client.h"

namespace {

// A required text argument: given and not empty.
bool Given(const char* text) { return text != 0 && *text != 0; }

}  // namespace

extern "C" VL_WS_Status VL_WS_doPurchaseSavedBilling(VL_WS_Handle* handle, int skuID, const char* ipAddress,
                                                     bool usePrePaidFunds, VL_WS_PurchaseResponse* answer) {
  VL_WS_Client* client = VLBeginCall(handle, answer);
  if (client == 0 || !Given(ipAddress)) return VL_WS_E_INVALID_ARGUMENT;
  bool answered = false;
  int error = VLCallInto(
      client->m_StreamDownloadAPI, "doPurchaseSavedbilling", &StreamDownloadAPI::doPurchaseSavedbilling,
      [&](_VL1__doPurchaseSavedbilling& request) {
        request.SkuID = skuID;
        request.IPAddress = const_cast<char*>(ipAddress);
        request.UsePrePaidFunds = const_cast<char*>(usePrePaidFunds ? "yes" : "no");
      },
      &_VL1__doPurchaseSavedbillingResponse::doPurchaseSavedbillingResult,
      VLUtilities::VL1__PurchaseResponse2VL_WS_PurchaseResponse, *answer, &answered);
  // The store takes a bought title off the wishlist: the cached pages and flags are out of date.
  CacheInterface* cache = VLUserData(client);
  if (VLSucceeded(error, answered, answer->ResponseCode) && cache != 0) {
    cache->PurgeUserData("getWishlistItems");
    cache->RemoveAllWishlistFlags();
  }
  return VLFoldedStatus("VL_WS_doPurchaseSavedBilling", error, *answer, "VL_WS_doPurchaseSavedBilling");
}

extern "C" VL_WS_Status VL_WS_calcOrderTax(VL_WS_Handle* handle, int skuID, VL_WS_OrderTaxResponse* tax) {
  VL_WS_Client* client = VLBeginCall(handle, tax);
  if (client == 0) return VL_WS_E_INVALID_ARGUMENT;
  int error = VLCallInto(client->m_StreamAPI, "calcOrderTax", &StreamAPI::calcOrderTax,
                         [skuID](_VL1__calcOrderTax& request) { request.SKUID = skuID; },
                         &_VL1__calcOrderTaxResponse::calcOrderTaxResult,
                         VLUtilities::VL1__CalcOrderTaxResponse2VL_WS_OrderTaxResponse, *tax);
  return VLUtilities::To_VL_WS_Status(error, tax->ResponseCode, "VL_WS_calcOrderTax");
}

extern "C" VL_WS_Status VL_WS_getBillingInfoAndPPCBalance(VL_WS_Handle* handle, VL_WS_BillingInfoAndPPCBalance* info) {
  VL_WS_Client* client = VLBeginCall(handle, info);
  if (client == 0) return VL_WS_E_INVALID_ARGUMENT;
  int error = VLCallInto(client->m_StreamAPI, "getBillingInfoAndPPCBalance", &StreamAPI::getBillingInfoAndPPCBalance,
                         VLNoFields(), &_VL1__getBillingInfoAndPPCBalanceResponse::getBillingInfoAndPPCBalanceResult,
                         VLUtilities::VL1__BillingInfoAndPPCBalanceResponse2VL_WS_BillingInfoAndPPCBalance, *info);
  return VLUtilities::To_VL_WS_Status(error, info->BillingInfo.ResponseCode, "");
}

extern "C" VL_WS_Status VL_WS_getPrePaidCardBalance(VL_WS_Handle* handle, VL_WS_PrePaidCardBalanceResponse* balance) {
  VL_WS_Client* client = VLBeginCall(handle, balance);
  if (client == 0) return VL_WS_E_INVALID_ARGUMENT;
  int error = VLCallInto(client->m_StreamDownloadAPI, "showPrePaidCardBalance",
                         &StreamDownloadAPI::showPrePaidCardBalance, VLNoFields(),
                         &_VL1__showPrePaidCardBalanceResponse::showPrePaidCardBalanceResult,
                         VLUtilities::VL1__PPCardBalanceResponse2VL_WS_PrePaidCardBalanceResponse, *balance);
  return VLFoldedStatus("VL_WS_getPrePaidCardBalance", error, *balance);
}

extern "C" VL_WS_Status VL_WS_assignGiftCertificateToUser(VL_WS_Handle* handle, const char* code,
                                                          VL_WS_GiftCertificateResponse* answer) {
  VL_WS_Client* client = VLBeginCall(handle, answer);
  if (client == 0 || !Given(code)) return VL_WS_E_INVALID_ARGUMENT;
  int error = VLCallInto(
      client->m_StreamDownloadAPI, "assignGiftCertificateToUser", &StreamDownloadAPI::assignGiftCertificateToUser,
      [code](_VL1__assignGiftCertificateToUser& request) { request.GiftCertificateCode = const_cast<char*>(code); },
      &_VL1__assignGiftCertificateToUserResponse::assignGiftCertificateToUserResult,
      VLUtilities::VL1__GiftCertificateResponse2VL_WS_GiftCertificateResponse, *answer);
  return VLFoldedStatus("VL_WS_assignGiftCertificateToUser", error, *answer, "VL_WS_assignGiftCertificateToUser");
}

extern "C" VL_WS_Status VL_WS_checkRentalExpiration(VL_WS_Handle* handle, int passID,
                                                    VL_WS_RentalExpirationResponse* answer) {
  VL_WS_Client* client = VLBeginCall(handle, answer);
  if (client == 0) return VL_WS_E_INVALID_ARGUMENT;
  int error = VLCallInto(client->m_StreamDownloadAPI, "checkRentalExpiration",
                         &StreamDownloadAPI::checkRentalExpiration,
                         [passID](_VL1__checkRentalExpiration& request) { request.PassId = passID; },
                         &_VL1__checkRentalExpirationResponse::checkRentalExpirationResult,
                         VLUtilities::VL1__CheckRentalExpirationResponse2VL_WS_RentalExpirationResponse, *answer);
  return VLFoldedStatus("VL_WS_checkRentalExpiration", error, *answer);
}

extern "C" VL_WS_Status VL_WS_checkForPurchasedTitle(VL_WS_Handle* handle, int titleID, bool* purchased) {
  VL_WS_Client* client = VLBeginCall(handle, purchased);
  if (client == 0) return VL_WS_E_INVALID_ARGUMENT;
  // The handle's access type, which VL_WS_getFileType may have changed, chooses the service.
  int error = client->m_Params.AccessType == DOWNLOAD
                  ? VLCall(client->m_DownloadAPI, "checkForPurchasedTitle", &DownloadAPI::checkForPurchasedTitle,
                           [titleID](_VL1__checkForPurchasedTitle& request) { request.TitleID = titleID; },
                           [purchased](const _VL1__checkForPurchasedTitleResponse& response) {
                             *purchased = response.checkForPurchasedTitleResult == true_;
                           })
                  : VLCall(client->m_StreamAPI, "checkForPurchasedStreamByTitleID",
                           &StreamAPI::checkForPurchasedStreamByTitleID,
                           [titleID](_VL1__checkForPurchasedStreamByTitleID& request) { request.TitleID = titleID; },
                           [purchased](const _VL1__checkForPurchasedStreamByTitleIDResponse& response) {
                             *purchased = response.checkForPurchasedStreamByTitleIDResult == true_;
                           });
  return VLBoolStatus("VL_WS_checkForPurchasedTitle", error, *purchased);
}

extern "C" VL_WS_Status VL_WS_checkForPurchasedSku(VL_WS_Handle* handle, int skuID, bool* purchased) {
  VL_WS_Client* client = VLBeginCall(handle, purchased);
  if (client == 0) return VL_WS_E_INVALID_ARGUMENT;
  int error = VLCall(client->m_StreamAPI, "checkForPurchasedStream", &StreamAPI::checkForPurchasedStream,
                     [skuID](_VL1__checkForPurchasedStream& request) { request.SkuID = skuID; },
                     [purchased](const _VL1__checkForPurchasedStreamResponse& response) {
                       *purchased = response.checkForPurchasedStreamResult == true_;
                     });
  return VLBoolStatus("VL_WS_checkForPurchasedSku", error, *purchased);
}

extern "C" VL_WS_Status VL_WS_removeAllMyPurchases(VL_WS_Handle* handle, const char* password,
                                                   VL_WS_StandardResponse* answer) {
  VL_WS_Client* client = VLBeginCall(handle, answer);
  if (client == 0 || !Given(password)) return VL_WS_E_INVALID_ARGUMENT;
  int error = VLCallInto(client->m_StreamAPI, "removeAllMyPurchases", &StreamAPI::removeAllMyPurchases,
                         [password](_VL1__removeAllMyPurchases& request) {
                           request.password = const_cast<char*>(password);
                         },
                         &_VL1__removeAllMyPurchasesResponse::removeAllMyPurchasesResult,
                         VLUtilities::VL1__StandardResponse2VL_WS_StandardResponse, *answer);
  return VLUtilities::To_VL_WS_Status(error, answer->ResponseCode, "");
}

extern "C" VL_WS_Status VL_WS_getTitleListingPurchaseds(VL_WS_Handle* handle, int count, const int* passIDs,
                                                        VL_WS_TitleListingPurchasedForPassArray* titles) {
  VL_WS_Client* client = VLBeginCall(handle, titles);
  if (client == 0 || passIDs == 0 || count < 1) return VL_WS_E_INVALID_ARGUMENT;
  VL1__ArrayOfInt passes;
  passes.__sizeint = count;
  passes.int_ = const_cast<int*>(passIDs);
  int error = VLCallInto(
      client->m_StreamAPI, "getTitleListingsPurchasedForPasses", &StreamAPI::getTitleListingsPurchasedForPasses,
      [&passes](_VL1__getTitleListingsPurchasedForPasses& request) { request.Passes = &passes; },
      &_VL1__getTitleListingsPurchasedForPassesResponse::getTitleListingsPurchasedForPassesResult,
      VLUtilities::VL1__ArrayOfTitleListingPurchasedForPass2VL_WS_TitleListingPurchasedForPassArray, *titles);
  return VLUtilities::To_VL_WS_Status(error);
}
