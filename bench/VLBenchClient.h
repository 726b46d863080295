// What the benchmarks share: a client handle on the store simulator with a cache of its own, and
// the page of titles that most of them ask for.
#ifndef VLBENCHCLIENT_H
#define VLBENCHCLIENT_H

#include "VLTestDir.h"
#include "VLTestSimulator.h"
#include "VL_WS.h"

// A handle with a cache of cacheType holding the kinds in cacheData, in a new folder; the
// simulator must already run (VLTestSimulator(), or one that VLWS_CONNECT_TO names).
class VLBenchClient {
 public:
  explicit VLBenchClient(int cacheType = 0, int cacheData = 7) {
    VL_WS_SetupParams params = VLTestSetupParams(cacheType, cacheData, m_Dir.path().c_str());
    m_Ok = VL_WS_initialize(&m_Handle, &params) == VL_WS_OK;
  }
  ~VLBenchClient() { VL_WS_release(&m_Handle); }
  VLBenchClient(const VLBenchClient&) = delete;
  VLBenchClient& operator=(const VLBenchClient&) = delete;

  bool ok() const { return m_Ok; }
  VL_WS_Handle* handle() { return &m_Handle; }

 private:
  VLTestDir m_Dir;
  VL_WS_Handle m_Handle = {};
  bool m_Ok;
};

// Page page of itemsPerPage titles of genre 1 (every film), any purchase type.
inline VL_WS_Status VLBenchTitlesPage(VL_WS_Handle* handle, int page = 1, int itemsPerPage = 20) {
  VL_WS_TitlesResponse titles;
  VL_WS_Status status = VL_WS_getTitles(handle, 1, page, itemsPerPage, 2, &titles);
  VL_WS_release(&titles);
  return status;
}

#endif  // VLBENCHCLIENT_H
