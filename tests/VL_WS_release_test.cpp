// VL_WS_release: every record kind, prepared and filled the way operations fill them, gives back
// everything it owns (the sanitizer build checks for leaks and double frees).
#include <gtest/gtest.h>

#include <initializer_list>
#include <type_traits>

#include "VLRecord.h"
#include "VLUtilities.h"
#include "VL_WS.h"

// The fillers live in the global namespace, beside the record types, so that the array filler
// template finds the element's filler by argument-dependent lookup.
static char* Text(const char* s) { return VLUtilities::StrDup(s); }

// ---- Filling, as operations and converters do: texts by StrDup, arrays by array new -------------

// Records that own nothing but a standard response's message, if they have one.
template <class Record>
static void Fill(Record& r) {
  if constexpr (std::is_base_of<VL_WS_StandardResponse, Record>::value) {
    r.ResponseCode = 3;
    r.ResponseMessage = Text("message");
  }
}
static void FillStandard(VL_WS_StandardResponse& r) { Fill(r); }
static void Fill(VL_WS_String& r) {
  r.Text = Text("hello");
  r.Length = 5;
}
static void Fill(VL_WS_IntArray& r) {
  r.Items = new int[3]{1, 2, 7};
  r.Count = 3;
}
static void Fill(VL_WS_BoolArray& r) {
  r.Items = new bool[2]{true, false};
  r.Count = 2;
}
static void Fill(VL_WS_Image& r) {
  r.Data = new char[4]{'\xff', '\xd8', 0, 1};
  r.Length = 4;
}

// Arrays of records: every element gets its own tag cell and is filled like a single record.
template <class Array>
static void FillItems(Array& r, int count) {
  VLRecordNewItems(r, count);
  for (int i = 0; i < count; ++i) Fill(r.Items[i]);
}

// Gives each text field an owned text.
static void FillTexts(std::initializer_list<char**> texts) {
  for (char** text : texts) *text = Text("text");
}

static void Fill(VL_WS_Genre& r) { r.Name = Text("Drama"); }
static void Fill(VL_WS_GenreArray& r) { FillItems(r, 3); }
static void Fill(VL_WS_GenreLabelResponse& r) {
  FillStandard(r);
  FillTexts({&r.Label, &r.LabelMessage});
}
static void Fill(VL_WS_BonusAssetArray& r) { FillItems(r, 2); }
static void Fill(VL_WS_AudioFile& r) { r.FileLocation = Text("http://a/1.aac"); }
static void Fill(VL_WS_AudioFileArray& r) { FillItems(r, 2); }
static void Fill(VL_WS_ProductListing& r) {
  FillTexts({&r.Price, &r.ExpireDate});
  Fill(r.AvailableAssets);
  Fill(r.AvailableAudioProfiles);
}
static void Fill(VL_WS_ProductListingArray& r) { FillItems(r, 2); }
static void Fill(VL_WS_TitleListing& r) {
  FillTexts(
      {&r.TitleName, &r.BoxArtPrefix, &r.MPAARating, &r.CHVRSRating, &r.LoyaltyPointsForBuy, &r.LoyaltyPointsForRent});
  Fill(r.BonusAssets);
  Fill(r.AvailableProducts);
}
static void Fill(VL_WS_TitleListingArray& r) { FillItems(r, 2); }
static void Fill(VL_WS_TitleListingResponse& r) {
  Fill(static_cast<VL_WS_TitleListing&>(r));
  FillTexts({&r.ResponseMessage, &r.Synopsys, &r.Directors, &r.Actors, &r.Writers, &r.Producers, &r.Copyright,
             &r.RunTime, &r.RatingReason});
}
static void Fill(VL_WS_TitleListingResponseArray& r) { FillItems(r, 2); }
static void Fill(VL_WS_TitlesResponse& r) {
  FillStandard(r);
  Fill(r.Titles);
}
static void Fill(VL_WS_TitlesResponseArray& r) { FillItems(r, 2); }
static void Fill(VL_WS_RecommendedTitlesResponse& r) {
  FillStandard(r);
  Fill(r.Titles);
}
static void Fill(VL_WS_TvEpisode& r) { r.EpisodeName = Text("Pilot"); }
static void Fill(VL_WS_TvEpisodeArray& r) { FillItems(r, 3); }
static void Fill(VL_WS_TvEpisodeListResponse& r) {
  FillStandard(r);
  Fill(r.Episodes);
}
static void Fill(VL_WS_TranslateTivoExternalIDResponse& r) {
  FillStandard(r);
  r.TivoExternalId = Text("tivo");
}
static void Fill(VL_WS_AuthorizeDeviceResponse& r) {
  FillStandard(r);
  FillTexts({&r.AuthToken, &r.EmailAddress, &r.DeviceID, &r.DeviceName});
}
static void Fill(VL_WS_TitleListingPurchased& r) {
  Fill(static_cast<VL_WS_TitleListing&>(r));
  r.RentalPeriod = Text("48 hours");
}
static void Fill(VL_WS_TitleListingPurchasedArray& r) { FillItems(r, 2); }
static void Fill(VL_WS_MyVideosResponse& r) {
  FillStandard(r);
  Fill(r.Titles);
}
static void Fill(VL_WS_WishlistItemsResponse& r) { Fill(static_cast<VL_WS_MyVideosResponse&>(r)); }
static void Fill(VL_WS_TitleListingPurchasedForPass& r) {
  Fill(static_cast<VL_WS_TitleListingPurchased&>(r));
  r.ResponseMessage = Text("pass ok");
}
static void Fill(VL_WS_TitleListingPurchasedForPassArray& r) { FillItems(r, 2); }
static void Fill(VL_WS_PurchaseResponse& r) {
  FillStandard(r);
  r.TransactionAuthNum = Text("auth");
}
static void Fill(VL_WS_OrderTaxResponse& r) {
  FillStandard(r);
  FillTexts({&r.SubTotal, &r.TotalPrice, &r.Tax});
}
static void Fill(VL_WS_BillingInfoResponse& r) {
  FillStandard(r);
  FillTexts({&r.CCLastFour, &r.CCType});
}
static void Fill(VL_WS_BillingInfoAndPPCBalance& r) {
  Fill(r.BillingInfo);
  Fill(r.PPCardBalance);
}
static void Fill(VL_WS_EmailAddressResponse& r) {
  FillStandard(r);
  r.EmailAddress = Text("a@b");
}
static void Fill(VL_WS_SettingsPageResponse& r) {
  FillStandard(r);
  FillTexts({&r.Account, &r.DeviceID, &r.DeviceName});
}
static void Fill(VL_WS_ConfigurationItem& r) { FillTexts({&r.Key, &r.Value}); }
static void Fill(VL_WS_ConfigResponse& r) {
  FillStandard(r);
  FillItems(r, 2);
}
static void Fill(VL_WS_StreamingAssetLocationResponse& r) {
  FillStandard(r);
  FillTexts({&r.StreamingAssetLocation, &r.StreamID, &r.DRMServerURL, &r.DRMACKServerURL, &r.HeartbeatURL});
}
static void Fill(VL_WS_THXMediaDirectorResponse& r) {
  FillStandard(r);
  FillTexts({&r.LongFormat, &r.ShortFormat});
}

namespace {

// ---- Every record kind --------------------------------------------------------------------------

template <class Record>
class EveryRecord : public testing::Test {};

typedef testing::Types<
    VL_WS_Handle, VL_WS_String, VL_WS_StandardResponse, VL_WS_Genre, VL_WS_GenreArray, VL_WS_GenreLabelResponse,
    VL_WS_BonusAsset, VL_WS_BonusAssetArray, VL_WS_IntArray, VL_WS_AudioFileArray, VL_WS_AudioFile,
    VL_WS_ProductListing, VL_WS_ProductListingArray, VL_WS_TitleListing, VL_WS_TitleListingArray,
    VL_WS_TitleListingResponse, VL_WS_TitleListingResponseArray, VL_WS_TitlesResponse, VL_WS_TitlesResponseArray,
    VL_WS_TvEpisode, VL_WS_TvEpisodeArray, VL_WS_TvEpisodeListResponse, VL_WS_AuthorizeDeviceResponse,
    VL_WS_TitleListingPurchased, VL_WS_TitleListingPurchasedArray, VL_WS_MyVideosResponse, VL_WS_WishlistItemsResponse,
    VL_WS_GiftCertificateResponse, VL_WS_AdultVerificationEnabledResponse, VL_WS_AdultVerificationPinResponse,
    VL_WS_PurchaseResponse, VL_WS_StreamingAssetLocationResponse, VL_WS_PrePaidCardBalanceResponse,
    VL_WS_ConfigurationItem, VL_WS_ConfigResponse, VL_WS_BillingInfoResponse, VL_WS_BillingInfoAndPPCBalance,
    VL_WS_SettingsPageResponse, VL_WS_EmailAddressResponse, VL_WS_RecommendedTitlesResponse, VL_WS_OrderTaxResponse,
    VL_WS_RentalExpirationResponse, VL_WS_TitleListingPurchasedForPass, VL_WS_TitleListingPurchasedForPassArray,
    VL_WS_FileType, VL_WS_Version, VL_WS_BoolArray, VL_WS_Image, VL_WS_TranslateTivoExternalIDResponse,
    VL_WS_TranslateSkuIDResponse, VL_WS_THXMediaDirectorResponse>
    RecordTypes;
TYPED_TEST_SUITE(EveryRecord, RecordTypes);

// Empty first, as an operation that tagged its record and then refused (for example with -1000)
// leaves it with tag cells only, its nested ones included; then filled.
TYPED_TEST(EveryRecord, EmptyAndFilledRecordsAreReleasedOnceAndASecondReleaseIsHarmless) {
  TypeParam record;
  VLRecordInit(record);
  EXPECT_EQ(VL_WS_OK, VL_WS_release(&record));
  EXPECT_EQ(nullptr, record.tag);
  VLRecordInit(record);
  ASSERT_NE(nullptr, record.tag);
  EXPECT_EQ(VLRecordTag<TypeParam>::value, *record.tag);
  Fill(record);
  EXPECT_EQ(VL_WS_OK, VL_WS_release(&record));
  EXPECT_EQ(nullptr, record.tag);
  EXPECT_EQ(VL_WS_OK, VL_WS_release(&record));
}

// ---- Particular cases ---------------------------------------------------------------------------

TEST(Release, NestedRecordsAndThoseOfTheBasesAreGivenBackAndCleared) {
  VL_WS_TitlesResponse page;
  Fill(VLRecordInit(page));
  EXPECT_EQ(VL_WS_OK, VL_WS_release(&page));
  EXPECT_EQ(nullptr, page.tag);
  EXPECT_EQ(nullptr, page.ResponseMessage);
  EXPECT_EQ(nullptr, page.Titles.tag);
  EXPECT_EQ(nullptr, page.Titles.Items);
  EXPECT_EQ(0, page.Titles.Count);

  // Wishlist page (27) -> my-videos page (26) -> standard response (3).
  VL_WS_WishlistItemsResponse wishlist;
  Fill(VLRecordInit(wishlist));
  EXPECT_EQ(VL_WS_OK, VL_WS_release(&wishlist));
  EXPECT_EQ(nullptr, wishlist.tag);
  EXPECT_EQ(nullptr, wishlist.ResponseMessage);
  EXPECT_EQ(nullptr, wishlist.Titles.Items);
}

TEST(Release, NoContentsTagFreesOnlyTheCell) {
  int* record[1] = {new int(VL_WS_TAG_NONE)};
  EXPECT_EQ(VL_WS_OK, VL_WS_release(record));
  EXPECT_EQ(nullptr, record[0]);
}

TEST(Release, UnknownTagsAreRefusedAndNothingIsFreed) {
  const int unknown[] = {56, 1000, -1, 45, 46, 47, 48};
  for (int tag : unknown) {
    VL_WS_String record;
    record.tag = new int(tag);
    record.Text = nullptr;
    EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_release(&record)) << tag;
    ASSERT_NE(nullptr, record.tag) << tag;
    EXPECT_EQ(tag, *record.tag);
    delete record.tag;
  }
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_release(nullptr));
}

}  // namespace
