#include "VLSimTestClient.h"

#include <arpa/inet.h>
#include <netinet/in.h>
#include <openssl/err.h>
#include <openssl/evp.h>
#include <openssl/rand.h>
#include <openssl/ssl.h>
#include <sys/socket.h>
#include <unistd.h>

#include "VLTestDir.h"
#include "VLWSAELog.h"
#include "VL_Log.h"

namespace {

std::string Base64(const unsigned char* bytes, size_t n) {
  std::string text(4 * ((n + 2) / 3) + 1, '\0');
  text.resize(static_cast<size_t>(EVP_EncodeBlock(reinterpret_cast<unsigned char*>(&text[0]), bytes, static_cast<int>(n))));
  return text;
}

// Replaces the text of element tag (its first occurrence) with value.
void SetElement(std::string& xml, const std::string& tag, const std::string& value) {
  size_t open = xml.find("<" + tag);
  size_t start = xml.find('>', open) + 1;
  size_t end = xml.find("</" + tag + ">", start);
  if (open != std::string::npos && end != std::string::npos) xml.replace(start, end - start, value);
}

}  // namespace

VLRawExchange VLRawLogOf(const std::function<void()>& call) {
  VLTestDir dir;
  VLRawExchange raw;
  VLWSAELog::InitWSLogs(0x1800, 2, dir.path().c_str());  // into a log file, and to the observer
  VL_LogSetObserver(
      [](void* to, const char* area, int, const char* text, size_t n) {
        std::string& bytes = std::string(area) == "soap_sent" ? static_cast<VLRawExchange*>(to)->sent
                                                              : static_cast<VLRawExchange*>(to)->received;
        bytes.append(text, n);
        // The logging service takes the line end that closes a message for its own; HTTP's line
        // ends are CRLF, so a message that ends in CR lost its LF.
        if (n > 0 && text[n - 1] == '\r') bytes += '\n';
      },
      &raw);
  call();
  VL_LogSetObserver(nullptr, nullptr);
  VLWSAELog::InitWSLogs(0, 2, dir.path().c_str());
  return raw;
}

std::string VLPasswordDigest(const std::string& nonce, const std::string& created, const std::string& password) {
  std::string hashed = nonce + created + password;
  unsigned char digest[EVP_MAX_MD_SIZE];
  unsigned int length = 0;
  EVP_Digest(hashed.data(), hashed.size(), digest, &length, EVP_sha1(), nullptr);
  return Base64(digest, length);
}

std::string VLWithNewToken(std::string request, const std::string& password, time_t created) {
  unsigned char nonce[20];
  RAND_bytes(nonce, sizeof nonce);
  char time[32];
  struct tm tm;
  strftime(time, sizeof time, "%Y-%m-%dT%H:%M:%SZ", gmtime_r(&created, &tm));
  SetElement(request, "wsse:Nonce", Base64(nonce, sizeof nonce));
  SetElement(request, "wsu:Created", time);
  SetElement(request, "wsse:Password",
             VLPasswordDigest(std::string(reinterpret_cast<const char*>(nonce), sizeof nonce), time, password));
  return request;
}

std::string VLSimExchange(int port, const std::string& caFile, const std::string& host, const std::string& request) {
  std::string raw;
  int fd = socket(AF_INET, SOCK_STREAM, 0);
  struct sockaddr_in sin = {};
  sin.sin_family = AF_INET;
  sin.sin_port = htons(static_cast<uint16_t>(port));
  sin.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
  struct timeval timeout = {20, 0};
  setsockopt(fd, SOL_SOCKET, SO_RCVTIMEO, &timeout, sizeof timeout);
  SSL_CTX* ctx = SSL_CTX_new(TLS_client_method());
  SSL_CTX_load_verify_locations(ctx, caFile.c_str(), nullptr);
  SSL_CTX_set_verify(ctx, SSL_VERIFY_PEER, nullptr);
  SSL* ssl = SSL_new(ctx);
  SSL_set_tlsext_host_name(ssl, host.c_str());
  SSL_set1_host(ssl, host.c_str());
  SSL_set_fd(ssl, fd);
  if (connect(fd, reinterpret_cast<struct sockaddr*>(&sin), sizeof sin) == 0 && SSL_connect(ssl) == 1) {
    SSL_write(ssl, request.data(), static_cast<int>(request.size()));
    char buffer[16384];
    for (int n; (n = SSL_read(ssl, buffer, sizeof buffer)) > 0;) raw.append(buffer, static_cast<size_t>(n));
  }
  ERR_clear_error();
  SSL_free(ssl);
  SSL_CTX_free(ctx);
  close(fd);
  return raw;
}
