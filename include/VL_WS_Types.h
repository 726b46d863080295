/*
 * VL_WS_Types.h: the status type, enumerations, setup record and handle of the flat client
 * interface VL_WS_. The records that the interface fills for its callers are declared in
 * VL_WS_Records.h; the operations in VL_WS.h.
 */
#ifndef VL_WS_TYPES_H
#define VL_WS_TYPES_H

/* Status of every VL_WS_ operation: 0 success, negative failure (values in VL_WS_Records.h). */
typedef int VL_WS_Status;

/* The enumerations below have the fixed underlying type int: callers (the script layer among
 * them) may hand over any int, and the operations say what they do with values outside the
 * named ones. */

/* Which store environment a handle talks to. 0 to 2 select a fixed one; VL_WS_ENV_DEFAULT (and
 * any larger value) asks the store's device-environment service at initialisation. */
enum VL_WS_EnvNum : int {
  VL_WS_ENV_STGAPI = 0,
  VL_WS_ENV_STG = 1,
  VL_WS_ENV_PRODUCTION = 2,
  VL_WS_ENV_DEFAULT = 3
};

/* The environment a handle actually uses: 0 to 2 as above, or the digit the device-environment
 * service answered. */
typedef int VL_WS_EnvID;

/* How the device gets its titles; decides which account service answers (download or stream). */
enum VL_WS_AccessType : int { UNKNOWN = 0, DOWNLOAD = 1, STREAM = 2 };

/* Box-art image sizes; each value has a folder word and an image word in the image URL. */
enum VL_WS_BoxArtSize : int {
  VL_WS_BOXART_95 = 0,
  VL_WS_BOXART_175 = 1,
  VL_WS_BOXART_65 = 2,
  VL_WS_BOXART_77 = 3,
  VL_WS_BOXART_102 = 4,
  VL_WS_BOXART_126 = 5,
  VL_WS_BOXART_135S = 6,
  VL_WS_BOXART_137 = 7,
  VL_WS_BOXART_153 = 8,
  VL_WS_BOXART_177 = 9,
  VL_WS_BOXART_203 = 10,
  VL_WS_BOXART_269 = 11,
  VL_WS_BOXART_321 = 12
};

/* Sort order of wishlist pages, passed to the store as its number (0 to 3; others become 0). */
enum VL_WS_SortOrder : int {
  VL_WS_SORT_0 = 0,
  VL_WS_SORT_1 = 1,
  VL_WS_SORT_2 = 2,
  VL_WS_SORT_3 = 3
};

/* Cache settings. */
struct VL_WS_CacheParam {
  /* Which kinds of data are cached (bit set). */
  enum CacheData : int {
    CACHE_NONE = 0,
    CACHE_METADATA = 1, /* catalogue answers */
    CACHE_BOXART = 2,   /* box-art images */
    CACHE_USERDATA = 4  /* account answers and wishlist flags */
  };
};

/* The caller's setup record for VL_WS_initialize. Strings are borrowed for the call only. */
struct VL_WS_SetupParams {
  /* Catalogue of the handle. */
  enum ContentType : int { GENERAL = 0, ADULT = 1 };

  const char* APIKey;              /* required: the application's key */
  const char* AuthToken;           /* optional: token from an earlier VL_WS_authorizeDevice */
  const char* DestinationUniqueID; /* required, at most 350 bytes: the device's identifier */
  int DestinationTypeID;           /* the device type number */
  const char* UserName;            /* required: WS-Security user name */
  const char* Password;            /* required: WS-Security password */
  const char* ServiceBaseURL;      /* accepted and not used */
  enum ContentType ContentType;       /* 0 general or 1 adult catalogue; other values: -1000 */
  VL_WS_EnvNum EnvNum;             /* environment (see VL_WS_EnvNum) */
  int CacheType;                   /* 0 none, 1 database in memory, 2 database file */
  VL_WS_CacheParam::CacheData CacheData; /* bit set of cached kinds */
  unsigned int CacheLimit;         /* bytes; 0 = no limit, else at least 358400 */
  const char* CachePath;           /* folder of the cache file; required for CacheType 2 */
  const char* ProxyHost;           /* optional HTTP proxy; the next three are used only with it */
  int ProxyPort;
  const char* ProxyUserName;
  const char* ProxyPassword;
  VL_WS_AccessType AccessType;     /* 1 or 2 as given; anything else asks the store */
  const char* ApplicationRevision; /* optional, part of the User-Agent */
  const char* firmwareVersion;     /* optional, part of the User-Agent */
  const char* modelNumber;         /* optional, part of the User-Agent */
};

/* The client state behind a handle; opaque to callers. */
struct VL_WS_Client;

/* A client handle: made by VL_WS_initialize or VL_WS_duplicate, released by VL_WS_release.
 * Both words are null before initialisation and after release. */
struct VL_WS_Handle {
  int* tag;                /* type tag cell (tag 1) */
  VL_WS_Client* client;    /* null when initialisation did not get that far */
};

#endif /* VL_WS_TYPES_H */
