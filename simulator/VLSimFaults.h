// VLSimFaults: the faults the simulator injects into its answers, chosen per SOAP operation, per
// path or (for TLS) per host name, from the command line or through the test API.
//
// A fault is written TARGET=MODE[:ARG][,times=N]:
//   TARGET  an operation name ("getTitlesByNavigation"), a path prefix starting with "/"
//           ("/device/time/", "/images/boxart/"), a host name for tls faults, or "*" for all;
//   MODE    delay:MS      wait MS milliseconds before answering
//           close         close the connection before answering
//           cut           send the header and half of the body, then close
//           status:N      answer the HTTP status N (404, 500, 503, ...) with a short HTML page
//           soapfault[:client|server]  answer a SOAP fault (default server)
//           code:N        answer the operation normally but with ResponseCode N
//           malformed     answer 200 with a body that is not well-formed XML
//           truncated     answer 200 with the first half of the body (Content-Length to match)
//           gzip, deflate compress the body with that Content-Encoding
//           badlength:D   announce a Content-Length D bytes off the body (default +64), then close
//           trickle:MS    send the answer in 64-byte pieces, MS milliseconds apart
//           tls:KIND      present the certificate KIND (selfsigned, wronghost, expired) in the
//                         TLS handshake; the target is the host name the client asks for (SNI)
//   times=N applies the fault to the next N matching requests only (default: every one).
#ifndef VLSIMFAULTS_H
#define VLSIMFAULTS_H

#include <mutex>
#include <string>
#include <vector>

struct VLSimFault {
  enum Mode { kDelay, kClose, kCut, kStatus, kSoapFault, kCode, kMalformed, kTruncated, kGzip,
              kDeflate, kBadLength, kTrickle, kTls };

  std::string target;
  Mode mode = kDelay;
  int arg = 0;       // milliseconds, HTTP status, response code or byte difference
  std::string text;  // tls: the certificate kind; soapfault: "client" or "server"
  int times = -1;    // applications left; -1: unlimited

  // Parses the written form above; false with a message for anything else.
  static bool Parse(const std::string& spec, VLSimFault* fault, std::string* error);
  std::string ToString() const;
};

// The active faults, shared by all connection threads.
class VLSimFaults {
 public:
  void Add(const VLSimFault& fault);
  void Clear();
  // Every non-TLS fault whose target matches the operation (may be empty) or the path; each one
  // taken counts as one application.
  std::vector<VLSimFault> Take(const std::string& operation, const std::string& path);
  // The TLS fault for a handshake that asked for serverName (may be empty), if any.
  bool TakeTls(const std::string& serverName, VLSimFault* fault);

 private:
  std::mutex m_Mutex;
  std::vector<VLSimFault> m_Faults;
};

#endif  // VLSIMFAULTS_H
