#include "VLTestSimulator.h"

#include <stdio.h>
#include <stdlib.h>

#include <algorithm>
#include <memory>
#include <string>

VLSimServer& VLTestSimulator(const VLSimOptions& options) {
  static std::unique_ptr<VLSimServer> s_Sim = [&options] {
    std::unique_ptr<VLSimServer> sim(new VLSimServer(options));
    std::string error;
    if (!sim->Start(&error)) {
      fprintf(stderr, "the store simulator does not start: %s\n", error.c_str());
      abort();
    }
    setenv("SSL_CERT_FILE", sim->CAFile().c_str(), 1);
    setenv("VLWS_CONNECT_TO", sim->ConnectTo().c_str(), 1);
    return sim;
  }();
  return *s_Sim;
}

VL_WS_SetupParams VLTestSetupParams(int cacheType, int cacheData, const char* cachePath) {
  VLSimOptions defaults;
  static const std::string s_User = defaults.userName, s_Password = defaults.password, s_Key = defaults.apiKey;
  VL_WS_SetupParams params = {};
  params.APIKey = s_Key.c_str();
  params.DestinationUniqueID = "00-11-22-33-44-55";
  params.DestinationTypeID = 7;
  params.UserName = s_User.c_str();
  params.Password = s_Password.c_str();
  params.ContentType = VL_WS_SetupParams::GENERAL;
  params.EnvNum = VL_WS_ENV_PRODUCTION;
  params.CacheType = cacheType;
  params.CacheData = static_cast<VL_WS_CacheParam::CacheData>(cacheType ? cacheData : 0);
  params.CachePath = cachePath;
  params.AccessType = STREAM;
  return params;
}

void VLSimClientTest::SetUp() {
  m_Sim.ClearFaults();
  m_Sim.ClearRequests();
}

void VLSimClientTest::TearDown() {
  VL_WS_release(&m_Handle);
  m_Sim.ClearFaults();
}

std::vector<VLSimRequest> VLRequestsByConnection(VLSimServer& sim) {
  std::vector<VLSimRequest> log = sim.Requests();
  std::stable_sort(log.begin(), log.end(),
                   [](const VLSimRequest& a, const VLSimRequest& b) { return a.connection < b.connection; });
  return log;
}

std::vector<VLSimRequest> VLSimClientTest::Requests(size_t count) {
  m_Sim.WaitForRequests(count, 5000);
  return VLRequestsByConnection(m_Sim);
}

void VLSimClientTest::Fault(const std::string& spec) {
  std::string error;
  ASSERT_TRUE(m_Sim.AddFault(spec, &error)) << error;
}
