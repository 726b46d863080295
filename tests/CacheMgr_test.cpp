// CacheMgr on a real SQLite file and in memory: budgets and eviction, the three kinds of data,
// wishlist flags, and two objects sharing one file from two threads. (Box-art rows, their
// validators and revalidation mark are read back by the box-art tests; what a new catalogue load
// time drops, by the catalogue and client tests.)
#include "CacheMgr.h"

#include <gtest/gtest.h>

#include <string>
#include <thread>

#include "VLFile.h"
#include "VLTestDir.h"
#include "VLWS_BoolVector.h"
#include "VLWS_IntVector.h"

namespace {

const int kAllData = 7;
const int kMemory = 1;
const int kFile = 2;

VL_WS_CacheParam2 Params(int type, int data, int limit, const std::string& path = "") {
  VL_WS_CacheParam2 params;
  params.CacheType = type;
  params.CacheData = data;
  params.CacheLimit = limit;
  params.CachePath = path.c_str();
  return params;
}

std::string Str(const VLString& s) { return std::string(s.c_str(), s.length()); }

bool HasMeta(CacheMgr& cache, const char* name, const char* key) {
  VLString value;
  return cache.ReadMetaData(name, key, value);
}

bool HasUser(CacheMgr& cache, const char* name, const char* key) {
  VLString value;
  return cache.ReadUserData(name, key, value);
}

// The wishlist flag of a title: 1 or 0, or -1 when there is none (after checking that a miss
// leaves the output false).
int Flag(CacheMgr& cache, int titleID) {
  bool flag = true;
  if (cache.ReadWishlistFlag(titleID, flag)) return flag;
  EXPECT_FALSE(flag) << titleID;
  return -1;
}

bool HasBoxArt(CacheMgr& cache, const std::string& prefix, VL_WS_BoxArtSize dim) {
  unsigned size, needUpdate;
  VLString lastModified, data;
  return cache.ReadBoxArt(prefix.c_str(), dim, size, lastModified, needUpdate, data);
}

// Every operation on a kind whose bit is off in data is refused, and its reads miss with an
// emptied output (data 0: a type-0 or closed cache).
void ExpectOnlyKinds(CacheMgr& cache, int data) {
  SCOPED_TRACE(testing::Message() << "cache data " << data);
  VLString value("x");
  if (!(data & 1)) {
    EXPECT_FALSE(cache.ReadMetaData("n", "k", value));
    EXPECT_EQ("", Str(value));
    EXPECT_FALSE(cache.WriteMetaData("n", "k", "v"));
    EXPECT_FALSE(cache.UpdateLastCacheLoadTime("t"));
  }
  if (!(data & 2)) {
    EXPECT_FALSE(cache.WriteBoxArt("p", VL_WS_BOXART_95, 1, "", 0, "d"));
    EXPECT_FALSE(cache.SetBoxArtNeedUpdate());
  }
  if (!(data & 4)) {
    EXPECT_EQ(-1, Flag(cache, 1));
    EXPECT_FALSE(cache.WriteUserData("n", "k", "v"));
    EXPECT_FALSE(cache.PurgeUserData(""));
    EXPECT_FALSE(cache.WriteWishlistFlag(1, true));
    EXPECT_FALSE(cache.RemoveWishlistFlag(1));
    EXPECT_FALSE(cache.RemoveAllWishlistFlags());
  }
}

// Box art gets 70%, the others 15% each; the rounding rest goes to box art, else to user data,
// else to metadata. Budgets above 2^31 bytes are read as unsigned.
TEST(CacheBudget, SplitsFifteenSeventyFifteenAndGivesTheRestByKind) {
  const struct {
    int data;
    unsigned limit, meta, boxArt, user;
  } rows[] = {
      {kAllData, 999, 149, 701, 149}, {1 | 4, 1000, 150, 0, 850}, {1, 1000, 1000, 0, 0},
      {2, 3000000000u, 0, 3000000000u, 0},
  };
  CacheMgr cache;
  for (const auto& row : rows) {
    SCOPED_TRACE(testing::Message() << "data " << row.data << ", limit " << row.limit);
    ASSERT_EQ(0, cache.Open(Params(kMemory, row.data, static_cast<int>(row.limit))));
    EXPECT_EQ(row.meta, cache.MetaDataLimit());
    EXPECT_EQ(row.boxArt, cache.BoxArtLimit());
    EXPECT_EQ(row.user, cache.UserDataLimit());
  }
  cache.Close();
  EXPECT_EQ(0u, cache.BoxArtLimit());
}

// ---- Behaviour shared by memory and file caches ---------------------------------------------------

class CacheKinds : public testing::TestWithParam<int> {
 protected:
  int Open(int data, int limit = 0) { return m_Cache.Open(Params(GetParam(), data, limit, m_Dir / "c.vl")); }

  VLTestDir m_Dir;
  CacheMgr m_Cache;
};

INSTANTIATE_TEST_SUITE_P(MemoryAndFile, CacheKinds, testing::Values(kMemory, kFile),
                         [](const testing::TestParamInfo<int>& info) {
                           return info.param == kMemory ? "Memory" : "File";
                         });

TEST_P(CacheKinds, MetadataKeepsItsExactBytesAndRefusesEmptyNamesAndValues) {
  ASSERT_EQ(0, Open(kAllData));
  const std::string bytes("\x1f\x8b\0\x01zip\0", 8);
  EXPECT_TRUE(m_Cache.WriteMetaData("getTitles", "1,1,20,2", VLString(bytes.data(), bytes.size())));
  VLString read("old");
  EXPECT_TRUE(m_Cache.ReadMetaData("getTitles", "1,1,20,2", read));
  EXPECT_EQ(bytes, Str(read));
  // Other keys and names are misses, a miss empties the output, and user data is separate.
  EXPECT_FALSE(m_Cache.ReadMetaData("getTitles", "1,1,10,2", read));
  EXPECT_EQ("", Str(read));
  EXPECT_FALSE(HasUser(m_Cache, "getTitles", "1,1,20,2"));
  // The empty key is a key like any other (navigation is cached under it).
  EXPECT_TRUE(m_Cache.WriteMetaData("getNavigation", "", "nav"));
  EXPECT_TRUE(HasMeta(m_Cache, "getNavigation", ""));

  EXPECT_FALSE(m_Cache.WriteMetaData("", "k", "v"));
  EXPECT_FALSE(m_Cache.WriteMetaData("n", "k", ""));
  EXPECT_FALSE(m_Cache.WriteUserData("n", "k", ""));
  EXPECT_FALSE(HasMeta(m_Cache, "n", "k"));
  EXPECT_FALSE(m_Cache.WriteBoxArt("", VL_WS_BOXART_95, 1, "", 0, ""));
}

TEST_P(CacheKinds, KindsWhoseBitIsOffAndAClosedCacheAnswerNothing) {
  ASSERT_EQ(0, Open(kAllData));
  ASSERT_TRUE(m_Cache.WriteMetaData("n", "k", "v"));
  ASSERT_EQ(0, Open(4));  // user data only; the file keeps its rows
  ExpectOnlyKinds(m_Cache, 4);
  EXPECT_TRUE(m_Cache.WriteWishlistFlag(1, true));
  ASSERT_EQ(0, Open(1));
  ExpectOnlyKinds(m_Cache, 1);

  ASSERT_EQ(0, Open(kAllData));
  EXPECT_EQ(0, m_Cache.Close());
  ExpectOnlyKinds(m_Cache, 0);
  EXPECT_EQ(0, m_Cache.Close());
}

// With a metadata budget of 150 bytes and 150 bytes stored, a write of 10 more bytes finds 150
// (not above the budget) and stores; the next write finds 160 and empties Service and Userdata
// before storing its own row.
TEST_P(CacheKinds, MetadataEvictionIsStrictAndEmptiesUserDataToo) {
  ASSERT_EQ(0, Open(kAllData, 1000));
  ASSERT_EQ(150u, m_Cache.MetaDataLimit());
  ASSERT_TRUE(m_Cache.WriteUserData("getEmailAddress", "", "mail"));
  ASSERT_TRUE(m_Cache.WriteMetaData("a", "1", std::string(150, 'a').c_str()));
  ASSERT_TRUE(m_Cache.WriteMetaData("a", "2", std::string(10, 'b').c_str()));
  EXPECT_TRUE(HasMeta(m_Cache, "a", "1"));
  EXPECT_TRUE(HasMeta(m_Cache, "a", "2"));
  EXPECT_TRUE(HasUser(m_Cache, "getEmailAddress", ""));

  ASSERT_TRUE(m_Cache.WriteMetaData("a", "3", "c"));
  EXPECT_FALSE(HasMeta(m_Cache, "a", "1"));
  EXPECT_FALSE(HasMeta(m_Cache, "a", "2"));
  EXPECT_TRUE(HasMeta(m_Cache, "a", "3"));
  EXPECT_FALSE(HasUser(m_Cache, "getEmailAddress", ""));
}

TEST_P(CacheKinds, UserDataEvictionEmptiesServiceTooAndNoBudgetNeverEvicts) {
  ASSERT_EQ(0, Open(kAllData, 1000));
  ASSERT_TRUE(m_Cache.WriteMetaData("getTitles", "k", "page"));
  ASSERT_TRUE(m_Cache.WriteUserData("u", "1", std::string(151, 'u').c_str()));
  ASSERT_TRUE(m_Cache.WriteWishlistFlag(5, true));  // finds 151 > 150
  EXPECT_FALSE(HasMeta(m_Cache, "getTitles", "k"));
  EXPECT_FALSE(HasUser(m_Cache, "u", "1"));
  EXPECT_EQ(1, Flag(m_Cache, 5));

  ASSERT_EQ(0, Open(kAllData, 0));
  for (int i = 0; i < 5; ++i) {
    ASSERT_TRUE(m_Cache.WriteMetaData("a", std::to_string(i).c_str(), std::string(100000, 'x').c_str()));
  }
  EXPECT_TRUE(HasMeta(m_Cache, "a", "0"));
}

TEST_P(CacheKinds, WishlistFlags) {
  ASSERT_EQ(0, Open(kAllData));
  EXPECT_EQ(-1, Flag(m_Cache, 7));
  ASSERT_TRUE(m_Cache.WriteWishlistFlag(7, false));
  EXPECT_EQ(0, Flag(m_Cache, 7));
  ASSERT_TRUE(m_Cache.WriteWishlistFlag(-3, true));
  EXPECT_EQ(1, Flag(m_Cache, -3));
  // A flag is a user-data row under "WishlistFlag" and the title in decimal.
  VLString value;
  EXPECT_TRUE(m_Cache.ReadUserData("WishlistFlag", "-3", value));
  EXPECT_EQ("1", Str(value));
  EXPECT_TRUE(m_Cache.RemoveWishlistFlag(7));
  EXPECT_TRUE(m_Cache.RemoveWishlistFlag(7));  // no row: still done
  EXPECT_EQ(-1, Flag(m_Cache, 7));

  // Lists must be non-empty and of one length.
  const int32_t titles[] = {1, 2, 3};
  const bool titleFlags[] = {true, false, true};
  VLWS_IntVector ids(titles, titles + 3);
  VLWS_BoolVector flags(titleFlags, titleFlags + 2);
  EXPECT_FALSE(m_Cache.WriteWishlistFlags(ids, flags));
  EXPECT_EQ(-1, Flag(m_Cache, 1));
  flags.push_back(true);
  ASSERT_TRUE(m_Cache.WriteWishlistFlags(ids, flags));
  EXPECT_EQ(0, Flag(m_Cache, 2));
  EXPECT_EQ(1, Flag(m_Cache, 3));
}

TEST_P(CacheKinds, PurgeUserDataByNameOrAll) {
  const char* titleAnswers[] = {"getTitleListing", "getTvEpisodeListing", "getAllTvEpisodeListings"};
  ASSERT_EQ(0, Open(kAllData));
  ASSERT_TRUE(m_Cache.WriteUserData("getWishlistItems", "0,1,20,0", "page"));
  ASSERT_TRUE(m_Cache.WriteUserData("getEmailAddress", "", "mail"));
  ASSERT_TRUE(m_Cache.WriteWishlistFlag(1, true));
  for (const char* name : titleAnswers) ASSERT_TRUE(m_Cache.WriteMetaData(name, "1", "title"));
  ASSERT_TRUE(m_Cache.WriteMetaData("getTitles", "1,1,20,2", "page"));
  ASSERT_TRUE(m_Cache.WriteMetaData("getNavigation", "", "nav"));

  // Another name removes only its rows.
  EXPECT_TRUE(m_Cache.PurgeUserData("getWishlistItems"));
  EXPECT_FALSE(HasUser(m_Cache, "getWishlistItems", "0,1,20,0"));
  EXPECT_TRUE(HasUser(m_Cache, "getEmailAddress", ""));
  EXPECT_TRUE(HasMeta(m_Cache, "getTitleListing", "1"));

  // The wishlist flags take the cached title answers with them, which carry the same flags.
  EXPECT_TRUE(m_Cache.RemoveAllWishlistFlags());
  EXPECT_EQ(-1, Flag(m_Cache, 1));
  EXPECT_TRUE(HasUser(m_Cache, "getEmailAddress", ""));
  for (const char* name : titleAnswers) EXPECT_FALSE(HasMeta(m_Cache, name, "1")) << name;
  EXPECT_TRUE(HasMeta(m_Cache, "getTitles", "1,1,20,2"));

  // So does purging all user data.
  ASSERT_TRUE(m_Cache.WriteWishlistFlag(1, true));
  for (const char* name : titleAnswers) ASSERT_TRUE(m_Cache.WriteMetaData(name, "1", "title"));
  EXPECT_TRUE(m_Cache.PurgeUserData(""));
  EXPECT_FALSE(HasUser(m_Cache, "getEmailAddress", ""));
  EXPECT_FALSE(HasUser(m_Cache, "WishlistFlag", "1"));
  for (const char* name : titleAnswers) EXPECT_FALSE(HasMeta(m_Cache, name, "1")) << name;
  EXPECT_TRUE(HasMeta(m_Cache, "getNavigation", ""));

  // Without metadata caching the title answers are not touched (nor readable).
  ASSERT_TRUE(m_Cache.WriteMetaData("getTitleListing", "1", "title"));
  ASSERT_EQ(0, Open(4));
  EXPECT_TRUE(m_Cache.PurgeUserData(""));
  ASSERT_EQ(0, Open(kAllData));
  if (GetParam() == kFile) {
    EXPECT_TRUE(HasMeta(m_Cache, "getTitleListing", "1"));
  }
}

// ---- Cache types ---------------------------------------------------------------------------------

// Type 0 opens and caches nothing, an unknown type does not open, and memory caches are
// separate and lost at the close.
TEST(CacheTypes, TypeZeroUnknownTypesAndMemoryCaches) {
  CacheMgr a, b;
  EXPECT_EQ(0, a.Open(Params(0, kAllData, 0)));
  ExpectOnlyKinds(a, 0);
  EXPECT_NE(0, a.Open(Params(3, kAllData, 0)));
  EXPECT_FALSE(a.WriteMetaData("n", "k", "v"));
  ASSERT_EQ(0, a.Open(Params(kMemory, kAllData, 0)));
  ASSERT_EQ(0, b.Open(Params(kMemory, kAllData, 0)));
  ASSERT_TRUE(a.WriteMetaData("n", "k", "v"));
  EXPECT_FALSE(HasMeta(b, "n", "k"));
  a.Close();
  ASSERT_EQ(0, a.Open(Params(kMemory, kAllData, 0)));
  EXPECT_FALSE(HasMeta(a, "n", "k"));
}

// Two caches of every kind without a budget, open on one new file.
struct TwoCachesOnOneFile {
  TwoCachesOnOneFile() {
    EXPECT_EQ(0, a.Open(Params(kFile, kAllData, 0, path)));
    EXPECT_EQ(0, b.Open(Params(kFile, kAllData, 0, path)));
  }
  VLTestDir dir;
  std::string path = dir / "c.vl";
  CacheMgr a, b;
};

TEST(CacheTypes, FileCacheIsSharedAndHoldsNoConnectionBetweenOperations) {
  TwoCachesOnOneFile file;
  ASSERT_TRUE(file.a.WriteMetaData("n", "k", "v"));
  EXPECT_TRUE(HasMeta(file.b, "n", "k"));
  // Another program can take the write lock while both caches are open.
  VLRunSql(file.path, "BEGIN EXCLUSIVE; DELETE FROM Service; COMMIT;");
  EXPECT_FALSE(HasMeta(file.a, "n", "k"));
}

TEST(CacheTypes, FileThatCannotBeOpenedFailsOpen) {
  VLTestDir dir;
  CacheMgr cache;
  EXPECT_NE(0, cache.Open(Params(kFile, kAllData, 0, dir / "missing/c.vl")));
  EXPECT_FALSE(cache.WriteMetaData("n", "k", "v"));

  // A file that is not a database: the schema cannot be created.
  ASSERT_TRUE(VLWriteFile(dir / "junk.vl", std::string(4096, 'j')));
  EXPECT_NE(0, cache.Open(Params(kFile, kAllData, 0, dir / "junk.vl")));
  EXPECT_FALSE(cache.WriteMetaData("n", "k", "v"));
}

// Bytes overwritten in a data page (the file's header intact): the operation that meets the
// damage misses and leaves a new, empty database that every object on the file uses.
TEST(CacheTypes, DamagedDatabaseIsMadeAnewByTheOperationThatFindsIt) {
  TwoCachesOnOneFile file;
  CacheMgr &cache = file.a, &other = file.b;
  const std::string& path = file.path;
  const std::string value(500, 'v');
  for (int i = 0; i < 30; ++i) ASSERT_TRUE(cache.WriteMetaData("n", std::to_string(i).c_str(), value.c_str()));
  long pageSize = std::stol(VLRunSql(path, "PRAGMA page_size"));
  long root = std::stol(VLRunSql(path, "SELECT rootpage FROM sqlite_master WHERE name = 'Service'"));
  std::string bytes = VLReadFile(path);
  ASSERT_GT(root, 1);
  bytes.replace((root - 1) * pageSize, pageSize, pageSize, '\xA5');
  ASSERT_TRUE(VLWriteFile(path, bytes));

  EXPECT_FALSE(HasMeta(cache, "n", "7"));
  EXPECT_EQ("ok", VLRunSql(path, "PRAGMA integrity_check"));
  EXPECT_FALSE(HasMeta(other, "n", "8"));
  ASSERT_TRUE(other.WriteMetaData("n", "k", "v"));
  EXPECT_TRUE(HasMeta(cache, "n", "k"));
  EXPECT_FALSE(VLFile::Exist((path + "-journal").c_str()));
}

// ---- Box-art eviction ----------------------------------------------------------------------------

// Eleven titles of one size, oldest first, plus a second, newest size of the oldest title. The
// write that finds the total over budget deletes every row of the ten oldest titles, both sizes
// of the oldest one included, and their image files.
TEST(BoxArtEviction, RemovesEverySizeOfTheOldestTitlesWithTheirFiles) {
  VLTestDir dir;
  std::string path = dir / "c.vl";
  auto exists = [&](const std::string& name) { return VLFile::Exist((dir / name).c_str()); };
  CacheMgr cache;
  ASSERT_EQ(0, cache.Open(Params(kFile, 2, 1000, path)));
  ASSERT_EQ(1000u, cache.BoxArtLimit());
  for (int i = 0; i <= 10; ++i) {
    std::string prefix = "t" + std::to_string(i);
    ASSERT_TRUE(cache.WriteBoxArt(prefix.c_str(), VL_WS_BOXART_95, 90, "", 0, ""));
    ASSERT_TRUE(VLWriteFile(dir / (prefix + "95.jpg"), "img"));
  }
  ASSERT_TRUE(cache.WriteBoxArt("t0", VL_WS_BOXART_135S, 10, "", 0, ""));
  ASSERT_TRUE(VLWriteFile(dir / "t0135.jpg", "img"));
  VLRunSql(path,
           "UPDATE BoxArt SET TS = datetime('2011-01-01', '+' || substr(Prefix, 2) || ' minutes');"
           "UPDATE BoxArt SET TS = '2012-01-01 00:00:00' WHERE Dim = 6;");

  // 11 * 90 + 10 = 1000: not above the budget, so this write evicts nothing.
  ASSERT_TRUE(cache.WriteBoxArt("new", VL_WS_BOXART_95, 5, "", 0, ""));
  EXPECT_TRUE(HasBoxArt(cache, "t0", VL_WS_BOXART_95));

  // 1005 is above: t0 to t9 go, t10 and the new image stay.
  ASSERT_TRUE(cache.WriteBoxArt("newer", VL_WS_BOXART_95, 5, "", 0, ""));
  for (int i = 0; i <= 9; ++i) {
    std::string prefix = "t" + std::to_string(i);
    EXPECT_FALSE(HasBoxArt(cache, prefix, VL_WS_BOXART_95)) << prefix;
    EXPECT_FALSE(exists(prefix + "95.jpg")) << prefix;
  }
  EXPECT_FALSE(HasBoxArt(cache, "t0", VL_WS_BOXART_135S));
  EXPECT_FALSE(exists("t0135.jpg"));
  EXPECT_TRUE(HasBoxArt(cache, "t10", VL_WS_BOXART_95));
  EXPECT_TRUE(exists("t1095.jpg"));
  EXPECT_TRUE(HasBoxArt(cache, "new", VL_WS_BOXART_95));
  EXPECT_TRUE(HasBoxArt(cache, "newer", VL_WS_BOXART_95));
}

TEST(BoxArtEviction, MemoryCacheEvictsRowsOnly) {
  VLTestDir dir;
  CacheMgr cache;
  ASSERT_EQ(0, cache.Open(Params(kMemory, 2, 1000)));
  ASSERT_TRUE(VLWriteFile(dir / "a95.jpg", "img"));
  ASSERT_TRUE(cache.WriteBoxArt("a", VL_WS_BOXART_95, 1001, "", 0, "bytes"));
  ASSERT_TRUE(cache.WriteBoxArt("b", VL_WS_BOXART_95, 1, "", 0, "bytes"));
  EXPECT_FALSE(HasBoxArt(cache, "a", VL_WS_BOXART_95));
  EXPECT_TRUE(HasBoxArt(cache, "b", VL_WS_BOXART_95));
  EXPECT_TRUE(VLFile::Exist((dir / "a95.jpg").c_str()));
}

// ---- Two handles on one file ---------------------------------------------------------------------

// Each thread works through its own CacheMgr on the same file, as duplicated client handles do,
// and reads back everything it wrote: a busy database must make an operation wait, never turn
// into a miss or a lost write.
TEST(CacheSharing, TwoObjectsOnOneFileFromTwoThreadsLoseNothing) {
  VLTestDir dir;
  const std::string path = dir / "shared.vl";
  const int kRounds = 400;
  int failures[2] = {0, 0};
  auto key = [](int thread, int i) { return std::to_string(thread) + "," + std::to_string(i); };

  auto work = [&](int thread) {
    CacheMgr cache;
    if (cache.Open(Params(kFile, kAllData, 0, path)) != 0) {
      ++failures[thread];
      return;
    }
    for (int i = 0; i < kRounds; ++i) {
      const std::string k = key(thread, i), page = "page " + k;
      const int title = thread * 100000 + i;
      VLString value, lastModified, data;
      bool flag = false;
      unsigned size = 0, needUpdate = 0;
      bool ok = cache.WriteMetaData("getTitles", k.c_str(), page.c_str()) &&
                cache.ReadMetaData("getTitles", k.c_str(), value) && Str(value) == page &&
                cache.WriteWishlistFlag(title, true) && cache.ReadWishlistFlag(title, flag) && flag &&
                cache.WriteBoxArt(k.c_str(), VL_WS_BOXART_95, i, "lm", 0, "") &&
                cache.ReadBoxArt(k.c_str(), VL_WS_BOXART_95, size, lastModified, needUpdate, data) &&
                size == static_cast<unsigned>(i) && cache.SetBoxArtNeedUpdate();
      if (!ok) ++failures[thread];
    }
  };
  std::thread first(work, 0), second(work, 1);
  first.join();
  second.join();
  EXPECT_EQ(0, failures[0]);
  EXPECT_EQ(0, failures[1]);

  // Nothing either thread wrote is missing afterwards.
  CacheMgr check;
  ASSERT_EQ(0, check.Open(Params(kFile, kAllData, 0, path)));
  for (int thread = 0; thread < 2; ++thread) {
    for (int i = 0; i < kRounds; ++i) {
      EXPECT_TRUE(HasMeta(check, "getTitles", key(thread, i).c_str())) << key(thread, i);
      EXPECT_EQ(1, Flag(check, thread * 100000 + i)) << key(thread, i);
    }
  }
}

}  // namespace
