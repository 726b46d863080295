#include "VLWSAELog.h"

#include <stdarg.h>
#include <stdint.h>
#include <stdio.h>

#include "VL_Log.h"

extern "C" {
const char VLWSAELOG_AREA_NAME[] = "VL_WSAE";
const char VLWSAE_CFGLOG_AREA_NAME[] = "VL_WSCFGAE";
const char VLWS_SoapProxyLOG_AREA_NAME[] = "soap_proxy";
const char VLWS_SoapRecvLOG_AREA_NAME[] = "soap_recv";
const char VLWS_SoapSentLOG_AREA_NAME[] = "soap_sent";
const char VLWS_SoapTestLOG_AREA_NAME[] = "soap_test";
int RECV_VLLogAreaID = -1;
int SENT_VLLogAreaID = -1;
int TEST_VLLogAreaID = -1;
}

void soap_init_vl_log() {
  // A function-local static runs the registration exactly once, even when several threads make
  // their first SOAP call at the same time.
  static const bool registered = [] {
    VL_LogRegisterArea(VLWS_SoapRecvLOG_AREA_NAME, &RECV_VLLogAreaID);
    VL_LogRegisterArea(VLWS_SoapSentLOG_AREA_NAME, &SENT_VLLogAreaID);
    VL_LogRegisterArea(VLWS_SoapTestLOG_AREA_NAME, &TEST_VLLogAreaID);
    return true;
  }();
  (void)registered;
}

int VLLogArea::Id() {
  if (!m_Registered.load(std::memory_order_acquire)) {
    int id = -1;
    if (VL_LogRegisterArea(m_Name, &id) == 0) {
      m_Id.store(id, std::memory_order_relaxed);
      m_Registered.store(true, std::memory_order_release);
    }
  }
  return m_Id.load(std::memory_order_relaxed);
}

void VLLogOutputwithConfig(VLLogOutputConfig config, const char* format, ...) {
  char message[512];
  va_list args;
  va_start(args, format);
  vsnprintf(message, sizeof message, format, args);
  va_end(args);
  VL_LogOutput(config.area, config.level, "%s", message);
}

VLWSAELog::VLWSAELog(const char* className, const char* methodName, int areaId)
    : m_ClassName(className), m_MethodName(methodName), m_AreaId(areaId) {
  VL_LogOutput(m_AreaId, 4, "Entering %s::%s\n", m_ClassName.c_str(), m_MethodName.c_str());
}

VLWSAELog::~VLWSAELog() {
  VL_LogOutput(m_AreaId, 4, "Exiting %s::%s\n", m_ClassName.c_str(), m_MethodName.c_str());
}

VLWSAELog::AreaInfo VLWSAELog::m_areainfos[VLWSAELog::kAreaCount] = {
    {VLWSAELOG_AREA_NAME, 0x100, -1},         {VLWSAE_CFGLOG_AREA_NAME, 0x200, -1},
    {VLWS_SoapProxyLOG_AREA_NAME, 0x400, -1}, {VLWS_SoapRecvLOG_AREA_NAME, 0x800, -1},
    {VLWS_SoapSentLOG_AREA_NAME, 0x1000, -1}, {VLWS_SoapTestLOG_AREA_NAME, 0x2000, -1},
};

int VLWSAELog::InitWSLogs(unsigned int areaMask, unsigned char target, const char* directory) {
  for (AreaInfo& area : m_areainfos) {
    VL_LogRegisterArea(area.name, &area.id);
    VL_LogActivateArea(area.id, (areaMask & area.bit) ? 1 : 0);
  }

  uintptr_t t1 = 0, t2 = 0;
  if (target & 1) {
    VL_LogGetConsoleTarget(&t1, &t2);
    VL_LogSetTarget(t1, t2);
    return 0;
  }
  if (!(target & 2)) return 1;

  // Built without a length limit: a long directory must not be cut into some other path.
  VLString path = (directory && *directory) ? VLString(directory) + "log.txt" : VLString("./log.txt");
  switch (VL_LogGetFileTarget(path.c_str(), &t1, &t2, 0, 1)) {
    case 0:
      VL_LogSetTarget(t1, t2);
      return 0;
    case 1:
      return 3;
    case 2:
      return 2;
    default:
      return 0;
  }
}
