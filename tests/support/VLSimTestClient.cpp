#include "VLSimTestClient.h"

#include <arpa/inet.h>
#include <netinet/in.h>
#include <openssl/err.h>
#include <openssl/evp.h>
#include <openssl/rand.h>
#include <openssl/ssl.h>
#include <strings.h>
#include <sys/socket.h>
#include <unistd.h>

#include <cstring>

#include "VLStoreHosts.h"
#include "wsaapi.h"
#include "wsseapi.h"

extern struct Namespace namespaces[];

namespace {

struct Buffers {
  const std::string* in = nullptr;
  size_t read = 0;
  std::string* out = nullptr;
};

size_t ReadBuffer(struct soap* soap, char* data, size_t size) {
  Buffers* buffers = static_cast<Buffers*>(soap->user);
  size_t n = std::min(size, buffers->in->size() - buffers->read);
  memcpy(data, buffers->in->data() + buffers->read, n);
  buffers->read += n;
  return n;
}

int WriteBuffer(struct soap* soap, const char* data, size_t size) {
  static_cast<Buffers*>(soap->user)->out->append(data, size);
  return SOAP_OK;
}

template <typename Settings>
Settings* FillSettings(struct soap* soap, Settings* settings, const VLSimSoapCall& call) {
  settings->APIKey = soap_strdup(soap, call.apiKey.c_str());
  settings->DestinationUniqueID = soap_strdup(soap, call.deviceId.c_str());
  settings->DestinationTypeID = call.deviceType;
  settings->AuthToken = call.sendToken ? soap_strdup(soap, call.token.c_str()) : nullptr;
  return settings;
}

std::string Base64(const unsigned char* data, size_t size) {
  std::string text(4 * ((size + 2) / 3) + 1, '\0');
  int n = EVP_EncodeBlock(reinterpret_cast<unsigned char*>(&text[0]), data, static_cast<int>(size));
  text.resize(n);
  return text;
}

}  // namespace

std::string VLSimTestReply::Header(const std::string& name) const {
  std::string key = "\r\n" + name + ":";
  for (size_t pos = 0; (pos = head.find("\r\n", pos)) != std::string::npos; pos += 2) {
    if (strncasecmp(head.c_str() + pos, key.c_str(), key.size()) != 0) continue;
    size_t start = head.find_first_not_of(' ', pos + key.size());
    return head.substr(start, head.find("\r\n", start) - start);
  }
  return std::string();
}

VLSimTestReply VLSimExchange(int port, const std::string& caFile, const std::string& host, const std::string& request) {
  VLSimTestReply reply;
  int fd = socket(AF_INET, SOCK_STREAM, 0);
  struct sockaddr_in sin = {};
  sin.sin_family = AF_INET;
  sin.sin_port = htons(static_cast<uint16_t>(port));
  sin.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
  struct timeval timeout = {20, 0};
  setsockopt(fd, SOL_SOCKET, SO_RCVTIMEO, &timeout, sizeof timeout);
  if (connect(fd, reinterpret_cast<struct sockaddr*>(&sin), sizeof sin) != 0) {
    reply.error = "connect failed";
    close(fd);
    return reply;
  }
  SSL_CTX* ctx = nullptr;
  SSL* ssl = nullptr;
  if (!caFile.empty()) {
    ctx = SSL_CTX_new(TLS_client_method());
    SSL_CTX_load_verify_locations(ctx, caFile.c_str(), nullptr);
    SSL_CTX_set_verify(ctx, SSL_VERIFY_PEER, nullptr);
    ssl = SSL_new(ctx);
    SSL_set_tlsext_host_name(ssl, host.c_str());
    SSL_set1_host(ssl, host.c_str());
    SSL_set_fd(ssl, fd);
    if (SSL_connect(ssl) != 1) {
      reply.error = "TLS handshake failed: " + std::string(X509_verify_cert_error_string(SSL_get_verify_result(ssl)));
      ERR_clear_error();
      SSL_free(ssl);
      SSL_CTX_free(ctx);
      close(fd);
      return reply;
    }
  }
  reply.connected = true;
  if (ssl) SSL_write(ssl, request.data(), static_cast<int>(request.size()));
  else send(fd, request.data(), request.size(), MSG_NOSIGNAL);
  char buffer[16384];
  for (;;) {
    int n = ssl ? SSL_read(ssl, buffer, sizeof buffer) : static_cast<int>(recv(fd, buffer, sizeof buffer, 0));
    if (n <= 0) break;
    reply.raw.append(buffer, n);
  }
  ERR_clear_error();
  if (ssl) SSL_free(ssl);
  if (ctx) SSL_CTX_free(ctx);
  close(fd);
  if (reply.raw.compare(0, 9, "HTTP/1.1 ") == 0) reply.status = atoi(reply.raw.c_str() + 9);
  size_t blank = reply.raw.find("\r\n\r\n");
  if (blank != std::string::npos) {
    reply.head = reply.raw.substr(0, blank + 2);
    reply.body = reply.raw.substr(blank + 4);
  }
  return reply;
}

std::string VLSimGetRequest(const std::string& host, const std::string& target, const std::string& extraHeaders) {
  return "GET " + target + " HTTP/1.1\r\nHost: " + host + "\r\nUser-Agent: DUDUVud\r\n" + extraHeaders + "\r\n";
}

struct soap* VLSimNewSoap(const std::string* raw, std::string* out) {
  struct soap* soap = soap_new1(SOAP_C_UTFSTRING);
  soap_set_namespaces(soap, namespaces);
  Buffers* buffers = new Buffers;
  buffers->in = raw;
  buffers->out = out;
  soap->user = buffers;
  soap->frecv = ReadBuffer;
  soap->fsend = WriteBuffer;
  return soap;
}

void VLSimFreeSoap(struct soap* soap) {
  delete static_cast<Buffers*>(soap->user);
  soap_destroy(soap);
  soap_end(soap);
  soap_free(soap);
}

void VLSimAddHeader(struct soap* soap, const VLSimSoapCall& call, const char* operation) {
  soap_register_plugin(soap, soap_wsa);
  soap_register_plugin(soap, soap_wsse);
  std::string endpoint = "https://" + call.host + call.path;
  std::string action = std::string(VL_API_NAMESPACE) + operation;
  soap->header = nullptr;
  soap_wsa_request(soap, ("uuid:" + std::string(operation)).c_str(), endpoint.c_str(), action.c_str());
  if (!call.created) {
    soap_wsse_add_UsernameTokenDigest(soap, "User", call.user.c_str(), call.password.c_str());
  } else {
    // A token written by hand, for created times the plug-in would not write.
    unsigned char nonce[20];
    RAND_bytes(nonce, sizeof nonce);
    char created[32];
    struct tm tm;
    gmtime_r(&call.created, &tm);
    strftime(created, sizeof created, "%Y-%m-%dT%H:%M:%SZ", &tm);
    std::string data(reinterpret_cast<char*>(nonce), sizeof nonce);
    data += created + call.password;
    unsigned char digest[EVP_MAX_MD_SIZE];
    unsigned int length = 0;
    EVP_Digest(data.data(), data.size(), digest, &length, EVP_sha1(), nullptr);
    soap_wsse_add_UsernameTokenText(soap, "User", call.user.c_str(), Base64(digest, length).c_str());
    _wsse__UsernameToken* token = soap_wsse_UsernameToken(soap, "User");
    token->Password->Type = soap_strdup(soap,
        "http://docs.oasis-open.org/wss/2004/01/oasis-200401-wss-username-token-profile-1.0#PasswordDigest");
    token->Nonce = soap_new_wsse__EncodedString(soap);
    token->Nonce->__item = soap_strdup(soap, Base64(nonce, sizeof nonce).c_str());
    token->wsu__Created = soap_strdup(soap, created);
  }
  if (call.settingsElement == "DeviceSettings")
    soap->header->VL1__DeviceSettings_ = FillSettings(soap, soap_new_VL1__DeviceSettings(soap), call);
  else if (call.settingsElement == "StreamDeviceRequestSettings")
    soap->header->VL1__StreamDeviceRequestSettings_ = FillSettings(soap, soap_new_VL1__StreamDeviceRequestSettings(soap), call);
  else if (call.settingsElement == "DownloadDeviceRequestSettings")
    soap->header->VL1__DownloadDeviceRequestSettings_ = FillSettings(soap, soap_new_VL1__DownloadDeviceRequestSettings(soap), call);
}

std::string VLSimPost(const VLSimSoapCall& call, const char* operation, const std::string& envelope) {
  std::string action = call.soapAction.empty() ? std::string(VL_API_NAMESPACE) + operation : call.soapAction;
  return "POST " + call.path + " HTTP/1.1\r\nHost: " + call.host +
         "\r\nUser-Agent: gSOAP/2.7\r\nContent-Type: text/xml; charset=utf-8\r\nContent-Length: " +
         std::to_string(envelope.size()) + "\r\nAccept-Encoding: gzip, deflate\r\nSOAPAction: \"" + action +
         "\"\r\n\r\n" + envelope;
}

VLSimSoapExchange::~VLSimSoapExchange() {
  if (m_Soap) VLSimFreeSoap(m_Soap);
}

std::string VLSimSoapExchange::FaultString() {
  const char* text = m_Soap ? soap_fault_string(m_Soap) : nullptr;
  return text ? text : "";
}
