// ae::stagecraft::IStagecraft: the stage interface that the launcher hands to applications.
#ifndef ISTAGECRAFT_H
#define ISTAGECRAFT_H

#include "AEError.h"
#include "ASExtensionClass.h"

namespace ae {
namespace stagecraft {

class IStagecraft {
 public:
  // Registers an extension class; the stage copies the descriptor. AEError_Usage when a class
  // with the same id is already registered, AEError_InvalidParameters for a descriptor with a
  // missing function or class id.
  virtual AEError RegisterExtensionClass(const ASExtensionClassDescriptor& descriptor) = 0;
  // Delivers a key to the stage.
  virtual void SendKeyPress(unsigned int keyCode, unsigned int modifiers) = 0;
  virtual void SendKeyRelease(unsigned int keyCode) = 0;

 protected:
  virtual ~IStagecraft() {}
};

}  // namespace stagecraft
}  // namespace ae

#endif  // ISTAGECRAFT_H
