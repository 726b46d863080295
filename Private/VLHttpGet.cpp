#include "VLHttpGet.h"

#include <string.h>
#include <strings.h>

#include "VL_WS_Records.h"

namespace {

const char kOK[] = "HTTP/1.1 200 OK\r\n";
const char kNotFound[] = "HTTP/1.1 404 Not Found\r\n";
const char kNotModified[] = "HTTP/1.1 304 Not Modified\r\n";

// The next "\r\n" at or after text and before limit, else limit.
const char* FindLineEnd(const char* text, const char* limit) {
  const void* found = memmem(text, static_cast<size_t>(limit - text), "\r\n", 2);
  return found ? static_cast<const char*>(found) : limit;
}

bool StartsWith(const char* text, const char* prefix) { return strncmp(text, prefix, strlen(prefix)) == 0; }

// A decimal number of 1 to maxDigits digits and nothing else, above 0; false for anything else.
bool ParseNumber(const VLString& text, size_t maxDigits, uint64_t* number) {
  if (text.empty() || text.length() > maxDigits) return false;
  uint64_t n = 0;
  for (size_t i = 0; i < text.length(); ++i) {
    if (text[i] < '0' || text[i] > '9') return false;
    n = n * 10 + static_cast<uint64_t>(text[i] - '0');
  }
  *number = n;
  return n > 0;
}

}  // namespace

bool VLHttpGet::SplitURL(const char* url, VLHttpURL* parts) {
  const char* slashes = strstr(url, "//");
  if (slashes == 0) return false;
  const char* host = slashes + 2;
  const char* slash = strchr(host, '/');
  if (slash == 0 || slash == host || slash[1] == 0) return false;
  const char* colon = static_cast<const char*>(memchr(host, ':', static_cast<size_t>(slash - host)));
  const char* hostEnd = colon ? colon : slash;
  if (hostEnd == host) return false;
  int port = strncasecmp(url, "https:", 6) == 0 ? 443 : 80;
  if (colon) {
    VLString digits(colon + 1, static_cast<size_t>(slash - colon - 1));
    uint64_t number = 0;
    if (!ParseNumber(digits, 5, &number) || number > 65535) return false;
    port = static_cast<int>(number);
  }
  parts->authority.assign(host, static_cast<size_t>(slash - host));
  parts->host.assign(host, static_cast<size_t>(hostEnd - host));
  parts->port = port;
  parts->path = slash + 1;
  return true;
}

VLHttpGet::VLHttpGet(soap* context)
    : m_Connection(context),
      m_Received(0),
      m_Fields(0),
      m_HeaderEnd(0),
      m_Body(0),
      m_BodyReceived(0),
      m_ContentLength(0) {
  m_Piece[0] = 0;
}

VL_WS_Status VLHttpGet::Get(const char* url, const Kind& kind, const VLString& fields) {
  m_Received = 0;
  m_Piece[0] = 0;
  m_Fields = m_HeaderEnd = m_Body = 0;
  m_BodyReceived = 0;
  m_ContentLength = 0;
  VLHttpURL parts;
  if (!SplitURL(url, &parts)) return kind.badURL;
  const VLString host = "Host: " + parts.authority + "\r\n";
  const char agent[] = "User-Agent: DUDUVud\r\n";
  VLString request = "GET /" + parts.path + " HTTP/1.1\r\n" + fields;
  request += kind.hostFirst ? host + agent : agent + host;
  request += "\r\n";
  if (!m_Connection.Open(url, parts.host.c_str(), parts.port)) return VL_WS_E_CONNECT;
  VL_WS_Status status = VL_WS_E_NETWORK;
  if (m_Connection.Send(request.c_str(), request.length())) {
    // TCP may cut the header anywhere: read on until it ends, the buffer is full or the
    // connection ends (the transport's deadline included).
    while (m_Received < kPieceSize - 1 && !memmem(m_Piece, m_Received, "\r\n\r\n", 4)) {
      size_t got = m_Connection.Receive(m_Piece + m_Received, kPieceSize - 1 - m_Received);
      if (got == 0) break;
      m_Received += got;
    }
    m_Piece[m_Received] = 0;
    if (m_Received > 0) status = ReadHeader(kind);
  }
  if (status != VL_WS_OK) Close();
  return status;
}

VL_WS_Status VLHttpGet::ReadHeader(const Kind& kind) {
  if (StartsWith(m_Piece, kNotFound)) return kind.notFound;
  if (StartsWith(m_Piece, kNotModified)) return kind.notModified;
  if (!StartsWith(m_Piece, kOK)) return VL_WS_E_NETWORK;
  m_Fields = m_Piece + strlen(kOK) - 2;
  m_HeaderEnd = static_cast<const char*>(memmem(m_Fields, m_Piece + m_Received - m_Fields, "\r\n\r\n", 4));
  VLString length;
  if (m_HeaderEnd == 0 || !Field("Content-Length", &length) || !ParseNumber(length, 18, &m_ContentLength))
    return VL_WS_E_NETWORK;
  // The requests ask for no encoding: an encoded body is not the one they can read.
  VLString encoding;
  if (Field("Content-Encoding", &encoding) && strcasecmp(encoding.c_str(), "identity") != 0) return VL_WS_E_NETWORK;
  m_Body = m_HeaderEnd + 4;
  m_BodyReceived = static_cast<size_t>(m_Piece + m_Received - m_Body);
  if (m_BodyReceived > m_ContentLength) {
    m_BodyReceived = static_cast<size_t>(m_ContentLength);
    m_Piece[m_Body - m_Piece + m_BodyReceived] = 0;
  }
  return VL_WS_OK;
}

bool VLHttpGet::Field(const char* name, VLString* value) const {
  if (m_HeaderEnd == 0) return false;
  size_t nameLength = strlen(name);
  // Each field line starts after a "\r\n" within the header; the last one ends at the blank line.
  for (const char* line = m_Fields; line < m_HeaderEnd;) {
    const char* text = line + 2;
    const char* end = FindLineEnd(text, m_HeaderEnd + 2);
    line = end;
    if (static_cast<size_t>(end - text) <= nameLength || strncasecmp(text, name, nameLength) != 0 ||
        text[nameLength] != ':')
      continue;
    text += nameLength + 1;
    while (text < end && (*text == ' ' || *text == '\t')) ++text;
    while (end > text && (end[-1] == ' ' || end[-1] == '\t')) --end;
    value->assign(text, static_cast<size_t>(end - text));
    return true;
  }
  return false;
}

size_t VLHttpGet::Receive(char* buffer, size_t n) { return m_Connection.Receive(buffer, n); }

bool VLHttpGet::ReceiveBody() {
  if (m_Body == 0) return false;
  char* body = m_Piece + (m_Body - m_Piece);
  if (m_ContentLength > static_cast<uint64_t>(m_Piece + kPieceSize - 1 - body)) return false;
  while (m_BodyReceived < m_ContentLength) {
    size_t got = m_Connection.Receive(body + m_BodyReceived, static_cast<size_t>(m_ContentLength) - m_BodyReceived);
    if (got == 0) return false;
    m_BodyReceived += got;
    m_Received += got;
  }
  body[m_BodyReceived] = 0;
  return true;
}

void VLHttpGet::Close() { m_Connection.Close(); }
