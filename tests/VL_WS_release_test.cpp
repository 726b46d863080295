// VL_WS_release: every record kind, prepared and filled the way operations fill them, gives back
// everything it owns (the sanitizer build checks for leaks and double frees).
#include <gtest/gtest.h>

#include "VLRecord.h"
#include "VLUtilities.h"
#include "VL_WS.h"

// The fillers live in the global namespace, beside the record types, so that the array filler
// template finds the element's filler by argument-dependent lookup.
static char* Text(const char* s) { return VLUtilities::StrDup(s); }

// ---- Filling, as operations and converters do: texts by StrDup, arrays by array new -------------

static void Fill(VL_WS_Handle&) {}
static void Fill(VL_WS_String& r) {
  r.Text = Text("hello");
  r.Length = 5;
}
static void Fill(VL_WS_StandardResponse& r) {
  r.ResponseCode = 3;
  r.ResponseMessage = Text("message");
}
static void Fill(VL_WS_IntArray& r) {
  r.Items = new int[3]{1, 2, 7};
  r.Count = 3;
}
static void Fill(VL_WS_BoolArray& r) {
  r.Items = new bool[2]{true, false};
  r.Count = 2;
}
static void Fill(VL_WS_Version& r) {
  r.Major = 1;
  r.Minor = 3;
  r.Revision = 1;
}
static void Fill(VL_WS_Image& r) {
  r.Data = new char[4]{'\xff', '\xd8', 0, 1};
  r.Length = 4;
}
static void Fill(VL_WS_FileType& r) { r.File_AccessType = STREAM; }

// Arrays of records: every element gets its own tag cell and is filled like a single record.
template <class Array>
static void FillItems(Array& r, int count) {
  VLRecordNewItems(r, count);
  for (int i = 0; i < count; ++i) Fill(r.Items[i]);
}

static void Fill(VL_WS_Genre& r) { r.Name = Text("Drama"); }
static void Fill(VL_WS_GenreArray& r) { FillItems(r, 3); }
static void Fill(VL_WS_GenreLabelResponse& r) {
  Fill(static_cast<VL_WS_StandardResponse&>(r));
  r.Label = Text("label");
  r.LabelMessage = Text("label message");
}
static void Fill(VL_WS_BonusAsset& r) { r.BonusAssetID = 9; }
static void Fill(VL_WS_BonusAssetArray& r) { FillItems(r, 2); }
static void Fill(VL_WS_AudioFile& r) { r.FileLocation = Text("http://a/1.aac"); }
static void Fill(VL_WS_AudioFileArray& r) { FillItems(r, 2); }
static void Fill(VL_WS_ProductListing& r) {
  r.Price = Text("3.99");
  Fill(r.AvailableAssets);
  r.ExpireDate = Text("2011/05/01 10:20:30");
  Fill(r.AvailableAudioProfiles);
}
static void Fill(VL_WS_ProductListingArray& r) { FillItems(r, 2); }
static void Fill(VL_WS_TitleListing& r) {
  r.TitleName = Text("Title");
  r.BoxArtPrefix = Text("prefix");
  Fill(r.BonusAssets);
  r.MPAARating = Text("PG");
  Fill(r.AvailableProducts);
  r.CHVRSRating = Text("G");
  r.LoyaltyPointsForBuy = Text("10");
  r.LoyaltyPointsForRent = Text("");
}
static void Fill(VL_WS_TitleListingArray& r) { FillItems(r, 2); }
static void Fill(VL_WS_TitleListingResponse& r) {
  Fill(static_cast<VL_WS_TitleListing&>(r));
  r.ResponseMessage = Text("ok");
  r.Synopsys = Text("synopsis");
  r.Directors = Text("d");
  r.Actors = Text("a");
  r.Writers = Text("w");
  r.Producers = Text("p");
  r.Copyright = Text("c");
  r.RunTime = Text("90");
  r.RatingReason = Text("r");
}
static void Fill(VL_WS_TitleListingResponseArray& r) { FillItems(r, 2); }
static void Fill(VL_WS_TitlesResponse& r) {
  Fill(static_cast<VL_WS_StandardResponse&>(r));
  Fill(r.Titles);
}
static void Fill(VL_WS_TitlesResponseArray& r) { FillItems(r, 2); }
static void Fill(VL_WS_RecommendedTitlesResponse& r) {
  Fill(static_cast<VL_WS_StandardResponse&>(r));
  Fill(r.Titles);
}
static void Fill(VL_WS_TvEpisode& r) { r.EpisodeName = Text("Pilot"); }
static void Fill(VL_WS_TvEpisodeArray& r) { FillItems(r, 3); }
static void Fill(VL_WS_TvEpisodeListResponse& r) {
  Fill(static_cast<VL_WS_StandardResponse&>(r));
  Fill(r.Episodes);
}
static void Fill(VL_WS_TranslateTivoExternalIDResponse& r) {
  Fill(static_cast<VL_WS_StandardResponse&>(r));
  r.TivoExternalId = Text("tivo");
}
static void Fill(VL_WS_TranslateSkuIDResponse& r) { Fill(static_cast<VL_WS_StandardResponse&>(r)); }
static void Fill(VL_WS_AuthorizeDeviceResponse& r) {
  Fill(static_cast<VL_WS_StandardResponse&>(r));
  r.AuthToken = Text("token");
  r.EmailAddress = Text("a@b");
  r.DeviceID = Text("id");
  r.DeviceName = Text("name");
}
static void Fill(VL_WS_TitleListingPurchased& r) {
  Fill(static_cast<VL_WS_TitleListing&>(r));
  r.RentalPeriod = Text("48 hours");
}
static void Fill(VL_WS_TitleListingPurchasedArray& r) { FillItems(r, 2); }
static void Fill(VL_WS_MyVideosResponse& r) {
  Fill(static_cast<VL_WS_StandardResponse&>(r));
  Fill(r.Titles);
}
static void Fill(VL_WS_WishlistItemsResponse& r) {
  Fill(static_cast<VL_WS_MyVideosResponse&>(r));
  r.SortOrder = 2;
}
static void Fill(VL_WS_TitleListingPurchasedForPass& r) {
  Fill(static_cast<VL_WS_TitleListingPurchased&>(r));
  r.ResponseMessage = Text("pass ok");
}
static void Fill(VL_WS_TitleListingPurchasedForPassArray& r) { FillItems(r, 2); }
static void Fill(VL_WS_PurchaseResponse& r) {
  Fill(static_cast<VL_WS_StandardResponse&>(r));
  r.TransactionAuthNum = Text("auth");
}
static void Fill(VL_WS_OrderTaxResponse& r) {
  Fill(static_cast<VL_WS_StandardResponse&>(r));
  r.SubTotal = Text("9.99");
  r.TotalPrice = Text("10.99");
  r.Tax = Text("1.00");
}
static void Fill(VL_WS_GiftCertificateResponse& r) { Fill(static_cast<VL_WS_StandardResponse&>(r)); }
static void Fill(VL_WS_PrePaidCardBalanceResponse& r) { Fill(static_cast<VL_WS_StandardResponse&>(r)); }
static void Fill(VL_WS_BillingInfoResponse& r) {
  Fill(static_cast<VL_WS_StandardResponse&>(r));
  r.CCLastFour = Text("1234");
  r.CCType = Text("VISA");
}
static void Fill(VL_WS_BillingInfoAndPPCBalance& r) {
  Fill(r.BillingInfo);
  Fill(r.PPCardBalance);
}
static void Fill(VL_WS_AdultVerificationEnabledResponse& r) {
  Fill(static_cast<VL_WS_StandardResponse&>(r));
}
static void Fill(VL_WS_AdultVerificationPinResponse& r) { Fill(static_cast<VL_WS_StandardResponse&>(r)); }
static void Fill(VL_WS_RentalExpirationResponse& r) { Fill(static_cast<VL_WS_StandardResponse&>(r)); }
static void Fill(VL_WS_EmailAddressResponse& r) {
  Fill(static_cast<VL_WS_StandardResponse&>(r));
  r.EmailAddress = Text("a@b");
}
static void Fill(VL_WS_SettingsPageResponse& r) {
  Fill(static_cast<VL_WS_StandardResponse&>(r));
  r.Account = Text("account");
  r.DeviceID = Text("id");
  r.DeviceName = Text("name");
}
static void Fill(VL_WS_ConfigurationItem& r) {
  r.Key = Text("BandwithCheckURL");
  r.Value = Text("http://host/probe");
}
static void Fill(VL_WS_ConfigResponse& r) {
  Fill(static_cast<VL_WS_StandardResponse&>(r));
  FillItems(r, 2);
}
static void Fill(VL_WS_StreamingAssetLocationResponse& r) {
  Fill(static_cast<VL_WS_StandardResponse&>(r));
  r.StreamingAssetLocation = Text("rtmpe://x");
  r.StreamID = Text("s1");
  r.DRMServerURL = Text("https://drm");
  r.DRMACKServerURL = Text("https://ack");
  r.HeartbeatURL = Text("https://hb");
}
static void Fill(VL_WS_THXMediaDirectorResponse& r) {
  Fill(static_cast<VL_WS_StandardResponse&>(r));
  r.LongFormat = Text("long");
  r.ShortFormat = Text("short");
}

namespace {

// ---- Every record kind --------------------------------------------------------------------------

template <class Record>
class EveryRecord : public testing::Test {};

typedef testing::Types<
    VL_WS_Handle, VL_WS_String, VL_WS_StandardResponse, VL_WS_Genre, VL_WS_GenreArray,
    VL_WS_GenreLabelResponse, VL_WS_BonusAsset, VL_WS_BonusAssetArray, VL_WS_IntArray,
    VL_WS_AudioFileArray, VL_WS_AudioFile, VL_WS_ProductListing, VL_WS_ProductListingArray,
    VL_WS_TitleListing, VL_WS_TitleListingArray, VL_WS_TitleListingResponse,
    VL_WS_TitleListingResponseArray, VL_WS_TitlesResponse, VL_WS_TitlesResponseArray,
    VL_WS_TvEpisode, VL_WS_TvEpisodeArray, VL_WS_TvEpisodeListResponse,
    VL_WS_AuthorizeDeviceResponse, VL_WS_TitleListingPurchased, VL_WS_TitleListingPurchasedArray,
    VL_WS_MyVideosResponse, VL_WS_WishlistItemsResponse, VL_WS_GiftCertificateResponse,
    VL_WS_AdultVerificationEnabledResponse, VL_WS_AdultVerificationPinResponse,
    VL_WS_PurchaseResponse, VL_WS_StreamingAssetLocationResponse,
    VL_WS_PrePaidCardBalanceResponse, VL_WS_ConfigurationItem, VL_WS_ConfigResponse,
    VL_WS_BillingInfoResponse, VL_WS_BillingInfoAndPPCBalance, VL_WS_SettingsPageResponse,
    VL_WS_EmailAddressResponse, VL_WS_RecommendedTitlesResponse, VL_WS_OrderTaxResponse,
    VL_WS_RentalExpirationResponse, VL_WS_TitleListingPurchasedForPass,
    VL_WS_TitleListingPurchasedForPassArray, VL_WS_FileType, VL_WS_Version, VL_WS_BoolArray,
    VL_WS_Image, VL_WS_TranslateTivoExternalIDResponse, VL_WS_TranslateSkuIDResponse,
    VL_WS_THXMediaDirectorResponse>
    RecordTypes;
TYPED_TEST_SUITE(EveryRecord, RecordTypes);

TYPED_TEST(EveryRecord, FilledRecordIsReleasedOnceAndSecondReleaseIsHarmless) {
  TypeParam record;
  VLRecordInit(record);
  ASSERT_NE(nullptr, record.tag);
  EXPECT_EQ(VLRecordTag<TypeParam>::value, *record.tag);
  Fill(record);
  EXPECT_EQ(VL_WS_OK, VL_WS_release(&record));
  EXPECT_EQ(nullptr, record.tag);
  EXPECT_EQ(VL_WS_OK, VL_WS_release(&record));
}

// A record that an operation tagged and then refused (for example with -1000) holds only tag
// cells, its nested ones included.
TYPED_TEST(EveryRecord, TaggedEmptyRecordIsReleased) {
  TypeParam record;
  VLRecordInit(record);
  EXPECT_EQ(VL_WS_OK, VL_WS_release(&record));
  EXPECT_EQ(nullptr, record.tag);
}

// ---- Particular cases ---------------------------------------------------------------------------

TEST(Release, TitlesResponseGivesBackEveryNestedRecord) {
  VL_WS_TitlesResponse page;
  VLRecordInit(page);
  Fill(page);
  ASSERT_EQ(2, page.Titles.Count);
  VL_WS_TitleListing& title = page.Titles.Items[1];
  ASSERT_EQ(2, title.AvailableProducts.Count);
  EXPECT_EQ(VL_WS_TAG_PRODUCT_LISTING, *title.AvailableProducts.Items[0].tag);
  EXPECT_EQ(2, title.AvailableProducts.Items[1].AvailableAudioProfiles.Count);
  EXPECT_EQ(3, title.AvailableProducts.Items[1].AvailableAssets.Count);
  EXPECT_EQ(2, title.BonusAssets.Count);

  EXPECT_EQ(VL_WS_OK, VL_WS_release(&page));
  EXPECT_EQ(nullptr, page.tag);
  EXPECT_EQ(nullptr, page.ResponseMessage);
  EXPECT_EQ(nullptr, page.Titles.tag);
  EXPECT_EQ(nullptr, page.Titles.Items);
  EXPECT_EQ(0, page.Titles.Count);
}

TEST(Release, ExtendedRecordGoesThroughItsBases) {
  // Wishlist page (27) -> my-videos page (26) -> standard response (3).
  VL_WS_WishlistItemsResponse wishlist;
  VLRecordInit(wishlist);
  Fill(wishlist);
  EXPECT_EQ(VL_WS_OK, VL_WS_release(&wishlist));
  EXPECT_EQ(nullptr, wishlist.tag);
  EXPECT_EQ(nullptr, wishlist.ResponseMessage);
  EXPECT_EQ(nullptr, wishlist.Titles.Items);
}

TEST(Release, ArrayWithoutElementsKeepsItsCell) {
  // A title whose products were missing: the product array has count 0 and still a tag cell.
  VL_WS_TitleListing title;
  VLRecordInit(title);
  EXPECT_EQ(0, title.AvailableProducts.Count);
  EXPECT_EQ(nullptr, title.AvailableProducts.Items);
  ASSERT_NE(nullptr, title.AvailableProducts.tag);
  EXPECT_EQ(VL_WS_TAG_PRODUCT_LISTING_ARRAY, *title.AvailableProducts.tag);
  EXPECT_EQ(VL_WS_OK, VL_WS_release(&title));
}

TEST(Release, HandleWithoutClientStateLosesOnlyItsCell) {
  VL_WS_Handle handle;
  VLRecordInit(handle);
  EXPECT_EQ(VL_WS_OK, VL_WS_release(&handle));
  EXPECT_EQ(nullptr, handle.tag);
  EXPECT_EQ(nullptr, handle.client);
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
