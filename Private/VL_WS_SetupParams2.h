// VL_WS_SetupParams2: a client handle's own settings, copied from the caller's VL_WS_SetupParams
// at initialisation and completed with the chosen endpoint, environment, User-Agent and
// time-outs. The handle owns every string. The three SOAP service objects keep a pointer to it
// and read its strings at every call, so it must outlive them, and a later change (AuthToken
// after a device authorisation) is seen by the next request.
#ifndef VL_WS_SETUPPARAMS2_H
#define VL_WS_SETUPPARAMS2_H

#include "VLString.h"
#include "VL_WS_Types.h"

// The types of cache: the values of VL_WS_SetupParams::CacheType and VL_WS_CacheParam2::CacheType.
enum VLCacheType : int { kNoCache = 0, kMemoryCache = 1, kFileCache = 2 };

// The handle's cache settings.
struct VL_WS_CacheParam2 {
  int CacheType = kNoCache;  // VLCacheType: none, database in memory, database file
  int CacheData = 0;   // bit set of VL_WS_CacheParam::CacheData
  int CacheLimit = 0;  // bytes; 0 = no limit
  VLString CachePath;  // full path of the cache file once initialised
};

struct VL_WS_SetupParams2 {
  VLString APIKey;
  VLString AuthToken;
  VLString DestinationUniqueID;
  int DestinationTypeID = 0;
  VLString UserName;
  VLString Password;
  VLString ServiceBaseURL;  // the chosen endpoint base, ending in "/"
  VL_WS_EnvID EnvID = 0;    // the environment actually in use
  VLString BandwithCheckURL;
  VL_WS_CacheParam2 CacheParam;
  VLString ProxyHost;  // no proxy when empty
  int ProxyPort = 0;
  VLString ProxyUserName;
  VLString ProxyPassword;
  // Seconds. Each bounds one wait; together they bound a whole exchange, from connecting to the
  // last byte of the answer (VLSoapTransport). Every context starts with the defaults.
  static const int kDefaultSendTimeout = 30;
  static const int kDefaultRecvTimeout = 88;
  int SendTimeout = kDefaultSendTimeout;  // for sending and for connecting (TLS handshake included)
  int RecvTimeout = kDefaultRecvTimeout;  // for receiving
  bool AuthTokenValid = false;  // the last answer of the store's token check
  VL_WS_AccessType AccessType = UNKNOWN;
  VLString ApplicationRevision;
  VLString firmwareVersion;
  VLString UserAgent;  // sent with every SOAP request; "gSOAP/2.7" when empty
  VLString modelNumber;
};

#endif  // VL_WS_SETUPPARAMS2_H
