// VLTransportConnection: one hand-written HTTP exchange (the device-environment query, box-art
// downloads) over the connection callbacks of a SOAP context, so that it takes the same road as
// the context's SOAP calls: VLWS_CONNECT_TO, TLS with the context's TLS context for "https" URLs,
// the context's time-outs and the raw logging of sent and received bytes (VLSoapTransport).
//
// The context's socket is the connection's while it is open; the exchange must not overlap a
// SOAP call on the same context. The destructor closes a connection still open.
#ifndef VLTRANSPORTCONNECTION_H
#define VLTRANSPORTCONNECTION_H

#include <stddef.h>

#include "stdsoap2.h"

class VLTransportConnection {
 public:
  explicit VLTransportConnection(soap* context);
  ~VLTransportConnection();
  VLTransportConnection(const VLTransportConnection&) = delete;
  VLTransportConnection& operator=(const VLTransportConnection&) = delete;

  // Connects to url, whose host and port are given apart (as the open callback takes them).
  // False when no connection could be made (TCP, proxy tunnel or TLS handshake).
  bool Open(const char* url, const char* host, int port);
  // Sends the n bytes with one call of the send callback; false when that failed.
  bool Send(const char* data, size_t n);
  bool Send(const char* text);
  // One call of the receive callback for at most n bytes: the count received, 0 when the peer
  // closed, the receive time-out passed or the receive failed.
  size_t Receive(char* buffer, size_t n);
  // Closes the connection if it is open.
  void Close();

 private:
  soap* m_Soap;
  bool m_Open;
};

#endif  // VLTRANSPORTCONNECTION_H
