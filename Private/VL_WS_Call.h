// VL_WS_Call.h: the steps every store operation of the flat interface shares: preparing its
// result, making one SOAP call on a service object (or the account dispatcher), and turning the
// outcome into a status and its result line in the log.
#ifndef VL_WS_CALL_H
#define VL_WS_CALL_H

#include "VLRecord.h"
#include "VL_WS_Client.h"
#include "VL_WS_Records.h"

// Prepares an operation's result before anything is checked: a record is cleared and tagged (so
// the caller can always release it), a bool or int result is set to false or 0. Returns the
// handle's client state, or null when the handle has none or the result pointer is null: the
// operation then returns VL_WS_E_INVALID_ARGUMENT.
template <class Record>
VL_WS_Client* VLBeginCall(VL_WS_Handle* handle, Record* record) {
  if (record == 0) return 0;
  VLRecordInit(*record);
  return VLClientOf(handle);
}
VL_WS_Client* VLBeginCall(VL_WS_Handle* handle, bool* value);
VL_WS_Client* VLBeginCall(VL_WS_Handle* handle, int* value);

// The request filler of operations whose request has no fields.
struct VLNoFields {
  template <class Request>
  void operator()(Request&) const {}
};

// One SOAP call of `operation` on service (a service object or the dispatcher): the request and
// response records live here, everything they point to in the service's context. fill completes
// the request, Setup prepares the header blocks, send makes the call and read gets the response
// when the call succeeded; then the call's memory is released, so read must copy what it keeps.
// Returns the SOAP runtime's error code.
template <class Service, class Proxy, class Request, class Response, class Fill, class Read>
int VLCall(Service& service, const char* operation, int (Proxy::*send)(Request*, Response*), Fill fill, Read read) {
  Request request;
  Response response;
  fill(request);
  int error = service.Setup(operation);
  if (error == SOAP_OK) error = (service.*send)(&request, &response);
  if (error == SOAP_OK) read(static_cast<const Response&>(response));
  soap& context = service;
  VLEndCall(context);
  return error;
}

// VLCall for an answer whose result element is converted into record: convert(result, record)
// runs when the call succeeded and the answer holds the element (result names it), else the
// record stays as it is. answered, when given, tells whether it ran.
template <class Service, class Proxy, class Request, class Response, class Fill, class Result, class Convert,
          class Record>
int VLCallInto(Service& service, const char* operation, int (Proxy::*send)(Request*, Response*), Fill fill,
               Result* Response::*result, Convert convert, Record& record, bool* answered = 0) {
  bool converted = false;
  int error = VLCall(service, operation, send, fill, [&](const Response& response) {
    if (response.*result == 0) return;
    convert(response.*result, record);
    converted = true;
  });
  if (answered != 0) *answered = converted;
  return error;
}

// Statuses of an operation that returns a record. VLFoldedStatus folds the record's response
// code into the status (the codes of statusRow, one of the operations with a response-code row,
// or none: any code then gives VL_WS_E_UNEXPECTED); VLSoapStatus converts the SOAP error alone
// and leaves the code for the caller to read. Both log "<name>, ret:<error>,responseCode:<code>"
// at level 4.
VL_WS_Status VLFoldedStatus(const char* name, int soapError, const VL_WS_StandardResponse& record,
                            const char* statusRow = "");
VL_WS_Status VLSoapStatus(const char* name, int soapError, const VL_WS_StandardResponse& record);

// The result line "<name>, result:<value>" (level 4) of operations that answer a bool, and the
// status of those whose status is the SOAP error's alone.
void VLLogBoolResult(const char* name, bool value);
VL_WS_Status VLBoolStatus(const char* name, int soapError, bool value);

// True when an answer may change state: the call succeeded, the answer held its result and
// the store's response code is 0.
inline bool VLSucceeded(int soapError, bool answered, int responseCode) {
  return soapError == SOAP_OK && answered && responseCode == 0;
}

// The handle's cache when it keeps user data (CACHE_USERDATA), else null.
CacheInterface* VLUserData(VL_WS_Client* client);

#endif  // VL_WS_CALL_H
