// The lab override VLWS_CONNECT_TO: parsing, and connections that reach a server on another
// address while URL, Host header and TLS check keep the logical host. The variable is read once
// per process, so one test sets it before the first connection of this program.
#include <gtest/gtest.h>
#include <stdlib.h>

#include <string>

#include "RealTimeBrowse.h"
#include "Setup_SSL_Client_CACerts.h"
#include "VLConnectTo.h"
#include "VLTestServer.h"

TEST(VLConnectTo, ParsesEntriesLikeCurl) {
  std::vector<VLConnectTo::Entry> e =
      VLConnectTo::Parse("store.ostrel.example:443:127.0.0.1:8443,:80:[::1]:,bad,x:1:y,a:b:c:d,::h:9");
  ASSERT_EQ(3u, e.size());
  EXPECT_TRUE(e[0].host == "store.ostrel.example");
  EXPECT_EQ(443, e[0].port);
  EXPECT_TRUE(e[0].addr == "127.0.0.1");
  EXPECT_EQ(8443, e[0].addrPort);
  EXPECT_TRUE(e[1].host.empty());
  EXPECT_EQ(80, e[1].port);
  EXPECT_TRUE(e[1].addr == "::1");
  EXPECT_EQ(0, e[1].addrPort);
  EXPECT_TRUE(e[2].host.empty());
  EXPECT_EQ(0, e[2].port);
  EXPECT_TRUE(e[2].addr == "h");
  EXPECT_EQ(9, e[2].addrPort);
  EXPECT_TRUE(VLConnectTo::Parse(nullptr).empty());
  EXPECT_TRUE(VLConnectTo::Parse("").empty());
}

TEST(VLConnectTo, ConnectionsGoToTheOverriddenAddress) {
  VLTestServer tls(&VLTestPKI::Get().Trusted()), plain;
  const std::string reply = VLTestServer::HttpReply(VLTestServer::Envelope("<VL1:getNavigationResponse/>"));
  tls.SetReply(reply);
  plain.SetReply(reply);
  std::string map = "store.ostrel.example:443:127.0.0.1:" + std::to_string(tls.Port()) +
                    ",store.ostrel.example:80:127.0.0.1:" + std::to_string(plain.Port()) +
                    ",other.ostrel.example:443:127.0.0.1:" + std::to_string(tls.Port());
  setenv("VLWS_CONNECT_TO", map.c_str(), 1);

  struct Case {
    const char* base;
    int code;
  } cases[] = {
      {"https://store.ostrel.example/api/", SOAP_OK},
      {"http://store.ostrel.example/api/", SOAP_OK},
      // Same server, but the certificate does not name the logical host: refused.
      {"https://other.ostrel.example/api/", SOAP_SSL_ERROR},
  };
  for (const Case& c : cases) {
    VL_WS_SetupParams2 params;
    VLTestFillParams(&params, c.base);
    RealTimeBrowse rtb;
    ASSERT_EQ(SOAP_OK, Setup_SSL_Client_CACerts(&rtb));
    rtb.SetParams(&params);
    ASSERT_EQ(SOAP_OK, rtb.Setup("getNavigation"));
    EXPECT_EQ(c.code, rtb.getNavigation(soap_new__VL1__getNavigation(&rtb), soap_new__VL1__getNavigationResponse(&rtb)))
        << c.base;
    soap_destroy(&rtb);
    soap_end(&rtb);
  }
  ASSERT_EQ(1u, tls.Requests().size());
  ASSERT_EQ(1u, plain.Requests().size());
  for (const std::string& r : {tls.Requests()[0], plain.Requests()[0]}) {
    EXPECT_EQ("store.ostrel.example", VLTestServer::Header(r, "Host"));  // default ports are not written
    EXPECT_EQ("POST /api/RealTimeBrowse.asmx HTTP/1.1", r.substr(0, r.find("\r\n")));
  }
  EXPECT_NE(std::string::npos, tls.Requests()[0].find(">https://store.ostrel.example/api/RealTimeBrowse.asmx</wsa:To>"));
}
