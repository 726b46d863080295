// CacheMgr: the local cache database.
#include "CacheMgr.h"

#include <sqlite3.h>
#include <sys/stat.h>
#include <time.h>

#include "VLAssert.h"
#include "VLFile.h"
#include "VLUtilities.h"
#include "VLWS_BoolVector.h"
#include "VLWS_IntVector.h"

namespace {

const int kMetaData = VL_WS_CacheParam::CACHE_METADATA;
const int kBoxArt = VL_WS_CacheParam::CACHE_BOXART;
const int kUserData = VL_WS_CacheParam::CACHE_USERDATA;

// How long an operation waits for other connections to the same file, which hold their locks
// for one operation each.
const int kBusyTimeoutMs = 10000;
const int kBusyPollMs = 1;

// Waits while another connection holds the lock: up to kBusyTimeoutMs in steps of kBusyPollMs.
// SQLite's own timeout backs off to steps of 100 ms, and a connection of this process that writes
// again and again releases its lock only for moments between its operations: polled that rarely,
// a waiting handle misses those moments for many operations in a row and, when the disk is slow,
// runs out of time although each single operation is short. Polling every millisecond finds one
// of those gaps soon.
int BusyWait(void*, int retries) {
  if (retries * kBusyPollMs >= kBusyTimeoutMs) return 0;
  struct timespec pause = {0, kBusyPollMs * 1000000L};
  nanosleep(&pause, 0);
  return 1;
}

// The Userdata name of the per-title wishlist flags.
const char kWishlistFlag[] = "WishlistFlag";

// At most this many images are evicted by one write. A macro, so that the eviction statements
// below spell the same number in their text.
#define VL_EVICTION_BATCH 10
#define VL_TEXT(number) VL_DIGITS(number)
#define VL_DIGITS(number) #number
const int kEvictionBatch = VL_EVICTION_BATCH;

const char* const kSchema[] = {
    "CREATE TABLE IF NOT EXISTS Service (Name TEXT NOT NULL, Key TEXT NOT NULL, Value TEXT NOT "
    "NULL, Size INTEGER, PRIMARY KEY (Name, Key));",
    "CREATE TABLE IF NOT EXISTS BoxArt (Prefix TEXT NOT NULL, Dim INTEGER NOT NULL, Size INTEGER, "
    "LastModified TEXT, NeedUpdate INTEGER NOT NULL, TS DATETIME DEFAULT CURRENT_TIMESTAMP, Data "
    "BLOB, PRIMARY KEY (Prefix, Dim));",
    "CREATE TABLE IF NOT EXISTS Cache (ID INTEGER, LastLoadTime TEXT NOT NULL, PRIMARY KEY (ID));",
    "CREATE TABLE IF NOT EXISTS Userdata (Name TEXT NOT NULL, Key TEXT NOT NULL, Value TEXT NOT "
    "NULL, Size INTEGER, PRIMARY KEY (Name, Key));",
};

const char kSelectService[] = "SELECT Value FROM Service WHERE Name = ? AND Key = ?";
const char kWriteService[] = "INSERT OR REPLACE INTO Service(Name, Key, Value, Size) VALUES (?, ?, ?, ?)";
const char kSelectLoadTime[] = "SELECT LastLoadTime FROM Cache WHERE ID = 1";
const char kWriteLoadTime[] = "INSERT OR REPLACE INTO Cache(ID, LastLoadTime) VALUES(1, ?)";
const char kSelectBoxArt[] =
    "SELECT Size, LastModified, NeedUpdate, Data FROM BoxArt WHERE Prefix = ? AND Dim = ?";
const char kWriteBoxArt[] =
    "INSERT OR REPLACE INTO BoxArt(Prefix, Dim, Size, LastModified, NeedUpdate, Data) VALUES (?, "
    "?, ?, ?, ?, ?)";
const char kMarkBoxArt[] = "UPDATE BoxArt SET NeedUpdate = 1";
const char kSelectUserdata[] = "SELECT Value FROM Userdata WHERE Name = ? AND Key = ?";
const char kWriteUserdata[] = "INSERT OR REPLACE INTO Userdata(Name, Key, Value, Size) VALUES (?, ?, ?, ?)";
const char kWriteFlag[] =
    "INSERT OR REPLACE INTO Userdata(Name, Key, Value, Size) VALUES ('WishlistFlag', ?, ?, 1)";
const char kDeleteFlag[] = "DELETE FROM Userdata WHERE Name = 'WishlistFlag' AND Key = ?";
const char kDeleteUserdata[] = "DELETE FROM Userdata";
const char kDeleteUserdataByName[] = "DELETE FROM Userdata WHERE Name = ?";
// Cached title answers carry the title's wishlist membership.
const char* const kDeleteTitleAnswers[] = {
    "DELETE FROM Service WHERE Name = 'getTitleListing';",
    "DELETE FROM Service WHERE Name = 'getTvEpisodeListing';",
    "DELETE FROM Service WHERE Name = 'getAllTvEpisodeListings';",
};
const char kDeleteService[] = "DELETE FROM Service";
const char kSumService[] = "SELECT SUM(Size) FROM Service";
const char kSumUserdata[] = "SELECT SUM(Size) FROM Userdata";
const char kSumBoxArt[] = "SELECT SUM(Size) FROM BoxArt";
const char kOldestBoxArt[] = "SELECT Prefix, Dim FROM BoxArt ORDER BY TS ASC LIMIT " VL_TEXT(VL_EVICTION_BATCH);
const char kDeleteOldestBoxArt[] =
    "DELETE FROM BoxArt WHERE Prefix in "
    "(SELECT Prefix FROM BoxArt ORDER BY TS ASC LIMIT " VL_TEXT(VL_EVICTION_BATCH) ")";
const char kBeginImmediate[] = "BEGIN IMMEDIATE";
const char kBeginExclusive[] = "BEGIN EXCLUSIVE";
const char kCommit[] = "COMMIT";
const char kRollback[] = "ROLLBACK";

// Results by which SQLite reports a database file it cannot read as one.
bool IsDamage(int rc) { return rc == SQLITE_CORRUPT || rc == SQLITE_NOTADB; }

// The Userdata key of a title's wishlist flag.
VLString FlagKey(int titleID) {
  char key[32];
  return VLString(VLUtilities::safe_snprintf(key, sizeof(key), "%d", titleID));
}

}  // namespace

// The connection of one operation: open (or opened anew) before it, and its statement ended after it.
class CacheMgr::ScopedConnection {
 public:
  explicit ScopedConnection(CacheMgr& cache) : m_Cache(cache), m_Open(cache.OpenConnection() == SQLITE_OK) {}
  ~ScopedConnection() {
    if (m_Cache.m_Damaged) m_Cache.Recreate();
    m_Cache.CloseConnection(false);
  }
  bool IsOpen() const { return m_Open; }

 private:
  CacheMgr& m_Cache;
  bool m_Open;
};

CacheMgr::CacheMgr()
    : m_CacheType(kNoCache),
      m_CacheData(0),
      m_CacheLimit(0),
      m_Opened(false),
      m_Damaged(false),
      m_DB(0),
      m_Stmt(0),
      m_MetaDataLimit(0),
      m_BoxArtLimit(0),
      m_UserDataLimit(0) {}

CacheMgr::~CacheMgr() { Close(); }

// ---- Opening and closing ----------------------------------------------------------------------

int CacheMgr::Open(const VL_WS_CacheParam2& params) {
  Close();
  m_Damaged = false;
  m_CacheType = params.CacheType;
  m_CacheData = params.CacheData;
  m_CacheLimit = static_cast<unsigned int>(params.CacheLimit);
  m_Path = params.CachePath;
  SplitBudget();

  int rc = OpenConnection();
  if (rc == SQLITE_OK && (m_CacheType == kMemoryCache || m_CacheType == kFileCache)) {
    rc = CreateSchema();
  }
  if (rc != SQLITE_OK) {
    CloseConnection(true);
    m_Opened = false;
    return rc;
  }
  CloseConnection(false);
  m_Opened = m_CacheType == kMemoryCache || m_CacheType == kFileCache;
  return SQLITE_OK;
}

int CacheMgr::Close() {
  m_Opened = false;
  m_MetaDataLimit = 0;
  m_BoxArtLimit = 0;
  m_UserDataLimit = 0;
  return CloseConnection(true);
}

// Service answers and user data get 15% of the budget each, box art 70%; what the rounding
// leaves goes to box art, else user data, else service answers.
void CacheMgr::SplitBudget() {
  double share = m_CacheLimit / 10.0;
  if (m_CacheData & kMetaData) m_MetaDataLimit = static_cast<unsigned int>(share * 1.5);
  if (m_CacheData & kBoxArt) m_BoxArtLimit = static_cast<unsigned int>(share * 7.0);
  if (m_CacheData & kUserData) m_UserDataLimit = static_cast<unsigned int>(share * 1.5);
  unsigned int rest = m_CacheLimit - m_MetaDataLimit - m_BoxArtLimit - m_UserDataLimit;
  if (rest == 0) return;
  if (m_CacheData & kBoxArt) {
    m_BoxArtLimit += rest;
  } else if (m_CacheData & kUserData) {
    m_UserDataLimit += rest;
  } else if (m_CacheData & kMetaData) {
    m_MetaDataLimit += rest;
  }
}

int CacheMgr::OpenConnection() {
  if (m_DB != 0) {
    if (m_CacheType != kFileCache || IsOpenFile()) return SQLITE_OK;
    CloseConnection(true);  // the file was removed or replaced since
  }
  int rc;
  switch (m_CacheType) {
    case kNoCache:
      return SQLITE_OK;
    case kMemoryCache:
      rc = sqlite3_open_v2(":memory:", &m_DB, SQLITE_OPEN_READWRITE, 0);
      break;
    case kFileCache:
      rc = sqlite3_open_v2(m_Path.c_str(), &m_DB, SQLITE_OPEN_READWRITE | SQLITE_OPEN_CREATE, 0);
      break;
    default:  // not a cache type
      return SQLITE_MISUSE;
  }
  if (rc == SQLITE_OK) rc = sqlite3_busy_handler(m_DB, BusyWait, 0);
  if (rc == SQLITE_OK && m_CacheType == kFileCache) {
    struct stat file;
    m_FileId[0] = m_FileId[1] = 0;
    if (stat(m_Path.c_str(), &file) == 0) {
      m_FileId[0] = file.st_dev;
      m_FileId[1] = file.st_ino;
    }
  }
  if (rc != SQLITE_OK) CloseConnection(true);  // a failed open may still have made a handle
  return rc;
}

// Another cache object replaces a damaged database, and the client removes a file it cannot
// open: a connection kept to the file that went would read and write where nobody looks.
bool CacheMgr::IsOpenFile() const {
  struct stat file;
  return stat(m_Path.c_str(), &file) == 0 && file.st_dev == m_FileId[0] && file.st_ino == m_FileId[1];
}

int CacheMgr::CloseConnection(bool force) {
  if (m_DB == 0) return SQLITE_OK;
  EndStatement();
  if (!force) {
    // The next operation reads the file afresh: it sees at once what another program wrote to
    // it, or damaged, and an idle handle holds none of its pages.
    if (m_CacheType == kFileCache) sqlite3_db_release_memory(m_DB);
    return SQLITE_OK;
  }
  for (auto& kept : m_Statements) sqlite3_finalize(kept.second);
  m_Statements.clear();
  int rc = sqlite3_close(m_DB);
  m_DB = 0;
  return rc;
}

bool CacheMgr::RemoveDatabaseFile(const VLString& path) {
  // The journal goes first: left without its database, it would be played back into the new
  // database of the same name as if it were that database's own.
  VLFile::Remove((path + "-journal").c_str());
  return VLFile::Remove(path.c_str());
}

// Under an exclusive lock, so that no other connection to the file is in the middle of an
// operation on the database that goes.
void CacheMgr::Recreate() {
  if (m_CacheType == kFileCache) {
    Execute(kBeginExclusive, 0, 0);
    RemoveDatabaseFile(m_Path);
  }
  CloseConnection(true);
  if (OpenConnection() == SQLITE_OK) CreateSchema();
  m_Damaged = false;
}

int CacheMgr::CreateSchema() {
  for (const char* statement : kSchema) {
    int rc = Execute(statement, 0, 0);
    if (rc != SQLITE_OK) return rc;
  }
  return SQLITE_OK;
}

bool CacheMgr::Caches(int kind) const { return m_Opened && (m_CacheData & kind) != 0; }

// ---- Statements -------------------------------------------------------------------------------
// Each statement is prepared once per connection and kept. Every statement is reset before the
// next one starts, so that no read transaction is left open while the connection writes, or
// between operations: with one open, SQLite could not wait for a writer on another connection
// and would fail at once instead of waiting for the busy timeout.

int CacheMgr::Prepare(const char* sql) {
  EndStatement();
  for (auto& kept : m_Statements) {
    if (kept.first == sql) {
      m_Stmt = kept.second;
      return SQLITE_OK;
    }
  }
  int rc = Noted(sqlite3_prepare_v2(m_DB, sql, -1, &m_Stmt, 0));
  if (rc == SQLITE_OK) m_Statements.emplace_back(sql, m_Stmt);
  return rc;
}

int CacheMgr::Step() { return Noted(sqlite3_step(m_Stmt)); }

int CacheMgr::Noted(int rc) {
  if (IsDamage(rc)) m_Damaged = true;
  return rc;
}

void CacheMgr::EndStatement() {
  if (m_Stmt == 0) return;
  sqlite3_reset(m_Stmt);
  sqlite3_clear_bindings(m_Stmt);
  m_Stmt = 0;
}

// Texts are bound with their exact length and without a copy: they outlive the statement.
void CacheMgr::BindText(int index, const VLString& text) {
  sqlite3_bind_text(m_Stmt, index, text.c_str(), static_cast<int>(text.length()), SQLITE_STATIC);
}

void CacheMgr::ColumnText(int index, VLString& text) {
  const char* bytes = reinterpret_cast<const char*>(sqlite3_column_text(m_Stmt, index));
  if (bytes == 0) {
    text.assign("", 0);
  } else {
    text.assign(bytes, sqlite3_column_bytes(m_Stmt, index));
  }
}

// Runs sql to its first row and reads that row's first column into text or number (when given).
int CacheMgr::Execute(const char* sql, VLString* text, unsigned int* number) {
  if (text != 0) text->assign("", 0);
  if (number != 0) *number = 0;
  int rc = Prepare(sql);
  if (rc == SQLITE_OK) {
    rc = Step();
    if (rc == SQLITE_ROW) {
      if (text != 0) ColumnText(0, *text);
      if (number != 0) *number = static_cast<unsigned int>(sqlite3_column_int64(m_Stmt, 0));
    }
    if (rc == SQLITE_ROW || rc == SQLITE_DONE) rc = SQLITE_OK;
  }
  EndStatement();
  return rc;
}

int CacheMgr::ExecuteSQL(const VLString& sql, VLString& result) {
  VL_ASSERT(m_DB != 0);
  return Execute(sql.c_str(), &result, 0);
}

int CacheMgr::ExecuteSQL(const VLString& sql, unsigned int& result) {
  VL_ASSERT(m_DB != 0);
  return Execute(sql.c_str(), 0, &result);
}

// ---- Budget -----------------------------------------------------------------------------------

// Runs before a row of `kind` is written. Over budget (strictly), service answers and user data
// are both emptied whichever of them went over; box art loses the titles of its ten oldest
// images, every size of them, with their files. One call evicts one batch at most, so a write
// can leave its kind over budget; later writes evict further.
void CacheMgr::LimitHandler(int kind) {
  VL_ASSERT(m_DB != 0);
  unsigned int total = 0;
  if (kind == kMetaData || kind == kUserData) {
    unsigned int limit = kind == kMetaData ? m_MetaDataLimit : m_UserDataLimit;
    if (limit == 0) return;
    if (Execute(kind == kMetaData ? kSumService : kSumUserdata, 0, &total) != SQLITE_OK) return;
    if (total > limit) {
      Execute(kDeleteService, 0, 0);
      Execute(kDeleteUserdata, 0, 0);
    }
  } else if (kind == kBoxArt) {
    if (m_BoxArtLimit == 0) return;
    if (Execute(kSumBoxArt, 0, &total) != SQLITE_OK || total <= m_BoxArtLimit) return;
    // Listing the oldest titles and deleting them is one transaction, so that no other
    // connection changes which titles are the oldest in between: the files removed below are
    // exactly those of the deleted rows.
    if (Execute(kBeginImmediate, 0, 0) != SQLITE_OK) return;
    VLString prefixes[kEvictionBatch];
    int count = 0;
    bool deleted = Prepare(kOldestBoxArt) == SQLITE_OK;
    int rc = SQLITE_DONE;
    while (deleted && (rc = Step()) == SQLITE_ROW && count < kEvictionBatch) {
      ColumnText(0, prefixes[count++]);
    }
    EndStatement();
    deleted = deleted && rc == SQLITE_DONE && Execute(kDeleteOldestBoxArt, 0, 0) == SQLITE_OK &&
              Execute(kCommit, 0, 0) == SQLITE_OK;
    if (!deleted) {
      Execute(kRollback, 0, 0);
      return;
    }
    if (m_CacheType != kFileCache) return;
    // Every size of an evicted title lost its row, also sizes newer than the ten oldest rows:
    // remove the file of every size.
    for (int i = 0; i < count; ++i) {
      for (int size = VL_WS_BOXART_95; size <= VL_WS_BOXART_321; ++size) {
        VLString file = VLUtilities::GetBoxArtImageFileName(
            m_Path.c_str(), prefixes[i].c_str(), static_cast<VL_WS_BoxArtSize>(size));
        VLFile::Remove(file.c_str());
      }
    }
  }
}

// ---- Service answers and user data -------------------------------------------------------------

bool CacheMgr::ReadNamedValue(int kind, const char* sql, const VLString& name, const VLString& key,
                              VLString& value) {
  value.assign("", 0);
  if (!Caches(kind) || name.empty()) return false;
  ScopedConnection connection(*this);
  if (!connection.IsOpen() || Prepare(sql) != SQLITE_OK) return false;
  BindText(1, name);
  BindText(2, key);
  if (Step() != SQLITE_ROW) return false;
  ColumnText(0, value);
  return true;
}

bool CacheMgr::WriteNamedValue(int kind, const char* sql, const VLString& name,
                               const VLString& key, const VLString& value) {
  if (!Caches(kind) || name.empty() || value.empty()) return false;
  ScopedConnection connection(*this);
  if (!connection.IsOpen()) return false;
  LimitHandler(kind);
  if (Prepare(sql) != SQLITE_OK) return false;
  BindText(1, name);
  BindText(2, key);
  BindText(3, value);
  sqlite3_bind_int(m_Stmt, 4, static_cast<int>(value.length()));
  return Step() == SQLITE_DONE;
}

bool CacheMgr::ReadMetaData(const VLString& name, const VLString& key, VLString& value) {
  return ReadNamedValue(kMetaData, kSelectService, name, key, value);
}

bool CacheMgr::WriteMetaData(const VLString& name, const VLString& key, const VLString& value) {
  return WriteNamedValue(kMetaData, kWriteService, name, key, value);
}

bool CacheMgr::ReadUserData(const VLString& name, const VLString& key, VLString& value) {
  return ReadNamedValue(kUserData, kSelectUserdata, name, key, value);
}

bool CacheMgr::WriteUserData(const VLString& name, const VLString& key, const VLString& value) {
  return WriteNamedValue(kUserData, kWriteUserdata, name, key, value);
}

// A new load time means a new catalogue: every cached answer goes. The first call on a new
// database therefore always empties Service.
bool CacheMgr::UpdateLastCacheLoadTime(const VLString& time) {
  if (!Caches(kMetaData) || time.empty()) return false;
  ScopedConnection connection(*this);
  if (!connection.IsOpen()) return false;
  VLString stored;
  if (Execute(kSelectLoadTime, &stored, 0) != SQLITE_OK) return false;
  if (stored == time) return true;
  if (Prepare(kWriteLoadTime) != SQLITE_OK) return false;
  BindText(1, time);
  if (Step() != SQLITE_DONE) return false;
  return Execute(kDeleteService, 0, 0) == SQLITE_OK;
}

bool CacheMgr::PurgeUserData(const VLString& name) {
  if (!Caches(kUserData)) return false;
  ScopedConnection connection(*this);
  if (!connection.IsOpen()) return false;
  bool purged;
  if (name.empty()) {
    purged = Execute(kDeleteUserdata, 0, 0) == SQLITE_OK;
  } else {
    purged = Prepare(kDeleteUserdataByName) == SQLITE_OK;
    if (purged) {
      BindText(1, name);
      purged = Step() == SQLITE_DONE;
    }
    EndStatement();
  }
  if ((m_CacheData & kMetaData) && (name.empty() || name == kWishlistFlag)) {
    for (const char* statement : kDeleteTitleAnswers) Execute(statement, 0, 0);
  }
  return purged;
}

// ---- Box art -----------------------------------------------------------------------------------

bool CacheMgr::WriteBoxArt(const VLString& prefix, VL_WS_BoxArtSize dim, unsigned int size,
                           const VLString& lastModified, unsigned int needUpdate,
                           const VLString& data) {
  if (!Caches(kBoxArt) || prefix.empty()) return false;
  ScopedConnection connection(*this);
  if (!connection.IsOpen()) return false;
  LimitHandler(kBoxArt);
  if (Prepare(kWriteBoxArt) != SQLITE_OK) return false;
  BindText(1, prefix);
  sqlite3_bind_int(m_Stmt, 2, dim);
  sqlite3_bind_int(m_Stmt, 3, static_cast<int>(size));
  BindText(4, lastModified);
  sqlite3_bind_int(m_Stmt, 5, static_cast<int>(needUpdate));
  sqlite3_bind_blob(m_Stmt, 6, data.c_str(), static_cast<int>(data.length()), SQLITE_STATIC);
  return Step() == SQLITE_DONE;
}

bool CacheMgr::ReadBoxArt(const VLString& prefix, VL_WS_BoxArtSize dim, unsigned int& size,
                          VLString& lastModified, unsigned int& needUpdate, VLString& data) {
  size = 0;
  lastModified.assign("", 0);
  needUpdate = 0;
  data.assign("", 0);
  if (!Caches(kBoxArt)) return false;
  ScopedConnection connection(*this);
  if (!connection.IsOpen() || Prepare(kSelectBoxArt) != SQLITE_OK) return false;
  BindText(1, prefix);
  sqlite3_bind_int(m_Stmt, 2, dim);
  if (Step() != SQLITE_ROW) return false;
  size = static_cast<unsigned int>(sqlite3_column_int64(m_Stmt, 0));
  ColumnText(1, lastModified);
  needUpdate = static_cast<unsigned int>(sqlite3_column_int(m_Stmt, 2));
  const void* bytes = sqlite3_column_blob(m_Stmt, 3);
  int length = sqlite3_column_bytes(m_Stmt, 3);
  if (bytes != 0 && length > 0) data.assign(static_cast<const char*>(bytes), length);
  return true;
}

bool CacheMgr::SetBoxArtNeedUpdate() {
  if (!Caches(kBoxArt)) return false;
  ScopedConnection connection(*this);
  return connection.IsOpen() && Execute(kMarkBoxArt, 0, 0) == SQLITE_OK;
}

// ---- Wishlist flags ----------------------------------------------------------------------------

bool CacheMgr::ReadWishlistFlag(int titleID, bool& flag) {
  flag = false;
  VLString value;
  if (!ReadUserData(kWishlistFlag, FlagKey(titleID), value)) return false;
  flag = !value.empty() && value[0] == '1';
  return true;
}

bool CacheMgr::WriteWishlistFlag(int titleID, bool flag) {
  return WriteUserData(kWishlistFlag, FlagKey(titleID), flag ? "1" : "0");
}

// Rows are written from the last pair to the first, each on its own: the rows written before a
// failure stay.
bool CacheMgr::WriteWishlistFlags(const VLWS_IntVector& titleIDs, const VLWS_BoolVector& flags) {
  if (!Caches(kUserData) || titleIDs.empty() || titleIDs.size() != flags.size()) return false;
  ScopedConnection connection(*this);
  if (!connection.IsOpen() || Prepare(kWriteFlag) != SQLITE_OK) return false;
  for (size_t i = titleIDs.size(); i-- > 0;) {
    VLString key = FlagKey(titleIDs[i]);
    BindText(1, key);
    sqlite3_bind_text(m_Stmt, 2, flags[i] ? "1" : "0", 1, SQLITE_STATIC);
    if (Step() != SQLITE_DONE) return false;
    sqlite3_reset(m_Stmt);
  }
  return true;
}

bool CacheMgr::RemoveWishlistFlag(int titleID) {
  if (!Caches(kUserData)) return false;
  ScopedConnection connection(*this);
  if (!connection.IsOpen() || Prepare(kDeleteFlag) != SQLITE_OK) return false;
  VLString key = FlagKey(titleID);
  BindText(1, key);
  return Step() == SQLITE_DONE;
}

bool CacheMgr::RemoveAllWishlistFlags() { return PurgeUserData(kWishlistFlag); }
