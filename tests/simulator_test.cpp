// The simulator's checks that the client's tests rely on. A request the store would refuse (a
// wrong, stale, future or replayed token, another user or API key, the settings block of another
// service, an action that is not the body's, a token of another device or none) must be refused
// here too, or a client that sends it would pass its tests; so must the faults whose effect a
// passing client test does not show (compressed and trickled answers), and connections must be
// served side by side.
#include <gtest/gtest.h>

#include <chrono>
#include <future>
#include <thread>

#include "VLSimTestClient.h"
#include "VLTestSimulator.h"

namespace {

using Clock = std::chrono::steady_clock;

long Milliseconds(Clock::time_point since) {
  return static_cast<long>(std::chrono::duration_cast<std::chrono::milliseconds>(Clock::now() - since).count());
}

class Simulator : public VLSimClientTest {
 protected:
  // The label of genre 12 through a new handle with params.
  VL_WS_Status Label(const VL_WS_SetupParams& params, std::string* label = nullptr) {
    VL_WS_release(&m_Handle);
    VL_WS_Status status = VL_WS_initialize(&m_Handle, &params);
    if (status != VL_WS_OK) return status;
    VL_WS_GenreLabelResponse response;
    status = VL_WS_getGenreLabel(&m_Handle, 12, &response);
    if (label) *label = response.Label ? response.Label : "";
    VL_WS_release(&response);
    return status;
  }
  // The store's response code to the account's e-mail address, asked by a handle for device with
  // token.
  int Email(const char* device, const char* token) {
    VL_WS_SetupParams params = VLTestSetupParams();
    params.DestinationUniqueID = device;
    params.AuthToken = token;
    VL_WS_release(&m_Handle);
    EXPECT_EQ(VL_WS_OK, VL_WS_initialize(&m_Handle, &params));
    VL_WS_EmailAddressResponse answer;
    VL_WS_getEmailAddress(&m_Handle, &answer);
    int code = answer.ResponseCode;
    VL_WS_release(&answer);
    return code;
  }
  // Sends request to the simulator's TLS port: the answer's status line, and what the
  // simulator's check of the UsernameToken found. The whole answer is left in m_Answer.
  std::pair<std::string, std::string> Send(const std::string& request) {
    m_Sim.ClearRequests();
    m_Answer = VLSimExchange(m_Sim.TlsPort(), m_Sim.CAFile(), "store.ostrel.example", request);
    return {m_Answer.substr(0, m_Answer.find("\r\n")), Requests(1).at(0).authentication};
  }

  std::string m_Answer;
};

TEST_F(Simulator, RefusesRequestsTheStoreWouldRefuse) {
  VL_WS_SetupParams params = VLTestSetupParams();
  VLRawExchange raw = VLRawLogOf([&] { ASSERT_EQ(VL_WS_OK, Label(params)); });
  const std::string request = raw.sent;
  ASSERT_EQ(0u, request.find("POST /api/RealTimeBrowse.asmx HTTP/1.1\r\n"));

  // Another user, password or API key.
  const std::string password = params.Password;
  const struct {
    void (*change)(VL_WS_SetupParams&);
    const char* authentication;
    VL_WS_Status status;  // the fault code wsse:FailedAuthentication is neither Client nor Server
  } others[] = {{[](VL_WS_SetupParams& p) { p.Password = "guessed"; }, "wrong password digest", VL_WS_E_SOAP_FAULT(12)},
                {[](VL_WS_SetupParams& p) { p.UserName = "somebody"; }, "unknown user name", VL_WS_E_SOAP_FAULT(12)},
                {[](VL_WS_SetupParams& p) { p.APIKey = "OTHER"; }, "ok", VL_WS_E_SOAP_FAULT(1)}};
  for (const auto& other : others) {
    params = VLTestSetupParams();
    other.change(params);
    m_Sim.ClearRequests();
    EXPECT_EQ(other.status, Label(params));
    EXPECT_EQ(other.authentication, Requests(1).at(0).authentication);
  }

  // The client's bytes again, and with tokens it would not write. The clock skew allowed is
  // 300 s: margins for a loaded machine.
  typedef std::pair<std::string, std::string> Answer;
  const std::string refused = "HTTP/1.1 500 Internal Server Error";
  EXPECT_EQ(Answer(refused, "replayed nonce"), Send(request));
  time_t now = time(nullptr);
  EXPECT_EQ(Answer("HTTP/1.1 200 OK", "ok"), Send(VLWithNewToken(request, password, now - 200)));
  EXPECT_EQ(Answer(refused, "stale wsu:Created"), Send(VLWithNewToken(request, password, now - 400)));
  EXPECT_EQ(Answer(refused, "wsu:Created in the future"), Send(VLWithNewToken(request, password, now + 400)));

  // The settings block of the catalogue to the streaming service; the action of another operation.
  std::string stream = VLWithNewToken(request, password, now);
  stream.replace(0, stream.find(" HTTP/1.1"), "POST /api/StreamAPI.asmx");
  EXPECT_EQ(Answer(refused, "ok"), Send(stream));
  EXPECT_NE(std::string::npos, m_Answer.find("device-settings header block")) << m_Answer;
  std::string action = VLWithNewToken(request, password, now);
  size_t at = action.find("getGenreLabel\"\r\n");
  ASSERT_NE(std::string::npos, at);
  action.replace(at, 13, "getEmailAddress");
  EXPECT_EQ(Answer(refused, "ok"), Send(action));
  EXPECT_NE(std::string::npos, m_Answer.find("SOAPAction header does not name")) << m_Answer;
}

// A token is good for its account on its device until the device is deactivated.
TEST_F(Simulator, TokensAuthoriseTheirAccountOnTheirDeviceUntilDeactivated) {
  const char kDevice[] = "AA-AA-AA-AA-AA-AA";
  VL_WS_SetupParams params = VLTestSetupParams();
  params.DestinationUniqueID = kDevice;
  ASSERT_EQ(VL_WS_OK, VL_WS_initialize(&m_Handle, &params));
  VL_WS_AuthorizeDeviceResponse authorized;
  ASSERT_EQ(VL_WS_OK, VL_WS_authorizeDevice(&m_Handle, 1234, &authorized));
  const std::string token = authorized.AuthToken;
  VL_WS_release(&authorized);

  EXPECT_EQ(0, Email(kDevice, token.c_str()));
  EXPECT_EQ(1, Email("BB-BB-BB-BB-BB-BB", token.c_str())) << "a token belongs to its device";
  EXPECT_EQ(1, Email(kDevice, ""));
  EXPECT_EQ(1, Email(kDevice, "forged"));
  Email(kDevice, token.c_str());
  VL_WS_StandardResponse deactivated;
  ASSERT_EQ(VL_WS_OK, VL_WS_deactivateDevice(&m_Handle, &deactivated));
  VL_WS_release(&deactivated);
  EXPECT_EQ(1, Email(kDevice, token.c_str()));
}

TEST_F(Simulator, CompressedAndTrickledAnswersAreWhatTheySay) {
  for (const char* encoding : {"gzip", "deflate"}) {
    SCOPED_TRACE(encoding);
    Fault(std::string("getGenreLabel=") + encoding + ",times=1");
    std::string label;
    VLRawExchange raw = VLRawLogOf([&] { EXPECT_EQ(VL_WS_OK, Label(VLTestSetupParams(), &label)); });
    EXPECT_EQ("Drama", label);
    EXPECT_NE(std::string::npos, raw.received.find(std::string("Content-Encoding: ") + encoding));
    EXPECT_EQ(std::string::npos, raw.received.find("Drama")) << "the body is compressed";
  }

  Fault("getGenreLabel=trickle:20,times=1");
  Clock::time_point start = Clock::now();
  VLRawExchange raw = VLRawLogOf([&] { EXPECT_EQ(VL_WS_OK, Label(VLTestSetupParams())); });
  EXPECT_GE(Milliseconds(start), static_cast<long>((raw.received.size() - 1) / 64) * 20);
}

TEST_F(Simulator, ServesConnectionsSideBySide) {
  Fault("/device/time/=delay:3000,times=1");
  Clock::time_point start = Clock::now();
  std::future<VL_WS_Status> slow = std::async(std::launch::async, [] {
    time_t now;
    return VL_WS_getServerTime(&now);
  });
  std::this_thread::sleep_for(std::chrono::milliseconds(100));
  for (int i = 0; i < 5; ++i) EXPECT_EQ(VL_WS_OK, Label(VLTestSetupParams()));
  EXPECT_LT(Milliseconds(start), 3000) << "the held answer did not block the others";
  EXPECT_EQ(VL_WS_OK, slow.get());
}

}  // namespace
