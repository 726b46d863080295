#include "StreamDownloadAPI.h"

#include "VLAssert.h"

StreamDownloadAPI::StreamDownloadAPI() : m_StreamAPI(0), m_DownloadAPI(0), m_AccessType(UNKNOWN) {}

void StreamDownloadAPI::Init(StreamAPI* stapi, DownloadAPI* dlapi, VL_WS_AccessType type) {
  VL_ASSERT(stapi != 0);
  VL_ASSERT(dlapi != 0);
  m_StreamAPI = stapi;
  m_DownloadAPI = dlapi;
  m_AccessType = type;
}

int StreamDownloadAPI::Setup(const VLString& operation) {
  VL_ASSERT((m_StreamAPI != 0) && (m_DownloadAPI != 0));
  return Download() ? m_DownloadAPI->Setup(operation) : m_StreamAPI->Setup(operation);
}

StreamDownloadAPI::operator soap&() {
  VL_ASSERT((m_StreamAPI != 0) && (m_DownloadAPI != 0));
  if (Download()) return *m_DownloadAPI;
  return *m_StreamAPI;
}

#define VL_NOT_DISPATCHED(name, Type)
#define VL_DISPATCHED(name, Type)                                                                 \
  int StreamDownloadAPI::name(_VL1__##Type* request, _VL1__##Type##Response* response) {         \
    return Download() ? m_DownloadAPI->name(request, response) : m_StreamAPI->name(request, response); \
  }
VL_DOWNLOADAPI_OPERATIONS(VL_NOT_DISPATCHED, VL_DISPATCHED)
