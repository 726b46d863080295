#include "VLAnswerMemo.h"

#include <algorithm>

VLAnswerMemo::VLAnswerMemo() : m_Records(soap_new()) {}

VLAnswerMemo::~VLAnswerMemo() {
  soap_destroy(m_Records);
  soap_end(m_Records);
  soap_free(m_Records);
}

const void* VLAnswerMemo::Find(const char* name, const VLString& key, const std::type_info& type,
                               const VLString& value) {
  for (Entry& entry : m_Entries) {
    if (entry.name == name && entry.key == key && *entry.type == type)
      return entry.value == value ? entry.record : nullptr;
  }
  return nullptr;
}

void VLAnswerMemo::MakeRoom() {
  if (m_Kept < kCapacity) return;
  m_Entries.clear();
  soap_destroy(m_Records);
  soap_end(m_Records);
  m_Kept = 0;
}

void VLAnswerMemo::Add(const char* name, const VLString& key, const std::type_info& type, const VLString& value,
                       const void* record) {
  auto same = [&](const Entry& entry) { return entry.name == name && entry.key == key && *entry.type == type; };
  m_Entries.erase(std::remove_if(m_Entries.begin(), m_Entries.end(), same), m_Entries.end());
  m_Entries.push_back(Entry{name, key, &type, value, record});
}
