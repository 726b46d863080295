#include "VLServiceObject.h"

#include "VLSoapTransport.h"
#include "VLStoreHosts.h"
#include "wsaapi.h"
#include "wsseapi.h"

namespace {

const char* TextOrNull(const VLString& s) { return s.empty() ? NULL : s.c_str(); }

}  // namespace

void VLServiceBinding::Bind(VLSoapProxy* proxy, const VL_WS_SetupParams2& params, const char* serviceFile,
                            VLString* endpoint) {
  *endpoint = params.ServiceBaseURL + serviceFile;
  if (!params.ProxyHost.empty()) {
    proxy->proxy_host = params.ProxyHost.c_str();
    proxy->proxy_port = params.ProxyPort;
    proxy->proxy_userid = TextOrNull(params.ProxyUserName);
    proxy->proxy_passwd = TextOrNull(params.ProxyPassword);
    proxy->proxy_http_version = "1.1";
  }
  VLSoapTransport::SetUserAgent(proxy, params.UserAgent.c_str());
  VLSoapTransport::SetTimeouts(proxy, params.SendTimeout, params.RecvTimeout);
  proxy->soap_endpoint = endpoint->c_str();
  soap_register_plugin(proxy, soap_wsa);
  soap_register_plugin(proxy, soap_wsse);
}

int VLServiceBinding::AddRequestHeader(VLSoapProxy* proxy, const VL_WS_SetupParams2& params,
                                       const VLString& endpoint, const VLString& operation) {
  proxy->header = NULL;
  VLString messageId = "uuid:" + operation;
  VLString action = VL_API_NAMESPACE + operation;
  if (soap_wsa_request(proxy, messageId.c_str(), endpoint.c_str(), action.c_str()) != SOAP_OK) return proxy->error;
  int error = soap_wsse_add_UsernameTokenDigest(proxy, "User", params.UserName.c_str(), params.Password.c_str());
  if (error != SOAP_OK) return error;
  // The store's request layout has the nonce as plain Base64 text, without the encoding attribute
  // the plug-in writes.
  _wsse__UsernameToken* token = soap_wsse_UsernameToken(proxy, "User");
  if (token && token->Nonce) token->Nonce->EncodingType = NULL;
  return SOAP_OK;
}
