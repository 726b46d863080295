// Catalogue operations against the store simulator: their records checked against the store's
// data, the cache in front of them (Names, Keys, what is kept and what is not), transport faults
// and response codes, the wishlist flags of title answers, and the cache's refresh.
#include <gtest/gtest.h>
#include <string.h>

#include <string>
#include <vector>

#include "CacheInterface.h"
#include "Serializer.h"
#include "VLTestSimulator.h"
#include "VL_WS.h"
#include "VL_WS_Client.h"

namespace {

// ---- The store's data as the client records must show it ----

// A product's ExpireDate: an XML date-time re-formatted, anything else (the store's plain dates
// included) the all-zero time.
std::string ExpectedExpireDate(const std::string& text) {
  int y, mo, d, h, mi, s;
  char tee;
  if (sscanf(text.c_str(), "%4d-%2d-%2d%c%2d:%2d:%2d", &y, &mo, &d, &tee, &h, &mi, &s) != 7 || tee != 'T')
    return "1900/01/00 00:00:00";
  char out[32];
  snprintf(out, sizeof out, "%04d/%02d/%02d %02d:%02d:%02d", y, mo, d, h, mi, s);
  return out;
}

void ExpectProduct(const VL_WS_ProductListing& r, const VLSimProduct& p) {
  SCOPED_TRACE("SKU " + std::to_string(p.sku));
  ASSERT_NE(nullptr, r.tag);
  EXPECT_EQ(VL_WS_TAG_PRODUCT_LISTING, *r.tag);
  EXPECT_EQ(p.sku, r.SkuID);
  EXPECT_EQ(p.purchaseType, r.PurchaseType);
  EXPECT_STREQ(p.price.c_str(), r.Price);
  EXPECT_EQ(p.rentalHours, r.RentalPeriod);
  EXPECT_EQ(ExpectedExpireDate(p.expireDate), r.ExpireDate);
  ASSERT_EQ(static_cast<int>(p.profiles.size()), r.AvailableAssets.Count);
  for (int i = 0; i < r.AvailableAssets.Count; ++i) EXPECT_EQ(p.profiles[i], r.AvailableAssets.Items[i]);
  ASSERT_EQ(static_cast<int>(p.audio.size()), r.AvailableAudioProfiles.Count);
  for (int i = 0; i < r.AvailableAudioProfiles.Count; ++i) {
    const VL_WS_AudioFile& a = r.AvailableAudioProfiles.Items[i];
    EXPECT_EQ(VL_WS_TAG_AUDIO_FILE, *a.tag);
    EXPECT_EQ(p.sku * 10 + i, a.AssetAudioID);
    EXPECT_EQ("https://store.ostrel.example/media/audio/" + std::to_string(a.AssetAudioID) + ".mp4", a.FileLocation);
    EXPECT_EQ(i == 0, a.ContainsVideo);
    EXPECT_EQ(p.audio[i], a.AudioAssetProfile);
  }
}

// The title fields of a listing of title t (or of its episode e) with the products of the
// purchase type (0 rent, 1 buy, else all).
void ExpectTitle(const VL_WS_TitleListing& r, const VLSimCatalogue& c, const VLSimTitle& t,
                 const VLSimEpisode* e = nullptr, int purchaseType = 2) {
  SCOPED_TRACE("title " + std::to_string(t.id));
  ASSERT_NE(nullptr, r.tag);
  EXPECT_EQ(t.id, r.TitleID);
  EXPECT_STREQ(e ? (t.name + ": " + e->name).c_str() : t.name.c_str(), r.TitleName);
  EXPECT_STREQ(t.boxArt.c_str(), r.BoxArtPrefix);
  EXPECT_EQ(e ? e->number : 0, r.EpisodeNumber);
  EXPECT_EQ(t.tv, r.IsTvListing);
  EXPECT_STREQ(t.mpaa.c_str(), r.MPAARating);
  EXPECT_STREQ(t.chvrs.c_str(), r.CHVRSRating);
  EXPECT_EQ(t.thx, r.IsTHXMediaDirectorEnabled);
  EXPECT_EQ(t.thxTrailer, r.IsTHXMediaDirectorEnabledForTrailer);
  EXPECT_STREQ(t.loyaltyBuy.c_str(), r.LoyaltyPointsForBuy);
  EXPECT_STREQ(t.loyaltyRent.c_str(), r.LoyaltyPointsForRent);
  EXPECT_EQ(VL_WS_TAG_BONUS_ASSET_ARRAY, *r.BonusAssets.tag);
  ASSERT_EQ(static_cast<int>(t.bonus.size()), r.BonusAssets.Count);
  for (int i = 0; i < r.BonusAssets.Count; ++i) {
    const VLSimBonus* b = c.FindBonus(t.bonus[i]);
    EXPECT_EQ(b->id, r.BonusAssets.Items[i].BonusAssetID);
    EXPECT_EQ(b->profile, r.BonusAssets.Items[i].Profile);
    EXPECT_EQ(b->type, r.BonusAssets.Items[i].BonusType);
  }
  std::vector<const VLSimProduct*> products;
  for (int sku : e ? e->products : t.products) {
    const VLSimProduct* p = c.FindProduct(sku);
    if (purchaseType != 0 && purchaseType != 1) products.push_back(p);
    else if (p->purchaseType == purchaseType) products.push_back(p);
  }
  EXPECT_EQ(VL_WS_TAG_PRODUCT_LISTING_ARRAY, *r.AvailableProducts.tag);
  ASSERT_EQ(static_cast<int>(products.size()), r.AvailableProducts.Count);
  for (size_t i = 0; i < products.size(); ++i) ExpectProduct(r.AvailableProducts.Items[i], *products[i]);
}

// A page of the titles all (in store order), page and size as asked.
void ExpectPage(const VL_WS_TitlesResponse& r, const VLSimCatalogue& c, const std::vector<const VLSimTitle*>& all,
                int genre, int page, int perPage) {
  EXPECT_EQ(VL_WS_TAG_TITLES_RESPONSE, *r.tag);
  EXPECT_EQ(0, r.ResponseCode);
  EXPECT_STREQ("OK", r.ResponseMessage);
  EXPECT_EQ(genre, r.GenreID);
  EXPECT_EQ(page, r.CurrentPageNumber);
  EXPECT_EQ(perPage, r.ItemsPerPage);
  EXPECT_EQ(static_cast<int>(all.size()), r.TotalItems);
  EXPECT_EQ((static_cast<int>(all.size()) + perPage - 1) / perPage, r.TotalPages);
  EXPECT_EQ(VL_WS_TAG_TITLE_LISTING_ARRAY, *r.Titles.tag);
  int first = (page - 1) * perPage;
  int count = std::max(0, std::min(perPage, static_cast<int>(all.size()) - first));
  ASSERT_EQ(count, r.Titles.Count);
  for (int i = 0; i < count; ++i) {
    ExpectTitle(r.Titles.Items[i], c, *all[first + i]);
    EXPECT_EQ(first + i + 1, r.Titles.Items[i].TitlePosition);
  }
}

// ---- The fixture ----

class Catalog : public testing::Test {
 protected:
  void SetUp() override {
    m_Sim.ClearFaults();
    ASSERT_EQ(VL_WS_OK, Init(MemoryCache(7)));
  }
  void TearDown() override {
    VL_WS_release(&m_Handle);
    m_Sim.ClearFaults();
  }

  // A setup record with an in-memory cache of the kinds in data.
  static VL_WS_SetupParams MemoryCache(int data) {
    VL_WS_SetupParams params = VLTestSetupParams();
    params.CacheType = 1;
    params.CacheData = static_cast<VL_WS_CacheParam::CacheData>(data);
    return params;
  }
  // Makes m_Handle anew; the request log then starts empty.
  VL_WS_Status Init(const VL_WS_SetupParams& params) {
    VL_WS_release(&m_Handle);
    VL_WS_Status status = VL_WS_initialize(&m_Handle, &params);
    if (params.CacheType != 0 && (params.CacheData & 1) != 0) m_Sim.WaitForRequests(1, 5000);  // the load time
    m_Sim.ClearRequests();
    return status;
  }
  void Fault(const std::string& spec) {
    std::string error;
    ASSERT_TRUE(m_Sim.AddFault(spec, &error)) << error;
  }
  // The operations of the requests logged since the last call, once count arrived; the log is
  // emptied. A call answered by the cache adds nothing, so a check of "no request" is followed
  // by a call that does send one, and the log must then hold that one alone.
  std::vector<std::string> Sent(size_t count) {
    m_Sim.WaitForRequests(count, 5000);
    std::vector<std::string> operations;
    for (const VLSimRequest& r : m_Sim.Requests()) operations.push_back(r.operation);
    m_Sim.ClearRequests();
    return operations;
  }
  CacheInterface& Cache() { return *m_Handle.client->m_Cache; }
  bool Cached(const char* name, const char* key) {
    VLString value;
    return Cache().ReadMetaData(name, key, value);
  }
  const VLSimCatalogue& Store() { return m_Sim.Catalogue(); }

  VLSimServer& m_Sim = VLTestSimulator();
  VL_WS_Handle m_Handle = {};
};

const std::vector<std::string> kOne = {"getTitlesByNavigation"};

TEST_F(Catalog, TitlesPageShowsTheStoresTitles) {
  std::vector<const VLSimTitle*> movies = Store().TitlesInGenre(1);
  ASSERT_GT(movies.size(), 7u);
  VL_WS_TitlesResponse page;
  ASSERT_EQ(VL_WS_OK, VL_WS_getTitles(&m_Handle, 1, 2, 4, 2, &page));
  ExpectPage(page, Store(), movies, 1, 2, 4);
  EXPECT_EQ(VL_WS_OK, VL_WS_release(&page));

  // Rentals only: every title's products are rentals.
  ASSERT_EQ(VL_WS_OK, VL_WS_getTitles(&m_Handle, 10, 1, 50, 0, &page));
  EXPECT_GT(page.Titles.Count, 0);
  for (int i = 0; i < page.Titles.Count; ++i)
    for (int j = 0; j < page.Titles.Items[i].AvailableProducts.Count; ++j)
      EXPECT_EQ(0, page.Titles.Items[i].AvailableProducts.Items[j].PurchaseType);
  VL_WS_release(&page);
}

TEST_F(Catalog, RepeatedTitlesPageComesFromTheCacheAndAnotherPageSizeDoesNot) {
  std::vector<const VLSimTitle*> movies = Store().TitlesInGenre(1);
  VL_WS_TitlesResponse first, second, other;
  ASSERT_EQ(VL_WS_OK, VL_WS_getTitles(&m_Handle, 1, 1, 5, 2, &first));
  EXPECT_EQ(kOne, Sent(1));
  EXPECT_TRUE(Cached("getTitles", "1,1,5,2"));

  ASSERT_EQ(VL_WS_OK, VL_WS_getTitles(&m_Handle, 1, 1, 5, 2, &second));
  ASSERT_EQ(VL_WS_OK, VL_WS_getTitles(&m_Handle, 1, 1, 6, 2, &other));
  EXPECT_EQ(kOne, Sent(1));  // the page size makes another request; the same page none
  ExpectPage(first, Store(), movies, 1, 1, 5);
  ExpectPage(second, Store(), movies, 1, 1, 5);
  ExpectPage(other, Store(), movies, 1, 1, 6);
  EXPECT_TRUE(Cached("getTitles", "1,1,6,2"));
  VL_WS_release(&first);
  VL_WS_release(&second);
  VL_WS_release(&other);
}

TEST_F(Catalog, TitlesPageWithAResponseCodeIsFoldedAndNotCached) {
  Fault("getTitlesByNavigation=code:5,times=1");
  VL_WS_TitlesResponse page;
  EXPECT_EQ(VL_WS_E_UNEXPECTED, VL_WS_getTitles(&m_Handle, 1, 1, 5, 2, &page));
  EXPECT_EQ(5, page.ResponseCode);
  EXPECT_STREQ("Response code injected by the simulator", page.ResponseMessage);
  EXPECT_EQ(5, page.Titles.Count);  // the rest of the answer is there
  VL_WS_release(&page);
  EXPECT_FALSE(Cached("getTitles", "1,1,5,2"));

  // The store's own refusals too: an unknown genre.
  EXPECT_EQ(VL_WS_E_UNEXPECTED, VL_WS_getTitles(&m_Handle, 999, 1, 5, 2, &page));
  EXPECT_EQ(2, page.ResponseCode);
  VL_WS_release(&page);
  EXPECT_FALSE(Cached("getTitles", "999,1,5,2"));
  Sent(2);

  ASSERT_EQ(VL_WS_OK, VL_WS_getTitles(&m_Handle, 1, 1, 5, 2, &page));
  EXPECT_EQ(kOne, Sent(1));
  VL_WS_release(&page);
}

TEST_F(Catalog, TitlesPageTransportFaultGivesAnEmptyTaggedRecordAndCachesNothing) {
  struct {
    const char* fault;
    VL_WS_Status status;
  } cases[] = {{"status:503", VL_WS_E_HTTP_STATUS(503)},
               {"soapfault:server", VL_WS_E_SOAP_FAULT(2)},
               {"close", VL_WS_E_EOF},
               {"malformed", VL_WS_E_HTTP_STATUS(200)}};
  for (const auto& c : cases) {
    SCOPED_TRACE(c.fault);
    Fault(std::string("getTitlesByNavigation=") + c.fault + ",times=1");
    VL_WS_TitlesResponse page;
    EXPECT_EQ(c.status, VL_WS_getTitles(&m_Handle, 1, 1, 5, 2, &page));
    ASSERT_NE(nullptr, page.tag);
    EXPECT_EQ(VL_WS_TAG_TITLES_RESPONSE, *page.tag);
    EXPECT_EQ(VL_WS_TAG_TITLE_LISTING_ARRAY, *page.Titles.tag);
    EXPECT_EQ(0, page.ResponseCode);
    EXPECT_EQ(nullptr, page.ResponseMessage);
    EXPECT_EQ(0, page.Titles.Count);
    EXPECT_EQ(nullptr, page.Titles.Items);
    EXPECT_EQ(VL_WS_OK, VL_WS_release(&page));
    EXPECT_FALSE(Cached("getTitles", "1,1,5,2"));
  }
}

TEST_F(Catalog, UnreadableCachedAnswerIsAMissAndIsReplaced) {
  // Not a stored record at all, and a stored response without its result element.
  _VL1__getTitlesByNavigationResponse empty;
  VLString noResult;
  ASSERT_TRUE(StoreResponse(empty, noResult));
  for (const VLString& text : {VLString("not gzip, not XML"), noResult}) {
    ASSERT_TRUE(Cache().WriteMetaData("getTitles", "1,1,5,2", text));
    VL_WS_TitlesResponse page;
    ASSERT_EQ(VL_WS_OK, VL_WS_getTitles(&m_Handle, 1, 1, 5, 2, &page));
    EXPECT_EQ(kOne, Sent(1));
    ExpectPage(page, Store(), Store().TitlesInGenre(1), 1, 1, 5);
    VL_WS_release(&page);
    VLString value;
    ASSERT_TRUE(Cache().ReadMetaData("getTitles", "1,1,5,2", value));
    EXPECT_NE(text, value);
  }
}

TEST_F(Catalog, AnswersAreKeptOnlyWhenCatalogueAnswersAreCached) {
  for (int data : {0, 2, 4, 6}) {
    SCOPED_TRACE(data);
    ASSERT_EQ(VL_WS_OK, Init(MemoryCache(data)));
    VL_WS_TitlesResponse page;
    for (int i = 0; i < 2; ++i) {
      ASSERT_EQ(VL_WS_OK, VL_WS_getTitles(&m_Handle, 1, 1, 5, 2, &page));
      VL_WS_release(&page);
    }
    EXPECT_EQ(std::vector<std::string>(2, "getTitlesByNavigation"), Sent(2));
  }
  // No cache at all.
  ASSERT_EQ(VL_WS_OK, Init(VLTestSetupParams()));
  VL_WS_TitlesResponse page;
  for (int i = 0; i < 2; ++i) {
    ASSERT_EQ(VL_WS_OK, VL_WS_getTitles(&m_Handle, 1, 1, 5, 2, &page));
    VL_WS_release(&page);
  }
  EXPECT_EQ(2u, Sent(2).size());
}

TEST_F(Catalog, TitlesWithoutClientStateOrRecord) {
  VL_WS_Handle empty = {};
  VL_WS_TitlesResponse page;
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_getTitles(&empty, 1, 1, 5, 2, &page));
  ASSERT_NE(nullptr, page.tag);
  EXPECT_EQ(VL_WS_TAG_TITLES_RESPONSE, *page.tag);
  EXPECT_EQ(VL_WS_TAG_TITLE_LISTING_ARRAY, *page.Titles.tag);
  EXPECT_EQ(VL_WS_OK, VL_WS_release(&page));
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_getTitles(nullptr, 1, 1, 5, 2, &page));
  VL_WS_release(&page);
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_getTitles(&m_Handle, 1, 1, 5, 2, nullptr));
}

}  // namespace
