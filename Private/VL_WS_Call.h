// VL_WS_Call.h: the call sequence of a store operation, start to end. It serves every client
// operation that asks a SOAP service: the catalogue (VL_WS_Catalog.cpp), the freshness of the
// cache (VL_WS_Cache.cpp), the account (VL_WS_Account.cpp), purchases (VL_WS_Purchase.cpp), the
// wishlist (VL_WS_Wishlist.cpp) and streaming (VL_WS_Streaming.cpp); box art (VL_WS_BoxArt.cpp)
// takes its first step only.
//
//  1. The start (VLClientFor): the out-record is cleared and tagged before any check, so that the
//     caller can always release it; then the handle's client state is found and the arguments
//     are checked (VLPageFits for pages). What fails gives -1000.
//  2. The call (VLCachedCall, VLServiceCall): one SOAP request of a service object, with the
//     handle's cache in front of it for the operations whose answers are kept (VLCacheEntry).
//  3. The end: the result line is logged and the status made (VLFoldedStatus, VLSoapStatus,
//     VLBoolStatus); side effects wait for a call that succeeded (VLSucceeded, VLUserData).
//
// An operation that answers one kept record takes the call and its end in one step
// (VLKeptRecord):
//
//   VL_WS_Client* client = VLClientFor(handle, titles);
//   if (client == 0 || !VLPageFits(currentPageNumber, itemsPerPage)) return VL_WS_E_INVALID_ARGUMENT;
//   return VLKeptRecord(
//       *client, client->m_RealTimeBrowse, VL_SERVICE_OPERATION(RealTimeBrowse, getTitlesByNavigation),
//       {VLCacheKind::kMetaData, "getTitles", VLCacheKey("%d,%d,%d,%d", ...)},
//       [&](_VL1__getTitlesByNavigation& request) { request.GenreID = genreID; ... },
//       VLUtilities::VL1__GetTitlesResponse2VL_WS_TitlesResponse, *titles, "VL_WS_getTitles", VLFoldedStatus);
#ifndef VL_WS_CALL_H
#define VL_WS_CALL_H

#include <type_traits>

#include "CacheInterface.h"
#include "Serializer.h"
#include "VLAnswerMemo.h"
#include "VLRecord.h"
#include "VLString.h"
#include "VL_WS_Client.h"
#include "VL_WS_Records.h"

// ---- 1. The start -------------------------------------------------------------------------------

// Clears and tags record, then gives the handle's client state. Null when the record or the
// client state is missing.
template <class Record>
VL_WS_Client* VLClientFor(const VL_WS_Handle* handle, Record* record) {
  if (record == 0) return 0;
  VLRecordInit(*record);
  return VLClientOf(handle);
}

// The same for operations that answer a bool or an int: the value is set to false or 0 first.
VL_WS_Client* VLClientFor(const VL_WS_Handle* handle, bool* value);
VL_WS_Client* VLClientFor(const VL_WS_Handle* handle, int* value);

// Whether a page request can be answered: the store's answer carries page number and size in
// 16-bit fields, so a value beyond them would come back wrapped (100000 as -31072).
bool VLPageFits(int currentPageNumber, int itemsPerPage);

// ---- 2. The call --------------------------------------------------------------------------------

// Where a kind of cached data is kept: the cache's read and write calls for it and its bit of
// the cache settings (VL_WS_CacheParam::CacheData), without which nothing is written.
struct VLCacheKind {
  bool (CacheInterface::*Read)(const VLString& name, const VLString& key, VLString& value);
  bool (CacheInterface::*Write)(const VLString& name, const VLString& key, const VLString& value);
  int Bit;

  static const VLCacheKind kMetaData;  // service answers: ReadMetaData, WriteMetaData, bit 1
  static const VLCacheKind kUserData;  // user data: ReadUserData, WriteUserData, bit 4
};

// The place of one call's answer in the cache.
struct VLCacheEntry {
  const VLCacheKind& kind;
  const char* name;  // the operation's Name, e.g. "getTitles"
  VLString key;      // the request's arguments as text (VLCacheKey)
};

// A cache Key formatted with printf's rules, whole whatever its length: a Key cut to a buffer
// would let two requests that differ only after the cut share one answer.
VLString VLCacheKey(const char* format, ...)
#ifdef __GNUC__
    __attribute__((format(printf, 1, 2)))
#endif
    ;

// One SOAP operation of a service object: its name (for Setup), how its records are made in the
// context, the call, and its response's result element (a pointer, absent while null, or a
// plain value, always present).
template <class Service, class Request, class Response, class Result>
struct VLServiceOperation {
  const char* name;
  Request* (*newRequest)(soap*, int);
  Response* (*newResponse)(soap*, int);
  int (Service::*call)(Request*, Response*);
  Result Response::*result;
};

// The VLServiceOperation of operation op of Service, from the generated names: request
// _VL1__<op>, response _VL1__<op>Response with its element <op>Result.
#define VL_SERVICE_OPERATION(Service, op)                                                           \
  VLServiceOperation<Service, _VL1__##op, _VL1__##op##Response,                                     \
                     decltype(_VL1__##op##Response::op##Result)>{                                   \
      #op, soap_new__VL1__##op, soap_new__VL1__##op##Response, &Service::op, &_VL1__##op##Response::op##Result}

// The result element to convert, or null when a pointer result is absent.
template <class Result>
const typename std::remove_pointer<Result>::type* VLResultOf(const Result& result) {
  if constexpr (std::is_pointer<Result>::value) {
    return result;
  } else {
    return &result;
  }
}

// The request filler of operations whose request has no fields.
struct VLNoFields {
  template <class Request>
  void operator()(Request&) const {}
};

// A converter for VLServiceCall: fills record from the answer's result element with convert (a
// VLUtilities record converter) and, when answered is given, notes that the answer had one.
template <class Result, class Record>
auto VLInto(void (*convert)(const Result*, Record&), Record& record, bool* answered = nullptr) {
  return [convert, &record, answered](const Result& result) {
    convert(&result, record);
    if (answered != nullptr) *answered = true;
  };
}

// The same for VLCachedCall: the answer is worth keeping when its response code is 0.
template <class Result, class Record>
auto VLKeptInto(void (*convert)(const Result*, Record&), Record& record, bool* answered = nullptr) {
  return [into = VLInto(convert, record, answered)](const Result& result) {
    into(result);
    return result.ResponseCode == 0;
  };
}

// The line of an answer read from the cache instead of the store.
void VLLogCacheHit(const char* name);

// One call of op on service, answered from the cache when it can be. entry null: the operation
// is not cached. fill(Request&) fills the request; convert(const Result&) fills the caller's
// record and returns whether the answer is worth keeping; keep(CacheInterface&, const Result&)
// stores the side data of a kept answer (the wishlist flags a title answer carries).
//
// The answer stored under the entry's Name and Key counts only when it decodes to a response
// with its result element (the handle's memo of decoded answers, VLAnswerMemo, spares decoding
// it again); anything else is a miss and the store is asked. A fresh answer is kept when convert
// says so and the handle caches that kind of data. Converted records are the caller's own:
// whatever the call made in the service's context, the reply's header and texts included, is
// released before it returns, so nothing of the reply may be kept.
//
// Returns the SOAP error: 0 also for an answer from the cache, a missing result element and a
// non-zero response code, which the caller reads in its record.
template <class Service, class Request, class Response, class Result, class Fill, class Convert, class Keep>
int VLCachedCall(VL_WS_Client& client, Service& service,
                 const VLServiceOperation<Service, Request, Response, Result>& op, const VLCacheEntry* entry,
                 Fill fill, Convert convert, Keep keep) {
  soap& context = service;
  Request* request = op.newRequest(&context, -1);
  Response* response = op.newResponse(&context, -1);
  int soapError = request != nullptr && response != nullptr ? SOAP_OK : SOAP_EOM;
  CacheInterface* cache = entry != nullptr ? client.m_Cache : nullptr;
  bool fromCache = false;
  if (soapError == SOAP_OK && cache != nullptr) {
    VLString value;
    fromCache = (cache->*entry->kind.Read)(entry->name, entry->key, value) && !value.empty() &&
                client.m_Memo->Use(entry->name, entry->key, value, op.newResponse, [&](const Response& stored) {
                  const auto* result = VLResultOf(stored.*op.result);
                  if (result != nullptr) convert(*result);
                  return result != nullptr;
                });
    if (fromCache) VLLogCacheHit(op.name);
  }
  if (soapError == SOAP_OK && !fromCache) {
    fill(*request);
    soapError = service.Setup(op.name);
    if (soapError == SOAP_OK) soapError = (service.*op.call)(request, response);
    const auto* result = soapError == SOAP_OK ? VLResultOf(response->*op.result) : nullptr;
    if (result != nullptr && convert(*result) && cache != nullptr &&
        (client.m_Params.CacheParam.CacheData & entry->kind.Bit) != 0) {
      // The cache file keeps its values compressed; an in-memory cache is spared the work.
      VLString value;
      bool stored = StoreResponse(*response, value, client.m_Params.CacheParam.CacheType == kFileCache) &&
                    (cache->*entry->kind.Write)(entry->name, entry->key, value);
      keep(*cache, *result);
      if (stored) client.m_Memo->Keep(entry->name, entry->key, value, response, &context);
    }
  }
  soap_destroy(&context);
  soap_end(&context);
  return soapError;
}

// A cached call without side data.
template <class Service, class Request, class Response, class Result, class Fill, class Convert>
int VLCachedCall(VL_WS_Client& client, Service& service,
                 const VLServiceOperation<Service, Request, Response, Result>& op, const VLCacheEntry* entry,
                 Fill fill, Convert convert) {
  return VLCachedCall(client, service, op, entry, fill, convert, [](CacheInterface&, const auto&) {});
}

// An operation that is never cached. convert(const Result&) fills the caller's record; its
// result, if any, is ignored.
template <class Service, class Request, class Response, class Result, class Fill, class Convert>
int VLServiceCall(VL_WS_Client& client, Service& service,
                  const VLServiceOperation<Service, Request, Response, Result>& op, Fill fill, Convert convert) {
  return VLCachedCall(client, service, op, nullptr, fill, [&](const auto& result) {
    convert(result);
    return false;
  });
}

// ---- 3. The end ---------------------------------------------------------------------------------

// The end of an operation that returns a record: logs its result line
// "<name>, ret:<soapError>,responseCode:<responseCode>" and returns its status.
// VLFoldedStatus folds the response code into the status: a code the operation has a status of
// its own for gives that status, any other non-zero code VL_WS_E_UNEXPECTED
// (VLUtilities::To_VL_WS_Status). VLSoapStatus converts the SOAP error alone; the caller reads
// the code in the record.
VL_WS_Status VLFoldedStatus(const char* name, int soapError, int responseCode);
VL_WS_Status VLSoapStatus(const char* name, int soapError, int responseCode);

// The result line "<name>, result:<value>" of operations that answer a bool, and the end of
// those whose status is the SOAP error's alone.
void VLLogBoolResult(const char* name, bool value);
VL_WS_Status VLBoolStatus(const char* name, int soapError, bool value);

// True when an answer may change state: the call succeeded, the answer had its result element
// and the store's response code is 0.
inline bool VLSucceeded(int soapError, bool answered, int responseCode) {
  return soapError == SOAP_OK && answered && responseCode == 0;
}

// The handle's cache when it keeps user data (CACHE_USERDATA), else null.
CacheInterface* VLUserData(VL_WS_Client* client);

// ---- The call and its end in one ----------------------------------------------------------------

// An operation that answers one record, kept in the cache under entry when its response code is
// 0: the cached call of op on service, the record filled by convert (a VLUtilities record
// converter) from the result element, and the end by status (VLFoldedStatus or VLSoapStatus)
// under name. client is the one VLClientFor gave for record, the arguments already checked.
template <class Service, class Request, class Response, class Result, class Fill, class Answer, class Record>
VL_WS_Status VLKeptRecord(VL_WS_Client& client, Service& service,
                          const VLServiceOperation<Service, Request, Response, Result>& op, const VLCacheEntry& entry,
                          Fill fill, void (*convert)(const Answer*, Record&), Record& record, const char* name,
                          VL_WS_Status (*status)(const char* name, int soapError, int responseCode)) {
  int soapError = VLCachedCall(client, service, op, &entry, fill, VLKeptInto(convert, record));
  return status(name, soapError, record.ResponseCode);
}

#endif  // VL_WS_CALL_H
