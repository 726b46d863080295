// The configuration extension class: class functions, method table and methods.
#include "VLCfgLibAE.h"

#include <stdio.h>
#include <stdlib.h>
#include <string.h>

#include <cmath>
#include <new>

#include "ASObject.h"
#include "ASValue.h"
#include "VLFile.h"
#include "VLWSAELog.h"
#include "VL_WS.h"

namespace {

VLLogArea s_Log(VLWSAE_CFGLOG_AREA_NAME);

const char kXMLVersion[] = "XMLVersion";
const char kAuthToken[] = "AuthToken";
const char kDestinationUniqueID[] = "DestinationUniqueID";

// The per-environment settings paths are formatted into a buffer of this size; longer ones are
// refused.
const size_t kEnvPathSize = 100;

// Encrypted values (the account's token) never reach the log.
const char kMaskedValue[] = "********";

// Where the extension's messages go: progress at level 4, errors at level 1.
VLLogOutputConfig Trace() { return {s_Log.Id(), 4}; }
VLLogOutputConfig Error() { return {s_Log.Id(), 1}; }

const char* Outcome(bool done) { return done ? "Successfully" : "Failed to"; }
const char* Existence(bool exists) { return exists ? "existed" : "doesn't exist"; }

bool FileExists(const char* path) {
  bool exists = false;
  return VL_WS_fileExist(path, &exists) == VL_WS_OK && exists;
}

// The value of key in file: the status of VL_WS_readSetting, value empty unless it is VL_WS_OK.
VL_WS_Status ReadSetting(const AEString& file, const char* key, bool encrypted, AEString& value) {
  VL_WS_String text;
  VL_WS_Status status = VL_WS_readSetting(file.CString(), key, &text, encrypted);
  value.Set(status == VL_WS_OK ? text.Text : "");
  VL_WS_release(&text);
  return status;
}

bool WriteSetting(const AEString& file, const char* key, const AEString& value, bool encrypted) {
  return VL_WS_writeSetting(file.CString(), key, value.CString(), encrypted) == VL_WS_OK;
}

AEString NewDestinationUniqueID() {
  VL_WS_String id;
  VL_WS_getDestinationUniqueID(&id);
  AEString text(id.Text);
  VL_WS_release(&id);
  return text;
}

// The settings file of the movie's old release that setFile migrates: path with the folder that
// directly holds the file renamed to "1_00" (/data/app/2_05/ffpreference.xml gives
// /data/app/1_00/ffpreference.xml; app/ffpreference.xml gives 1_00/ffpreference.xml). A path
// without a folder to rename stays as it is.
AEString OldReleaseSettingsFile(const char* path) {
  const char* last = strrchr(path, VLFile::PATH_SEPERATOR);
  if (last == 0) return AEString(path);
  const char* folder = path;  // where the folder's name starts
  for (const char* c = last - 1; c >= path; --c) {
    if (*c == VLFile::PATH_SEPERATOR) {
      folder = c + 1;
      break;
    }
  }
  if (folder == path && last == path) return AEString(path);  // the file lies in "/"
  VLString renamed(path, folder - path);
  renamed += "1_00";
  renamed += last;
  return AEString(renamed.c_str(), renamed.length());
}

// init's choice of a file: the value of the environment variable name when it is set (printed
// with label), else path as it was; when that is empty, fallback (logged, the line ending with
// end).
void PathFromEnvironment(const AEString& name, const char* label, const char* fallback, const char* end,
                         AEString& path) {
  if (const char* value = getenv(name.CString())) {
    path.Set(value);
    printf("[VL_FLASH]\n %s = %s \n", label, value);
  }
  if (path.IsEmpty()) {
    VLLogOutputwithConfig(Trace(), "VLCfgLibAE::init environment variable (%s) is not set! Use \"%s\"%s\n",
                          name.CString(), fallback, end);
    path.Set(fallback);
  }
}

// A setting's argument: the argument at index of a call as text.
AEString TextArgument(ae::stagecraft::ASValueArray& arguments, size_t index) { return arguments.Get(index).AsString(); }

// The environment number of selectEnv and clearEnv: their only argument, a number or a text that
// holds one (what read returns), converted as the engine converts a value to an integer. An empty
// text, such as read's answer for a missing setting, names no environment.
bool EnvArgument(ae::stagecraft::ASValueArray& arguments, int* env) {
  if (arguments.Count() != 1) return false;
  const ae::stagecraft::ASValue& value = arguments.Get(0);
  bool numericText = value.IsString() && !value.AsString().IsEmpty() && !std::isnan(value.AsNumber());
  if (!value.IsNumber() && !numericText) return false;
  *env = value.AsInteger();
  return true;
}

}  // namespace

const char* VLCfgLibAE::GetClassName() { return "com.ostrel.VLCfgLib"; }

bool VLCfgLibAE::FiresEvents() { return false; }

void VLCfgLibAE::GetMethods(AEArray<Method>& table) {
  static const Method kMethods[] = {
      Method::Bind("init", &VLCfgLibAE::init),
      Method::Bind("setFile", &VLCfgLibAE::setFile),
      Method::Bind("read", &VLCfgLibAE::read),
      Method::Bind("write", &VLCfgLibAE::write),
      Method::Bind("selectEnv", &VLCfgLibAE::selectEnv),
      Method::Bind("clearEnv", &VLCfgLibAE::clearEnv),
  };
  table.Append(kMethods, sizeof kMethods / sizeof kMethods[0]);
}

ae::stagecraft::ASExtensionClass* VLCfgLibAE::ConstructInstance(StageWindow*, ASObject&, ASValueArray&) {
  return new (std::nothrow) VLCfgLibAE;
}

void VLCfgLibAE::DestructInstance(StageWindow*, ASObject& object) { delete object.GetNativeInstance(); }

void VLCfgLibAE::init(StageWindow*, ASObject&, ASValueArray& arguments, ASValue& result) {
  result.SetBoolean(false);
  if (arguments.Count() != 2) return;
  AEString configVar = TextArgument(arguments, 0);
  AEString settingsVar = TextArgument(arguments, 1);
  VLLogOutputwithConfig(Trace(), "VLCfgLibAE::init (%s, %s)\n", configVar.CString(), settingsVar.CString());

  PathFromEnvironment(configVar, "m_ConfigurationFile", "./ffcredentials.xml", ".", m_ConfigurationFile);
  PathFromEnvironment(settingsVar, "m_SettingsFile", "./ffpreference.xml", "", m_SettingsFile);
  fflush(stdout);
  m_BaseSettingsFile = m_SettingsFile;

  checkXMLupgrade();
  result.SetBoolean(true);
  VLLogOutputwithConfig(Trace(), "VLCfgLibAE init exit (%s) (%s)\n", m_ConfigurationFile.CString(), m_SettingsFile.CString());
}

void VLCfgLibAE::setFile(StageWindow*, ASObject&, ASValueArray& arguments, ASValue& result) {
  VLWSAELog trace("VLCfgLibAE", "setFile", s_Log.Id());
  result.SetBoolean(false);
  if (arguments.Count() != 2 && arguments.Count() != 4) {
    VLLogOutputwithConfig(Error(), "VLCfgLibAE::setFile Error:INVALID_PARAMETER, There should be two or four input parameters.\n");
    return;
  }
  AEString configFile = TextArgument(arguments, 0);
  AEString settingsFile = TextArgument(arguments, 1);
  VLLogOutputwithConfig(Trace(), "VLCfgLibAE::setFile (%s, %s)\n", configFile.CString(), settingsFile.CString());
  if (!configFile.IsEmpty()) {
    VLLogOutputwithConfig(Trace(), "VLCfgLibAE::setFile ConfigurationFile is %s.\n", configFile.CString());
    m_ConfigurationFile = configFile;
  }
  if (!settingsFile.IsEmpty()) {
    VLLogOutputwithConfig(Trace(), "VLCfgLibAE::setFile m_SettingsFile is %s.\n", settingsFile.CString());
    m_SettingsFile = settingsFile;
    m_BaseSettingsFile = settingsFile;
  }
  VLLogOutputwithConfig(Trace(), "VLCfgLibAE::setFile (ConfigurationFile:%s, SettingsFile:%s)\n", m_ConfigurationFile.CString(),
      m_SettingsFile.CString());

  if (arguments.Count() == 4) MigrateSettingsFile(TextArgument(arguments, 2), TextArgument(arguments, 3));

  VLLogOutputwithConfig(Trace(), "VLCfgLibAE::setFile Calling  VLCfgLibAE::checkXMLupgrade \n");
  checkXMLupgrade();
  VLLogOutputwithConfig(Trace(), "VLCfgLibAE::setFile Returned from  VLCfgLibAE::checkXMLupgrade \n");
  result.SetBoolean(true);
}

void VLCfgLibAE::MigrateSettingsFile(const AEString& oldSettingsFile, const AEString& oldCachePath) {
  AEString usSettingsFile = OldReleaseSettingsFile(m_SettingsFile.CString());
  bool oldExists = FileExists(oldSettingsFile.CString());
  VLLogOutputwithConfig(Trace(), "VLCfgLibAE::setFile BCSettingsFile(%s) %s.\n", oldSettingsFile.CString(), Existence(oldExists));
  if (oldSettingsFile.IsEmpty() || oldSettingsFile == usSettingsFile || !oldExists) return;

  // The old file goes only once its settings (the account's token among them) are safe in
  // USSettingsFile: an existing one is never overwritten, else the copy must have succeeded.
  bool kept = FileExists(usSettingsFile.CString());
  VLLogOutputwithConfig(Trace(), "VLCfgLibAE::setFile USSettingsFile(%s) %s.\n", usSettingsFile.CString(), Existence(kept));
  if (!kept) {
    VL_WS_String folder;
    VL_WS_getFolderName(usSettingsFile.CString(), &folder);
    bool folderExists = false;
    VL_WS_folderExist(folder.Text, &folderExists);
    if (!folderExists) {
      bool created = VL_WS_createFolder(folder.Text) == VL_WS_OK;
      VLLogOutputwithConfig(Trace(), "VLCfgLibAE::setFile %s create USSettingsFile folder(%s).\n", Outcome(created), folder.Text);
    }
    VL_WS_release(&folder);
    kept = VL_WS_copyFile(oldSettingsFile.CString(), usSettingsFile.CString()) == VL_WS_OK;
    VLLogOutputwithConfig(Trace(), "VLCfgLibAE::setFile %s copy BCSettingsFile(%s) to USSettingsFile(%s).\n", Outcome(kept),
        oldSettingsFile.CString(), usSettingsFile.CString());
  }
  if (kept) {
    bool removed = VL_WS_removeFile(oldSettingsFile.CString()) == VL_WS_OK;
    VLLogOutputwithConfig(Trace(), "VLCfgLibAE::setFile %s remove BCSettingsFile(%s).\n", Outcome(removed), oldSettingsFile.CString());
  } else {
    VLLogOutputwithConfig(Error(), "VLCfgLibAE::setFile Error: BCSettingsFile(%s) is kept, it could not be copied.\n",
        oldSettingsFile.CString());
  }
  bool cleared = VL_WS_clearLocalCache(oldCachePath.CString()) == VL_WS_OK;
  VLLogOutputwithConfig(Trace(), "VLCfgLibAE::setFile %s clear BCCachePath(%s).\n", Outcome(cleared), oldCachePath.CString());
}

void VLCfgLibAE::read(StageWindow*, ASObject&, ASValueArray& arguments, ASValue& result) {
  result.SetString("");
  if (arguments.Count() != 2) return;
  AEString key = TextArgument(arguments, 0);
  bool encrypted = arguments.Get(1).AsBoolean();
  if (key.IsEmpty()) return;

  AEString value;
  VL_WS_Status status = ReadSetting(m_SettingsFile, key.CString(), encrypted, value);
  if (status != VL_WS_OK && status != VL_WS_E_INVALID_ARGUMENT)
    ReadSetting(m_ConfigurationFile, key.CString(), encrypted, value);
  if (value.IsEmpty() && strcmp(key.CString(), kDestinationUniqueID) == 0) {
    value = NewDestinationUniqueID();
    WriteSetting(m_SettingsFile, kDestinationUniqueID, value, false);
  }
  result.SetString(value);
}

void VLCfgLibAE::write(StageWindow*, ASObject&, ASValueArray& arguments, ASValue& result) {
  result.SetBoolean(false);
  if (arguments.Count() != 3) return;
  AEString key = TextArgument(arguments, 0);
  AEString value = TextArgument(arguments, 1);
  bool encrypted = arguments.Get(2).AsBoolean();
  VLLogOutputwithConfig(Trace(), "VLCfgLibAE::write (%s, %s, %s)\n", key.CString(), encrypted ? kMaskedValue : value.CString(),
      encrypted ? "true" : "false");
  if (key.IsEmpty()) return;
  result.SetBoolean(WriteSetting(m_SettingsFile, key.CString(), value, encrypted));
}

void VLCfgLibAE::selectEnv(StageWindow*, ASObject&, ASValueArray& arguments, ASValue& result) {
  result.SetBoolean(false);
  int env = 0;
  AEString path;
  if (!EnvArgument(arguments, &env) || !EnvSettingsFile("selectEnv", env, path)) return;
  m_SettingsFile = path;
  checkXMLupgrade();
  VLLogOutputwithConfig(Trace(), "VLCfgLibAE::selectEnv m_SettingsFile = %s\n", m_SettingsFile.CString());
  result.SetBoolean(true);
}

void VLCfgLibAE::clearEnv(StageWindow*, ASObject&, ASValueArray& arguments, ASValue& result) {
  result.SetBoolean(false);
  int env = 0;
  AEString path;
  if (!EnvArgument(arguments, &env) || !EnvSettingsFile("clearEnv", env, path)) return;
  result.SetBoolean(VL_WS_deleteEnvXML(path.CString()) == VL_WS_OK);
}

bool VLCfgLibAE::EnvSettingsFile(const char* method, int env, AEString& path) const {
  if (env == VL_WS_ENV_DEFAULT) {
    path = m_BaseSettingsFile;
    return true;
  }
  VL_WS_EnvList list;
  VL_WS_getAvailableEnvLists(&list);
  const char* name = 0;
  for (int i = 0; i < list.Count; ++i) {
    if (list.Entries[i].EnvNum == env) name = list.Entries[i].Name;
  }
  if (name == 0) {
    VLLogOutputwithConfig(Error(), "VLCfgLibAE::%s Error:INVALID_PARAMETER, There is no environment %d.\n", method, env);
    return false;
  }
  const char* base = m_BaseSettingsFile.CString();
  const char* slash = strrchr(base, VLFile::PATH_SEPERATOR);
  char buffer[kEnvPathSize];
  int length = slash ? snprintf(buffer, sizeof buffer, "%.*s%s%s", static_cast<int>(slash - base + 1), base,
                                name, slash + 1)
                     : snprintf(buffer, sizeof buffer, "./%s%s", name, base);
  if (length < 0 || static_cast<size_t>(length) >= sizeof buffer) {
    VLLogOutputwithConfig(Error(), "VLCfgLibAE::%s Error:INVALID_PARAMETER, The settings file of environment %d would be longer than %d bytes.\n",
        method, env, static_cast<int>(sizeof buffer - 1));
    return false;
  }
  path.Set(buffer, static_cast<size_t>(length));
  return true;
}

bool VLCfgLibAE::checkXMLVersion(const char* version) {
  for (const char* c = version; *c; ++c) {
    bool digit = *c >= '0' && *c <= '9';
    bool dot = *c == '.' && (c == version || c[-1] != '.');
    if (!digit && !dot) return false;
  }
  return true;
}

void VLCfgLibAE::checkXMLupgrade() {
  VLWSAELog trace("VLCfgLibAE", "checkXMLupgrade", s_Log.Id());
  AEString settingsVersion, configVersion;
  if (ReadSetting(m_SettingsFile, kXMLVersion, false, settingsVersion) == VL_WS_E_SETTING_UNREADABLE) {
    // Rebuilding would lose the token and the device's identifier that the file may still hold.
    VLLogOutputwithConfig(Error(), "VLCfgLibAE::checkXMLupgrade Error: SettingsFile(%s) cannot be read; it is not upgraded.\n",
        m_SettingsFile.CString());
    return;
  }
  ReadSetting(m_ConfigurationFile, kXMLVersion, false, configVersion);
  for (const AEString* version : {&settingsVersion, &configVersion}) {
    if (!checkXMLVersion(version->CString())) {
      VLLogOutputwithConfig(Trace(), "VLCfgLibAE checkXMLupgrade  XMLVersion is invalid value. (%s)\n", version->CString());
      return;
    }
  }
  if (configVersion.IsEmpty()) return;
  if (!settingsVersion.IsEmpty() && strcmp(configVersion.CString(), settingsVersion.CString()) <= 0) return;

  AEString token, id;
  ReadSetting(m_SettingsFile, kAuthToken, true, token);
  ReadSetting(m_SettingsFile, kDestinationUniqueID, false, id);
  if (id.IsEmpty()) id = NewDestinationUniqueID();

  // The new file is built beside the old one and then takes its place, so that a failure on the
  // way leaves the old file (and the account's token in it) as it was.
  VLString fresh = VLString(m_SettingsFile.CString()) + ".upgrade";
  VL_WS_deleteEnvXML(fresh.c_str());  // left over from an interrupted upgrade
  AEString freshFile(fresh.c_str(), fresh.length());
  bool built = WriteSetting(freshFile, kXMLVersion, configVersion, false) &&
               (token.IsEmpty() || WriteSetting(freshFile, kAuthToken, token, true)) &&
               WriteSetting(freshFile, kDestinationUniqueID, id, false) &&
               VLFile::Rename(fresh.c_str(), m_SettingsFile.CString());
  if (!built) {
    VL_WS_deleteEnvXML(fresh.c_str());
    VLLogOutputwithConfig(Error(), "VLCfgLibAE::checkXMLupgrade Error: SettingsFile(%s) could not be rebuilt; it stays as it was.\n",
        m_SettingsFile.CString());
    return;
  }
  VLLogOutputwithConfig(Trace(), "VLCfgLibAE::checkXMLupgrade Updated SettingsFile(Only keep AuthToken, DestinationUniqueID and added a new tag XMLVersion).\n");
}
