// The fault matrix: every way the store's hosts can fail (a refused connection, a connection
// closed or cut, HTTP errors, SOAP faults and refusing response codes, damaged, compressed,
// mis-announced, slow and split answers, false certificates) against one operation of each kind:
// a cached catalogue page, a page kept as user data, a plain account answer, a stream location,
// box art, the bandwidth probe, the device-environment query and the server time. Each cell
// checks the status the interface documents for it, a record that carries its tag and can be
// released, a cache left as it was, and that the same handle works for the next call. Standard
// output gets one line per cell: operation, fault, outcome.
#include <gtest/gtest.h>

#include <stdio.h>
#include <stdlib.h>
#include <unistd.h>

#include <chrono>
#include <sstream>
#include <string>

#include "VLSimServer.h"
#include "VLTestDir.h"
#include "VLTestRelay.h"
#include "VLTestSimulator.h"
#include "VL_WS.h"
#include "VL_WS_Client.h"

namespace {

// ---- The fault modes -------------------------------------------------------------------------

enum Mode {
  kRefused, kClosed, kCut, k404, k500, k503, kSoapFault, kCode, kMalformed, kTruncated, kGzip, kDeflate,
  kLonger, kShorter, kSlow, kPieces, kUntrusted, kWrongHost, kExpired, kModeCount
};

// How the simulator injects each mode (one or more of its faults) into the next answer of the
// operation's target; refused connections come from the relay in front of the simulator, and
// certificates are a property of the host's TLS handshake. The slow answer starts after 700 ms
// and comes in 64-byte pieces 700 ms apart: each wait is shorter than the receive time-out the
// cell sets (800 ms), the whole exchange is longer than its deadline (300 + 800 ms), even for
// the shortest answer. The split answer comes in 64-byte pieces 2 ms apart.
const struct {
  const char* name;
  const char* spec;
} kModes[kModeCount] = {
    {"refused", ""},           {"closed", "close"},         {"cut", "cut"},
    {"http404", "status:404"}, {"http500", "status:500"},   {"http503", "status:503"},
    {"soapfault", "soapfault"}, {"code", "code:5"},         {"malformed", "malformed"},
    {"truncated", "truncated"}, {"gzip", "gzip"},           {"deflate", "deflate"},
    {"longer", "badlength:64"}, {"shorter", "badlength:-64"}, {"slow", "delay:700 trickle:700"},
    {"pieces", "trickle:2"},   {"untrusted", "tls:selfsigned"}, {"wronghost", "tls:wronghost"},
    {"expired", "tls:expired"},
};

// ---- The operations --------------------------------------------------------------------------

// A cell's outcome: the operation's status, or one of these marks (statuses are never positive).
const int kNotApplicable = 1;  // the fault cannot happen to the operation
const int kProduction = 2;     // the environment query's VL_WS_OK with the production environment,
                               // which it answers for every answer it cannot read

const VL_WS_Status OK = VL_WS_OK, CONNECT = VL_WS_E_CONNECT, EOF_ = VL_WS_E_EOF, NET = VL_WS_E_NETWORK,
                   UNEXPECTED = VL_WS_E_UNEXPECTED, NOT_FOUND = VL_WS_E_HTTP_NOT_FOUND, TLS = VL_WS_E_TLS,
                   SERVER_FAULT = VL_WS_E_SOAP_FAULT(2);
constexpr int HTTP(int status) { return VL_WS_E_HTTP_STATUS(status); }
const int NA = kNotApplicable, PROD = kProduction;

// The outcomes of each mode, in the order of kModes, as the interface documents them.
//
// SOAP calls: a connection refused is -2011; closed before the answer, -2012; a certificate
// that is not the host's, -5030; HTTP errors and faults have their own statuses, a refusing
// response code is -1004. An answer that ends early (cut, or truncated to its announced length)
// ends as an early end (-2012), or as an HTTP 200 answer without a body that can be read (-4200)
// when what came does not reach into the body: for the short answers of the account and
// streaming calls, half of the answer is little more than the envelope's start; at the deadline
// of the slow cell not even the header is whole. A malformed body is -4200 too. Compressed
// answers are read; a Content-Length that is off either way does not matter, as the runtime
// reads the answer of a connection that closes to its end.
const int kSoapPage[kModeCount] = {CONNECT,    EOF_,      EOF_,      HTTP(404), HTTP(500), HTTP(503), SERVER_FAULT,
                                   UNEXPECTED, HTTP(200), EOF_,      OK,        OK,        OK,        OK,
                                   HTTP(200),  OK,        TLS,       TLS,       TLS};
const int kSoapAnswer[kModeCount] = {CONNECT,    EOF_,      HTTP(200), HTTP(404), HTTP(500), HTTP(503), SERVER_FAULT,
                                     UNEXPECTED, HTTP(200), HTTP(200), OK,        OK,        OK,        OK,
                                     HTTP(200),  OK,        TLS,       TLS,       TLS};
// The hand-built requests: a refused connection is -2011, "404 Not Found" -1901; any other
// answer that is not "200 OK" with its whole body as announced (closed, cut, encoded, slow) is
// -1001. Box art must be a JPEG image; the probe reads bytes, whatever they are, up to the
// announced length; the server time's body must be a time of its announced length (-1004).
// The environment query answers production for anything it cannot read, and fails (-1001) only
// when it cannot connect.
const int kBoxArt[kModeCount] = {CONNECT, NET, NET, NOT_FOUND, NET, NET, NA, NA, NET, NET,
                                 NET,     NET, NET, NET,       NET, OK,  NA, NA, NA};
const int kProbe[kModeCount] = {CONNECT, NET, NET, NOT_FOUND, NET, NET, NA, NA, OK, OK,
                                NET,     NET, NET, OK,        NET, OK,  NA, NA, NA};
const int kEnvironment[kModeCount] = {NET,  PROD, PROD, PROD, PROD, PROD, NA, NA,  PROD, PROD,
                                      PROD, PROD, PROD, PROD, PROD, OK,   NET, NET, NET};
// The server time has no handle: its fixed time-outs (30 + 88 s) are too long for a slow cell.
const int kServerTime[kModeCount] = {CONNECT, NET, UNEXPECTED, NET, NET, NET, NA, NA, UNEXPECTED, UNEXPECTED,
                                     NET,     NET, UNEXPECTED, NET, NA,  OK,  NA, NA, NA};

const int kBonusTrailer = 10015;

const struct Operation {
  const char* name;
  const char* target;  // the simulator's fault target
  int (*call)(VL_WS_Handle* handle);
  const int* outcome;  // of each mode
} kOperations[] = {
    {"getTitles (cached)", "getTitlesByNavigation",
     [](VL_WS_Handle* h) {
       VL_WS_TitlesResponse page;
       VL_WS_Status status = VL_WS_getTitles(h, 10, 1, 5, 2, &page);
       EXPECT_EQ(VL_WS_TAG_TITLES_RESPONSE, *page.tag);
       EXPECT_EQ(status == OK || page.ResponseCode != 0 ? 5 : 0, page.Titles.Count);  // a refused page is kept
       EXPECT_EQ(VL_WS_OK, VL_WS_release(&page));
       return status;
     },
     kSoapPage},
    {"getEmailAddress (user data)", "getEmailAddress",
     [](VL_WS_Handle* h) {
       return VLReleasedCall<VL_WS_EmailAddressResponse>(VL_WS_TAG_EMAIL_ADDRESS_RESPONSE, VL_WS_getEmailAddress, h);
     },
     kSoapAnswer},
    {"getPrePaidCardBalance", "showPrePaidCardBalance",
     [](VL_WS_Handle* h) {
       return VLReleasedCall<VL_WS_PrePaidCardBalanceResponse>(VL_WS_TAG_PREPAID_CARD_BALANCE_RESPONSE,
                                                               VL_WS_getPrePaidCardBalance, h);
     },
     kSoapAnswer},
    {"getStreamingBonusAssetLocation", "getBonusAssetLocation",
     [](VL_WS_Handle* h) {
       return VLReleasedCall<VL_WS_StreamingAssetLocationResponse>(
           VL_WS_TAG_STREAMING_ASSET_LOCATION_RESPONSE, VL_WS_getStreamingBonusAssetLocation, h, kBonusTrailer);
     },
     kSoapAnswer},
    {"getBoxArtImageData", "/images/boxart/",
     [](VL_WS_Handle* h) {
       VL_WS_Image image;
       VL_WS_Status status = VL_WS_getBoxArtImageData(h, VL_WS_BOXART_175, "t1001_", &image);
       EXPECT_EQ(VL_WS_TAG_IMAGE, *image.tag);
       EXPECT_EQ(status == OK, image.Data != nullptr);
       EXPECT_EQ(VL_WS_OK, VL_WS_release(&image));
       return status;
     },
     kBoxArt},
    {"checkBandwidth", "/speedtest/",
     [](VL_WS_Handle* h) {
       unsigned int bits = 12345;
       VL_WS_Status status = VL_WS_checkBandwidth(h, &bits);
       EXPECT_EQ(status == OK, bits != 0);
       return status;
     },
     kProbe},
    {"getDefaultEnvID", "/device/env/",
     [](VL_WS_Handle* h) {
       VL_WS_EnvID env = 99;
       VL_WS_Status status = VL_WS_getDefaultEnvID(h, &env);
       if (status != OK) {
         EXPECT_EQ(99, env);
         return status;
       }
       EXPECT_TRUE(env == 1 || env == 2) << env;  // what the store answers, or production
       return env == 2 ? kProduction : status;
     },
     kEnvironment},
    {"getServerTime", "/device/time/",
     [](VL_WS_Handle*) {
       time_t now = 12345;
       VL_WS_Status status = VL_WS_getServerTime(&now);
       EXPECT_EQ(status == OK, now != -1);
       return status;
     },
     kServerTime},
};

// ---- The setting -----------------------------------------------------------------------------

class FaultMatrix : public testing::Test {
 protected:
  static void SetUpTestSuite() {
    VLSimOptions options;
    options.probeBytes = 16384;  // a split answer of the probe takes 0.5 s, not 30
    s_Sim = new VLSimServer(options);
    std::string error;
    ASSERT_TRUE(s_Sim->Start(&error)) << error;
    s_Relays[0] = new VLTestRelay(s_Sim->TlsPort());
    s_Relays[1] = new VLTestRelay(s_Sim->HttpPort());
    std::string connectTo;
    for (const char* const* host = VLSimServer::Hosts(); *host; ++host) {
      connectTo += std::string(connectTo.empty() ? "" : ",") + *host + ":443:127.0.0.1:" +
                   std::to_string(s_Relays[0]->Port()) + "," + *host + ":80:127.0.0.1:" +
                   std::to_string(s_Relays[1]->Port());
    }
    setenv("SSL_CERT_FILE", s_Sim->CAFile().c_str(), 1);
    setenv("VLWS_CONNECT_TO", connectTo.c_str(), 1);
  }
  static void TearDownTestSuite() {
    delete s_Relays[0];
    delete s_Relays[1];
    delete s_Sim;
  }

  // A handle with a file cache of every kind, authorised for an account, its probe URL known,
  // the store's environment for the device staging (1), so that an answer read tells.
  void SetUp() override {
    VL_WS_SetupParams params = VLTestSetupParams(2, 7, m_Dir.path().c_str());
    ASSERT_EQ(VL_WS_OK, VL_WS_initialize(&m_Handle, &params));
    ASSERT_EQ(VL_WS_OK, VLReleasedCall<VL_WS_AuthorizeDeviceResponse>(VL_WS_TAG_AUTHORIZE_DEVICE_RESPONSE,
                                                                       VL_WS_authorizeDevice, &m_Handle, 1234));
    unsigned int bits = 0;
    ASSERT_EQ(VL_WS_OK, VL_WS_checkBandwidth(&m_Handle, &bits));
    s_Sim->Store().SetDefaultEnv(1);
    m_CacheFile = VLCacheFileIn(m_Dir.path());
    ASSERT_FALSE(m_CacheFile.empty());
  }
  void TearDown() override {
    s_Sim->Store().SetDefaultEnv(2);
    s_Sim->ClearFaults();
    VL_WS_release(&m_Handle);
  }

  // Everything the cache holds, answers and images, as text.
  std::string CacheContents() {
    std::string contents;
    for (const char* table : {"Service", "BoxArt", "Cache", "Userdata"})
      contents += std::string(table) + ":\n" + VLRunSql(m_CacheFile, std::string("SELECT * FROM ") + table) + "\n";
    for (const std::string& file : VLFolderFiles(m_Dir.path())) contents += file + "\n";
    return contents;
  }

  // Drops the answers and images the cache keeps, so that the next call asks the store.
  void EmptyCache() {
    VLRunSql(m_CacheFile, "DELETE FROM Service; DELETE FROM Userdata; DELETE FROM BoxArt;");
    for (const std::string& file : VLFolderFiles(m_Dir.path()))
      if (file.find(".jpg") != std::string::npos) unlink((m_Dir / file).c_str());
  }

  // Each wait for the store and the whole exchange short (0.3 + 0.8 s), or the handle's own.
  void ShortTimeouts(bool shortened) {
    soap* contexts[] = {&m_Handle.client->m_RealTimeBrowse, &m_Handle.client->m_StreamAPI,
                        &m_Handle.client->m_DownloadAPI};
    for (soap* context : contexts) {
      context->send_timeout = shortened ? -300000 : m_Handle.client->m_Params.SendTimeout;
      context->recv_timeout = shortened ? -800000 : m_Handle.client->m_Params.RecvTimeout;
    }
  }

  static VLSimServer* s_Sim;
  static VLTestRelay* s_Relays[2];  // in front of the simulator's TLS and plain port
  VLTestDir m_Dir;
  std::string m_CacheFile;
  VL_WS_Handle m_Handle = {};
};

VLSimServer* FaultMatrix::s_Sim = nullptr;
VLTestRelay* FaultMatrix::s_Relays[2] = {};

TEST_F(FaultMatrix, EveryFaultOfEveryKindOfOperation) {
  int cells = 0;
  auto start = std::chrono::steady_clock::now();
  for (const Operation& operation : kOperations) {
    for (int mode = 0; mode < kModeCount; ++mode) {
      const int expected = operation.outcome[mode];
      if (expected == kNotApplicable) continue;
      SCOPED_TRACE(std::string(operation.name) + ", " + kModes[mode].name);
      EmptyCache();
      const std::string before = CacheContents();
      std::string error;
      if (mode == kRefused) {
        ASSERT_TRUE(s_Relays[0]->SetRefusing(true) && s_Relays[1]->SetRefusing(true));
      } else {
        std::istringstream faults(kModes[mode].spec);
        for (std::string fault; faults >> fault;) {
          std::string target = mode >= kUntrusted ? "store.ostrel.example" : operation.target;
          ASSERT_TRUE(s_Sim->AddFault(target + "=" + fault + ",times=1", &error)) << error;
        }
      }
      ShortTimeouts(mode == kSlow);

      const int outcome = operation.call(&m_Handle);
      printf("%-32s %-10s %d%s\n", operation.name, kModes[mode].name, outcome == kProduction ? 0 : outcome,
             outcome == kProduction ? " (production)" : "");
      fflush(stdout);
      ++cells;

      ShortTimeouts(false);
      ASSERT_TRUE(s_Relays[0]->SetRefusing(false) && s_Relays[1]->SetRefusing(false));
      s_Sim->ClearFaults();
      EXPECT_EQ(expected, outcome);
      if (outcome != OK) {
        EXPECT_EQ(before, CacheContents()) << "the cache changed";
      }
      EmptyCache();
      EXPECT_EQ(OK, operation.call(&m_Handle)) << "the call after the fault";
    }
  }
  printf("%d cells in %lld ms\n", cells,
         static_cast<long long>(std::chrono::duration_cast<std::chrono::milliseconds>(
                                    std::chrono::steady_clock::now() - start)
                                    .count()));
}

}  // namespace
