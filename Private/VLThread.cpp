#include "VLThread.h"

#include <errno.h>
#include <pthread.h>
#include <time.h>

#include <atomic>

#include "VLAssert.h"

struct VLThread::Impl {
  std::atomic<bool> m_Running{false};
  pthread_t m_Thread = 0;  // 0 until a thread was started
  void (*m_Function)(void*) = nullptr;
  void* m_Argument = nullptr;

  // The new thread's start: arg is a heap copy of the owner's share of the record.
  static void* EntryPoint(void* arg) {
    std::shared_ptr<Impl>* share = static_cast<std::shared_ptr<Impl>*>(arg);
    std::shared_ptr<Impl> impl = std::move(*share);
    delete share;
    impl->m_Function(impl->m_Argument);
    impl->m_Running.store(false);  // publishes everything the function did
    return nullptr;
  }
};

VLThread::VLThread() : m_Impl(std::make_shared<Impl>()) {}

VLThread::~VLThread() {}

VLThread* VLThread::CreateThread() { return new VLThread; }

void VLThread::DestroyThread(VLThread* t) {
  if (!t) return;
  t->m_Impl->m_Thread = 0;
  delete t;
}

bool VLThread::Run(const char* name, void (*func)(void*), void* arg) {
  VL_ASSERT(m_Impl->m_Thread == 0);
  if (!func) return false;
  m_Impl->m_Function = func;
  m_Impl->m_Argument = arg;
  // Raised before the thread exists, so that a wait issued right after Run cannot return before
  // the function has even started.
  m_Impl->m_Running.store(true);

  pthread_attr_t attr;
  pthread_attr_init(&attr);
  pthread_attr_setdetachstate(&attr, PTHREAD_CREATE_DETACHED);
  std::shared_ptr<Impl>* share = new std::shared_ptr<Impl>(m_Impl);
  pthread_t thread;
  int result = pthread_create(&thread, &attr, Impl::EntryPoint, share);
  pthread_attr_destroy(&attr);
  if (result != 0) {
    delete share;
    m_Impl->m_Running.store(false);
    return false;
  }
  m_Impl->m_Thread = thread;
  return true;
}

bool VLThread::IsRunning() const { return m_Impl->m_Thread != 0 && m_Impl->m_Running.load(); }

void VLThread::WaitUntilCompletion() const {
  while (IsRunning()) Sleep(200);
}

void VLThread::Sleep(unsigned long ms) {
  struct timespec wait;
  wait.tv_sec = static_cast<time_t>(ms / 1000);
  wait.tv_nsec = static_cast<long>(ms % 1000) * 1000000L;
  struct timespec rest;
  while (nanosleep(&wait, &rest) != 0 && errno == EINTR) wait = rest;
}
