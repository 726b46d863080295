#include "VLSimHttp.h"

#include <errno.h>
#include <poll.h>
#include <strings.h>
#include <sys/socket.h>
#include <unistd.h>
#include <zlib.h>

#include <algorithm>
#include <chrono>
#include <cstdio>

namespace {

const size_t kMaxHead = 64 * 1024;
const size_t kMaxBody = 8 * 1024 * 1024;
const size_t kTricklePiece = 64;
const int kLingerMilliseconds = 2000;

// What a malformed answer holds: the start of an envelope that never becomes well-formed XML.
const char kMalformedBody[] =
    "<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n"
    "<SOAP-ENV:Envelope xmlns:SOAP-ENV=\"http://schemas.xmlsoap.org/soap/envelope/\">"
    "<SOAP-ENV:Body><<this is not XML>></SOAP-ENV:Envelope></SOAP-ENV:Body>";

std::string Trim(const std::string& text) {
  size_t begin = text.find_first_not_of(" \t");
  if (begin == std::string::npos) return std::string();
  size_t end = text.find_last_not_of(" \t\r");
  return text.substr(begin, end - begin + 1);
}

// gzip (windowBits 31) or zlib-wrapped deflate (windowBits 15), as HTTP names them.
std::string Compress(const std::string& data, bool gzip) {
  z_stream stream = {};
  if (deflateInit2(&stream, Z_BEST_COMPRESSION, Z_DEFLATED, gzip ? 31 : 15, 8, Z_DEFAULT_STRATEGY) != Z_OK)
    return data;
  std::string out(deflateBound(&stream, data.size()) + 32, '\0');
  stream.next_in = reinterpret_cast<Bytef*>(const_cast<char*>(data.data()));
  stream.avail_in = static_cast<uInt>(data.size());
  stream.next_out = reinterpret_cast<Bytef*>(&out[0]);
  stream.avail_out = static_cast<uInt>(out.size());
  int result = deflate(&stream, Z_FINISH);
  out.resize(stream.total_out);
  deflateEnd(&stream);
  return result == Z_STREAM_END ? out : data;
}

int HexValue(char c) {
  if (c >= '0' && c <= '9') return c - '0';
  if (c >= 'a' && c <= 'f') return c - 'a' + 10;
  if (c >= 'A' && c <= 'F') return c - 'A' + 10;
  return -1;
}

}  // namespace

std::string VLSimHttpRequest::Header(const std::string& name) const {
  for (const auto& header : headers)
    if (strcasecmp(header.first.c_str(), name.c_str()) == 0) return header.second;
  return std::string();
}

std::string VLSimHttpRequest::Host() const {
  std::string host = Header("Host");
  size_t colon = host.rfind(':');
  if (colon != std::string::npos && host.find(']') == std::string::npos) host.resize(colon);
  std::transform(host.begin(), host.end(), host.begin(), [](unsigned char c) { return static_cast<char>(tolower(c)); });
  return host;
}

const char* VLSimHttpResponse::Reason(int status) {
  switch (status) {
    case 200: return "OK";
    case 304: return "Not Modified";
    case 400: return "Bad Request";
    case 403: return "Forbidden";
    case 404: return "Not Found";
    case 405: return "Method Not Allowed";
    case 411: return "Length Required";
    case 413: return "Payload Too Large";
    case 500: return "Internal Server Error";
    case 501: return "Not Implemented";
    case 502: return "Bad Gateway";
    case 503: return "Service Unavailable";
    case 504: return "Gateway Timeout";
    default: return "Status";
  }
}

VLSimHttpResponse VLSimHttpResponse::Page(int status, const std::string& text) {
  VLSimHttpResponse response;
  response.status = status;
  response.headers.push_back({"Content-Type", "text/html; charset=utf-8"});
  char title[64];
  snprintf(title, sizeof title, "%d %s", status, Reason(status));
  response.body = std::string("<html><head><title>") + title + "</title></head><body><h1>" + title +
                  "</h1><p>" + text + "</p></body></html>\n";
  return response;
}

void VLSimStopSignal::Stop() {
  std::lock_guard<std::mutex> lock(m_Mutex);
  m_Stopped = true;
  m_Changed.notify_all();
}

bool VLSimStopSignal::Stopped() {
  std::lock_guard<std::mutex> lock(m_Mutex);
  return m_Stopped;
}

bool VLSimStopSignal::Sleep(int milliseconds) {
  std::unique_lock<std::mutex> lock(m_Mutex);
  return !m_Changed.wait_for(lock, std::chrono::milliseconds(milliseconds), [this] { return m_Stopped; });
}

VLSimConnection::~VLSimConnection() {
  Close(false);
  if (m_Ssl) SSL_free(m_Ssl);
  close(m_Fd);
}

std::string VLSimConnection::ServerName() const {
  const char* name = m_Ssl ? SSL_get_servername(m_Ssl, TLSEXT_NAMETYPE_host_name) : nullptr;
  return name ? name : "";
}

int VLSimConnection::Receive(char* buffer, int size) {
  if (m_Closed) return -1;
  if (m_Ssl) return SSL_read(m_Ssl, buffer, size);
  ssize_t n;
  do n = recv(m_Fd, buffer, size, 0);
  while (n < 0 && errno == EINTR);
  return static_cast<int>(n);
}

bool VLSimConnection::ReadRequest(VLSimHttpRequest* request, std::string* error) {
  *request = VLSimHttpRequest();
  error->clear();
  std::string data;
  data.swap(m_Pending);
  char buffer[16384];
  size_t headEnd;
  while ((headEnd = data.find("\r\n\r\n")) == std::string::npos) {
    if (data.size() > kMaxHead) {
      *error = "request head too long";
      return false;
    }
    int n = Receive(buffer, sizeof buffer);
    if (n <= 0) {
      if (!data.empty()) *error = "connection ended inside the request head";
      return false;
    }
    data.append(buffer, n);
  }

  size_t lineEnd = data.find("\r\n");
  std::string line = data.substr(0, lineEnd);
  size_t space1 = line.find(' ');
  size_t space2 = line.rfind(' ');
  if (space1 == std::string::npos || space2 == space1 || line.compare(space2 + 1, 5, "HTTP/") != 0) {
    *error = "bad request line \"" + line + "\"";
    return false;
  }
  request->method = line.substr(0, space1);
  request->target = line.substr(space1 + 1, space2 - space1 - 1);
  size_t question = request->target.find('?');
  request->path = request->target.substr(0, question);
  if (question != std::string::npos) request->query = request->target.substr(question + 1);

  for (size_t pos = lineEnd + 2; pos < headEnd;) {
    size_t end = data.find("\r\n", pos);
    std::string header = data.substr(pos, end - pos);
    pos = end + 2;
    size_t colon = header.find(':');
    if (colon == std::string::npos) {
      *error = "bad header line \"" + header + "\"";
      return false;
    }
    request->headers.push_back({Trim(header.substr(0, colon)), Trim(header.substr(colon + 1))});
  }

  data.erase(0, headEnd + 4);
  if (!request->Header("Transfer-Encoding").empty()) {
    *error = "chunked requests are not accepted";
    return false;
  }
  std::string lengthText = request->Header("Content-Length");
  size_t length = 0;
  if (!lengthText.empty()) {
    char* end = nullptr;
    unsigned long long value = strtoull(lengthText.c_str(), &end, 10);
    if (*end != '\0' || value > kMaxBody) {
      *error = "bad Content-Length \"" + lengthText + "\"";
      return false;
    }
    length = static_cast<size_t>(value);
  }
  while (data.size() < length) {
    int n = Receive(buffer, sizeof buffer);
    if (n <= 0) {
      *error = "connection ended inside the request body";
      return false;
    }
    data.append(buffer, n);
  }
  request->body = data.substr(0, length);
  m_Pending = data.substr(length);
  return true;
}

bool VLSimConnection::Write(const std::string& bytes) {
  size_t sent = 0;
  while (sent < bytes.size() && !m_Closed) {
    int chunk = static_cast<int>(std::min<size_t>(bytes.size() - sent, 1 << 20));
    ssize_t n;
    if (m_Ssl) {
      n = SSL_write(m_Ssl, bytes.data() + sent, chunk);
    } else {
      do n = send(m_Fd, bytes.data() + sent, chunk, MSG_NOSIGNAL);
      while (n < 0 && errno == EINTR);
    }
    if (n <= 0) return false;
    sent += static_cast<size_t>(n);
  }
  return sent == bytes.size();
}

void VLSimConnection::Close(bool graceful) {
  if (m_Closed) return;
  m_Closed = true;
  if (!graceful) {
    shutdown(m_Fd, SHUT_RDWR);
    return;
  }
  if (m_Ssl) SSL_shutdown(m_Ssl);
  shutdown(m_Fd, SHUT_WR);
  // Linger: a close with unread input would reset the connection and could destroy the answer
  // in the peer's buffers before the peer has read it.
  char buffer[4096];
  auto deadline = std::chrono::steady_clock::now() + std::chrono::milliseconds(kLingerMilliseconds);
  for (;;) {
    int left = static_cast<int>(
        std::chrono::duration_cast<std::chrono::milliseconds>(deadline - std::chrono::steady_clock::now()).count());
    struct pollfd pfd = {m_Fd, POLLIN, 0};
    if (left <= 0 || poll(&pfd, 1, left) <= 0) break;
    if (recv(m_Fd, buffer, sizeof buffer, 0) <= 0) break;
  }
}

VLSimSent VLSimSendResponse(VLSimConnection& connection, VLSimHttpResponse response,
                            const std::vector<VLSimFault>& faults, VLSimStopSignal& stop,
                            const std::function<void(int status)>& answering) {
  VLSimSent sent;
  bool cut = false;
  long lengthDelta = 0;
  int trickle = -1;
  for (const VLSimFault& fault : faults) {
    switch (fault.mode) {
      case VLSimFault::kDelay:
        if (!stop.Sleep(fault.arg)) {
          sent.abrupt = true;
          return sent;
        }
        break;
      case VLSimFault::kClose:
        sent.abrupt = true;
        return sent;
      case VLSimFault::kStatus:
        response = VLSimHttpResponse::Page(fault.arg, "Injected by the simulator.");
        break;
      case VLSimFault::kMalformed:
        response.body = kMalformedBody;
        break;
      case VLSimFault::kTruncated:
        response.body.resize(response.body.size() / 2);
        break;
      case VLSimFault::kGzip:
      case VLSimFault::kDeflate: {
        bool gzip = fault.mode == VLSimFault::kGzip;
        response.body = Compress(response.body, gzip);
        response.headers.push_back({"Content-Encoding", gzip ? "gzip" : "deflate"});
        break;
      }
      case VLSimFault::kCut:
        cut = true;
        break;
      case VLSimFault::kBadLength:
        lengthDelta = fault.arg;
        break;
      case VLSimFault::kTrickle:
        trickle = fault.arg;
        break;
      default:  // SOAP-level and TLS faults are applied elsewhere
        break;
    }
  }

  char line[128];
  snprintf(line, sizeof line, "HTTP/1.1 %d %s\r\n", response.status, VLSimHttpResponse::Reason(response.status));
  std::string message = line;
  for (const auto& header : response.headers) message += header.first + ": " + header.second + "\r\n";
  if (response.status != 304) {
    long announced = std::max(0L, static_cast<long>(response.body.size()) + lengthDelta);
    message += "Content-Length: " + std::to_string(announced) + "\r\n";
  }
  message += "Connection: close\r\n\r\n";
  message += cut ? response.body.substr(0, response.body.size() / 2) : response.body;

  answering(response.status);
  bool written = true;
  if (trickle >= 0) {
    for (size_t pos = 0; written && pos < message.size(); pos += kTricklePiece) {
      if (pos > 0 && !stop.Sleep(trickle)) written = false;
      else written = connection.Write(message.substr(pos, kTricklePiece));
    }
  } else {
    written = connection.Write(message);
  }
  sent.status = response.status;
  sent.abrupt = !written || cut || lengthDelta > 0;
  return sent;
}

std::string VLSimURLDecode(const std::string& text, bool plusIsSpace) {
  std::string out;
  for (size_t i = 0; i < text.size(); ++i) {
    if (text[i] == '%' && i + 2 < text.size() && HexValue(text[i + 1]) >= 0 && HexValue(text[i + 2]) >= 0) {
      out += static_cast<char>(HexValue(text[i + 1]) * 16 + HexValue(text[i + 2]));
      i += 2;
    } else if (plusIsSpace && text[i] == '+') {
      out += ' ';
    } else {
      out += text[i];
    }
  }
  return out;
}
