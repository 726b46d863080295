// VLCfgLibAE: the native side of the script class "com.ostrel.VLCfgLib", through which the movie
// reads and writes its configuration and settings files. Methods work synchronously on the
// engine's thread and write their result into their last argument.
#ifndef VLCFGLIBAE_H
#define VLCFGLIBAE_H

#include "AEArray.h"
#include "AEString.h"
#include "ASExtensionClass.h"

class VLCfgLibAE : public ae::stagecraft::ASExtensionClass {
 public:
  // The class functions that register the class with the stage.
  static const char* GetClassName();
  static bool FiresEvents();
  // Appends the 6 method entries, in table order, at the end of table.
  static void GetMethods(AEArray<Method>& table);
  static ae::stagecraft::ASExtensionClass* ConstructInstance(StageWindow* window, ASObject& object,
                                                             ASValueArray& arguments);
  static void DestructInstance(StageWindow* window, ASObject& object);

  void init(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void setFile(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void read(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void write(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void selectEnv(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void clearEnv(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);

 private:
  AEString m_ConfigurationFile;  // read only
  AEString m_SettingsFile;       // the settings file in use
  AEString m_BaseSettingsFile;   // given to init or setFile; the environments' files derive from it
};

#endif  // VLCFGLIBAE_H
