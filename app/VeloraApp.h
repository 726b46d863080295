// The application object that the launcher gets from createApplication2: it starts and stops
// the device's DRM service and network message queue and registers the three script extension
// classes (DUDUVudAE, VLCfgLibAE, VLPlayerLibAE) with the stage.
#ifndef VELORAAPP_H
#define VELORAAPP_H

#include "IApplication.h"
#include "IStagecraft.h"

extern "C" {
// The library's entry point: a new application object, owned by the launcher.
scLauncher::IApplication2* createApplication2();
// Set by another component of the process; non-zero makes onTerminate send an extra key first.
extern unsigned char sp_flag;
}

namespace veloraApp {

class VeloraApp : public scLauncher::IApplication2 {
 public:
  VeloraApp();
  // Stops the network message queue and the DRM service, whether or not init ran.
  ~VeloraApp() override;

  // Gets the stage, starts the DRM service (a failure is reported and ignored) and the network
  // message queue (a failure is reported and leaves the classes unregistered), then registers
  // the extension classes. Without a stage nothing is started.
  void init(scLauncher::ILauncher* launcher) override;
  // Sends the exit keys to the stage (none without one).
  void onTerminate() override;
  void onEvent(ADDON_HOST_EVENT_T event) override;
  // Lets every key through.
  bool filterKeyEvent(unsigned int keyCode, bool pressed) override;

 private:
  ae::stagecraft::IStagecraft* m_Stage;  // not owned
};

}  // namespace veloraApp

#endif  // VELORAAPP_H
