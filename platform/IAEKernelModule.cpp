// The stand-in kernel module "libIAEKernel.so": a kernel of its own, made when the module is
// loaded and destroyed when it is unloaded. Only the three module functions are exported.
#include "IAEKernel.h"

IAEKernel* VLPlatformCreateKernel();
void VLPlatformDestroyKernel(IAEKernel* kernel);

namespace {
IAEKernel* s_Kernel = nullptr;
}

#define VL_MODULE_EXPORT __attribute__((visibility("default")))

extern "C" {

VL_MODULE_EXPORT IAEKernel* IAEModule_IAEKernel_LoadModule() {
  if (!s_Kernel) s_Kernel = VLPlatformCreateKernel();
  return s_Kernel;
}

VL_MODULE_EXPORT int IAEModule_IAEKernel_InitializeKernel(int, char**) { return 0; }

VL_MODULE_EXPORT void IAEModule_IAEKernel_UnloadModule() {
  VLPlatformDestroyKernel(s_Kernel);
  s_Kernel = nullptr;
}

}  // extern "C"
