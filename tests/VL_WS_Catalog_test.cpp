// Catalogue operations against the store simulator: their records checked against the store's
// data, the cache in front of them (Names, Keys, what is kept and what is not), transport faults
// and response codes, the wishlist flags of title answers, and the cache's refresh.
#include <gtest/gtest.h>
#include <string.h>
#include <sys/stat.h>

#include <functional>

#include <string>
#include <vector>

#include "CacheInterface.h"
#include "Serializer.h"
#include "VLFile.h"
#include "VLTestDir.h"
#include "VLTestSimulator.h"
#include "VL_WS.h"
#include "VL_WS_Client.h"
#include "VL_Log.h"

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

// The details of title t (or of its episode e).
void ExpectDetails(const VL_WS_TitleListingResponse& r, const VLSimCatalogue& c, const VLSimTitle& t,
                   const VLSimEpisode* e = nullptr) {
  EXPECT_EQ(VL_WS_TAG_TITLE_LISTING_RESPONSE, *r.tag);
  ExpectTitle(r, c, t, e);
  EXPECT_EQ(0, r.ResponseCode);
  EXPECT_STREQ("OK", r.ResponseMessage);
  EXPECT_STREQ(t.synopsis.c_str(), r.Synopsys);
  EXPECT_EQ(t.userRating, r.UserRating);
  EXPECT_STREQ(t.directors.c_str(), r.Directors);
  EXPECT_STREQ(t.actors.c_str(), r.Actors);
  EXPECT_STREQ(t.writers.c_str(), r.Writers);
  EXPECT_STREQ(t.producers.c_str(), r.Producers);
  EXPECT_STREQ(t.copyright.c_str(), r.Copyright);
  EXPECT_STREQ(t.runtime.c_str(), r.RunTime);
  EXPECT_STREQ(t.ratingReason.c_str(), r.RatingReason);
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
  // The title's wishlist flag in the cache: -1 without one, else 0 or 1.
  int Flag(int titleID) {
    bool flag = false;
    return Cache().ReadWishlistFlag(titleID, flag) ? flag : -1;
  }
  // Makes m_Handle anew for the account with the PIN (all kinds cached); returns the account.
  int Authorise(const char* pin) {
    std::string token;
    int account = 0;
    EXPECT_EQ(0, m_Sim.Store().Authorize(pin, VLTestSetupParams().DestinationUniqueID, 7, &token, &account));
    VL_WS_SetupParams params = MemoryCache(7);
    params.AuthToken = token.c_str();
    EXPECT_EQ(VL_WS_OK, Init(params));
    return account;
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


TEST_F(Catalog, NavigationIsTheStoresGenreTreeKeptUnderTheEmptyKey) {
  const std::vector<VLSimGenre>& all = Store().Genres();
  VL_WS_GenreArray genres;
  for (int round = 0; round < 2; ++round) {
    ASSERT_EQ(VL_WS_OK, VL_WS_getNavigation(&m_Handle, &genres));
    EXPECT_EQ(VL_WS_TAG_GENRE_ARRAY, *genres.tag);
    ASSERT_EQ(static_cast<int>(all.size()), genres.Count);
    for (int i = 0; i < genres.Count; ++i) {
      EXPECT_EQ(VL_WS_TAG_GENRE, *genres.Items[i].tag);
      EXPECT_EQ(all[i].id, genres.Items[i].ID);
      EXPECT_STREQ(all[i].name.c_str(), genres.Items[i].Name);
      EXPECT_EQ(all[i].visible, genres.Items[i].Visible);
      EXPECT_EQ(all[i].parent, genres.Items[i].ParentId);
    }
    VL_WS_release(&genres);
    EXPECT_TRUE(Cached("getNavigation", ""));
  }
  VL_WS_GenreLabelResponse label;
  VL_WS_getGenreLabel(&m_Handle, 10, &label);
  VL_WS_release(&label);
  EXPECT_EQ((std::vector<std::string>{"getNavigation", "getGenreLabel"}), Sent(2));
}

TEST_F(Catalog, GenreLabelIsNeverKeptAndFoldsItsCode) {
  const VLSimGenre* genre = Store().FindGenre(10);
  VL_WS_GenreLabelResponse label;
  for (int round = 0; round < 2; ++round) {
    ASSERT_EQ(VL_WS_OK, VL_WS_getGenreLabel(&m_Handle, 10, &label));
    EXPECT_EQ(VL_WS_TAG_GENRE_LABEL_RESPONSE, *label.tag);
    EXPECT_EQ(0, label.ResponseCode);
    EXPECT_STREQ("OK", label.ResponseMessage);
    EXPECT_STREQ(genre->name.c_str(), label.Label);
    EXPECT_STREQ(genre->labelMessage.c_str(), label.LabelMessage);
    VL_WS_release(&label);
  }
  EXPECT_EQ(std::vector<std::string>(2, "getGenreLabel"), Sent(2));

  EXPECT_EQ(VL_WS_E_UNEXPECTED, VL_WS_getGenreLabel(&m_Handle, 999, &label));
  EXPECT_EQ(2, label.ResponseCode);
  EXPECT_STREQ("Unknown genre", label.ResponseMessage);
  EXPECT_STREQ("", label.Label);
  VL_WS_release(&label);
}

TEST_F(Catalog, TitlesByGenreIDsGivesOnePagePerGenreAndIsNeverKept) {
  const int ids[] = {10, 999, 2};
  VL_WS_TitlesResponseArray pages;
  ASSERT_EQ(VL_WS_OK, VL_WS_getTitlesByGenreIDs(&m_Handle, 3, ids, 1, 3, 2, &pages));
  EXPECT_EQ(VL_WS_TAG_TITLES_RESPONSE_ARRAY, *pages.tag);
  ASSERT_EQ(3, pages.Count);
  ExpectPage(pages.Items[0], Store(), Store().TitlesInGenre(10), 10, 1, 3);
  EXPECT_EQ(VL_WS_TAG_TITLES_RESPONSE, *pages.Items[1].tag);
  EXPECT_EQ(2, pages.Items[1].ResponseCode);  // an unknown genre's page; the status is the call's
  EXPECT_EQ(999, pages.Items[1].GenreID);
  ExpectPage(pages.Items[2], Store(), Store().TitlesInGenre(2), 2, 1, 3);
  VL_WS_release(&pages);

  // A count below 1 or no IDs: refused, untouched by the store.
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_getTitlesByGenreIDs(&m_Handle, 0, ids, 1, 3, 2, &pages));
  EXPECT_EQ(VL_WS_TAG_TITLES_RESPONSE_ARRAY, *pages.tag);
  VL_WS_release(&pages);
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_getTitlesByGenreIDs(&m_Handle, -1, ids, 1, 3, 2, &pages));
  VL_WS_release(&pages);
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_getTitlesByGenreIDs(&m_Handle, 1, nullptr, 1, 3, 2, &pages));
  VL_WS_release(&pages);

  ASSERT_EQ(VL_WS_OK, VL_WS_getTitlesByGenreIDs(&m_Handle, 1, ids, 1, 3, 2, &pages));
  EXPECT_EQ(1, pages.Count);
  VL_WS_release(&pages);
  EXPECT_EQ(std::vector<std::string>(2, "getTitlesByGenreArray"), Sent(2));
}

TEST_F(Catalog, TitleListingIsKeptWithItsWishlistFlagWhichTheCacheDoesNotRewrite) {
  int account = Authorise("5678");
  m_Sim.Store().WishlistAdd(account, 1002);
  VL_WS_TitleListingResponse details;
  ASSERT_EQ(VL_WS_OK, VL_WS_getTitleListing(&m_Handle, 1002, &details));
  ExpectDetails(details, Store(), *Store().FindTitle(1002));
  VL_WS_release(&details);
  ASSERT_EQ(VL_WS_OK, VL_WS_getTitleListing(&m_Handle, 1003, &details));
  VL_WS_release(&details);
  EXPECT_EQ(std::vector<std::string>(2, "getTitleListing"), Sent(2));
  EXPECT_TRUE(Cached("getTitleListing", "1002"));
  EXPECT_EQ(1, Flag(1002));
  EXPECT_EQ(0, Flag(1003));

  // Answered by the cache: the flag stays as the cache has it.
  ASSERT_TRUE(Cache().WriteWishlistFlag(1002, false));
  ASSERT_EQ(VL_WS_OK, VL_WS_getTitleListing(&m_Handle, 1002, &details));
  ExpectDetails(details, Store(), *Store().FindTitle(1002));
  VL_WS_release(&details);
  EXPECT_EQ(0, Flag(1002));

  // An unknown title: folded, and neither the answer nor a flag is kept.
  EXPECT_EQ(VL_WS_E_UNEXPECTED, VL_WS_getTitleListing(&m_Handle, 999999, &details));
  EXPECT_EQ(2, details.ResponseCode);
  EXPECT_EQ(999999, details.TitleID);
  VL_WS_release(&details);
  EXPECT_EQ(std::vector<std::string>{"getTitleListing"}, Sent(1));
  EXPECT_FALSE(Cached("getTitleListing", "999999"));
  EXPECT_EQ(-1, Flag(999999));

  // Without user data the answer is kept and no flag written.
  VL_WS_SetupParams params = MemoryCache(1);
  ASSERT_EQ(VL_WS_OK, Init(params));
  ASSERT_EQ(VL_WS_OK, VL_WS_getTitleListing(&m_Handle, 1002, &details));
  VL_WS_release(&details);
  EXPECT_TRUE(Cached("getTitleListing", "1002"));
  EXPECT_EQ(-1, Flag(1002));
  m_Sim.Store().WishlistRemove(account, 1002);
}

TEST_F(Catalog, EpisodeListingIsKeptWithTheSeriesWishlistFlag) {
  int account = Authorise("5678");
  m_Sim.Store().WishlistAdd(account, 1151);
  const VLSimTitle* series = Store().FindTitle(1151);
  VL_WS_TitleListingResponse details;
  for (int round = 0; round < 2; ++round) {
    ASSERT_EQ(VL_WS_OK, VL_WS_getTvEpisodeListing(&m_Handle, 50002, &details));
    ExpectDetails(details, Store(), *series, Store().FindEpisode(50002));
    VL_WS_release(&details);
  }
  EXPECT_TRUE(Cached("getTvEpisodeListing", "50002"));
  EXPECT_EQ(1, Flag(1151));
  EXPECT_EQ(-1, Flag(50002));

  EXPECT_EQ(VL_WS_E_UNEXPECTED, VL_WS_getTvEpisodeListing(&m_Handle, 1, &details));
  EXPECT_EQ(2, details.ResponseCode);
  VL_WS_release(&details);
  EXPECT_FALSE(Cached("getTvEpisodeListing", "1"));
  EXPECT_EQ(std::vector<std::string>(2, "getTvEpisodeListing"), Sent(2));
  m_Sim.Store().WishlistRemove(account, 1151);
}

TEST_F(Catalog, EpisodeListOfASeriesIsKeptAndAMovieHasNone) {
  const VLSimTitle* series = Store().FindTitle(1152);
  VL_WS_TvEpisodeListResponse list;
  for (int round = 0; round < 2; ++round) {
    ASSERT_EQ(VL_WS_OK, VL_WS_getTvEpisodeListByTitleID(&m_Handle, 1152, &list));
    EXPECT_EQ(VL_WS_TAG_TV_EPISODE_LIST_RESPONSE, *list.tag);
    EXPECT_EQ(0, list.ResponseCode);
    EXPECT_EQ(VL_WS_TAG_TV_EPISODE_ARRAY, *list.Episodes.tag);
    ASSERT_EQ(static_cast<int>(series->episodes.size()), list.Episodes.Count);
    for (int i = 0; i < list.Episodes.Count; ++i) {
      const VLSimEpisode* e = Store().FindEpisode(series->episodes[i]);
      EXPECT_EQ(VL_WS_TAG_TV_EPISODE, *list.Episodes.Items[i].tag);
      EXPECT_EQ(e->id, list.Episodes.Items[i].EpisodeID);
      EXPECT_STREQ(e->name.c_str(), list.Episodes.Items[i].EpisodeName);
      EXPECT_EQ(e->number, list.Episodes.Items[i].EpisodeNumber);
    }
    VL_WS_release(&list);
  }
  EXPECT_TRUE(Cached("getTvEpisodeListByTitleID", "1152"));

  EXPECT_EQ(VL_WS_E_UNEXPECTED, VL_WS_getTvEpisodeListByTitleID(&m_Handle, 1001, &list));
  EXPECT_EQ(2, list.ResponseCode);
  EXPECT_EQ(0, list.Episodes.Count);
  VL_WS_release(&list);
  EXPECT_FALSE(Cached("getTvEpisodeListByTitleID", "1001"));
  EXPECT_EQ(std::vector<std::string>(2, "getTvEpisodeListByTitleID"), Sent(2));
}

TEST_F(Catalog, AllEpisodeListingsAreKeptWithEveryWishlistFlagWhenThereAreAnyAndNoneFailed) {
  int account = Authorise("5678");
  m_Sim.Store().WishlistAdd(account, 1152);
  const VLSimTitle* series = Store().FindTitle(1152);
  VL_WS_TitleListingResponseArray listings;
  for (int round = 0; round < 2; ++round) {
    ASSERT_EQ(VL_WS_OK, VL_WS_getAllTvEpisodeListings(&m_Handle, 1152, &listings));
    EXPECT_EQ(VL_WS_TAG_TITLE_LISTING_RESPONSE_ARRAY, *listings.tag);
    ASSERT_EQ(static_cast<int>(series->episodes.size()), listings.Count);
    for (int i = 0; i < listings.Count; ++i)
      ExpectDetails(listings.Items[i], Store(), *series, Store().FindEpisode(series->episodes[i]));
    VL_WS_release(&listings);
  }
  EXPECT_TRUE(Cached("getAllTvEpisodeListings", "1152"));
  EXPECT_EQ(1, Flag(1152));

  // No listing: returned with status 0 and not kept.
  ASSERT_EQ(VL_WS_OK, VL_WS_getAllTvEpisodeListings(&m_Handle, 999999, &listings));
  EXPECT_EQ(0, listings.Count);
  VL_WS_release(&listings);
  EXPECT_FALSE(Cached("getAllTvEpisodeListings", "999999"));

  // Listings the store refused: the codes are the caller's to read, and they are not kept.
  Fault("getAllTvEpisodeListings=code:5,times=1");
  ASSERT_EQ(VL_WS_OK, VL_WS_getAllTvEpisodeListings(&m_Handle, 1151, &listings));
  ASSERT_GT(listings.Count, 0);
  EXPECT_EQ(5, listings.Items[0].ResponseCode);
  VL_WS_release(&listings);
  EXPECT_FALSE(Cached("getAllTvEpisodeListings", "1151"));
  EXPECT_EQ(std::vector<std::string>(3, "getAllTvEpisodeListings"), Sent(3));
  m_Sim.Store().WishlistRemove(account, 1152);
}

TEST_F(Catalog, TivoAndSkuTranslationsAreKeptAndLeaveTheirCodeToTheCaller) {
  const VLSimTitle* title = Store().FindTitle(1001);
  VL_WS_TranslateTivoExternalIDResponse tivo;
  VL_WS_TranslateSkuIDResponse sku;
  for (int round = 0; round < 2; ++round) {
    ASSERT_EQ(VL_WS_OK, VL_WS_translateTivoExternalID(&m_Handle, title->tivoId.c_str(), &tivo));
    EXPECT_EQ(VL_WS_TAG_TRANSLATE_TIVO_EXTERNAL_ID_RESPONSE, *tivo.tag);
    EXPECT_EQ(0, tivo.ResponseCode);
    EXPECT_STREQ(title->tivoId.c_str(), tivo.TivoExternalId);
    EXPECT_EQ(1001, tivo.TitleId);
    VL_WS_release(&tivo);
    ASSERT_EQ(VL_WS_OK, VL_WS_translateSkuID(&m_Handle, 10021, &sku));
    EXPECT_EQ(VL_WS_TAG_TRANSLATE_SKU_ID_RESPONSE, *sku.tag);
    EXPECT_EQ(0, sku.ResponseCode);
    EXPECT_STREQ("OK", sku.ResponseMessage);
    EXPECT_EQ(1002, sku.TitleId);
    VL_WS_release(&sku);
  }
  EXPECT_TRUE(Cached("translateTivoExternalId", title->tivoId.c_str()));
  EXPECT_TRUE(Cached("translateSkuId", "10021"));
  EXPECT_EQ((std::vector<std::string>{"translateTivoExternalId", "translateSkuId"}), Sent(2));

  EXPECT_EQ(VL_WS_OK, VL_WS_translateTivoExternalID(&m_Handle, "tivo:none", &tivo));
  EXPECT_EQ(2, tivo.ResponseCode);
  EXPECT_EQ(0, tivo.TitleId);
  VL_WS_release(&tivo);
  EXPECT_EQ(VL_WS_OK, VL_WS_translateSkuID(&m_Handle, 1, &sku));
  EXPECT_EQ(2, sku.ResponseCode);
  VL_WS_release(&sku);
  EXPECT_FALSE(Cached("translateTivoExternalId", "tivo:none"));
  EXPECT_FALSE(Cached("translateSkuId", "1"));

  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_translateTivoExternalID(&m_Handle, nullptr, &tivo));
  EXPECT_EQ(VL_WS_TAG_TRANSLATE_TIVO_EXTERNAL_ID_RESPONSE, *tivo.tag);
  VL_WS_release(&tivo);
  EXPECT_EQ((std::vector<std::string>{"translateTivoExternalId", "translateSkuId"}), Sent(2));
}

TEST_F(Catalog, SearchMatchesNamesAndDetailSearchAlsoPeople) {
  std::vector<const VLSimTitle*> byName = Store().Search("harbor", false);
  std::vector<const VLSimTitle*> byPeople = Store().Search("Olive Stroud", true);
  ASSERT_FALSE(byName.empty());
  ASSERT_FALSE(byPeople.empty());
  VL_WS_TitlesResponse page;
  ASSERT_EQ(VL_WS_OK, VL_WS_searchForTitle(&m_Handle, 1, 50, 2, 0, "harbor", &page));
  ExpectPage(page, Store(), byName, 0, 1, 50);
  VL_WS_release(&page);
  ASSERT_EQ(VL_WS_OK, VL_WS_searchForTitleDetail(&m_Handle, 1, 50, 2, 0, "Olive Stroud", &page));
  ExpectPage(page, Store(), byPeople, 0, 1, 50);
  VL_WS_release(&page);
  EXPECT_TRUE(Cached("searchForTitle", "1,50,2,0,harbor"));
  EXPECT_TRUE(Cached("searchForTitleDetail", "1,50,2,0,Olive Stroud"));

  // The title type is part of the request and of the Key: television only.
  ASSERT_EQ(VL_WS_OK, VL_WS_searchForTitle(&m_Handle, 1, 50, 2, 1, "harbor", &page));
  EXPECT_GT(page.Titles.Count, 0);
  EXPECT_LT(page.Titles.Count, static_cast<int>(byName.size()));
  for (int i = 0; i < page.Titles.Count; ++i) EXPECT_TRUE(page.Titles.Items[i].IsTvListing);
  VL_WS_release(&page);
  EXPECT_TRUE(Cached("searchForTitle", "1,50,2,1,harbor"));
  EXPECT_EQ((std::vector<std::string>{"searchForTitle", "searchForTitleDetail", "searchForTitle"}), Sent(3));
}

TEST_F(Catalog, SearchNeedsAQueryAndLeavesTheResponseCodeToTheCaller) {
  VL_WS_TitlesResponse page;
  for (const char* query : {"", static_cast<const char*>(nullptr)}) {
    EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_searchForTitle(&m_Handle, 1, 10, 2, 0, query, &page));
    EXPECT_EQ(VL_WS_TAG_TITLES_RESPONSE, *page.tag);
    EXPECT_EQ(VL_WS_TAG_TITLE_LISTING_ARRAY, *page.Titles.tag);
    EXPECT_EQ(0, page.Titles.Count);
    EXPECT_EQ(nullptr, page.ResponseMessage);
    VL_WS_release(&page);
    EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_searchForTitleDetail(&m_Handle, 1, 10, 2, 0, query, &page));
    EXPECT_EQ(VL_WS_TAG_TITLES_RESPONSE, *page.tag);
    VL_WS_release(&page);
  }
  Fault("searchForTitle=code:5,times=1");
  EXPECT_EQ(VL_WS_OK, VL_WS_searchForTitle(&m_Handle, 1, 10, 2, 0, "harbor", &page));
  EXPECT_EQ(5, page.ResponseCode);
  VL_WS_release(&page);
  EXPECT_FALSE(Cached("searchForTitle", "1,10,2,0,harbor"));
  EXPECT_EQ(std::vector<std::string>{"searchForTitle"}, Sent(1));
}

TEST_F(Catalog, LongQueriesThatDifferLateHaveKeysOfTheirOwn) {
  // Keys far beyond 256 bytes: cut ones would let the second query be served the first one's
  // answer.
  const std::string common(300, 'q');
  const std::string first = common + "-first", second = common + "-second";
  VL_WS_TitlesResponse page;
  for (int round = 0; round < 2; ++round) {
    for (const std::string& query : {first, second}) {
      ASSERT_EQ(VL_WS_OK, VL_WS_searchForTitle(&m_Handle, 1, 10, 2, 0, query.c_str(), &page));
      VL_WS_release(&page);
    }
  }
  EXPECT_EQ(std::vector<std::string>(2, "searchForTitle"), Sent(2));
  EXPECT_TRUE(Cached("searchForTitle", ("1,10,2,0," + first).c_str()));
  EXPECT_TRUE(Cached("searchForTitle", ("1,10,2,0," + second).c_str()));
}

TEST_F(Catalog, RecommendedTitlesAreKeptAndFoldTheirCode) {
  std::vector<const VLSimTitle*> recommended = Store().Recommendations(1001);
  ASSERT_FALSE(recommended.empty());
  VL_WS_RecommendedTitlesResponse titles;
  for (int round = 0; round < 2; ++round) {
    ASSERT_EQ(VL_WS_OK, VL_WS_getRecommendedTitles(&m_Handle, 1001, &titles));
    EXPECT_EQ(VL_WS_TAG_RECOMMENDED_TITLES_RESPONSE, *titles.tag);
    EXPECT_EQ(0, titles.ResponseCode);
    EXPECT_EQ(VL_WS_TAG_TITLE_LISTING_ARRAY, *titles.Titles.tag);
    ASSERT_EQ(static_cast<int>(recommended.size()), titles.Titles.Count);
    for (int i = 0; i < titles.Titles.Count; ++i) {
      ExpectTitle(titles.Titles.Items[i], Store(), *recommended[i]);
      EXPECT_EQ(i + 1, titles.Titles.Items[i].TitlePosition);
    }
    VL_WS_release(&titles);
  }
  EXPECT_TRUE(Cached("getRecommendedTitles", "1001"));
  EXPECT_EQ(VL_WS_E_UNEXPECTED, VL_WS_getRecommendedTitles(&m_Handle, 999999, &titles));
  EXPECT_EQ(2, titles.ResponseCode);
  VL_WS_release(&titles);
  EXPECT_FALSE(Cached("getRecommendedTitles", "999999"));
  EXPECT_EQ(std::vector<std::string>(2, "getRecommendedTitles"), Sent(2));
}

TEST_F(Catalog, ShouldUpdateCacheAsksTheStoreAndLeavesTheCacheAlone) {
  VL_WS_TitlesResponse page;
  ASSERT_EQ(VL_WS_OK, VL_WS_getTitles(&m_Handle, 1, 1, 5, 2, &page));
  VL_WS_release(&page);
  Sent(1);
  bool update = true;
  EXPECT_EQ(VL_WS_OK, VL_WS_shouldUpdateCache(&m_Handle, m_Sim.Store().LastCacheLoadTime().c_str(), &update));
  EXPECT_FALSE(update);
  EXPECT_EQ(VL_WS_OK, VL_WS_shouldUpdateCache(&m_Handle, "2001-01-01T00:00:00", &update));
  EXPECT_TRUE(update);
  EXPECT_TRUE(Cached("getTitles", "1,1,5,2"));

  for (const char* time : {"", static_cast<const char*>(nullptr)}) {
    update = true;
    EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_shouldUpdateCache(&m_Handle, time, &update));
    EXPECT_FALSE(update);
  }
  VL_WS_Handle empty = {};
  update = true;
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_shouldUpdateCache(&empty, "2001-01-01T00:00:00", &update));
  EXPECT_FALSE(update);
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_shouldUpdateCache(&m_Handle, "2001-01-01T00:00:00", nullptr));

  Fault("shouldUpdateCache=status:503,times=1");
  update = true;
  EXPECT_EQ(VL_WS_E_HTTP_STATUS(503), VL_WS_shouldUpdateCache(&m_Handle, "2001-01-01T00:00:00", &update));
  EXPECT_FALSE(update);
  EXPECT_EQ(std::vector<std::string>(3, "shouldUpdateCache"), Sent(3));
}

TEST_F(Catalog, UpdateLocalCacheDropsTheAnswersOnlyForANewCatalogue) {
  VL_WS_TitlesResponse page;
  ASSERT_EQ(VL_WS_OK, VL_WS_getTitles(&m_Handle, 1, 1, 5, 2, &page));
  VL_WS_release(&page);
  ASSERT_TRUE(Cache().WriteWishlistFlag(1001, true));
  EXPECT_EQ(kOne, Sent(1));

  // The same catalogue: the answers stay; user data are another kind.
  EXPECT_EQ(VL_WS_OK, VL_WS_updateLocalCache(&m_Handle, VL_WS_CacheParam::CACHE_METADATA));
  EXPECT_EQ(std::vector<std::string>{"getLastCacheLoadTimeUTC"}, Sent(1));
  EXPECT_TRUE(Cached("getTitles", "1,1,5,2"));
  EXPECT_EQ(1, Flag(1001));

  // A new catalogue: they go, and the next page comes from the store.
  const std::string loaded = m_Sim.Store().LastCacheLoadTime();
  m_Sim.Store().SetLastCacheLoadTime("2014-04-04T04:04:04");
  EXPECT_EQ(VL_WS_OK, VL_WS_updateLocalCache(&m_Handle, VL_WS_CacheParam::CACHE_METADATA));
  m_Sim.Store().SetLastCacheLoadTime(loaded);
  EXPECT_FALSE(Cached("getTitles", "1,1,5,2"));
  ASSERT_EQ(VL_WS_OK, VL_WS_getTitles(&m_Handle, 1, 1, 5, 2, &page));
  VL_WS_release(&page);
  EXPECT_EQ((std::vector<std::string>{"getLastCacheLoadTimeUTC", "getTitlesByNavigation"}), Sent(2));

  EXPECT_EQ(VL_WS_OK, VL_WS_updateLocalCache(&m_Handle, VL_WS_CacheParam::CACHE_USERDATA));
  EXPECT_EQ(-1, Flag(1001));

  // Box art on a handle that caches catalogue answers and user data only: nothing happens.
  ASSERT_EQ(VL_WS_OK, Init(MemoryCache(5)));
  ASSERT_EQ(VL_WS_OK, VL_WS_getTitles(&m_Handle, 1, 1, 5, 2, &page));
  VL_WS_release(&page);
  ASSERT_TRUE(Cache().WriteWishlistFlag(1001, true));
  EXPECT_EQ(VL_WS_OK, VL_WS_updateLocalCache(&m_Handle, VL_WS_CacheParam::CACHE_BOXART));
  EXPECT_TRUE(Cached("getTitles", "1,1,5,2"));
  EXPECT_EQ(1, Flag(1001));
  VL_WS_GenreLabelResponse label;
  VL_WS_getGenreLabel(&m_Handle, 10, &label);
  VL_WS_release(&label);
  EXPECT_EQ((std::vector<std::string>{"getTitlesByNavigation", "getGenreLabel"}), Sent(2));
}

TEST_F(Catalog, FileCacheServesEveryHandleOfItsFile) {
  VLTestDir dir;
  VL_WS_SetupParams params = MemoryCache(7);
  params.CacheType = 2;
  params.CachePath = dir.path().c_str();
  ASSERT_EQ(VL_WS_OK, Init(params));
  VL_WS_TitlesResponse page;
  ASSERT_EQ(VL_WS_OK, VL_WS_getTitles(&m_Handle, 1, 1, 5, 2, &page));
  VL_WS_release(&page);
  EXPECT_EQ(kOne, Sent(1));

  VL_WS_Handle copy = {};
  ASSERT_EQ(VL_WS_OK, VL_WS_duplicate(&copy, &m_Handle));
  ASSERT_EQ(VL_WS_OK, VL_WS_getTitles(&copy, 1, 1, 5, 2, &page));
  ExpectPage(page, Store(), Store().TitlesInGenre(1), 1, 1, 5);
  VL_WS_release(&page);
  ASSERT_EQ(VL_WS_OK, VL_WS_getTitles(&copy, 1, 2, 5, 2, &page));
  VL_WS_release(&page);
  EXPECT_EQ(kOne, Sent(1));

  // Wiping the folder takes the answers with it; the handles keep working through the store.
  EXPECT_EQ(VL_WS_OK, VL_WS_clearLocalCache(dir.path().c_str()));
  ASSERT_EQ(VL_WS_OK, VL_WS_getTitles(&copy, 1, 1, 5, 2, &page));
  ExpectPage(page, Store(), Store().TitlesInGenre(1), 1, 1, 5);
  VL_WS_release(&page);
  EXPECT_EQ(kOne, Sent(1));
  VL_WS_release(&copy);
}


// Every operation once with a transport fault: its status, a tagged record holding nothing, and
// nothing in the cache.
TEST_F(Catalog, TransportFaultOfEveryOperationLeavesAnEmptyRecordAndNothingKept) {
  const int ids[] = {10};
  VL_WS_Handle* h = &m_Handle;
  struct Case {
    const char* operation;  // the SOAP operation
    const char* name;       // its cache Name, or null
    const char* key;
    std::function<void()> call;  // calls with the expected status and checks the record
  };
  VL_WS_Status status = 0;
  const Case cases[] = {
      {"getNavigation", "getNavigation", "",
       [&] {
         VL_WS_GenreArray r;
         EXPECT_EQ(status, VL_WS_getNavigation(h, &r));
         EXPECT_EQ(VL_WS_TAG_GENRE_ARRAY, *r.tag);
         EXPECT_EQ(0, r.Count);
         VL_WS_release(&r);
       }},
      {"getGenreLabel", nullptr, nullptr,
       [&] {
         VL_WS_GenreLabelResponse r;
         EXPECT_EQ(status, VL_WS_getGenreLabel(h, 10, &r));
         EXPECT_EQ(VL_WS_TAG_GENRE_LABEL_RESPONSE, *r.tag);
         EXPECT_EQ(nullptr, r.ResponseMessage);
         EXPECT_EQ(nullptr, r.Label);
         VL_WS_release(&r);
       }},
      {"getTitlesByGenreArray", nullptr, nullptr,
       [&] {
         VL_WS_TitlesResponseArray r;
         EXPECT_EQ(status, VL_WS_getTitlesByGenreIDs(h, 1, ids, 1, 5, 2, &r));
         EXPECT_EQ(VL_WS_TAG_TITLES_RESPONSE_ARRAY, *r.tag);
         EXPECT_EQ(0, r.Count);
         VL_WS_release(&r);
       }},
      {"getTitleListing", "getTitleListing", "1001",
       [&] {
         VL_WS_TitleListingResponse r;
         EXPECT_EQ(status, VL_WS_getTitleListing(h, 1001, &r));
         EXPECT_EQ(VL_WS_TAG_TITLE_LISTING_RESPONSE, *r.tag);
         EXPECT_EQ(VL_WS_TAG_BONUS_ASSET_ARRAY, *r.BonusAssets.tag);
         EXPECT_EQ(VL_WS_TAG_PRODUCT_LISTING_ARRAY, *r.AvailableProducts.tag);
         EXPECT_EQ(0, r.TitleID);
         EXPECT_EQ(nullptr, r.TitleName);
         EXPECT_EQ(nullptr, r.Synopsys);
         VL_WS_release(&r);
         EXPECT_EQ(-1, Flag(1001));
       }},
      {"getTvEpisodeListing", "getTvEpisodeListing", "50001",
       [&] {
         VL_WS_TitleListingResponse r;
         EXPECT_EQ(status, VL_WS_getTvEpisodeListing(h, 50001, &r));
         EXPECT_EQ(VL_WS_TAG_TITLE_LISTING_RESPONSE, *r.tag);
         EXPECT_EQ(0, r.TitleID);
         EXPECT_EQ(nullptr, r.ResponseMessage);
         VL_WS_release(&r);
         EXPECT_EQ(-1, Flag(1151));
       }},
      {"getTvEpisodeListByTitleID", "getTvEpisodeListByTitleID", "1151",
       [&] {
         VL_WS_TvEpisodeListResponse r;
         EXPECT_EQ(status, VL_WS_getTvEpisodeListByTitleID(h, 1151, &r));
         EXPECT_EQ(VL_WS_TAG_TV_EPISODE_LIST_RESPONSE, *r.tag);
         EXPECT_EQ(VL_WS_TAG_TV_EPISODE_ARRAY, *r.Episodes.tag);
         EXPECT_EQ(0, r.Episodes.Count);
         VL_WS_release(&r);
       }},
      {"getAllTvEpisodeListings", "getAllTvEpisodeListings", "1151",
       [&] {
         VL_WS_TitleListingResponseArray r;
         EXPECT_EQ(status, VL_WS_getAllTvEpisodeListings(h, 1151, &r));
         EXPECT_EQ(VL_WS_TAG_TITLE_LISTING_RESPONSE_ARRAY, *r.tag);
         EXPECT_EQ(0, r.Count);
         VL_WS_release(&r);
       }},
      {"translateTivoExternalId", "translateTivoExternalId", "tivo:ts.307007",
       [&] {
         VL_WS_TranslateTivoExternalIDResponse r;
         EXPECT_EQ(status, VL_WS_translateTivoExternalID(h, "tivo:ts.307007", &r));
         EXPECT_EQ(VL_WS_TAG_TRANSLATE_TIVO_EXTERNAL_ID_RESPONSE, *r.tag);
         EXPECT_EQ(nullptr, r.TivoExternalId);
         EXPECT_EQ(0, r.TitleId);
         VL_WS_release(&r);
       }},
      {"translateSkuId", "translateSkuId", "10021",
       [&] {
         VL_WS_TranslateSkuIDResponse r;
         EXPECT_EQ(status, VL_WS_translateSkuID(h, 10021, &r));
         EXPECT_EQ(VL_WS_TAG_TRANSLATE_SKU_ID_RESPONSE, *r.tag);
         EXPECT_EQ(0, r.TitleId);
         EXPECT_EQ(nullptr, r.ResponseMessage);
         VL_WS_release(&r);
       }},
      {"searchForTitle", "searchForTitle", "1,5,2,0,harbor",
       [&] {
         VL_WS_TitlesResponse r;
         EXPECT_EQ(status, VL_WS_searchForTitle(h, 1, 5, 2, 0, "harbor", &r));
         EXPECT_EQ(VL_WS_TAG_TITLES_RESPONSE, *r.tag);
         EXPECT_EQ(0, r.Titles.Count);
         EXPECT_EQ(0, r.TotalItems);
         VL_WS_release(&r);
       }},
      {"searchForTitleDetail", "searchForTitleDetail", "1,5,2,0,harbor",
       [&] {
         VL_WS_TitlesResponse r;
         EXPECT_EQ(status, VL_WS_searchForTitleDetail(h, 1, 5, 2, 0, "harbor", &r));
         EXPECT_EQ(VL_WS_TAG_TITLES_RESPONSE, *r.tag);
         EXPECT_EQ(0, r.Titles.Count);
         VL_WS_release(&r);
       }},
      {"getRecommendedTitles", "getRecommendedTitles", "1001",
       [&] {
         VL_WS_RecommendedTitlesResponse r;
         EXPECT_EQ(status, VL_WS_getRecommendedTitles(h, 1001, &r));
         EXPECT_EQ(VL_WS_TAG_RECOMMENDED_TITLES_RESPONSE, *r.tag);
         EXPECT_EQ(VL_WS_TAG_TITLE_LISTING_ARRAY, *r.Titles.tag);
         EXPECT_EQ(0, r.Titles.Count);
         VL_WS_release(&r);
       }},
      {"shouldUpdateCache", nullptr, nullptr,
       [&] {
         bool update = true;
         EXPECT_EQ(status, VL_WS_shouldUpdateCache(h, "2001-01-01T00:00:00", &update));
         EXPECT_FALSE(update);
       }},
      {"getLastCacheLoadTimeUTC", nullptr, nullptr,
       [&] {
         VL_WS_String r;
         EXPECT_EQ(status, VL_WS_getLastCacheLoadTimeUTC(h, &r));
         EXPECT_EQ(VL_WS_TAG_STRING, *r.tag);
         EXPECT_EQ(nullptr, r.Text);
         VL_WS_release(&r);
       }},
  };
  const struct {
    const char* fault;
    VL_WS_Status status;
  } faults[] = {{"status:503", VL_WS_E_HTTP_STATUS(503)},
                {"soapfault:client", VL_WS_E_SOAP_FAULT(1)},
                {"close", VL_WS_E_EOF},
                {"malformed", VL_WS_E_HTTP_STATUS(200)}};
  Authorise("5678");
  for (size_t i = 0; i < sizeof(cases) / sizeof(cases[0]); ++i) {
    const Case& c = cases[i];
    SCOPED_TRACE(c.operation);
    Fault(std::string(c.operation) + "=" + faults[i % 4].fault + ",times=1");
    status = faults[i % 4].status;
    c.call();
    if (c.name != nullptr) {
      EXPECT_FALSE(Cached(c.name, c.key));
    }
    EXPECT_EQ(std::vector<std::string>{c.operation}, Sent(1));
  }
}

// The log area of the client operations, captured.
class CapturedResultLines {
 public:
  CapturedResultLines() {
    VL_LogRegisterArea("VL_WSAE", &m_Area);
    VL_LogActivateArea(m_Area, 1);
    VL_LogSetObserver(Observe, this);
  }
  ~CapturedResultLines() {
    VL_LogSetObserver(nullptr, nullptr);
    VL_LogActivateArea(m_Area, 0);
  }
  std::vector<std::string> lines;

 private:
  static void Observe(void* self, const char* area, int level, const char* text, size_t length) {
    if (std::string(area) == "VL_WSAE" && level == 4)
      static_cast<CapturedResultLines*>(self)->lines.push_back(std::string(text, length));
  }
  int m_Area = -1;
};

TEST_F(Catalog, EveryOperationLogsOneResultLine) {
  VL_WS_TitlesResponse page;
  VL_WS_GenreArray genres;
  VL_WS_TitleListingResponseArray listings;
  bool update = false;
  CapturedResultLines log;
  VL_WS_getTitles(&m_Handle, 1, 1, 5, 2, &page);
  VL_WS_release(&page);
  VL_WS_getTitles(&m_Handle, 1, 1, 5, 2, &page);  // from the cache
  VL_WS_release(&page);
  Fault("getTitlesByNavigation=code:5,times=1");
  VL_WS_getTitles(&m_Handle, 1, 1, 6, 2, &page);
  VL_WS_release(&page);
  Fault("getTitlesByNavigation=status:503,times=1");
  VL_WS_getTitles(&m_Handle, 1, 1, 6, 2, &page);
  VL_WS_release(&page);
  VL_WS_getNavigation(&m_Handle, &genres);
  VL_WS_release(&genres);
  VL_WS_getAllTvEpisodeListings(&m_Handle, 999999, &listings);
  VL_WS_release(&listings);
  VL_WS_shouldUpdateCache(&m_Handle, "2001-01-01T00:00:00", &update);
  EXPECT_EQ((std::vector<std::string>{"VL_WS_getTitles, ret:0,responseCode:0", "VL_WS_getTitles, ret:0,responseCode:0",
                                      "VL_WS_getTitles, ret:0,responseCode:5", "VL_WS_getTitles, ret:503,responseCode:0",
                                      "VL_WS_getNavigation, ret:0", "VL_WS_getAllTvEpisodeListings, ret:0,responseCode:0",
                                      "VL_WS_shouldUpdateCache, result:1"}),
            log.lines);
}

TEST(ClearLocalCache, RemovesImagesDatabasesAndTemporaryFilesOnly) {
  VLTestDir dir;
  for (const char* name : {"t1001_175.jpg", "a b.jpg", ".hidden.jpg", "0_1_7_2.vl", "vlwsAb12Cd", "vlws",
                           "keep.txt", "photo.jpeg", "cache.vl.bak", "settings.xml", "sub/inner.jpg"}) {
    if (strchr(name, '/') != nullptr) {
      ASSERT_EQ(0, mkdir((dir / "sub").c_str(), 0755));
    }
    ASSERT_TRUE(VLWriteFile(dir / name, "x"));
  }
  // Without its separator.
  std::string folder = dir.path().substr(0, dir.path().size() - 1);
  EXPECT_EQ(VL_WS_OK, VL_WS_clearLocalCache(folder.c_str()));
  for (const char* gone : {"t1001_175.jpg", "a b.jpg", ".hidden.jpg", "0_1_7_2.vl", "vlwsAb12Cd", "vlws"})
    EXPECT_FALSE(VLFile::Exist((dir / gone).c_str())) << gone;
  for (const char* kept : {"keep.txt", "photo.jpeg", "cache.vl.bak", "settings.xml", "sub/inner.jpg"})
    EXPECT_TRUE(VLFile::Exist((dir / kept).c_str())) << kept;
  EXPECT_EQ(VL_WS_OK, VL_WS_clearLocalCache(dir.path().c_str()));  // nothing left to remove

  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_clearLocalCache(""));
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_clearLocalCache(nullptr));
  EXPECT_EQ(VL_WS_E_FILE, VL_WS_clearLocalCache((dir / "missing").c_str()));
}

}  // namespace
