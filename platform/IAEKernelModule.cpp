// The stand-in kernel module "libIAEKernel.so": hands out its own instance of the built-in kernel.
#include "IAEKernel.h"

IAEKernel* VLPlatformBuiltinKernel();

extern "C" {

IAEKernel* IAEModule_IAEKernel_LoadModule() { return VLPlatformBuiltinKernel(); }

int IAEModule_IAEKernel_InitializeKernel(int, char**) { return 0; }

void IAEModule_IAEKernel_UnloadModule() {}

}  // extern "C"
