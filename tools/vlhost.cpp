// vlhost: the launcher. Runs movie scripts with an application library the way the device's
// launcher does.
//
//   vlhost [--library PATH] MOVIE.js [MORE.js ...]
//
// It loads the kernel module (libIAEKernel.so), loads the application library (default: the
// libDUDUVud.so next to vlhost) with the dynamic loader, gets the application from the plain
// symbol createApplication2 and initialises it with a launcher whose stage registers the
// application's extension classes. Then it runs the movie scripts in order (one global scope)
// and the frame loop until the movie ends, closes the movie (every extension object is
// destructed), calls onTerminate, deletes the application and lists the keys the stage
// received.
//
// Movie script globals (details in platform/include/VLStage.h):
//   newExtension(classId, ...args)  an object of a registered extension class
//   print(...values)                one line to standard output
//   quit()                          quit the movie
//   exit(code)                      end the movie with that exit status
//   getenv(name)                    an environment variable, or undefined
//   onEnterFrame                    a function the movie may define; called every frame
//
// Exit status: the movie's (0, or the code given to exit()); 1 after an uncaught script error,
// whose message and script stack go to standard error; 2 when the kernel module or the library
// cannot be loaded or the arguments are wrong.
#include <dlfcn.h>
#include <unistd.h>

#include <cstdio>
#include <cstring>
#include <string>
#include <vector>

#include "IAEKernel.h"
#include "VLStage.h"

namespace {

typedef scLauncher::IApplication2* (*CreateApplicationFn)();

// The folder of this executable, with a final "/".
std::string ExecutableFolder() {
  char path[4096];
  ssize_t n = readlink("/proc/self/exe", path, sizeof path - 1);
  if (n <= 0) return "./";
  std::string exe(path, static_cast<size_t>(n));
  return exe.substr(0, exe.rfind('/') + 1);
}

int Usage() {
  fprintf(stderr, "usage: vlhost [--library PATH] MOVIE.js [MORE.js ...]\n");
  return 2;
}

}  // namespace

int main(int argc, char** argv) {
  std::string library = ExecutableFolder() + "libDUDUVud.so";
  std::vector<std::string> scripts;
  for (int i = 1; i < argc; ++i) {
    if (strcmp(argv[i], "--library") == 0 && i + 1 < argc) {
      library = argv[++i];
    } else if (argv[i][0] == '-') {
      return Usage();
    } else {
      scripts.push_back(argv[i]);
    }
  }
  if (scripts.empty()) return Usage();

  if (!IAEKernel::InitializeAEKernel(argc, argv)) return 2;  // the loader's message is printed
  void* handle = dlopen(library.c_str(), RTLD_NOW | RTLD_LOCAL);
  CreateApplicationFn create =
      handle ? reinterpret_cast<CreateApplicationFn>(dlsym(handle, "createApplication2")) : nullptr;
  scLauncher::IApplication2* application = create ? create() : nullptr;
  if (!application) {
    fprintf(stderr, "vlhost: cannot start an application from %s: %s\n", library.c_str(),
            handle ? (create ? "createApplication2 returned none" : "no createApplication2") : dlerror());
    if (handle) dlclose(handle);
    IAEKernel::UninitializeAEKernel();
    return 2;
  }

  vlplatform::Stage stage;
  int status = vlplatform::RunApplication(application, stage, scripts);
  for (const vlplatform::KeyEvent& key : stage.Keys()) {
    printf("vlhost: key %s 0x%08x\n", key.pressed ? "press" : "release", key.keyCode);
  }
  fflush(stdout);
  if (!stage.Error().empty()) fprintf(stderr, "vlhost: %s\n", stage.Error().c_str());
  dlclose(handle);
  IAEKernel::UninitializeAEKernel();
  return status;
}
