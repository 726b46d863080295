#include "CfgXMLFile.h"

#include <errno.h>
#include <fcntl.h>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>
#include <sys/stat.h>
#include <unistd.h>

#include <memory>
#include <vector>

#include "EVPCipher.h"
#include "Serializer.h"
#include "VLFile.h"
#include "VLUtilities.h"
#include "VLWSAELog.h"

namespace {

// The configuration extension's area: a settings file that had to be set aside is its concern.
VLLogArea s_Log(VLWSAE_CFGLOG_AREA_NAME);

const size_t kCheckLength = 4;

// The check digits of a packed value: its hash modulo 10000 as four decimal digits.
VLString CheckDigits(const char* data, size_t n) {
  char digits[8];
  snprintf(digits, sizeof digits, "%04u",
           VLUtilities::Hash(0, data, static_cast<unsigned int>(n)) % 10000);
  return VLString(digits);
}

// The first setting with key, or null.
VL1__ConfigurationItemOfString* FindSetting(const VL1__ArrayOfConfigurationItemOfString& settings,
                                            const VLString& key) {
  for (int i = 0; i < settings.__sizeConfiguration; ++i) {
    VL1__ConfigurationItemOfString* setting = settings.Configuration[i];
    if (setting && setting->Key && key == VLString(setting->Key)) return setting;
  }
  return NULL;
}

// A new setting with key after the existing ones, in ctx's memory; null when out of memory.
VL1__ConfigurationItemOfString* AppendSetting(struct soap* ctx,
                                              VL1__ArrayOfConfigurationItemOfString& settings,
                                              const VLString& key) {
  int n = settings.__sizeConfiguration;
  VL1__ConfigurationItemOfString** items = static_cast<VL1__ConfigurationItemOfString**>(
      soap_malloc(ctx, (n + 1) * sizeof(VL1__ConfigurationItemOfString*)));
  VL1__ConfigurationItemOfString* setting = soap_new_VL1__ConfigurationItemOfString(ctx);
  if (!items || !setting) return NULL;
  if (n > 0) memcpy(items, settings.Configuration, n * sizeof(VL1__ConfigurationItemOfString*));
  setting->Key = soap_strdup(ctx, key.c_str());
  items[n] = setting;
  settings.Configuration = items;
  settings.__sizeConfiguration = n + 1;
  return setting;
}

// ---- Replacing a file whole ---------------------------------------------------------------------

// The file that replacing path overwrites: the target of a symbolic link (so that the link stays
// a link), else path itself, with "./" before a bare file name so that it names its folder.
VLString ReplacedPath(const VLString& path) {
  if (char* real = realpath(path.c_str(), NULL)) {
    VLString target(real);
    free(real);
    return target;
  }
  return path.find(VLFile::PATH_SEPERATOR) == VLString::npos ? "./" + path : path;
}

// The process's file-creation mask, read without setting it (umask() would change it for a
// moment in every thread).
mode_t CurrentUmask() {
  mode_t mask = 022;
  if (FILE* status = fopen("/proc/self/status", "r")) {
    char line[128];
    unsigned int value;
    while (fgets(line, sizeof line, status)) {
      if (sscanf(line, "Umask: %o", &value) == 1) {
        mask = value;
        break;
      }
    }
    fclose(status);
  }
  return mask;
}

bool WriteAll(int fd, const char* data, size_t n) {
  while (n > 0) {
    ssize_t written = write(fd, data, n);
    if (written < 0) {
      if (errno == EINTR) continue;
      return false;
    }
    data += written;
    n -= static_cast<size_t>(written);
  }
  return true;
}

// Fills the new file temp with text and syncs it to disk. It gets the permissions and, where
// the process may, the owner of the file model (the one it replaces, or the one it is a copy
// of); without that file, the permissions fopen would have given it. ownerOnly takes away every
// permission of group and others.
bool WriteNewFile(const VLString& temp, const VLString& model, const VLString& text, bool ownerOnly) {
  int fd = open(temp.c_str(), O_WRONLY | O_TRUNC | O_CLOEXEC);
  if (fd < 0) return false;
  mode_t mode = 0666 & ~CurrentUmask();
  struct stat old;
  if (stat(model.c_str(), &old) == 0) {
    mode = old.st_mode & 07777;
    if ((old.st_uid != geteuid() || old.st_gid != getegid()) &&
        fchown(fd, old.st_uid, old.st_gid) != 0) {
      // Only a privileged process may give a file away; the new file stays the process's own.
    }
  }
  fchmod(fd, ownerOnly ? mode & ~077 : mode);
  bool written = WriteAll(fd, text.c_str(), text.length()) && fsync(fd) == 0;
  return close(fd) == 0 && written;
}

// Replaces the content of the file replaced (a path from ReplacedPath) with text, so that at
// every moment the file holds either its old or its new content: a new file in the same folder
// is written and synced, then renamed over the old one. It takes model's permissions (see
// WriteNewFile). False (old file untouched) on any failure.
bool ReplaceFile(const VLString& replaced, const VLString& model, const VLString& text, bool ownerOnly) {
  VLString temp = VLFile::CreateTempFileName(replaced.c_str());
  if (temp.empty()) return false;
  if (!WriteNewFile(temp, model, text, ownerOnly) || rename(temp.c_str(), replaced.c_str()) != 0) {
    unlink(temp.c_str());
    return false;
  }
  // Syncing the folder makes the rename itself durable. Where a file system cannot sync a
  // folder, the rename still stands and the next sync of the file system writes it.
  VLString folderName = VLFile::GetFolderName(replaced.c_str());
  int folder = open(folderName.c_str(), O_RDONLY | O_DIRECTORY | O_CLOEXEC);
  if (folder >= 0) {
    fsync(folder);
    close(folder);
  }
  return true;
}

// Keeps the bytes of the settings file replaced, which does not parse, beside it before it is
// overwritten: whatever it still holds (the account's token) can then be recovered by hand.
bool KeepDamaged(const VLString& replaced, const VLString& bytes) {
  VLString kept = replaced + ".damaged";
  bool done = ReplaceFile(kept, replaced, bytes, false);
  VLLogOutputwithConfig({s_Log.Id(), 1}, "CfgXMLFile::Write %s cannot be read: %s %s\n", replaced.c_str(),
                        done ? "its bytes are kept in" : "it is left as it is, it could not be kept in", kept.c_str());
  return done;
}

}  // namespace

CfgXMLFile::CfgXMLFile(const VLString& filename) : m_FileName(filename) {}

CfgXMLFile::~CfgXMLFile() {}

CfgXMLFile::Loaded CfgXMLFile::Load(Serializer& serializer, VL1__ArrayOfConfigurationItemOfString& settings,
                                    VLString& text) const {
  VLFile file;
  if (!file.Open(m_FileName.c_str(), "rb")) return errno == ENOENT ? NO_FILE : READ_ERROR;
  vl_int64 size = file.GetSize();
  if (size == 0) return EMPTY_FILE;
  if (size < 0 || static_cast<uint64_t>(size) > VLString::npos) return READ_ERROR;
  std::vector<char> bytes(static_cast<size_t>(size));
  if (file.Read(bytes.data(), size) != size) return READ_ERROR;
  text.assign(bytes.data(), bytes.size());
  serializer.SetXML(text);
  return serializer.Get(settings) == SOAP_OK ? LOADED : NOT_PARSED;
}

CfgXMLFile::Result CfgXMLFile::Read(const VLString& key, VLString& value, bool encrypted) {
  value = VLString();
  if (key.empty()) return CFG_EMPTY_KEY;
  std::unique_ptr<Serializer> serializer(new Serializer(false, false));
  VL1__ArrayOfConfigurationItemOfString settings;
  VLString text;
  switch (Load(*serializer, settings, text)) {
    case LOADED:
      break;
    case EMPTY_FILE:
      return CFG_NOT_FOUND;
    case NOT_PARSED:
      return CFG_UNREADABLE;
    case NO_FILE:
    case READ_ERROR:
      return CFG_FILE_ERROR;
  }
  const VL1__ConfigurationItemOfString* setting = FindSetting(settings, key);
  if (!setting) return CFG_NOT_FOUND;
  VLString stored(setting->Value ? setting->Value : "");
  if (!encrypted || stored.empty()) {
    value = stored;
    return CFG_OK;
  }
  VLString password, cipherText;
  if (UnPackEncryptedValue(stored, password, cipherText) != CFG_OK) return CFG_DAMAGED;
  // A value whose check matches but whose cipher text does not decrypt is just as damaged.
  EVPCipher cipher(EVPCipher::AES_128_CBC);
  value = cipher.Decrypt(cipherText, password);
  return value.empty() ? CFG_DAMAGED : CFG_OK;
}

CfgXMLFile::Result CfgXMLFile::Write(const VLString& key, const VLString& value, bool encrypted) {
  if (key.empty()) return CFG_EMPTY_KEY;
  std::unique_ptr<Serializer> serializer(new Serializer(false, true));
  VL1__ArrayOfConfigurationItemOfString settings;
  VLString text;
  Loaded loaded = Load(*serializer, settings, text);
  if (loaded == READ_ERROR) return CFG_FILE_ERROR;
  VLString stored = value;
  if (encrypted) {
    EVPCipher cipher(EVPCipher::AES_128_CBC);
    VLString password = cipher.GeneratePswd();
    VLString cipherText = cipher.Encrypt(value, password);
    // Never store a value that could not be encrypted: it would read back as damaged.
    if (password.empty() || (!value.empty() && cipherText.empty())) return CFG_FILE_ERROR;
    stored = PackEncryptedValue(cipherText, password);
  }
  VL1__ConfigurationItemOfString* setting = FindSetting(settings, key);
  if (!setting) setting = AppendSetting(serializer.get(), settings, key);
  if (!setting) return CFG_FILE_ERROR;
  setting->Value = soap_strdup(serializer.get(), stored.c_str());
  if (serializer->Put(settings) != SOAP_OK) return CFG_FILE_ERROR;
  VLString replaced = ReplacedPath(m_FileName);
  if (loaded == NOT_PARSED && !KeepDamaged(replaced, text)) return CFG_FILE_ERROR;
  return ReplaceFile(replaced, replaced, serializer->GetXML(), encrypted) ? CFG_OK : CFG_FILE_ERROR;
}

VLString CfgXMLFile::PackEncryptedValue(const VLString& cipherText, const VLString& password) {
  VLString packed = password + cipherText;
  packed += CheckDigits(packed.c_str(), packed.length());
  return packed;
}

CfgXMLFile::Result CfgXMLFile::UnPackEncryptedValue(const VLString& packed, VLString& password,
                                                    VLString& cipherText) {
  password = VLString();
  cipherText = VLString();
  size_t passwordLength = EVPCipher(EVPCipher::AES_128_CBC).PasswordLength();
  if (packed.length() <= passwordLength + kCheckLength) return CFG_DAMAGED;
  size_t checked = packed.length() - kCheckLength;
  if (CheckDigits(packed.c_str(), checked) != packed.substr(checked)) return CFG_DAMAGED;
  password = packed.substr(0, passwordLength);
  cipherText = packed.substr(passwordLength, checked - passwordLength);
  return CFG_OK;
}
