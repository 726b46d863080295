// VLAnswerMemo: the decoded records of the cached answers that a handle and its duplicates
// stored or read last, so that a cache hit converts a record it already has instead of inflating
// and parsing the stored text again. A record counts only for the very bytes it was decoded from
// (or stored as): a hit compares the text the cache holds now with them, so the memo never
// answers anything the cache does not hold.
//
// The records live in the memo's own SOAP context. It keeps at most kCapacity records and then
// starts afresh: a context frees its records only all together. Handles on several threads share one memo (the page prefetch stores the
// pages that the main handle reads next); every use holds its lock.
#ifndef VLANSWERMEMO_H
#define VLANSWERMEMO_H

#include <memory>
#include <mutex>
#include <typeinfo>
#include <vector>

#include "Serializer.h"
#include "VLString.h"

class VLAnswerMemo {
 public:
  // The page shown and the eight pages fetched around it.
  static const size_t kCapacity = 10;

  VLAnswerMemo();
  ~VLAnswerMemo();
  VLAnswerMemo(const VLAnswerMemo&) = delete;
  VLAnswerMemo& operator=(const VLAnswerMemo&) = delete;

  // Calls use(const Response&) with the record of value, the text the cache holds under name and
  // key: the record kept for that very text, or one decoded from it now (and kept). Returns use's
  // result, or false without calling it when value does not decode as a Response.
  // newResponse makes a Response in a context (soap_new_<Response>).
  template <class Response, class Reader>
  bool Use(const char* name, const VLString& key, const VLString& value, Response* (*newResponse)(soap*, int),
           Reader use);

  // Keeps response, just stored under name and key as value. Everything owner allocated so far
  // (response included) becomes the memo's: owner must not use any of it afterwards.
  template <class Response>
  void Keep(const char* name, const VLString& key, const VLString& value, Response* response, soap* owner);

 private:
  struct Entry {
    VLString name;
    VLString key;
    const std::type_info* type;
    VLString value;  // the text the record was decoded from or stored as
    const void* record;
  };

  // The record of type kept for name, key and value, or null. Requires the lock.
  const void* Find(const char* name, const VLString& key, const std::type_info& type, const VLString& value);
  // Makes room for one more record: drops all of them when the memo is full. Requires the lock.
  void MakeRoom();
  void Add(const char* name, const VLString& key, const std::type_info& type, const VLString& value,
           const void* record);

  std::mutex m_Mutex;
  soap* m_Records;  // owns every record kept
  std::vector<Entry> m_Entries;
  size_t m_Kept = 0;  // records kept since the context was last emptied
};

template <class Response, class Reader>
bool VLAnswerMemo::Use(const char* name, const VLString& key, const VLString& value,
                       Response* (*newResponse)(soap*, int), Reader use) {
  std::lock_guard<std::mutex> lock(m_Mutex);
  const Response* record = static_cast<const Response*>(Find(name, key, typeid(Response), value));
  if (record == nullptr) {
    // A new decoder each time: an input pass that fails may leave the runtime's state behind
    // (an inflate stream still open, for one).
    std::unique_ptr<Serializer> decoder(new Serializer(false, false));
    Response* decoded = newResponse(decoder.get(), -1);
    decoder->SetXML(value);
    if (decoded == nullptr || decoder->Get(*decoded) != SOAP_OK) return false;
    MakeRoom();
    ++m_Kept;
    soap_delegate_deletion(decoder.get(), m_Records);
    Add(name, key, typeid(Response), value, decoded);
    record = decoded;
  }
  return use(*record);
}

template <class Response>
void VLAnswerMemo::Keep(const char* name, const VLString& key, const VLString& value, Response* response,
                        soap* owner) {
  std::lock_guard<std::mutex> lock(m_Mutex);
  MakeRoom();
  ++m_Kept;
  soap_delegate_deletion(owner, m_Records);
  Add(name, key, typeid(Response), value, response);
}

#endif  // VLANSWERMEMO_H
