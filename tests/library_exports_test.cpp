// The built library as the launcher sees it: the plain entry symbols, nothing internal.
#include <dlfcn.h>
#include <gtest/gtest.h>

#include <cstdio>
#include <set>
#include <string>

namespace {

const std::string kLibrary = std::string(VL_BINARY_DIR) + "/libDUDUVud.so";

// The log area names and SOAP log area ids are exported for the platform and the player library.
const std::set<std::string> kLogNames = {
    "VLWSAELOG_AREA_NAME",         "VLWSAE_CFGLOG_AREA_NAME",    "VLWS_SoapProxyLOG_AREA_NAME",
    "VLWS_SoapRecvLOG_AREA_NAME",  "VLWS_SoapSentLOG_AREA_NAME", "VLWS_SoapTestLOG_AREA_NAME",
    "RECV_VLLogAreaID",            "SENT_VLLogAreaID",           "TEST_VLLogAreaID"};

// The shared gSOAP runtime calls back into the library's generated code and reads its namespace
// table, so these must be visible to it.
const std::set<std::string> kSoapCallbacks = {
    "namespaces", "soap_delelement", "soap_dupelement", "soap_getelement", "soap_markelement",
    "soap_putelement", "_Z13soap_getfaultP4soap", "_Z13soap_putfaultP4soap",
    "_Z14soap_faultcodeP4soap", "_Z14soap_getheaderP4soap", "_Z14soap_putheaderP4soap",
    "_Z16soap_faultdetailP4soap", "_Z16soap_faultstringP4soap", "_Z17soap_fault_detailP4soap",
    "_Z17soap_fault_stringP4soap", "_Z17soap_faultsubcodeP4soap", "_Z18soap_fault_subcodeP4soap",
    "_Z19soap_serializefaultP4soap", "_Z20soap_serializeheaderP4soap"};

TEST(LibraryExports, OnlyThePublicInterfaceUnmangled) {
  FILE* nm = popen(("nm -D --defined-only --format=posix " + kLibrary).c_str(), "r");
  ASSERT_NE(nullptr, nm);
  std::set<std::string> symbols;
  char line[1024];
  while (fgets(line, sizeof line, nm)) symbols.insert(std::string(line).substr(0, std::string(line).find(' ')));
  ASSERT_EQ(0, pclose(nm));
  EXPECT_EQ(1u, symbols.count("createApplication2"));
  EXPECT_EQ(1u, symbols.count("sp_flag"));
  for (const std::string& s : symbols) {
    bool isPublic = kLogNames.count(s) == 1 || kSoapCallbacks.count(s) == 1 ||
                    s == "createApplication2" || s == "sp_flag" || s.rfind("VL_WS_", 0) == 0;
    EXPECT_TRUE(isPublic) << "exported: " << s;
  }
}

TEST(LibraryExports, TheLoaderFindsTheEntryPointAndTheFlag) {
  void* library = dlopen(kLibrary.c_str(), RTLD_NOW | RTLD_LOCAL);
  ASSERT_NE(nullptr, library) << dlerror();
  EXPECT_NE(nullptr, dlsym(library, "createApplication2"));
  unsigned char* flag = static_cast<unsigned char*>(dlsym(library, "sp_flag"));
  ASSERT_NE(nullptr, flag);
  EXPECT_EQ(0, *flag);
  EXPECT_EQ(nullptr, dlsym(library, "_ZN9veloraApp9VeloraAppC1Ev"));
  dlclose(library);
}

}  // namespace
