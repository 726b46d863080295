#include "AutoSSL.h"

#include <mutex>

#include <openssl/crypto.h>
#include <openssl/opensslv.h>

#include "VLWSAELog.h"
#include "stdsoap2.h"

namespace {

pthread_mutex_t* s_Locks = NULL;
long* s_LockCounts = NULL;

}  // namespace

void AutoSSL::InitOpenSSL() {
  static std::once_flag s_Once;
  std::call_once(s_Once, [] {
    soap_init_vl_log();
    soap_ssl_init();
    VLLogOutputwithConfig({TEST_VLLogAreaID, 4}, "Initializing OpenSSL, version=%ld\n",
                          static_cast<long>(OPENSSL_VERSION_NUMBER));
  });
}

AutoSSL::AutoSSL() {
  InitOpenSSL();
  int n = CRYPTO_num_locks();
  s_Locks = static_cast<pthread_mutex_t*>(OPENSSL_malloc(n * sizeof(pthread_mutex_t)));
  s_LockCounts = static_cast<long*>(OPENSSL_malloc(n * sizeof(long)));
  for (int i = 0; i < n; i++) {
    s_LockCounts[i] = 0;
    pthread_mutex_init(&s_Locks[i], NULL);
  }
  // Both are no-ops with OpenSSL 3 (see the header).
  CRYPTO_set_id_callback(pthreads_thread_id);
  CRYPTO_set_locking_callback(pthreads_locking_callback);
}

AutoSSL::~AutoSSL() {
  CRYPTO_set_locking_callback(NULL);
  for (int i = 0; i < CRYPTO_num_locks(); i++) pthread_mutex_destroy(&s_Locks[i]);
  OPENSSL_free(s_Locks);
  OPENSSL_free(s_LockCounts);
  s_Locks = NULL;
  s_LockCounts = NULL;
  // OpenSSL 3 releases its tables, error strings and thread state by itself at process exit;
  // the clean-up calls of older versions are no-ops there.
}

unsigned long pthreads_thread_id() { return static_cast<unsigned long>(pthread_self()); }

void pthreads_locking_callback(int mode, int n, const char* /*file*/, int /*line*/) {
  if (mode & CRYPTO_LOCK) {
    pthread_mutex_lock(&s_Locks[n]);
    s_LockCounts[n]++;
  } else {
    pthread_mutex_unlock(&s_Locks[n]);
  }
}
