// CfgXMLFile: one settings XML file of key/value pairs; reads one value or writes one value,
// keeping every other pair as it is.
//
// The file is the plain, indented Serializer output of one VL1__ArrayOfConfigurationItemOfString
// under the element "DUDUVud": one "VL1:Configuration" element per setting, in file order, with
// the attribute "Key" and a "VL1:Value" child holding the value. Keys compare byte for byte;
// only the first setting with a key is read or replaced; settings without a key stay in the file
// and never match.
//
// An encrypted value is stored packed: its own random AES-128-CBC password (EVPCipher), the
// cipher text, then four check digits over both (see PackEncryptedValue).
//
// Nothing is kept open between calls. Two writers of one file at the same time can lose one
// write (each rewrites the whole file), but a reader never sees a half-written file.
#ifndef CFGXMLFILE_H
#define CFGXMLFILE_H

#include "VLString.h"

class VL1__ArrayOfConfigurationItemOfString;
class Serializer;

class CfgXMLFile {
 public:
  // Result codes of Read and Write. The client's setting functions map them to statuses.
  enum Result {
    CFG_OK = 0,
    CFG_EMPTY_KEY = 1,
    CFG_FILE_ERROR = 2,  // cannot be opened or read; or cannot be created or fully written
    CFG_NOT_FOUND = 3,   // Read: the file is empty, holds no settings, or has none with the key
    CFG_DAMAGED = 4,     // Read: an encrypted value is too short, fails its check or its cipher
    CFG_UNREADABLE = 5,  // Read: the file does not parse as a settings file (cut short, garbage)
  };

  explicit CfgXMLFile(const VLString& filename);
  virtual ~CfgXMLFile();

  // value receives the value (decrypted when encrypted is true); it is empty on any result but
  // CFG_OK. An encrypted read of an empty stored value gives CFG_OK with an empty value.
  Result Read(const VLString& key, VLString& value, bool encrypted);
  // Replaces the value of the first setting with key in place, or appends a new setting;
  // CFG_OK, CFG_EMPTY_KEY or CFG_FILE_ERROR. A missing or empty file counts as one without
  // settings; a file that exists but cannot be read is left alone (CFG_FILE_ERROR). A file that
  // does not parse may still hold the account's token, so it is never overwritten: its bytes are
  // first kept beside it as "<name>.damaged" (replacing an older one, with the same
  // permissions; logged), then a new file holds the one setting. The file is replaced whole:
  // written to a temporary file in its folder, synced to disk and renamed over it, so a crash or
  // a full disk leaves either the old or the new file, never a mixture. A symbolic link stays a
  // link to the replaced file; the file keeps its permissions, except that an encrypted write
  // leaves it readable and writable by its owner only. Its folder must exist.
  Result Write(const VLString& key, const VLString& value, bool encrypted);

  // password + cipherText + four check digits: the last four decimal digits of
  // VLUtilities::Hash(0, password + cipherText), printed with "%04u".
  static VLString PackEncryptedValue(const VLString& cipherText, const VLString& password);
  // Splits a packed value: CFG_OK with both parts, or CFG_DAMAGED with both empty when the
  // value is not longer than an AES-128-CBC password plus the check, or its check digits do not
  // match.
  static Result UnPackEncryptedValue(const VLString& packed, VLString& password,
                                     VLString& cipherText);

 private:
  // What Load found.
  enum Loaded { LOADED, NO_FILE, EMPTY_FILE, READ_ERROR, NOT_PARSED };
  // Reads the file into text and parses it into settings, which then live in serializer's
  // memory. Settings stay empty unless the result is LOADED.
  Loaded Load(Serializer& serializer, VL1__ArrayOfConfigurationItemOfString& settings,
              VLString& text) const;

  VLString m_FileName;
};

#endif  // CFGXMLFILE_H
