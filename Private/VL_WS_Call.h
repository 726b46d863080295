// VL_WS_Call.h: what the account, purchase, wishlist and streaming operations share on top of the
// call sequence of VLCachedCall.h: results that are a bool or an int, converters into client
// records, the statuses with their result lines, and the conditions of the side effects.
//
//   VL_WS_Client* client = VLClientFor(handle, answer);
//   if (client == 0) return VL_WS_E_INVALID_ARGUMENT;
//   bool answered = false;
//   int soapError = VLServiceCall(*client, client->m_StreamDownloadAPI,
//       VL_SERVICE_OPERATION(StreamDownloadAPI, deactivateDevice), VLNoFields(),
//       VLInto(VLUtilities::VL1__StandardResponse2VL_WS_StandardResponse, *answer, &answered));
//   if (VLSucceeded(soapError, answered, answer->ResponseCode)) ...side effect...
//   return VLFoldedStatus("VL_WS_deactivateDevice", soapError, answer->ResponseCode);
#ifndef VL_WS_CALL_H
#define VL_WS_CALL_H

#include "VLCachedCall.h"
#include "VL_WS_Client.h"
#include "VL_WS_Records.h"

// VLClientFor of operations that answer a bool or an int: the value is set to false or 0 first.
VL_WS_Client* VLClientFor(const VL_WS_Handle* handle, bool* value);
VL_WS_Client* VLClientFor(const VL_WS_Handle* handle, int* value);

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

// The end of an operation that returns a record: logs its result line
// "<name>, ret:<soapError>,responseCode:<responseCode>" and returns its status. VLFoldedStatus
// folds the response code into the status: by the codes of statusRow, the name of one of the
// operations with their own statuses, or without it any non-zero code is VL_WS_E_UNEXPECTED.
// VLSoapStatus converts the SOAP error alone; the caller reads the code in the record.
VL_WS_Status VLFoldedStatus(const char* name, int soapError, int responseCode, const char* statusRow = "");
VL_WS_Status VLSoapStatus(const char* name, int soapError, int responseCode);

// The result line "<name>, result:<value>" of operations that answer a bool, and the end of
// those whose status is the SOAP error's alone.
void VLLogBoolResult(const char* name, bool value);
VL_WS_Status VLBoolStatus(const char* name, int soapError, bool value);

// An account record of an operation without request fields, kept as user data under the
// operation's name with an empty Key: fills record with convert and returns VLFoldedStatus of
// name and statusRow.
template <class Operation, class Result, class Record>
VL_WS_Status VLKeptAccountRecord(VL_WS_Handle* handle, Record* record, const char* name, const Operation& op,
                                 void (*convert)(const Result*, Record&), const char* statusRow = "") {
  VL_WS_Client* client = VLClientFor(handle, record);
  if (client == 0) return VL_WS_E_INVALID_ARGUMENT;
  VLCacheEntry entry = {VLCacheKind::kUserData, op.name, VLString()};
  int soapError = VLCachedCall(*client, client->m_StreamDownloadAPI, op, &entry, VLNoFields(),
                               VLKeptInto(convert, *record));
  return VLFoldedStatus(name, soapError, record->ResponseCode, statusRow);
}

// True when an answer may change state: the call succeeded, the answer had its result element
// and the store's response code is 0.
inline bool VLSucceeded(int soapError, bool answered, int responseCode) {
  return soapError == SOAP_OK && answered && responseCode == 0;
}

// The handle's cache when it keeps user data (CACHE_USERDATA), else null.
CacheInterface* VLUserData(VL_WS_Client* client);

#endif  // VL_WS_CALL_H
