// scLauncher::ILauncher: what the application launcher offers the application it loaded.
#ifndef ILAUNCHER_H
#define ILAUNCHER_H

#include "IStagecraft.h"

namespace scLauncher {

class ILauncher {
 public:
  // The stage of the launcher; null when it has none.
  virtual ae::stagecraft::IStagecraft* GetStagecraft() = 0;

 protected:
  virtual ~ILauncher() {}
};

}  // namespace scLauncher

#endif  // ILAUNCHER_H
