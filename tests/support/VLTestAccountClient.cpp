#include "VLTestAccountClient.h"

#include "VLWSAELog.h"
#include "VL_Log.h"

const char VLTestAccountClient::kPin[] = "1234";

void VLTestAccountClient::SetUp() {
  VLSimClientTest::SetUp();
  m_Account = m_Sim.Store().AccountForPin(kPin);
  ASSERT_NE(0, m_Account);
  m_Sim.Store().WishlistClear(m_Account);
  // Only the library's own area, into a file of the test's folder: the observer sees its lines.
  VLWSAELog::InitWSLogs(0x100, 2, m_LogDir.path().c_str());
  VL_LogSetObserver(Observe, this);
}

void VLTestAccountClient::TearDown() {
  VL_LogSetObserver(nullptr, nullptr);
  VLWSAELog::InitWSLogs(0, 1, "");
  VLSimClientTest::TearDown();
}

void VLTestAccountClient::Init(VL_WS_AccessType accessType, int cacheData) {
  VL_WS_release(&m_Handle);
  std::string token;
  int account = 0;
  ASSERT_EQ(0, m_Sim.Store().Authorize(kPin, "00-11-22-33-44-55", 7, &token, &account));
  VL_WS_SetupParams params = VLTestSetupParams(cacheData != 0 ? 1 : 0, cacheData);
  params.AuthToken = token.c_str();
  params.AccessType = accessType;
  ASSERT_EQ(VL_WS_OK, VL_WS_initialize(&m_Handle, &params));
  m_Sim.ClearRequests();
  m_Log.clear();
}

std::vector<std::string> VLTestAccountClient::TakeLog() {
  std::vector<std::string> lines;
  lines.swap(m_Log);
  return lines;
}

void VLTestAccountClient::Observe(void* ctx, const char* area, int level, const char* text, size_t len) {
  if (std::string(area) != VLWSAELOG_AREA_NAME || level != 4) return;
  if (len > 0 && text[len - 1] == '\n') --len;
  static_cast<VLTestAccountClient*>(ctx)->m_Log.push_back(std::string(text, len));
}
