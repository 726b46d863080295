// DUDUVud::SetResult: builds the "onComplete" script value of a finished request.
#include <stddef.h>
#include <stdio.h>

#include "DUDUVudAE.h"
#include "VL_WS.h"

using ae::stagecraft::ASObject;
using ae::stagecraft::ASValue;
using ae::stagecraft::ASValueArray;

namespace {

// ---- Properties and lists -------------------------------------------------------------------

void SetInt(const ASObject& target, const char* name, int number) {
  ASValue value;
  value.SetInteger(number);
  target.SetProperty(name, value);
}

// A null text (a record cleared by a failed call) gives "".
void SetStr(const ASObject& target, const char* name, const char* text) {
  ASValue value;
  value.SetString(text);
  target.SetProperty(name, value);
}

void SetBool(const ASObject& target, const char* name, bool flag) {
  ASValue value;
  value.SetBoolean(flag);
  target.SetProperty(name, value);
}

void SetObj(const ASObject& target, const char* name, const ASObject& child) {
  ASValue value;
  value.SetObject(child);
  target.SetProperty(name, value);
}

// Appends a value holding element to the script array.
void Push(const ASObject& array, const ASObject& element) {
  ASValue value;
  value.SetObject(element);
  array.CallMethod("push", value);
}

// An "Array" with one new "Object" per item, in order, each filled by fill(object, item). A null
// item pointer (count 0) gives an empty array.
template <class Item, class Fill>
ASObject MakeList(const ASObject& factory, const Item* items, int count, Fill fill) {
  ASObject array = factory.NewObject("Array");
  for (int i = 0; items && i < count; ++i) {
    ASObject element = factory.NewObject("Object");
    fill(element, items[i]);
    Push(array, element);
  }
  return array;
}

// A script Date from "YYYY/MM/DD hh:mm:ss"; missing parts (or a missing text) stay 0.
ASObject MakeDate(const ASObject& factory, const char* text) {
  int parts[6] = {0, 0, 0, 0, 0, 0};
  if (text)
    sscanf(text, "%04d/%02d/%02d %02d:%02d:%02d", &parts[0], &parts[1], &parts[2], &parts[3],
           &parts[4], &parts[5]);
  parts[1] -= 1;  // the script's months count from 0
  ASValueArray arguments;
  for (int part : parts) {
    ASValue value;
    value.SetInteger(part);
    arguments.Append(value);
  }
  return factory.NewObject("Date", arguments);
}

// ---- Shared shapes --------------------------------------------------------------------------

void SetTail(const ASObject& target, const VL_WS_StandardResponse& response) {
  SetInt(target, "ResponseCode", response.ResponseCode);
  SetStr(target, "ResponseMessage", response.ResponseMessage);
}

void FillProduct(const ASObject& factory, const ASObject& target,
                 const VL_WS_ProductListing& product) {
  SetInt(target, "SkuID", product.SkuID);
  SetInt(target, "PurchaseType", product.PurchaseType);
  SetStr(target, "Price", product.Price);
  SetInt(target, "RentalPeriod", product.RentalPeriod);
  SetObj(
      target, "AvailableAssets",
      MakeList(factory, product.AvailableAssets.Items, product.AvailableAssets.Count,
               [](const ASObject& asset, int profile) { SetInt(asset, "FileProfile", profile); }));
  SetObj(
      target, "AvailableAudioProfiles",
      MakeList(factory, product.AvailableAudioProfiles.Items, product.AvailableAudioProfiles.Count,
               [](const ASObject& audio, const VL_WS_AudioFile& file) {
                 SetInt(audio, "AssetAudioID", file.AssetAudioID);
                 SetStr(audio, "FileLocation", file.FileLocation);
                 SetBool(audio, "ContainsVideo", file.ContainsVideo);
                 SetInt(audio, "AudioAssetProfile", file.AudioAssetProfile);
               }));
  SetObj(target, "ExpireDate", MakeDate(factory, product.ExpireDate));
}

void FillTitle(const ASObject& factory, const ASObject& target, const VL_WS_TitleListing& title) {
  SetInt(target, "TitleID", title.TitleID);
  SetStr(target, "TitleName", title.TitleName);
  SetStr(target, "BoxArtPrefix", title.BoxArtPrefix);
  SetInt(target, "TitlePosition", title.TitlePosition);
  SetInt(target, "EpisodeNumber", title.EpisodeNumber);
  SetStr(target, "CHVRSRating", title.CHVRSRating);
  SetStr(target, "LoyaltyPointsForBuy", title.LoyaltyPointsForBuy);
  SetStr(target, "LoyaltyPointsForRent", title.LoyaltyPointsForRent);
  SetObj(target, "BonusAssets",
         MakeList(factory, title.BonusAssets.Items, title.BonusAssets.Count,
                  [](const ASObject& bonus, const VL_WS_BonusAsset& asset) {
                    SetInt(bonus, "BonusAssetID", asset.BonusAssetID);
                    SetInt(bonus, "Profile", asset.Profile);
                    SetInt(bonus, "BonusType", asset.BonusType);
                  }));
  SetBool(target, "IsTvListing", title.IsTvListing);
  SetStr(target, "MPAARating", title.MPAARating);
  SetBool(target, "IsTHXMediaDirectorEnabled", title.IsTHXMediaDirectorEnabled);
  SetBool(target, "IsTHXMediaDirectorEnabledForTrailer", title.IsTHXMediaDirectorEnabledForTrailer);
  SetObj(target, "AvailableProducts",
         MakeList(factory, title.AvailableProducts.Items, title.AvailableProducts.Count,
                  [&factory](const ASObject& object, const VL_WS_ProductListing& product) {
                    FillProduct(factory, object, product);
                  }));
}

// An "Array" of title objects.
ASObject MakeTitles(const ASObject& factory, const VL_WS_TitleListingArray& titles) {
  return MakeList(factory, titles.Items, titles.Count,
                  [&factory](const ASObject& object, const VL_WS_TitleListing& title) {
                    FillTitle(factory, object, title);
                  });
}

void FillTitleDetail(const ASObject& factory, const ASObject& target,
                     const VL_WS_TitleListingResponse& detail) {
  SetInt(target, "ResponseCode", detail.ResponseCode);
  SetStr(target, "ResponseMessage", detail.ResponseMessage);
  SetStr(target, "Synopsis", detail.Synopsys);
  SetInt(target, "UserRating", detail.UserRating);
  SetStr(target, "Directors", detail.Directors);
  SetStr(target, "Actors", detail.Actors);
  SetStr(target, "Writers", detail.Writers);
  SetStr(target, "Producers", detail.Producers);
  SetStr(target, "Copyright", detail.Copyright);
  SetStr(target, "RunTime", detail.RunTime);
  SetStr(target, "RatingReason", detail.RatingReason);
  FillTitle(factory, target, detail);
}

void FillVideoPage(const ASObject& factory, const ASObject& target,
                   const VL_WS_MyVideosResponse& page) {
  SetInt(target, "CurrentPageNumber", page.CurrentPageNumber);  // shorts: sign-extended
  SetInt(target, "ItemsPerPage", page.ItemsPerPage);
  SetInt(target, "TotalPages", page.TotalPages);
  SetInt(target, "TotalItems", page.TotalItems);
  SetTail(target, page);
  SetObj(target, "Titles",
         MakeList(factory, page.Titles.Items, page.Titles.Count,
                  [&factory](const ASObject& video, const VL_WS_TitleListingPurchased& title) {
                    FillTitle(factory, video, title);
                    SetInt(video, "EpisodeID", title.EpisodeID);
                    SetInt(video, "TvListingTitleID", title.TvListingTitleID);
                    SetInt(video, "PurchaseType", title.PurchaseType);
                    SetInt(video, "Status", title.Status);
                    SetStr(video, "RentalPeriod", title.RentalPeriod);
                    SetInt(video, "PassID", title.PassID);
                    SetInt(video, "PlayStatus", title.PlayStatus);
                    SetInt(video, "StartTimeSeconds", title.StartTimeSeconds);
                  }));
}

}  // namespace

namespace DUDUVud {

bool SetResult(DUDUVudAE::Result& result, ASValue& value, ASObject& object) {
  DUDUVudAE::Result::Data& data = result.data;
  const ASObject& factory = object;
  if (result.type < DUDUVudAE::RESULT_INT || result.type > DUDUVudAE::RESULT_THX_MEDIA_DIRECTOR)
    return false;  // unknown type: value untouched, nothing released

  switch (result.type) {
    case DUDUVudAE::RESULT_INT:
      value.SetInteger(data.Int);
      return true;
    case DUDUVudAE::RESULT_BOOL:
      value.SetBoolean(data.Bool);
      return true;
    case DUDUVudAE::RESULT_STRING:
      value.SetString(data.String.Text, data.String.Length > 0 ? size_t(data.String.Length) : 0);
      VL_WS_release(&data.String);
      return true;
    case DUDUVudAE::RESULT_BOOL_ARRAY: {
      ASObject array = factory.NewObject("Array");
      for (int i = 0; data.Flags.Items && i < data.Flags.Count; ++i) {
        ASValue flag;
        flag.SetBoolean(data.Flags.Items[i]);
        array.CallMethod("push", flag);
      }
      value.SetObject(array);
      VL_WS_release(&data.Flags);
      return true;
    }
    case DUDUVudAE::RESULT_NAVIGATION:
      value.SetObject(MakeList(factory, data.Genres.Items, data.Genres.Count,
                               [](const ASObject& genre, const VL_WS_Genre& item) {
                                 SetInt(genre, "ID", item.ID);
                                 SetStr(genre, "Name", item.Name);
                                 SetBool(genre, "Visible", item.Visible);
                                 SetInt(genre, "ParentID", item.ParentId);
                               }));
      VL_WS_release(&data.Genres);
      return true;
    default:
      break;
  }

  // The remaining types build one "Object".
  ASObject target = factory.NewObject("Object");
  switch (result.type) {
    case DUDUVudAE::RESULT_TITLES:
      SetInt(target, "GenreID", data.Titles.GenreID);
      SetInt(target, "CurrentPageNumber", data.Titles.CurrentPageNumber);
      SetInt(target, "ItemsPerPage", data.Titles.ItemsPerPage);
      SetInt(target, "TotalPages", data.Titles.TotalPages);
      SetInt(target, "TotalItems", data.Titles.TotalItems);
      SetTail(target, data.Titles);
      SetObj(target, "Titles", MakeTitles(factory, data.Titles.Titles));
      break;
    case DUDUVudAE::RESULT_TITLE_LISTING:
      FillTitleDetail(factory, target, data.TitleListing);
      break;
    case DUDUVudAE::RESULT_AUTHORIZE_DEVICE:
      SetStr(target, "AuthToken", data.Authorization.AuthToken);
      SetStr(target, "EmailAddress", data.Authorization.EmailAddress);
      SetBool(target, "IsAdultVerificationEnabled", data.Authorization.IsAdultVerificationEnabled);
      SetStr(target, "DeviceID", data.Authorization.DeviceID);
      SetStr(target, "DeviceName", data.Authorization.DeviceName);
      SetTail(target, data.Authorization);
      break;
    case DUDUVudAE::RESULT_MY_VIDEOS:
      FillVideoPage(factory, target, data.MyVideos);
      break;
    case DUDUVudAE::RESULT_STANDARD:
      SetTail(target, data.Standard);
      break;
    case DUDUVudAE::RESULT_RECOMMENDED_TITLES:
      SetTail(target, data.Recommended);
      SetObj(target, "Titles", MakeTitles(factory, data.Recommended.Titles));
      break;
    case DUDUVudAE::RESULT_TRANSLATE_SKU_ID:
      SetTail(target, data.SkuTranslation);
      SetInt(target, "TitleID", data.SkuTranslation.TitleId);
      break;
    case DUDUVudAE::RESULT_TV_EPISODE_LIST:
      SetTail(target, data.Episodes);
      SetObj(target, "Episodes",
             MakeList(factory, data.Episodes.Episodes.Items, data.Episodes.Episodes.Count,
                      [](const ASObject& episode, const VL_WS_TvEpisode& item) {
                        SetInt(episode, "EpisodeID", item.EpisodeID);
                        SetStr(episode, "EpisodeName", item.EpisodeName);
                        SetInt(episode, "EpisodeNumber", item.EpisodeNumber);
                      }));
      break;
    case DUDUVudAE::RESULT_ALL_TV_EPISODE_LISTINGS:
      SetObj(target, "TitleListingResponse",
             MakeList(factory, data.AllEpisodes.Items, data.AllEpisodes.Count,
                      [&factory](const ASObject& detail, const VL_WS_TitleListingResponse& item) {
                        FillTitleDetail(factory, detail, item);
                      }));
      break;
    case DUDUVudAE::RESULT_WISHLIST_ITEMS:
      FillVideoPage(factory, target, data.Wishlist);
      SetInt(target, "SortOrder", data.Wishlist.SortOrder);
      break;
    case DUDUVudAE::RESULT_PURCHASE:
      SetInt(target, "PassID", data.Purchase.PassID);
      SetInt(target, "TransactionID", data.Purchase.TransactionId);
      SetStr(target, "TransactionAuthNum", data.Purchase.TransactionAuthNum);
      SetTail(target, data.Purchase);
      break;
    case DUDUVudAE::RESULT_ADULT_VERIFICATION_ENABLED:
      SetBool(target, "IsAdultVerificationEnabled",
              data.AdultVerification.IsAdultVerificationEnabled);
      SetTail(target, data.AdultVerification);
      break;
    case DUDUVudAE::RESULT_ADULT_VERIFICATION_PIN:
      SetBool(target, "IsPinVerified", data.AdultPin.IsPinVerified);
      SetTail(target, data.AdultPin);
      break;
    case DUDUVudAE::RESULT_GIFT_CERTIFICATE:
      SetInt(target, "Balance", data.GiftCertificate.Balance);
      SetTail(target, data.GiftCertificate);
      break;
    case DUDUVudAE::RESULT_RENTAL_EXPIRATION:
      SetBool(target, "ShouldDisplay", data.RentalExpiration.ShouldDisplay);
      SetInt(target, "HoursRemaining", data.RentalExpiration.HoursRemaining);
      SetTail(target, data.RentalExpiration);
      break;
    case DUDUVudAE::RESULT_STREAMING_ASSET_LOCATION: {
      const VL_WS_StreamingAssetLocationResponse& stream = data.StreamLocation;
      SetStr(target, "StreamingAssetLocation", stream.StreamingAssetLocation);
      SetInt(target, "AssetID", stream.AssetID);
      SetStr(target, "StreamID", stream.StreamID);
      SetStr(target, "DRMServerURL", stream.DRMServerURL);
      SetStr(target, "DRMACKServerURL", stream.DRMACKServerURL);
      SetInt(target, "Status", stream.Status);
      SetInt(target, "StartTimeSeconds", stream.StartTimeSeconds);
      SetStr(target, "HeartbeatURL", stream.HeartbeatURL);
      SetInt(target, "HeartbeatPollInSeconds", stream.HeartbeatPollInSeconds);
      SetTail(target, stream);
      break;
    }
    case DUDUVudAE::RESULT_EMAIL_ADDRESS:
      SetStr(target, "EmailAddress", data.Email.EmailAddress);
      SetTail(target, data.Email);
      break;
    case DUDUVudAE::RESULT_BILLING_INFO:
      SetStr(target, "CCLastFour", data.Billing.CCLastFour);
      SetInt(target, "CCTypeID", data.Billing.CCTypeId);
      SetStr(target, "CCType", data.Billing.CCType);
      SetTail(target, data.Billing);
      break;
    case DUDUVudAE::RESULT_PREPAID_CARD_BALANCE:
      SetInt(target, "Balance", data.PrePaidBalance.Balance);
      SetTail(target, data.PrePaidBalance);
      break;
    case DUDUVudAE::RESULT_CONFIG:
      SetTail(target, data.Config);
      SetObj(target, "ConfigurationItem",
             MakeList(factory, data.Config.Items, data.Config.Count,
                      [](const ASObject& entry, const VL_WS_ConfigurationItem& item) {
                        SetStr(entry, "Key", item.Key);
                        SetStr(entry, "Value", item.Value);
                      }));
      break;
    case DUDUVudAE::RESULT_SETTINGS_PAGE:
      SetStr(target, "Account", data.SettingsPage.Account);
      SetStr(target, "DeviceID", data.SettingsPage.DeviceID);
      SetStr(target, "DeviceName", data.SettingsPage.DeviceName);
      SetTail(target, data.SettingsPage);
      break;
    case DUDUVudAE::RESULT_FILE_TYPE:
      SetInt(target, "DRMProvider", data.FileType.File_DRMProvider);
      SetInt(target, "AccessType", data.FileType.File_AccessType);
      SetInt(target, "FileProfile", data.FileType.File_FileProfile);
      SetInt(target, "VideoFormat", data.FileType.File_VideoFormat);
      SetInt(target, "FileExtension", data.FileType.File_FileExtension);
      break;
    case DUDUVudAE::RESULT_ORDER_TAX:
      SetStr(target, "SubTotal", data.OrderTax.SubTotal);
      SetStr(target, "TotalPrice", data.OrderTax.TotalPrice);
      SetStr(target, "Tax", data.OrderTax.Tax);
      SetTail(target, data.OrderTax);
      break;
    case DUDUVudAE::RESULT_THX_MEDIA_DIRECTOR:
      SetStr(target, "LongFormat", data.THX.LongFormat);
      SetStr(target, "ShortFormat", data.THX.ShortFormat);
      SetTail(target, data.THX);
      break;
    default:
      return false;  // not reached: the types were checked above
  }
  value.SetObject(target);
  // Every record member begins at the union's start with its tag pointer.
  VL_WS_release(&data);
  return true;
}

}  // namespace DUDUVud
