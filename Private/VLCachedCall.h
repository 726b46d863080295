// VLCachedCall: the one call sequence of a store operation, with the handle's cache in front of
// it for the operations whose answers are kept.
//
// A call:
//  1. creates the request and response records in the service object's context;
//  2. when the operation is cached and the handle has a cache, reads the answer stored under its
//     Name and Key and hands its result element to the converter, which fills the caller's
//     record; the record of the stored text comes from the handle's memo of decoded answers
//     (VLAnswerMemo), which decodes it when it has none. A miss, an empty text, a text that is
//     not such a record and a record without its result element all count as not cached;
//  3. otherwise fills the request, runs Setup, calls the service and hands a present result
//     element to the converter, which also says whether the answer is worth keeping (its
//     response code is 0, or its list is not empty);
//  4. keeps an answer worth keeping when the handle caches that kind of data: the serialised
//     response under Name and Key (gzip-compressed in a cache file), then the operation's side
//     data (the wishlist flags a title answer carries); the memo takes the response record;
//  5. releases everything the call allocated in the context.
// It returns the SOAP error: 0 also for an answer from the cache, a missing result element and
// a non-zero response code.
//
// Before the call the operation tags its out-record and checks its arguments; after it the
// operation logs its result line (VLLogCallResult) and turns the SOAP error, and for operations
// that fold the response code the record's code, into its status (VLUtilities::To_VL_WS_Status).
//
//   VLCacheEntry entry = {VLCacheKind::kMetaData, "getTitles", VLCacheKey("%d,%d,%d,%d", ...)};
//   int soapError = VLCachedCall(*client, client->m_RealTimeBrowse,
//       VL_SERVICE_OPERATION(RealTimeBrowse, getTitlesByNavigation), &entry,
//       [&](_VL1__getTitlesByNavigation& request) { request.GenreID = genreID; ... },
//       [&](const VL1__GetTitlesResponse& result) { ...convert...; return result.ResponseCode == 0; });
//
// Account operations keep their answers as user data: the same call with VLCacheKind::kUserData
// and the dispatcher (StreamDownloadAPI) or another service object as the service.
#ifndef VLCACHEDCALL_H
#define VLCACHEDCALL_H

#include <type_traits>

#include "CacheInterface.h"
#include "Serializer.h"
#include "VLAnswerMemo.h"
#include "VLString.h"
#include "VL_WS_Client.h"

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

// Logs an operation's result line "<name>, ret:<soapError>,responseCode:<responseCode>" to
// "VL_WSAE" at level 4.
void VLLogCallResult(const char* name, int soapError, int responseCode);
// The line of an answer read from the cache instead of the store.
void VLLogCacheHit(const char* name);

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

// The call sequence above. entry null: the operation is not cached. fill(Request&) fills the
// request; convert(const Result&) fills the caller's record and returns whether the answer is
// worth keeping; keep(CacheInterface&, const Result&) stores the side data of a kept answer.
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
      bool stored = StoreResponse(*response, value, client.m_Params.CacheParam.CacheType == 2 /* a file */) &&
                    (cache->*entry->kind.Write)(entry->name, entry->key, value);
      keep(*cache, *result);
      if (stored) client.m_Memo->Keep(entry->name, entry->key, value, response, &context);
    }
  }
  VLEndCall(context);
  return soapError;
}

// A cached call without side data.
template <class Service, class Request, class Response, class Result, class Fill, class Convert>
int VLCachedCall(VL_WS_Client& client, Service& service,
                 const VLServiceOperation<Service, Request, Response, Result>& op, const VLCacheEntry* entry,
                 Fill fill, Convert convert) {
  return VLCachedCall(client, service, op, entry, fill, convert, [](CacheInterface&, const auto&) {});
}

// An operation that is never cached: the same sequence without the cache. convert(const
// Result&) fills the caller's record; its result, if any, is ignored.
template <class Service, class Request, class Response, class Result, class Fill, class Convert>
int VLServiceCall(VL_WS_Client& client, Service& service,
                  const VLServiceOperation<Service, Request, Response, Result>& op, Fill fill, Convert convert) {
  return VLCachedCall(client, service, op, nullptr, fill, [&](const auto& result) {
    convert(result);
    return false;
  });
}

#endif  // VLCACHEDCALL_H
