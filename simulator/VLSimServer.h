// VLSimServer: the store simulator — the three SOAP services and the plain HTTP endpoints of the
// store on loopback, over real TLS and TCP — as a library that tests start in-process on
// ephemeral ports, and that the program vlstore-sim runs in the foreground.
//
// Every logical store host (VLStoreHosts.h) is served on the two ports and recognised by
// the Host header: a client reaches them through the destination override ConnectTo() and
// trusts the simulator's own CA through CAFile() (the environment settings VLWS_CONNECT_TO and
// SSL_CERT_FILE). The TLS port serves the SOAP services under "/api/" (and "/aac/api/" on the
// staging API host) and the device-environment query; the plain port serves the server time,
// the box art and the bandwidth probe.
//
// Typical test use:
//   VLSimServer sim;
//   std::string error;
//   ASSERT_TRUE(sim.Start(&error)) << error;
//   sim.AddFault("getTitlesByNavigation=status:503,times=1", &error);
//   ... client calls with SSL_CERT_FILE=sim.CAFile(), VLWS_CONNECT_TO=sim.ConnectTo() ...
//   EXPECT_EQ(sim.Requests().back().authToken, "");
#ifndef VLSIMSERVER_H
#define VLSIMSERVER_H

#include <memory>
#include <string>
#include <vector>

#include "VLSimCatalogue.h"
#include "VLSimFaults.h"
#include "VLSimRequestLog.h"
#include "VLSimStore.h"

struct VLSimOptions {
  std::string dataFolder;    // the sample store; empty: the repository's simulator/data
  std::string certFolder;    // where ca.pem is written; empty: a temporary folder, removed at Stop
  std::string bindAddress = "127.0.0.1";
  int tlsPort = 0;           // 0: an ephemeral port
  int httpPort = 0;
  std::string userName = "vlsim-user";  // the WS-Security user name and password
  std::string password = "vlsim-password";
  std::string apiKey = "VLSIM-API-KEY";  // the API key of the device-settings block
  int clockSkewSeconds = 300;            // how far "wsu:Created" may be from the store's clock
  int returnTimeoutSeconds = 100;        // how long ReturnTimeout holds its answer
  int probeBytes = 1000000;              // size of the bandwidth probe file
  std::vector<std::string> faults;       // in the written form of VLSimFaults.h
  bool printRequests = false;            // one line per request on standard output
};

class VLSimServer {
 public:
  explicit VLSimServer(const VLSimOptions& options = VLSimOptions());
  ~VLSimServer();  // stops the server
  VLSimServer(const VLSimServer&) = delete;
  VLSimServer& operator=(const VLSimServer&) = delete;

  // Loads the data, makes the certificates, binds both ports and starts serving. False with a
  // message when something is wrong; AddressInUse() then tells whether a port was taken.
  bool Start(std::string* error);
  // Stops accepting, ends open connections (held answers included) and waits for every thread.
  void Stop();
  bool AddressInUse() const;

  int TlsPort() const;
  int HttpPort() const;
  const std::string& CAFile() const;
  // "host:443:ADDR:TLSPORT,host:80:ADDR:HTTPPORT,..." for every logical host.
  std::string ConnectTo() const;
  // The two lines a shell needs: export SSL_CERT_FILE=... and export VLWS_CONNECT_TO=...
  std::string EnvironmentSettings() const;
  const VLSimOptions& Options() const;

  VLSimStore& Store();
  const VLSimCatalogue& Catalogue() const;

  // The request log. An entry is complete before the client sees the end of its answer, except
  // for a refused TLS handshake, which the client may notice first: WaitForRequests waits until
  // the log holds count entries (false after milliseconds).
  std::vector<VLSimRequest> Requests();
  void ClearRequests();
  bool WaitForRequests(size_t count, int milliseconds);

  bool AddFault(const std::string& spec, std::string* error);
  void AddFault(const VLSimFault& fault);
  void ClearFaults();

  // The logical store hosts, null-terminated.
  static const char* const* Hosts();

 private:
  struct Impl;
  std::unique_ptr<Impl> m_Impl;
};

#endif  // VLSIMSERVER_H
