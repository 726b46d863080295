// Record conversion: store answers decoded by the SOAP runtime from XML, converted into client
// records, checked field by field and released (the sanitizer build checks that nothing leaks).
#include <gtest/gtest.h>

#include <sstream>
#include <string>

#include "VLRecord.h"
#include "VLStoreHosts.h"
#include "VLUtilities.h"
#include "VL_WS.h"
#include "soapH.h"

namespace {

class Convert : public testing::Test {
 public:
  Convert() : m_Soap(soap_new()) { soap_set_namespaces(m_Soap, namespaces); }
  ~Convert() override {
    soap_destroy(m_Soap);
    soap_end(m_Soap);
    soap_free(m_Soap);
  }

  // Reads a schema record from the content of one element, as it arrives in an answer.
  template <class Schema>
  Schema* Read(Schema* record, const std::string& content) {
    std::string xml = "<r xmlns:VL1=\"" VL_API_NAMESPACE "\">" + content + "</r>";
    std::istringstream in(xml);
    m_Soap->is = &in;
    bool ok = soap_begin_recv(m_Soap) == SOAP_OK && record->soap_in(m_Soap, "r", nullptr) != nullptr &&
              soap_end_recv(m_Soap) == SOAP_OK;
    m_Soap->is = nullptr;
    EXPECT_TRUE(ok) << "cannot read " << xml;
    return record;
  }

 protected:
  struct soap* m_Soap;
};

std::string E(const std::string& name, const std::string& value) {
  return "<VL1:" + name + ">" + value + "</VL1:" + name + ">";
}

const std::string kProduct =
    "<VL1:ProductListing>" + E("SkuID", "501") + E("PurchaseType", "buy") + E("Price", "3.99") +
    E("AvailableAssets", E("FileProfile", "HIGH_DEFINITION") + E("FileProfile", "7")) +
    E("ExpireDate", "2011-05-01T10:20:30") +
    E("AvailableAudioProfiles",
      E("AudioFile", E("AssetAudioID", "11") + E("FileLocation", "http://a/11.aac") +
                         E("ContainsVideo", "true") + E("AudioAssetProfile", "Dolby_Digital_Plus_51")) +
          E("AudioFile", E("AssetAudioID", "12"))) +
    E("RentalPeriod", "48") + "</VL1:ProductListing>";

const std::string kTitleFields =
    E("TitleID", "42") + E("TitleName", "Heat") + E("BoxArtPrefix", "heat_1995") +
    E("TitlePosition", "3") + E("EpisodeNumber", "0") +
    E("BonusAssets", "<VL1:BonusAsset BonusAssetID=\"900\" Profile=\"STANDARD\" BonusType=\"Trailer\"/>") +
    E("IsTvListing", "false") + E("MPAARating", "R") + E("AvailableProducts", kProduct) +
    E("IsTHXMediaDirectorEnabled", "true") + E("IsTHXMediaDirectorEnabledForTrailer", "false") +
    E("CHVRSRating", "18A") + E("LoyaltyPointsForBuy", "20");

void ExpectTitleFields(const VL_WS_TitleListing& t) {
  EXPECT_EQ(42, t.TitleID);
  EXPECT_STREQ("Heat", t.TitleName);
  EXPECT_STREQ("heat_1995", t.BoxArtPrefix);
  EXPECT_EQ(3, t.TitlePosition);
  ASSERT_EQ(1, t.BonusAssets.Count);
  EXPECT_EQ(VL_WS_TAG_BONUS_ASSET, *t.BonusAssets.Items[0].tag);
  EXPECT_EQ(900, t.BonusAssets.Items[0].BonusAssetID);
  EXPECT_EQ(1, t.BonusAssets.Items[0].Profile);
  EXPECT_EQ(0, t.BonusAssets.Items[0].BonusType);
  EXPECT_FALSE(t.IsTvListing);
  EXPECT_STREQ("R", t.MPAARating);
  EXPECT_TRUE(t.IsTHXMediaDirectorEnabled);
  EXPECT_FALSE(t.IsTHXMediaDirectorEnabledForTrailer);
  EXPECT_STREQ("18A", t.CHVRSRating);
  EXPECT_STREQ("20", t.LoyaltyPointsForBuy);
  ASSERT_NE(nullptr, t.LoyaltyPointsForRent);  // missing: an owned empty text
  EXPECT_STREQ("", t.LoyaltyPointsForRent);

  ASSERT_EQ(1, t.AvailableProducts.Count);
  const VL_WS_ProductListing& p = t.AvailableProducts.Items[0];
  EXPECT_EQ(VL_WS_TAG_PRODUCT_LISTING, *p.tag);
  EXPECT_EQ(501, p.SkuID);
  EXPECT_EQ(1, p.PurchaseType);
  EXPECT_STREQ("3.99", p.Price);
  EXPECT_STREQ("2011/05/01 10:20:30", p.ExpireDate);
  EXPECT_EQ(48, p.RentalPeriod);
  ASSERT_EQ(2, p.AvailableAssets.Count);
  EXPECT_EQ(2, p.AvailableAssets.Items[0]);
  EXPECT_EQ(7, p.AvailableAssets.Items[1]);
  ASSERT_EQ(2, p.AvailableAudioProfiles.Count);
  const VL_WS_AudioFile& a = p.AvailableAudioProfiles.Items[0];
  EXPECT_EQ(VL_WS_TAG_AUDIO_FILE, *a.tag);
  EXPECT_EQ(11, a.AssetAudioID);
  EXPECT_STREQ("http://a/11.aac", a.FileLocation);
  EXPECT_TRUE(a.ContainsVideo);
  EXPECT_EQ(3, a.AudioAssetProfile);
  EXPECT_STREQ("", p.AvailableAudioProfiles.Items[1].FileLocation);
}

TEST_F(Convert, TitlePageCopiesEveryFieldAndReleasesCompletely) {
  VL1__GetTitlesResponse* t = Read(
      soap_new_VL1__GetTitlesResponse(m_Soap),
      E("ResponseCode", "0") + E("ResponseMessage", "OK") + E("GenreID", "17") +
          E("CurrentPageNumber", "2") + E("ItemsPerPage", "20") + E("TotalPages", "-3") +
          E("TotalItems", "41") +
          E("Titles", E("TitleListing", kTitleFields) + E("TitleListing", E("TitleID", "43"))));
  VL_WS_TitlesResponse r;
  VLRecordInit(r);
  VLUtilities::VL1__GetTitlesResponse2VL_WS_TitlesResponse(t, r);

  EXPECT_EQ(0, r.ResponseCode);
  EXPECT_STREQ("OK", r.ResponseMessage);
  EXPECT_EQ(17, r.GenreID);
  EXPECT_EQ(2, r.CurrentPageNumber);
  EXPECT_EQ(20, r.ItemsPerPage);
  EXPECT_EQ(-3, r.TotalPages);
  EXPECT_EQ(41, r.TotalItems);
  ASSERT_EQ(2, r.Titles.Count);
  EXPECT_EQ(VL_WS_TAG_TITLE_LISTING, *r.Titles.Items[0].tag);
  ExpectTitleFields(r.Titles.Items[0]);

  // A title without products or bonus assets has empty arrays that still carry their cells.
  const VL_WS_TitleListing& bare = r.Titles.Items[1];
  EXPECT_EQ(43, bare.TitleID);
  EXPECT_STREQ("", bare.TitleName);
  EXPECT_EQ(0, bare.AvailableProducts.Count);
  EXPECT_EQ(nullptr, bare.AvailableProducts.Items);
  ASSERT_NE(nullptr, bare.AvailableProducts.tag);
  EXPECT_EQ(VL_WS_TAG_PRODUCT_LISTING_ARRAY, *bare.AvailableProducts.tag);
  EXPECT_EQ(0, bare.BonusAssets.Count);

  EXPECT_EQ(VL_WS_OK, VL_WS_release(&r));
  EXPECT_EQ(VL_WS_OK, VL_WS_release(&r));
}

TEST_F(Convert, TitleArraysAreBuiltOnlyWithElements) {
  VL_WS_TitlesResponse empty, missing;
  VLRecordInit(empty);
  VLRecordInit(missing);
  VLUtilities::VL1__GetTitlesResponse2VL_WS_TitlesResponse(
      Read(soap_new_VL1__GetTitlesResponse(m_Soap), E("ResponseCode", "5") + "<VL1:Titles/>"), empty);
  VLUtilities::VL1__GetTitlesResponse2VL_WS_TitlesResponse(
      Read(soap_new_VL1__GetTitlesResponse(m_Soap), E("ResponseCode", "0")), missing);
  EXPECT_EQ(5, empty.ResponseCode);
  EXPECT_STREQ("", empty.ResponseMessage);
  for (VL_WS_TitlesResponse* r : {&empty, &missing}) {
    EXPECT_EQ(0, r->Titles.Count);
    EXPECT_EQ(nullptr, r->Titles.Items);
    EXPECT_NE(nullptr, r->Titles.tag);
    EXPECT_EQ(VL_WS_OK, VL_WS_release(r));
  }
}

std::string ExpireDateOf(Convert& test, struct soap* soap, const std::string& element) {
  VL1__TitleListing* t = test.Read(
      soap_new_VL1__TitleListing(soap),
      E("AvailableProducts", "<VL1:ProductListing>" + element + "</VL1:ProductListing>"));
  VL_WS_TitleListing r;
  VLRecordInit(r);
  VLUtilities::VL1__TitleListing2VL_WS_TitleListing(t, r);
  std::string date = r.AvailableProducts.Count == 1 ? r.AvailableProducts.Items[0].ExpireDate : "?";
  VL_WS_release(&r);
  return date;
}

TEST_F(Convert, ExpireDateIsReformatted) {
  EXPECT_EQ("2011/05/01 10:20:30", ExpireDateOf(*this, m_Soap, E("ExpireDate", "2011-05-01T10:20:30")));
  EXPECT_EQ("2011/12/31 23:59:59",
            ExpireDateOf(*this, m_Soap, E("ExpireDate", "2011-12-31T23:59:59.123-05:00")));
  // Missing or unreadable: the all-zero time.
  EXPECT_EQ("1900/01/00 00:00:00", ExpireDateOf(*this, m_Soap, E("SkuID", "1")));
  EXPECT_EQ("1900/01/00 00:00:00", ExpireDateOf(*this, m_Soap, E("ExpireDate", "")));
  EXPECT_EQ("1900/01/00 00:00:00", ExpireDateOf(*this, m_Soap, E("ExpireDate", "next week")));
  EXPECT_EQ("1900/01/00 00:00:00", ExpireDateOf(*this, m_Soap, E("ExpireDate", "2011-13-01T10:20:30")));
}

TEST_F(Convert, TitleDetailsAndEpisodeListings) {
  const std::string details = kTitleFields + E("ResponseCode", "0") + E("ResponseMessage", "fine") +
                              E("Synopsys", "A heist.") + E("UserRating", "4") + E("Directors", "Mann") +
                              E("Actors", "Pacino, De Niro") + E("Writers", "Mann") +
                              E("Producers", "P") + E("Copyright", "1995") + E("RunTime", "170") +
                              E("IsAvailInUserWishList", "true") + E("RatingReason", "violence");
  VL_WS_TitleListingResponse r;
  VLRecordInit(r);
  VLUtilities::VL1__TitleListingResponse2VL_WS_TitleListingResponse(
      Read(soap_new_VL1__TitleListingResponse(m_Soap), details), r);
  ExpectTitleFields(r);
  EXPECT_STREQ("fine", r.ResponseMessage);
  EXPECT_STREQ("A heist.", r.Synopsys);
  EXPECT_EQ(4, r.UserRating);
  EXPECT_STREQ("Pacino, De Niro", r.Actors);
  EXPECT_STREQ("1995", r.Copyright);
  EXPECT_STREQ("170", r.RunTime);
  EXPECT_STREQ("violence", r.RatingReason);
  EXPECT_EQ(VL_WS_OK, VL_WS_release(&r));

  VL_WS_TitleListingResponseArray all;
  VLRecordInit(all);
  VLUtilities::VL1__ArrayOfTitleListingResponse2VL_WS_TitleListingResponseArray(
      Read(soap_new_VL1__ArrayOfTitleListingResponse(m_Soap),
           E("TitleListingResponse", details) + E("TitleListingResponse", E("TitleID", "8"))),
      all);
  ASSERT_EQ(2, all.Count);
  EXPECT_EQ(VL_WS_TAG_TITLE_LISTING_RESPONSE, *all.Items[1].tag);
  EXPECT_STREQ("A heist.", all.Items[0].Synopsys);
  EXPECT_EQ(8, all.Items[1].TitleID);
  EXPECT_STREQ("", all.Items[1].Synopsys);
  EXPECT_EQ(VL_WS_OK, VL_WS_release(&all));

  VL_WS_TvEpisodeListResponse episodes;
  VLRecordInit(episodes);
  VLUtilities::VL1__TvEpisodeList2VL_WS_TvEpisodeListResponse(
      Read(soap_new_VL1__TvEpisodeList(m_Soap),
           E("ResponseCode", "0") +
               E("Episodes", E("TvEpisode", E("EpisodeID", "1") + E("EpisodeName", "Pilot") +
                                                E("EpisodeNumber", "1")) +
                                 E("TvEpisode", E("EpisodeID", "2")))),
      episodes);
  ASSERT_EQ(2, episodes.Episodes.Count);
  EXPECT_STREQ("Pilot", episodes.Episodes.Items[0].EpisodeName);
  EXPECT_EQ(2, episodes.Episodes.Items[1].EpisodeID);
  EXPECT_STREQ("", episodes.Episodes.Items[1].EpisodeName);
  EXPECT_EQ(VL_WS_OK, VL_WS_release(&episodes));
}

TEST_F(Convert, PagesOfGenresAndRecommendations) {
  VL_WS_GenreArray genres;
  VLRecordInit(genres);
  VLUtilities::VL1__ArrayOfGenre2VL_WS_GenreArray(
      Read(soap_new_VL1__ArrayOfGenre(m_Soap),
           E("Genre", E("ID", "1") + E("Name", "Drama") + E("Visible", "true") + E("ParentId", "0")) +
               E("Genre", E("ID", "2") + E("ParentId", "1"))),
      genres);
  ASSERT_EQ(2, genres.Count);
  EXPECT_STREQ("Drama", genres.Items[0].Name);
  EXPECT_TRUE(genres.Items[0].Visible);
  EXPECT_EQ(1, genres.Items[1].ParentId);
  ASSERT_NE(nullptr, genres.Items[1].Name);
  EXPECT_STREQ("", genres.Items[1].Name);
  EXPECT_FALSE(genres.Items[1].Visible);
  EXPECT_EQ(VL_WS_OK, VL_WS_release(&genres));

  VL_WS_RecommendedTitlesResponse recommended;
  VLRecordInit(recommended);
  VLUtilities::VL1__RecommendedTitlesResponse2VL_WS_RecommendedTitlesResponse(
      Read(soap_new_VL1__RecommendedTitlesResponse(m_Soap),
           E("ResponseCode", "0") + E("Titles", E("TitleListing", kTitleFields))),
      recommended);
  ASSERT_EQ(1, recommended.Titles.Count);
  ExpectTitleFields(recommended.Titles.Items[0]);
  EXPECT_EQ(VL_WS_OK, VL_WS_release(&recommended));

  VL_WS_TitlesResponseArray pages;
  VLRecordInit(pages);
  VLUtilities::VL1__ArrayOfGetTitlesResponse2VL_WS_TitlesResponseArray(
      Read(soap_new_VL1__ArrayOfGetTitlesResponse(m_Soap),
           E("GetTitlesResponse", E("GenreID", "3") + E("Titles", E("TitleListing", kTitleFields))) +
               E("GetTitlesResponse", E("GenreID", "4"))),
      pages);
  ASSERT_EQ(2, pages.Count);
  EXPECT_EQ(VL_WS_TAG_TITLES_RESPONSE, *pages.Items[0].tag);
  EXPECT_EQ(3, pages.Items[0].GenreID);
  ASSERT_EQ(1, pages.Items[0].Titles.Count);
  ExpectTitleFields(pages.Items[0].Titles.Items[0]);
  EXPECT_EQ(4, pages.Items[1].GenreID);
  EXPECT_EQ(0, pages.Items[1].Titles.Count);
  EXPECT_EQ(VL_WS_OK, VL_WS_release(&pages));
}

const std::string kPurchased = kTitleFields + E("EpisodeID", "5") + E("TvListingTitleID", "6") +
                               E("PurchaseType", "rent") + E("Status", "Undefined") +
                               E("RentalPeriod", "48 hours") + E("PassID", "777") +
                               E("PlayStatus", "paused") + E("StartTimeSeconds", "360");

void ExpectPurchasedFields(const VL_WS_TitleListingPurchased& p) {
  ExpectTitleFields(p);
  EXPECT_EQ(5, p.EpisodeID);
  EXPECT_EQ(6, p.TvListingTitleID);
  EXPECT_EQ(0, p.PurchaseType);
  EXPECT_EQ(3, p.Status);
  EXPECT_STREQ("48 hours", p.RentalPeriod);
  EXPECT_EQ(777, p.PassID);
  EXPECT_EQ(2, p.PlayStatus);
  EXPECT_EQ(360, p.StartTimeSeconds);
}

TEST_F(Convert, VideoAndWishlistPages) {
  VL_WS_WishlistItemsResponse r;
  VLRecordInit(r);
  VLUtilities::VL1__GetWishlistItemsResponse2VL_WS_WishlistItemsResponse(
      Read(soap_new_VL1__GetWishlistItemsResponse(m_Soap),
           E("ResponseCode", "0") + E("Titles", E("TitleListingPurchased", kPurchased)) +
               E("CurrentPageNumber", "1") + E("ItemsPerPage", "50") + E("TotalPages", "2") +
               E("TotalItems", "51") + E("SortOrder", "3")),
      r);
  EXPECT_EQ(1, r.CurrentPageNumber);
  EXPECT_EQ(50, r.ItemsPerPage);
  EXPECT_EQ(2, r.TotalPages);
  EXPECT_EQ(51, r.TotalItems);
  EXPECT_EQ(3, r.SortOrder);
  ASSERT_EQ(1, r.Titles.Count);
  EXPECT_EQ(VL_WS_TAG_TITLE_LISTING_PURCHASED, *r.Titles.Items[0].tag);
  ExpectPurchasedFields(r.Titles.Items[0]);
  EXPECT_EQ(VL_WS_OK, VL_WS_release(&r));

  VL_WS_TitleListingPurchasedForPassArray passes;
  VLRecordInit(passes);
  VLUtilities::VL1__ArrayOfTitleListingPurchasedForPass2VL_WS_TitleListingPurchasedForPassArray(
      Read(soap_new_VL1__ArrayOfTitleListingPurchasedForPass(m_Soap),
           E("TitleListingPurchasedForPass",
             kPurchased + E("ResponseCode", "2") + E("ResponseMessage", "expired"))),
      passes);
  ASSERT_EQ(1, passes.Count);
  ExpectPurchasedFields(passes.Items[0]);
  EXPECT_EQ(2, passes.Items[0].ResponseCode);
  EXPECT_STREQ("expired", passes.Items[0].ResponseMessage);
  EXPECT_EQ(VL_WS_OK, VL_WS_release(&passes));
}

bool AdultVerification(Convert& test, struct soap* soap, const std::string& content) {
  VL_WS_AuthorizeDeviceResponse r;
  VLRecordInit(r);
  VLUtilities::VL1__AuthorizeDeviceResponse2VL_WS_AuthorizeDeviceResponse(
      test.Read(soap_new_VL1__AuthorizeDeviceResponse(soap), content), r);
  bool enabled = r.IsAdultVerificationEnabled;
  VL_WS_release(&r);
  return enabled;
}

TEST_F(Convert, DeviceAuthorisation) {
  VL_WS_AuthorizeDeviceResponse r;
  VLRecordInit(r);
  VLUtilities::VL1__AuthorizeDeviceResponse2VL_WS_AuthorizeDeviceResponse(
      Read(soap_new_VL1__AuthorizeDeviceResponse(m_Soap),
           E("ResponseCode", "0") + E("AuthToken", "tok") + E("EmailAddress", "a@b.example") +
               E("IsAdultVerificationEnabled", "true") + E("DeviceID", "d1") +
               E("DeviceName", "Living room")),
      r);
  EXPECT_STREQ("tok", r.AuthToken);
  EXPECT_STREQ("a@b.example", r.EmailAddress);
  EXPECT_TRUE(r.IsAdultVerificationEnabled);
  EXPECT_STREQ("d1", r.DeviceID);
  EXPECT_STREQ("Living room", r.DeviceName);
  EXPECT_STREQ("", r.ResponseMessage);
  EXPECT_EQ(VL_WS_OK, VL_WS_release(&r));

  // The untyped flag is true exactly for "true" in any letter case.
  EXPECT_TRUE(AdultVerification(*this, m_Soap, E("IsAdultVerificationEnabled", "TRUE")));
  EXPECT_TRUE(AdultVerification(*this, m_Soap, E("IsAdultVerificationEnabled", "True")));
  EXPECT_FALSE(AdultVerification(*this, m_Soap, E("IsAdultVerificationEnabled", "1")));
  EXPECT_FALSE(AdultVerification(*this, m_Soap, E("IsAdultVerificationEnabled", "")));
  EXPECT_FALSE(AdultVerification(*this, m_Soap, E("ResponseCode", "1")));
}

TEST_F(Convert, StreamingLocationAndTivoTranslation) {
  VL_WS_StreamingAssetLocationResponse r;
  VLRecordInit(r);
  VLUtilities::VL1__GetStreamingAssetLocationResponse2VL_WS_StreamingAssetLocationResponse(
      Read(soap_new_VL1__GetStreamingAssetLocationResponse(m_Soap),
           E("ResponseCode", "3") + E("ResponseMessage", "later") +
               E("StreamingAssetLocation", "rtmpe://s/x") + E("AssetID", "99") + E("StreamID", "s-1") +
               E("DRMServerURL", "https://drm") + E("DRMACKServerURL", "https://ack") +
               E("Status", "resumeplay") + E("StartTimeSeconds", "61") + E("HeartbeatURL", "https://hb") +
               E("HeartbeatPollInSeconds", "30")),
      r);
  EXPECT_EQ(3, r.ResponseCode);
  EXPECT_STREQ("later", r.ResponseMessage);
  EXPECT_STREQ("rtmpe://s/x", r.StreamingAssetLocation);
  EXPECT_EQ(99, r.AssetID);
  EXPECT_STREQ("s-1", r.StreamID);
  EXPECT_STREQ("https://drm", r.DRMServerURL);
  EXPECT_STREQ("https://ack", r.DRMACKServerURL);
  EXPECT_EQ(3, r.Status);
  EXPECT_EQ(61, r.StartTimeSeconds);
  EXPECT_STREQ("https://hb", r.HeartbeatURL);
  EXPECT_EQ(30, r.HeartbeatPollInSeconds);
  EXPECT_EQ(VL_WS_OK, VL_WS_release(&r));

  VL_WS_TranslateTivoExternalIDResponse tivo;
  VLRecordInit(tivo);
  VLUtilities::VL1__TranslateTivoExternalIDResponse2VL_WS_TranslateTivoExternalIDResponse(
      Read(soap_new_VL1__TranslatedTivoExternalIdResponse(m_Soap),
           E("ResponseCode", "0") + E("ResponseMessage", "OK") + E("TivoExternalId", "tv-12") +
               E("TitleId", "4242")),
      tivo);
  EXPECT_STREQ("tv-12", tivo.TivoExternalId);
  EXPECT_EQ(4242, tivo.TitleId);
  EXPECT_STREQ("OK", tivo.ResponseMessage);
  EXPECT_EQ(VL_WS_OK, VL_WS_release(&tivo));
}

TEST(ConvertDeathTest, NeedsTheSchemaRecord) {
  GTEST_FLAG_SET(death_test_style, "threadsafe");
  VL_WS_TitlesResponse r;
  VLRecordInit(r);
  EXPECT_DEATH(VLUtilities::VL1__GetTitlesResponse2VL_WS_TitlesResponse(nullptr, r), "t != 0");
  EXPECT_DEATH(VLUtilities::VL1__ArrayOfTitleListing2VL_WS_TitleListingArray(nullptr, r.Titles),
               "t != 0");
  VL_WS_release(&r);
}

}  // namespace
