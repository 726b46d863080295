// scLauncher::IApplication and IApplication2: the interface through which the launcher drives
// an application it loaded. The launcher gets the application from the library's entry point
// createApplication2, calls init, forwards host and key events, calls onTerminate, and finally
// deletes the application through its virtual destructor.
#ifndef IAPPLICATION_H
#define IAPPLICATION_H

#include "ILauncher.h"

// Host events that the launcher forwards to the application.
enum ADDON_HOST_EVENT_T {
  ADDON_HOST_EVENT_SUSPEND = 0,
  ADDON_HOST_EVENT_RESUME = 1,
  ADDON_HOST_EVENT_NETWORK_CHANGED = 2
};

namespace scLauncher {

class IApplication {
 public:
  virtual ~IApplication() {}
  virtual void init(ILauncher* launcher) = 0;
  virtual void onTerminate() = 0;
  virtual void onEvent(ADDON_HOST_EVENT_T event) = 0;
};

class IApplication2 : public IApplication {
 public:
  // Whether the application lets the key reach the movie.
  virtual bool filterKeyEvent(unsigned int keyCode, bool pressed) = 0;
};

}  // namespace scLauncher

#endif  // IAPPLICATION_H
