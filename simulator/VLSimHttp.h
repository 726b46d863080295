// VLSimHttp: one HTTP/1.1 exchange on an accepted connection, plain or TLS, written by hand so
// that every byte of an answer can be shaped by a fault (VLSimFaults.h).
//
// The simulator answers one request per connection and closes it, as the store client expects
// (it sends no keep-alive and reads until the announced length or the end of the connection).
// Answers carry an exact "HTTP/1.1 <status> <reason>\r\n" status line and a "Content-Length: "
// header, never chunking: the client's hand-written parsers look for exactly those texts.
#ifndef VLSIMHTTP_H
#define VLSIMHTTP_H

#include <openssl/ssl.h>

#include <condition_variable>
#include <functional>
#include <mutex>
#include <string>
#include <utility>
#include <vector>

#include "VLSimFaults.h"

using VLSimHeaders = std::vector<std::pair<std::string, std::string>>;

struct VLSimHttpRequest {
  std::string method;
  std::string target;  // as sent: path and query
  std::string path;    // without the query, percent-encoding kept
  std::string query;   // after "?", or empty
  VLSimHeaders headers;
  std::string body;

  // The value of the first header of that name (any letter case), or "".
  std::string Header(const std::string& name) const;
  // Host header without a port, in lower case.
  std::string Host() const;
};

struct VLSimHttpResponse {
  int status = 200;
  VLSimHeaders headers;  // besides Content-Length and Connection, which the sender writes
  std::string body;

  // A short HTML page for status, as a web server would send with an error.
  static VLSimHttpResponse Page(int status, const std::string& text);
  static const char* Reason(int status);
};

// Lets the server's waits (delays, trickles, held answers) end as soon as it is stopped.
class VLSimStopSignal {
 public:
  void Stop();
  bool Stopped();
  // Sleeps up to milliseconds; false when the server stopped first.
  bool Sleep(int milliseconds);

 private:
  std::mutex m_Mutex;
  std::condition_variable m_Changed;
  bool m_Stopped = false;
};

// An accepted connection; owns the socket and the TLS session (null for plain HTTP).
class VLSimConnection {
 public:
  VLSimConnection(int fd, SSL* ssl) : m_Fd(fd), m_Ssl(ssl) {}
  ~VLSimConnection();
  VLSimConnection(const VLSimConnection&) = delete;
  VLSimConnection& operator=(const VLSimConnection&) = delete;

  bool IsTLS() const { return m_Ssl != nullptr; }
  // The host name the client asked for in the TLS handshake (SNI), or "".
  std::string ServerName() const;

  // Reads one request: the head (at most 64 KiB) and a body of Content-Length bytes (at most
  // 8 MiB). False when the peer closed or timed out (error empty) or sent no valid request.
  bool ReadRequest(VLSimHttpRequest* request, std::string* error);
  // Sends the whole text; false when the peer is gone.
  bool Write(const std::string& bytes);
  // Ends the exchange. A graceful close sends the TLS close_notify, shuts down the sending side
  // and reads what the peer still sends for a moment, so the peer reads the whole answer before
  // the socket goes; an abrupt one shuts the socket down at once (no close_notify). The socket
  // itself is closed by the destructor, so its number stays taken while the owner still knows it.
  void Close(bool graceful);

 private:
  int Receive(char* buffer, int size);

  int m_Fd;
  SSL* m_Ssl;
  bool m_Closed = false;
  std::string m_Pending;  // bytes received beyond the current request's head
};

// Sends response on connection, shaped by the transport faults among faults (delay, close, cut,
// status, malformed, truncated, gzip, deflate, badlength, trickle). answering is called with the
// status just before the first byte of an answer goes out (not when a fault sends none): a client
// reads no further than Content-Length and may be on to its next request before the connection
// ends, so what answering records must be there when the client has the answer. The caller closes
// the connection afterwards: abruptly when abrupt is set, else gracefully.
struct VLSimSent {
  int status = 0;  // the HTTP status sent, 0 when nothing was sent
  bool abrupt = false;
};
VLSimSent VLSimSendResponse(VLSimConnection& connection, VLSimHttpResponse response,
                            const std::vector<VLSimFault>& faults, VLSimStopSignal& stop,
                            const std::function<void(int status)>& answering);

// Percent-decoding of a URL path or query component ("%20" and "+" in queries).
std::string VLSimURLDecode(const std::string& text, bool plusIsSpace);

#endif  // VLSIMHTTP_H
