#include "VLSoapTransport.h"

#include <arpa/inet.h>
#include <errno.h>
#include <fcntl.h>
#include <limits.h>
#include <netdb.h>
#include <netinet/in.h>
#include <netinet/tcp.h>
#include <poll.h>
#include <stdio.h>
#include <string.h>
#include <strings.h>
#include <sys/socket.h>
#include <time.h>
#include <unistd.h>

#include <algorithm>
#include <mutex>
#include <new>

#include <openssl/err.h>
#include <openssl/evp.h>
#include <openssl/ssl.h>
#include <openssl/x509v3.h>

#include "AutoSSL.h"
#include "VLConnectTo.h"
#include "VLTlsSessionCache.h"
#include "VLWSAELog.h"
#include "VL_Log.h"
#include "VL_WS_SetupParams2.h"

namespace {

const char kPluginId[] = "VL-Transport-1.0";

// Every send of the library, plain or TLS: a peer that hangs up gives an error result, never a
// SIGPIPE that would end the launcher.
const int kNoSignal = MSG_NOSIGNAL;

// ---- Raw logs --------------------------------------------------------------------------------

// The raw logs of one direction of a connection, without the secrets in it: the text content of
// every element whose local name is "AuthToken" (the account's token, in every request's
// settings block and in the authorisation's answer) or "password" (the account's password, sent
// to remove all purchases) becomes "********"; every other byte is logged as it is. Blocks cut
// the text anywhere, within a tag or a value too, so what the last block left open is kept.
class RawLog {
 public:
  explicit RawLog(const int* area) : m_Area(area) {}

  // A new message: nothing of an earlier one is open.
  void Reset() {
    m_InTag = m_InSecret = m_Masked = false;
    m_Prev = 0;
  }

  // Jumps from tag to tag; the bytes are copied only around a masked value, and a block without
  // one is logged as it is.
  void Write(const char* data, size_t n) {
    VLString masked;
    const char* kept = data;  // the first byte not yet copied into masked
    const char* c = data;
    const char* end = data + n;
    while (c < end) {
      if (m_InSecret) {
        const char* next = Find(c, end, '<');
        if (next > c) {  // one mask stands for the whole value
          masked.append(kept, c - kept);
          if (!m_Masked) masked += kMask;
          m_Masked = true;
          m_Prev = next[-1];
          c = kept = next;
          continue;
        }
        m_InSecret = false;
      }
      // Within a tag, a "<" before its ">" starts another tag.
      const char* next = m_InTag ? Find(c, Find(c, end, '>'), '<') : Find(c, end, '<');
      if (m_InTag) {
        size_t take = std::min(static_cast<size_t>(next - c), sizeof(m_Tag) - m_TagLength);
        memcpy(m_Tag + m_TagLength, c, take);
        m_TagLength += take;
      }
      if (next > c) m_Prev = next[-1];
      c = next;
      if (c == end) break;
      if (*c == '<') {
        m_InTag = true;
        m_TagLength = 0;
      } else {  // the ">" that ends a tag
        m_InTag = false;
        m_InSecret = m_Prev != '/' && IsSecretName(m_Tag, m_TagLength);
        m_Masked = false;
      }
      m_Prev = *c++;
    }
    if (kept == data) {
      VL_LogOutputwithLen(*m_Area, 4, data, static_cast<int>(n));
    } else {
      masked.append(kept, end - kept);
      VL_LogOutputwithLen(*m_Area, 4, masked.c_str(), static_cast<int>(masked.length()));
    }
  }

 private:
  static constexpr const char* kMask = "********";

  // The first byte ch in [c, end), or end.
  static const char* Find(const char* c, const char* end, char ch) {
    const void* found = memchr(c, ch, static_cast<size_t>(end - c));
    return found ? static_cast<const char*>(found) : end;
  }

  static bool IsNameEnd(char c) { return c == ' ' || c == '\t' || c == '\r' || c == '\n' || c == '/' || c == '\0'; }

  // Whether the start of a tag's text (after its "<") names a secret element.
  static bool IsSecretName(const char* tag, size_t tagLength) {
    size_t length = 0;
    while (length < tagLength && !IsNameEnd(tag[length])) ++length;
    const char* colon = static_cast<const char*>(memrchr(tag, ':', length));
    const char* local = colon ? colon + 1 : tag;
    size_t localLength = length - static_cast<size_t>(local - tag);
    for (const char* secret : {"AuthToken", "password"})
      if (localLength == strlen(secret) && memcmp(local, secret, localLength) == 0) return true;
    return false;
  }

  const int* m_Area;  // one of the exported area ids, which are registered after construction
  // The first bytes of the tag being read, after its "<": more than any name looked for, prefix
  // included.
  char m_Tag[64];
  size_t m_TagLength = 0;
  bool m_InTag = false;
  bool m_InSecret = false;  // within the value of a secret element
  bool m_Masked = false;    // the mask of that value is written
  char m_Prev = 0;          // the byte before the current one
};

// The context's callbacks that the transport replaced (it chains to them) and its settings.
struct TransportData {
  SOAP_SOCKET (*fopen)(soap*, const char*, const char*, int);
  int (*fclose)(soap*);
  int (*fposthdr)(soap*, const char*, const char*);
  int (*fsend)(soap*, const char*, size_t);
  const char* userAgent;
  VLString tlsHost;  // the host and port of the open TLS connection (its session's place)
  int tlsPort;
  int family;  // of the next connection's addresses; AF_UNSPEC any
  long long exchangeDeadline;  // of the exchange on the open connection (see ExchangeDeadline)
  RawLog sent{&SENT_VLLogAreaID};
  RawLog received{&RECV_VLLogAreaID};
};

TransportData* Data(soap* s) { return static_cast<TransportData*>(soap_lookup_plugin(s, kPluginId)); }

// ---- Time-outs -------------------------------------------------------------------------------

// Deadlines are milliseconds of CLOCK_MONOTONIC; -1 is none.
long long Now() {
  timespec now;
  clock_gettime(CLOCK_MONOTONIC, &now);
  return now.tv_sec * 1000LL + now.tv_nsec / 1000000;
}

// A gSOAP time-out (> 0 seconds, < 0 microseconds, 0 none) in milliseconds.
long long TimeoutMs(int timeout) {
  return timeout >= 0 ? timeout * 1000LL : (-static_cast<long long>(timeout) + 999) / 1000;
}

long long Earlier(long long a, long long b) {
  if (a < 0) return b;
  if (b < 0) return a;
  return a < b ? a : b;
}

// The deadline of one wait of the given time-out, never after the exchange's.
long long Deadline(soap* s, int timeout) {
  return Earlier(timeout == 0 ? -1 : Now() + TimeoutMs(timeout), Data(s)->exchangeDeadline);
}

// The time-outs bound each single wait, so an answer that trickles in (a byte now and then)
// would never end. The whole exchange on a connection, from connecting to the last byte of the
// answer, therefore ends within the send and the receive time-out together: 118 s with the
// handles' 30 and 88. Without a receive time-out there is no deadline.
long long ExchangeDeadline(const soap* s) {
  if (s->recv_timeout == 0) return -1;
  return Now() + TimeoutMs(s->send_timeout) + TimeoutMs(s->recv_timeout);
}

// Waits until fd is ready for events or the deadline passes. Returns 1 ready, 0 time-out, -1
// error (errno set).
int WaitSocket(int fd, short events, long long deadline) {
  for (;;) {
    int wait = -1;
    if (deadline >= 0) {
      long long left = deadline - Now();
      if (left <= 0) return 0;
      wait = left > INT_MAX ? INT_MAX : static_cast<int>(left);
    }
    pollfd p = {fd, events, 0};
    int r = poll(&p, 1, wait);
    if (r > 0) return 1;
    if (r == 0) return 0;
    if (errno != EINTR) return -1;
  }
}

// ---- TCP -------------------------------------------------------------------------------------

int ConnectOne(const addrinfo* ai, long long deadline, int* err) {
  int fd = socket(ai->ai_family, ai->ai_socktype | SOCK_CLOEXEC | SOCK_NONBLOCK, ai->ai_protocol);
  if (fd < 0) {
    *err = errno;
    return -1;
  }
  if (connect(fd, ai->ai_addr, ai->ai_addrlen) == 0) return fd;
  if (errno == EINPROGRESS) {
    int r = WaitSocket(fd, POLLOUT, deadline);
    socklen_t len = sizeof(*err);
    if (r > 0 && getsockopt(fd, SOL_SOCKET, SO_ERROR, err, &len) == 0 && *err == 0) return fd;
    if (r == 0) *err = ETIMEDOUT;
    if (r < 0) *err = errno;
  } else {
    *err = errno;
  }
  close(fd);
  return -1;
}

// Connects to host:port, or where VLWS_CONNECT_TO sends it, trying the addresses of family
// (AF_UNSPEC: all) in the resolver's order. The socket stays non-blocking when the context has
// send or receive time-outs (gSOAP's send and receive loops wait with select), else it is made
// blocking.
SOAP_SOCKET ConnectTcp(soap* s, const char* host, int port, int family) {
  VLString addr;
  int addrPort;
  if (VLConnectTo::Resolve(host, port, &addr, &addrPort)) {
    VLLogOutputwithConfig({TEST_VLLogAreaID, 4}, "Connect %s:%d via %s:%d (VLWS_CONNECT_TO)\n",
                          host, port, addr.c_str(), addrPort);
  } else {
    VLLogOutputwithConfig({TEST_VLLogAreaID, 4}, "Connect %s:%d\n", host, port);
  }
  addrinfo hints;
  memset(&hints, 0, sizeof(hints));
  hints.ai_family = family;
  hints.ai_socktype = SOCK_STREAM;
  char service[16];
  snprintf(service, sizeof(service), "%d", addrPort);
  addrinfo* res = NULL;
  if (getaddrinfo(addr.c_str(), service, &hints, &res) != 0 || !res) {
    soap_set_receiver_error(s, "Host not found", "getaddrinfo failed in VLSoapTransport", SOAP_TCP_ERROR);
    return SOAP_INVALID_SOCKET;
  }
  long long deadline = Deadline(s, s->connect_timeout);
  int fd = -1, err = 0;
  for (const addrinfo* ai = res; ai && fd < 0; ai = ai->ai_next) fd = ConnectOne(ai, deadline, &err);
  freeaddrinfo(res);
  if (fd < 0) {
    s->errnum = err;
    soap_set_receiver_error(s, err == ETIMEDOUT ? "Timeout" : "Connection refused",
                            "connect failed in VLSoapTransport", SOAP_TCP_ERROR);
    return SOAP_INVALID_SOCKET;
  }
  int on = 1;
  setsockopt(fd, IPPROTO_TCP, TCP_NODELAY, &on, sizeof(on));
  if (s->send_timeout == 0 && s->recv_timeout == 0) fcntl(fd, F_SETFL, fcntl(fd, F_GETFL) & ~O_NONBLOCK);
  return fd;
}

// Sends all n bytes on a connected socket within the send time-out.
bool SendAll(soap* s, int fd, const char* data, size_t n) {
  long long deadline = Deadline(s, s->send_timeout);
  while (n > 0) {
    ssize_t r = send(fd, data, n, kNoSignal);
    if (r > 0) {
      data += r;
      n -= r;
    } else if (r < 0 && (errno == EAGAIN || errno == EWOULDBLOCK || errno == EINTR)) {
      if (WaitSocket(fd, POLLOUT, deadline) <= 0) return false;
    } else {
      return false;
    }
  }
  return true;
}

// ---- HTTP proxy tunnel -----------------------------------------------------------------------

// "Basic " + Base64(user:password), when both are set and together shorter than 761 characters
// (the rule gSOAP applies to its own requests through a proxy); empty otherwise.
VLString ProxyAuthorization(const soap* s) {
  if (!s->proxy_userid || !s->proxy_passwd ||
      strlen(s->proxy_userid) + strlen(s->proxy_passwd) >= 761)
    return VLString();
  VLString plain(s->proxy_userid);
  plain += ":";
  plain += s->proxy_passwd;
  unsigned char encoded[1100];
  int len = EVP_EncodeBlock(encoded, reinterpret_cast<const unsigned char*>(plain.c_str()),
                            static_cast<int>(plain.length()));
  VLString value("Basic ");
  value.append(reinterpret_cast<const char*>(encoded), len);
  return value;
}

// Opens a tunnel to host:port through the proxy connected on fd. On a refusal the error is the
// proxy's HTTP status.
int ProxyConnect(soap* s, int fd, const char* host, int port) {
  char line[SOAP_TAGLEN + 64];
  const char* version = s->proxy_http_version ? s->proxy_http_version : "1.1";
  snprintf(line, sizeof(line), "CONNECT %s:%d HTTP/%s\r\nHost: %s:%d\r\n", host, port, version, host, port);
  VLString request(line);
  VLString auth = ProxyAuthorization(s);
  if (!auth.empty()) request += "Proxy-Authorization: " + auth + "\r\n";
  request += "\r\n";
  VL_LogOutputwithLen(SENT_VLLogAreaID, 4, request.c_str(), static_cast<int>(request.length()));
  if (!SendAll(s, fd, request.c_str(), request.length()))
    return soap_set_receiver_error(s, "Proxy connection failed", "CONNECT not sent", SOAP_TCP_ERROR);

  // The proxy says nothing after its header until TLS starts, so reading past it is safe.
  char reply[4096];
  size_t got = 0;
  long long deadline = Deadline(s, s->recv_timeout);
  for (;;) {
    reply[got] = '\0';
    if (strstr(reply, "\r\n\r\n")) break;
    if (got == sizeof(reply) - 1 || WaitSocket(fd, POLLIN, deadline) <= 0)
      return soap_set_receiver_error(s, "Proxy connection failed", "no CONNECT reply", SOAP_TCP_ERROR);
    ssize_t r = recv(fd, reply + got, sizeof(reply) - 1 - got, 0);
    if (r == 0 || (r < 0 && errno != EINTR && errno != EAGAIN))
      return soap_set_receiver_error(s, "Proxy connection failed", "no CONNECT reply", SOAP_TCP_ERROR);
    if (r > 0) got += r;
  }
  VL_LogOutputwithLen(RECV_VLLogAreaID, 4, reply, static_cast<int>(got));
  int status = 0;
  if (sscanf(reply, "HTTP/%*d.%*d %d", &status) != 1 || status < 100 || status > 599)
    return soap_set_receiver_error(s, "Proxy connection failed", "bad CONNECT reply", SOAP_TCP_ERROR);
  if (status != 200)
    return soap_set_receiver_error(s, "Proxy refused the tunnel", "CONNECT refused", status);
  return SOAP_OK;
}

// ---- TLS -------------------------------------------------------------------------------------

bool IsIpLiteral(const char* host) {
  unsigned char buf[sizeof(in6_addr)];
  return inet_pton(AF_INET, host, buf) == 1 || inet_pton(AF_INET6, host, buf) == 1;
}

int TlsError(soap* s, SSL* ssl, const char* detail) {
  char text[256];
  long verify = ssl ? SSL_get_verify_result(ssl) : X509_V_OK;
  unsigned long e = ERR_peek_last_error();
  if (verify != X509_V_OK)
    snprintf(text, sizeof(text), "SSL certificate verification failed: %s", X509_verify_cert_error_string(verify));
  else if (e)
    snprintf(text, sizeof(text), "SSL error: %s", ERR_reason_error_string(e) ? ERR_reason_error_string(e) : "unknown");
  else
    snprintf(text, sizeof(text), "SSL error: connection closed");
  ERR_clear_error();
  VLLogOutputwithConfig({TEST_VLLogAreaID, 1}, "%s (%s)\n", text, detail);
  return soap_set_receiver_error(s, soap_strdup(s, text), detail, SOAP_SSL_ERROR);
}

// Only connections that check the server's certificate and host name keep and resume sessions:
// a resumed session skips those checks, so it must come from a connection that made them.
bool Authenticates(const soap* s) { return (s->ssl_flags & SOAP_SSL_REQUIRE_SERVER_AUTHENTICATION) != 0; }

// TLS client handshake on fd with the context's TLS context, resuming the last session of
// host:port when there is one. With server authentication required (the library always requires
// it) the chain must verify and the certificate must name host; a resumed session was verified
// so when it was made, for the same host and port.
int StartTls(soap* s, int fd, const char* host, int port) {
  if (!s->ctx && s->fsslauth && (s->error = s->fsslauth(s)) != SOAP_OK) return s->error;
  if (!s->ctx) return soap_set_receiver_error(s, "SSL error", "no TLS context", SOAP_SSL_ERROR);
  ERR_clear_error();
  SSL* ssl = SSL_new(s->ctx);
  BIO* bio = ssl ? VLSoapTransport::NewSocketBIO(fd) : NULL;
  if (!bio) {
    SSL_free(ssl);
    return TlsError(s, NULL, "SSL_new failed in VLSoapTransport");
  }
  SSL_set_bio(ssl, bio, bio);
  bool ip = IsIpLiteral(host);
  if (!ip) SSL_set_tlsext_host_name(ssl, host);
  if (Authenticates(s)) {
    X509_VERIFY_PARAM* param = SSL_get0_param(ssl);
    X509_VERIFY_PARAM_set_hostflags(param, X509_CHECK_FLAG_NO_PARTIAL_WILDCARDS);
    if (ip ? !X509_VERIFY_PARAM_set1_ip_asc(param, host) : !X509_VERIFY_PARAM_set1_host(param, host, 0)) {
      SSL_free(ssl);
      return TlsError(s, NULL, "bad host name in VLSoapTransport");
    }
    SSL_set_verify(ssl, SSL_VERIFY_PEER, SSL_CTX_get_verify_callback(s->ctx));
    if (SSL_SESSION* session = VLTlsSessionCache::Get(host, port)) {
      SSL_set_session(ssl, session);
      SSL_SESSION_free(session);
    }
  }
  long long deadline = Deadline(s, s->connect_timeout);
  int rc = SOAP_OK;
  for (;;) {
    int r = SSL_connect(ssl);
    if (r == 1) break;
    int err = SSL_get_error(ssl, r);
    short events = err == SSL_ERROR_WANT_READ ? POLLIN : err == SSL_ERROR_WANT_WRITE ? POLLOUT : 0;
    if (!events || WaitSocket(fd, events, deadline) <= 0) {
      rc = TlsError(s, ssl, events ? "SSL_connect timed out" : "SSL_connect failed in VLSoapTransport");
      break;
    }
  }
  if (rc == SOAP_OK && Authenticates(s) &&
      (SSL_get_verify_result(ssl) != X509_V_OK || !SSL_get0_peer_certificate(ssl)))
    rc = TlsError(s, ssl, "SSL certificate check failed in VLSoapTransport");
  if (rc != SOAP_OK) {
    // The next handshake starts afresh, whatever went wrong with this one.
    VLTlsSessionCache::Remove(host, port);
    SSL_free(ssl);
    return rc;
  }
  s->ssl = ssl;
  return SOAP_OK;
}

// ---- Callbacks -------------------------------------------------------------------------------

SOAP_SOCKET Open(soap* s, const char* endpoint, const char* host, int port) {
  TransportData* d = Data(s);
  d->exchangeDeadline = ExchangeDeadline(s);
  d->sent.Reset();
  d->received.Reset();
  bool tls = strncasecmp(endpoint, "https:", 6) == 0;
  bool proxy = s->proxy_host && *s->proxy_host;
  int family = d->family;
  d->family = AF_UNSPEC;
  SOAP_SOCKET fd = proxy ? ConnectTcp(s, s->proxy_host, s->proxy_port, family) : ConnectTcp(s, host, port, family);
  if (!soap_valid_socket(fd)) return SOAP_INVALID_SOCKET;
  if (tls && ((proxy && ProxyConnect(s, fd, host, port) != SOAP_OK) || StartTls(s, fd, host, port) != SOAP_OK)) {
    close(fd);
    return SOAP_INVALID_SOCKET;
  }
  if (tls) {
    d->tlsHost = host;
    d->tlsPort = port;
  }
  return fd;
}

int Close(soap* s) {
  if (s->ssl) {
    // The answer has been read, and with it the session tickets that TLS 1.3 sends after the
    // handshake: the session to resume next time.
    if (Authenticates(s) && SSL_is_init_finished(s->ssl)) {
      TransportData* d = Data(s);
      VLTlsSessionCache::Put(d->tlsHost.c_str(), d->tlsPort, SSL_get0_session(s->ssl));
    }
    // Say goodbye without waiting for the peer's answer: the message is complete or failed.
    if (SSL_is_init_finished(s->ssl) && !(SSL_get_shutdown(s->ssl) & SSL_SENT_SHUTDOWN))
      SSL_shutdown(s->ssl);
    SSL_free(s->ssl);
    s->ssl = NULL;
    ERR_clear_error();
  }
  return Data(s)->fclose(s);
}

int PostHeader(soap* s, const char* key, const char* value) {
  TransportData* d = Data(s);
  if (key && strcmp(key, "User-Agent") == 0)
    value = d->userAgent && *d->userAgent ? d->userAgent : "gSOAP/2.7";
  else if (key && strcmp(key, "Accept-Encoding") == 0)
    value = "gzip, deflate";
  return d->fposthdr(s, key, value);
}

int Send(soap* s, const char* data, size_t n) {
  TransportData* d = Data(s);
  d->sent.Write(data, n);
  return d->fsend(s, data, n);
}

// A receive that waited until its deadline: nothing, as from a peer that closed.
size_t ReceiveTimedOut(soap* s) {
  s->errnum = 0;
  VLLogOutputwithConfig({TEST_VLLogAreaID, 1}, "Receive time-out\n");
  return 0;
}

// One read over TLS: at most one recv_timeout of waiting for data, however the records come.
size_t RecvTls(soap* s, char* buf, size_t n) {
  long long deadline = Deadline(s, s->recv_timeout);
  int fd = s->socket;
  for (;;) {
    ERR_clear_error();
    int r = SSL_read(s->ssl, buf, n > INT_MAX ? INT_MAX : static_cast<int>(n));
    if (r > 0) return r;
    int err = SSL_get_error(s->ssl, r);
    short events = err == SSL_ERROR_WANT_READ ? POLLIN : err == SSL_ERROR_WANT_WRITE ? POLLOUT : 0;
    if (!events) {
      s->errnum = err == SSL_ERROR_SYSCALL ? errno : 0;
      return 0;
    }
    int w = WaitSocket(fd, events, deadline);
    if (w == 0) return ReceiveTimedOut(s);
    if (w < 0) {
      s->errnum = errno;
      return 0;
    }
  }
}

// One read of a plain connection: at most one recv_timeout of waiting for data.
size_t RecvPlain(soap* s, char* buf, size_t n) {
  long long deadline = Deadline(s, s->recv_timeout);
  for (;;) {
    int w = WaitSocket(s->socket, POLLIN, deadline);
    if (w == 0) return ReceiveTimedOut(s);
    if (w > 0) {
      ssize_t r = recv(s->socket, buf, n, 0);
      if (r >= 0) return static_cast<size_t>(r);
      if (errno == EINTR || errno == EAGAIN || errno == EWOULDBLOCK) continue;
    }
    s->errnum = errno;
    return 0;
  }
}

size_t Recv(soap* s, char* buf, size_t n) {
  size_t r = s->ssl ? RecvTls(s, buf, n) : RecvPlain(s, buf, n);
  if (r > 0) Data(s)->received.Write(buf, r);
  return r;
}

void DeletePlugin(soap*, soap_plugin* p) { delete static_cast<TransportData*>(p->data); }

int Plugin(soap* s, soap_plugin* p, void*) {
  TransportData* d = new (std::nothrow) TransportData;
  if (!d) return SOAP_EOM;
  d->fopen = s->fopen;
  d->fclose = s->fclose;
  d->fposthdr = s->fposthdr;
  d->fsend = s->fsend;
  d->userAgent = NULL;
  d->tlsPort = 0;
  d->family = AF_UNSPEC;
  d->exchangeDeadline = -1;
  p->id = kPluginId;
  p->data = d;
  p->fcopy = NULL;
  p->fdelete = DeletePlugin;
  s->fopen = Open;
  s->fclose = Close;
  s->fposthdr = PostHeader;
  s->fsend = Send;
  s->frecv = Recv;
  return SOAP_OK;
}

// ---- The no-signal socket BIO ----------------------------------------------------------------

int NoSignalWrite(BIO* b, const char* data, int len) {
  int fd = -1;
  BIO_get_fd(b, &fd);
  errno = 0;
  int r = static_cast<int>(send(fd, data, len, kNoSignal));
  BIO_clear_retry_flags(b);
  if (r <= 0 && BIO_sock_should_retry(r)) BIO_set_retry_write(b);
  return r;
}

int NoSignalPuts(BIO* b, const char* text) { return NoSignalWrite(b, text, static_cast<int>(strlen(text))); }

BIO_METHOD* NewNoSignalMethod() {
  const BIO_METHOD* sock = BIO_s_socket();
  BIO_METHOD* m = BIO_meth_new(BIO_TYPE_SOCKET, "socket without SIGPIPE");
  if (m) {
    BIO_meth_set_write(m, NoSignalWrite);
    BIO_meth_set_puts(m, NoSignalPuts);
    BIO_meth_set_read(m, BIO_meth_get_read(sock));
    BIO_meth_set_ctrl(m, BIO_meth_get_ctrl(sock));
    BIO_meth_set_create(m, BIO_meth_get_create(sock));
    BIO_meth_set_destroy(m, BIO_meth_get_destroy(sock));
  }
  return m;
}

// One method for the process, freed when the library is unloaded (a launcher may unload it and
// go on).
BIO_METHOD* NoSignalMethod() {
  static const struct Holder {
    BIO_METHOD* method;
    ~Holder() { BIO_meth_free(method); }
  } s_Holder{NewNoSignalMethod()};
  return s_Holder.method;
}

}  // namespace

BIO* VLSoapTransport::NewSocketBIO(int fd) {
  BIO_METHOD* method = NoSignalMethod();
  BIO* bio = method ? BIO_new(method) : NULL;
  if (bio) BIO_set_fd(bio, fd, BIO_NOCLOSE);
  return bio;
}

int VLSoapTransport::Install(soap* s) {
  soap_init_vl_log();
  AutoSSL::InitOpenSSL();
  SetTimeouts(s, VL_WS_SetupParams2::kDefaultSendTimeout, VL_WS_SetupParams2::kDefaultRecvTimeout);
  s->socket_flags = kNoSignal;
  return soap_register_plugin_arg(s, Plugin, NULL);
}

void VLSoapTransport::SetNextFamily(soap* s, int family) { Data(s)->family = family; }

void VLSoapTransport::SetTimeouts(soap* s, int sendTimeout, int recvTimeout) {
  s->send_timeout = sendTimeout;
  s->connect_timeout = sendTimeout;
  s->recv_timeout = recvTimeout;
}

void VLSoapTransport::SetUserAgent(soap* s, const char* userAgent) { Data(s)->userAgent = userAgent; }
