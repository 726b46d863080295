// Catalogue operations against the store simulator (what their records hold, the requests they
// send and what a file cache keeps under which Name and Key, vlws_test pins): refused arguments,
// unreadable cached answers, transport faults and response codes, the wishlist flags of title
// answers, and the cache's refresh.
#include <gtest/gtest.h>
#include <string.h>
#include <sys/stat.h>

#include <chrono>
#include <functional>
#include <string>
#include <vector>

#include "Serializer.h"
#include "VLFile.h"
#include "VLRecord.h"
#include "VLTestAccountClient.h"

namespace {

const VLSimCatalogue& Catalogue() { return VLTestSimulator().Catalogue(); }

// Checks that an answer record carries its own tag, then releases it.
template <class Record>
void ExpectTaggedAndRelease(Record& r) {
  ASSERT_NE(nullptr, r.tag);
  EXPECT_EQ(VLRecordTag<Record>::value, *r.tag);
  EXPECT_EQ(VL_WS_OK, VL_WS_release(&r));
}

// Whether a record holds nothing but its tag cells, the way an operation prepares it before it
// checks anything: word by word, where a freshly prepared record has a tag cell the record has a
// cell with the same tag, and everywhere else it has zero.
template <class Record>
bool HoldsNothing(const Record& r) {
  static_assert(sizeof(Record) % sizeof(int*) == 0, "records are made of pointer-sized words");
  Record fresh;
  VLRecordInit(fresh);
  bool empty = true;
  for (size_t at = 0; at < sizeof(Record); at += sizeof(int*)) {
    const int *got, *cell;
    memcpy(&got, reinterpret_cast<const char*>(&r) + at, sizeof got);
    memcpy(&cell, reinterpret_cast<const char*>(&fresh) + at, sizeof cell);
    if (cell ? got == nullptr || *got != *cell : got != nullptr) empty = false;
  }
  VL_WS_release(&fresh);
  return empty;
}

// Checks that a refused or failed operation left its record tagged and holding nothing, then
// releases it.
template <class Record>
void ExpectEmptyAndRelease(Record& r) {
  EXPECT_TRUE(HoldsNothing(r));
  ExpectTaggedAndRelease(r);
}

// A call that fills a record of type Record, made into one that returns the call's status and
// checks that the record came back empty.
template <class Record, class Call>
std::function<VL_WS_Status()> EmptyAnswer(Call call) {
  return [call] {
    Record r;
    VL_WS_Status status = call(&r);
    ExpectEmptyAndRelease(r);
    return status;
  };
}

// ---- The fixture ----

// Its handle has an in-memory cache of every kind and no token; Init(STREAM, 7) makes one with
// the token of the account of PIN 1234, whose wishlist starts empty.
class Catalog : public VLTestAccountClient {
 protected:
  void SetUp() override {
    VLTestAccountClient::SetUp();
    ASSERT_EQ(VL_WS_OK, Init(VLTestSetupParams(1)));
  }

  // Makes m_Handle anew; the request log and the log lines then start empty.
  using VLTestAccountClient::Init;
  VL_WS_Status Init(const VL_WS_SetupParams& params) {
    VL_WS_release(&m_Handle);
    VL_WS_Status status = VL_WS_initialize(&m_Handle, &params);
    m_Sim.ClearRequests();
    TakeLog();
    return status;
  }
  // The operations of the requests logged since the last call, once count arrived; the log is
  // emptied. A call answered by the cache adds nothing, so a check of "no request" is followed
  // by a call that does send one, and the log must then hold that one alone.
  std::vector<std::string> Sent(size_t count) {
    std::vector<std::string> operations;
    for (const VLSimRequest& r : Requests(count)) operations.push_back(r.operation);
    m_Sim.ClearRequests();
    return operations;
  }
  // Asks for the first page of genre 1 with all products and releases it at once.
  VL_WS_Status FetchTitles(int perPage = 5, VL_WS_Handle* handle = nullptr) {
    VL_WS_TitlesResponse page;
    VL_WS_Status status = VL_WS_getTitles(handle ? handle : &m_Handle, 1, 1, perPage, 2, &page);
    VL_WS_release(&page);
    return status;
  }
  bool Cached(const char* name, const char* key) {
    VLString value;
    return Cache().ReadMetaData(name, key, value);
  }
};

const std::vector<std::string> kOne = {"getTitlesByNavigation"};

TEST_F(Catalog, UnreadableCachedAnswerIsAMissAndIsReplaced) {
  // Not a stored record at all, and a stored response without its result element.
  _VL1__getTitlesByNavigationResponse empty;
  VLString noResult;
  ASSERT_TRUE(StoreResponse(empty, noResult, true));
  for (const VLString& text : {VLString("not gzip, not XML"), noResult}) {
    ASSERT_TRUE(Cache().WriteMetaData("getTitles", "1,1,5,2", text));
    VL_WS_TitlesResponse page;
    ASSERT_EQ(VL_WS_OK, VL_WS_getTitles(&m_Handle, 1, 1, 5, 2, &page));
    EXPECT_EQ(kOne, Sent(1));
    EXPECT_EQ(5, page.Titles.Count);
    VL_WS_release(&page);
    VLString value;
    ASSERT_TRUE(Cache().ReadMetaData("getTitles", "1,1,5,2", value));
    EXPECT_NE(text, value);
  }
}

// The store answers page number and size in 16-bit fields: values beyond them never go out, nor
// do requests without the IDs they are about.
TEST_F(Catalog, PagesBeyondSixteenBitsAndMissingIDsAreRefusedBeforeAnyRequest) {
  const int genres[] = {1};
  for (auto page : std::vector<std::pair<int, int>>{{1, 100000}, {32768, 5}, {-32769, 5}, {1, -100000}}) {
    SCOPED_TRACE(std::to_string(page.first) + "," + std::to_string(page.second));
    const int n = page.first, per = page.second;
    std::vector<std::function<VL_WS_Status()>> calls = {
        EmptyAnswer<VL_WS_TitlesResponse>([&](auto* r) { return VL_WS_getTitles(&m_Handle, 1, n, per, 2, r); }),
        EmptyAnswer<VL_WS_TitlesResponseArray>(
            [&](auto* r) { return VL_WS_getTitlesByGenreIDs(&m_Handle, 1, genres, n, per, 2, r); }),
        EmptyAnswer<VL_WS_TitlesResponse>([&](auto* r) { return VL_WS_searchForTitle(&m_Handle, n, per, 2, 0, "a", r); }),
        EmptyAnswer<VL_WS_TitlesResponse>(
            [&](auto* r) { return VL_WS_searchForTitleDetail(&m_Handle, n, per, 2, 0, "a", r); }),
        EmptyAnswer<VL_WS_MyVideosResponse>([&](auto* r) { return VL_WS_getMyVideos(&m_Handle, n, per, 2, 0, 0, r); }),
        EmptyAnswer<VL_WS_WishlistItemsResponse>(
            [&](auto* r) { return VL_WS_getWishlistItems(&m_Handle, static_cast<VL_WS_SortOrder>(0), n, per, 0, r); }),
    };
    for (auto& call : calls) EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, call());
  }
  VL_WS_Handle empty = {};
  VL_WS_TitlesResponse page;
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_getTitles(&empty, 1, 1, 5, 2, &page));
  ExpectEmptyAndRelease(page);
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_getTitles(&m_Handle, 1, 1, 5, 2, nullptr));
  // A count of genres below 1 or no IDs, no TiVo ID.
  VL_WS_TitlesResponseArray pages;
  for (int count : {0, -1, 1}) {
    EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT,
              VL_WS_getTitlesByGenreIDs(&m_Handle, count, count > 0 ? nullptr : genres, 1, 3, 2, &pages));
    ExpectEmptyAndRelease(pages);
  }
  VL_WS_TranslateTivoExternalIDResponse tivo;
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_translateTivoExternalID(&m_Handle, nullptr, &tivo));
  ExpectEmptyAndRelease(tivo);
  EXPECT_TRUE(RequestsNow().empty());
  EXPECT_EQ(VL_WS_OK, FetchTitles(32767));
}

TEST_F(Catalog, GenreLabelOfAnUnknownGenreFoldsItsCode) {
  VL_WS_GenreLabelResponse label;
  EXPECT_EQ(VL_WS_E_UNEXPECTED, VL_WS_getGenreLabel(&m_Handle, 999, &label));
  EXPECT_EQ(2, label.ResponseCode);
  EXPECT_STREQ("Unknown genre", label.ResponseMessage);
  EXPECT_STREQ("", label.Label);
  VL_WS_release(&label);
}

TEST_F(Catalog, TitleListingIsKeptWithItsWishlistFlagWhichTheCacheDoesNotRewrite) {
  Init(STREAM, 7);
  m_Sim.Store().WishlistAdd(Account(), 1002);
  VL_WS_TitleListingResponse details;
  ASSERT_EQ(VL_WS_OK, VL_WS_getTitleListing(&m_Handle, 1002, &details));
  VL_WS_release(&details);
  ASSERT_EQ(VL_WS_OK, VL_WS_getTitleListing(&m_Handle, 1003, &details));
  VL_WS_release(&details);
  EXPECT_EQ(1, Flag(1002));
  EXPECT_EQ(0, Flag(1003));

  // Answered by the cache: the flag stays as the cache has it.
  ASSERT_TRUE(Cache().WriteWishlistFlag(1002, false));
  ASSERT_EQ(VL_WS_OK, VL_WS_getTitleListing(&m_Handle, 1002, &details));
  const VLSimTitle& title = *Catalogue().FindTitle(1002);  // the cache keeps the details too
  EXPECT_STREQ(title.synopsis.c_str(), details.Synopsys);
  EXPECT_STREQ(title.ratingReason.c_str(), details.RatingReason);
  EXPECT_EQ(static_cast<int>(title.products.size()), details.AvailableProducts.Count);
  ExpectTaggedAndRelease(details);
  EXPECT_EQ(0, Flag(1002));

  // An unknown title: folded.
  EXPECT_EQ(VL_WS_E_UNEXPECTED, VL_WS_getTitleListing(&m_Handle, 999999, &details));
  EXPECT_EQ(2, details.ResponseCode);
  EXPECT_EQ(999999, details.TitleID);
  VL_WS_release(&details);

  // Without user data the answer is kept and no flag written.
  Init(STREAM, 1);
  ASSERT_EQ(VL_WS_OK, VL_WS_getTitleListing(&m_Handle, 1002, &details));
  VL_WS_release(&details);
  EXPECT_TRUE(Cached("getTitleListing", "1002"));
  EXPECT_EQ(-1, Flag(1002));
}

TEST_F(Catalog, EpisodeListingIsKeptWithTheSeriesWishlistFlag) {
  Init(STREAM, 7);
  m_Sim.Store().WishlistAdd(Account(), 1151);
  VL_WS_TitleListingResponse details;
  for (int round = 0; round < 2; ++round) {
    ASSERT_EQ(VL_WS_OK, VL_WS_getTvEpisodeListing(&m_Handle, 50002, &details));
    EXPECT_STREQ("Harbor Lights: Episode 2: Iron Island", details.TitleName);
    ExpectTaggedAndRelease(details);
  }
  EXPECT_EQ(1, Flag(1151));
  EXPECT_EQ(-1, Flag(50002));
}

TEST_F(Catalog, AllEpisodeListingsAreKeptWithEveryWishlistFlagWhenThereAreAnyAndNoneFailed) {
  Init(STREAM, 7);
  m_Sim.Store().WishlistAdd(Account(), 1152);
  const VLSimTitle* series = Catalogue().FindTitle(1152);
  VL_WS_TitleListingResponseArray listings;
  for (int round = 0; round < 2; ++round) {
    ASSERT_EQ(VL_WS_OK, VL_WS_getAllTvEpisodeListings(&m_Handle, 1152, &listings));
    ASSERT_EQ(static_cast<int>(series->episodes.size()), listings.Count);
    EXPECT_STREQ(series->synopsis.c_str(), listings.Items[1].Synopsys);
    ExpectTaggedAndRelease(listings);
  }
  EXPECT_EQ(1, Flag(1152));

  // Listings the store refused: the codes are the caller's to read, and they are not kept.
  Fault("getAllTvEpisodeListings=code:5,times=1");
  ASSERT_EQ(VL_WS_OK, VL_WS_getAllTvEpisodeListings(&m_Handle, 1151, &listings));
  ASSERT_GT(listings.Count, 0);
  EXPECT_EQ(5, listings.Items[0].ResponseCode);
  VL_WS_release(&listings);
  EXPECT_FALSE(Cached("getAllTvEpisodeListings", "1151"));
}

TEST_F(Catalog, SearchNeedsAQueryAndLeavesTheResponseCodeToTheCaller) {
  VL_WS_TitlesResponse page;
  for (const char* query : {"", static_cast<const char*>(nullptr)}) {
    EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_searchForTitle(&m_Handle, 1, 10, 2, 0, query, &page));
    ExpectEmptyAndRelease(page);
    EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_searchForTitleDetail(&m_Handle, 1, 10, 2, 0, query, &page));
    ExpectEmptyAndRelease(page);
  }
  Fault("searchForTitle=code:5,times=1");
  EXPECT_EQ(VL_WS_OK, VL_WS_searchForTitle(&m_Handle, 1, 10, 2, 0, "harbor", &page));
  EXPECT_EQ(5, page.ResponseCode);
  VL_WS_release(&page);
  EXPECT_FALSE(Cached("searchForTitle", "1,10,2,0,harbor"));
  EXPECT_EQ(std::vector<std::string>{"searchForTitle"}, Sent(1));
}

TEST_F(Catalog, ShouldUpdateCacheNeedsATime) {
  bool update = true;
  VL_WS_Handle empty = {};
  const struct {
    VL_WS_Handle* handle;
    const char* time;
  } refused[] = {{&m_Handle, ""}, {&m_Handle, nullptr}, {&empty, "2001-01-01T00:00:00"}};
  for (const auto& c : refused) {
    update = true;
    EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_shouldUpdateCache(c.handle, c.time, &update));
    EXPECT_FALSE(update);
  }
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_shouldUpdateCache(&m_Handle, "2001-01-01T00:00:00", nullptr));
  EXPECT_TRUE(RequestsNow().empty());
}

// Only the kinds given and cached are refreshed: box art is marked for revalidation, catalogue
// answers go only for a new catalogue, user data always go.
TEST_F(Catalog, UpdateLocalCacheRefreshesTheKindsGivenAndCached) {
  EXPECT_EQ(VL_WS_OK, FetchTitles());
  ASSERT_TRUE(Cache().WriteWishlistFlag(1001, true));
  ASSERT_TRUE(Cache().WriteBoxArt("t1001_", VL_WS_BOXART_175, 5, "Mon", 0, ""));
  EXPECT_EQ(kOne, Sent(1));
  EXPECT_EQ(VL_WS_OK, VL_WS_updateLocalCache(&m_Handle, VL_WS_CacheParam::CACHE_BOXART));
  unsigned int size = 0, needUpdate = 0;
  VLString lastModified, data;
  ASSERT_TRUE(Cache().ReadBoxArt("t1001_", VL_WS_BOXART_175, size, lastModified, needUpdate, data));
  EXPECT_EQ(1u, needUpdate);
  EXPECT_TRUE(RequestsNow().empty());

  // The same catalogue: the answers stay; user data are another kind.
  EXPECT_EQ(VL_WS_OK, VL_WS_updateLocalCache(&m_Handle, VL_WS_CacheParam::CACHE_METADATA));
  EXPECT_EQ(std::vector<std::string>{"getLastCacheLoadTimeUTC"}, Sent(1));
  EXPECT_TRUE(Cached("getTitles", "1,1,5,2"));
  EXPECT_EQ(1, Flag(1001));

  // A new catalogue whose load time cannot be fetched changes nothing; once fetched, the answers
  // go, and the next page comes from the store.
  const std::string loaded = m_Sim.Store().LastCacheLoadTime();
  m_Sim.Store().SetLastCacheLoadTime("2014-04-04T04:04:04");
  Fault("getLastCacheLoadTimeUTC=status:503,times=1");
  EXPECT_EQ(VL_WS_OK, VL_WS_updateLocalCache(&m_Handle, VL_WS_CacheParam::CACHE_METADATA));
  EXPECT_TRUE(Cached("getTitles", "1,1,5,2"));
  EXPECT_EQ(VL_WS_OK, VL_WS_updateLocalCache(&m_Handle, VL_WS_CacheParam::CACHE_METADATA));
  m_Sim.Store().SetLastCacheLoadTime(loaded);
  EXPECT_FALSE(Cached("getTitles", "1,1,5,2"));
  EXPECT_EQ(VL_WS_OK, FetchTitles());
  EXPECT_EQ((std::vector<std::string>{"getLastCacheLoadTimeUTC", "getLastCacheLoadTimeUTC", "getTitlesByNavigation"}),
            Sent(3));

  EXPECT_EQ(VL_WS_OK, VL_WS_updateLocalCache(&m_Handle, VL_WS_CacheParam::CACHE_USERDATA));
  EXPECT_EQ(-1, Flag(1001));

  // Box art on a handle that caches catalogue answers and user data only: nothing happens.
  ASSERT_EQ(VL_WS_OK, Init(VLTestSetupParams(1, 5)));
  EXPECT_EQ(VL_WS_OK, FetchTitles());
  ASSERT_TRUE(Cache().WriteWishlistFlag(1001, true));
  EXPECT_EQ(VL_WS_OK, VL_WS_updateLocalCache(&m_Handle, VL_WS_CacheParam::CACHE_BOXART));
  EXPECT_TRUE(Cached("getTitles", "1,1,5,2"));
  EXPECT_EQ(1, Flag(1001));
  EXPECT_EQ(kOne, Sent(1));

  // Without a cache there is nothing to refresh.
  ASSERT_EQ(VL_WS_OK, Init(VLTestSetupParams()));
  EXPECT_EQ(VL_WS_OK, VL_WS_updateLocalCache(&m_Handle, 7));
  EXPECT_TRUE(RequestsNow().empty());
  VL_WS_Handle empty = {};
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_updateLocalCache(&empty, 7));
}

TEST_F(Catalog, FileCacheServesEveryHandleOfItsFile) {
  VLTestDir dir;
  ASSERT_EQ(VL_WS_OK, Init(VLTestSetupParams(2, 7, dir.path().c_str())));
  EXPECT_EQ(VL_WS_OK, FetchTitles());
  EXPECT_EQ(kOne, Sent(1));

  VL_WS_Handle copy = {};
  ASSERT_EQ(VL_WS_OK, VL_WS_duplicate(&copy, &m_Handle));
  VL_WS_TitlesResponse page;
  ASSERT_EQ(VL_WS_OK, VL_WS_getTitles(&copy, 1, 1, 5, 2, &page));
  EXPECT_EQ(5, page.Titles.Count);
  VL_WS_release(&page);
  EXPECT_EQ(VL_WS_OK, FetchTitles(6, &copy));
  EXPECT_EQ(kOne, Sent(1));

  // Wiping the folder takes the answers with it; the handles keep working through the store.
  EXPECT_EQ(VL_WS_OK, VL_WS_clearLocalCache(dir.path().c_str()));
  ASSERT_EQ(VL_WS_OK, VL_WS_getTitles(&copy, 1, 1, 5, 2, &page));
  EXPECT_EQ(5, page.Titles.Count);
  VL_WS_release(&page);
  EXPECT_EQ(kOne, Sent(1));
  VL_WS_release(&copy);
}

// A transport fault in each shape of catalogue answer (they share one call sequence): its status,
// a tagged record holding nothing, and nothing in the cache.
TEST_F(Catalog, TransportFaultsLeaveAnEmptyRecordAndNothingKept) {
  VL_WS_Handle* h = &m_Handle;
  const struct {
    const char* operation;  // the SOAP operation
    const char* name;       // its cache Name and Key, or null when it is never kept
    const char* key;
    std::function<VL_WS_Status()> call;
  } cases[] = {
      {"getTitlesByNavigation", "getTitles", "1,1,5,2",
       EmptyAnswer<VL_WS_TitlesResponse>([&](auto* r) { return VL_WS_getTitles(h, 1, 1, 5, 2, r); })},
      {"getGenreLabel", nullptr, nullptr,
       EmptyAnswer<VL_WS_GenreLabelResponse>([&](auto* r) { return VL_WS_getGenreLabel(h, 10, r); })},
      {"getAllTvEpisodeListings", "getAllTvEpisodeListings", "1151",
       EmptyAnswer<VL_WS_TitleListingResponseArray>(
           [&](auto* r) { return VL_WS_getAllTvEpisodeListings(h, 1151, r); })},
      {"shouldUpdateCache", nullptr, nullptr,
       [&] {
         bool update = true;
         VL_WS_Status status = VL_WS_shouldUpdateCache(h, "2001-01-01T00:00:00", &update);
         EXPECT_FALSE(update);
         return status;
       }},
      {"getLastCacheLoadTimeUTC", nullptr, nullptr,
       EmptyAnswer<VL_WS_String>([&](auto* r) { return VL_WS_getLastCacheLoadTimeUTC(h, r); })},
  };
  const struct {
    const char* fault;
    VL_WS_Status status;
  } faults[] = {{"status:503", VL_WS_E_HTTP_STATUS(503)},
                {"soapfault:client", VL_WS_E_SOAP_FAULT(1)},
                {"soapfault:server", VL_WS_E_SOAP_FAULT(2)},
                {"close", VL_WS_E_EOF},
                {"malformed", VL_WS_E_HTTP_STATUS(200)}};
  Init(STREAM, 7);
  size_t i = 0;
  for (const auto& c : cases) {
    const auto& f = faults[i++ % (sizeof(faults) / sizeof(faults[0]))];
    SCOPED_TRACE(std::string(c.operation) + " " + f.fault);
    Fault(std::string(c.operation) + "=" + f.fault + ",times=1");
    EXPECT_EQ(f.status, c.call());
    if (c.name != nullptr) {
      EXPECT_FALSE(Cached(c.name, c.key));
    }
    EXPECT_EQ(-1, Flag(1001));
    EXPECT_EQ(-1, Flag(1151));
    EXPECT_EQ(std::vector<std::string>{c.operation}, Sent(1));
  }
}

// Each wait for the answer is short, but the answer trickles in: the call ends at the deadline of
// the whole exchange (send and receive time-out together, 1 + 1 s here) with the status a
// receive time-out gives, SOAP call or hand-built request alike, and the handle works next.
TEST_F(Catalog, ATricklingAnswerEndsAtTheDeadlineOfTheExchange) {
  soap& context = m_Handle.client->m_RealTimeBrowse;
  context.send_timeout = context.recv_timeout = 1;
  const struct {
    const char* fault;
    VL_WS_Status status;
    std::function<VL_WS_Status()> call;
  } cases[] = {
      {"getTitlesByNavigation=trickle:100,times=1", VL_WS_E_EOF, [&] { return FetchTitles(); }},
      {"/images/boxart/=trickle:100,times=1", VL_WS_E_NETWORK,
       [&] {
         VL_WS_Image image;
         VL_WS_Status status = VL_WS_getBoxArtImageData(&m_Handle, VL_WS_BOXART_321, "t1001_", &image);
         EXPECT_EQ(nullptr, image.Data);
         VL_WS_release(&image);
         return status;
       }},
  };
  for (const auto& c : cases) {
    SCOPED_TRACE(c.fault);
    Fault(c.fault);
    auto start = std::chrono::steady_clock::now();
    EXPECT_EQ(c.status, c.call());
    EXPECT_LT(std::chrono::steady_clock::now() - start, std::chrono::seconds(10));
  }
  EXPECT_EQ(VL_WS_OK, FetchTitles());
}

TEST_F(Catalog, EveryOperationLogsOneResultLine) {
  VL_WS_GenreArray genres;
  VL_WS_TitleListingResponseArray listings;
  bool update = false;
  FetchTitles();
  FetchTitles();  // from the cache
  Fault("getTitlesByNavigation=code:5,times=1");
  FetchTitles(6);
  Fault("getTitlesByNavigation=status:503,times=1");
  FetchTitles(6);
  VL_WS_getNavigation(&m_Handle, &genres);
  VL_WS_release(&genres);
  VL_WS_getAllTvEpisodeListings(&m_Handle, 999999, &listings);
  VL_WS_release(&listings);
  VL_WS_shouldUpdateCache(&m_Handle, "2001-01-01T00:00:00", &update);
  EXPECT_EQ((std::vector<std::string>{"VL_WS_getTitles, ret:0,responseCode:0",
                                      "getTitlesByNavigation, answered from the cache",
                                      "VL_WS_getTitles, ret:0,responseCode:0",
                                      "VL_WS_getTitles, ret:0,responseCode:5", "VL_WS_getTitles, ret:503,responseCode:0",
                                      "VL_WS_getNavigation, ret:0", "VL_WS_getAllTvEpisodeListings, ret:0,responseCode:0",
                                      "VL_WS_shouldUpdateCache, result:1"}),
            TakeLog());
}

TEST(ClearLocalCache, RemovesImagesDatabasesAndTemporaryFilesOnly) {
  VLTestDir dir;
  ASSERT_EQ(0, mkdir((dir / "sub").c_str(), 0755));
  const std::vector<const char*> gone = {"t1001_175.jpg", "a b.jpg", ".hidden.jpg", "0_1_7_2.vl", "vlwsAb12Cd", "vlws"};
  const std::vector<const char*> kept = {"keep.txt", "photo.jpeg", "cache.vl.bak", "settings.xml", "sub/inner.jpg"};
  for (const auto* names : {&gone, &kept})
    for (const char* name : *names) ASSERT_TRUE(VLWriteFile(dir / name, "x")) << name;
  // Without its separator.
  std::string folder = dir.path().substr(0, dir.path().size() - 1);
  EXPECT_EQ(VL_WS_OK, VL_WS_clearLocalCache(folder.c_str()));
  for (const char* name : gone) EXPECT_FALSE(VLFile::Exist((dir / name).c_str())) << name;
  for (const char* name : kept) EXPECT_TRUE(VLFile::Exist((dir / name).c_str())) << name;
  EXPECT_EQ(VL_WS_OK, VL_WS_clearLocalCache(dir.path().c_str()));  // nothing left to remove

  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_clearLocalCache(""));
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_clearLocalCache(nullptr));
  EXPECT_EQ(VL_WS_E_FILE, VL_WS_clearLocalCache((dir / "missing").c_str()));
}

}  // namespace
