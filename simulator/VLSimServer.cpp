#include "VLSimServer.h"

#include <arpa/inet.h>
#include <errno.h>
#include <fcntl.h>
#include <ftw.h>
#include <netinet/in.h>
#include <openssl/err.h>
#include <poll.h>
#include <signal.h>
#include <stdlib.h>
#include <sys/socket.h>
#include <unistd.h>

#include <atomic>
#include <cstdio>
#include <cstring>
#include <iostream>
#include <list>
#include <set>
#include <thread>

#include "VLSimCertificates.h"
#include "VLSimContext.h"
#include "VLStoreHosts.h"

#ifndef VL_SIM_DATA_FOLDER
#define VL_SIM_DATA_FOLDER "simulator/data"
#endif

namespace {

const char* const kHosts[] = {VL_STORE_PRODUCTION_HOST, VL_STORE_STAGING_HOST,
                              VL_STORE_STAGING_API_HOST, VL_STORE_ADULT_PRODUCTION_HOST,
                              VL_STORE_ADULT_STAGING_HOST, VL_STORE_IMAGE_HOST, nullptr};

const int kIOTimeoutSeconds = 30;

int RemoveEntry(const char* path, const struct stat*, int, struct FTW*) { return remove(path); }

// OpenSSL writes to a closed peer with write(), which raises SIGPIPE. The server's threads block
// the signal for themselves instead of changing the process's disposition (tests run the
// simulator inside their own process); a pending SIGPIPE is consumed before the thread ends.
void BlockSigpipe() {
  sigset_t set;
  sigemptyset(&set);
  sigaddset(&set, SIGPIPE);
  pthread_sigmask(SIG_BLOCK, &set, nullptr);
}

void ConsumeSigpipe() {
  sigset_t set;
  sigemptyset(&set);
  sigaddset(&set, SIGPIPE);
  struct timespec zero = {0, 0};
  while (sigtimedwait(&set, nullptr, &zero) > 0) {
  }
}

}  // namespace

struct VLSimServer::Impl {
  VLSimContext context;
  VLSimCertificates certificates;
  SSL_CTX* tlsContexts[VLSimCertificates::kKindCount] = {};
  std::string caFile;
  std::string tempFolder;
  bool addressInUse = false;
  bool running = false;

  int listeners[2] = {-1, -1};  // TLS, plain
  int ports[2] = {0, 0};
  int wakePipe[2] = {-1, -1};
  std::thread acceptors[2];

  struct Worker {
    std::thread thread;
    std::shared_ptr<std::atomic<bool>> done;
  };
  std::mutex workersMutex;
  std::list<Worker> workers;
  std::set<int> openSockets;
  std::atomic<int> connections{0};

  bool Listen(int which, int port, std::string* error);
  bool MakeTlsContexts(std::string* error);
  void AcceptLoop(int which);
  void Serve(int fd, bool tls, int number);
  void ReapWorkers(bool all);
  static int ClientHelloCallback(SSL* ssl, int* alert, void* arg);
  static SSL_TICKET_RETURN TicketCallback(SSL* ssl, SSL_SESSION* session, const unsigned char* keyName,
                                          size_t keyNameLength, SSL_TICKET_STATUS status, void* arg);
};

VLSimServer::VLSimServer(const VLSimOptions& options) : m_Impl(new Impl) {
  m_Impl->context.options = options;
  if (m_Impl->context.options.dataFolder.empty()) m_Impl->context.options.dataFolder = VL_SIM_DATA_FOLDER;
}

VLSimServer::~VLSimServer() { Stop(); }

const char* const* VLSimServer::Hosts() { return kHosts; }

bool VLSimServer::Impl::Listen(int which, int port, std::string* error) {
  const std::string& address = context.options.bindAddress;
  struct sockaddr_in sin = {};
  sin.sin_family = AF_INET;
  sin.sin_port = htons(static_cast<uint16_t>(port));
  if (inet_pton(AF_INET, address.c_str(), &sin.sin_addr) != 1) {
    *error = "bad bind address \"" + address + "\" (an IPv4 address is needed)";
    return false;
  }
  int fd = socket(AF_INET, SOCK_STREAM | SOCK_CLOEXEC, 0);
  int one = 1;
  if (fd < 0 || setsockopt(fd, SOL_SOCKET, SO_REUSEADDR, &one, sizeof one) != 0 ||
      bind(fd, reinterpret_cast<struct sockaddr*>(&sin), sizeof sin) != 0 || listen(fd, 64) != 0) {
    int code = errno;
    if (fd >= 0) close(fd);
    addressInUse = code == EADDRINUSE;
    *error = "cannot listen on " + address + ":" + std::to_string(port) + ": " +
             (addressInUse ? std::string("the port is in use") : std::string(strerror(code)));
    return false;
  }
  socklen_t length = sizeof sin;
  getsockname(fd, reinterpret_cast<struct sockaddr*>(&sin), &length);
  listeners[which] = fd;
  ports[which] = ntohs(sin.sin_port);
  return true;
}

namespace {

// The host name of the ClientHello's server_name extension, or "".
std::string ClientHelloServerName(SSL* ssl) {
  const unsigned char* p = nullptr;
  size_t length = 0;
  // A list of (type, 2-byte length, name) behind its own 2-byte length; clients send one name.
  if (!SSL_client_hello_get0_ext(ssl, TLSEXT_TYPE_server_name, &p, &length) || length < 5 ||
      p[2] != TLSEXT_NAMETYPE_host_name)
    return "";
  size_t nameLength = static_cast<size_t>(p[3]) << 8 | p[4];
  return nameLength <= length - 5 ? std::string(reinterpret_cast<const char*>(p) + 5, nameLength) : "";
}

}  // namespace

// A TLS fault is taken as the ClientHello arrives, before a session ticket in it is looked at:
// the connection then presents the fault's certificate.
int VLSimServer::Impl::ClientHelloCallback(SSL* ssl, int*, void* arg) {
  Impl* impl = static_cast<Impl*>(arg);
  VLSimFault fault;
  if (impl->context.faults.TakeTls(ClientHelloServerName(ssl), &fault)) {
    SSL_set_SSL_CTX(ssl, impl->tlsContexts[VLSimCertificates::Parse(fault.text)]);
    SSL_set_app_data(ssl, const_cast<char*>(VLSimCertificates::Name(VLSimCertificates::Parse(fault.text))));
  }
  return SSL_CLIENT_HELLO_SUCCESS;
}

// Sessions are resumed from the tickets the server issues (OpenSSL's defaults), except on a
// connection with a TLS fault: resumed, it would send no certificate at all, and a client must
// see the fault's certificate to refuse it.
SSL_TICKET_RETURN VLSimServer::Impl::TicketCallback(SSL* ssl, SSL_SESSION*, const unsigned char*, size_t,
                                                    SSL_TICKET_STATUS status, void*) {
  if (SSL_get_app_data(ssl)) return SSL_TICKET_RETURN_IGNORE;
  switch (status) {
    case SSL_TICKET_SUCCESS:
      return SSL_TICKET_RETURN_USE;
    case SSL_TICKET_SUCCESS_RENEW:
      return SSL_TICKET_RETURN_USE_RENEW;
    case SSL_TICKET_FATAL_ERR_MALLOC:
    case SSL_TICKET_FATAL_ERR_OTHER:
      return SSL_TICKET_RETURN_ABORT;
    default:  // no ticket, an empty one, or one that does not decrypt
      return SSL_TICKET_RETURN_IGNORE_RENEW;
  }
}

bool VLSimServer::Impl::MakeTlsContexts(std::string* error) {
  for (int kind = 0; kind < VLSimCertificates::kKindCount; ++kind) {
    SSL_CTX* ctx = SSL_CTX_new(TLS_server_method());
    tlsContexts[kind] = ctx;
    auto k = static_cast<VLSimCertificates::Kind>(kind);
    if (!ctx || !SSL_CTX_set_min_proto_version(ctx, TLS1_2_VERSION) ||
        SSL_CTX_use_certificate(ctx, certificates.Certificate(k)) != 1 ||
        SSL_CTX_use_PrivateKey(ctx, certificates.PrivateKey(k)) != 1) {
      *error = "cannot set up the TLS server context";
      ERR_clear_error();
      return false;
    }
    SSL_CTX_set_client_hello_cb(ctx, ClientHelloCallback, this);
    SSL_CTX_set_session_ticket_cb(ctx, nullptr, TicketCallback, nullptr);
  }
  return true;
}

bool VLSimServer::Start(std::string* error) {
  Impl& impl = *m_Impl;
  if (impl.running) return true;
  impl.addressInUse = false;
  VLSimOptions& options = impl.context.options;
  if (!impl.context.catalogue.Load(options.dataFolder, error)) {
    *error = "cannot load the sample store from " + options.dataFolder + ": " + *error;
    return false;
  }
  impl.context.store.reset(new VLSimStore(impl.context.catalogue));
  for (const std::string& spec : options.faults)
    if (!AddFault(spec, error)) return false;

  std::vector<std::string> hosts(kHosts, kHosts + 6);
  std::string folder = options.certFolder;
  if (folder.empty()) {
    const char* tmp = getenv("TMPDIR");
    std::string pattern = std::string(tmp && *tmp ? tmp : "/tmp") + "/vlstore-sim.XXXXXX";
    if (!mkdtemp(&pattern[0])) {
      *error = "cannot create a temporary folder for the certificates";
      return false;
    }
    impl.tempFolder = folder = pattern;
  }
  impl.caFile = folder + "/ca.pem";
  if (!impl.certificates.Create(hosts, error) || !impl.certificates.WriteCA(impl.caFile, error) ||
      !impl.MakeTlsContexts(error) || !impl.Listen(0, options.tlsPort, error) ||
      !impl.Listen(1, options.httpPort, error) || pipe2(impl.wakePipe, O_CLOEXEC) != 0) {
    Stop();
    return false;
  }
  impl.running = true;
  for (int which = 0; which < 2; ++which) impl.acceptors[which] = std::thread(&Impl::AcceptLoop, &impl, which);
  return true;
}

void VLSimServer::Stop() {
  Impl& impl = *m_Impl;
  impl.context.stop.Stop();
  if (impl.wakePipe[1] >= 0) {
    char byte = 0;
    ssize_t ignored = write(impl.wakePipe[1], &byte, 1);
    (void)ignored;
  }
  for (std::thread& acceptor : impl.acceptors)
    if (acceptor.joinable()) acceptor.join();
  {
    std::lock_guard<std::mutex> lock(impl.workersMutex);
    for (int fd : impl.openSockets) shutdown(fd, SHUT_RDWR);
  }
  impl.ReapWorkers(true);
  for (int& fd : impl.listeners) {
    if (fd >= 0) close(fd);
    fd = -1;
  }
  for (int& fd : impl.wakePipe) {
    if (fd >= 0) close(fd);
    fd = -1;
  }
  for (SSL_CTX*& ctx : impl.tlsContexts) {
    SSL_CTX_free(ctx);
    ctx = nullptr;
  }
  if (!impl.tempFolder.empty()) nftw(impl.tempFolder.c_str(), RemoveEntry, 8, FTW_DEPTH | FTW_PHYS);
  impl.tempFolder.clear();
  impl.running = false;
}

void VLSimServer::Impl::ReapWorkers(bool all) {
  std::list<Worker> finished;
  {
    std::lock_guard<std::mutex> lock(workersMutex);
    for (auto it = workers.begin(); it != workers.end();) {
      if (all || it->done->load()) {
        finished.push_back(std::move(*it));
        it = workers.erase(it);
      } else {
        ++it;
      }
    }
  }
  for (Worker& worker : finished) worker.thread.join();
}

void VLSimServer::Impl::AcceptLoop(int which) {
  BlockSigpipe();
  for (;;) {
    struct pollfd fds[2] = {{listeners[which], POLLIN, 0}, {wakePipe[0], POLLIN, 0}};
    if (poll(fds, 2, -1) < 0 && errno != EINTR) break;
    if (fds[1].revents || context.stop.Stopped()) break;
    if (!(fds[0].revents & POLLIN)) continue;
    int fd = accept4(listeners[which], nullptr, nullptr, SOCK_CLOEXEC);
    if (fd < 0) continue;
    ReapWorkers(false);
    struct timeval timeout = {kIOTimeoutSeconds, 0};
    setsockopt(fd, SOL_SOCKET, SO_RCVTIMEO, &timeout, sizeof timeout);
    setsockopt(fd, SOL_SOCKET, SO_SNDTIMEO, &timeout, sizeof timeout);
    std::lock_guard<std::mutex> lock(workersMutex);
    if (context.stop.Stopped()) {
      close(fd);
      break;
    }
    openSockets.insert(fd);
    Worker worker;
    worker.done = std::make_shared<std::atomic<bool>>(false);
    auto done = worker.done;
    int number = ++connections;
    worker.thread = std::thread([this, fd, which, number, done] {
      Serve(fd, which == 0, number);
      done->store(true);
    });
    workers.push_back(std::move(worker));
  }
}

void VLSimServer::Impl::Serve(int fd, bool tls, int number) {
  BlockSigpipe();
  SSL* ssl = nullptr;
  if (tls) {
    ssl = SSL_new(tlsContexts[VLSimCertificates::kGood]);
    if (ssl) SSL_set_fd(ssl, fd);
  }
  {
    VLSimConnection connection(fd, ssl);
    VLSimRequest entry;
    entry.connection = number;
    entry.tls = tls;
    // The entry goes into the log before the answer goes out (or, when none does, before the
    // connection ends), so a client that has its answer finds the entry there.
    auto record = [this, &entry] {
      context.log.Add(entry);
      if (context.options.printRequests) std::cout << VLSimRequestLog::Format(entry) << std::endl;
    };
    bool ready = !tls || (ssl && SSL_accept(ssl) == 1);
    if (tls) {
      entry.serverName = connection.ServerName();
      const char* certificate = ssl ? static_cast<const char*>(SSL_get_app_data(ssl)) : nullptr;
      if (certificate) entry.faults = "tls:" + std::string(certificate);
      entry.resumed = ready && SSL_session_reused(ssl);
      ERR_clear_error();
    }
    VLSimHttpRequest request;
    std::string problem;
    bool graceful = ready;
    if (!ready) {
      entry.note = "TLS handshake failed";
      record();
    } else if (connection.ReadRequest(&request, &problem) || !problem.empty()) {
      entry.host = request.Host();
      entry.method = request.method;
      entry.path = request.path;
      entry.query = request.query;
      entry.userAgent = request.Header("User-Agent");
      entry.ifModifiedSince = request.Header("If-Modified-Since");
      entry.acceptEncoding = request.Header("Accept-Encoding");
      std::vector<VLSimFault> faults;
      VLSimHttpResponse response = problem.empty() ? VLSimHandleRequest(context, request, tls, &entry, &faults)
                                                   : VLSimHttpResponse::Page(400, problem);
      if (!problem.empty()) entry.note = problem;
      for (const VLSimFault& fault : faults) entry.faults += (entry.faults.empty() ? "" : " ") + fault.ToString();
      bool recorded = false;
      VLSimSent sent = VLSimSendResponse(connection, response, faults, context.stop, [&](int status) {
        entry.status = status;
        record();
        recorded = true;
      });
      graceful = !sent.abrupt;
      if (!recorded) record();
    }
    connection.Close(graceful);
    // Forget the socket before the connection's destructor closes it and its number is reused.
    std::lock_guard<std::mutex> lock(workersMutex);
    openSockets.erase(fd);
  }
  ERR_clear_error();
  ConsumeSigpipe();
}

bool VLSimServer::AddressInUse() const { return m_Impl->addressInUse; }
int VLSimServer::TlsPort() const { return m_Impl->ports[0]; }
int VLSimServer::HttpPort() const { return m_Impl->ports[1]; }
const std::string& VLSimServer::CAFile() const { return m_Impl->caFile; }
const VLSimOptions& VLSimServer::Options() const { return m_Impl->context.options; }
VLSimStore& VLSimServer::Store() { return *m_Impl->context.store; }
const VLSimCatalogue& VLSimServer::Catalogue() const { return m_Impl->context.catalogue; }
std::vector<VLSimRequest> VLSimServer::Requests() { return m_Impl->context.log.Entries(); }
void VLSimServer::ClearRequests() { m_Impl->context.log.Clear(); }
bool VLSimServer::WaitForRequests(size_t count, int milliseconds) {
  return m_Impl->context.log.WaitFor(count, milliseconds);
}
void VLSimServer::AddFault(const VLSimFault& fault) { m_Impl->context.faults.Add(fault); }
void VLSimServer::ClearFaults() { m_Impl->context.faults.Clear(); }

bool VLSimServer::AddFault(const std::string& spec, std::string* error) {
  VLSimFault fault;
  if (!VLSimFault::Parse(spec, &fault, error)) return false;
  AddFault(fault);
  return true;
}

std::string VLSimServer::ConnectTo() const {
  const std::string& address = m_Impl->context.options.bindAddress;
  std::string value;
  for (const char* const* host = kHosts; *host; ++host) {
    if (!value.empty()) value += ",";
    value += std::string(*host) + ":443:" + address + ":" + std::to_string(TlsPort()) + "," + *host + ":80:" +
             address + ":" + std::to_string(HttpPort());
  }
  return value;
}

std::string VLSimServer::EnvironmentSettings() const {
  return "export SSL_CERT_FILE=" + CAFile() + "\nexport VLWS_CONNECT_TO=" + ConnectTo() + "\n";
}
