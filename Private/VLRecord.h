// VLRecord.h: preparing the client records of the flat interface for filling.
//
// Every record handed to a caller starts with a heap cell holding its type tag, and so does every
// record nested in it. An operation prepares its out-record with VLRecordInit before it checks
// anything, so that the caller can always release it; converters give array elements their cells
// with VLRecordNewItems. The matching release is VL_WS_release.
//
// Allocation rules that VL_WS_release relies on: a tag cell is `new int`, texts and plain-value
// arrays are array new (texts through VLUtilities::StrDup), record arrays come from
// VLRecordNewItems.
#ifndef VLRECORD_H
#define VLRECORD_H

#include <string.h>

#include <type_traits>

#include "VL_WS_Records.h"

// The type tag of each record type.
template <class Record>
struct VLRecordTag;

#define VL_RECORD_TAG(Record, Tag) \
  template <>                      \
  struct VLRecordTag<Record> {     \
    enum { value = Tag };          \
  };
VL_RECORD_TAG(VL_WS_Handle, VL_WS_TAG_HANDLE)
VL_RECORD_TAG(VL_WS_String, VL_WS_TAG_STRING)
VL_RECORD_TAG(VL_WS_StandardResponse, VL_WS_TAG_STANDARD_RESPONSE)
VL_RECORD_TAG(VL_WS_Genre, VL_WS_TAG_GENRE)
VL_RECORD_TAG(VL_WS_GenreArray, VL_WS_TAG_GENRE_ARRAY)
VL_RECORD_TAG(VL_WS_GenreLabelResponse, VL_WS_TAG_GENRE_LABEL_RESPONSE)
VL_RECORD_TAG(VL_WS_BonusAsset, VL_WS_TAG_BONUS_ASSET)
VL_RECORD_TAG(VL_WS_BonusAssetArray, VL_WS_TAG_BONUS_ASSET_ARRAY)
VL_RECORD_TAG(VL_WS_IntArray, VL_WS_TAG_INT_ARRAY)
VL_RECORD_TAG(VL_WS_AudioFileArray, VL_WS_TAG_AUDIO_FILE_ARRAY)
VL_RECORD_TAG(VL_WS_AudioFile, VL_WS_TAG_AUDIO_FILE)
VL_RECORD_TAG(VL_WS_ProductListing, VL_WS_TAG_PRODUCT_LISTING)
VL_RECORD_TAG(VL_WS_ProductListingArray, VL_WS_TAG_PRODUCT_LISTING_ARRAY)
VL_RECORD_TAG(VL_WS_TitleListing, VL_WS_TAG_TITLE_LISTING)
VL_RECORD_TAG(VL_WS_TitleListingArray, VL_WS_TAG_TITLE_LISTING_ARRAY)
VL_RECORD_TAG(VL_WS_TitleListingResponse, VL_WS_TAG_TITLE_LISTING_RESPONSE)
VL_RECORD_TAG(VL_WS_TitleListingResponseArray, VL_WS_TAG_TITLE_LISTING_RESPONSE_ARRAY)
VL_RECORD_TAG(VL_WS_TitlesResponse, VL_WS_TAG_TITLES_RESPONSE)
VL_RECORD_TAG(VL_WS_TitlesResponseArray, VL_WS_TAG_TITLES_RESPONSE_ARRAY)
VL_RECORD_TAG(VL_WS_TvEpisode, VL_WS_TAG_TV_EPISODE)
VL_RECORD_TAG(VL_WS_TvEpisodeArray, VL_WS_TAG_TV_EPISODE_ARRAY)
VL_RECORD_TAG(VL_WS_TvEpisodeListResponse, VL_WS_TAG_TV_EPISODE_LIST_RESPONSE)
VL_RECORD_TAG(VL_WS_AuthorizeDeviceResponse, VL_WS_TAG_AUTHORIZE_DEVICE_RESPONSE)
VL_RECORD_TAG(VL_WS_TitleListingPurchased, VL_WS_TAG_TITLE_LISTING_PURCHASED)
VL_RECORD_TAG(VL_WS_TitleListingPurchasedArray, VL_WS_TAG_TITLE_LISTING_PURCHASED_ARRAY)
VL_RECORD_TAG(VL_WS_MyVideosResponse, VL_WS_TAG_MY_VIDEOS_RESPONSE)
VL_RECORD_TAG(VL_WS_WishlistItemsResponse, VL_WS_TAG_WISHLIST_ITEMS_RESPONSE)
VL_RECORD_TAG(VL_WS_GiftCertificateResponse, VL_WS_TAG_GIFT_CERTIFICATE_RESPONSE)
VL_RECORD_TAG(VL_WS_AdultVerificationEnabledResponse, VL_WS_TAG_ADULT_VERIFICATION_ENABLED_RESPONSE)
VL_RECORD_TAG(VL_WS_AdultVerificationPinResponse, VL_WS_TAG_ADULT_VERIFICATION_PIN_RESPONSE)
VL_RECORD_TAG(VL_WS_PurchaseResponse, VL_WS_TAG_PURCHASE_RESPONSE)
VL_RECORD_TAG(VL_WS_StreamingAssetLocationResponse, VL_WS_TAG_STREAMING_ASSET_LOCATION_RESPONSE)
VL_RECORD_TAG(VL_WS_PrePaidCardBalanceResponse, VL_WS_TAG_PREPAID_CARD_BALANCE_RESPONSE)
VL_RECORD_TAG(VL_WS_ConfigurationItem, VL_WS_TAG_CONFIGURATION_ITEM)
VL_RECORD_TAG(VL_WS_ConfigResponse, VL_WS_TAG_CONFIG_RESPONSE)
VL_RECORD_TAG(VL_WS_BillingInfoResponse, VL_WS_TAG_BILLING_INFO_RESPONSE)
VL_RECORD_TAG(VL_WS_BillingInfoAndPPCBalance, VL_WS_TAG_BILLING_INFO_AND_PPC_BALANCE)
VL_RECORD_TAG(VL_WS_SettingsPageResponse, VL_WS_TAG_SETTINGS_PAGE_RESPONSE)
VL_RECORD_TAG(VL_WS_EmailAddressResponse, VL_WS_TAG_EMAIL_ADDRESS_RESPONSE)
VL_RECORD_TAG(VL_WS_RecommendedTitlesResponse, VL_WS_TAG_RECOMMENDED_TITLES_RESPONSE)
VL_RECORD_TAG(VL_WS_OrderTaxResponse, VL_WS_TAG_ORDER_TAX_RESPONSE)
VL_RECORD_TAG(VL_WS_RentalExpirationResponse, VL_WS_TAG_RENTAL_EXPIRATION_RESPONSE)
VL_RECORD_TAG(VL_WS_TitleListingPurchasedForPass, VL_WS_TAG_TITLE_LISTING_PURCHASED_FOR_PASS)
VL_RECORD_TAG(VL_WS_TitleListingPurchasedForPassArray,
              VL_WS_TAG_TITLE_LISTING_PURCHASED_FOR_PASS_ARRAY)
VL_RECORD_TAG(VL_WS_FileType, VL_WS_TAG_FILE_TYPE)
VL_RECORD_TAG(VL_WS_Version, VL_WS_TAG_VERSION)
VL_RECORD_TAG(VL_WS_BoolArray, VL_WS_TAG_BOOL_ARRAY)
VL_RECORD_TAG(VL_WS_Image, VL_WS_TAG_IMAGE)
VL_RECORD_TAG(VL_WS_TranslateTivoExternalIDResponse, VL_WS_TAG_TRANSLATE_TIVO_EXTERNAL_ID_RESPONSE)
VL_RECORD_TAG(VL_WS_TranslateSkuIDResponse, VL_WS_TAG_TRANSLATE_SKU_ID_RESPONSE)
VL_RECORD_TAG(VL_WS_THXMediaDirectorResponse, VL_WS_TAG_THX_MEDIA_DIRECTOR_RESPONSE)
#undef VL_RECORD_TAG

// Tags the records nested in a record. Records whose base has the nested records (a purchased
// title, a wishlist page) reach their base's overload; records without any reach the first one.
void VLRecordInitNested(const void* record);
void VLRecordInitNested(VL_WS_ProductListing* record);
void VLRecordInitNested(VL_WS_TitleListing* record);
void VLRecordInitNested(VL_WS_TitlesResponse* record);
void VLRecordInitNested(VL_WS_RecommendedTitlesResponse* record);
void VLRecordInitNested(VL_WS_TvEpisodeListResponse* record);
void VLRecordInitNested(VL_WS_MyVideosResponse* record);
void VLRecordInitNested(VL_WS_BillingInfoAndPPCBalance* record);

// Clears a record and gives it, and every record nested in it, a new tag cell. The record must
// not own anything (a filled record is released first).
template <class Record>
Record& VLRecordInit(Record& record) {
  static_assert(std::is_trivially_copyable<Record>::value, "client records are plain data");
  memset(static_cast<void*>(&record), 0, sizeof(Record));
  record.tag = new int(VLRecordTag<Record>::value);
  VLRecordInitNested(&record);
  return record;
}

// Fills a string record prepared with VLRecordInit with an owned copy of text (an empty one for
// null) and its length.
void VLRecordSetString(VL_WS_String& record, const char* text);

// Gives an empty array record `count` cleared and tagged elements (nothing for a count below 1).
template <class Array>
void VLRecordNewItems(Array& array, int count) {
  typedef typename std::remove_reference<decltype(*array.Items)>::type Item;
  if (count < 1) return;
  array.Items = new Item[count];
  array.Count = count;
  for (int i = 0; i < count; ++i) VLRecordInit(array.Items[i]);
}

#endif  // VLRECORD_H
