#include "VLTlsSessionCache.h"

#include <map>
#include <mutex>
#include <string>

namespace {

class Sessions {
 public:
  ~Sessions() {
    for (auto& kept : m_Sessions) SSL_SESSION_free(kept.second);
  }

  SSL_SESSION* Get(const std::string& key) {
    std::lock_guard<std::mutex> lock(m_Mutex);
    auto it = m_Sessions.find(key);
    if (it == m_Sessions.end()) return nullptr;
    SSL_SESSION_up_ref(it->second);
    return it->second;
  }

  void Put(const std::string& key, SSL_SESSION* session) {
    SSL_SESSION_up_ref(session);
    std::lock_guard<std::mutex> lock(m_Mutex);
    SSL_SESSION*& slot = m_Sessions[key];
    if (slot) SSL_SESSION_free(slot);
    slot = session;
  }

  void Remove(const std::string& key) {
    std::lock_guard<std::mutex> lock(m_Mutex);
    auto it = m_Sessions.find(key);
    if (it == m_Sessions.end()) return;
    SSL_SESSION_free(it->second);
    m_Sessions.erase(it);
  }

 private:
  std::mutex m_Mutex;
  std::map<std::string, SSL_SESSION*> m_Sessions;  // by "host:port", a handful at most
};

// Destroyed when the library is unloaded or the process ends, when no handle is left.
Sessions& TheSessions() {
  static Sessions s_Sessions;
  return s_Sessions;
}

std::string Key(const char* host, int port) { return std::string(host) + ":" + std::to_string(port); }

}  // namespace

SSL_SESSION* VLTlsSessionCache::Get(const char* host, int port) { return TheSessions().Get(Key(host, port)); }

void VLTlsSessionCache::Put(const char* host, int port, SSL_SESSION* session) {
  if (session && SSL_SESSION_is_resumable(session)) TheSessions().Put(Key(host, port), session);
}

void VLTlsSessionCache::Remove(const char* host, int port) { TheSessions().Remove(Key(host, port)); }
