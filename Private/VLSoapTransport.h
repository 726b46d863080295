// VLSoapTransport: how every SOAP context of the library reaches the network. Installed once on
// a context (as a gSOAP plug-in) it replaces the context's connection callbacks:
//
// - open: TCP to the URL's host and port, or to the HTTP proxy when one is set, after the lab
//   override VLWS_CONNECT_TO (VLConnectTo), over IPv4 or IPv6 (SetNextFamily may narrow one
//   connection to one of them); connect time-out = the context's connect_timeout.
//   For "https" URLs then a CONNECT tunnel through the proxy, and TLS with the context's TLS
//   context: SNI and the certificate check use the URL's host, never the overridden address.
//   The handshake is bounded by connect_timeout as well. It resumes the last TLS session of the
//   same host and port (VLTlsSessionCache), which the close keeps once the answer is read.
// - TLS writes go through a socket BIO that sends with MSG_NOSIGNAL, so a peer that hangs up
//   gives an error result and never a SIGPIPE (plain sockets get the same flag through the
//   context's socket_flags, set by Install).
// - receive: one wait of at most recv_timeout for data, however the TLS records are cut.
// - deadline: the whole exchange on a connection (connect, TLS handshake, request and answer)
//   ends within send_timeout and recv_timeout together, so that an answer trickling in a byte
//   at a time cannot hold a call for longer; a receive that reaches the deadline returns
//   nothing, as one that reaches its receive time-out does.
// - close: a TLS connection sends its close_notify and is closed at once. (gSOAP's own close
//   then waits up to 5 s for the peer's close_notify, which put 5 s on every failed call and
//   made a 5 s receive time-out take twice as long.)
// - HTTP headers: "User-Agent" is the configured text or "gSOAP/2.7"; "Accept-Encoding" is
//   "gzip, deflate".
// - every block of bytes sent or received is logged raw to "soap_sent" / "soap_recv" (level 4),
//   except the values of the secret elements "AuthToken" and "password" (any namespace prefix),
//   which read "********"; connection traces go to "soap_test".
//
// Any request made on the context (SOAP calls and plain HTTP requests over soap_connect_command,
// fsend and frecv) takes this path.
#ifndef VLSOAPTRANSPORT_H
#define VLSOAPTRANSPORT_H

#include <openssl/bio.h>

#include "stdsoap2.h"

class VLSoapTransport {
 public:
  // Makes soap one of the library's connections: the default time-outs of the handles' settings,
  // sends that raise no SIGPIPE and the transport's callbacks. TLS is set up apart, by
  // Setup_SSL_Client_CACerts, on the contexts that open "https" URLs. Returns SOAP_OK or the
  // registration's error.
  static int Install(soap* soap);

  // The next connection of the context tries only addresses of family (AF_INET or AF_INET6);
  // the ones after it any again.
  static void SetNextFamily(soap* soap, int family);

  // The context's time-outs in seconds: sending and connecting (TLS handshake included) within
  // sendTimeout, receiving within recvTimeout.
  static void SetTimeouts(soap* soap, int sendTimeout, int recvTimeout);

  // The User-Agent of the context's requests: userAgent when not empty, else "gSOAP/2.7". The
  // text is referenced, not copied. Requires Install.
  static void SetUserAgent(soap* soap, const char* userAgent);

  // A BIO over the connected socket fd (not closed with the BIO) that writes with
  // send(MSG_NOSIGNAL) and otherwise behaves as OpenSSL's socket BIO. Null when out of memory.
  static BIO* NewSocketBIO(int fd);
};

// A context of its own for a request that needs no client handle, installed as above; what the
// requests left in it is released with it.
class VLSoapContext : public soap {
 public:
  VLSoapContext() : soap(SOAP_C_UTFSTRING) { VLSoapTransport::Install(this); }
  ~VLSoapContext() {
    soap_destroy(this);
    soap_end(this);
  }
  VLSoapContext(const VLSoapContext&) = delete;
  VLSoapContext& operator=(const VLSoapContext&) = delete;
};

#endif  // VLSOAPTRANSPORT_H
