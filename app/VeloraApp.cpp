// The application object and the library's entry point.
#include "VeloraApp.h"

#include <chrono>
#include <cstdio>
#include <new>
#include <thread>

#include "DUDUVudAE.h"
#include "VLCfgLibAE.h"
#include "VLPlayerLibAE.h"
#include "VL_PlatformServices.h"

extern "C" {
unsigned char sp_flag = 0;
}

namespace veloraApp {

namespace {

// Sent by onTerminate only when sp_flag is set, followed by a pause that gives the stage time
// to act on it.
const unsigned int kSpFlagKey = 0x01000009;
const int kSpFlagPauseMs = 800;
// Always sent by onTerminate.
const unsigned int kTerminateKey = 0x00400100;

void Trace(const char* function, int line) {
  printf("[VL_FLASH]Enter %s ,line = %d \n", function, line);
}

void SendKey(ae::stagecraft::IStagecraft* stage, unsigned int key) {
  stage->SendKeyPress(key, 0);
  stage->SendKeyRelease(key);
}

}  // namespace

VeloraApp::VeloraApp() : m_Stage(nullptr) {}

VeloraApp::~VeloraApp() {
  Trace("~VeloraApp", 78);
  // Store objects the movie dropped mid-request are still being deleted; their threads run the
  // library's code, which must not go before they have ended.
  DUDUVudAE::JoinDroppedInstances();
  printf("[VL_FLASH] Uninit network ipc \n");
  uninit_network_msg_queue();
  int ret = Ipriv_drm_Terminate();
  if (ret != 0) printf("\n[VL_FLASH] Ipriv_drm_Terminate fail.ret = %d \n", ret);
}

void VeloraApp::init(scLauncher::ILauncher* launcher) {
  Trace("init", 94);
  m_Stage = launcher ? launcher->GetStagecraft() : nullptr;
  if (!m_Stage) return;
  Trace("init", 99);
  int ret = Ipriv_drm_Init();
  if (ret != 0) printf("\n[VL_FLASH] Ipriv_drm_Init fail.ret = %d \n", ret);
  printf("[VL_FLASH] Init network ipc \n");
  if (init_network_msg_queue() != 0) {
    printf("[VL_FLASH] init_network_msg_queue Error \n");
    return;
  }
  m_Stage->RegisterExtensionClass(ae::stagecraft::DescribeExtensionClass<DUDUVudAE>());
  m_Stage->RegisterExtensionClass(ae::stagecraft::DescribeExtensionClass<VLCfgLibAE>());
  m_Stage->RegisterExtensionClass(ae::stagecraft::DescribeExtensionClass<VLPlayerLibAE>());
}

void VeloraApp::onTerminate() {
  Trace("onTerminate", 133);
  if (!m_Stage) return;
  printf("\n[VL_FLASH] Now send  AEKEY_TERMINATEANIMATION \n");
  if (sp_flag != 0) {
    SendKey(m_Stage, kSpFlagKey);
    printf("In Sleep FUNCTION, delay time is :%d ms\n", kSpFlagPauseMs);
    fflush(stdout);
    std::this_thread::sleep_for(std::chrono::milliseconds(kSpFlagPauseMs));
  }
  SendKey(m_Stage, kTerminateKey);
}

void VeloraApp::onEvent(ADDON_HOST_EVENT_T) { Trace("onEvent", 154); }

bool VeloraApp::filterKeyEvent(unsigned int, bool) {
  Trace("filterKeyEvent", 159);
  return true;
}

}  // namespace veloraApp

extern "C" scLauncher::IApplication2* createApplication2() {
  veloraApp::Trace("createApplication2", 169);
  veloraApp::Trace("VeloraApp", 71);
  return new (std::nothrow) veloraApp::VeloraApp;
}
