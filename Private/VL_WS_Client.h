// VL_WS_Client.h: the client state behind a VL_WS_Handle (tag 1). One block per handle: its
// three SOAP service objects, the dispatcher of account operations, the handle's own settings and
// its cache, whose decoded answers it shares with its duplicates. Also the steps that the client operations share: tag the
// out-record and find the client (VLClientFor) and end a SOAP call (VLEndCall); the call itself
// is VLCachedCall.h's.
#ifndef VL_WS_CLIENT_H
#define VL_WS_CLIENT_H

#include <memory>

#include "CacheInterface.h"
#include "DownloadAPI.h"
#include "RealTimeBrowse.h"
#include "StreamAPI.h"
#include "StreamDownloadAPI.h"
#include "VLAnswerMemo.h"
#include "VLRecord.h"
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

// The first step of an operation with an out-record: clears and tags the record (before any
// check, so that the caller can always release it), then gives the handle's client state. Null
// when the record or the client state is missing; the operation answers -1000 then.
template <class Record>
VL_WS_Client* VLClientFor(const VL_WS_Handle* handle, Record* record) {
  if (record == 0) return 0;
  VLRecordInit(*record);
  return VLClientOf(handle);
}

// Whether a page request can be answered: the store's answer carries page number and size in
// 16-bit fields, so a value beyond them would come back wrapped (100000 as -31072). The paged
// operations refuse any other with -1000.
bool VLPageFits(int currentPageNumber, int itemsPerPage);

// Ends one SOAP call on a service context: deletes the call's request and response records and
// everything else the call allocated in the context (the reply's header and texts included) and
// ends the context's message state. Nothing of the reply may be used afterwards. Every
// operation runs it once per call, whatever the call's outcome.
void VLEndCall(soap& context);

// Frees a handle's client state: closes and deletes its cache, then destroys its settings, the
// dispatcher and the three service objects. VL_WS_release calls it for a handle that has one.
void VLClientRelease(VL_WS_Client* client);

#endif  // VL_WS_CLIENT_H
