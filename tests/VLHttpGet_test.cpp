// VLHttpGet, the hand-built HTTP exchange of box art, the server time and the bandwidth probe,
// against canned answers of a loopback server: what it sends, how it reads answers and which
// answers it refuses.
#include <gtest/gtest.h>
#include <sys/socket.h>

#include <string>

#include "VLHttpGet.h"
#include "VLSoapTransport.h"
#include "VLTestServer.h"

namespace {

// A context as the library's plain requests use it, with short time-outs.
class HttpContext : public soap {
 public:
  HttpContext() : soap(SOAP_C_UTFSTRING) {
    send_timeout = connect_timeout = recv_timeout = 5;
    socket_flags = MSG_NOSIGNAL;
    VLSoapTransport::Install(this);
  }
  // A failed connection leaves its fault record in the context.
  ~HttpContext() {
    soap_destroy(this);
    soap_end(this);
  }
};

class HttpGet : public testing::Test {
 protected:
  VLHttpGet::Result Get(const std::string& reply) {
    m_Server.SetReply(reply);
    return Run(m_Server.Port());
  }
  VLHttpGet::Result Run(int port) {
    std::string url = "http://127.0.0.1:" + std::to_string(port) + "/probe";
    return m_Get.Run(url.c_str(), "127.0.0.1", port, "GET /probe HTTP/1.1\r\nHost: probe\r\n\r\n");
  }

  VLTestServer m_Server;
  HttpContext m_Context;
  VLHttpGet m_Get{&m_Context};
};

TEST_F(HttpGet, FindsTheBodyAndTheHeaderFields) {
  ASSERT_EQ(VLHttpGet::HTTP_OK, Get("HTTP/1.1 200 OK\r\ncontent-length:  5 \r\nLast-Modified: Mon, 03 Jan 2011 "
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
  ASSERT_EQ(1u, m_Server.Requests().size());
  EXPECT_EQ("GET /probe HTTP/1.1\r\nHost: probe\r\n\r\n", m_Server.Requests()[0]);
}

TEST_F(HttpGet, ABodyBeyondItsLengthIsCutAndALongerOneIsReadOn) {
  ASSERT_EQ(VLHttpGet::HTTP_OK, Get("HTTP/1.1 200 OK\r\nContent-Length: 3\r\n\r\nabcdef"));
  EXPECT_EQ(3u, m_Get.BodyReceived());
  EXPECT_STREQ("abc", m_Get.Body());

  std::string body(10000, 'x');
  ASSERT_EQ(VLHttpGet::HTTP_OK, Get("HTTP/1.1 200 OK\r\nContent-Length: 10000\r\n\r\n" + body));
  size_t total = m_Get.BodyReceived();
  EXPECT_LT(total, 2048u);
  char piece[4096];
  while (size_t n = m_Get.Receive(piece, sizeof piece)) total += n;
  EXPECT_EQ(10000u, total);
}

TEST_F(HttpGet, OtherAnswersAreNamed) {
  static const char kNulInHeader[] = "HTTP/1.1 200 OK\r\nX-Nul: a\0b\r\nContent-Length: 1\r\n\r\nx";
  struct {
    std::string reply;
    VLHttpGet::Result result;
  } cases[] = {
      {"HTTP/1.1 404 Not Found\r\nContent-Length: 0\r\n\r\n", VLHttpGet::HTTP_NOT_FOUND},
      {"HTTP/1.1 304 Not Modified\r\n\r\n", VLHttpGet::HTTP_NOT_MODIFIED},
      {"HTTP/1.1 500 Internal Server Error\r\nContent-Length: 1\r\n\r\nx", VLHttpGet::HTTP_BAD_ANSWER},
      {"HTTP/1.0 200 OK\r\nContent-Length: 1\r\n\r\nx", VLHttpGet::HTTP_BAD_ANSWER},
      {"HTTP/1.1 200 OK\r\n\r\nx", VLHttpGet::HTTP_BAD_ANSWER},
      {"HTTP/1.1 200 OK\r\nContent-Length: 0\r\n\r\n", VLHttpGet::HTTP_BAD_ANSWER},
      {"HTTP/1.1 200 OK\r\nContent-Length: 12x\r\n\r\nx", VLHttpGet::HTTP_BAD_ANSWER},
      {"HTTP/1.1 200 OK\r\nContent-Length: -1\r\n\r\nx", VLHttpGet::HTTP_BAD_ANSWER},
      {"HTTP/1.1 200 OK\r\nContent-Length: 99999999999999999999\r\n\r\nx", VLHttpGet::HTTP_BAD_ANSWER},
      {"HTTP/1.1 200 OK\r\nX-Body: Content-Length: 1\r\n\r\nx", VLHttpGet::HTTP_BAD_ANSWER},
      {"HTTP/1.1 200 OK\r\nContent-Length: 1\r\n", VLHttpGet::HTTP_BAD_ANSWER},
      // The whole header must fit into the first piece.
      {"HTTP/1.1 200 OK\r\nX-Long: " + std::string(3000, 'a') + "\r\nContent-Length: 1\r\n\r\nx",
       VLHttpGet::HTTP_BAD_ANSWER},
      {std::string(kNulInHeader, sizeof kNulInHeader - 1), VLHttpGet::HTTP_OK},
      {"", VLHttpGet::HTTP_NOTHING_RECEIVED},
  };
  for (const auto& c : cases) EXPECT_EQ(c.result, Get(c.reply)) << c.reply;
}

// TCP may deliver an answer in pieces anywhere, also within the header: it is read to the end
// of the header, and a small body to its announced length.
TEST_F(HttpGet, AnswersThatArriveInPiecesAreReadWhole) {
  m_Server.SetBehaviour(VLTestServer::kPieces);
  ASSERT_EQ(VLHttpGet::HTTP_OK, Get("HTTP/1.1 200 OK\r\nLast-Modified: Mon, 03 Jan 2011 10:00:00 GMT\r\n"
                                    "Content-Length: 25\r\n\r\n12/31/2010 11:59:59 PM ok"));
  VLString value;
  EXPECT_TRUE(m_Get.Field("Last-Modified", &value));
  EXPECT_STREQ("Mon, 03 Jan 2011 10:00:00 GMT", value.c_str());
  ASSERT_TRUE(m_Get.ReceiveBody());
  EXPECT_EQ(25u, m_Get.BodyReceived());
  EXPECT_STREQ("12/31/2010 11:59:59 PM ok", m_Get.Body());
  EXPECT_EQ(VLHttpGet::HTTP_NOT_FOUND, Get("HTTP/1.1 404 Not Found\r\nContent-Length: 0\r\n\r\n"));

  // A body that ends early, or does not fit beside the header, is not read whole.
  ASSERT_EQ(VLHttpGet::HTTP_OK, Get("HTTP/1.1 200 OK\r\nContent-Length: 30\r\n\r\nshort"));
  EXPECT_FALSE(m_Get.ReceiveBody());
  ASSERT_EQ(VLHttpGet::HTTP_OK, Get("HTTP/1.1 200 OK\r\nContent-Length: 3000\r\n\r\nlong"));
  EXPECT_FALSE(m_Get.ReceiveBody());
}

TEST_F(HttpGet, ConnectionFailures) {
  EXPECT_EQ(VLHttpGet::HTTP_CONNECT_FAILED, Run(VLClosedPort()));
  m_Server.SetBehaviour(VLTestServer::kCloseAtOnce);
  EXPECT_NE(VLHttpGet::HTTP_OK, Run(m_Server.Port()));
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
