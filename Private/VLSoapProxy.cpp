#include "VLSoapProxy.h"

#include <string.h>

#include "VLSoapTransport.h"
#include "VLWSAELog.h"

namespace {

VLLogArea s_ProxyLog(VLWS_SoapProxyLOG_AREA_NAME);

}  // namespace

VLSoapProxy::VLSoapProxy(const char* className, const char* fallbackEndpoint)
    : soap(SOAP_C_UTFSTRING, SOAP_C_UTFSTRING),
      soap_endpoint(NULL),
      m_ClassName(className),
      m_FallbackEndpoint(fallbackEndpoint),
      m_LogAreaId(-1) {
  // The handle's settings may change the time-outs later.
  VLSoapTransport::Install(this);
}

VLSoapProxy::~VLSoapProxy() {
  soap_destroy(this);
  soap_end(this);
}

void VLSoapProxy::Init(int imode, int omode) {
  // The store's answers are document/literal: no element stands for another by "id" and "href"
  // (SOAP encoding's multi-references), so they are read as plain trees. Otherwise the runtime
  // would keep a table of every "id" an answer shows, and for one shown twice it copies the id's
  // text onto itself (undefined behaviour: the copy overlaps its source).
  soap_imode(this, imode | SOAP_XML_TREE);
  soap_omode(this, omode);
  soap_endpoint = NULL;
  m_LogAreaId = s_ProxyLog.Id();
  if (!local_namespaces) soap_set_namespaces(this, ::namespaces);
}

void VLSoapProxy::soap_noheader() { header = NULL; }

SOAP_ENV__Header* VLSoapProxy::soap_header() { return header; }

const char* VLSoapProxy::soap_fault_string() { return *soap_faultstring(this); }

const char* VLSoapProxy::soap_fault_detail() { return *soap_faultdetail(this); }

int VLSoapProxy::soap_close_socket() { return soap_closesock(this); }

void VLSoapProxy::soap_print_fault(FILE* fd) { ::soap_print_fault(this, fd); }

int VLSoapProxy::Send(const char* endpoint, const char* action, const char* requestTag, const Body& body) {
  soap_begin(this);
  encodingStyle = NULL;  // document/literal
  soap_serializeheader(this);
  body.serialize(this, body.request);
  // Length pass: the same output once without sending, to count the Content-Length.
  if (soap_begin_count(this)) return error;
  if ((mode & SOAP_IO_LENGTH) &&
      (soap_envelope_begin_out(this) || soap_putheader(this) || soap_body_begin_out(this) ||
       body.put(this, body.request, requestTag) || soap_body_end_out(this) || soap_envelope_end_out(this)))
    return error;
  if (soap_end_count(this)) return error;
  if (soap_connect(this, endpoint, action) || soap_envelope_begin_out(this) || soap_putheader(this) ||
      soap_body_begin_out(this) || body.put(this, body.request, requestTag) || soap_body_end_out(this) ||
      soap_envelope_end_out(this) || soap_end_send(this))
    return soap_closesock(this);
  return SOAP_OK;
}

namespace {

// The runtime tells a server's fault from a client's only when the answer writes the envelope's
// namespace with the runtime's own prefix. The fault code it has read is a qualified name already
// turned to the runtime's prefix of that namespace, so the kind is told from it whatever prefix the
// store chose, in either SOAP version.
int FaultKind(soap* s, int error) {
  const char* code = error == SOAP_FAULT ? *soap_faultcode(s) : NULL;
  if (!code) return error;
  if (strcmp(code, "SOAP-ENV:Server") == 0 || strcmp(code, "SOAP-ENV:Receiver") == 0) {
    return s->error = SOAP_SVR_FAULT;
  }
  if (strcmp(code, "SOAP-ENV:Client") == 0 || strcmp(code, "SOAP-ENV:Sender") == 0) {
    return s->error = SOAP_CLI_FAULT;
  }
  return error;
}

}  // namespace

int VLSoapProxy::Receive(const char* responseTag, const Body& body) {
  body.reset(this, body.response);
  if (soap_begin_recv(this) || soap_envelope_begin_in(this) || soap_recv_header(this) ||
      soap_body_begin_in(this))
    return soap_closesock(this);
  body.get(this, body.response, responseTag);
  // Another element than the response at body level is read as a fault.
  if (error) return FaultKind(this, soap_recv_fault(this, 0));
  // The end of the message: an error in it is the call's. The connection closes either way, and
  // soap_closesock returns the error the reading left, SOAP_OK when none.
  if (soap_body_end_in(this) == SOAP_OK && soap_envelope_end_in(this) == SOAP_OK) soap_end_recv(this);
  return soap_closesock(this);
}

int VLSoapProxy::Invoke(const char* logName, const char* requestTag, const char* responseTag,
                        const char* action, const Body& body) {
  VLLogOutputwithConfig({m_LogAreaId, 4}, "Entering %s\n", logName);
  const char* endpoint = soap_endpoint ? soap_endpoint : m_FallbackEndpoint;
  int rc = Send(endpoint, action, requestTag, body);
  if (rc == SOAP_OK) rc = body.response ? Receive(responseTag, body) : soap_closesock(this);
  if (rc >= 100 && rc <= 599) VLLogOutputwithConfig({TEST_VLLogAreaID, 1}, "HTTP error %d\n", rc);
  VLLogOutputwithConfig({m_LogAreaId, 4}, "Exiting %s\n", logName);
  return rc;
}
