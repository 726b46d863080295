#include "Serializer.h"

#include <string.h>

#include "VLAssert.h"

// Text content is kept as UTF-8 bytes in both directions, as in the service contexts: without
// SOAP_C_UTFSTRING the runtime would take every byte above 0x7F for a Latin-1 character, writing
// UTF-8 text double-encoded and folding characters above U+00FF of a file written by hand.
Serializer::Serializer(bool compress, bool indent)
    : soap(SOAP_ENC_XML | SOAP_C_UTFSTRING, SOAP_ENC_XML | SOAP_C_UTFSTRING |
                                                (compress ? SOAP_ENC_ZLIB : 0) |
                                                (indent ? SOAP_XML_INDENT : 0)) {
  user = this;
  fsend = Serializer_fsend;
  frecv = Serializer_frecv;
  soap_set_namespaces(this, ::namespaces);  // the library's table (soap/VLNamespaces.cpp)
}

Serializer::~Serializer() {
  soap_destroy(this);
  soap_end(this);
}

void Serializer::SetXML(const VLString& xml) { m_XML = xml; }

VLString Serializer::GetXML() const { return m_XML; }

int Serializer::BeginPut() {
  soap_begin(this);
  int result = soap_begin_send(this);
  // Plain XML of one record: no SOAP encodingStyle attribute on it.
  version = 1;
  encodingStyle = NULL;
  return result;
}

int Serializer::EndPut() { return soap_end_send(this); }

int Serializer::BeginGet() {
  soap_begin(this);
  return soap_begin_recv(this);
}

int Serializer::EndGet() { return soap_end_recv(this); }

int Serializer::Serializer_fsend(struct soap* soap, const char* data, size_t n) {
  Serializer* pSerializer = static_cast<Serializer*>(soap->user);
  VL_ASSERT(pSerializer != 0);
  pSerializer->m_XML.append(data, n);
  return SOAP_OK;
}

size_t Serializer::Serializer_frecv(struct soap* soap, char* buf, size_t n) {
  Serializer* pSerializer = static_cast<Serializer*>(soap->user);
  VL_ASSERT(pSerializer != 0);
  VLString& xml = pSerializer->m_XML;
  size_t count = xml.length() < n ? xml.length() : n;
  if (count == 0) return 0;
  memcpy(buf, xml.c_str(), count);
  xml.assign(xml.c_str() + count, xml.length() - count);
  return count;
}
