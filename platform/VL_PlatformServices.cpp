// Stand-ins for the device's DRM service and network message queue: they record their calls and
// return the result chosen for them.
#include "VL_PlatformServices.h"

#include <cstdlib>
#include <mutex>
#include <vector>

namespace {

const char* const kResultVariables[] = {"VL_DRM_INIT_RESULT", "VL_DRM_TERMINATE_RESULT",
                                        "VL_NET_INIT_RESULT", "VL_NET_UNINIT_RESULT"};
const int kServiceCount = 4;

struct Services {
  std::mutex lock;
  bool chosen[kServiceCount] = {};
  int result[kServiceCount] = {};
  std::vector<VL_PlatformService> calls;
};

Services& State() {
  static Services* services = new Services;  // lives until exit: called during teardown
  return *services;
}

int Call(VL_PlatformService service) {
  Services& s = State();
  std::lock_guard<std::mutex> guard(s.lock);
  s.calls.push_back(service);
  if (s.chosen[service]) return s.result[service];
  const char* text = getenv(kResultVariables[service]);
  return text ? atoi(text) : 0;
}

}  // namespace

extern "C" {

int Ipriv_drm_Init(void) { return Call(VL_SERVICE_DRM_INIT); }
int Ipriv_drm_Terminate(void) { return Call(VL_SERVICE_DRM_TERMINATE); }
int init_network_msg_queue(void) { return Call(VL_SERVICE_NET_INIT); }
int uninit_network_msg_queue(void) { return Call(VL_SERVICE_NET_UNINIT); }

void VL_PlatformSetServiceResult(enum VL_PlatformService service, int result) {
  if (service < 0 || service >= kServiceCount) return;
  Services& s = State();
  std::lock_guard<std::mutex> guard(s.lock);
  s.chosen[service] = true;
  s.result[service] = result;
}

void VL_PlatformResetServices(void) {
  Services& s = State();
  std::lock_guard<std::mutex> guard(s.lock);
  for (int i = 0; i < kServiceCount; ++i) s.chosen[i] = false;
  s.calls.clear();
}

size_t VL_PlatformServiceCalls(enum VL_PlatformService* calls, size_t max) {
  Services& s = State();
  std::lock_guard<std::mutex> guard(s.lock);
  for (size_t i = 0; i < max && i < s.calls.size(); ++i) calls[i] = s.calls[i];
  return s.calls.size();
}

}  // extern "C"
