// Serializer: a SOAP runtime context whose transport is a byte buffer instead of a socket, so
// that the generated serialisers turn any schema record into XML text and back. The cache keeps
// service answers in this form (gzip-compressed) and the settings files are its plain, indented
// output. Nothing here touches the network.
//
// The context is large (about 164 KB): allocate a Serializer with new, never on a thread's stack.
// Callers that only store one record use StoreResponse below, which does that and the whole
// Begin/End sequence for them; VLAnswerMemo reads stored records back.
//
// Reading needs no compression flag: the runtime recognises a gzip stream by its first byte and
// inflates it.
#ifndef SERIALIZER_H
#define SERIALIZER_H

#include <stddef.h>

#include <memory>

#include "VLString.h"
#include "soapH.h"

class Serializer : public soap {
 public:
  // The element tag of every stored record.
  static constexpr const char* kElementTag = "DUDUVud";

  // Plain XML without envelope or HTTP, UTF-8 text kept as it is, in both directions; compress
  // makes the output a gzip stream, indent indents the output.
  Serializer(bool compress, bool indent);
  virtual ~Serializer();
  Serializer(const Serializer&) = delete;
  Serializer& operator=(const Serializer&) = delete;

  // The buffer: the text an output pass produced, or the text an input pass still has to read.
  void SetXML(const VLString& xml);
  VLString GetXML() const;

  // One output pass: BeginPut, the record's soap_serialize and soap_put, EndPut. BeginPut writes
  // no SOAP encodingStyle attribute. Each returns the runtime's result (SOAP_OK is 0).
  int BeginPut();
  int EndPut();
  // One input pass: BeginGet, the record's soap_get, EndGet.
  int BeginGet();
  int EndGet();

  // Replaces the buffer with record as one "DUDUVud" element: a whole output pass.
  // Returns the runtime's result.
  template <class T>
  int Put(const T& record);
  // Reads the buffer's "DUDUVud" element into record: a whole input pass. The strings, nested
  // records and arrays it fills in live in this context's memory. On failure record is reset to
  // its defaults (no pointer into a half-read message survives). Returns the runtime's result.
  template <class T>
  int Get(T& record);

  // The context's transport callbacks. fsend appends n bytes to the buffer and returns SOAP_OK.
  // frecv moves up to n bytes from the front of the buffer into buf and returns their count;
  // 0 means the end of the input (empty buffer, or n is 0).
  static int Serializer_fsend(struct soap* soap, const char* data, size_t n);
  static size_t Serializer_frecv(struct soap* soap, char* buf, size_t n);

 private:
  VLString m_XML;
};

template <class T>
int Serializer::Put(const T& record) {
  SetXML(VLString());
  if (BeginPut() != SOAP_OK) return error;
  record.soap_serialize(this);
  if (record.soap_put(this, kElementTag, NULL) != SOAP_OK) return error;
  return EndPut();
}

template <class T>
int Serializer::Get(T& record) {
  if (BeginGet() == SOAP_OK) {
    if (record.soap_get(this, kElementTag, NULL) != NULL) {
      EndGet();
    } else if (error == SOAP_OK) {
      error = SOAP_TAG_MISMATCH;  // no record read must never look like success
    }
  }
  if (error != SOAP_OK) record.soap_default(this);
  return error;
}

// Stores a response record the way the cache keeps it: the XML of one "DUDUVud" element, gzip-
// compressed when compress is set, in value. False (value untouched) when the runtime failed.
template <class T>
bool StoreResponse(const T& record, VLString& value, bool compress) {
  std::unique_ptr<Serializer> serializer(new Serializer(compress, false));
  if (serializer->Put(record) != SOAP_OK) return false;
  value = serializer->GetXML();
  return true;
}

#endif  // SERIALIZER_H
