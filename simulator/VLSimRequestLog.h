// VLSimRequestLog: one entry per request the simulator answered, for tests to read ("was this
// call answered from the client's cache?", "did the next request carry an empty token?").
#ifndef VLSIMREQUESTLOG_H
#define VLSIMREQUESTLOG_H

#include <condition_variable>
#include <mutex>
#include <string>
#include <vector>

struct VLSimRequest {
  int connection = 0;     // serial number of the connection, from 1
  bool tls = false;
  bool resumed = false;    // the TLS session was resumed from a ticket
  std::string serverName;  // TLS SNI, or ""
  std::string host;        // Host header without port
  std::string method;
  std::string path;        // request path without the query
  std::string query;
  std::string userAgent;
  std::string ifModifiedSince;
  std::string acceptEncoding;

  // SOAP requests only.
  std::string service;          // "RealTimeBrowse", "StreamAPI", "DownloadAPI"
  std::string soapAction;       // the SOAPAction header without its quotes
  std::string operation;        // local name of the body's request element
  std::string settingsElement;  // "VL1:DeviceSettings", ... or "" (several: joined with ",")
  bool hasAuthToken = false;    // the settings block had an AuthToken element
  std::string apiKey, authToken, destinationUniqueID;
  int destinationTypeID = 0;
  std::string userName, messageID, wsaAction, wsaTo;
  std::string authentication;   // "ok" or why the UsernameToken was refused

  int status = 0;         // HTTP status answered (0: connection closed without an answer)
  int responseCode = 0;   // the operation's ResponseCode, where it has one
  std::string faults;     // the injected faults, as written on the command line, joined by " "
  std::string note;       // why a request was refused, or what it was routed to
};

class VLSimRequestLog {
 public:
  void Add(const VLSimRequest& request);
  std::vector<VLSimRequest> Entries();
  void Clear();
  // Waits until the log holds at least count entries; false after milliseconds without.
  bool WaitFor(size_t count, int milliseconds);
  // One line per entry for the simulator's console.
  static std::string Format(const VLSimRequest& request);

 private:
  std::mutex m_Mutex;
  std::condition_variable m_Added;
  std::vector<VLSimRequest> m_Entries;
};

#endif  // VLSIMREQUESTLOG_H
