// VLThread: runs one function once on a detached POSIX thread. The owner polls IsRunning() or
// calls WaitUntilCompletion() before DestroyThread(); nothing ever joins or cancels the thread.
//
//   VLThread* t = VLThread::CreateThread();
//   if (!t->Run("worker", Work, arg)) { VLThread::DestroyThread(t); ... }
//   ...
//   t->WaitUntilCompletion();
//   VLThread::DestroyThread(t);
#ifndef VLTHREAD_H
#define VLTHREAD_H

#include <memory>

class VLThread {
 public:
  // A new, idle thread object.
  static VLThread* CreateThread();
  // Deletes t (null is allowed) without waiting for its function.
  static void DestroyThread(VLThread* t);
  // Sleeps ms milliseconds, also across interrupting signals.
  static void Sleep(unsigned long ms);

  // Starts func(arg) on a new detached thread; true when the thread was created. The name is
  // accepted and not used. The object counts as running from here on until func returns; when
  // the thread cannot be created it stays idle and may be run again. Runs once: a second Run
  // after a successful one is a precondition failure.
  virtual bool Run(const char* name, void (*func)(void*), void* arg);
  virtual ~VLThread();

  // True from a successful Run until the function has returned.
  bool IsRunning() const;
  // Returns once the function has returned (at once when it never ran), polling every 200 ms.
  void WaitUntilCompletion() const;

 protected:
  VLThread();

 private:
  struct Impl;
  // Shared with the running thread, which writes the running flag after the function returns:
  // the record outlives an owner that destroys this object too early.
  std::shared_ptr<Impl> m_Impl;
};

#endif  // VLTHREAD_H
