// VLTlsSessionCache: the last TLS session of each host and port, kept for the whole process, so
// that the next connection to the same place resumes it instead of making a full handshake.
// Every call of the library opens its own connection; resuming saves the certificate
// verification and most of the key exchange on each of them.
//
// A session is kept under the logical host name that its certificate was checked against (not
// the address VLWS_CONNECT_TO sends the connection to) and is only ever offered to that host
// and port. Sessions are kept once the answer has been read: TLS 1.3 sends its session tickets
// after the handshake. Handles on several threads share the cache; it holds a lock.
#ifndef VLTLSSESSIONCACHE_H
#define VLTLSSESSIONCACHE_H

#include <openssl/ssl.h>

class VLTlsSessionCache {
 public:
  // The session kept for host:port with a reference for the caller (SSL_SESSION_free), or null.
  static SSL_SESSION* Get(const char* host, int port);
  // Keeps session (a reference of its own) for host:port in place of the one before. A session
  // that cannot be resumed is not kept.
  static void Put(const char* host, int port, SSL_SESSION* session);
  // Forgets the session of host:port.
  static void Remove(const char* host, int port);
};

#endif  // VLTLSSESSIONCACHE_H
