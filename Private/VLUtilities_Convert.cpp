// Record conversion: the store's schema records into the client records of the flat interface.
#include <string.h>
#include <time.h>

#include "VLAssert.h"
#include "VLRecord.h"
#include "VLUtilities.h"
#include "soapH.h"

namespace {

char* Text(const char* s) { return VLUtilities::StrDup(s); }

bool Bool(xsd__boolean b) { return b == true_; }

// An XML schema date-time ("2011-05-01T10:20:30", a time zone or fraction after the seconds is
// not looked at) as "2011/05/01 10:20:30"; a missing or unreadable one as the all-zero time.
char* ExpireDate(const char* dateTime) {
  tm time;
  memset(&time, 0, sizeof(time));
  if (dateTime != 0 && strptime(dateTime, "%Y-%m-%dT%H:%M:%S", &time) == 0) {
    memset(&time, 0, sizeof(time));
  }
  return Text(VLUtilities::TM2Str(time).c_str());
}

// Gives the client array one tagged element per schema element and converts each. A missing or
// empty schema array leaves the client array empty; a nil element is converted as an empty one, so
// that its texts are owned empty texts like those of every other element.
template <class SchemaItem, class Array, class Convert>
void ConvertItems(SchemaItem* const* items, int count, Array& array, Convert convert) {
  if (items == 0 || count < 1) return;
  VLRecordNewItems(array, count);
  const SchemaItem empty;
  for (int i = 0; i < count; ++i) convert(items[i] != 0 ? items[i] : &empty, array.Items[i]);
}

void ConvertBonusAssets(const VL1__ArrayOfBonusAsset* t, VL_WS_BonusAssetArray& r) {
  if (t == 0) return;
  ConvertItems(t->BonusAsset, t->__sizeBonusAsset, r,
               [](const VL1__BonusAsset* a, VL_WS_BonusAsset& b) {
                 b.BonusAssetID = a->BonusAssetID;
                 b.Profile = a->Profile;
                 b.BonusType = a->BonusType;
               });
}

void ConvertFileProfiles(const VL1__ArrayOfFileProfile* t, VL_WS_IntArray& r) {
  if (t == 0 || t->FileProfile == 0 || t->__sizeFileProfile < 1) return;
  r.Items = new int[t->__sizeFileProfile];
  r.Count = t->__sizeFileProfile;
  for (int i = 0; i < r.Count; ++i) r.Items[i] = t->FileProfile[i];
}

void ConvertAudioFiles(const VL1__ArrayOfAudioFile* t, VL_WS_AudioFileArray& r) {
  if (t == 0) return;
  ConvertItems(t->AudioFile, t->__sizeAudioFile, r,
               [](const VL1__AudioFile* a, VL_WS_AudioFile& b) {
                 b.AssetAudioID = a->AssetAudioID;
                 b.FileLocation = Text(a->FileLocation);
                 b.ContainsVideo = Bool(a->ContainsVideo);
                 b.AudioAssetProfile = a->AudioAssetProfile;
               });
}

void ConvertProducts(const VL1__ArrayOfProductListing* t, VL_WS_ProductListingArray& r) {
  if (t == 0) return;
  ConvertItems(t->ProductListing, t->__sizeProductListing, r,
               [](const VL1__ProductListing* a, VL_WS_ProductListing& b) {
                 b.SkuID = a->SkuID;
                 b.PurchaseType = a->PurchaseType;
                 b.Price = Text(a->Price);
                 ConvertFileProfiles(a->AvailableAssets, b.AvailableAssets);
                 b.ExpireDate = ExpireDate(a->ExpireDate);
                 ConvertAudioFiles(a->AvailableAudioProfiles, b.AvailableAudioProfiles);
                 b.RentalPeriod = a->RentalPeriod;
               });
}

void ConvertTvEpisodes(const VL1__ArrayOfTvEpisode* t, VL_WS_TvEpisodeArray& r) {
  if (t == 0) return;
  ConvertItems(t->TvEpisode, t->__sizeTvEpisode, r,
               [](const VL1__TvEpisode* a, VL_WS_TvEpisode& b) {
                 b.EpisodeID = a->EpisodeID;
                 b.EpisodeName = Text(a->EpisodeName);
                 b.EpisodeNumber = a->EpisodeNumber;
               });
}

void ConvertPurchasedTitles(const VL1__ArrayOfTitleListingPurchased* t,
                            VL_WS_TitleListingPurchasedArray& r) {
  if (t == 0) return;
  ConvertItems(t->TitleListingPurchased, t->__sizeTitleListingPurchased, r,
               VLUtilities::VL1__TitleListingPurchased2VL_WS_TitleListingPurchased);
}

}  // namespace

void VLUtilities::VL1__StandardResponse2VL_WS_StandardResponse(const VL1__StandardResponse* t,
                                                               VL_WS_StandardResponse& r) {
  VL_ASSERT(t != 0);
  r.ResponseCode = t->ResponseCode;
  r.ResponseMessage = Text(t->ResponseMessage);
}

void VLUtilities::VL1__TitleListing2VL_WS_TitleListing(const VL1__TitleListing* t,
                                                       VL_WS_TitleListing& r) {
  VL_ASSERT(t != 0);
  r.TitleID = t->TitleID;
  r.TitleName = Text(t->TitleName);
  r.BoxArtPrefix = Text(t->BoxArtPrefix);
  r.TitlePosition = t->TitlePosition;
  r.EpisodeNumber = t->EpisodeNumber;
  ConvertBonusAssets(t->BonusAssets, r.BonusAssets);
  r.IsTvListing = Bool(t->IsTvListing);
  r.MPAARating = Text(t->MPAARating);
  ConvertProducts(t->AvailableProducts, r.AvailableProducts);
  r.IsTHXMediaDirectorEnabled = Bool(t->IsTHXMediaDirectorEnabled);
  r.IsTHXMediaDirectorEnabledForTrailer = Bool(t->IsTHXMediaDirectorEnabledForTrailer);
  r.CHVRSRating = Text(t->CHVRSRating);
  r.LoyaltyPointsForBuy = Text(t->LoyaltyPointsForBuy);
  r.LoyaltyPointsForRent = Text(t->LoyaltyPointsForRent);
}

void VLUtilities::VL1__ArrayOfTitleListing2VL_WS_TitleListingArray(
    const VL1__ArrayOfTitleListing* t, VL_WS_TitleListingArray& r) {
  VL_ASSERT(t != 0);
  ConvertItems(t->TitleListing, t->__sizeTitleListing, r, VL1__TitleListing2VL_WS_TitleListing);
}

void VLUtilities::VL1__TitleListingResponse2VL_WS_TitleListingResponse(
    const VL1__TitleListingResponse* t, VL_WS_TitleListingResponse& r) {
  VL_ASSERT(t != 0);
  r.ResponseCode = t->ResponseCode;
  r.ResponseMessage = Text(t->ResponseMessage);
  r.Synopsys = Text(t->Synopsys);
  r.UserRating = t->UserRating;
  r.Directors = Text(t->Directors);
  r.Actors = Text(t->Actors);
  r.Writers = Text(t->Writers);
  r.Producers = Text(t->Producers);
  r.Copyright = Text(t->Copyright);
  r.RunTime = Text(t->RunTime);
  r.RatingReason = Text(t->RatingReason);
  VL1__TitleListing2VL_WS_TitleListing(t, r);
}

void VLUtilities::VL1__ArrayOfTitleListingResponse2VL_WS_TitleListingResponseArray(
    const VL1__ArrayOfTitleListingResponse* t, VL_WS_TitleListingResponseArray& r) {
  VL_ASSERT(t != 0);
  ConvertItems(t->TitleListingResponse, t->__sizeTitleListingResponse, r,
               VL1__TitleListingResponse2VL_WS_TitleListingResponse);
}

void VLUtilities::VL1__GetTitlesResponse2VL_WS_TitlesResponse(const VL1__GetTitlesResponse* t,
                                                              VL_WS_TitlesResponse& r) {
  VL_ASSERT(t != 0);
  VL1__StandardResponse2VL_WS_StandardResponse(t, r);
  r.GenreID = t->GenreID;
  r.CurrentPageNumber = t->CurrentPageNumber;
  r.ItemsPerPage = t->ItemsPerPage;
  r.TotalPages = t->TotalPages;
  r.TotalItems = t->TotalItems;
  if (t->Titles != 0) VL1__ArrayOfTitleListing2VL_WS_TitleListingArray(t->Titles, r.Titles);
}

void VLUtilities::VL1__ArrayOfGetTitlesResponse2VL_WS_TitlesResponseArray(
    const VL1__ArrayOfGetTitlesResponse* t, VL_WS_TitlesResponseArray& r) {
  VL_ASSERT(t != 0);
  ConvertItems(t->GetTitlesResponse, t->__sizeGetTitlesResponse, r,
               VL1__GetTitlesResponse2VL_WS_TitlesResponse);
}

void VLUtilities::VL1__RecommendedTitlesResponse2VL_WS_RecommendedTitlesResponse(
    const VL1__RecommendedTitlesResponse* t, VL_WS_RecommendedTitlesResponse& r) {
  VL_ASSERT(t != 0);
  VL1__StandardResponse2VL_WS_StandardResponse(t, r);
  if (t->Titles != 0) VL1__ArrayOfTitleListing2VL_WS_TitleListingArray(t->Titles, r.Titles);
}

void VLUtilities::VL1__ArrayOfGenre2VL_WS_GenreArray(const VL1__ArrayOfGenre* t,
                                                     VL_WS_GenreArray& r) {
  VL_ASSERT(t != 0);
  ConvertItems(t->Genre, t->__sizeGenre, r, [](const VL1__Genre* a, VL_WS_Genre& b) {
    b.ID = a->ID;
    b.Name = Text(a->Name);
    b.Visible = Bool(a->Visible);
    b.ParentId = a->ParentId;
  });
}

void VLUtilities::VL1__GetGenreLabelResponse2VL_WS_GenreLabelResponse(const VL1__GetGenreLabelResponse* t,
                                                                     VL_WS_GenreLabelResponse& r) {
  VL_ASSERT(t != 0);
  VL1__StandardResponse2VL_WS_StandardResponse(t, r);
  r.Label = Text(t->Label);
  r.LabelMessage = Text(t->LabelMessage);
}

void VLUtilities::VL1__TvEpisodeList2VL_WS_TvEpisodeListResponse(const VL1__TvEpisodeList* t,
                                                                 VL_WS_TvEpisodeListResponse& r) {
  VL_ASSERT(t != 0);
  VL1__StandardResponse2VL_WS_StandardResponse(t, r);
  ConvertTvEpisodes(t->Episodes, r.Episodes);
}

void VLUtilities::VL1__TranslateTivoExternalIDResponse2VL_WS_TranslateTivoExternalIDResponse(
    const VL1__TranslatedTivoExternalIdResponse* t, VL_WS_TranslateTivoExternalIDResponse& r) {
  VL_ASSERT(t != 0);
  r.TivoExternalId = Text(t->TivoExternalId);
  r.TitleId = t->TitleId;
  VL1__StandardResponse2VL_WS_StandardResponse(t, r);
}

void VLUtilities::VL1__TranslateSkuIdResponse2VL_WS_TranslateSkuIDResponse(const VL1__TranslateSkuIdResponse* t,
                                                                           VL_WS_TranslateSkuIDResponse& r) {
  VL_ASSERT(t != 0);
  VL1__StandardResponse2VL_WS_StandardResponse(t, r);
  r.TitleId = t->TitleId;
}

void VLUtilities::VL1__TitleListingPurchased2VL_WS_TitleListingPurchased(
    const VL1__TitleListingPurchased* t, VL_WS_TitleListingPurchased& r) {
  VL_ASSERT(t != 0);
  r.EpisodeID = t->EpisodeID;
  r.TvListingTitleID = t->TvListingTitleID;
  r.PurchaseType = t->PurchaseType;
  r.Status = t->Status;
  r.RentalPeriod = Text(t->RentalPeriod);
  r.PassID = t->PassID;
  r.PlayStatus = t->PlayStatus;
  r.StartTimeSeconds = t->StartTimeSeconds;
  VL1__TitleListing2VL_WS_TitleListing(t, r);
}

void VLUtilities::VL1__GetMyVideosResponse2VL_WS_MyVideosResponse(
    const VL1__GetMyVideosResponse* t, VL_WS_MyVideosResponse& r) {
  VL_ASSERT(t != 0);
  VL1__StandardResponse2VL_WS_StandardResponse(t, r);
  r.CurrentPageNumber = t->CurrentPageNumber;
  r.ItemsPerPage = t->ItemsPerPage;
  r.TotalPages = t->TotalPages;
  r.TotalItems = t->TotalItems;
  ConvertPurchasedTitles(t->Titles, r.Titles);
}

void VLUtilities::VL1__GetWishlistItemsResponse2VL_WS_WishlistItemsResponse(
    const VL1__GetWishlistItemsResponse* t, VL_WS_WishlistItemsResponse& r) {
  VL_ASSERT(t != 0);
  VL1__GetMyVideosResponse2VL_WS_MyVideosResponse(t, r);
  r.SortOrder = t->SortOrder;
}

void VLUtilities::VL1__ArrayOfTitleListingPurchasedForPass2VL_WS_TitleListingPurchasedForPassArray(
    const VL1__ArrayOfTitleListingPurchasedForPass* t, VL_WS_TitleListingPurchasedForPassArray& r) {
  VL_ASSERT(t != 0);
  ConvertItems(t->TitleListingPurchasedForPass, t->__sizeTitleListingPurchasedForPass, r,
               [](const VL1__TitleListingPurchasedForPass* a, VL_WS_TitleListingPurchasedForPass& b) {
                 VL1__TitleListingPurchased2VL_WS_TitleListingPurchased(a, b);
                 b.ResponseCode = a->ResponseCode;
                 b.ResponseMessage = Text(a->ResponseMessage);
               });
}

void VLUtilities::VL1__AuthorizeDeviceResponse2VL_WS_AuthorizeDeviceResponse(
    const VL1__AuthorizeDeviceResponse* t, VL_WS_AuthorizeDeviceResponse& r) {
  VL_ASSERT(t != 0);
  VL1__StandardResponse2VL_WS_StandardResponse(t, r);
  r.AuthToken = Text(t->AuthToken);
  r.EmailAddress = Text(t->EmailAddress);
  r.IsAdultVerificationEnabled = Str2Bool(t->IsAdultVerificationEnabled);
  r.DeviceID = Text(t->DeviceID);
  r.DeviceName = Text(t->DeviceName);
}

void VLUtilities::VL1__GetStreamingAssetLocationResponse2VL_WS_StreamingAssetLocationResponse(
    const VL1__GetStreamingAssetLocationResponse* t, VL_WS_StreamingAssetLocationResponse& r) {
  VL_ASSERT(t != 0);
  VL1__StandardResponse2VL_WS_StandardResponse(t, r);
  r.StreamingAssetLocation = Text(t->StreamingAssetLocation);
  r.AssetID = t->AssetID;
  r.StreamID = Text(t->StreamID);
  r.DRMServerURL = Text(t->DRMServerURL);
  r.DRMACKServerURL = Text(t->DRMACKServerURL);
  r.Status = t->Status;
  r.StartTimeSeconds = t->StartTimeSeconds;
  r.HeartbeatURL = Text(t->HeartbeatURL);
  r.HeartbeatPollInSeconds = t->HeartbeatPollInSeconds;
}

void VLUtilities::VL1__THXMediaDirectorResponse2VL_WS_THXMediaDirectorResponse(
    const VL1__THXMediaDirectorResponse* t, VL_WS_THXMediaDirectorResponse& r) {
  VL_ASSERT(t != 0);
  VL1__StandardResponse2VL_WS_StandardResponse(t, r);
  r.LongFormat = Text(t->LongFormat);
  r.ShortFormat = Text(t->ShortFormat);
}

void VLUtilities::VL1__WishListActionResponse2VL_WS_StandardResponse(const VL1__WishListActionResponse* t,
                                                                     VL_WS_StandardResponse& r) {
  VL_ASSERT(t != 0);
  r.ResponseCode = t->ResponseCode;
  r.ResponseMessage = Text(t->ResponseMessage);
}

void VLUtilities::VL1__PurchaseResponse2VL_WS_PurchaseResponse(const VL1__PurchaseResponse* t,
                                                               VL_WS_PurchaseResponse& r) {
  VL_ASSERT(t != 0);
  VL1__StandardResponse2VL_WS_StandardResponse(t, r);
  r.PassID = t->PassID;
  r.TransactionId = t->TransactionId;
  r.TransactionAuthNum = Text(t->TransactionAuthNum);
}

void VLUtilities::VL1__CalcOrderTaxResponse2VL_WS_OrderTaxResponse(const VL1__CalcOrderTaxResponse* t,
                                                                   VL_WS_OrderTaxResponse& r) {
  VL_ASSERT(t != 0);
  VL1__StandardResponse2VL_WS_StandardResponse(t, r);
  r.SubTotal = Text(t->SubTotal);
  r.TotalPrice = Text(t->TotalPrice);
  r.Tax = Text(t->Tax);
}

void VLUtilities::VL1__BillingInfoResponse2VL_WS_BillingInfoResponse(const VL1__BillingInfoResponse* t,
                                                                     VL_WS_BillingInfoResponse& r) {
  VL_ASSERT(t != 0);
  VL1__StandardResponse2VL_WS_StandardResponse(t, r);
  r.CCLastFour = Text(t->CCLastFour);
  r.CCTypeId = t->CCTypeId;
  r.CCType = Text(t->CCType);
}

void VLUtilities::VL1__PPCardBalanceResponse2VL_WS_PrePaidCardBalanceResponse(
    const VL1__PPCardBalanceResponse* t, VL_WS_PrePaidCardBalanceResponse& r) {
  VL_ASSERT(t != 0);
  VL1__StandardResponse2VL_WS_StandardResponse(t, r);
  r.Balance = t->Balance;
}

void VLUtilities::VL1__BillingInfoAndPPCBalanceResponse2VL_WS_BillingInfoAndPPCBalance(
    const VL1__BillingInfoAndPPCBalanceResponse* t, VL_WS_BillingInfoAndPPCBalance& r) {
  VL_ASSERT(t != 0);
  if (t->BillingInfo != 0) VL1__BillingInfoResponse2VL_WS_BillingInfoResponse(t->BillingInfo, r.BillingInfo);
  if (t->PPCardBalance != 0) VL1__PPCardBalanceResponse2VL_WS_PrePaidCardBalanceResponse(t->PPCardBalance, r.PPCardBalance);
}

void VLUtilities::VL1__GiftCertificateResponse2VL_WS_GiftCertificateResponse(
    const VL1__GiftCertificateResponse* t, VL_WS_GiftCertificateResponse& r) {
  VL_ASSERT(t != 0);
  VL1__StandardResponse2VL_WS_StandardResponse(t, r);
  r.Balance = t->Balance;
}

void VLUtilities::VL1__GetEmailAddressResponse2VL_WS_EmailAddressResponse(
    const VL1__GetEmailAddressResponse* t, VL_WS_EmailAddressResponse& r) {
  VL_ASSERT(t != 0);
  VL1__StandardResponse2VL_WS_StandardResponse(t, r);
  r.EmailAddress = Text(t->EmailAddress);
}

void VLUtilities::VL1__SettingsPageInfo2VL_WS_SettingsPageResponse(const VL1__SettingsPageInfo* t,
                                                                   VL_WS_SettingsPageResponse& r) {
  VL_ASSERT(t != 0);
  VL1__StandardResponse2VL_WS_StandardResponse(t, r);
  r.Account = Text(t->Account);
  r.DeviceID = Text(t->DeviceID);
  r.DeviceName = Text(t->DeviceName);
}

void VLUtilities::VL1__GetConfigResponse2VL_WS_ConfigResponse(const VL1__GetConfigResponse* t,
                                                              VL_WS_ConfigResponse& r) {
  VL_ASSERT(t != 0);
  VL1__StandardResponse2VL_WS_StandardResponse(t, r);
  if (t->ConfigurationSet == 0) return;
  ConvertItems(t->ConfigurationSet->Configuration, t->ConfigurationSet->__sizeConfiguration, r,
               [](const VL1__ConfigurationItemOfString* a, VL_WS_ConfigurationItem& b) {
                 b.Key = Text(a->Key);
                 b.Value = Text(a->Value);
               });
}

void VLUtilities::VL1__CheckAdultVerificationEnabledResponse2VL_WS_AdultVerificationEnabledResponse(
    const VL1__CheckAdultVerificationEnabledResponse* t, VL_WS_AdultVerificationEnabledResponse& r) {
  VL_ASSERT(t != 0);
  VL1__StandardResponse2VL_WS_StandardResponse(t, r);
  r.IsAdultVerificationEnabled = Str2Bool(t->IsAdultVerificationEnabled);
}

void VLUtilities::VL1__CheckAdultVerificationPinResponse2VL_WS_AdultVerificationPinResponse(
    const VL1__CheckAdultVerificationPinResponse* t, VL_WS_AdultVerificationPinResponse& r) {
  VL_ASSERT(t != 0);
  VL1__StandardResponse2VL_WS_StandardResponse(t, r);
  r.IsPinVerified = Bool(t->IsPinVerified);
}

void VLUtilities::VL1__CheckRentalExpirationResponse2VL_WS_RentalExpirationResponse(
    const VL1__CheckRentalExpirationResponse* t, VL_WS_RentalExpirationResponse& r) {
  VL_ASSERT(t != 0);
  VL1__StandardResponse2VL_WS_StandardResponse(t, r);
  r.ShouldDisplay = Bool(t->ShouldDisplay);
  r.HoursRemaining = t->HoursRemaining;
}
