// StreamDownloadAPI: the dispatcher of the account operations that both the streaming and the
// download service offer with identical messages. Access type DOWNLOAD (1) selects the handle's
// DownloadAPI object; every other value (UNKNOWN, STREAM, anything else) its StreamAPI object.
// Initialised once per handle, after the access type is resolved; it borrows both objects.
#ifndef STREAMDOWNLOADAPI_H
#define STREAMDOWNLOADAPI_H

#include "DownloadAPI.h"
#include "StreamAPI.h"
#include "VLString.h"
#include "VL_WS_Types.h"

class StreamDownloadAPI {
 public:
  StreamDownloadAPI();

  // Both objects must be given.
  void Init(StreamAPI* stapi, DownloadAPI* dlapi, VL_WS_AccessType type);

  // Setup of the selected object (requires Init).
  int Setup(const VLString& operation);

  // The selected object's context (requires Init): callers allocate and free the call's records
  // in it and end the call with it.
  operator soap&();

  // The dispatched operations, SHARED in VL_DOWNLOADAPI_OPERATIONS: each calls the same
  // operation of the selected object.
#define VL_NOT_DISPATCHED(name, Type)
#define VL_DISPATCHED(name, Type) int name(_VL1__##Type* request, _VL1__##Type##Response* response);
  VL_DOWNLOADAPI_OPERATIONS(VL_NOT_DISPATCHED, VL_DISPATCHED)
#undef VL_NOT_DISPATCHED
#undef VL_DISPATCHED

 private:
  bool Download() const { return m_AccessType == DOWNLOAD; }

  StreamAPI* m_StreamAPI;
  DownloadAPI* m_DownloadAPI;
  VL_WS_AccessType m_AccessType;
};

#endif  // STREAMDOWNLOADAPI_H
