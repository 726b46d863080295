#include "VLTestServer.h"

#include <arpa/inet.h>
#include <netinet/in.h>
#include <poll.h>
#include <stdlib.h>
#include <string.h>
#include <strings.h>
#include <sys/socket.h>
#include <unistd.h>

#include <gtest/gtest.h>

#include <algorithm>
#include <chrono>

#include <openssl/err.h>
#include <openssl/ssl.h>

#include "VLSimServer.h"
#include "VLSoapTransport.h"
#include "VLStoreHosts.h"

VLTestPKI::VLTestPKI() {
  std::vector<std::string> names = {"localhost", "127.0.0.1"};
  for (const char* const* host = VLSimServer::Hosts(); *host; ++host) names.push_back(*host);
  std::string error;
  if (!m_Certificates.Create(names, &error)) abort();
  m_CA = {m_Certificates.CACertificate(), nullptr};
  m_Trusted = {m_Certificates.Certificate(VLSimCertificates::kGood), m_Certificates.PrivateKey(VLSimCertificates::kGood)};
  m_SelfSigned = {m_Certificates.Certificate(VLSimCertificates::kSelfSigned),
                  m_Certificates.PrivateKey(VLSimCertificates::kSelfSigned)};
  m_OtherHost = {m_Certificates.Certificate(VLSimCertificates::kWrongHost),
                 m_Certificates.PrivateKey(VLSimCertificates::kWrongHost)};
  char path[] = "/tmp/vl-test-ca-XXXXXX";
  int fd = mkstemp(path);
  close(fd);
  if (!m_Certificates.WriteCA(path, &error)) abort();
  m_CAFile = path;
  setenv("SSL_CERT_FILE", path, 1);
}

VLTestPKI& VLTestPKI::Get() {
  // Never destroyed: the CA file is removed at exit, the objects live as long as the process.
  static VLTestPKI* s_PKI = [] {
    VLTestPKI* pki = new VLTestPKI();
    static std::string s_File = pki->m_CAFile;
    atexit([] { unlink(s_File.c_str()); });
    return pki;
  }();
  return *s_PKI;
}

VLTestServer::VLTestServer(const VLTestPKI::Cert* cert) : m_Ctx(nullptr), m_Stop(false), m_Behaviour(kReply) {
  m_Listen = socket(AF_INET, SOCK_STREAM | SOCK_CLOEXEC, 0);
  sockaddr_in addr;
  memset(&addr, 0, sizeof(addr));
  addr.sin_family = AF_INET;
  addr.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
  bind(m_Listen, reinterpret_cast<sockaddr*>(&addr), sizeof(addr));
  listen(m_Listen, 16);
  socklen_t len = sizeof(addr);
  getsockname(m_Listen, reinterpret_cast<sockaddr*>(&addr), &len);
  m_Port = ntohs(addr.sin_port);
  if (cert) {
    SSL_CTX* ctx = SSL_CTX_new(TLS_server_method());
    SSL_CTX_use_certificate(ctx, cert->cert);
    SSL_CTX_use_PrivateKey(ctx, cert->key);
    m_Ctx = ctx;
  }
  m_Thread = std::thread([this] { Serve(); });
}

VLTestServer::~VLTestServer() {
  m_Stop = true;
  m_Thread.join();
  close(m_Listen);
  SSL_CTX_free(static_cast<SSL_CTX*>(m_Ctx));
}

void VLTestServer::SetReply(const std::string& reply) {
  std::lock_guard<std::mutex> lock(m_Mutex);
  m_Reply = reply;
}

void VLTestServer::SetBehaviour(Behaviour b) {
  std::lock_guard<std::mutex> lock(m_Mutex);
  m_Behaviour = b;
}

std::vector<std::string> VLTestServer::Requests() {
  std::lock_guard<std::mutex> lock(m_Mutex);
  return m_Requests;
}

bool VLTestServer::WaitFor(size_t n) {
  std::unique_lock<std::mutex> lock(m_Mutex);
  return m_Cond.wait_for(lock, std::chrono::seconds(5), [&] { return m_Requests.size() >= n; });
}

void VLTestServer::Serve() {
  while (!m_Stop) {
    pollfd p = {m_Listen, POLLIN, 0};
    if (poll(&p, 1, 50) <= 0) continue;
    int fd = accept4(m_Listen, NULL, NULL, SOCK_CLOEXEC);
    if (fd < 0) continue;
    timeval tv = {5, 0};
    setsockopt(fd, SOL_SOCKET, SO_RCVTIMEO, &tv, sizeof(tv));
    setsockopt(fd, SOL_SOCKET, SO_SNDTIMEO, &tv, sizeof(tv));
    Handle(fd);
    close(fd);
  }
}

void VLTestServer::Handle(int fd) {
  Behaviour behaviour;
  std::string reply;
  {
    std::lock_guard<std::mutex> lock(m_Mutex);
    behaviour = m_Behaviour;
    reply = m_Reply;
  }
  SSL* ssl = nullptr;
  if (m_Ctx) {
    ssl = SSL_new(static_cast<SSL_CTX*>(m_Ctx));
    BIO* bio = VLSoapTransport::NewSocketBIO(fd);
    SSL_set_bio(ssl, bio, bio);
    if (SSL_accept(ssl) != 1) {  // the client refused the certificate
      SSL_free(ssl);
      ERR_clear_error();
      return;
    }
  }
  auto readSome = [&](char* buf, int n) { return ssl ? SSL_read(ssl, buf, n) : static_cast<int>(recv(fd, buf, n, 0)); };
  if (behaviour == kCloseAtOnce) {
    linger l = {1, 0};  // reset: the client's next write fails at once
    setsockopt(fd, SOL_SOCKET, SO_LINGER, &l, sizeof(l));
    SSL_free(ssl);
    std::lock_guard<std::mutex> lock(m_Mutex);
    m_Requests.push_back("");
    m_Cond.notify_all();
    return;
  }
  std::string request;
  size_t need = std::string::npos;
  char buf[16384];
  while (request.size() < need) {
    int r = readSome(buf, sizeof(buf));
    if (r <= 0) break;
    request.append(buf, r);
    size_t end = request.find("\r\n\r\n");
    if (end != std::string::npos && need == std::string::npos) {
      std::string length = Header(request, "Content-Length");
      need = end + 4 + (length.empty() ? 0 : strtoul(length.c_str(), NULL, 10));
    }
  }
  {
    std::lock_guard<std::mutex> lock(m_Mutex);
    m_Requests.push_back(request);
    m_Cond.notify_all();
  }
  if (behaviour == kHang) {
    while (!m_Stop) {
      pollfd p = {fd, POLLIN, 0};
      if (poll(&p, 1, 50) > 0 && readSome(buf, sizeof(buf)) <= 0) break;
    }
  } else {
    size_t piece = behaviour == kPieces ? 8 : reply.size();
    for (size_t at = 0; at < reply.size(); at += piece) {
      if (at > 0) std::this_thread::sleep_for(std::chrono::milliseconds(2));
      size_t n = std::min(piece, reply.size() - at);
      if (ssl ? SSL_write(ssl, reply.data() + at, static_cast<int>(n)) <= 0
              : send(fd, reply.data() + at, n, MSG_NOSIGNAL) < 0)
        break;
    }
    if (ssl) SSL_shutdown(ssl);
  }
  SSL_free(ssl);
  ERR_clear_error();
}

std::string VLTestServer::Head(const std::string& request) {
  size_t end = request.find("\r\n\r\n");
  return end == std::string::npos ? request : request.substr(0, end + 4);
}

std::string VLTestServer::Body(const std::string& request) {
  size_t end = request.find("\r\n\r\n");
  return end == std::string::npos ? "" : request.substr(end + 4);
}

std::string VLTestServer::Header(const std::string& request, const std::string& name) {
  std::string head = Head(request), key = "\r\n" + name + ":";
  for (size_t p = head.find("\r\n"); p != std::string::npos; p = head.find("\r\n", p + 2)) {
    if (strncasecmp(head.c_str() + p, key.c_str(), key.size()) != 0) continue;
    size_t start = head.find_first_not_of(' ', p + key.size());
    return head.substr(start, head.find("\r\n", start) - start);
  }
  return "";
}

std::string VLTestServer::HttpReply(const std::string& body, const std::string& status, const std::string& extraHeaders) {
  return "HTTP/1.1 " + status + "\r\nContent-Type: text/xml; charset=utf-8\r\nContent-Length: " +
         std::to_string(body.size()) + "\r\n" + extraHeaders + "Connection: close\r\n\r\n" + body;
}

std::string VLTestServer::Envelope(const std::string& bodyContent) {
  return "<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n"
         "<SOAP-ENV:Envelope xmlns:SOAP-ENV=\"http://schemas.xmlsoap.org/soap/envelope/\" "
         "xmlns:VL1=\"" VL_API_NAMESPACE "\"><SOAP-ENV:Body>" +
         bodyContent + "</SOAP-ENV:Body></SOAP-ENV:Envelope>";
}

void VLTestFillParams(VL_WS_SetupParams2* params, const std::string& serviceBaseURL) {
  params->APIKey = "key";
  params->DestinationUniqueID = "00-11-22-33-44-55";
  params->DestinationTypeID = 7;
  params->UserName = "user";
  params->Password = "secret";
  params->ServiceBaseURL = serviceBaseURL.c_str();
  params->SendTimeout = 5;
  params->RecvTimeout = 5;
}

int VLClosedPort() {
  int fd = socket(AF_INET, SOCK_STREAM | SOCK_CLOEXEC, 0);
  sockaddr_in addr;
  memset(&addr, 0, sizeof(addr));
  addr.sin_family = AF_INET;
  addr.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
  bind(fd, reinterpret_cast<sockaddr*>(&addr), sizeof(addr));
  socklen_t len = sizeof(addr);
  getsockname(fd, reinterpret_cast<sockaddr*>(&addr), &len);
  close(fd);
  return ntohs(addr.sin_port);
}

VLTestServer& VLStandInServer(const char* host, int port, const VLTestPKI::Cert* cert) {
  static VLTestServer& s_Server = *new VLTestServer(cert);
  static const bool s_Mapped = [&] {
    std::string map = std::string(host) + ":" + std::to_string(port) + ":127.0.0.1:" + std::to_string(s_Server.Port());
    return setenv("VLWS_CONNECT_TO", map.c_str(), 1) == 0;
  }();
  EXPECT_TRUE(s_Mapped);
  return s_Server;
}
