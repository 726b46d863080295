// The device and network operations against real sockets: the bandwidth probe against canned
// answers of a loopback server, and the operations against the store simulator: the bandwidth
// probe of the store's configuration, the local address, the User-Agent and the device identifier.
#include <gtest/gtest.h>

#include <regex>
#include <string>

#include "VLTestServer.h"
#include "VLTestSimulator.h"
#include "VL_WS.h"
#include "VL_WS_Client.h"

namespace {

// The library reads VLWS_CONNECT_TO at its first connection: the simulator starts before any
// test connects.
class SimulatorFirst : public testing::Environment {
 public:
  void SetUp() override { VLTestSimulator(); }
};
testing::Environment* const s_Simulator = testing::AddGlobalTestEnvironment(new SimulatorFirst);

// ---- Operations against the simulator ----

class Device : public VLSimClientTest {
 protected:
  void Init() {
    VL_WS_SetupParams params = VLTestSetupParams();
    ASSERT_EQ(VL_WS_OK, VL_WS_initialize(&m_Handle, &params));
  }
};

// ---- Bandwidth ----

// The probe URL of the simulator's configuration.
const char kStoreProbe[] = "http://images.ostrel.example/speedtest/probe.bin";

class Bandwidth : public Device {
 protected:
  // The tests may change the probe items of the store's configuration.
  void TearDown() override {
    m_Sim.Store().SetConfigItem("BANDWITHCHECKURL", "");
    m_Sim.Store().SetConfigItem("BandwithCheckURL", kStoreProbe);
    Device::TearDown();
  }
  // Checks with the probe URL set on the handle, so the configuration is not asked.
  VL_WS_Status Check(const std::string& url, unsigned int* bits) {
    m_Handle.client->m_Params.BandwithCheckURL = url.c_str();
    *bits = 12345;
    return VL_WS_checkBandwidth(&m_Handle, bits);
  }
  // A probe URL on the canned server.
  std::string Canned(const std::string& reply) {
    m_Probe.SetReply(reply);
    return "http://127.0.0.1:" + std::to_string(m_Probe.Port()) + "/speed/probe.bin";
  }
  static std::string Answer(size_t contentLength, size_t bodyBytes) {
    return "HTTP/1.1 200 OK\r\nContent-Length: " + std::to_string(contentLength) + "\r\n\r\n" +
           std::string(bodyBytes, 'p');
  }

  VLTestServer m_Probe;
};

TEST_F(Bandwidth, AnAnnouncedMegabyteIsMeasuredOverItsFirst204800Bytes) {
  Init();
  unsigned int bits = 0;
  // The server sends no more than 204800 bytes: a probe that waited for more would fail.
  ASSERT_EQ(VL_WS_OK, Check(Canned(Answer(1000000, 204800)), &bits));
  EXPECT_GT(bits, 0u);
  EXPECT_LE(bits, 204800u * 8000u);
  ASSERT_EQ(1u, m_Probe.Requests().size());
  EXPECT_EQ("GET /speed/probe.bin HTTP/1.1\r\nHost: 127.0.0.1:" + std::to_string(m_Probe.Port()) +
                "\r\nUser-Agent: DUDUVud\r\n\r\n",
            m_Probe.Requests()[0]);

  EXPECT_EQ(VL_WS_E_NETWORK, Check(Canned(Answer(1000000, 204799)), &bits));
  EXPECT_EQ(0u, bits);

  // A body that came with the header counts as timed in at least one millisecond.
  ASSERT_EQ(VL_WS_OK, Check(Canned(Answer(100, 100)), &bits));
  EXPECT_LE(bits, 800000u);
  EXPECT_GE(bits, 8000u);
}

// The probe's own statuses; VLHttpGet's tests and the fault matrix have every answer it refuses.
TEST_F(Bandwidth, FailuresOfTheProbe) {
  Init();
  unsigned int bits = 0;
  EXPECT_EQ(VL_WS_E_BANDWIDTH_BAD_URL, Check("http://images.ostrel.example:http/probe", &bits));
  EXPECT_EQ(0u, bits);
  VL_WS_Handle none = {};
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_checkBandwidth(&none, &bits));
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_checkBandwidth(&m_Handle, nullptr));
}

TEST_F(Bandwidth, TheProbeBypassesTheHandlesProxyAndRestoresIt) {
  VL_WS_SetupParams params = VLTestSetupParams();
  params.ProxyHost = "127.0.0.1";
  params.ProxyPort = VLClosedPort();
  ASSERT_EQ(VL_WS_OK, VL_WS_initialize(&m_Handle, &params));
  const char* proxy = m_Handle.client->m_RealTimeBrowse.proxy_host;
  ASSERT_NE(nullptr, proxy);
  unsigned int bits = 0;
  EXPECT_EQ(VL_WS_OK, Check(Canned(Answer(5000, 5000)), &bits));
  EXPECT_EQ(proxy, m_Handle.client->m_RealTimeBrowse.proxy_host);
  EXPECT_EQ(VL_WS_E_NETWORK, Check(Canned(""), &bits));
  EXPECT_EQ(proxy, m_Handle.client->m_RealTimeBrowse.proxy_host);
}

TEST_F(Bandwidth, TheProbeURLComesFromTheStoresConfigurationOnceAndPointsAtTheImageHost) {
  Init();
  unsigned int bits = 0;
  ASSERT_EQ(VL_WS_OK, VL_WS_checkBandwidth(&m_Handle, &bits));
  EXPECT_GT(bits, 0u);
  EXPECT_STREQ(kStoreProbe, m_Handle.client->m_Params.BandwithCheckURL.c_str());
  std::vector<VLSimRequest> requests = Requests(2);
  ASSERT_EQ(2u, requests.size());
  EXPECT_EQ("getConfig", requests[0].operation);
  EXPECT_EQ("bandwidth probe", requests[1].note);
  EXPECT_EQ("images.ostrel.example", requests[1].host);
  EXPECT_EQ("/speedtest/probe.bin", requests[1].path);
  EXPECT_EQ("DUDUVud", requests[1].userAgent);

  m_Sim.ClearRequests();
  ASSERT_EQ(VL_WS_OK, VL_WS_checkBandwidth(&m_Handle, &bits));
  requests = Requests(1);
  ASSERT_EQ(1u, requests.size());
  EXPECT_EQ("bandwidth probe", requests[0].note);
}

TEST_F(Bandwidth, TheLastProbeKeyInAnyLetterCaseWins) {
  std::string canned = Canned(Answer(5000, 5000));
  m_Sim.Store().SetConfigItem("BANDWITHCHECKURL", canned);
  Init();
  unsigned int bits = 0;
  EXPECT_EQ(VL_WS_OK, VL_WS_checkBandwidth(&m_Handle, &bits));
  EXPECT_EQ(canned, m_Handle.client->m_Params.BandwithCheckURL.c_str());
  EXPECT_EQ(1u, m_Probe.Requests().size());
}

TEST_F(Bandwidth, AConfigurationWithoutProbeOrNoConfigurationAtAll) {
  Init();
  unsigned int bits = 12345;
  Fault("getConfig=status:503,times=1");
  EXPECT_EQ(VL_WS_E_HTTP_STATUS(503), VL_WS_checkBandwidth(&m_Handle, &bits));
  EXPECT_EQ(0u, bits);
  m_Sim.Store().SetConfigItem("BandwithCheckURL", "");
  EXPECT_EQ(VL_WS_E_BANDWIDTH_NO_URL, VL_WS_checkBandwidth(&m_Handle, &bits));
  EXPECT_STREQ("", m_Handle.client->m_Params.BandwithCheckURL.c_str());
}

TEST_F(Device, LocalAddressIsTheLocalEndOfAConnectionToTheService) {
  Init();
  VL_WS_String address;
  VLString& base = m_Handle.client->m_Params.ServiceBaseURL;
  VLString saved = base;
  base = "https://no-path-here";
  EXPECT_EQ(VL_WS_E_UNEXPECTED, VL_WS_getLocalIPAddr(&m_Handle, &address));
  VL_WS_release(&address);
  base = ("http://127.0.0.1:" + std::to_string(VLClosedPort()) + "/api/").c_str();
  EXPECT_EQ(VL_WS_E_CONNECT, VL_WS_getLocalIPAddr(&m_Handle, &address));
  EXPECT_EQ(nullptr, address.Text);
  VL_WS_release(&address);
  base = saved;

  VL_WS_Handle none = {};
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_getLocalIPAddr(&none, &address));
  EXPECT_NE(nullptr, address.tag);
  VL_WS_release(&address);
}

// Null arguments, and a handle without client state, which leaves the record untouched (the
// server time's answers are in the device-server-time session).
TEST_F(Device, NullArgumentsAndAHandleWithoutClientState) {
  Init();
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_getServerTime(nullptr));
  VL_WS_Handle none = {};
  VL_WS_String untouched = {};
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_getUserAgent(&none, &untouched));
  EXPECT_EQ(nullptr, untouched.tag);
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_getUserAgent(&m_Handle, nullptr));
}

TEST(DeviceIdentifier, SixUpperCaseHexadecimalPairs) {
  VL_WS_String id;
  ASSERT_EQ(VL_WS_OK, VL_WS_getDestinationUniqueID(&id));
  EXPECT_TRUE(std::regex_match(id.Text, std::regex("[0-9A-F]{2}(-[0-9A-F]{2}){5}"))) << id.Text;
  EXPECT_EQ(17, id.Length);
  VL_WS_release(&id);
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_getDestinationUniqueID(nullptr));
}

}  // namespace
