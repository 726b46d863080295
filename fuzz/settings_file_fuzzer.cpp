// The settings file reader: the input is a settings file as a damaged, cut or foreign file
// could hold it. Reading a plain and an encrypted value from it parses it whole (Serializer),
// finds the first setting of the key and, for the encrypted one, unpacks and decrypts its value.
#include <stddef.h>
#include <stdint.h>
#include <stdio.h>
#include <stdlib.h>

#include <string>

#include "CfgXMLFile.h"

namespace {

// A file of this process in a folder of its own.
const std::string& FileName() {
  static const std::string s_Name = [] {
    char folder[] = "/tmp/vl-settings-fuzz-XXXXXX";
    if (!mkdtemp(folder)) __builtin_trap();
    return std::string(folder) + "/settings.xml";
  }();
  return s_Name;
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
  FILE* file = fopen(FileName().c_str(), "wb");
  if (!file) __builtin_trap();
  fwrite(data, 1, size, file);
  fclose(file);
  CfgXMLFile settings(FileName().c_str());
  VLString value;
  settings.Read("DestinationUniqueID", value, false);
  settings.Read("AuthToken", value, true);
  return 0;
}
