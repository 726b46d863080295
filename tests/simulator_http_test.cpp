// The simulator's plain HTTP endpoints, its TLS certificates and the transport faults, spoken to
// over real sockets the way the client's hand-written requests speak to them.
#include <gtest/gtest.h>
#include <jpeglib.h>
#include <openssl/x509.h>

#include <chrono>
#include <cstdio>
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

// Width and height of a JPEG file, decoded with libjpeg; false when it does not decode.
bool DecodeJpeg(const std::string& data, int* width, int* height) {
  jpeg_decompress_struct info;
  jpeg_error_mgr errors;
  info.err = jpeg_std_error(&errors);
  errors.error_exit = [](j_common_ptr) { throw 1; };
  bool ok = true;
  jpeg_create_decompress(&info);
  try {
    jpeg_mem_src(&info, reinterpret_cast<const unsigned char*>(data.data()), data.size());
    jpeg_read_header(&info, TRUE);
    jpeg_start_decompress(&info);
    std::vector<JSAMPLE> row(info.output_width * info.output_components);
    while (info.output_scanline < info.output_height) {
      JSAMPROW rows[1] = {row.data()};
      jpeg_read_scanlines(&info, rows, 1);
    }
    *width = info.output_width;
    *height = info.output_height;
    jpeg_finish_decompress(&info);
  } catch (int) {
    ok = false;
  }
  jpeg_destroy_decompress(&info);
  return ok;
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

TEST_F(SimulatorHttp, DeviceEnvironmentAnswersOneDigitPerDevice) {
  m_Sim.Store().SetDeviceEnv("AB CD/1", 1);
  VLSimTestReply known = Secure(VL_STORE_PRODUCTION_HOST, "/device/env/?d=AB%20CD%2F1&dt=5");
  EXPECT_EQ(0u, known.raw.find("HTTP/1.1 200 OK\r\n"));
  EXPECT_NE(std::string::npos, known.head.find("\r\nContent-Length: 1\r\n"));
  EXPECT_EQ("1", known.body);
  EXPECT_EQ("2", Secure(VL_STORE_PRODUCTION_HOST, "/device/env/?d=OTHER&dt=5").body);
  m_Sim.Store().SetDefaultEnv(0);
  EXPECT_EQ("0", Secure(VL_STORE_PRODUCTION_HOST, "/device/env/?d=OTHER&dt=5").body);
  EXPECT_EQ(400, Secure(VL_STORE_PRODUCTION_HOST, "/device/env/?dt=5").status);
  EXPECT_EQ(404, Plain(VL_STORE_PRODUCTION_HOST, "/device/env/?d=X&dt=5").status) << "HTTPS only";
  EXPECT_EQ(404, Secure(VL_STORE_STAGING_HOST, "/device/env/?d=X&dt=5").status) << "production host only";
}

TEST_F(SimulatorHttp, ServerTimeIsTheStoreClockOnATwelveHourDial) {
  // The store clock may tick once between setting it and the answer: either text is right.
  struct Case {
    time_t when;
    const char* text;
    const char* next;
  } cases[] = {{1293839999, "12/31/2010 11:59:59 PM", "1/1/2011 12:00:00 AM"},
               {1293840300, "1/1/2011 12:05:00 AM", "1/1/2011 12:05:01 AM"},
               {1293883200, "1/1/2011 12:00:00 PM", "1/1/2011 12:00:01 PM"},
               {1293886861, "1/1/2011 1:01:01 PM", "1/1/2011 1:01:02 PM"}};
  for (const Case& c : cases) {
    m_Sim.Store().SetNow(c.when);
    VLSimTestReply reply = Time();
    EXPECT_EQ(0u, reply.raw.find("HTTP/1.1 200 OK\r\n"));
    EXPECT_TRUE(reply.body == c.text || reply.body == c.next) << reply.body;
    EXPECT_EQ(std::to_string(reply.body.size()), reply.Header("Content-Length"));
  }
  EXPECT_EQ(404, Secure(VL_STORE_PRODUCTION_HOST, "/device/time/").status) << "plain HTTP only";
}

TEST_F(SimulatorHttp, BoxArtIsRealJpegRevalidatedByLastModified) {
  const std::string prefix = "night owl_";  // the sample store's prefix with a space
  ASSERT_TRUE(m_Sim.Catalogue().HasBoxArt(prefix));
  const std::string path = VLSimBoxArtPath(prefix, 6);
  EXPECT_EQ("/images/boxart/135s/night%20owl_135.jpg", path);

  VLSimTestReply first = Plain(VL_STORE_IMAGE_HOST, path);
  ASSERT_EQ(0u, first.raw.find("HTTP/1.1 200 OK\r\n"));
  EXPECT_EQ("image/jpeg", first.Header("Content-Type"));
  EXPECT_EQ(std::to_string(first.body.size()), first.Header("Content-Length"));
  int width = 0, height = 0;
  ASSERT_TRUE(DecodeJpeg(first.body, &width, &height));
  EXPECT_EQ(135, width);
  EXPECT_EQ(first.body, Plain(VL_STORE_IMAGE_HOST, path).body) << "deterministic";
  EXPECT_NE(first.body, Plain(VL_STORE_IMAGE_HOST, VLSimBoxArtPath(prefix, 1)).body);
  const std::string modified = first.Header("Last-Modified");
  ASSERT_FALSE(modified.empty());

  VLSimTestReply same = Plain(VL_STORE_IMAGE_HOST, path, "If-Modified-Since: " + modified + "\r\n");
  EXPECT_EQ(0u, same.raw.find("HTTP/1.1 304 Not Modified\r\n"));
  EXPECT_TRUE(same.body.empty());
  EXPECT_EQ(200, Plain(VL_STORE_IMAGE_HOST, path, "If-Modified-Since: Sun, 02 Jan 2011 10:00:00 GMT\r\n").status);
  EXPECT_EQ(200, Plain(VL_STORE_IMAGE_HOST, path, "If-Modified-Since: yesterday\r\n").status);

  m_Sim.Store().TouchBoxArt(prefix);
  VLSimTestReply changed = Plain(VL_STORE_IMAGE_HOST, path, "If-Modified-Since: " + modified + "\r\n");
  EXPECT_EQ(200, changed.status);
  EXPECT_NE(modified, changed.Header("Last-Modified"));
  EXPECT_NE(first.body, changed.body);
  ASSERT_TRUE(DecodeJpeg(changed.body, &width, &height));

  EXPECT_EQ(0u, Plain(VL_STORE_IMAGE_HOST, VLSimBoxArtPath("unknown_", 1)).raw.find("HTTP/1.1 404 Not Found\r\n"));
  EXPECT_EQ(404, Plain(VL_STORE_IMAGE_HOST, "/images/boxart/135/night%20owl_135.jpg").status) << "no such folder word";
  EXPECT_EQ(404, Plain(VL_STORE_PRODUCTION_HOST, path).status) << "image host only";
}

TEST_F(SimulatorHttp, BandwidthProbeIsServedWhereTheConfigurationPoints) {
  std::string url;
  for (const auto& item : m_Sim.Store().ConfigItems())
    if (item.first == "BandwithCheckURL") url = item.second;
  const std::string prefix = "http://" VL_STORE_IMAGE_HOST "/";
  ASSERT_EQ(0u, url.find(prefix)) << url;
  std::string path = url.substr(prefix.size() - 1);

  // Like the client: read only the head and a little body, then hang up.
  VLSimTestReply reply = Plain(VL_STORE_IMAGE_HOST, path);
  EXPECT_EQ(std::to_string(m_Sim.Options().probeBytes), reply.Header("Content-Length"));
  EXPECT_EQ(static_cast<size_t>(m_Sim.Options().probeBytes), reply.body.size());

  m_Sim.Store().SetConfigItem("BandwithCheckURL", "https://" VL_STORE_STAGING_HOST "/probe/file.bin");
  EXPECT_EQ(404, Plain(VL_STORE_IMAGE_HOST, path).status);
  EXPECT_EQ(200, Secure(VL_STORE_STAGING_HOST, "/probe/file.bin").status);
}

TEST_F(SimulatorHttp, EveryLogicalHostVerifiesAgainstTheTestCA) {
  int hosts = 0;
  for (const char* const* host = VLSimServer::Hosts(); *host; ++host, ++hosts) {
    VLSimTestReply reply = Secure(*host, "/nothing-here");
    EXPECT_TRUE(reply.connected) << *host << ": " << reply.error;
    EXPECT_EQ(404, reply.status) << *host;
    EXPECT_NE(std::string::npos, m_Sim.ConnectTo().find(std::string(*host) + ":443:127.0.0.1:" +
                                                         std::to_string(m_Sim.TlsPort())));
    EXPECT_NE(std::string::npos, m_Sim.ConnectTo().find(std::string(*host) + ":80:127.0.0.1:" +
                                                         std::to_string(m_Sim.HttpPort())));
  }
  EXPECT_EQ(6, hosts);
  VLSimTestReply stranger = Secure("elsewhere.example", "/");
  EXPECT_FALSE(stranger.connected) << "no SAN for other names, and the CN matches none";
  ASSERT_TRUE(m_Sim.WaitForRequests(hosts + 1, 5000));
  EXPECT_EQ(404, Plain("elsewhere.example", "/device/time/").status);
  EXPECT_EQ("unknown host", m_Sim.Requests().back().note);
}

TEST_F(SimulatorHttp, TlsFaultsPresentCertificatesAVerifyingClientRefuses) {
  for (const char* kind : {"selfsigned", "wronghost", "expired"}) {
    SCOPED_TRACE(kind);
    Fault(std::string(VL_STORE_STAGING_HOST) + "=tls:" + kind + ",times=1");
    m_Sim.ClearRequests();
    EXPECT_FALSE(Secure(VL_STORE_STAGING_HOST, "/").connected);
    ASSERT_TRUE(m_Sim.WaitForRequests(1, 5000));
    EXPECT_EQ("TLS handshake failed", m_Sim.Requests().back().note);
    EXPECT_EQ(std::string("tls:") + kind, m_Sim.Requests().back().faults);
    EXPECT_TRUE(Secure(VL_STORE_STAGING_HOST, "/").connected) << "times=1";
  }
  Fault("*=tls:selfsigned");
  EXPECT_FALSE(Secure(VL_STORE_PRODUCTION_HOST, "/").connected);
  EXPECT_FALSE(Secure(VL_STORE_ADULT_STAGING_HOST, "/").connected);
}

TEST_F(SimulatorHttp, TransportFaultsDoWhatTheySay) {
  std::string label;
  ASSERT_EQ(SOAP_OK, GenreLabel(&label));
  ASSERT_EQ("Drama", label);
  VLSimTestReply reply;

  Fault("/device/time/=close,times=1");
  reply = Time();
  EXPECT_TRUE(reply.connected);
  EXPECT_TRUE(reply.raw.empty());
  EXPECT_EQ(200, Time().status);

  Fault("getGenreLabel=cut,times=1");
  EXPECT_NE(SOAP_OK, GenreLabel(&label, &reply));
  EXPECT_LT(reply.body.size(), std::stoul(reply.Header("Content-Length")));

  Fault("getGenreLabel=status:503,times=1");
  EXPECT_EQ(503, GenreLabel(&label, &reply));
  EXPECT_EQ(0u, reply.raw.find("HTTP/1.1 503 Service Unavailable\r\n"));
  Fault("/device/time/=status:404,times=1");
  EXPECT_EQ(404, Time().status);

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
  }

  Fault("/device/time/=badlength,times=1");
  reply = Time();
  EXPECT_EQ(std::to_string(reply.body.size() + 64), reply.Header("Content-Length"));
  Fault("/device/time/=badlength:-5,times=1");
  reply = Time();
  EXPECT_EQ(std::to_string(reply.body.size() - 5), reply.Header("Content-Length"));

  Fault("/device/time/=delay:300,times=1");
  Clock::time_point start = Clock::now();
  EXPECT_EQ(200, Time().status);
  EXPECT_GE(Milliseconds(start), 300);

  Fault("/device/time/=trickle:20,times=1");
  start = Clock::now();
  reply = Time();
  EXPECT_EQ(200, reply.status);
  EXPECT_GE(Milliseconds(start), static_cast<long>((reply.raw.size() - 1) / 64) * 20);

  Fault("/images/boxart/=status:500,times=1");
  EXPECT_EQ(500, Plain(VL_STORE_IMAGE_HOST, VLSimBoxArtPath("night owl_", 0)).status) << "a path prefix";
  EXPECT_EQ(200, Plain(VL_STORE_IMAGE_HOST, VLSimBoxArtPath("night owl_", 0)).status);
  EXPECT_EQ(SOAP_OK, GenreLabel(&label));
}

TEST_F(SimulatorHttp, ServesConnectionsConcurrentlyAndStopsHeldAnswers) {
  Fault("/device/time/=delay:3000,times=1");
  Clock::time_point start = Clock::now();
  std::future<VLSimTestReply> slow = std::async(std::launch::async, [this] { return Time(); });
  std::this_thread::sleep_for(std::chrono::milliseconds(100));
  for (int i = 0; i < 5; ++i) EXPECT_EQ(200, Plain(VL_STORE_IMAGE_HOST, VLSimBoxArtPath("night owl_", i)).status);
  EXPECT_LT(Milliseconds(start), 3000) << "the held answer did not block the others";
  EXPECT_EQ(200, slow.get().status);

  // ReturnTimeout holds its answer far longer than any test; Stop ends it.
  std::future<int> held = std::async(std::launch::async, [this] {
    VLSimSoapCall call;
    call.path = "/api/StreamAPI.asmx";
    call.settingsElement = "StreamDeviceRequestSettings";
    VLSimSoapExchange exchange;
    _VL1__ReturnTimeout request;
    _VL1__ReturnTimeoutResponse response;
    return exchange.Run(m_Sim.TlsPort(), m_Sim.CAFile(), call, "ReturnTimeout", &request, &response);
  });
  std::this_thread::sleep_for(std::chrono::milliseconds(300));
  start = Clock::now();
  m_Sim.Stop();
  EXPECT_LT(Milliseconds(start), 5000);
  EXPECT_NE(SOAP_OK, held.get());
}

}  // namespace
