// CacheInterface: the local cache as the client sees it. Three kinds of data, each cached only
// when its bit of the cache settings is set: service answers by operation name and key (bit 1),
// box-art images with their HTTP validators (bit 2), and user data by name and key, the
// per-title wishlist flags among them (bit 4). Every operation returns false, or an empty output,
// when the cache is not open or its kind is not cached; a failed read is a miss and a failed
// write is simply not stored.
#ifndef CACHEINTERFACE_H
#define CACHEINTERFACE_H

#include "VLString.h"
#include "VL_WS_SetupParams2.h"
#include "VL_WS_Types.h"

class VLWS_IntVector;
class VLWS_BoolVector;

class CacheInterface {
 public:
  virtual ~CacheInterface() {}

  // Opens the cache with the settings (closing it first when open). 0 on success, else the
  // database's result code.
  virtual int Open(const VL_WS_CacheParam2& params) = 0;
  // Closes the cache; a memory cache loses its contents.
  virtual int Close() = 0;

  // Service answers (bit 1). value is emptied first; an empty name is a miss. Writing an empty
  // name or value stores nothing.
  virtual bool ReadMetaData(const VLString& name, const VLString& key, VLString& value) = 0;
  virtual bool WriteMetaData(const VLString& name, const VLString& key, const VLString& value) = 0;
  // Records the store's last catalogue load time; when it differs from the stored one, every
  // cached answer is dropped. False for an empty time or a failure.
  virtual bool UpdateLastCacheLoadTime(const VLString& time) = 0;

  // Box art (bit 2), by prefix and size. data holds the image bytes for a memory cache and is
  // empty for a file cache, whose images are files beside the database.
  virtual bool WriteBoxArt(const VLString& prefix, VL_WS_BoxArtSize dim, unsigned int size,
                           const VLString& lastModified, unsigned int needUpdate,
                           const VLString& data) = 0;
  virtual bool ReadBoxArt(const VLString& prefix, VL_WS_BoxArtSize dim, unsigned int& size,
                          VLString& lastModified, unsigned int& needUpdate, VLString& data) = 0;
  // Marks every stored image for revalidation with the server.
  virtual bool SetBoxArtNeedUpdate() = 0;

  // User data (bit 4), as the service answers above.
  virtual bool ReadUserData(const VLString& name, const VLString& key, VLString& value) = 0;
  virtual bool WriteUserData(const VLString& name, const VLString& key, const VLString& value) = 0;
  // Deletes the user data of one name, or all of them for the empty name; cached title answers,
  // which carry wishlist membership, go with the wishlist flags.
  virtual bool PurgeUserData(const VLString& name) = 0;

  // Wishlist flags (bit 4). ReadWishlistFlag is true when the title has a flag.
  virtual bool ReadWishlistFlag(int titleID, bool& flag) = 0;
  virtual bool WriteWishlistFlag(int titleID, bool flag) = 0;
  // One flag per title, lists of equal, non-zero length.
  virtual bool WriteWishlistFlags(const VLWS_IntVector& titleIDs,
                                  const VLWS_BoolVector& flags) = 0;
  virtual bool RemoveWishlistFlag(int titleID) = 0;
  virtual bool RemoveAllWishlistFlags() = 0;
};

#endif  // CACHEINTERFACE_H
