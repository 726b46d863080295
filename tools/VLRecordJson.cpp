#include "VLRecordJson.h"

#include <openssl/evp.h>

#include <vector>

namespace {

// Members(json, record) writes the fields of a record into the open object; a derived record's
// Members writes its base's first. Value(json, x) writes a whole value: a record's object, an
// array, or a plain element of an array.

void Members(VLJsonWriter& json, const VL_WS_StandardResponse& r);
void Members(VLJsonWriter& json, const VL_WS_Version& r);
void Members(VLJsonWriter& json, const VL_WS_EnvListEntry& r);
void Members(VLJsonWriter& json, const VL_WS_FileType& r);
void Members(VLJsonWriter& json, const VL_WS_Genre& r);
void Members(VLJsonWriter& json, const VL_WS_BonusAsset& r);
void Members(VLJsonWriter& json, const VL_WS_AudioFile& r);
void Members(VLJsonWriter& json, const VL_WS_ProductListing& r);
void Members(VLJsonWriter& json, const VL_WS_TitleListing& r);
void Members(VLJsonWriter& json, const VL_WS_TitleListingResponse& r);
void Members(VLJsonWriter& json, const VL_WS_TitlesResponse& r);
void Members(VLJsonWriter& json, const VL_WS_TvEpisode& r);
void Members(VLJsonWriter& json, const VL_WS_TitleListingPurchased& r);
void Members(VLJsonWriter& json, const VL_WS_TitleListingPurchasedForPass& r);
void Members(VLJsonWriter& json, const VL_WS_MyVideosResponse& r);
void Members(VLJsonWriter& json, const VL_WS_BillingInfoResponse& r);
void Members(VLJsonWriter& json, const VL_WS_PrePaidCardBalanceResponse& r);
void Members(VLJsonWriter& json, const VL_WS_ConfigurationItem& r);

void Value(VLJsonWriter& json, int value) { json.Int(value); }
void Value(VLJsonWriter& json, bool value) { json.Bool(value); }

template <class Record>
auto Value(VLJsonWriter& json, const Record& record) -> decltype(Members(json, record)) {
  json.BeginObject();
  Members(json, record);
  json.EndObject();
}

template <class Element>
void Array(VLJsonWriter& json, int count, const Element* items) {
  json.BeginArray();
  for (int i = 0; i < count; ++i) Value(json, items[i]);
  json.EndArray();
}

// An array record: its Count elements of Items.
template <class ArrayRecord>
void Array(VLJsonWriter& json, const ArrayRecord& record) {
  Array(json, record.Count, record.Items);
}

void Field(VLJsonWriter& json, const char* key, int value) {
  json.Key(key);
  json.Int(value);
}
void Field(VLJsonWriter& json, const char* key, bool value) {
  json.Key(key);
  json.Bool(value);
}
void Field(VLJsonWriter& json, const char* key, const char* text) {
  json.Key(key);
  json.String(text);
}
template <class ArrayRecord>
auto Field(VLJsonWriter& json, const char* key, const ArrayRecord& record) -> decltype(record.Items, void()) {
  json.Key(key);
  Array(json, record);
}
template <class Record>
auto Field(VLJsonWriter& json, const char* key, const Record& record) -> decltype(Members(json, record)) {
  json.Key(key);
  Value(json, record);
}

void Members(VLJsonWriter& json, const VL_WS_StandardResponse& r) {
  Field(json, "ResponseCode", r.ResponseCode);
  Field(json, "ResponseMessage", r.ResponseMessage);
}

void Members(VLJsonWriter& json, const VL_WS_Version& r) {
  Field(json, "Major", r.Major);
  Field(json, "Minor", r.Minor);
  Field(json, "Revision", r.Revision);
}

void Members(VLJsonWriter& json, const VL_WS_EnvListEntry& r) {
  Field(json, "EnvNum", r.EnvNum);
  Field(json, "Name", r.Name);
}

void Members(VLJsonWriter& json, const VL_WS_FileType& r) {
  Field(json, "File_DRMProvider", r.File_DRMProvider);
  Field(json, "File_AccessType", r.File_AccessType);
  Field(json, "File_FileProfile", r.File_FileProfile);
  Field(json, "File_VideoFormat", r.File_VideoFormat);
  Field(json, "File_FileExtension", r.File_FileExtension);
}

void Members(VLJsonWriter& json, const VL_WS_Genre& r) {
  Field(json, "ID", r.ID);
  Field(json, "Name", r.Name);
  Field(json, "Visible", r.Visible);
  Field(json, "ParentId", r.ParentId);
}

void Members(VLJsonWriter& json, const VL_WS_BonusAsset& r) {
  Field(json, "BonusAssetID", r.BonusAssetID);
  Field(json, "Profile", r.Profile);
  Field(json, "BonusType", r.BonusType);
}

void Members(VLJsonWriter& json, const VL_WS_AudioFile& r) {
  Field(json, "AssetAudioID", r.AssetAudioID);
  Field(json, "FileLocation", r.FileLocation);
  Field(json, "ContainsVideo", r.ContainsVideo);
  Field(json, "AudioAssetProfile", r.AudioAssetProfile);
}

void Members(VLJsonWriter& json, const VL_WS_ProductListing& r) {
  Field(json, "SkuID", r.SkuID);
  Field(json, "PurchaseType", r.PurchaseType);
  Field(json, "Price", r.Price);
  Field(json, "AvailableAssets", r.AvailableAssets);
  Field(json, "ExpireDate", r.ExpireDate);
  Field(json, "AvailableAudioProfiles", r.AvailableAudioProfiles);
  Field(json, "RentalPeriod", r.RentalPeriod);
}

void Members(VLJsonWriter& json, const VL_WS_TitleListing& r) {
  Field(json, "TitleID", r.TitleID);
  Field(json, "TitleName", r.TitleName);
  Field(json, "BoxArtPrefix", r.BoxArtPrefix);
  Field(json, "TitlePosition", r.TitlePosition);
  Field(json, "EpisodeNumber", r.EpisodeNumber);
  Field(json, "BonusAssets", r.BonusAssets);
  Field(json, "IsTvListing", r.IsTvListing);
  Field(json, "MPAARating", r.MPAARating);
  Field(json, "AvailableProducts", r.AvailableProducts);
  Field(json, "IsTHXMediaDirectorEnabled", r.IsTHXMediaDirectorEnabled);
  Field(json, "IsTHXMediaDirectorEnabledForTrailer", r.IsTHXMediaDirectorEnabledForTrailer);
  Field(json, "CHVRSRating", r.CHVRSRating);
  Field(json, "LoyaltyPointsForBuy", r.LoyaltyPointsForBuy);
  Field(json, "LoyaltyPointsForRent", r.LoyaltyPointsForRent);
}

void Members(VLJsonWriter& json, const VL_WS_TitleListingResponse& r) {
  Members(json, static_cast<const VL_WS_TitleListing&>(r));
  Field(json, "ResponseCode", r.ResponseCode);
  Field(json, "ResponseMessage", r.ResponseMessage);
  Field(json, "Synopsys", r.Synopsys);
  Field(json, "UserRating", r.UserRating);
  Field(json, "Directors", r.Directors);
  Field(json, "Actors", r.Actors);
  Field(json, "Writers", r.Writers);
  Field(json, "Producers", r.Producers);
  Field(json, "Copyright", r.Copyright);
  Field(json, "RunTime", r.RunTime);
  Field(json, "RatingReason", r.RatingReason);
}

// The page fields that title pages, the account's videos and the wishlist share.
template <class Page>
void PageFields(VLJsonWriter& json, const Page& r) {
  Field(json, "CurrentPageNumber", r.CurrentPageNumber);
  Field(json, "ItemsPerPage", r.ItemsPerPage);
  Field(json, "TotalPages", r.TotalPages);
  Field(json, "TotalItems", r.TotalItems);
  Field(json, "Titles", r.Titles);
}

void Members(VLJsonWriter& json, const VL_WS_TitlesResponse& r) {
  Members(json, static_cast<const VL_WS_StandardResponse&>(r));
  Field(json, "GenreID", r.GenreID);
  PageFields(json, r);
}

void Members(VLJsonWriter& json, const VL_WS_TvEpisode& r) {
  Field(json, "EpisodeID", r.EpisodeID);
  Field(json, "EpisodeName", r.EpisodeName);
  Field(json, "EpisodeNumber", r.EpisodeNumber);
}

void Members(VLJsonWriter& json, const VL_WS_TitleListingPurchased& r) {
  Members(json, static_cast<const VL_WS_TitleListing&>(r));
  Field(json, "EpisodeID", r.EpisodeID);
  Field(json, "TvListingTitleID", r.TvListingTitleID);
  Field(json, "PurchaseType", r.PurchaseType);
  Field(json, "Status", r.Status);
  Field(json, "RentalPeriod", r.RentalPeriod);
  Field(json, "PassID", r.PassID);
  Field(json, "PlayStatus", r.PlayStatus);
  Field(json, "StartTimeSeconds", r.StartTimeSeconds);
}

void Members(VLJsonWriter& json, const VL_WS_TitleListingPurchasedForPass& r) {
  Members(json, static_cast<const VL_WS_TitleListingPurchased&>(r));
  Field(json, "ResponseCode", r.ResponseCode);
  Field(json, "ResponseMessage", r.ResponseMessage);
}

void Members(VLJsonWriter& json, const VL_WS_MyVideosResponse& r) {
  Members(json, static_cast<const VL_WS_StandardResponse&>(r));
  PageFields(json, r);
}

void Members(VLJsonWriter& json, const VL_WS_BillingInfoResponse& r) {
  Members(json, static_cast<const VL_WS_StandardResponse&>(r));
  Field(json, "CCLastFour", r.CCLastFour);
  Field(json, "CCTypeId", r.CCTypeId);
  Field(json, "CCType", r.CCType);
}

void Members(VLJsonWriter& json, const VL_WS_PrePaidCardBalanceResponse& r) {
  Members(json, static_cast<const VL_WS_StandardResponse&>(r));
  Field(json, "Balance", r.Balance);
}

void Members(VLJsonWriter& json, const VL_WS_ConfigurationItem& r) {
  Field(json, "Key", r.Key);
  Field(json, "Value", r.Value);
}

// A response of the store: its code and message, then the fields of its own.
template <class Record, class OwnFields>
void Response(VLJsonWriter& json, const Record& r, OwnFields own) {
  json.BeginObject();
  Members(json, static_cast<const VL_WS_StandardResponse&>(r));
  own();
  json.EndObject();
}

}  // namespace

void VLJsonValue(VLJsonWriter& json, const VL_WS_String& r) {
  json.BeginObject();
  Field(json, "Length", r.Length);
  json.Key("Text");
  json.String(r.Text ? r.Text : "", r.Text ? static_cast<size_t>(r.Length) : 0);
  json.EndObject();
}

void VLJsonValue(VLJsonWriter& json, const VL_WS_StandardResponse& r) { Value(json, r); }
void VLJsonValue(VLJsonWriter& json, const VL_WS_BoolArray& r) { Array(json, r); }
void VLJsonValue(VLJsonWriter& json, const VL_WS_Version& r) { Value(json, r); }
void VLJsonValue(VLJsonWriter& json, const VL_WS_EnvList& r) { Array(json, r.Count, r.Entries); }

void VLJsonValue(VLJsonWriter& json, const VL_WS_Image& r) {
  std::vector<unsigned char> base64(4 * ((static_cast<size_t>(r.Length) + 2) / 3) + 1);
  int written = r.Data ? EVP_EncodeBlock(base64.data(), reinterpret_cast<const unsigned char*>(r.Data), r.Length) : 0;
  json.BeginObject();
  Field(json, "Kind", r.Kind);
  Field(json, "Length", r.Length);
  json.Key("Data");
  json.String(reinterpret_cast<const char*>(base64.data()), static_cast<size_t>(written));
  json.EndObject();
}

void VLJsonValue(VLJsonWriter& json, const VL_WS_FileType& r) { Value(json, r); }
void VLJsonValue(VLJsonWriter& json, const VL_WS_GenreArray& r) { Array(json, r); }

void VLJsonValue(VLJsonWriter& json, const VL_WS_GenreLabelResponse& r) {
  Response(json, r, [&] {
    Field(json, "Label", r.Label);
    Field(json, "LabelMessage", r.LabelMessage);
  });
}

void VLJsonValue(VLJsonWriter& json, const VL_WS_TitleListingResponse& r) { Value(json, r); }
void VLJsonValue(VLJsonWriter& json, const VL_WS_TitleListingResponseArray& r) { Array(json, r); }
void VLJsonValue(VLJsonWriter& json, const VL_WS_TitlesResponse& r) { Value(json, r); }
void VLJsonValue(VLJsonWriter& json, const VL_WS_TitlesResponseArray& r) { Array(json, r); }

void VLJsonValue(VLJsonWriter& json, const VL_WS_RecommendedTitlesResponse& r) {
  Response(json, r, [&] { Field(json, "Titles", r.Titles); });
}

void VLJsonValue(VLJsonWriter& json, const VL_WS_TvEpisodeListResponse& r) {
  Response(json, r, [&] { Field(json, "Episodes", r.Episodes); });
}

void VLJsonValue(VLJsonWriter& json, const VL_WS_TranslateTivoExternalIDResponse& r) {
  Response(json, r, [&] {
    Field(json, "TivoExternalId", r.TivoExternalId);
    Field(json, "TitleId", r.TitleId);
  });
}

void VLJsonValue(VLJsonWriter& json, const VL_WS_TranslateSkuIDResponse& r) {
  Response(json, r, [&] { Field(json, "TitleId", r.TitleId); });
}

void VLJsonValue(VLJsonWriter& json, const VL_WS_AuthorizeDeviceResponse& r) {
  Response(json, r, [&] {
    Field(json, "AuthToken", r.AuthToken);
    Field(json, "EmailAddress", r.EmailAddress);
    Field(json, "IsAdultVerificationEnabled", r.IsAdultVerificationEnabled);
    Field(json, "DeviceID", r.DeviceID);
    Field(json, "DeviceName", r.DeviceName);
  });
}

void VLJsonValue(VLJsonWriter& json, const VL_WS_MyVideosResponse& r) { Value(json, r); }

void VLJsonValue(VLJsonWriter& json, const VL_WS_WishlistItemsResponse& r) {
  json.BeginObject();
  Members(json, r);
  Field(json, "SortOrder", r.SortOrder);
  json.EndObject();
}

void VLJsonValue(VLJsonWriter& json, const VL_WS_TitleListingPurchasedForPassArray& r) { Array(json, r); }

void VLJsonValue(VLJsonWriter& json, const VL_WS_PurchaseResponse& r) {
  Response(json, r, [&] {
    Field(json, "PassID", r.PassID);
    Field(json, "TransactionId", r.TransactionId);
    Field(json, "TransactionAuthNum", r.TransactionAuthNum);
  });
}

void VLJsonValue(VLJsonWriter& json, const VL_WS_OrderTaxResponse& r) {
  Response(json, r, [&] {
    Field(json, "SubTotal", r.SubTotal);
    Field(json, "TotalPrice", r.TotalPrice);
    Field(json, "Tax", r.Tax);
  });
}

void VLJsonValue(VLJsonWriter& json, const VL_WS_GiftCertificateResponse& r) {
  Response(json, r, [&] { Field(json, "Balance", r.Balance); });
}

void VLJsonValue(VLJsonWriter& json, const VL_WS_PrePaidCardBalanceResponse& r) { Value(json, r); }
void VLJsonValue(VLJsonWriter& json, const VL_WS_BillingInfoResponse& r) { Value(json, r); }

void VLJsonValue(VLJsonWriter& json, const VL_WS_BillingInfoAndPPCBalance& r) {
  json.BeginObject();
  Field(json, "BillingInfo", r.BillingInfo);
  Field(json, "PPCardBalance", r.PPCardBalance);
  json.EndObject();
}

void VLJsonValue(VLJsonWriter& json, const VL_WS_AdultVerificationEnabledResponse& r) {
  Response(json, r, [&] { Field(json, "IsAdultVerificationEnabled", r.IsAdultVerificationEnabled); });
}

void VLJsonValue(VLJsonWriter& json, const VL_WS_AdultVerificationPinResponse& r) {
  Response(json, r, [&] { Field(json, "IsPinVerified", r.IsPinVerified); });
}

void VLJsonValue(VLJsonWriter& json, const VL_WS_RentalExpirationResponse& r) {
  Response(json, r, [&] {
    Field(json, "ShouldDisplay", r.ShouldDisplay);
    Field(json, "HoursRemaining", r.HoursRemaining);
  });
}

void VLJsonValue(VLJsonWriter& json, const VL_WS_EmailAddressResponse& r) {
  Response(json, r, [&] { Field(json, "EmailAddress", r.EmailAddress); });
}

void VLJsonValue(VLJsonWriter& json, const VL_WS_SettingsPageResponse& r) {
  Response(json, r, [&] {
    Field(json, "Account", r.Account);
    Field(json, "DeviceID", r.DeviceID);
    Field(json, "DeviceName", r.DeviceName);
  });
}

void VLJsonValue(VLJsonWriter& json, const VL_WS_ConfigResponse& r) {
  Response(json, r, [&] {
    json.Key("Items");
    Array(json, r.Count, r.Items);
  });
}

void VLJsonValue(VLJsonWriter& json, const VL_WS_StreamingAssetLocationResponse& r) {
  Response(json, r, [&] {
    Field(json, "StreamingAssetLocation", r.StreamingAssetLocation);
    Field(json, "AssetID", r.AssetID);
    Field(json, "StreamID", r.StreamID);
    Field(json, "DRMServerURL", r.DRMServerURL);
    Field(json, "DRMACKServerURL", r.DRMACKServerURL);
    Field(json, "Status", r.Status);
    Field(json, "StartTimeSeconds", r.StartTimeSeconds);
    Field(json, "HeartbeatURL", r.HeartbeatURL);
    Field(json, "HeartbeatPollInSeconds", r.HeartbeatPollInSeconds);
  });
}

void VLJsonValue(VLJsonWriter& json, const VL_WS_THXMediaDirectorResponse& r) {
  Response(json, r, [&] {
    Field(json, "LongFormat", r.LongFormat);
    Field(json, "ShortFormat", r.ShortFormat);
  });
}
