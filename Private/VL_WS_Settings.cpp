// The settings and file operations of the flat interface: single settings of the configuration
// files, the environment file, the MD5 sum of a file, and small file and folder helpers. None
// needs a handle.
#include <stdio.h>
#include <string.h>

#include "CfgXMLFile.h"
#include "VLFile.h"
#include "VLRecord.h"
#include "VL_WS.h"

namespace {

// The status of a settings file result.
VL_WS_Status SettingStatus(CfgXMLFile::Result result) {
  switch (result) {
    case CfgXMLFile::CFG_OK:
      return VL_WS_OK;
    case CfgXMLFile::CFG_EMPTY_KEY:
      return VL_WS_E_INVALID_ARGUMENT;
    case CfgXMLFile::CFG_FILE_ERROR:
      return VL_WS_E_FILE;
    case CfgXMLFile::CFG_NOT_FOUND:
      return VL_WS_E_SETTING_MISSING;
    case CfgXMLFile::CFG_DAMAGED:
      return VL_WS_E_SETTING_DAMAGED;
    case CfgXMLFile::CFG_UNREADABLE:
      return VL_WS_E_SETTING_UNREADABLE;
  }
  return VL_WS_E_UNEXPECTED;
}

bool Empty(const char* text) { return text == 0 || *text == 0; }

// Copies source to destination. A copy that fails leaves no partial destination behind when
// there was none before, so a later existence check never mistakes it for a complete copy.
VL_WS_Status Copy(const char* source, const char* destination) {
  bool existed = VLFile::Exist(destination);
  if (VLFile::CopyFile(source, destination)) return VL_WS_OK;
  if (!existed) VLFile::Remove(destination);
  return VL_WS_E_FILE;
}

// The md5sum command for filename, the name quoted for the shell so that no character of it is
// interpreted: each "'" becomes "'\''". False when the command does not fit its buffer.
bool Md5sumCommand(const char* filename, char (&command)[1024]) {
  VLString text("md5sum -- '");
  for (const char* c = filename; *c; ++c) {
    if (*c == '\'')
      text += "'\\''";
    else
      text += *c;
  }
  text += '\'';
  if (text.length() >= sizeof command) return false;
  memcpy(command, text.c_str(), text.length() + 1);
  return true;
}

}  // namespace

VL_WS_Status VL_WS_readSetting(const char* filename, const char* key, VL_WS_String* value,
                               bool encrypted) {
  if (value == 0) return VL_WS_E_INVALID_ARGUMENT;
  VLRecordInit(*value);
  if (Empty(filename) || Empty(key)) return VL_WS_E_INVALID_ARGUMENT;
  VLString text;
  VL_WS_Status status = SettingStatus(CfgXMLFile(filename).Read(key, text, encrypted));
  if (status == VL_WS_OK) VLRecordSetString(*value, text.c_str());
  return status;
}

VL_WS_Status VL_WS_writeSetting(const char* filename, const char* key, const char* value,
                                bool encrypted) {
  if (Empty(filename) || Empty(key) || value == 0) return VL_WS_E_INVALID_ARGUMENT;
  if (strchr(filename, VLFile::PATH_SEPERATOR) != 0) {
    VLString folder = VLFile::GetFolderName(filename);
    if (!VLFile::FolderExist(folder.c_str()) && !VLFile::CreateFolder(folder.c_str()))
      return VL_WS_E_FILE;
  }
  return SettingStatus(CfgXMLFile(filename).Write(key, value, encrypted));
}

VL_WS_Status VL_WS_createEnvXML(const char* source, const char* destination) {
  if (source == 0 || destination == 0) return VL_WS_E_INVALID_ARGUMENT;
  if (VLFile::Exist(destination)) return VL_WS_OK;
  return Copy(source, destination);
}

VL_WS_Status VL_WS_deleteEnvXML(const char* filename) {
  if (filename == 0) return VL_WS_E_INVALID_ARGUMENT;
  if (VLFile::Exist(filename)) VLFile::Remove(filename);
  return VL_WS_OK;
}

VL_WS_Status VL_WS_checkVLSWFmd5sum(const char* filename, VL_WS_String* md5sum) {
  if (md5sum == 0) return VL_WS_E_INVALID_ARGUMENT;
  VLRecordInit(*md5sum);
  char command[1024];
  if (filename == 0 || !Md5sumCommand(filename, command)) return VL_WS_E_INVALID_ARGUMENT;
  FILE* pipe = popen(command, "r");
  if (pipe == 0) return VL_WS_E_UNEXPECTED;
  VLString output;
  char piece[1024];
  while (fgets(piece, sizeof piece, pipe) != 0) output += piece;
  pclose(pipe);
  VLRecordSetString(*md5sum, output.c_str());
  return VL_WS_OK;
}

VL_WS_Status VL_WS_removeFile(const char* filename) {
  if (filename == 0) return VL_WS_E_INVALID_ARGUMENT;
  if (!VLFile::Exist(filename)) return VL_WS_OK;
  return VLFile::Remove(filename) ? VL_WS_OK : VL_WS_E_FILE;
}

VL_WS_Status VL_WS_copyFile(const char* source, const char* destination) {
  if (source == 0 || destination == 0) return VL_WS_E_INVALID_ARGUMENT;
  return Copy(source, destination);
}

VL_WS_Status VL_WS_getFolderName(const char* path, VL_WS_String* folder) {
  if (folder == 0) return VL_WS_E_INVALID_ARGUMENT;
  VLRecordInit(*folder);
  if (path == 0) return VL_WS_E_INVALID_ARGUMENT;
  VLRecordSetString(*folder, VLFile::GetFolderName(path).c_str());
  return VL_WS_OK;
}

VL_WS_Status VL_WS_folderExist(const char* path, bool* exist) {
  if (path == 0 || exist == 0) return VL_WS_E_INVALID_ARGUMENT;
  *exist = VLFile::FolderExist(path);
  return VL_WS_OK;
}

VL_WS_Status VL_WS_createFolder(const char* path) {
  if (path == 0) return VL_WS_E_INVALID_ARGUMENT;
  return VLFile::CreateFolder(path) ? VL_WS_OK : VL_WS_E_FILE;
}

VL_WS_Status VL_WS_fileExist(const char* path, bool* exist) {
  if (path == 0 || exist == 0) return VL_WS_E_INVALID_ARGUMENT;
  *exist = VLFile::Exist(path);
  return VL_WS_OK;
}
