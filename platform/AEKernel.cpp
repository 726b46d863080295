// The built-in kernel of the stand-in platform: POSIX mutexes, the C heap, and failed checks
// reported on standard error.
#include "IAEKernel.h"

#include <pthread.h>

#include <cstdio>
#include <cstdlib>
#include <cstring>

namespace {

class PosixMutex : public IAEKernel::Mutex {
 public:
  PosixMutex() { pthread_mutex_init(&m_Mutex, nullptr); }
  ~PosixMutex() override { pthread_mutex_destroy(&m_Mutex); }
  void Lock() override { pthread_mutex_lock(&m_Mutex); }
  void Unlock() override { pthread_mutex_unlock(&m_Mutex); }

 private:
  pthread_mutex_t m_Mutex;
};

class BuiltinKernel : public IAEKernel {
 public:
  Mutex* CreateMutex() override { return new PosixMutex; }
  void DestroyMutex(Mutex* mutex) override { delete mutex; }
  void* Allocate(size_t size, const char*, int) override { return malloc(size ? size : 1); }
  void Free(void* p) override { free(p); }
  void* SetMemory(void* dst, int value, size_t n) override { return memset(dst, value, n); }
  void* CopyMemory(void* dst, const void* src, size_t n) override { return memcpy(dst, src, n); }
  void* MoveMemory(void* dst, const void* src, size_t n) override { return memmove(dst, src, n); }
  size_t StringLength(const char* s) override { return strlen(s); }
  void ReportFailedCheck(const char* file, int line, const char* expression) override {
    fprintf(stderr, "Check failed: %s, file %s, line %d\n", expression, file, line);
    fflush(stderr);
  }
};

}  // namespace

IAEKernel* VLPlatformBuiltinKernel() {
  static BuiltinKernel* kernel = new BuiltinKernel;  // never destroyed: used until exit
  return kernel;
}

IAEKernel* VLPlatformCreateKernel() { return new BuiltinKernel; }

void VLPlatformDestroyKernel(IAEKernel* kernel) { delete static_cast<BuiltinKernel*>(kernel); }
