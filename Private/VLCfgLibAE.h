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
  // setFile's migration of the movie's old settings file oldSettingsFile and cache folder
  // oldCachePath: the old settings move to the old release's place ("1_00" folder) unless a
  // file is there already; the old file is removed only once its settings are safe there.
  void MigrateSettingsFile(const AEString& oldSettingsFile, const AEString& oldCachePath);
  // The settings file of environment env (0 to 3): the base settings file for 3 ("default"),
  // else the base's folder, the environment's name and the base's file name. False (logged)
  // for another number or a path of 100 bytes or more.
  bool EnvSettingsFile(const char* method, int env, AEString& path) const;
  // When the configuration file names a newer "XMLVersion" than the settings file (or the
  // settings file names none), rebuilds the settings file with only that version, the
  // account's token and the device identifier. A settings file that cannot be read is left as
  // it is (logged): rebuilding it would lose the token and identifier it may still hold.
  void checkXMLupgrade();
  // Whether version is empty or a text of digits and single dots.
  static bool checkXMLVersion(const char* version);

  AEString m_ConfigurationFile;  // read only
  AEString m_SettingsFile;       // the settings file in use
  AEString m_BaseSettingsFile;   // given to init or setFile; the environments' files derive from it
};

#endif  // VLCFGLIBAE_H
