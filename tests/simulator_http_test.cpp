// The simulator's plain HTTP endpoints and transport faults, where a wrong simulator would let a
// wrong client pass: each endpoint only on the scheme and host the store serves it on, the time
// text the client parses, the transport faults (compressed and slow answers among them), and
// connections served side by side. (Box-art revalidation is checked byte for byte by the client's
// box-art tests.)
#include <gtest/gtest.h>

#include <chrono>
#include <future>
#include <thread>

#include "VLSimBoxArt.h"
#include "VLSimServer.h"
#include "VLSimTestClient.h"
#include "VLStoreHosts.h"

namespace {

using Clock = std::chrono::steady_clock;

long Milliseconds(Clock::time_point since) {
  return static_cast<long>(std::chrono::duration_cast<std::chrono::milliseconds>(Clock::now() - since).count());
}

class SimulatorHttp : public testing::Test {
 protected:
  void SetUp() override {
    std::string error;
    ASSERT_TRUE(m_Sim.Start(&error)) << error;
  }

  VLSimTestReply Plain(const std::string& host, const std::string& target, const std::string& headers = "") {
    return VLSimExchange(m_Sim.HttpPort(), "", host, VLSimGetRequest(host, target, headers));
  }
  VLSimTestReply Secure(const std::string& host, const std::string& target) {
    return VLSimExchange(m_Sim.TlsPort(), m_Sim.CAFile(), host, VLSimGetRequest(host, target));
  }
  VLSimTestReply Time() { return Plain(VL_STORE_PRODUCTION_HOST, "/device/time/"); }
  void Fault(const std::string& spec) {
    std::string error;
    ASSERT_TRUE(m_Sim.AddFault(spec, &error)) << error;
  }

  // getGenreLabel through the client runtime's reader: its error code and the label.
  int GenreLabel(std::string* label, VLSimTestReply* reply = nullptr) {
    VLSimSoapExchange exchange;
    _VL1__getGenreLabel request;
    request.GenreID = 12;
    _VL1__getGenreLabelResponse response;
    int error = exchange.Run(m_Sim.TlsPort(), m_Sim.CAFile(), VLSimSoapCall(), "getGenreLabel", &request, &response);
    *label = response.getGenreLabelResult && response.getGenreLabelResult->Label ? response.getGenreLabelResult->Label : "";
    if (reply) *reply = exchange.reply;
    return error;
  }

  VLSimServer m_Sim;
};

TEST_F(SimulatorHttp, DeviceEnvironmentAndServerTimeOnlyWhereTheStoreServesThem) {
  m_Sim.Store().SetDeviceEnv("AB CD/1", 1);
  VLSimTestReply known = Secure(VL_STORE_PRODUCTION_HOST, "/device/env/?d=AB%20CD%2F1&dt=5");
  EXPECT_EQ(0u, known.raw.find("HTTP/1.1 200 OK\r\n"));
  EXPECT_EQ("1", known.Header("Content-Length"));
  EXPECT_EQ("1", known.body);
  EXPECT_EQ("2", Secure(VL_STORE_PRODUCTION_HOST, "/device/env/?d=OTHER&dt=5").body);
  EXPECT_EQ(400, Secure(VL_STORE_PRODUCTION_HOST, "/device/env/?dt=5").status);
  EXPECT_EQ(404, Plain(VL_STORE_PRODUCTION_HOST, "/device/env/?d=X&dt=5").status) << "HTTPS only";
  EXPECT_EQ(404, Secure(VL_STORE_STAGING_HOST, "/device/env/?d=X&dt=5").status) << "production host only";

  // The store clock on a twelve-hour dial; it may tick once before the answer.
  struct Case {
    time_t when;
    const char* text;
    const char* next;
  } cases[] = {{1293839999, "12/31/2010 11:59:59 PM", "1/1/2011 12:00:00 AM"},
               {1293840300, "1/1/2011 12:05:00 AM", "1/1/2011 12:05:01 AM"},
               {1293883200, "1/1/2011 12:00:00 PM", "1/1/2011 12:00:01 PM"}};
  for (const Case& c : cases) {
    m_Sim.Store().SetNow(c.when);
    VLSimTestReply reply = Time();
    EXPECT_TRUE(reply.body == c.text || reply.body == c.next) << reply.body;
    EXPECT_EQ(std::to_string(reply.body.size()), reply.Header("Content-Length"));
  }
  EXPECT_EQ(404, Secure(VL_STORE_PRODUCTION_HOST, "/device/time/").status) << "plain HTTP only";
}

TEST_F(SimulatorHttp, TransportFaultsDoWhatTheySay) {
  std::string label;
  VLSimTestReply reply;
  Fault("getGenreLabel=cut,times=1");
  EXPECT_NE(SOAP_OK, GenreLabel(&label, &reply));
  EXPECT_LT(reply.body.size(), std::stoul(reply.Header("Content-Length")));
  Fault("getGenreLabel=status:503,times=1");
  EXPECT_EQ(503, GenreLabel(&label, &reply));
  EXPECT_EQ(0u, reply.raw.find("HTTP/1.1 503 Service Unavailable\r\n"));
  Fault("getGenreLabel=malformed,times=1");
  EXPECT_NE(SOAP_OK, GenreLabel(&label, &reply));
  EXPECT_EQ(200, reply.status);
  Fault("getGenreLabel=truncated,times=1");
  EXPECT_NE(SOAP_OK, GenreLabel(&label, &reply));
  EXPECT_EQ(std::to_string(reply.body.size()), reply.Header("Content-Length"));
  for (const char* encoding : {"gzip", "deflate"}) {
    Fault(std::string("getGenreLabel=") + encoding + ",times=1");
    label.clear();
    EXPECT_EQ(SOAP_OK, GenreLabel(&label, &reply)) << encoding;
    EXPECT_EQ("Drama", label);
    EXPECT_EQ(encoding, reply.Header("Content-Encoding"));
    EXPECT_EQ(std::string::npos, reply.body.find("Drama")) << "the body is compressed";
  }

  Fault("/device/time/=delay:300,times=1");
  Clock::time_point start = Clock::now();
  EXPECT_EQ(200, Time().status);
  EXPECT_GE(Milliseconds(start), 300);

  Fault("/device/time/=trickle:20,times=1");
  start = Clock::now();
  reply = Time();
  EXPECT_EQ(200, reply.status);
  EXPECT_GE(Milliseconds(start), static_cast<long>((reply.raw.size() - 1) / 64) * 20);
}

TEST_F(SimulatorHttp, ServesConnectionsConcurrently) {
  Fault("/device/time/=delay:3000,times=1");
  Clock::time_point start = Clock::now();
  std::future<VLSimTestReply> slow = std::async(std::launch::async, [this] { return Time(); });
  std::this_thread::sleep_for(std::chrono::milliseconds(100));
  for (int i = 0; i < 5; ++i) EXPECT_EQ(200, Plain(VL_STORE_IMAGE_HOST, VLSimBoxArtPath("night owl_", i)).status);
  EXPECT_LT(Milliseconds(start), 3000) << "the held answer did not block the others";
  EXPECT_EQ(200, slow.get().status);
}

}  // namespace
