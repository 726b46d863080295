// The simulator's SOAP checks that client tests rely on: a request the store would refuse (bad
// digest, replayed nonce, wrong settings block or API key, a token of another device) must be
// refused here too, or a client that sends it would pass its tests. Also the injected SOAP
// faults and the request log that client tests read.
#include <gtest/gtest.h>

#include "VLSimServer.h"
#include "VLSimTestClient.h"
#include "VLStoreHosts.h"

namespace {

class SimulatorSoap : public testing::Test {
 protected:
  void SetUp() override {
    std::string error;
    ASSERT_TRUE(m_Sim.Start(&error)) << error;
  }

  template <typename Request, typename Response>
  int Call(VLSimSoapExchange& exchange, const VLSimSoapCall& call, const char* operation, Request* request,
           Response* response) {
    return exchange.Run(m_Sim.TlsPort(), m_Sim.CAFile(), call, operation, request, response);
  }

  static VLSimSoapCall Stream(const std::string& token, const std::string& device = "00-11-22-33-44-55") {
    VLSimSoapCall call;
    call.path = "/api/StreamAPI.asmx";
    call.settingsElement = "StreamDeviceRequestSettings";
    call.token = token;
    call.deviceId = device;
    return call;
  }

  // Authorises a device with an account's PIN and returns the new token.
  std::string Authorize(int pin, const std::string& device = "00-11-22-33-44-55") {
    VLSimSoapExchange exchange;
    _VL1__authorizeDevice request;
    request.Pin = pin;
    _VL1__authorizeDeviceResponse response;
    EXPECT_EQ(SOAP_OK, Call(exchange, Stream("", device), "authorizeDevice", &request, &response));
    if (!response.authorizeDeviceResult || response.authorizeDeviceResult->ResponseCode != 0) return "";
    return response.authorizeDeviceResult->AuthToken;
  }

  VLSimServer m_Sim;
};

TEST_F(SimulatorSoap, RefusesWrongStaleFutureAndReplayedDigests) {
  struct Case {
    const char* name;
    VLSimSoapCall call;
    const char* reason;
  } cases[] = {{"right", VLSimSoapCall(), "ok"},
               {"wrong password", VLSimSoapCall(), "wrong password digest"},
               {"stale", VLSimSoapCall(), "stale wsu:Created"},
               {"future", VLSimSoapCall(), "wsu:Created in the future"},
               {"unknown user", VLSimSoapCall(), "unknown user name"},
               {"just inside the skew", VLSimSoapCall(), "ok"}};
  cases[1].call.password = "guessed";
  cases[2].call.created = time(nullptr) - 400;  // the skew is 300 s: margins for a loaded machine
  cases[3].call.created = time(nullptr) + 400;
  cases[4].call.user = "somebody";
  cases[5].call.created = time(nullptr) - 200;
  for (const Case& c : cases) {
    SCOPED_TRACE(c.name);
    VLSimSoapExchange exchange;
    _VL1__getNavigation request;
    _VL1__getNavigationResponse response;
    int error = Call(exchange, c.call, "getNavigation", &request, &response);
    EXPECT_EQ(c.reason, m_Sim.Requests().back().authentication);
    if (std::string(c.reason) == "ok") {
      EXPECT_EQ(SOAP_OK, error);
      EXPECT_NE(nullptr, response.getNavigationResult);
    } else {
      EXPECT_EQ(500, exchange.reply.status);
      EXPECT_EQ(SOAP_FAULT, error);  // faultcode wsse:FailedAuthentication
      EXPECT_NE(std::string::npos, exchange.reply.body.find("FailedAuthentication"));
    }
  }

  // The same request bytes a second time: the nonce was used.
  VLSimSoapCall call;
  _VL1__getNavigation request;
  std::string bytes = VLSimSoapRequest(call, "getNavigation", &request);
  EXPECT_EQ(200, VLSimExchange(m_Sim.TlsPort(), m_Sim.CAFile(), call.host, bytes).status);
  EXPECT_EQ(500, VLSimExchange(m_Sim.TlsPort(), m_Sim.CAFile(), call.host, bytes).status);
  EXPECT_EQ("replayed nonce", m_Sim.Requests().back().authentication);
}

TEST_F(SimulatorSoap, NeedsTheSettingsBlockOfTheServiceWithTheApiKeyAndAMatchingAction) {
  struct Case {
    const char* name;
    std::string path, element, apiKey, action;
    bool accepted;
  } cases[] = {
      {"browse with the stream block", "/api/RealTimeBrowse.asmx", "StreamDeviceRequestSettings", "VLSIM-API-KEY", "", false},
      {"stream with its block", "/api/StreamAPI.asmx", "StreamDeviceRequestSettings", "VLSIM-API-KEY", "", true},
      {"download with its block", "/api/DownloadAPI.asmx", "DownloadDeviceRequestSettings", "VLSIM-API-KEY", "", true},
      {"download without a block", "/api/DownloadAPI.asmx", "", "VLSIM-API-KEY", "", false},
      {"wrong API key", "/api/StreamAPI.asmx", "StreamDeviceRequestSettings", "OTHER", "", false},
      {"action of another operation", "/api/StreamAPI.asmx", "StreamDeviceRequestSettings", "VLSIM-API-KEY",
       VL_API_NAMESPACE "getEmailAddress", false},
  };
  for (const Case& c : cases) {
    SCOPED_TRACE(c.name);
    VLSimSoapCall call;
    call.path = c.path;
    call.settingsElement = c.element;
    call.apiKey = c.apiKey;
    call.soapAction = c.action;
    VLSimSoapExchange exchange;
    _VL1__getConfig request;
    _VL1__getConfigResponse response;
    EXPECT_EQ(c.accepted ? SOAP_OK : SOAP_CLI_FAULT, Call(exchange, call, "getConfig", &request, &response))
        << exchange.reply.body;
    EXPECT_EQ(c.accepted, response.getConfigResult != nullptr);
  }
}

// A token is good for its account on its device until the device is deactivated; an account's
// device limit holds.
TEST_F(SimulatorSoap, TokensAuthoriseTheirAccountOnTheirDeviceUntilDeactivated) {
  EXPECT_EQ("", Authorize(9999));
  std::string alice = Authorize(1234, "AA-AA-AA-AA-AA-AA");
  ASSERT_FALSE(alice.empty());
  auto email = [this](const std::string& token, const std::string& device) {
    VLSimSoapExchange exchange;
    _VL1__getEmailAddress request;
    _VL1__getEmailAddressResponse response;
    EXPECT_EQ(SOAP_OK, Call(exchange, Stream(token, device), "getEmailAddress", &request, &response));
    return response.getEmailAddressResult->ResponseCode;
  };
  EXPECT_EQ(0, email(alice, "AA-AA-AA-AA-AA-AA"));
  EXPECT_EQ(1, email(alice, "BB-BB-BB-BB-BB-BB")) << "a token belongs to its device";
  EXPECT_EQ(1, email("", "AA-AA-AA-AA-AA-AA"));
  EXPECT_EQ(1, email("forged", "AA-AA-AA-AA-AA-AA"));

  VLSimSoapExchange exchange;
  _VL1__deactivateDevice request;
  _VL1__deactivateDeviceResponse response;
  ASSERT_EQ(SOAP_OK, Call(exchange, Stream(alice, "AA-AA-AA-AA-AA-AA"), "deactivateDevice", &request, &response));
  EXPECT_EQ(0, response.deactivateDeviceResult->ResponseCode);
  EXPECT_EQ(1, email(alice, "AA-AA-AA-AA-AA-AA"));

  // Dave's account allows one device.
  EXPECT_FALSE(Authorize(1357, "D1-D1-D1-D1-D1-D1").empty());
  EXPECT_EQ("", Authorize(1357, "D2-D2-D2-D2-D2-D2"));
}

TEST_F(SimulatorSoap, InjectedFaultsAndTheRequestLog) {
  std::string error;
  ASSERT_TRUE(m_Sim.AddFault("getGenreLabel=soapfault,times=1", &error)) << error;
  _VL1__getGenreLabel label;
  label.GenreID = 10;
  VLSimSoapExchange first, second;
  _VL1__getGenreLabelResponse firstResponse, secondResponse;
  EXPECT_EQ(SOAP_SVR_FAULT, Call(first, VLSimSoapCall(), "getGenreLabel", &label, &firstResponse));
  EXPECT_EQ("Fault injected by the simulator", first.FaultString());
  EXPECT_EQ(SOAP_OK, Call(second, VLSimSoapCall(), "getGenreLabel", &label, &secondResponse)) << "times=1";

  m_Sim.ClearRequests();
  VLSimSoapCall call = Stream("SOME-TOKEN", "0A-0B-0C-0D-0E-0F");
  call.host = VL_STORE_STAGING_API_HOST;
  call.path = "/aac/api/StreamAPI.asmx";
  VLSimSoapExchange exchange;
  _VL1__checkAuthToken request;
  _VL1__checkAuthTokenResponse response;
  ASSERT_EQ(SOAP_OK, Call(exchange, call, "checkAuthToken", &request, &response));
  call.sendToken = false;
  VLSimSoapExchange other;
  ASSERT_EQ(SOAP_OK, Call(other, call, "checkAuthToken", &request, &response));

  // What client tests read to tell whether a token was sent, and where to.
  std::vector<VLSimRequest> log = m_Sim.Requests();
  ASSERT_EQ(2u, log.size());
  EXPECT_EQ(VL_STORE_STAGING_API_HOST, log[0].serverName);
  EXPECT_EQ("checkAuthToken", log[0].operation);
  EXPECT_TRUE(log[0].hasAuthToken);
  EXPECT_EQ("SOME-TOKEN", log[0].authToken);
  EXPECT_EQ("0A-0B-0C-0D-0E-0F", log[0].destinationUniqueID);
  EXPECT_FALSE(log[1].hasAuthToken);
  EXPECT_EQ("", log[1].authToken);
}

}  // namespace
