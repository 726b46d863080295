// AutoSSL: the process-wide OpenSSL set-up. The client's first initialisation constructs one
// instance as a function-local static (destroyed at process exit); it must exist before two
// threads use TLS at the same time.
//
// OpenSSL 3 locks its own state and ignores the locking and thread-id callbacks of older
// versions. The instance still keeps one mutex and lock counter per OpenSSL lock number (there
// is one in OpenSSL 3) and installs pthreads_thread_id and pthreads_locking_callback, so the
// library behaves the same when built against an OpenSSL that wants them.
#ifndef AUTOSSL_H
#define AUTOSSL_H

#include <pthread.h>

class AutoSSL {
 public:
  AutoSSL();
  ~AutoSSL();
  AutoSSL(const AutoSSL&) = delete;
  AutoSSL& operator=(const AutoSSL&) = delete;

  // Initialises OpenSSL once per process (library, error strings, random pool) and logs
  // "Initializing OpenSSL, version=%ld" to "soap_test". Every SOAP context calls it when made.
  static void InitOpenSSL();
};

// OpenSSL's thread identity: pthread_self().
unsigned long pthreads_thread_id();

// OpenSSL's locking callback: locks mutex n when mode has bit 1 (CRYPTO_LOCK) set, counting the
// lock, else unlocks it.
void pthreads_locking_callback(int mode, int n, const char* file, int line);

#endif  // AUTOSSL_H
