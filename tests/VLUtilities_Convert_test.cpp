// Record conversion: store answers decoded by the SOAP runtime from XML, converted into client
// records and released (the sanitizer build checks that nothing leaks). The catalogue tests check
// every copied field of the catalogue answers against the store simulator's data; here is what
// the simulator does not send (missing elements, numbers for enumerations, date-times) and the
// answers of the account and streaming operations.
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

  // Reads a schema record from the content of one element, as it arrives in an answer, and
  // converts it into r, which it prepares first.
  template <class Schema, class Record>
  Record& From(Schema* schema, const std::string& content, void (*convert)(const Schema*, Record&), Record& r) {
    std::string xml = "<r xmlns:VL1=\"" VL_API_NAMESPACE "\">" + content + "</r>";
    std::istringstream in(xml);
    m_Soap->is = &in;
    bool ok = soap_begin_recv(m_Soap) == SOAP_OK && schema->soap_in(m_Soap, "r", nullptr) != nullptr &&
              soap_end_recv(m_Soap) == SOAP_OK;
    m_Soap->is = nullptr;
    EXPECT_TRUE(ok) << "cannot read " << xml;
    convert(schema, VLRecordInit(r));
    return r;
  }

 protected:
  struct soap* m_Soap;
};

std::string E(const std::string& name, const std::string& value) {
  return "<VL1:" + name + ">" + value + "</VL1:" + name + ">";
}

TEST_F(Convert, MissingElementsBecomeOwnedEmptyTextsAndEmptyTaggedArrays) {
  VL_WS_TitlesResponse page;
  From(soap_new_VL1__GetTitlesResponse(m_Soap),
       E("ResponseCode", "5") + E("TotalPages", "-3") + E("Titles", E("TitleListing", E("TitleID", "43"))),
       VLUtilities::VL1__GetTitlesResponse2VL_WS_TitlesResponse, page);
  EXPECT_EQ(5, page.ResponseCode);
  EXPECT_STREQ("", page.ResponseMessage);
  EXPECT_EQ(-3, page.TotalPages);
  ASSERT_EQ(1, page.Titles.Count);
  const VL_WS_TitleListing& bare = page.Titles.Items[0];
  EXPECT_EQ(VL_WS_TAG_TITLE_LISTING, *bare.tag);
  EXPECT_EQ(43, bare.TitleID);
  EXPECT_STREQ("", bare.TitleName);
  EXPECT_STREQ("", bare.LoyaltyPointsForRent);
  EXPECT_EQ(0, bare.AvailableProducts.Count);
  EXPECT_EQ(nullptr, bare.AvailableProducts.Items);
  ASSERT_NE(nullptr, bare.AvailableProducts.tag);
  EXPECT_EQ(VL_WS_TAG_PRODUCT_LISTING_ARRAY, *bare.AvailableProducts.tag);
  EXPECT_EQ(0, bare.BonusAssets.Count);
  EXPECT_EQ(VL_WS_OK, VL_WS_release(&page));
  EXPECT_EQ(VL_WS_OK, VL_WS_release(&page));

  // A nil title is an empty one, with owned empty texts.
  From(soap_new_VL1__GetTitlesResponse(m_Soap),
       E("Titles", "<VL1:TitleListing xmlns:xsi=\"http://www.w3.org/2001/XMLSchema-instance\" xsi:nil=\"true\"/>"),
       VLUtilities::VL1__GetTitlesResponse2VL_WS_TitlesResponse, page);
  ASSERT_EQ(1, page.Titles.Count);
  EXPECT_STREQ("", page.Titles.Items[0].TitleName);
  EXPECT_STREQ("", page.Titles.Items[0].BoxArtPrefix);
  EXPECT_EQ(VL_WS_OK, VL_WS_release(&page));

  // Titles empty or missing: no array, but its cell.
  for (const char* titles : {"<VL1:Titles/>", ""}) {
    From(soap_new_VL1__GetTitlesResponse(m_Soap), E("ResponseCode", "0") + titles,
         VLUtilities::VL1__GetTitlesResponse2VL_WS_TitlesResponse, page);
    EXPECT_EQ(0, page.Titles.Count);
    EXPECT_EQ(nullptr, page.Titles.Items);
    EXPECT_NE(nullptr, page.Titles.tag);
    EXPECT_EQ(VL_WS_OK, VL_WS_release(&page));
  }

  VL_WS_TitlesResponseArray pages;
  From(soap_new_VL1__ArrayOfGetTitlesResponse(m_Soap), E("GetTitlesResponse", E("GenreID", "4")),
       VLUtilities::VL1__ArrayOfGetTitlesResponse2VL_WS_TitlesResponseArray, pages);
  ASSERT_EQ(1, pages.Count);
  EXPECT_EQ(VL_WS_TAG_TITLES_RESPONSE, *pages.Items[0].tag);
  EXPECT_EQ(4, pages.Items[0].GenreID);
  EXPECT_EQ(0, pages.Items[0].Titles.Count);
  EXPECT_EQ(VL_WS_OK, VL_WS_release(&pages));

  VL_WS_TitleListingResponseArray details;
  From(soap_new_VL1__ArrayOfTitleListingResponse(m_Soap), E("TitleListingResponse", E("TitleID", "8")),
       VLUtilities::VL1__ArrayOfTitleListingResponse2VL_WS_TitleListingResponseArray, details);
  ASSERT_EQ(1, details.Count);
  EXPECT_EQ(VL_WS_TAG_TITLE_LISTING_RESPONSE, *details.Items[0].tag);
  EXPECT_EQ(8, details.Items[0].TitleID);
  EXPECT_STREQ("", details.Items[0].Synopsys);
  EXPECT_EQ(VL_WS_OK, VL_WS_release(&details));

  VL_WS_GenreArray genres;
  From(soap_new_VL1__ArrayOfGenre(m_Soap), E("Genre", E("ID", "2") + E("ParentId", "1")),
       VLUtilities::VL1__ArrayOfGenre2VL_WS_GenreArray, genres);
  ASSERT_EQ(1, genres.Count);
  EXPECT_EQ(1, genres.Items[0].ParentId);
  EXPECT_STREQ("", genres.Items[0].Name);
  EXPECT_FALSE(genres.Items[0].Visible);
  EXPECT_EQ(VL_WS_OK, VL_WS_release(&genres));

  VL_WS_TvEpisodeListResponse episodes;
  From(soap_new_VL1__TvEpisodeList(m_Soap), E("Episodes", E("TvEpisode", E("EpisodeID", "2"))),
       VLUtilities::VL1__TvEpisodeList2VL_WS_TvEpisodeListResponse, episodes);
  ASSERT_EQ(1, episodes.Episodes.Count);
  EXPECT_EQ(2, episodes.Episodes.Items[0].EpisodeID);
  EXPECT_STREQ("", episodes.Episodes.Items[0].EpisodeName);
  EXPECT_EQ(VL_WS_OK, VL_WS_release(&episodes));
}

TEST_F(Convert, EnumerationsAreReadFromWordsAndNumbers) {
  const std::string product =
      E("PurchaseType", "buy") + E("AvailableAssets", E("FileProfile", "HIGH_DEFINITION") + E("FileProfile", "7")) +
      E("AvailableAudioProfiles",
        E("AudioFile", E("ContainsVideo", "true") + E("AudioAssetProfile", "Dolby_Digital_Plus_51")) +
            E("AudioFile", E("AssetAudioID", "12")));
  const std::string bonus = "<VL1:BonusAsset BonusAssetID=\"900\" Profile=\"STANDARD\" BonusType=\"Trailer\"/>";
  VL_WS_TitlesResponse page;
  From(soap_new_VL1__GetTitlesResponse(m_Soap),
       E("Titles", E("TitleListing", E("BonusAssets", bonus) + E("AvailableProducts", E("ProductListing", product)))),
       VLUtilities::VL1__GetTitlesResponse2VL_WS_TitlesResponse, page);
  ASSERT_EQ(1, page.Titles.Count);
  const VL_WS_TitleListing& t = page.Titles.Items[0];
  ASSERT_EQ(1, t.BonusAssets.Count);
  EXPECT_EQ(VL_WS_TAG_BONUS_ASSET, *t.BonusAssets.Items[0].tag);
  EXPECT_EQ(900, t.BonusAssets.Items[0].BonusAssetID);
  EXPECT_EQ(1, t.BonusAssets.Items[0].Profile);
  EXPECT_EQ(0, t.BonusAssets.Items[0].BonusType);
  ASSERT_EQ(1, t.AvailableProducts.Count);
  const VL_WS_ProductListing& p = t.AvailableProducts.Items[0];
  EXPECT_EQ(VL_WS_TAG_PRODUCT_LISTING, *p.tag);
  EXPECT_EQ(1, p.PurchaseType);
  ASSERT_EQ(2, p.AvailableAssets.Count);
  EXPECT_EQ(2, p.AvailableAssets.Items[0]);
  EXPECT_EQ(7, p.AvailableAssets.Items[1]);
  ASSERT_EQ(2, p.AvailableAudioProfiles.Count);
  EXPECT_EQ(VL_WS_TAG_AUDIO_FILE, *p.AvailableAudioProfiles.Items[0].tag);
  EXPECT_TRUE(p.AvailableAudioProfiles.Items[0].ContainsVideo);
  EXPECT_EQ(3, p.AvailableAudioProfiles.Items[0].AudioAssetProfile);
  EXPECT_EQ(12, p.AvailableAudioProfiles.Items[1].AssetAudioID);
  EXPECT_STREQ("", p.AvailableAudioProfiles.Items[1].FileLocation);
  EXPECT_EQ(VL_WS_OK, VL_WS_release(&page));
}

TEST_F(Convert, ExpireDateIsReformatted) {
  const char* kZero = "1900/01/00 00:00:00";  // missing or unreadable
  const std::pair<const char*, const char*> cases[] = {{"2011-05-01T10:20:30", "2011/05/01 10:20:30"},
                                                       {"2011-12-31T23:59:59.123-05:00", "2011/12/31 23:59:59"},
                                                       {nullptr, kZero},
                                                       {"", kZero},
                                                       {"next week", kZero},
                                                       {"2011-13-01T10:20:30", kZero}};
  for (const auto& c : cases) {
    SCOPED_TRACE(c.first ? c.first : "(missing)");
    VL_WS_TitleListing r;
    From(soap_new_VL1__TitleListing(m_Soap),
         E("AvailableProducts", E("ProductListing", c.first ? E("ExpireDate", c.first) : E("SkuID", "1"))),
         VLUtilities::VL1__TitleListing2VL_WS_TitleListing, r);
    ASSERT_EQ(1, r.AvailableProducts.Count);
    EXPECT_STREQ(c.second, r.AvailableProducts.Items[0].ExpireDate);
    VL_WS_release(&r);
  }
}

// The title fields of a purchased title come from the title listing's conversion.
const std::string kPurchased = E("TitleID", "42") + E("EpisodeID", "5") + E("TvListingTitleID", "6") +
                               E("PurchaseType", "rent") + E("Status", "Undefined") + E("RentalPeriod", "48 hours") +
                               E("PassID", "777") + E("PlayStatus", "paused") + E("StartTimeSeconds", "360");

void ExpectPurchasedFields(const VL_WS_TitleListingPurchased& p) {
  EXPECT_EQ(42, p.TitleID);
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
  From(soap_new_VL1__GetWishlistItemsResponse(m_Soap),
       E("ResponseCode", "0") + E("Titles", E("TitleListingPurchased", kPurchased)) + E("CurrentPageNumber", "1") +
           E("ItemsPerPage", "50") + E("TotalPages", "2") + E("TotalItems", "51") + E("SortOrder", "3"),
       VLUtilities::VL1__GetWishlistItemsResponse2VL_WS_WishlistItemsResponse, r);
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
  From(soap_new_VL1__ArrayOfTitleListingPurchasedForPass(m_Soap),
       E("TitleListingPurchasedForPass", kPurchased + E("ResponseCode", "2") + E("ResponseMessage", "expired")),
       VLUtilities::VL1__ArrayOfTitleListingPurchasedForPass2VL_WS_TitleListingPurchasedForPassArray, passes);
  ASSERT_EQ(1, passes.Count);
  ExpectPurchasedFields(passes.Items[0]);
  EXPECT_EQ(2, passes.Items[0].ResponseCode);
  EXPECT_STREQ("expired", passes.Items[0].ResponseMessage);
  EXPECT_EQ(VL_WS_OK, VL_WS_release(&passes));
}

TEST_F(Convert, DeviceAuthorisation) {
  VL_WS_AuthorizeDeviceResponse r;
  From(soap_new_VL1__AuthorizeDeviceResponse(m_Soap),
       E("ResponseCode", "0") + E("AuthToken", "tok") + E("EmailAddress", "a@b.example") +
           E("IsAdultVerificationEnabled", "true") + E("DeviceID", "d1") + E("DeviceName", "Living room"),
       VLUtilities::VL1__AuthorizeDeviceResponse2VL_WS_AuthorizeDeviceResponse, r);
  EXPECT_STREQ("tok", r.AuthToken);
  EXPECT_STREQ("a@b.example", r.EmailAddress);
  EXPECT_TRUE(r.IsAdultVerificationEnabled);
  EXPECT_STREQ("d1", r.DeviceID);
  EXPECT_STREQ("Living room", r.DeviceName);
  EXPECT_STREQ("", r.ResponseMessage);
  EXPECT_EQ(VL_WS_OK, VL_WS_release(&r));

  // The untyped flag is true exactly for "true" in any letter case.
  const std::pair<std::string, bool> flags[] = {{E("IsAdultVerificationEnabled", "TRUE"), true},
                                                {E("IsAdultVerificationEnabled", "True"), true},
                                                {E("IsAdultVerificationEnabled", "1"), false},
                                                {E("IsAdultVerificationEnabled", ""), false},
                                                {E("ResponseCode", "1"), false}};
  for (const auto& flag : flags) {
    From(soap_new_VL1__AuthorizeDeviceResponse(m_Soap), flag.first,
         VLUtilities::VL1__AuthorizeDeviceResponse2VL_WS_AuthorizeDeviceResponse, r);
    EXPECT_EQ(flag.second, r.IsAdultVerificationEnabled) << flag.first;
    VL_WS_release(&r);
  }
}

TEST_F(Convert, StreamingLocation) {
  VL_WS_StreamingAssetLocationResponse r;
  From(soap_new_VL1__GetStreamingAssetLocationResponse(m_Soap),
       E("ResponseCode", "3") + E("ResponseMessage", "later") + E("StreamingAssetLocation", "rtmpe://s/x") +
           E("AssetID", "99") + E("StreamID", "s-1") + E("DRMServerURL", "https://drm") +
           E("DRMACKServerURL", "https://ack") + E("Status", "resumeplay") + E("StartTimeSeconds", "61") +
           E("HeartbeatURL", "https://hb") + E("HeartbeatPollInSeconds", "30"),
       VLUtilities::VL1__GetStreamingAssetLocationResponse2VL_WS_StreamingAssetLocationResponse, r);
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
}

}  // namespace
