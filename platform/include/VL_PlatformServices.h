// The device's DRM service and network message queue (stand-ins). Each function returns 0 on
// success, another value on failure.
//
// The stand-ins do nothing but record their calls and return the result chosen for them: the
// one set with VL_PlatformSetServiceResult, else the integer in the service's environment
// variable (VL_DRM_INIT_RESULT, VL_DRM_TERMINATE_RESULT, VL_NET_INIT_RESULT,
// VL_NET_UNINIT_RESULT), else 0.
#ifndef VL_PLATFORMSERVICES_H
#define VL_PLATFORMSERVICES_H

#include <stddef.h>

#ifdef __cplusplus
extern "C" {
#endif

int Ipriv_drm_Init(void);
int Ipriv_drm_Terminate(void);
int init_network_msg_queue(void);
int uninit_network_msg_queue(void);

// Stand-in only, for tests.
enum VL_PlatformService {
  VL_SERVICE_DRM_INIT = 0,
  VL_SERVICE_DRM_TERMINATE = 1,
  VL_SERVICE_NET_INIT = 2,
  VL_SERVICE_NET_UNINIT = 3
};
// Chooses the result of a service's following calls.
void VL_PlatformSetServiceResult(enum VL_PlatformService service, int result);
// Forgets chosen results and recorded calls.
void VL_PlatformResetServices(void);
// Copies up to max recorded calls, oldest first, into calls; returns how many calls there are.
size_t VL_PlatformServiceCalls(enum VL_PlatformService* calls, size_t max);

#ifdef __cplusplus
}
#endif

#endif  // VL_PLATFORMSERVICES_H
