// VLHttpGet: one small hand-built HTTP/1.1 GET of the library (the device environment, the
// server time, the bandwidth probe, box-art images) over the connection of a SOAP context
// (VLTransportConnection): build the request from the URL, send it, receive the first piece of
// the answer, up to the end of its header however TCP cuts it, check its status line and
// "Content-Length", find the body, and give the caller's status for what came back. The rest of
// the body is read with ReceiveBody (small bodies) or Receive.
//
// The answer must start with "HTTP/1.1 200 OK\r\n" (or be a 404 or 304), and its whole header,
// with a "Content-Length" above 0, must fit into the first piece. The connection is closed by
// Close or the destructor.
#ifndef VLHTTPGET_H
#define VLHTTPGET_H

#include <stddef.h>
#include <stdint.h>

#include "VLString.h"
#include "VLTransportConnection.h"
#include "VL_WS_Types.h"

// The parts of an absolute URL "scheme://host[:port]/path".
struct VLHttpURL {
  VLString authority;  // the text between "//" and the next "/": host and port as written
  VLString host;
  int port;       // the URL's port; without one 443 for "https:" URLs (any letter case), else 80
  VLString path;  // the text after the "/" that ends the host
};

class VLHttpGet {
 public:
  // What differs between the library's requests: the order of the two header fields that every
  // request has, and the caller's statuses for a URL that does not split, "404 Not Found" and
  // "304 Not Modified". For every caller a connection that cannot be made (TCP, proxy tunnel or
  // TLS handshake) is VL_WS_E_CONNECT, and any other failure VL_WS_E_NETWORK: a failed send, no
  // answer, another status, no "Content-Length" above 0, a "Content-Encoding" other than
  // "identity" (the requests ask for none) or a header cut short.
  struct Kind {
    bool hostFirst;  // "Host" before "User-Agent" (the bandwidth probe), else after it
    VL_WS_Status badURL;
    VL_WS_Status notFound;
    VL_WS_Status notModified;
  };

  // The first piece of an answer, the whole header and what came with it, is received into a
  // buffer of this size (one byte is kept for the terminator).
  static const size_t kPieceSize = 2048;

  // Splits url: false when it has no "//", no "/" after the host, an empty host or path, or a
  // port that is not a number from 1 to 65535.
  static bool SplitURL(const char* url, VLHttpURL* parts);

  explicit VLHttpGet(soap* context);
  VLHttpGet(const VLHttpGet&) = delete;
  VLHttpGet& operator=(const VLHttpGet&) = delete;

  // Sends "GET /<path> HTTP/1.1", then fields (whole header lines, each ending in "\r\n", or
  // none), "User-Agent: DUDUVud" and "Host: <authority>" in kind's order and the blank line, to
  // url's host and port, and reads the first piece of the answer. VL_WS_OK for a 200 answer, else
  // the status of Kind; on any status but VL_WS_OK the connection is closed already.
  VL_WS_Status Get(const char* url, const Kind& kind, const VLString& fields = VLString());

  // After VL_WS_OK: the announced body length, and the body bytes that came with the header (at
  // most ContentLength of them; the text after them is terminated).
  uint64_t ContentLength() const { return m_ContentLength; }
  const char* Body() const { return m_Body; }
  size_t BodyReceived() const { return m_BodyReceived; }
  // After VL_WS_OK: the value of the header field name (compared ignoring case), without the
  // blanks around it. False when the header has no such field.
  bool Field(const char* name, VLString* value) const;

  // One more receive of at most n bytes of the body: the count received, 0 when the connection
  // ended, the receive time-out passed or the receive failed.
  size_t Receive(char* buffer, size_t n);
  // After VL_WS_OK: receives the rest of a body that fits into the first piece's buffer, so that
  // Body() holds all ContentLength bytes (terminated). False when it does not fit or the
  // connection ended before.
  bool ReceiveBody();
  void Close();

 private:
  // Checks the first piece (terminated, m_Received bytes): status, header end, Content-Length.
  VL_WS_Status ReadHeader(const Kind& kind);

  VLTransportConnection m_Connection;
  char m_Piece[kPieceSize];
  size_t m_Received;       // bytes in m_Piece
  const char* m_Fields;    // the header after the status line, starting at its "\r\n"
  const char* m_HeaderEnd; // the blank line ending the header ("\r\n\r\n")
  const char* m_Body;
  size_t m_BodyReceived;
  uint64_t m_ContentLength;
};

#endif  // VLHTTPGET_H
