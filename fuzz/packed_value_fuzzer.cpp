// The packed encrypted value of a settings file: the input is the stored text of a value, as a
// hand-edited or damaged file could hold it. It is unpacked (password, cipher text, check
// digits) and, when the check holds, decrypted. The input is also taken as a plain value: packed
// and unpacked again, it must read back as it was written, up to its first 0 byte.
#include <stddef.h>
#include <stdint.h>
#include <string.h>

#include "CfgXMLFile.h"
#include "EVPCipher.h"

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
  VLString text(reinterpret_cast<const char*>(data), size);
  EVPCipher cipher(EVPCipher::AES_128_CBC);
  VLString password, cipherText;
  if (CfgXMLFile::UnPackEncryptedValue(text, password, cipherText) == CfgXMLFile::CFG_OK)
    cipher.Decrypt(cipherText, password);

  size_t plainLength = strnlen(text.c_str(), size);
  if (plainLength == 0) return 0;  // an empty value is never encrypted
  VLString fresh = cipher.GeneratePswd();
  VLString packed = CfgXMLFile::PackEncryptedValue(cipher.Encrypt(text, fresh), fresh);
  if (CfgXMLFile::UnPackEncryptedValue(packed, password, cipherText) != CfgXMLFile::CFG_OK) __builtin_trap();
  VLString back = cipher.Decrypt(cipherText, password);
  if (back.length() != plainLength || memcmp(back.c_str(), text.c_str(), plainLength) != 0) __builtin_trap();
  return 0;
}
