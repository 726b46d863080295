// Logging of the library. Every message goes to the platform logging service (VL_Log.h) by area
// and level. Levels: 1 error, 4 trace (entry and exit lines, results, progress), 8 parameter
// detail.
//
// A source file that logs keeps one lazily registered area:
//   static VLLogArea s_Log(VLWSAELOG_AREA_NAME);
//   VLLogOutputwithConfig({s_Log.Id(), 4}, "%s, ret:%d\n", name, ret);
// and a script method traces its whole body with a scope object:
//   VLWSAELog log("DUDUVudAE", "getTitles", s_Log.Id());
#ifndef VLWSAELOG_H
#define VLWSAELOG_H

#include <atomic>

#include "VLString.h"

// The library's log area names and the ids of the SOAP message areas, exported for the platform
// and the player library. The ids are -1 until soap_init_vl_log() registers them.
extern "C" {
extern const char VLWSAELOG_AREA_NAME[];          // "VL_WSAE": the web-service extension
extern const char VLWSAE_CFGLOG_AREA_NAME[];      // "VL_WSCFGAE": the configuration extension
extern const char VLWS_SoapProxyLOG_AREA_NAME[];  // "soap_proxy": the SOAP service proxies
extern const char VLWS_SoapRecvLOG_AREA_NAME[];   // "soap_recv": received SOAP messages
extern const char VLWS_SoapSentLOG_AREA_NAME[];   // "soap_sent": sent SOAP messages
extern const char VLWS_SoapTestLOG_AREA_NAME[];   // "soap_test": record copy tracing
extern int RECV_VLLogAreaID;
extern int SENT_VLLogAreaID;
extern int TEST_VLLogAreaID;
}

// Registers "soap_recv", "soap_sent" and "soap_test" into the three exported ids, once per
// process; later calls do nothing.
void soap_init_vl_log();

// A log area registered on first use. Until a registration succeeds, Id() is -1 (messages to it
// are dropped) and every call tries again. Without a lock: two threads may both register on
// first use, and both get the same valid id.
class VLLogArea {
 public:
  constexpr explicit VLLogArea(const char* name) : m_Name(name), m_Id(-1), m_Registered(false) {}
  VLLogArea(const VLLogArea&) = delete;
  VLLogArea& operator=(const VLLogArea&) = delete;

  int Id();

 private:
  const char* m_Name;
  std::atomic<int> m_Id;
  std::atomic<bool> m_Registered;
};

// Where and at which level a message goes.
struct VLLogOutputConfig {
  int area;
  int level;
};

// Formats one message (at most 511 bytes; longer text is cut) and writes it to config.area at
// config.level. The formatted text is written as it is: '%' in it is not interpreted again.
void VLLogOutputwithConfig(VLLogOutputConfig config, const char* format, ...)
#ifdef __GNUC__
    __attribute__((format(printf, 2, 3)))
#endif
    ;

// Scope trace of a method: logs "Entering <class>::<method>" at level 4 when made and
// "Exiting <class>::<method>" when destroyed.
class VLWSAELog {
 public:
  VLWSAELog(const char* className, const char* methodName, int areaId);
  ~VLWSAELog();
  VLWSAELog(const VLWSAELog&) = delete;
  VLWSAELog& operator=(const VLWSAELog&) = delete;

  // One of the library's log areas and its bit in the activation mask of InitWSLogs.
  struct AreaInfo {
    const char* name;
    unsigned int bit;
    int id;  // -1 until InitWSLogs registers the area
  };
  static const int kAreaCount = 6;
  // "VL_WSAE" 0x100, "VL_WSCFGAE" 0x200, "soap_proxy" 0x400, "soap_recv" 0x800,
  // "soap_sent" 0x1000, "soap_test" 0x2000.
  static AreaInfo m_areainfos[kAreaCount];

  // Registers the six areas and activates exactly those whose bit is in areaMask, then selects
  // the target: bit 0 of target the console, else bit 1 the file "<directory>log.txt"
  // ("./log.txt" for an empty or null directory). Returns 0 when a target was set, 1 when target
  // selects none (the current target stays), 2 when the log file cannot be opened, 3 when the
  // platform rejects its path.
  static int InitWSLogs(unsigned int areaMask, unsigned char target, const char* directory);

 private:
  VLString m_ClassName;
  VLString m_MethodName;
  int m_AreaId;
};

#endif  // VLWSAELOG_H
