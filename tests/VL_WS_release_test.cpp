// VL_WS_release: every record kind, as an operation prepares it before it checks anything (tag
// cells only, nested ones included), is given back once and a second release is harmless; unknown
// tags are refused. Records filled by the real converters are released by the operations' own
// tests, where the sanitizer build checks for leaks and double frees.
#include <gtest/gtest.h>

#include "VLRecord.h"
#include "VL_WS.h"

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

TYPED_TEST(EveryRecord, APreparedRecordIsReleasedOnceAndASecondReleaseIsHarmless) {
  TypeParam record;
  VLRecordInit(record);
  ASSERT_NE(nullptr, record.tag);
  EXPECT_EQ(VLRecordTag<TypeParam>::value, *record.tag);
  EXPECT_EQ(VL_WS_OK, VL_WS_release(&record));
  EXPECT_EQ(nullptr, record.tag);
  EXPECT_EQ(VL_WS_OK, VL_WS_release(&record));
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
