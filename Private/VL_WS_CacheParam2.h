// VL_WS_CacheParam2: a handle's cache settings, as the cache opens with them.
#ifndef VL_WS_CACHEPARAM2_H
#define VL_WS_CACHEPARAM2_H

#include "VLString.h"

struct VL_WS_CacheParam2 {
  int CacheType;      // 0 no cache, 1 database in memory, 2 database file
  int CacheData;      // bit set of VL_WS_CacheParam::CacheData: the kinds of data cached
  int CacheLimit;     // total byte budget (read as unsigned); 0 = no limit
  VLString CachePath; // full name of the database file (type 2)
};

#endif  // VL_WS_CACHEPARAM2_H
