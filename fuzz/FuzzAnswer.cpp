#include "FuzzAnswer.h"

#include <stdlib.h>
#include <string.h>
#include <sys/socket.h>

#include "VL_WS_Client.h"

namespace {

// The answer being received: one at a time, as the fuzzers run one input at a time.
struct Answer {
  const uint8_t* data = nullptr;
  size_t size = 0;
  size_t at = 0;
  size_t piece = 1;
} s_Answer;

// A real socket for the context to hold: the runtime may look at its socket between calls.
SOAP_SOCKET Socket() {
  static const int s_Socket = [] {
    int pair[2];
    return socketpair(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC, 0, pair) == 0 ? pair[0] : -1;
  }();
  return s_Socket;
}

SOAP_SOCKET Open(soap*, const char*, const char*, int) {
  s_Answer.at = 0;
  return Socket();
}

int Send(soap*, const char*, size_t) { return SOAP_OK; }

size_t Receive(soap*, char* buffer, size_t n) {
  size_t left = s_Answer.size - s_Answer.at;
  if (n > left) n = left;
  if (n > s_Answer.piece) n = s_Answer.piece;
  if (n == 0) return 0;
  memcpy(buffer, s_Answer.data + s_Answer.at, n);
  s_Answer.at += n;
  return n;
}

int Close(soap*) { return SOAP_OK; }

}  // namespace

void FuzzAnswer::Install(soap* context) {
  context->fopen = Open;
  context->fsend = Send;
  context->frecv = Receive;
  context->fclose = Close;
}

void FuzzAnswer::Set(const uint8_t* data, size_t size, size_t piece) {
  s_Answer.data = data;
  s_Answer.size = size;
  s_Answer.at = 0;
  s_Answer.piece = piece == 0 ? 1 : piece;
}

bool FuzzAnswer::Take(const uint8_t* data, size_t size, uint8_t* selector) {
  if (size < 2) return false;
  *selector = data[0];
  // Piece sizes from 1 to 255 bytes, and 0 for whole answers.
  Set(data + 2, size - 2, data[1] == 0 ? size : data[1]);
  return true;
}

VL_WS_Handle* FuzzAnswer::Handle(int cacheType) {
  static VL_WS_Handle s_Handle = [cacheType] {
    setenv("VLWS_CONNECT_TO", "::127.0.0.1:1", 1);
    VL_WS_SetupParams params = {};
    params.APIKey = "key";
    params.DestinationUniqueID = "00-11-22-33-44-55";
    params.DestinationTypeID = 7;
    params.UserName = "user";
    params.Password = "secret";
    params.EnvNum = VL_WS_ENV_PRODUCTION;
    params.AccessType = STREAM;
    params.CacheType = cacheType;
    if (cacheType != 0)
      params.CacheData = static_cast<VL_WS_CacheParam::CacheData>(VL_WS_CacheParam::CACHE_METADATA |
                                                                  VL_WS_CacheParam::CACHE_USERDATA);
    VL_WS_Handle handle = {};
    if (VL_WS_initialize(&handle, &params) != VL_WS_OK) __builtin_trap();
    Install(&handle.client->m_RealTimeBrowse);
    Install(&handle.client->m_StreamAPI);
    Install(&handle.client->m_DownloadAPI);
    return handle;
  }();
  return &s_Handle;
}
