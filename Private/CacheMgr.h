// CacheMgr: the local cache in one SQLite database, in memory (type 1) or in a file (type 2).
//
// Tables: Service (service answers by Name and Key), BoxArt (images by Prefix and Dim), Cache
// (the last catalogue load time) and Userdata (user data and wishlist flags by Name and Key).
// The total byte budget is split between the three kinds of data; a write that finds its kind
// over budget first evicts (see LimitHandler).
//
// A database stays open from Open to Close, with its statements prepared once, but holds no lock
// between operations, so several CacheMgr objects (one per client handle, each used by one
// thread) can share a file: SQLite's file locks serialise them, with a busy timeout of 10
// seconds. Before each operation an object checks that its path still names the file it has
// open, and opens the path anew when the file was removed or replaced. A memory database belongs
// to its one object.
//
// A database that SQLite reports as damaged (corrupt, or not a database) in any operation is
// deleted and made anew, empty, when that operation ends: the operation misses, the ones after
// it work again. A cache must never keep answering from, or failing on, a damaged file.
#ifndef CACHEMGR_H
#define CACHEMGR_H

#include <string>
#include <utility>
#include <vector>

#include "CacheInterface.h"
#include "VLString.h"

struct sqlite3;
struct sqlite3_stmt;

class CacheMgr : public CacheInterface {
 public:
  CacheMgr();
  ~CacheMgr() override;  // closes the cache
  CacheMgr(const CacheMgr&) = delete;
  CacheMgr& operator=(const CacheMgr&) = delete;

  int Open(const VL_WS_CacheParam2& params) override;
  int Close() override;
  bool ReadMetaData(const VLString& name, const VLString& key, VLString& value) override;
  bool WriteMetaData(const VLString& name, const VLString& key, const VLString& value) override;
  bool UpdateLastCacheLoadTime(const VLString& time) override;
  bool WriteBoxArt(const VLString& prefix, VL_WS_BoxArtSize dim, unsigned int size,
                   const VLString& lastModified, unsigned int needUpdate,
                   const VLString& data) override;
  bool ReadBoxArt(const VLString& prefix, VL_WS_BoxArtSize dim, unsigned int& size,
                  VLString& lastModified, unsigned int& needUpdate, VLString& data) override;
  bool SetBoxArtNeedUpdate() override;
  bool ReadUserData(const VLString& name, const VLString& key, VLString& value) override;
  bool WriteUserData(const VLString& name, const VLString& key, const VLString& value) override;
  bool PurgeUserData(const VLString& name) override;
  bool ReadWishlistFlag(int titleID, bool& flag) override;
  bool WriteWishlistFlag(int titleID, bool flag) override;
  bool WriteWishlistFlags(const VLWS_IntVector& titleIDs, const VLWS_BoolVector& flags) override;
  bool RemoveWishlistFlag(int titleID) override;
  bool RemoveAllWishlistFlags() override;

  // Run one statement on the open connection (asserting there is one) and return its SQLite
  // result code, 0 when it finished or produced a row. result receives the first column of the
  // first row, as text or as a number truncated to 32 bits; it is emptied (0) first.
  int ExecuteSQL(const VLString& sql, VLString& result);
  int ExecuteSQL(const VLString& sql, unsigned int& result);

  // Deletes a cache database file with its rollback journal; true when the database file was
  // there and is gone.
  static bool RemoveDatabaseFile(const VLString& path);

  // The byte budgets of the three kinds after Open; 0 means no limit.
  unsigned int MetaDataLimit() const { return m_MetaDataLimit; }
  unsigned int BoxArtLimit() const { return m_BoxArtLimit; }
  unsigned int UserDataLimit() const { return m_UserDataLimit; }

 private:
  class ScopedConnection;

  bool Caches(int kind) const;
  void SplitBudget();
  int OpenConnection();
  // Ends the operation's statement; with force also closes the connection.
  int CloseConnection(bool force);
  bool IsOpenFile() const;
  int CreateSchema();
  // Replaces the damaged database with a new, empty one.
  void Recreate();
  void LimitHandler(int kind);

  // Prepare and Step note a result that reports a damaged database (see Recreate).
  int Prepare(const char* sql);
  int Step();
  int Noted(int rc);
  void EndStatement();
  void BindText(int index, const VLString& text);
  void ColumnText(int index, VLString& text);
  int Execute(const char* sql, VLString* text, unsigned int* number);
  bool ReadNamedValue(int kind, const char* sql, const VLString& name, const VLString& key,
                      VLString& value);
  bool WriteNamedValue(int kind, const char* sql, const VLString& name, const VLString& key,
                       const VLString& value);

  int m_CacheType;
  int m_CacheData;
  unsigned int m_CacheLimit;
  VLString m_Path;
  bool m_Opened;
  bool m_Damaged;  // SQLite reported the database as damaged during the operation under way
  sqlite3* m_DB;
  sqlite3_stmt* m_Stmt;  // the statement of the operation under way
  std::vector<std::pair<std::string, sqlite3_stmt*>> m_Statements;  // prepared on m_DB, by text
  unsigned long long m_FileId[2] = {0, 0};  // device and inode of the open database file
  unsigned int m_MetaDataLimit;
  unsigned int m_BoxArtLimit;
  unsigned int m_UserDataLimit;
};

#endif  // CACHEMGR_H
