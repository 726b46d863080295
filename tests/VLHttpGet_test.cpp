// VLHttpGet, the hand-built HTTP GET of box art, the server time, the bandwidth probe and the
// device-environment query, against canned answers of a loopback server: what it sends, how it
// reads answers, and the status it gives each answer it refuses.
#include <gtest/gtest.h>

#include <string>

#include "VLHttpGet.h"
#include "VLSoapTransport.h"
#include "VLStoreHosts.h"
#include "VLTestServer.h"
#include "VL_WS.h"

namespace {

// The server time's host: the library reads VLWS_CONNECT_TO at its first connection, so its
// stand-in starts before any test connects.
class ServerTimeHostFirst : public testing::Environment {
 public:
  void SetUp() override { VLStandInServer(VL_STORE_PRODUCTION_HOST, 80); }
};
testing::Environment* const s_ServerTimeHost = testing::AddGlobalTestEnvironment(new ServerTimeHostFirst);

// Statuses that tell the callers' own entries apart from the ones all callers share.
const VLHttpGet::Kind kKind = {false, VL_WS_E_BANDWIDTH_BAD_URL, VL_WS_E_HTTP_NOT_FOUND, VL_WS_E_HTTP_NOT_MODIFIED};

class HttpGet : public testing::Test {
 protected:
  HttpGet() { VLSoapTransport::SetTimeouts(&m_Context, 5, 5); }

  VL_WS_Status Get(const std::string& reply) {
    m_Server.SetReply(reply);
    return Run(m_Server.Port());
  }
  VL_WS_Status Run(int port, const VLHttpGet::Kind& kind = kKind, const VLString& fields = VLString()) {
    std::string url = "http://127.0.0.1:" + std::to_string(port) + "/probe";
    return m_Get.Get(url.c_str(), kind, fields);
  }

  VLTestServer m_Server;
  VLSoapContext m_Context;
  VLHttpGet m_Get{&m_Context};
};

TEST_F(HttpGet, BuildsTheRequestFromTheURLAndFindsTheBodyAndTheHeaderFields) {
  ASSERT_EQ(VL_WS_OK, Get("HTTP/1.1 200 OK\r\ncontent-length:  5 \r\nLast-Modified: Mon, 03 Jan 2011 "
                          "10:00:00 GMT\r\nX-Empty:\r\n\r\nhello"));
  EXPECT_EQ(5u, m_Get.ContentLength());
  ASSERT_EQ(5u, m_Get.BodyReceived());
  EXPECT_STREQ("hello", m_Get.Body());
  VLString value;
  EXPECT_TRUE(m_Get.Field("Last-Modified", &value));
  EXPECT_STREQ("Mon, 03 Jan 2011 10:00:00 GMT", value.c_str());
  EXPECT_TRUE(m_Get.Field("x-empty", &value));
  EXPECT_STREQ("", value.c_str());
  EXPECT_FALSE(m_Get.Field("Content", &value));
  EXPECT_FALSE(m_Get.Field("ETag", &value));
  std::string host = "Host: 127.0.0.1:" + std::to_string(m_Server.Port()) + "\r\n";
  ASSERT_EQ(1u, m_Server.Requests().size());
  EXPECT_EQ("GET /probe HTTP/1.1\r\nUser-Agent: DUDUVud\r\n" + host + "\r\n", m_Server.Requests()[0]);

  // Extra fields come first; the bandwidth probe's kind names the host before the agent.
  const VLHttpGet::Kind hostFirst = {true, VL_WS_E_UNEXPECTED, VL_WS_E_NETWORK, VL_WS_E_NETWORK};
  EXPECT_EQ(VL_WS_OK, Run(m_Server.Port(), hostFirst, "If-Modified-Since: x\r\n"));
  EXPECT_EQ("GET /probe HTTP/1.1\r\nIf-Modified-Since: x\r\n" + host + "User-Agent: DUDUVud\r\n\r\n",
            m_Server.Requests().back());

  // A URL that does not split is refused before anything is sent.
  EXPECT_EQ(VL_WS_E_BANDWIDTH_BAD_URL, m_Get.Get("http://127.0.0.1/", kKind));
  EXPECT_EQ(2u, m_Server.Requests().size());
}

TEST_F(HttpGet, ABodyBeyondItsLengthIsCutAndALongerOneIsReadOn) {
  ASSERT_EQ(VL_WS_OK, Get("HTTP/1.1 200 OK\r\nContent-Length: 3\r\n\r\nabcdef"));
  EXPECT_EQ(3u, m_Get.BodyReceived());
  EXPECT_STREQ("abc", m_Get.Body());

  std::string body(10000, 'x');
  ASSERT_EQ(VL_WS_OK, Get("HTTP/1.1 200 OK\r\nContent-Length: 10000\r\n\r\n" + body));
  size_t total = m_Get.BodyReceived();
  EXPECT_LT(total, 2048u);
  char piece[4096];
  while (size_t n = m_Get.Receive(piece, sizeof piece)) total += n;
  EXPECT_EQ(10000u, total);
}

// The one mapping of answers to statuses: 404 and 304 are the caller's, everything else but a
// complete 200 answer a network failure.
TEST_F(HttpGet, EveryOtherAnswerHasItsStatus) {
  static const char kNulInHeader[] = "HTTP/1.1 200 OK\r\nX-Nul: a\0b\r\nContent-Length: 1\r\n\r\nx";
  struct {
    std::string reply;
    VL_WS_Status status;
  } cases[] = {
      {"HTTP/1.1 404 Not Found\r\nContent-Length: 0\r\n\r\n", VL_WS_E_HTTP_NOT_FOUND},
      {"HTTP/1.1 304 Not Modified\r\n\r\n", VL_WS_E_HTTP_NOT_MODIFIED},
      {"HTTP/1.1 500 Internal Server Error\r\nContent-Length: 1\r\n\r\nx", VL_WS_E_NETWORK},
      {"HTTP/1.0 200 OK\r\nContent-Length: 1\r\n\r\nx", VL_WS_E_NETWORK},
      {"HTTP/1.1 200 OK\r\n\r\nx", VL_WS_E_NETWORK},
      {"HTTP/1.1 200 OK\r\nContent-Length: 0\r\n\r\n", VL_WS_E_NETWORK},
      {"HTTP/1.1 200 OK\r\nContent-Length: 12x\r\n\r\nx", VL_WS_E_NETWORK},
      {"HTTP/1.1 200 OK\r\nContent-Length: -1\r\n\r\nx", VL_WS_E_NETWORK},
      {"HTTP/1.1 200 OK\r\nContent-Length: 99999999999999999999\r\n\r\nx", VL_WS_E_NETWORK},
      {"HTTP/1.1 200 OK\r\nX-Body: Content-Length: 1\r\n\r\nx", VL_WS_E_NETWORK},
      {"HTTP/1.1 200 OK\r\nContent-Length: 1\r\n", VL_WS_E_NETWORK},
      {"HTTP/1.1 200 OK\r\nContent-Length: 1\r\nContent-Encoding: gzip\r\n\r\nx", VL_WS_E_NETWORK},
      {"HTTP/1.1 200 OK\r\nContent-Length: 1\r\nContent-Encoding: Identity\r\n\r\nx", VL_WS_OK},
      // The whole header must fit into the first piece.
      {"HTTP/1.1 200 OK\r\nX-Long: " + std::string(3000, 'a') + "\r\nContent-Length: 1\r\n\r\nx",
       VL_WS_E_NETWORK},
      {std::string(kNulInHeader, sizeof kNulInHeader - 1), VL_WS_OK},
      {"", VL_WS_E_NETWORK},
  };
  for (const auto& c : cases) EXPECT_EQ(c.status, Get(c.reply)) << c.reply;
}

// TCP may deliver an answer in pieces anywhere, also within the header: it is read to the end
// of the header, and a small body to its announced length.
TEST_F(HttpGet, AnswersThatArriveInPiecesAreReadWhole) {
  m_Server.SetBehaviour(VLTestServer::kPieces);
  ASSERT_EQ(VL_WS_OK, Get("HTTP/1.1 200 OK\r\nLast-Modified: Mon, 03 Jan 2011 10:00:00 GMT\r\n"
                          "Content-Length: 25\r\n\r\n12/31/2010 11:59:59 PM ok"));
  VLString value;
  EXPECT_TRUE(m_Get.Field("Last-Modified", &value));
  EXPECT_STREQ("Mon, 03 Jan 2011 10:00:00 GMT", value.c_str());
  ASSERT_TRUE(m_Get.ReceiveBody());
  EXPECT_EQ(25u, m_Get.BodyReceived());
  EXPECT_STREQ("12/31/2010 11:59:59 PM ok", m_Get.Body());
  EXPECT_EQ(VL_WS_E_HTTP_NOT_FOUND, Get("HTTP/1.1 404 Not Found\r\nContent-Length: 0\r\n\r\n"));

  // A body that ends early, or does not fit beside the header, is not read whole.
  ASSERT_EQ(VL_WS_OK, Get("HTTP/1.1 200 OK\r\nContent-Length: 30\r\n\r\nshort"));
  EXPECT_FALSE(m_Get.ReceiveBody());
  ASSERT_EQ(VL_WS_OK, Get("HTTP/1.1 200 OK\r\nContent-Length: 3000\r\n\r\nlong"));
  EXPECT_FALSE(m_Get.ReceiveBody());
}

TEST_F(HttpGet, ConnectionFailures) {
  EXPECT_EQ(VL_WS_E_CONNECT, Run(VLClosedPort()));
  // The server resets the connection on accepting it: the reset may reach the client while it
  // still connects, or when it sends.
  m_Server.SetBehaviour(VLTestServer::kCloseAtOnce);
  VL_WS_Status status = Run(m_Server.Port());
  EXPECT_TRUE(status == VL_WS_E_NETWORK || status == VL_WS_E_CONNECT) << status;
}

// The server time's request, which no other test sees whole (it makes a context of its own).
TEST(ServerTime, AsksWithAHandBuiltGet) {
  VLTestServer& service = VLStandInServer(VL_STORE_PRODUCTION_HOST, 80);
  service.SetReply(VLTestServer::HttpReply("12/31/2010 11:59:59 PM", "200 OK"));
  time_t now = 0;
  ASSERT_EQ(VL_WS_OK, VL_WS_getServerTime(&now));
  EXPECT_EQ(1293839999, now);
  EXPECT_EQ("GET /device/time/ HTTP/1.1\r\nUser-Agent: DUDUVud\r\nHost: " VL_STORE_PRODUCTION_HOST "\r\n\r\n",
            service.Requests().back());
}

TEST(HttpURL, SplitsHostPortAndPath) {
  VLHttpURL parts;
  ASSERT_TRUE(VLHttpGet::SplitURL("http://images.ostrel.example/probe/file.bin", &parts));
  EXPECT_STREQ("images.ostrel.example", parts.host.c_str());
  EXPECT_EQ(80, parts.port);
  EXPECT_STREQ("probe/file.bin", parts.path.c_str());
  ASSERT_TRUE(VLHttpGet::SplitURL("HTTPS://store.ostrel.example/api/RealTimeBrowse.asmx", &parts));
  EXPECT_EQ(443, parts.port);
  ASSERT_TRUE(VLHttpGet::SplitURL("http://127.0.0.1:8080/p", &parts));
  EXPECT_STREQ("127.0.0.1:8080", parts.authority.c_str());
  EXPECT_STREQ("127.0.0.1", parts.host.c_str());
  EXPECT_EQ(8080, parts.port);
  for (const char* bad :
       {"http://host", "http://host/", "images.ostrel.example/probe", "http:///probe", "http://:80/probe",
        "http://host:/p", "http://host:0/p", "http://host:65536/p", "http://host:8o/p"})
    EXPECT_FALSE(VLHttpGet::SplitURL(bad, &parts)) << bad;
}

}  // namespace
