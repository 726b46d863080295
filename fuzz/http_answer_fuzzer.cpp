// The hand-built HTTP answer readers: the input (after a byte that picks the reader and one that
// cuts the answer into pieces) is the whole answer of a store host to the device-environment
// query, a box-art download, the bandwidth probe, or a request of the reader underneath them all
// (VLHttpGet: status line, header to its end however it is cut, its fields, a small body).
#include <stddef.h>
#include <stdint.h>
#include <stdio.h>

#include "BoxArtDownloader.h"
#include "FuzzAnswer.h"
#include "VLHttpGet.h"
#include "VLUtilities.h"
#include "VL_WS_Client.h"

namespace {

const char kImageURL[] = "http://images.ostrel.example/images/boxart/175/t1001_175.jpg";

// A context of the kind the readers run on, its connection the fuzzer's answer.
soap* Context() {
  static soap* s_Context = [] {
    soap* context = soap_new1(SOAP_C_UTFSTRING);
    FuzzAnswer::Install(context);
    return context;
  }();
  return s_Context;
}

void (*const kReaders[])() = {
    [] {
      VLHttpGet get(Context());
      const VLHttpGet::Kind kind = {false, VL_WS_E_UNEXPECTED, VL_WS_E_HTTP_NOT_FOUND, VL_WS_E_HTTP_NOT_MODIFIED};
      if (get.Get(kImageURL, kind) != VL_WS_OK) return;
      VLString value;
      get.Field("Last-Modified", &value);
      if (get.ReceiveBody()) return;
      char piece[512];
      while (get.Receive(piece, sizeof piece) > 0) {
      }
    },
    [] {
      VL_WS_EnvID env = 0;
      VLUtilities::QueryServiceBaseURL(VL_WS_SetupParams::GENERAL, Context(), "00-11-22-33-44-55", 7,
                                       VL_WS_ENV_DEFAULT, env);
    },
    [] {
      BoxArtDownloader downloader(Context());
      VLString image;
      downloader.DownloadToBuffer("t1001_", VL_WS_BOXART_175, "Mon, 03 Jan 2011 10:00:00 GMT", image);
    },
    [] {
      VL_WS_Handle* handle = FuzzAnswer::Handle(0);
      handle->client->m_Params.BandwithCheckURL = "http://images.ostrel.example/speedtest/probe.bin";
      unsigned int bits;
      VL_WS_checkBandwidth(handle, &bits);
    },
};

}  // namespace

extern "C" int LLVMFuzzerInitialize(int*, char***) {
  // The environment query prints the endpoint it chose on every call.
  return freopen("/dev/null", "w", stdout) ? 0 : 1;
}

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
  uint8_t selector;
  if (!FuzzAnswer::Take(data, size, &selector)) return 0;
  kReaders[selector % (sizeof kReaders / sizeof kReaders[0])]();
  return 0;
}
