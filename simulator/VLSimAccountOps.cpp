// VLSimAccountOps: the account, wishlist, purchase and streaming operations of the streaming and
// download services. The account operations that both services offer share one implementation.
#include <strings.h>

#include <algorithm>

#include "VLSimSoap.h"
#include "VLStoreHosts.h"
#include "soapDownloadAPISoap12Service.h"
#include "soapStreamAPISoap12Service.h"

namespace {

const char kNotAuthorisedText[] = "The device is not authorised";
const int kRentalWarningHours = 24;
const int kHeartbeatSeconds = 60;

template <typename Result>
Result* NotAuthorised(struct soap* soap, Result* result) {
  return VLSimReply(soap, result, VLSimCode::kNotAuthorised, kNotAuthorisedText);
}

// The calling account's data; without a valid token, answers kNotAuthorised in result and false.
template <typename Result>
bool AccountData(struct soap* soap, Result* result, VLSimAccountData* data) {
  int account = VLSimAccountOf(soap);
  if (account && VLSimStoreOf(soap).Account(account, data)) return true;
  NotAuthorised(soap, result);
  return false;
}

template <typename Item>
Item** NewPointers(struct soap* soap, size_t count) {
  return static_cast<Item**>(soap_malloc(soap, (count + 1) * sizeof(Item*)));
}

char* BoolText(struct soap* soap, bool value) { return VLSimText(soap, value ? "true" : "false"); }

void FillPurchased(struct soap* soap, const VLSimPass& pass, VL1__TitleListingPurchased* item) {
  const VLSimCatalogue& catalogue = VLSimCatalogueOf(soap);
  const VLSimTitle* title = catalogue.FindTitle(pass.title);
  const VLSimEpisode* episode = pass.episode ? catalogue.FindEpisode(pass.episode) : nullptr;
  VLSimFillTitle(soap, *title, episode, pass.purchaseType, item);
  const VLSimProduct* product = catalogue.FindProduct(pass.sku);
  item->EpisodeID = pass.episode;
  item->TvListingTitleID = title->tv ? title->id : 0;
  item->PurchaseType = static_cast<VL1__StreamAPIPurchaseType>(pass.purchaseType);
  item->Status = static_cast<VL1__WatchStatus>(VLSimStoreOf(soap).WatchStatus(pass));
  item->RentalPeriod = VLSimText(soap, product->rentalHours ? std::to_string(product->rentalHours) + " hours" : "");
  item->PassID = pass.id;
  item->PlayStatus = static_cast<VL1__StreamStatus>(pass.playStatus);
  item->StartTimeSeconds = pass.position;
}

// A page of the account's passes (my videos); watch status 3 (Undefined) takes every pass.
VL1__GetMyVideosResponse* VideoPage(struct soap* soap, VL1__GetMyVideosResponse* response, int page, int itemsPerPage,
                                    int purchaseType, int titleType, int watchStatus) {
  VLSimStore& store = VLSimStoreOf(soap);
  const VLSimCatalogue& catalogue = VLSimCatalogueOf(soap);
  response->CurrentPageNumber = static_cast<short>(std::max(page, 1));
  response->ItemsPerPage = static_cast<short>(itemsPerPage);
  int account = VLSimAccountOf(soap);
  if (!account) return NotAuthorised(soap, response);
  if (itemsPerPage < 1) return VLSimReply(soap, response, VLSimCode::kBadRequest, "ItemsPerPage must be at least 1");
  std::vector<VLSimPass> passes;
  for (const VLSimPass& pass : store.Passes(account)) {
    bool tv = catalogue.FindTitle(pass.title)->tv;
    if ((purchaseType == 0 || purchaseType == 1) && pass.purchaseType != purchaseType) continue;
    if ((titleType == 1 && !tv) || (titleType == 2 && tv)) continue;
    if (watchStatus != 3 && store.WatchStatus(pass) != watchStatus) continue;
    passes.push_back(pass);
  }
  VLSimPage paging = VLSimPaging(static_cast<int>(passes.size()), page, itemsPerPage);
  response->TotalItems = static_cast<short>(passes.size());
  response->TotalPages = static_cast<short>(paging.totalPages);
  response->Titles = soap_new_VL1__ArrayOfTitleListingPurchased(soap);
  response->Titles->__sizeTitleListingPurchased = paging.count;
  response->Titles->TitleListingPurchased = NewPointers<VL1__TitleListingPurchased>(soap, paging.count);
  for (int i = 0; i < paging.count; ++i) {
    VL1__TitleListingPurchased* item = soap_new_VL1__TitleListingPurchased(soap);
    FillPurchased(soap, passes[paging.first + i], item);
    item->TitlePosition = static_cast<short>(paging.first + i + 1);
    response->Titles->TitleListingPurchased[i] = item;
  }
  return VLSimReply(soap, response, 0);
}

// ---- Operations of both account services ----

int AuthorizeDevice(struct soap* soap, _VL1__authorizeDevice* request, _VL1__authorizeDeviceResponse& response) {
  VLSimCall& call = VLSimCallOf(soap);
  VLSimStore& store = VLSimStoreOf(soap);
  VL1__AuthorizeDeviceResponse* result = soap_new_VL1__AuthorizeDeviceResponse(soap);
  response.authorizeDeviceResult = result;
  std::string token;
  int account = 0;
  int code = store.Authorize(std::to_string(request->Pin), call.deviceId, call.deviceType, &token, &account);
  if (code) {
    VLSimReply(soap, result, code, code == VLSimCode::kWrongPin ? "Wrong PIN" : "The account has no free device slot");
    return SOAP_OK;
  }
  VLSimAccountData data;
  store.Account(account, &data);
  result->AuthToken = VLSimText(soap, token);
  result->EmailAddress = VLSimText(soap, data.email);
  result->IsAdultVerificationEnabled = BoolText(soap, data.adultVerification);
  result->DeviceID = VLSimText(soap, call.deviceId);
  result->DeviceName = VLSimText(soap, store.DeviceName(token));
  VLSimReply(soap, result, 0);
  return SOAP_OK;
}

int DeactivateDevice(struct soap* soap, _VL1__deactivateDevice*, _VL1__deactivateDeviceResponse& response) {
  VLSimCall& call = VLSimCallOf(soap);
  VL1__StandardResponse* result = soap_new_VL1__StandardResponse(soap);
  response.deactivateDeviceResult = result;
  if (!VLSimStoreOf(soap).Deactivate(call.token, call.deviceId)) NotAuthorised(soap, result);
  else VLSimReply(soap, result, 0);
  return SOAP_OK;
}

int CheckAuthToken(struct soap* soap, _VL1__checkAuthToken*, _VL1__checkAuthTokenResponse& response) {
  response.checkAuthTokenResult = VLSimAccountOf(soap) ? true_ : false_;
  return SOAP_OK;
}

int Purchase(struct soap* soap, _VL1__doPurchaseSavedbilling* request, _VL1__doPurchaseSavedbillingResponse& response) {
  VL1__PurchaseResponse* result = soap_new_VL1__PurchaseResponse(soap);
  response.doPurchaseSavedbillingResult = result;
  int account = VLSimAccountOf(soap);
  if (!account) {
    NotAuthorised(soap, result);
    return SOAP_OK;
  }
  bool prepaid = request->UsePrePaidFunds && strcasecmp(request->UsePrePaidFunds, "yes") == 0;
  VLSimPurchase purchase =
      VLSimStoreOf(soap).Purchase(account, request->SkuID, request->IPAddress ? request->IPAddress : "", prepaid);
  static const char* const kMessages[] = {"OK", kNotAuthorisedText, "Unknown SKU", "The title is already owned",
                                          "Not enough prepaid funds", "No saved billing information",
                                          "The client IP address is missing"};
  result->PassID = purchase.pass;
  result->TransactionId = purchase.transaction;
  if (!purchase.authNumber.empty()) result->TransactionAuthNum = VLSimText(soap, purchase.authNumber);
  VLSimReply(soap, result, purchase.code, kMessages[purchase.code]);
  return SOAP_OK;
}

int RentalExpiration(struct soap* soap, _VL1__checkRentalExpiration* request,
                     _VL1__checkRentalExpirationResponse& response) {
  VLSimStore& store = VLSimStoreOf(soap);
  VL1__CheckRentalExpirationResponse* result = soap_new_VL1__CheckRentalExpirationResponse(soap);
  response.checkRentalExpirationResult = result;
  int account = VLSimAccountOf(soap);
  VLSimPass pass;
  if (!account) {
    NotAuthorised(soap, result);
  } else if (!store.FindPass(account, request->PassId, &pass)) {
    VLSimReply(soap, result, VLSimCode::kUnknownItem, "Unknown pass");
  } else {
    if (pass.expires) {
      long left = static_cast<long>(pass.expires - store.Now());
      result->HoursRemaining = left > 0 ? static_cast<int>((left + 3599) / 3600) : 0;
      result->ShouldDisplay = result->HoursRemaining <= kRentalWarningHours ? true_ : false_;
    }
    VLSimReply(soap, result, 0);
  }
  return SOAP_OK;
}

VL1__BillingInfoResponse* BillingInfo(struct soap* soap) {
  VL1__BillingInfoResponse* result = soap_new_VL1__BillingInfoResponse(soap);
  VLSimAccountData data;
  if (!AccountData(soap, result, &data)) return result;
  if (data.ccLastFour.empty()) return VLSimReply(soap, result, VLSimCode::kNoBillingInfo, "No saved billing information");
  result->CCLastFour = VLSimText(soap, data.ccLastFour);
  result->CCTypeId = data.ccTypeId;
  result->CCType = VLSimText(soap, data.ccType);
  return VLSimReply(soap, result, 0);
}

VL1__PPCardBalanceResponse* PrepaidBalance(struct soap* soap) {
  VL1__PPCardBalanceResponse* result = soap_new_VL1__PPCardBalanceResponse(soap);
  VLSimAccountData data;
  if (!AccountData(soap, result, &data)) return result;
  result->Balance = data.prepaidCents;
  return VLSimReply(soap, result, 0);
}

int GetBillingInfo(struct soap* soap, _VL1__getBillingInfo*, _VL1__getBillingInfoResponse& response) {
  response.getBillingInfoResult = BillingInfo(soap);
  return SOAP_OK;
}

int ShowPrePaidCardBalance(struct soap* soap, _VL1__showPrePaidCardBalance*,
                           _VL1__showPrePaidCardBalanceResponse& response) {
  response.showPrePaidCardBalanceResult = PrepaidBalance(soap);
  return SOAP_OK;
}

int GetEmailAddress(struct soap* soap, _VL1__getEmailAddress*, _VL1__getEmailAddressResponse& response) {
  VL1__GetEmailAddressResponse* result = soap_new_VL1__GetEmailAddressResponse(soap);
  response.getEmailAddressResult = result;
  VLSimAccountData data;
  if (!AccountData(soap, result, &data)) return SOAP_OK;
  result->EmailAddress = VLSimText(soap, data.email);
  VLSimReply(soap, result, 0);
  return SOAP_OK;
}

int GetSettingsPageInfo(struct soap* soap, _VL1__getSettingsPageInfo*, _VL1__getSettingsPageInfoResponse& response) {
  VLSimCall& call = VLSimCallOf(soap);
  VL1__SettingsPageInfo* result = soap_new_VL1__SettingsPageInfo(soap);
  response.getSettingsPageInfoResult = result;
  VLSimAccountData data;
  if (!AccountData(soap, result, &data)) return SOAP_OK;
  result->Account = VLSimText(soap, data.email);
  result->DeviceID = VLSimText(soap, call.deviceId);
  result->DeviceName = VLSimText(soap, VLSimStoreOf(soap).DeviceName(call.token));
  VLSimReply(soap, result, 0);
  return SOAP_OK;
}

int AssignGiftCertificate(struct soap* soap, _VL1__assignGiftCertificateToUser* request,
                          _VL1__assignGiftCertificateToUserResponse& response) {
  VL1__GiftCertificateResponse* result = soap_new_VL1__GiftCertificateResponse(soap);
  response.assignGiftCertificateToUserResult = result;
  int balance = 0;
  int code = VLSimStoreOf(soap).RedeemGift(VLSimAccountOf(soap),
                                           request->GiftCertificateCode ? request->GiftCertificateCode : "", &balance);
  static const char* const kMessages[] = {"OK", "Unknown gift certificate", "The gift certificate was already used",
                                          kNotAuthorisedText};
  result->Balance = balance;
  VLSimReply(soap, result, code, kMessages[code]);
  return SOAP_OK;
}

int GetWishlistItems(struct soap* soap, _VL1__getWishlistItems* request, _VL1__getWishlistItemsResponse& response) {
  VL1__GetWishlistItemsResponse* result = soap_new_VL1__GetWishlistItemsResponse(soap);
  response.getWishlistItemsResult = result;
  result->SortOrder = request->sortOrder >= 0 && request->sortOrder <= 3 ? request->sortOrder : 0;
  result->CurrentPageNumber = static_cast<short>(std::max(request->CurrentPageNumber, 1));
  result->ItemsPerPage = static_cast<short>(request->ItemsPerPage);
  int account = VLSimAccountOf(soap);
  if (!account) {
    NotAuthorised(soap, result);
    return SOAP_OK;
  }
  if (request->ItemsPerPage < 1) {
    VLSimReply(soap, result, VLSimCode::kBadRequest, "ItemsPerPage must be at least 1");
    return SOAP_OK;
  }
  const VLSimCatalogue& catalogue = VLSimCatalogueOf(soap);
  std::vector<int> titles = VLSimStoreOf(soap).Wishlist(account, result->SortOrder, request->TitleType);
  VLSimPage paging = VLSimPaging(static_cast<int>(titles.size()), request->CurrentPageNumber, request->ItemsPerPage);
  result->TotalItems = static_cast<short>(titles.size());
  result->TotalPages = static_cast<short>(paging.totalPages);
  result->Titles = soap_new_VL1__ArrayOfTitleListingPurchased(soap);
  result->Titles->__sizeTitleListingPurchased = paging.count;
  result->Titles->TitleListingPurchased = NewPointers<VL1__TitleListingPurchased>(soap, paging.count);
  for (int i = 0; i < paging.count; ++i) {
    VL1__TitleListingPurchased* item = soap_new_VL1__TitleListingPurchased(soap);
    VLSimFillTitle(soap, *catalogue.FindTitle(titles[paging.first + i]), nullptr, 2, item);
    item->TitlePosition = static_cast<short>(paging.first + i + 1);
    item->Status = VL1__WatchStatus__Undefined;
    result->Titles->TitleListingPurchased[i] = item;
  }
  VLSimReply(soap, result, 0);
  return SOAP_OK;
}

// Runs a wishlist change for the calling account.
template <typename Change>
VL1__WishListActionResponse* WishlistAction(struct soap* soap, Change change) {
  VL1__WishListActionResponse* result = soap_new_VL1__WishListActionResponse(soap);
  int account = VLSimAccountOf(soap);
  if (!account) return NotAuthorised(soap, result);
  int code = change(VLSimStoreOf(soap), account);
  return VLSimReply(soap, result, code, code ? "Unknown title" : "");
}

int AddItemToWishlist(struct soap* soap, _VL1__addItemToWishlist* request, _VL1__addItemToWishlistResponse& response) {
  int title = request->TitleID;
  response.addItemToWishlistResult =
      WishlistAction(soap, [title](VLSimStore& store, int account) { return store.WishlistAdd(account, title); });
  return SOAP_OK;
}

int RemoveItemFromWishList(struct soap* soap, _VL1__removeItemFromWishList* request,
                           _VL1__removeItemFromWishListResponse& response) {
  int title = request->TitleID;
  response.removeItemFromWishListResult =
      WishlistAction(soap, [title](VLSimStore& store, int account) { return store.WishlistRemove(account, title); });
  return SOAP_OK;
}

int RemoveAllItemsFromWishList(struct soap* soap, _VL1__removeAllItemsFromWishList*,
                               _VL1__removeAllItemsFromWishListResponse& response) {
  response.removeAllItemsFromWishListResult = WishlistAction(soap, [](VLSimStore& store, int account) {
    store.WishlistClear(account);
    return 0;
  });
  return SOAP_OK;
}

int CheckAdultVerificationEnabled(struct soap* soap, _VL1__checkAdultVerificationEnabled*,
                                  _VL1__checkAdultVerificationEnabledResponse& response) {
  VL1__CheckAdultVerificationEnabledResponse* result = soap_new_VL1__CheckAdultVerificationEnabledResponse(soap);
  response.checkAdultVerificationEnabledResult = result;
  VLSimAccountData data;
  if (!AccountData(soap, result, &data)) return SOAP_OK;
  result->IsAdultVerificationEnabled = BoolText(soap, data.adultVerification);
  VLSimReply(soap, result, 0);
  return SOAP_OK;
}

int CheckAdultVerificationPin(struct soap* soap, _VL1__checkAdultVerificationPin* request,
                              _VL1__checkAdultVerificationPinResponse& response) {
  VL1__CheckAdultVerificationPinResponse* result = soap_new_VL1__CheckAdultVerificationPinResponse(soap);
  response.checkAdultVerificationPinResult = result;
  VLSimAccountData data;
  if (!AccountData(soap, result, &data)) return SOAP_OK;
  result->IsPinVerified = request->Pin && data.adultPin == request->Pin ? true_ : false_;
  VLSimReply(soap, result, 0);
  return SOAP_OK;
}

int GetConfig(struct soap* soap, _VL1__getConfig*, _VL1__getConfigResponse& response) {
  VL1__GetConfigResponse* result = soap_new_VL1__GetConfigResponse(soap);
  response.getConfigResult = result;
  std::vector<std::pair<std::string, std::string>> items = VLSimStoreOf(soap).ConfigItems();
  result->ConfigurationSet = soap_new_VL1__ArrayOfConfigurationItemOfString(soap);
  result->ConfigurationSet->__sizeConfiguration = static_cast<int>(items.size());
  result->ConfigurationSet->Configuration = NewPointers<VL1__ConfigurationItemOfString>(soap, items.size());
  for (size_t i = 0; i < items.size(); ++i) {
    VL1__ConfigurationItemOfString* item = soap_new_VL1__ConfigurationItemOfString(soap);
    item->Key = VLSimText(soap, items[i].first);
    item->Value = VLSimText(soap, items[i].second);
    result->ConfigurationSet->Configuration[i] = item;
  }
  VLSimReply(soap, result, 0);
  return SOAP_OK;
}

int CountryID(struct soap* soap, _VL1__GetCountryID*, _VL1__GetCountryIDResponse& response) {
  VLSimAccountData data;
  int account = VLSimAccountOf(soap);
  response.GetCountryIDResult = account && VLSimStoreOf(soap).Account(account, &data) ? data.country : 1;
  return SOAP_OK;
}

// getMyStreamingVideos and getMyVideos: the same fields under two element names.
template <typename Request>
VL1__GetMyVideosResponse* MyVideos(struct soap* soap, const Request* request) {
  return VideoPage(soap, soap_new_VL1__GetMyVideosResponse(soap), request->CurrentPageNumber, request->ItemsPerPage,
                   request->PurchaseType, request->TitleType, request->WatchStatusFilter);
}

xsd__boolean OwnsTitle(struct soap* soap, int title) {
  int account = VLSimAccountOf(soap);
  return account && VLSimStoreOf(soap).OwnsTitle(account, title) ? true_ : false_;
}

VL1__GetStreamingAssetLocationResponse* Location(struct soap* soap, int code, const VLSimStream& stream) {
  static const char* const kMessages[] = {"OK", kNotAuthorisedText, "Unknown pass or asset", "The rental has expired",
                                          "The file profile is not available", "No previous stream"};
  VL1__GetStreamingAssetLocationResponse* result = soap_new_VL1__GetStreamingAssetLocationResponse(soap);
  if (code) return VLSimReply(soap, result, code, kMessages[code]);
  const std::string base = "https://" VL_STORE_PRODUCTION_HOST;
  const char* profile = soap_VL1__FileProfile2s(soap, static_cast<VL1__FileProfile>(stream.profile));
  result->StreamingAssetLocation = VLSimText(soap, base + "/media/stream/" + stream.id + "/" + profile + ".mp4");
  result->AssetID = stream.pass ? stream.pass : stream.bonus;
  result->StreamID = VLSimText(soap, stream.id);
  result->DRMServerURL = VLSimText(soap, base + "/drm/license");
  result->DRMACKServerURL = VLSimText(soap, base + "/drm/ack");
  result->Status = static_cast<VL1__StreamStatus>(stream.status);
  result->StartTimeSeconds = stream.startSeconds;
  result->HeartbeatURL = VLSimText(soap, base + "/stream/heartbeat/" + stream.id);
  result->HeartbeatPollInSeconds = kHeartbeatSeconds;
  return VLSimReply(soap, result, 0);
}

VL1__THXMediaDirectorResponse* THX(struct soap* soap, int code, const std::string& subject, int profile, int audio) {
  VL1__THXMediaDirectorResponse* result = soap_new_VL1__THXMediaDirectorResponse(soap);
  if (code) return VLSimReply(soap, result, code, "No THX media director settings");
  std::string profileName = soap_VL1__FileProfile2s(soap, static_cast<VL1__FileProfile>(profile));
  std::string audioName = soap_VL1__AudioProfile2s(soap, static_cast<VL1__AudioProfile>(audio));
  result->LongFormat = VLSimText(soap, "THX media director: " + subject + ", " + profileName + ", " + audioName);
  result->ShortFormat = VLSimText(soap, "THX:" + profileName + ":" + audioName);
  return VLSimReply(soap, result, 0);
}

VL1__StandardResponse* Standard(struct soap* soap, int code, const char* message) {
  return VLSimReply(soap, soap_new_VL1__StandardResponse(soap), code, message);
}

}  // namespace

// Each of these account operations is offered by both account services with the same elements.
#define VL_SIM_ACCOUNT_OPERATION(operation, function) \
  VL_SIM_SHARED_OPERATION(StreamAPISoap12Service, DownloadAPISoap12Service, operation, function)

VL_SIM_ACCOUNT_OPERATION(authorizeDevice, AuthorizeDevice)
VL_SIM_ACCOUNT_OPERATION(deactivateDevice, DeactivateDevice)
VL_SIM_ACCOUNT_OPERATION(checkAuthToken, CheckAuthToken)
VL_SIM_ACCOUNT_OPERATION(doPurchaseSavedbilling, Purchase)
VL_SIM_ACCOUNT_OPERATION(checkRentalExpiration, RentalExpiration)
VL_SIM_ACCOUNT_OPERATION(getBillingInfo, GetBillingInfo)
VL_SIM_ACCOUNT_OPERATION(showPrePaidCardBalance, ShowPrePaidCardBalance)
VL_SIM_ACCOUNT_OPERATION(getEmailAddress, GetEmailAddress)
VL_SIM_ACCOUNT_OPERATION(getSettingsPageInfo, GetSettingsPageInfo)
VL_SIM_ACCOUNT_OPERATION(assignGiftCertificateToUser, AssignGiftCertificate)
VL_SIM_ACCOUNT_OPERATION(getWishlistItems, GetWishlistItems)
VL_SIM_ACCOUNT_OPERATION(addItemToWishlist, AddItemToWishlist)
VL_SIM_ACCOUNT_OPERATION(removeItemFromWishList, RemoveItemFromWishList)
VL_SIM_ACCOUNT_OPERATION(removeAllItemsFromWishList, RemoveAllItemsFromWishList)
VL_SIM_ACCOUNT_OPERATION(checkAdultVerificationEnabled, CheckAdultVerificationEnabled)
VL_SIM_ACCOUNT_OPERATION(checkAdultVerificationPin, CheckAdultVerificationPin)
VL_SIM_ACCOUNT_OPERATION(getConfig, GetConfig)
VL_SIM_ACCOUNT_OPERATION(GetCountryID, CountryID)

// ---- Operations with a name of their own in each service ----

int StreamAPISoap12Service::getMyStreamingVideos(_VL1__getMyStreamingVideos* request,
                                                 _VL1__getMyStreamingVideosResponse& response) {
  response.getMyStreamingVideosResult = MyVideos(soap, request);
  return SOAP_OK;
}

int DownloadAPISoap12Service::getMyVideos(_VL1__getMyVideos* request, _VL1__getMyVideosResponse& response) {
  response.getMyVideosResult = MyVideos(soap, request);
  return SOAP_OK;
}

int StreamAPISoap12Service::checkForPurchasedStreamByTitleID(_VL1__checkForPurchasedStreamByTitleID* request,
                                                             _VL1__checkForPurchasedStreamByTitleIDResponse& response) {
  response.checkForPurchasedStreamByTitleIDResult = OwnsTitle(soap, request->TitleID);
  return SOAP_OK;
}

int DownloadAPISoap12Service::checkForPurchasedTitle(_VL1__checkForPurchasedTitle* request,
                                                     _VL1__checkForPurchasedTitleResponse& response) {
  response.checkForPurchasedTitleResult = OwnsTitle(soap, request->TitleID);
  return SOAP_OK;
}

// ---- Streaming service only ----

int StreamAPISoap12Service::checkForPurchasedStream(_VL1__checkForPurchasedStream* request,
                                                    _VL1__checkForPurchasedStreamResponse& response) {
  int account = VLSimAccountOf(soap);
  response.checkForPurchasedStreamResult = account && VLSimStoreOf(soap).OwnsSku(account, request->SkuID) ? true_ : false_;
  return SOAP_OK;
}

int StreamAPISoap12Service::getTitleListingsPurchasedForPasses(
    _VL1__getTitleListingsPurchasedForPasses* request, _VL1__getTitleListingsPurchasedForPassesResponse& response) {
  int account = VLSimAccountOf(soap);
  int count = request->Passes ? request->Passes->__sizeint : 0;
  VL1__ArrayOfTitleListingPurchasedForPass* result = soap_new_VL1__ArrayOfTitleListingPurchasedForPass(soap);
  result->__sizeTitleListingPurchasedForPass = count;
  result->TitleListingPurchasedForPass = NewPointers<VL1__TitleListingPurchasedForPass>(soap, count);
  for (int i = 0; i < count; ++i) {
    VL1__TitleListingPurchasedForPass* item = soap_new_VL1__TitleListingPurchasedForPass(soap);
    VLSimPass pass;
    if (!account) {
      NotAuthorised(soap, item);
    } else if (!VLSimStoreOf(soap).FindPass(account, request->Passes->int_[i], &pass)) {
      item->PassID = request->Passes->int_[i];
      VLSimReply(soap, item, VLSimCode::kUnknownItem, "Unknown pass");
    } else {
      FillPurchased(soap, pass, item);
      VLSimReply(soap, item, 0);
    }
    result->TitleListingPurchasedForPass[i] = item;
  }
  response.getTitleListingsPurchasedForPassesResult = result;
  return SOAP_OK;
}

int StreamAPISoap12Service::getTitleListingPurchasedForPass(_VL1__getTitleListingPurchasedForPass*,
                                                            _VL1__getTitleListingPurchasedForPassResponse&) {
  return soap_receiver_fault(soap, "The store simulator does not serve this operation", nullptr);
}

int StreamAPISoap12Service::getBillingInfoAndPPCBalance(_VL1__getBillingInfoAndPPCBalance*,
                                                        _VL1__getBillingInfoAndPPCBalanceResponse& response) {
  VL1__BillingInfoAndPPCBalanceResponse* result = soap_new_VL1__BillingInfoAndPPCBalanceResponse(soap);
  result->BillingInfo = BillingInfo(soap);
  result->PPCardBalance = PrepaidBalance(soap);
  VLSimCallOf(soap).entry->responseCode = result->BillingInfo->ResponseCode;
  response.getBillingInfoAndPPCBalanceResult = result;
  return SOAP_OK;
}

int StreamAPISoap12Service::manageStreamInstanceStatus(_VL1__manageStreamInstanceStatus* request,
                                                       _VL1__manageStreamInstanceStatusResponse& response) {
  int account = VLSimAccountOf(soap);
  if (!account) {
    response.manageStreamInstanceStatusResult = Standard(soap, VLSimCode::kNotAuthorised, kNotAuthorisedText);
    return SOAP_OK;
  }
  int code = VLSimStoreOf(soap).ReportStream(account, request->StreamID ? request->StreamID : "", request->Status,
                                             request->StopTimeSeconds);
  response.manageStreamInstanceStatusResult = Standard(soap, code, code ? "Unknown stream" : "");
  return SOAP_OK;
}

int StreamAPISoap12Service::getStreamingAssetLocation(_VL1__getStreamingAssetLocation* request,
                                                      _VL1__getStreamingAssetLocationResponse& response) {
  int account = VLSimAccountOf(soap);
  VLSimStream stream;
  int code = account ? VLSimStoreOf(soap).StartStream(account, request->PassID, request->FileProfile, &stream)
                     : VLSimCode::kNotAuthorised;
  response.getStreamingAssetLocationResult = Location(soap, code, stream);
  return SOAP_OK;
}

int StreamAPISoap12Service::loadLastStreamingAssetLocationForPass(
    _VL1__loadLastStreamingAssetLocationForPass* request, _VL1__loadLastStreamingAssetLocationForPassResponse& response) {
  int account = VLSimAccountOf(soap);
  VLSimStream stream;
  int code = account ? VLSimStoreOf(soap).LastStream(account, request->PassID, &stream) : VLSimCode::kNotAuthorised;
  response.loadLastStreamingAssetLocationForPassResult = Location(soap, code, stream);
  return SOAP_OK;
}

int StreamAPISoap12Service::getBonusAssetLocation(_VL1__getBonusAssetLocation* request,
                                                  _VL1__getBonusAssetLocationResponse& response) {
  VLSimStream stream;
  int code = VLSimStoreOf(soap).StartBonusStream(request->BonusAssetID, &stream);
  response.getBonusAssetLocationResult = Location(soap, code, stream);
  return SOAP_OK;
}

int StreamAPISoap12Service::removeAllMyPurchases(_VL1__removeAllMyPurchases* request,
                                                 _VL1__removeAllMyPurchasesResponse& response) {
  int code = VLSimStoreOf(soap).RemoveAllPurchases(VLSimAccountOf(soap), request->password ? request->password : "");
  static const char* const kMessages[] = {"OK", kNotAuthorisedText, "Wrong password"};
  response.removeAllMyPurchasesResult = Standard(soap, code, kMessages[code]);
  return SOAP_OK;
}

int StreamAPISoap12Service::ReturnError(_VL1__ReturnError*, _VL1__ReturnErrorResponse& response) {
  response.ReturnErrorResult = Standard(soap, VLSimCode::kReturnError, "ReturnError always fails");
  return SOAP_OK;
}

int StreamAPISoap12Service::ReturnTimeout(_VL1__ReturnTimeout*, _VL1__ReturnTimeoutResponse& response) {
  VLSimContext& context = *VLSimCallOf(soap).context;
  if (!context.stop.Sleep(context.options.returnTimeoutSeconds * 1000))
    return soap_receiver_fault(soap, "The simulator is stopping", nullptr);
  response.ReturnTimeoutResult = Standard(soap, 0, "");
  return SOAP_OK;
}

int StreamAPISoap12Service::calcOrderTax(_VL1__calcOrderTax* request, _VL1__calcOrderTaxResponse& response) {
  VL1__CalcOrderTaxResponse* result = soap_new_VL1__CalcOrderTaxResponse(soap);
  response.calcOrderTaxResult = result;
  VLSimTax tax;
  int code = VLSimStoreOf(soap).OrderTax(VLSimAccountOf(soap), request->SKUID, &tax);
  static const char* const kMessages[] = {"OK", kNotAuthorisedText, "Unknown SKU", "No billing address for the tax"};
  if (!code) {
    result->SubTotal = VLSimText(soap, tax.subTotal);
    result->Tax = VLSimText(soap, tax.tax);
    result->TotalPrice = VLSimText(soap, tax.total);
  }
  VLSimReply(soap, result, code, kMessages[code]);
  return SOAP_OK;
}

int StreamAPISoap12Service::getAudioDefaultProperty(_VL1__getAudioDefaultProperty*,
                                                    _VL1__getAudioDefaultPropertyResponse& response) {
  VLSimAccountData data;
  int account = VLSimAccountOf(soap);
  response.getAudioDefaultPropertyResult =
      static_cast<VL1__AudioProfile>(account && VLSimStoreOf(soap).Account(account, &data) ? data.audioDefault : 0);
  return SOAP_OK;
}

int StreamAPISoap12Service::setAudioDefaultProperty(_VL1__setAudioDefaultProperty* request,
                                                    _VL1__setAudioDefaultPropertyResponse& response) {
  int account = VLSimAccountOf(soap);
  if (account) VLSimStoreOf(soap).SetAudioDefault(account, request->AudioSetting);
  response.setAudioDefaultPropertyResult =
      account ? Standard(soap, 0, "") : Standard(soap, VLSimCode::kNotAuthorised, kNotAuthorisedText);
  return SOAP_OK;
}

int StreamAPISoap12Service::getTHXMediaDirector(_VL1__getTHXMediaDirector* request,
                                                _VL1__getTHXMediaDirectorResponse& response) {
  int account = VLSimAccountOf(soap);
  VLSimPass pass;
  const VLSimTitle* title = nullptr;
  int code = VLSimCode::kNotAuthorised;
  if (account && VLSimStoreOf(soap).FindPass(account, request->PassID, &pass)) {
    title = VLSimCatalogueOf(soap).FindTitle(pass.title);
    code = title->thx ? 0 : VLSimCode::kNoTHX;
  } else if (account) {
    code = VLSimCode::kUnknownItem;
  }
  response.getTHXMediaDirectorResult =
      THX(soap, code, title ? title->name : "", request->FileProfile, request->AudioSetting);
  return SOAP_OK;
}

int StreamAPISoap12Service::getTHXMediaDirectorBonusAsset(_VL1__getTHXMediaDirectorBonusAsset* request,
                                                          _VL1__getTHXMediaDirectorBonusAssetResponse& response) {
  const VLSimCatalogue& catalogue = VLSimCatalogueOf(soap);
  const VLSimBonus* bonus = catalogue.FindBonus(request->BonusAssetID);
  const VLSimTitle* title = bonus ? catalogue.FindTitle(bonus->title) : nullptr;
  int code = !title ? VLSimCode::kUnknownItem : title->thxTrailer ? 0 : VLSimCode::kNoTHX;
  response.getTHXMediaDirectorBonusAssetResult =
      THX(soap, code, title ? title->name + " trailer" : "", request->FileProfile, 0);
  return SOAP_OK;
}
