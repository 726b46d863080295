// CacheMgr on a real SQLite file and in memory: budgets and eviction, the three kinds of data,
// wishlist flags, and two objects sharing one file from two threads. (Box-art rows, their
// validators and revalidation mark are read back by the box-art tests; what a new catalogue load
// time drops, by the catalogue and client tests.)
#include "CacheMgr.h"

#include <gtest/gtest.h>

#include <sstream>
#include <string>
#include <thread>
#include <vector>

#include "VLFile.h"
#include "VLTestDir.h"
#include "VLTestTranscript.h"
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

// The wishlist flag of a title: 1 or 0, or -1 when there is none.
int Flag(CacheMgr& cache, int titleID) {
  bool flag = false;
  return cache.ReadWishlistFlag(titleID, flag) ? flag : -1;
}

bool HasBoxArt(CacheMgr& cache, const std::string& prefix, VL_WS_BoxArtSize dim) {
  unsigned size, needUpdate;
  VLString lastModified, data;
  return cache.ReadBoxArt(prefix.c_str(), dim, size, lastModified, needUpdate, data);
}

// ---- Cache scripts --------------------------------------------------------------------------------

// tests/data/cache/*.txt: commands on one CacheMgr, each followed by what it printed; "#" lines and
// blank lines are comments. Each script runs on a memory cache and on a file cache, and both must
// print it. Commands, with VALUE written as a text or as TEXT*N for N copies of TEXT ('' is empty;
// values printed are written so too):
//   open DATA LIMIT          opens the cache (CacheData and CacheLimit), printing a failing result
//   close                    closes it
//   limits                   the budgets of metadata, box art and user data
//   write-meta NAME KEY VALUE, write-user NAME KEY VALUE    print true or false
//   read-meta NAME KEY, read-user NAME KEY                  print the value, or "miss" (with any
//                                                           text a miss left in the output)
//   write-flag TITLE 0|1, write-flags TITLES FLAGS (comma lists), remove-flag TITLE, remove-flags,
//   purge NAME, write-boxart PREFIX, boxart-need-update, load-time TEXT    print true or false
//   read-flag TITLE          the flag, or -1 without one (with the flag a miss left, if true)
class CacheScript : public testing::TestWithParam<std::string> {
 protected:
  std::string Run(int type, const std::string& file) {
    VLTestDir dir;
    CacheMgr cache;
    std::istringstream lines(VLReadFile(file));
    std::string transcript;
    for (std::string line; std::getline(lines, line);) {
      if (line.compare(0, 2, "$ ") == 0) {
        std::istringstream words(line.substr(2));
        std::vector<std::string> w;
        for (std::string word; words >> word;) w.push_back(word == "''" ? "" : Value(word));
        transcript += line + "\n" + Command(cache, type, dir / "c.vl", w);
      } else if (line.empty() || line[0] == '#') {
        transcript += line + "\n";
      }
    }
    return transcript;
  }

  static std::string Value(const std::string& word) {
    size_t star = word.rfind('*');
    if (star == std::string::npos || star == 0) return word;
    std::string copies;
    for (int i = std::stoi(word.substr(star + 1)); i > 0; --i) copies += word.substr(0, star);
    return copies;
  }
  static std::string Done(bool done) { return done ? "true\n" : "false\n"; }
  // A text of more than 20 copies of one character as TEXT*N.
  static std::string Shown(const VLString& value) {
    std::string text = Str(value);
    if (text.size() <= 20 || text.find_first_not_of(text[0]) != std::string::npos) return text;
    return text.substr(0, 1) + "*" + std::to_string(text.size());
  }
  static std::string Read(bool found, const VLString& value) {
    return found ? Shown(value) + "\n" : value.length() ? "miss with " + Shown(value) + "\n" : "miss\n";
  }
  static std::vector<int> Ints(const std::string& list) {
    std::vector<int> values;
    std::istringstream items(list);
    for (std::string item; std::getline(items, item, ',');) values.push_back(std::stoi(item));
    return values;
  }

  static std::string Command(CacheMgr& cache, int type, const std::string& path, const std::vector<std::string>& w) {
    const std::string& c = w.empty() ? "" : w[0];
    VLString value("left over");
    bool flag = true;
    if (c == "open" && w.size() == 3) {
      int result = cache.Open(Params(type, std::stoi(w[1]), static_cast<int>(std::stoul(w[2])), path));
      return result ? "result " + std::to_string(result) + "\n" : "";
    }
    if (c == "close" && w.size() == 1) return cache.Close() ? "failed\n" : "";
    if (c == "limits" && w.size() == 1) {
      return std::to_string(cache.MetaDataLimit()) + " " + std::to_string(cache.BoxArtLimit()) + " " +
             std::to_string(cache.UserDataLimit()) + "\n";
    }
    if (c == "write-meta" && w.size() == 4) return Done(cache.WriteMetaData(w[1].c_str(), w[2].c_str(), w[3].c_str()));
    if (c == "write-user" && w.size() == 4) return Done(cache.WriteUserData(w[1].c_str(), w[2].c_str(), w[3].c_str()));
    if (c == "read-meta" && w.size() == 3) return Read(cache.ReadMetaData(w[1].c_str(), w[2].c_str(), value), value);
    if (c == "read-user" && w.size() == 3) return Read(cache.ReadUserData(w[1].c_str(), w[2].c_str(), value), value);
    if (c == "write-flag" && w.size() == 3) return Done(cache.WriteWishlistFlag(std::stoi(w[1]), w[2] == "1"));
    if (c == "read-flag" && w.size() == 2) {
      if (cache.ReadWishlistFlag(std::stoi(w[1]), flag)) return flag ? "1\n" : "0\n";
      return flag ? "-1 with true\n" : "-1\n";
    }
    if (c == "write-flags" && w.size() == 3) {
      VLWS_IntVector ids;
      VLWS_BoolVector flags;
      for (int id : Ints(w[1])) ids.push_back(id);
      for (int flag : Ints(w[2])) flags.push_back(flag == 1);
      return Done(cache.WriteWishlistFlags(ids, flags));
    }
    if (c == "remove-flag" && w.size() == 2) return Done(cache.RemoveWishlistFlag(std::stoi(w[1])));
    if (c == "remove-flags" && w.size() == 1) return Done(cache.RemoveAllWishlistFlags());
    if (c == "purge" && w.size() == 2) return Done(cache.PurgeUserData(w[1].c_str()));
    if (c == "write-boxart" && w.size() == 2) return Done(cache.WriteBoxArt(w[1].c_str(), VL_WS_BOXART_95, 1, "", 0, "d"));
    if (c == "boxart-need-update" && w.size() == 1) return Done(cache.SetBoxArtNeedUpdate());
    if (c == "load-time" && w.size() == 2) return Done(cache.UpdateLastCacheLoadTime(w[1].c_str()));
    return "usage: unknown command or wrong arguments\n";
  }
};

TEST_P(CacheScript, PrintsItsTranscriptInMemoryAndInAFile) {
  const std::string file = VL_SOURCE_DIR "/tests/data/cache/" + GetParam() + ".txt";
  const std::string memory = Run(kMemory, file);
  EXPECT_EQ(memory, Run(kFile, file));
  VLExpectTranscript("cache/" + GetParam() + ".txt", memory);
}

INSTANTIATE_TEST_SUITE_P(, CacheScript, testing::ValuesIn(VLTranscriptsIn(VL_SOURCE_DIR "/tests/data/cache")),
                         VLTranscriptTestName);

// Bytes of every value, zeros included, come back as they went in.
TEST(CacheKinds, MetadataKeepsItsExactBytes) {
  for (int type : {kMemory, kFile}) {
    VLTestDir dir;
    CacheMgr cache;
    ASSERT_EQ(0, cache.Open(Params(type, kAllData, 0, dir / "c.vl")));
    const std::string bytes("\x1f\x8b\0\x01zip\0", 8);
    EXPECT_TRUE(cache.WriteMetaData("getTitles", "1,1,20,2", VLString(bytes.data(), bytes.size())));
    VLString read("old");
    EXPECT_TRUE(cache.ReadMetaData("getTitles", "1,1,20,2", read));
    EXPECT_EQ(bytes, Str(read));
  }
}

// A file cache opened without metadata keeps the title answers when user data are purged.
TEST(CacheKinds, PurgeWithoutMetadataLeavesTheTitleAnswers) {
  VLTestDir dir;
  CacheMgr cache;
  ASSERT_EQ(0, cache.Open(Params(kFile, kAllData, 0, dir / "c.vl")));
  ASSERT_TRUE(cache.WriteMetaData("getTitleListing", "1", "title"));
  ASSERT_EQ(0, cache.Open(Params(kFile, 4, 0, dir / "c.vl")));
  EXPECT_TRUE(cache.PurgeUserData(""));
  ASSERT_EQ(0, cache.Open(Params(kFile, kAllData, 0, dir / "c.vl")));
  EXPECT_TRUE(HasMeta(cache, "getTitleListing", "1"));
}

// ---- Cache types ---------------------------------------------------------------------------------

// Type 0 opens and caches nothing, an unknown type does not open, and memory caches are
// separate and lost at the close.
TEST(CacheTypes, TypeZeroUnknownTypesAndMemoryCaches) {
  CacheMgr a, b;
  EXPECT_EQ(0, a.Open(Params(0, kAllData, 0)));
  EXPECT_FALSE(a.WriteMetaData("n", "k", "v"));
  EXPECT_FALSE(a.WriteUserData("n", "k", "v"));
  EXPECT_FALSE(a.WriteBoxArt("p", VL_WS_BOXART_95, 1, "", 0, "d"));
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
