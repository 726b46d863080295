// VL_WS_release: gives back any record of the flat interface by its type tag.
//
// A record that extends a base frees its own fields, writes the base's tag into its cell and is
// released again as the base, so each field is freed by the one record type that declares it.
#include "VL_WS.h"
#include "VL_WS_Client.h"

namespace {

void FreeText(char*& text) {
  delete[] text;
  text = 0;
}

template <class Plain>
void FreePlainItems(Plain*& items, int& count) {
  delete[] items;
  items = 0;
  count = 0;
}

// Releases every element of an array of records (each by its own tag), then the array.
template <class Array>
void FreeRecordItems(Array& array) {
  if (array.Items != 0) {
    for (int i = 0; i < array.Count; ++i) VL_WS_release(&array.Items[i]);
    delete[] array.Items;
  }
  array.Items = 0;
  array.Count = 0;
}

void FreeTitleListing(VL_WS_TitleListing& r) {
  FreeText(r.TitleName);
  FreeText(r.BoxArtPrefix);
  VL_WS_release(&r.BonusAssets);
  FreeText(r.MPAARating);
  VL_WS_release(&r.AvailableProducts);
  FreeText(r.CHVRSRating);
  FreeText(r.LoyaltyPointsForBuy);
  FreeText(r.LoyaltyPointsForRent);
}

template <class Record>
Record& As(void* record) {
  return *static_cast<Record*>(record);
}

// Frees what a record of type `tag` owns beyond its base. Returns the base's tag, or
// VL_WS_TAG_NONE when the record has no base.
int FreeOwnFields(int tag, void* record) {
  switch (tag) {
    case VL_WS_TAG_NONE:
      break;
    case VL_WS_TAG_HANDLE: {
      VL_WS_Handle& r = As<VL_WS_Handle>(record);
      if (r.client != 0) VLClientRelease(r.client);
      r.client = 0;
      break;
    }
    case VL_WS_TAG_STRING: {
      VL_WS_String& r = As<VL_WS_String>(record);
      FreeText(r.Text);
      r.Length = 0;
      break;
    }
    case VL_WS_TAG_STANDARD_RESPONSE:
      FreeText(As<VL_WS_StandardResponse>(record).ResponseMessage);
      break;
    case VL_WS_TAG_GENRE:
      FreeText(As<VL_WS_Genre>(record).Name);
      break;
    case VL_WS_TAG_GENRE_ARRAY:
      FreeRecordItems(As<VL_WS_GenreArray>(record));
      break;
    case VL_WS_TAG_GENRE_LABEL_RESPONSE: {
      VL_WS_GenreLabelResponse& r = As<VL_WS_GenreLabelResponse>(record);
      FreeText(r.Label);
      FreeText(r.LabelMessage);
      return VL_WS_TAG_STANDARD_RESPONSE;
    }
    case VL_WS_TAG_BONUS_ASSET:
      break;
    case VL_WS_TAG_BONUS_ASSET_ARRAY:
      FreeRecordItems(As<VL_WS_BonusAssetArray>(record));
      break;
    case VL_WS_TAG_INT_ARRAY: {
      VL_WS_IntArray& r = As<VL_WS_IntArray>(record);
      FreePlainItems(r.Items, r.Count);
      break;
    }
    case VL_WS_TAG_AUDIO_FILE_ARRAY:
      FreeRecordItems(As<VL_WS_AudioFileArray>(record));
      break;
    case VL_WS_TAG_AUDIO_FILE:
      FreeText(As<VL_WS_AudioFile>(record).FileLocation);
      break;
    case VL_WS_TAG_PRODUCT_LISTING: {
      VL_WS_ProductListing& r = As<VL_WS_ProductListing>(record);
      FreeText(r.Price);
      VL_WS_release(&r.AvailableAssets);
      FreeText(r.ExpireDate);
      VL_WS_release(&r.AvailableAudioProfiles);
      break;
    }
    case VL_WS_TAG_PRODUCT_LISTING_ARRAY:
      FreeRecordItems(As<VL_WS_ProductListingArray>(record));
      break;
    case VL_WS_TAG_TITLE_LISTING:
      FreeTitleListing(As<VL_WS_TitleListing>(record));
      break;
    case VL_WS_TAG_TITLE_LISTING_ARRAY:
      FreeRecordItems(As<VL_WS_TitleListingArray>(record));
      break;
    case VL_WS_TAG_TITLE_LISTING_RESPONSE: {
      VL_WS_TitleListingResponse& r = As<VL_WS_TitleListingResponse>(record);
      FreeText(r.ResponseMessage);
      FreeText(r.Synopsys);
      FreeText(r.Directors);
      FreeText(r.Actors);
      FreeText(r.Writers);
      FreeText(r.Producers);
      FreeText(r.Copyright);
      FreeText(r.RunTime);
      FreeText(r.RatingReason);
      return VL_WS_TAG_TITLE_LISTING;
    }
    case VL_WS_TAG_TITLE_LISTING_RESPONSE_ARRAY:
      FreeRecordItems(As<VL_WS_TitleListingResponseArray>(record));
      break;
    case VL_WS_TAG_TITLES_RESPONSE:
      VL_WS_release(&As<VL_WS_TitlesResponse>(record).Titles);
      return VL_WS_TAG_STANDARD_RESPONSE;
    case VL_WS_TAG_TITLES_RESPONSE_ARRAY:
      FreeRecordItems(As<VL_WS_TitlesResponseArray>(record));
      break;
    case VL_WS_TAG_TV_EPISODE:
      FreeText(As<VL_WS_TvEpisode>(record).EpisodeName);
      break;
    case VL_WS_TAG_TV_EPISODE_ARRAY:
      FreeRecordItems(As<VL_WS_TvEpisodeArray>(record));
      break;
    case VL_WS_TAG_TV_EPISODE_LIST_RESPONSE:
      VL_WS_release(&As<VL_WS_TvEpisodeListResponse>(record).Episodes);
      return VL_WS_TAG_STANDARD_RESPONSE;
    case VL_WS_TAG_AUTHORIZE_DEVICE_RESPONSE: {
      VL_WS_AuthorizeDeviceResponse& r = As<VL_WS_AuthorizeDeviceResponse>(record);
      FreeText(r.AuthToken);
      FreeText(r.EmailAddress);
      FreeText(r.DeviceID);
      FreeText(r.DeviceName);
      return VL_WS_TAG_STANDARD_RESPONSE;
    }
    case VL_WS_TAG_TITLE_LISTING_PURCHASED:
      FreeText(As<VL_WS_TitleListingPurchased>(record).RentalPeriod);
      return VL_WS_TAG_TITLE_LISTING;
    case VL_WS_TAG_TITLE_LISTING_PURCHASED_ARRAY:
      FreeRecordItems(As<VL_WS_TitleListingPurchasedArray>(record));
      break;
    case VL_WS_TAG_MY_VIDEOS_RESPONSE:
      VL_WS_release(&As<VL_WS_MyVideosResponse>(record).Titles);
      return VL_WS_TAG_STANDARD_RESPONSE;
    case VL_WS_TAG_WISHLIST_ITEMS_RESPONSE:
      return VL_WS_TAG_MY_VIDEOS_RESPONSE;
    case VL_WS_TAG_GIFT_CERTIFICATE_RESPONSE:
    case VL_WS_TAG_ADULT_VERIFICATION_ENABLED_RESPONSE:
    case VL_WS_TAG_ADULT_VERIFICATION_PIN_RESPONSE:
    case VL_WS_TAG_PREPAID_CARD_BALANCE_RESPONSE:
    case VL_WS_TAG_RENTAL_EXPIRATION_RESPONSE:
    case VL_WS_TAG_TRANSLATE_SKU_ID_RESPONSE:
      return VL_WS_TAG_STANDARD_RESPONSE;
    case VL_WS_TAG_PURCHASE_RESPONSE:
      FreeText(As<VL_WS_PurchaseResponse>(record).TransactionAuthNum);
      return VL_WS_TAG_STANDARD_RESPONSE;
    case VL_WS_TAG_STREAMING_ASSET_LOCATION_RESPONSE: {
      VL_WS_StreamingAssetLocationResponse& r = As<VL_WS_StreamingAssetLocationResponse>(record);
      FreeText(r.StreamingAssetLocation);
      FreeText(r.StreamID);
      FreeText(r.DRMServerURL);
      FreeText(r.DRMACKServerURL);
      FreeText(r.HeartbeatURL);
      return VL_WS_TAG_STANDARD_RESPONSE;
    }
    case VL_WS_TAG_CONFIGURATION_ITEM: {
      VL_WS_ConfigurationItem& r = As<VL_WS_ConfigurationItem>(record);
      FreeText(r.Key);
      FreeText(r.Value);
      break;
    }
    case VL_WS_TAG_CONFIG_RESPONSE:
      FreeRecordItems(As<VL_WS_ConfigResponse>(record));
      return VL_WS_TAG_STANDARD_RESPONSE;
    case VL_WS_TAG_BILLING_INFO_RESPONSE: {
      VL_WS_BillingInfoResponse& r = As<VL_WS_BillingInfoResponse>(record);
      FreeText(r.CCLastFour);
      FreeText(r.CCType);
      return VL_WS_TAG_STANDARD_RESPONSE;
    }
    case VL_WS_TAG_BILLING_INFO_AND_PPC_BALANCE: {
      VL_WS_BillingInfoAndPPCBalance& r = As<VL_WS_BillingInfoAndPPCBalance>(record);
      VL_WS_release(&r.BillingInfo);
      VL_WS_release(&r.PPCardBalance);
      break;
    }
    case VL_WS_TAG_SETTINGS_PAGE_RESPONSE: {
      VL_WS_SettingsPageResponse& r = As<VL_WS_SettingsPageResponse>(record);
      FreeText(r.Account);
      FreeText(r.DeviceID);
      FreeText(r.DeviceName);
      return VL_WS_TAG_STANDARD_RESPONSE;
    }
    case VL_WS_TAG_EMAIL_ADDRESS_RESPONSE:
      FreeText(As<VL_WS_EmailAddressResponse>(record).EmailAddress);
      return VL_WS_TAG_STANDARD_RESPONSE;
    case VL_WS_TAG_RECOMMENDED_TITLES_RESPONSE:
      VL_WS_release(&As<VL_WS_RecommendedTitlesResponse>(record).Titles);
      return VL_WS_TAG_STANDARD_RESPONSE;
    case VL_WS_TAG_ORDER_TAX_RESPONSE: {
      VL_WS_OrderTaxResponse& r = As<VL_WS_OrderTaxResponse>(record);
      FreeText(r.SubTotal);
      FreeText(r.TotalPrice);
      FreeText(r.Tax);
      return VL_WS_TAG_STANDARD_RESPONSE;
    }
    case VL_WS_TAG_TITLE_LISTING_PURCHASED_FOR_PASS:
      FreeText(As<VL_WS_TitleListingPurchasedForPass>(record).ResponseMessage);
      return VL_WS_TAG_TITLE_LISTING_PURCHASED;
    case VL_WS_TAG_TITLE_LISTING_PURCHASED_FOR_PASS_ARRAY:
      FreeRecordItems(As<VL_WS_TitleListingPurchasedForPassArray>(record));
      break;
    case VL_WS_TAG_FILE_TYPE:
    case VL_WS_TAG_VERSION:
      break;
    case VL_WS_TAG_BOOL_ARRAY: {
      VL_WS_BoolArray& r = As<VL_WS_BoolArray>(record);
      FreePlainItems(r.Items, r.Count);
      break;
    }
    case VL_WS_TAG_IMAGE: {
      VL_WS_Image& r = As<VL_WS_Image>(record);
      FreePlainItems(r.Data, r.Length);
      break;
    }
    case VL_WS_TAG_TRANSLATE_TIVO_EXTERNAL_ID_RESPONSE:
      FreeText(As<VL_WS_TranslateTivoExternalIDResponse>(record).TivoExternalId);
      return VL_WS_TAG_STANDARD_RESPONSE;
    case VL_WS_TAG_THX_MEDIA_DIRECTOR_RESPONSE: {
      VL_WS_THXMediaDirectorResponse& r = As<VL_WS_THXMediaDirectorResponse>(record);
      FreeText(r.LongFormat);
      FreeText(r.ShortFormat);
      return VL_WS_TAG_STANDARD_RESPONSE;
    }
  }
  return VL_WS_TAG_NONE;
}

// Tags 45 to 48 are reserved: no operation produces them, so their contents are unknown.
bool IsKnownTag(int tag) {
  return tag >= VL_WS_TAG_NONE && tag <= VL_WS_TAG_LAST && (tag < 45 || tag > 48);
}

}  // namespace

extern "C" VL_WS_Status VL_WS_release(void* record) {
  if (record == 0) return VL_WS_E_INVALID_ARGUMENT;
  int*& cell = *static_cast<int**>(record);
  if (cell == 0) return VL_WS_OK;
  if (!IsKnownTag(*cell)) return VL_WS_E_INVALID_ARGUMENT;
  int base = FreeOwnFields(*cell, record);
  if (base != VL_WS_TAG_NONE) {
    *cell = base;
    return VL_WS_release(record);
  }
  delete cell;
  cell = 0;
  return VL_WS_OK;
}
