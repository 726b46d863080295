#include "VLTransportConnection.h"

#include <string.h>

#include "VLAssert.h"

VLTransportConnection::VLTransportConnection(soap* context) : m_Soap(context), m_Open(false) {
  VL_ASSERT(m_Soap != 0);
}

VLTransportConnection::~VLTransportConnection() { Close(); }

bool VLTransportConnection::Open(const char* url, const char* host, int port) {
  Close();
  // The callbacks read the endpoint's parts from the context, as in a SOAP call, and the send
  // and receive callbacks use the context's socket.
  soap_set_endpoint(m_Soap, url);
  m_Soap->error = SOAP_OK;
  m_Soap->socket = m_Soap->fopen(m_Soap, url, host, port);
  m_Open = soap_valid_socket(m_Soap->socket);
  return m_Open;
}

bool VLTransportConnection::Send(const char* data, size_t n) {
  return m_Open && m_Soap->fsend(m_Soap, data, n) == SOAP_OK;
}

bool VLTransportConnection::Send(const char* text) { return Send(text, strlen(text)); }

size_t VLTransportConnection::Receive(char* buffer, size_t n) {
  return m_Open ? m_Soap->frecv(m_Soap, buffer, n) : 0;
}

void VLTransportConnection::Close() {
  if (!m_Open) return;
  m_Soap->fclose(m_Soap);
  m_Soap->socket = SOAP_INVALID_SOCKET;
  m_Open = false;
}
