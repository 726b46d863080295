// Test helpers that talk to the store simulator over real sockets the way a client does: raw
// HTTP/1.1 exchanges over TCP or TLS (verifying the simulator's certificate against its CA and
// the host name), and SOAP envelopes built and read with the generated serialisers.
#ifndef VLSIMTESTCLIENT_H
#define VLSIMTESTCLIENT_H

#include <time.h>

#include <string>

#include "soapH.h"

struct VLSimTestReply {
  bool connected = false;  // TCP connection and, for TLS, handshake succeeded
  std::string error;       // why not
  std::string raw;         // every byte received until the server closed
  int status = 0;          // from the status line, 0 when there is none
  std::string head, body;  // split at the first blank line
  std::string Header(const std::string& name) const;
};

// Sends request (raw bytes) to 127.0.0.1:port and reads until the server closes. With a CA file
// the connection is TLS with SNI host, and the certificate must verify for host.
VLSimTestReply VLSimExchange(int port, const std::string& caFile, const std::string& host, const std::string& request);

// "GET path HTTP/1.1" with Host and the client's User-Agent, plus extra header lines.
std::string VLSimGetRequest(const std::string& host, const std::string& target, const std::string& extraHeaders = "");

// How a SOAP request is dressed.
struct VLSimSoapCall {
  std::string host = "store.ostrel.example";
  std::string path = "/api/RealTimeBrowse.asmx";
  std::string settingsElement = "DeviceSettings";  // "StreamDeviceRequestSettings", ... or "" for none
  std::string soapAction;                           // empty: the API namespace + operation
  std::string user = "vlsim-user";
  std::string password = "vlsim-password";
  std::string apiKey = "VLSIM-API-KEY";
  std::string deviceId = "00-11-22-33-44-55";
  int deviceType = 7;
  std::string token;
  bool sendToken = true;   // false: no AuthToken element at all
  time_t created = 0;      // 0: the WS-Security plug-in's token with the current time
};

// The HTTP POST of a SOAP request whose body element is request under "VL1:<operation>".
template <typename Request>
std::string VLSimSoapRequest(const VLSimSoapCall& call, const char* operation, Request* request);

// Reads a raw HTTP answer as the client runtime does (status, Content-Encoding, envelope, fault)
// into the response element "VL1:<operation>Response"; returns the runtime's error code. soap
// comes from VLSimNewSoap(&raw, nullptr) and keeps the fault texts and the record's memory until
// VLSimFreeSoap.
template <typename Response>
int VLSimSoapResponse(struct soap* soap, const char* operation, Response* response);

// One SOAP exchange with the simulator's TLS port; the answer's records live as long as this.
class VLSimSoapExchange {
 public:
  VLSimSoapExchange() = default;
  ~VLSimSoapExchange();
  VLSimSoapExchange(const VLSimSoapExchange&) = delete;
  VLSimSoapExchange& operator=(const VLSimSoapExchange&) = delete;

  // Returns the client runtime's error code for the answer (0: response filled).
  template <typename Request, typename Response>
  int Run(int port, const std::string& caFile, const VLSimSoapCall& call, const char* operation, Request* request,
          Response* response);
  // The fault string of a SOAP fault answer, or "".
  std::string FaultString();

  VLSimTestReply reply;

 private:
  struct soap* m_Soap = nullptr;
};

// ---- Implementation of the templates ----

// A context that reads raw from memory, or writes to out.
struct soap* VLSimNewSoap(const std::string* raw, std::string* out);
// Adds the header blocks of call for operation to the context.
void VLSimAddHeader(struct soap* soap, const VLSimSoapCall& call, const char* operation);
std::string VLSimPost(const VLSimSoapCall& call, const char* operation, const std::string& envelope);
void VLSimFreeSoap(struct soap* soap);

template <typename Request>
std::string VLSimSoapRequest(const VLSimSoapCall& call, const char* operation, Request* request) {
  std::string envelope;
  struct soap* soap = VLSimNewSoap(nullptr, &envelope);
  VLSimAddHeader(soap, call, operation);
  std::string tag = std::string("VL1:") + operation;
  soap->encodingStyle = nullptr;
  soap_serializeheader(soap);
  request->soap_serialize(soap);
  soap_begin_send(soap);
  soap_envelope_begin_out(soap);
  soap_putheader(soap);
  soap_body_begin_out(soap);
  request->soap_put(soap, tag.c_str(), "");
  soap_body_end_out(soap);
  soap_envelope_end_out(soap);
  soap_end_send(soap);
  VLSimFreeSoap(soap);
  return VLSimPost(call, operation, envelope);
}

template <typename Response>
int VLSimSoapResponse(struct soap* soap, const char* operation, Response* response) {
  std::string tag = std::string("VL1:") + operation + "Response";
  if (soap_begin_recv(soap) || soap_envelope_begin_in(soap) || soap_recv_header(soap) || soap_body_begin_in(soap))
    return soap_closesock(soap);
  response->soap_get(soap, tag.c_str(), nullptr);
  if (soap->error) return soap->error == SOAP_TAG_MISMATCH && soap->level == 2 ? soap_recv_fault(soap, 0) : soap->error;
  if (soap_body_end_in(soap) || soap_envelope_end_in(soap) || soap_end_recv(soap)) return soap->error;
  return SOAP_OK;
}

template <typename Request, typename Response>
int VLSimSoapExchange::Run(int port, const std::string& caFile, const VLSimSoapCall& call, const char* operation,
                           Request* request, Response* response) {
  reply = VLSimExchange(port, caFile, call.host, VLSimSoapRequest(call, operation, request));
  if (m_Soap) VLSimFreeSoap(m_Soap);
  m_Soap = VLSimNewSoap(&reply.raw, nullptr);
  return VLSimSoapResponse(m_Soap, operation, response);
}

#endif  // VLSIMTESTCLIENT_H
