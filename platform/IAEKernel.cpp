// Kernel access and loading of the kernel module "libIAEKernel.so", counted per user.
#include "IAEKernel.h"

#include <dlfcn.h>
#include <unistd.h>

#include <cstdio>
#include <mutex>
#include <string>

IAEKernel* VLPlatformBuiltinKernel();

namespace {

typedef IAEKernel* (*LoadModuleFn)();
typedef int (*InitializeKernelFn)(int, char**);
typedef void (*UnloadModuleFn)();

const char kModuleName[] = "libIAEKernel.so";

struct Loaded {
  std::mutex lock;
  void* library = nullptr;
  IAEKernel* kernel = nullptr;
  UnloadModuleFn unload = nullptr;
  int users = 0;
};

Loaded& Module() {
  static Loaded* loaded = new Loaded;
  return *loaded;
}

// The platform keeps its modules next to its own library; there first, else wherever the
// loader finds the name. (The loader's search relative to this library cannot be relied upon:
// sanitizers intercept dlopen and so hide who called it.)
std::string ModulePath() {
  Dl_info info;
  if (dladdr(reinterpret_cast<void*>(&IAEKernel::InitializeAEKernel), &info) && info.dli_fname) {
    std::string self(info.dli_fname);
    size_t slash = self.rfind('/');
    if (slash != std::string::npos) {
      std::string beside = self.substr(0, slash + 1) + kModuleName;
      if (access(beside.c_str(), F_OK) == 0) return beside;
    }
  }
  return kModuleName;
}

}  // namespace

IAEKernel* IAEKernel::GetKernel() {
  Loaded& m = Module();
  std::lock_guard<std::mutex> guard(m.lock);
  return m.kernel ? m.kernel : VLPlatformBuiltinKernel();
}

IAEKernel* IAEKernel::InitializeAEKernel(int argc, char** argv) {
  Loaded& m = Module();
  std::lock_guard<std::mutex> guard(m.lock);
  if (m.kernel) {
    ++m.users;
    return m.kernel;
  }
  void* library = dlopen(ModulePath().c_str(), RTLD_NOW | RTLD_GLOBAL);
  if (!library) {
    fprintf(stderr, "Failed to load %s: %s\n", kModuleName, dlerror());
    return nullptr;
  }
  LoadModuleFn load = reinterpret_cast<LoadModuleFn>(dlsym(library, "IAEModule_IAEKernel_LoadModule"));
  InitializeKernelFn init =
      reinterpret_cast<InitializeKernelFn>(dlsym(library, "IAEModule_IAEKernel_InitializeKernel"));
  UnloadModuleFn unload = reinterpret_cast<UnloadModuleFn>(dlsym(library, "IAEModule_IAEKernel_UnloadModule"));
  IAEKernel* kernel = (load && init && unload) ? load() : nullptr;
  if (!kernel || init(argc, argv) != 0) {
    if (kernel) unload();
    dlclose(library);
    return nullptr;
  }
  m.library = library;
  m.kernel = kernel;
  m.unload = unload;
  m.users = 1;
  return kernel;
}

void IAEKernel::UninitializeAEKernel() {
  Loaded& m = Module();
  std::lock_guard<std::mutex> guard(m.lock);
  if (!m.kernel || --m.users > 0) return;
  m.unload();
  dlclose(m.library);
  m.library = nullptr;
  m.kernel = nullptr;
  m.unload = nullptr;
}
