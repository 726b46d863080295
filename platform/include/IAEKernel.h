// The engine's kernel services (stand-in): mutexes, memory, string helpers and the report of a
// failed check. IAEKernel::GetKernel() always returns a usable kernel; InitializeAEKernel loads
// the kernel module "libIAEKernel.so" the way the device's launcher does.
#ifndef IAEKERNEL_H
#define IAEKERNEL_H

#include <stddef.h>

class IAEKernel {
 public:
  class Mutex {
   public:
    virtual ~Mutex() {}
    virtual void Lock() = 0;
    virtual void Unlock() = 0;
  };

  // The process's kernel: the one that InitializeAEKernel loaded, else the built-in one.
  static IAEKernel* GetKernel();
  // Loads the kernel module once and counts its users; null when the module cannot be used.
  static IAEKernel* InitializeAEKernel(int argc, char** argv);
  // One user fewer; the module is unloaded when the last user leaves.
  static void UninitializeAEKernel();

  virtual Mutex* CreateMutex() = 0;
  virtual void DestroyMutex(Mutex* mutex) = 0;

  virtual void* Allocate(size_t size, const char* file, int line) = 0;
  virtual void Free(void* p) = 0;
  virtual void* SetMemory(void* dst, int value, size_t n) = 0;
  virtual void* CopyMemory(void* dst, const void* src, size_t n) = 0;
  virtual void* MoveMemory(void* dst, const void* src, size_t n) = 0;
  virtual size_t StringLength(const char* s) = 0;

  // Reports a failed check of the program (the caller stops the process afterwards).
  virtual void ReportFailedCheck(const char* file, int line, const char* expression) = 0;

 protected:
  virtual ~IAEKernel() {}
};

#endif  // IAEKERNEL_H
