// VL_WS_Client.h: the client state behind a VL_WS_Handle (tag 1). One block per handle: its
// three SOAP service objects, the dispatcher of account operations, the handle's own settings and
// its cache, whose decoded answers it shares with its duplicates. The operations that use it take
// the steps of VL_WS_Call.h.
#ifndef VL_WS_CLIENT_H
#define VL_WS_CLIENT_H

#include <memory>

#include "CacheInterface.h"
#include "DownloadAPI.h"
#include "RealTimeBrowse.h"
#include "StreamAPI.h"
#include "StreamDownloadAPI.h"
#include "VLAnswerMemo.h"
#include "VL_WS_SetupParams2.h"
#include "VL_WS_Types.h"

struct VL_WS_Client {
  RealTimeBrowse m_RealTimeBrowse;        // the catalogue service
  StreamAPI m_StreamAPI;                  // the streaming service
  DownloadAPI m_DownloadAPI;              // the download/account service
  StreamDownloadAPI m_StreamDownloadAPI;  // routes account operations by access type
  VL_WS_SetupParams2 m_Params;            // the handle's settings; the services point at them
  CacheInterface* m_Cache = nullptr;      // null when the handle has no cache
  // The decoded answers of the cache, shared with the handle's duplicates; null without a cache.
  std::shared_ptr<VLAnswerMemo> m_Memo;
};

// The client state of a handle: null for a null handle and for a handle without client state,
// which every operation refuses with -1000.
VL_WS_Client* VLClientOf(const VL_WS_Handle* handle);

// Frees a handle's client state: closes and deletes its cache, then destroys its settings, the
// dispatcher and the three service objects. VL_WS_release calls it for a handle that has one.
void VLClientRelease(VL_WS_Client* client);

#endif  // VL_WS_CLIENT_H
