// The device-environment query against a canned service (a loopback TLS server that plays one
// answer per connection): the exact request, and which answers are accepted. The endpoints of
// fixed environments and of each digit are tested through the client against the simulator.
#include <gtest/gtest.h>

#include <string>

#include "Setup_SSL_Client_CACerts.h"
#include "StreamAPI.h"
#include "VLStoreHosts.h"
#include "VLTestServer.h"
#include "VLUtilities.h"

namespace {

std::string Answer(const std::string& body) { return VLTestServer::HttpReply(body, "200 OK"); }

class EndpointQuery : public testing::Test {
 protected:
  void SetUp() override {
    ASSERT_EQ(SOAP_OK, Setup_SSL_Client_CACerts(&m_Context));
    m_Context.recv_timeout = 5;
  }

  // Asks with a default environment number; the text returned, envID starting at -1.
  std::string Ask(const std::string& reply, VL_WS_EnvID* envID,
                  enum VL_WS_SetupParams::ContentType content = VL_WS_SetupParams::GENERAL) {
    m_Service.SetReply(reply);
    *envID = -1;
    testing::internal::CaptureStdout();
    const char* url = VLUtilities::QueryServiceBaseURL(content, &m_Context, "00-11", 7, VL_WS_ENV_DEFAULT, *envID);
    testing::internal::GetCapturedStdout();
    return url;
  }

  VLTestServer& m_Service = VLStandInServer(VL_STORE_PRODUCTION_HOST, 443, &VLTestPKI::Get().Trusted());
  StreamAPI m_Context;
};

TEST_F(EndpointQuery, AsksWithAHandBuiltGet) {
  VL_WS_EnvID env;
  m_Service.SetReply(Answer("1"));
  env = -1;
  std::string url = VLUtilities::QueryServiceBaseURL(VL_WS_SetupParams::GENERAL, &m_Context, "a b/c", 7,
                                                     static_cast<VL_WS_EnvNum>(4), env);
  EXPECT_EQ("https://stg.ostrel.example/api/", url);
  EXPECT_EQ(1, env);
  EXPECT_EQ(
      "GET /device/env/?d=a%20b%2Fc&dt=7 HTTP/1.1\r\nUser-Agent: DUDUVud\r\nHost: store.ostrel.example\r\n\r\n",
      m_Service.Requests().back());
}

TEST_F(EndpointQuery, OnlyAnOkAnswerOfOneDigitChoosesTheEnvironment) {
  VL_WS_EnvID env;
  // An answer that TCP delivers in pieces.
  m_Service.SetBehaviour(VLTestServer::kPieces);
  EXPECT_EQ("https://stg.ostrel.example/api/", Ask(Answer("1"), &env));
  EXPECT_EQ(1, env);
  m_Service.SetBehaviour(VLTestServer::kReply);

  const char* production[] = {
      "HTTP/1.1 200 OK\r\nContent-Length: 1\r\n\r\n",   // the digit is missing
      "HTTP/1.1 200 OK\r\nContent-Length: 1\r\n\r\nx",  // not a digit
      "HTTP/1.1 200 OK\r\nContent-Length: 2\r\n\r\n10",
      "HTTP/1.1 404 Not Found\r\nContent-Length: 1\r\n\r\n1",
      "",  // the service closes without answering
  };
  for (const char* reply : production) {
    SCOPED_TRACE(reply);
    EXPECT_EQ("https://store.ostrel.example/api/", Ask(reply, &env));
    EXPECT_EQ(2, env);
  }
  EXPECT_EQ("https://adult.ostrel.example/api/", Ask("", &env, VL_WS_SetupParams::ADULT));
}

}  // namespace
