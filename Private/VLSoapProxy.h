// VLSoapProxy: what the three service proxies (RealTimeBrowseSoap12Proxy, StreamAPISoap12Proxy,
// DownloadAPISoap12Proxy) have in common: a gSOAP context (the proxy derives from soap) with the
// library's transport, the endpoint pointer, and the one call that every operation makes (Call).
//
// A call is one exchange on a connection of its own (no keep-alive): the request goes whole,
// with its Content-Length (no chunking), and the reply may come compressed. The request and
// response records live in this context; the caller frees them once it has read the result.
#ifndef VLSOAPPROXY_H
#define VLSOAPPROXY_H

#include <stdio.h>

#include "VLStoreHosts.h"
#include "soapH.h"

class VLSoapProxy : public soap {
 public:
  virtual ~VLSoapProxy();
  VLSoapProxy(const VLSoapProxy&) = delete;
  VLSoapProxy& operator=(const VLSoapProxy&) = delete;

  // Drops the header: the next request goes without one.
  virtual void soap_noheader();
  // The header of the next request, or after a call the header of the reply (null if none).
  virtual SOAP_ENV__Header* soap_header();
  // The fault of the last call.
  virtual const char* soap_fault_string();
  virtual const char* soap_fault_detail();
  // Closes the connection.
  virtual int soap_close_socket();
  // Prints the last error to fd.
  virtual void soap_print_fault(FILE* fd);

  // The URL of the service; borrowed; the fallback endpoint is used while it is null.
  const char* soap_endpoint;

 protected:
  // className names the proxy in the log ("DownloadAPISoap12Proxy"); fallbackEndpoint is used
  // while soap_endpoint is null. Both are static texts.
  VLSoapProxy(const char* className, const char* fallbackEndpoint);

  // The proxy's initialiser: sets the input and output modes (answers are read as XML trees,
  // without id/href resolution), clears the endpoint, registers the "soap_proxy" area and
  // installs the namespace table.
  void Init(int imode, int omode);

  // One operation: sends request as the body of a document/literal envelope to the endpoint
  // (the fallback one while none is set) and, when response is given, reads the reply's
  // response element into it. Returns 0 or the gSOAP error: an HTTP status, SOAP_SVR_FAULT or
  // SOAP_CLI_FAULT for a fault of the server or of the client whatever the prefix of its code,
  // another error of the fault or of the exchange. The connection is closed when it returns.
  // Logs "Entering <logName>" and "Exiting <logName>" to "soap_proxy" (level 4), and an HTTP
  // status as "HTTP error <status>" to "soap_test". logName is "<Proxy>::<operation>",
  // requestTag "VL1:<operation>", responseTag "VL1:<operation>Response", action the SOAPAction;
  // request must not be null.
  template <class Request, class Response>
  int Call(const char* logName, const char* requestTag, const char* responseTag, const char* action,
           const Request* request, Response* response) {
    Body body = {request,
                 [](soap* s, const void* r) { static_cast<const Request*>(r)->soap_serialize(s); },
                 [](soap* s, const void* r, const char* tag) { return static_cast<const Request*>(r)->soap_put(s, tag, ""); },
                 response,
                 [](soap* s, void* r) { static_cast<Response*>(r)->soap_default(s); },
                 [](soap* s, void* r, const char* tag) { static_cast<Response*>(r)->soap_get(s, tag, NULL); }};
    return Invoke(logName, requestTag, responseTag, action, body);
  }

 private:
  // A request and a response record behind plain functions, so that one Invoke serves all.
  struct Body {
    const void* request;
    void (*serialize)(soap*, const void*);
    int (*put)(soap*, const void*, const char*);
    void* response;
    void (*reset)(soap*, void*);
    void (*get)(soap*, void*, const char*);
  };
  int Invoke(const char* logName, const char* requestTag, const char* responseTag, const char* action,
             const Body& body);
  int Send(const char* endpoint, const char* action, const char* requestTag, const Body& body);
  int Receive(const char* responseTag, const Body& body);

  const char* m_ClassName;
  const char* m_FallbackEndpoint;
  int m_LogAreaId;  // "soap_proxy"
};

// Declares and defines operation name of a proxy class: name is the operation (the method's
// name), Type the generated record name part (the operation with "_" written "_USCORE"). The
// proxies apply them to the list of their service's operations.
#define VL_SOAP_DECLARE(name, Type) virtual int name(_VL1__##Type* request, _VL1__##Type##Response* response);
#define VL_SOAP_OPERATION(Proxy, name, Type)                                                        \
  int Proxy::name(_VL1__##Type* request, _VL1__##Type##Response* response) {                       \
    return Call(#Proxy "::" #name, "VL1:" #name, "VL1:" #name "Response", VL_API_NAMESPACE #name, \
                request, response);                                                                 \
  }

#endif  // VLSOAPPROXY_H
