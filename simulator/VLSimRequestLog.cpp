#include "VLSimRequestLog.h"

#include <chrono>

void VLSimRequestLog::Add(const VLSimRequest& request) {
  std::lock_guard<std::mutex> lock(m_Mutex);
  m_Entries.push_back(request);
  m_Added.notify_all();
}

bool VLSimRequestLog::WaitFor(size_t count, int milliseconds) {
  std::unique_lock<std::mutex> lock(m_Mutex);
  return m_Added.wait_for(lock, std::chrono::milliseconds(milliseconds), [&] { return m_Entries.size() >= count; });
}

std::vector<VLSimRequest> VLSimRequestLog::Entries() {
  std::lock_guard<std::mutex> lock(m_Mutex);
  return m_Entries;
}

void VLSimRequestLog::Clear() {
  std::lock_guard<std::mutex> lock(m_Mutex);
  m_Entries.clear();
}

std::string VLSimRequestLog::Format(const VLSimRequest& r) {
  std::string line = "#" + std::to_string(r.connection) + (r.tls ? " https://" : " http://") + r.host + " " +
                     r.method + " " + r.path + (r.query.empty() ? "" : "?" + r.query) + " -> " +
                     std::to_string(r.status);
  if (!r.operation.empty()) {
    line += " " + r.service + "." + r.operation + " code " + std::to_string(r.responseCode) + " [" +
            r.settingsElement + " key=" + r.apiKey + " token=" + (r.hasAuthToken ? r.authToken : "(none)") +
            " user=" + r.userName + " auth=" + r.authentication + " id=" + r.messageID + "]";
  }
  if (r.resumed) line += " (TLS session resumed)";
  if (!r.faults.empty()) line += " faults: " + r.faults;
  if (!r.note.empty()) line += " (" + r.note + ")";
  return line;
}
