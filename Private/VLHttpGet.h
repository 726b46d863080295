// VLHttpGet: one small hand-built HTTP/1.1 request of the library (the device environment, the
// server time, the bandwidth probe, box-art images) over the connection of a SOAP context
// (VLTransportConnection): send the request, receive the first piece of the answer, up to the end
// of its header however TCP cuts it, check its status line and "Content-Length", and find the
// body. The rest of the body is read with ReceiveBody (small bodies) or Receive.
//
// The answer must start with "HTTP/1.1 200 OK\r\n" (or one of the other statuses of Result),
// and its whole header, with a "Content-Length" above 0, must fit into the first piece. The
// connection is closed by Close or the destructor.
#ifndef VLHTTPGET_H
#define VLHTTPGET_H

#include <stddef.h>
#include <stdint.h>

#include "VLString.h"
#include "VLTransportConnection.h"

// The parts of an absolute URL "scheme://host[:port]/path".
struct VLHttpURL {
  VLString authority;  // the text between "//" and the next "/": host and port as written
  VLString host;
  int port;       // the URL's port; without one 443 for "https:" URLs (any letter case), else 80
  VLString path;  // the text after the "/" that ends the host
};

class VLHttpGet {
 public:
  enum Result {
    HTTP_OK,                // 200 OK with a Content-Length above 0 and the end of the header
    HTTP_CONNECT_FAILED,    // no connection (TCP, proxy tunnel or TLS handshake)
    HTTP_SEND_FAILED,
    HTTP_NOTHING_RECEIVED,  // the peer closed, the receive time-out passed or the receive failed
    HTTP_NOT_FOUND,         // "HTTP/1.1 404 Not Found"
    HTTP_NOT_MODIFIED,      // "HTTP/1.1 304 Not Modified"
    HTTP_BAD_ANSWER,        // another status, no Content-Length above 0, a Content-Encoding
                            // other than "identity", or a header cut short
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

  // Connects to url (its host and port given apart, as the context's open callback takes them),
  // sends request whole and reads the first piece of the answer. On any result but HTTP_OK the
  // connection is closed already.
  Result Run(const char* url, const char* host, int port, const VLString& request);

  // After HTTP_OK: the announced body length, and the body bytes that came with the header (at
  // most ContentLength of them; the text after them is terminated).
  uint64_t ContentLength() const { return m_ContentLength; }
  const char* Body() const { return m_Body; }
  size_t BodyReceived() const { return m_BodyReceived; }
  // After HTTP_OK: the value of the header field name (compared ignoring case), without the
  // blanks around it. False when the header has no such field.
  bool Field(const char* name, VLString* value) const;

  // One more receive of at most n bytes of the body: the count received, 0 when the connection
  // ended, the receive time-out passed or the receive failed.
  size_t Receive(char* buffer, size_t n);
  // After HTTP_OK: receives the rest of a body that fits into the first piece's buffer, so that
  // Body() holds all ContentLength bytes (terminated). False when it does not fit or the
  // connection ended before.
  bool ReceiveBody();
  void Close();

 private:
  // Checks the first piece (terminated, m_Received bytes): status, header end, Content-Length.
  Result ReadHeader();

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
