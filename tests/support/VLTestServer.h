// Test-only loopback servers for the SOAP layer: a TCP or TLS server on 127.0.0.1 that captures
// each request (headers and Content-Length body) and plays a canned reply, and the test PKI
// (a CA and server certificates made with the OpenSSL API at test time).
#ifndef VLTESTSERVER_H
#define VLTESTSERVER_H

#include "VLSimCertificates.h"
#include "VL_WS_SetupParams2.h"

#include <openssl/evp.h>
#include <openssl/x509.h>

#include <atomic>
#include <condition_variable>
#include <mutex>
#include <string>
#include <thread>
#include <vector>

// Certificates for the loopback servers, made once per process by the store simulator's PKI
// (simulator/VLSimCertificates.h). The CA is written to a PEM file and named in SSL_CERT_FILE,
// which the library's TLS set-up reads (OpenSSL's default verify paths), so Trusted() verifies.
// Common names never match a host name: the checks must pass or fail on the subjectAltNames.
class VLTestPKI {
 public:
  struct Cert {
    X509* cert;
    EVP_PKEY* key;
  };
  static VLTestPKI& Get();

  // Signed by the test CA for localhost, 127.0.0.1 and every store host.
  const Cert& Trusted() const { return m_Trusted; }
  // Self-signed, for the same names.
  const Cert& SelfSigned() const { return m_SelfSigned; }
  // Signed by the test CA for another host only ("wrong-host.invalid").
  const Cert& OtherHost() const { return m_OtherHost; }

 private:
  VLTestPKI();
  VLSimCertificates m_Certificates;
  Cert m_CA, m_Trusted, m_SelfSigned, m_OtherHost;
  std::string m_CAFile;
};

class VLTestServer {
 public:
  // What the server does with a connection.
  enum Behaviour {
    kReply,          // read the request, send the reply, close
    kHang,           // read the request and never answer (until the client leaves or Stop)
    kCloseAtOnce,    // close (with a reset) right after accepting / the TLS handshake
    kPieces,         // as kReply, but send the reply in pieces of 8 bytes, 2 ms apart, so that
                     // the client receives it in many reads, its header included
  };

  // A plain TCP server, or a TLS server with cert.
  explicit VLTestServer(const VLTestPKI::Cert* cert = nullptr);
  ~VLTestServer();

  int Port() const { return m_Port; }
  void SetReply(const std::string& reply);
  void SetBehaviour(Behaviour b);

  // The requests received so far, raw (request line, headers, blank line, body).
  std::vector<std::string> Requests();
  // Waits up to 5 s until n requests (or connections, for kCloseAtOnce) arrived.
  bool WaitFor(size_t n);

  // Parts of a captured request.
  static std::string Head(const std::string& request);  // up to and including the blank line
  static std::string Body(const std::string& request);
  // The value of header name (first occurrence), "" when absent.
  static std::string Header(const std::string& request, const std::string& name);

  // An HTTP reply with the body; Content-Type text/xml, Content-Length, extra headers as given.
  static std::string HttpReply(const std::string& body, const std::string& status = "200 OK",
                               const std::string& extraHeaders = "");
  // A SOAP 1.1 envelope around body content, declaring SOAP-ENV and VL1.
  static std::string Envelope(const std::string& bodyContent);

 private:
  void Serve();
  void Handle(int fd);

  int m_Listen;
  int m_Port;
  void* m_Ctx;  // SSL_CTX*, null for plain
  std::thread m_Thread;
  std::atomic<bool> m_Stop;
  std::mutex m_Mutex;
  std::condition_variable m_Cond;
  std::string m_Reply;
  Behaviour m_Behaviour;
  std::vector<std::string> m_Requests;
};

// A loopback port on which nobody listens (bound once and released): connections to it fail.
int VLClosedPort();

// The program's one loopback server standing in for host:port (TLS with cert): VLWS_CONNECT_TO
// sends that host and port here. The library reads the variable once, at its first connection,
// so a program calls this before anything connects, and for one host and port only. Never
// destroyed: at exit its thread would outlive OpenSSL's clean-up.
VLTestServer& VLStandInServer(const char* host, int port, const VLTestPKI::Cert* cert = nullptr);

// Settings of a test client: key "key", device "00-11-22-33-44-55" of type 7, user "user" with
// password "secret", the given endpoint base (ending in "/"), short time-outs (5 s).
void VLTestFillParams(VL_WS_SetupParams2* params, const std::string& serviceBaseURL);

#endif  // VLTESTSERVER_H
