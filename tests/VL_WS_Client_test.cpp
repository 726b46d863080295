// Client handles against the store simulator: what the client-* sessions cannot show (what
// initialisation prints, null arguments, settings the handle keeps, a socket in the cache file's
// place), duplicates and TLS sessions.
#include <gtest/gtest.h>
#include <string.h>
#include <sys/socket.h>
#include <sys/un.h>
#include <unistd.h>

#include <string>
#include <vector>

#include "CacheInterface.h"
#include "VLTestDir.h"
#include "VLTestSimulator.h"
#include "VL_WS.h"
#include "VL_WS_Client.h"

namespace {

const char kDevice[] = "00-11-22-33-44-55";

class Client : public VLSimClientTest {
 protected:
  void TearDown() override {
    VLSimClientTest::TearDown();
    m_Sim.Store().SetDeviceEnv(kDevice, 2);
    m_Sim.Store().SetAccessType(STREAM);
  }

  // Initialises m_Handle (released first).
  VL_WS_Status Init(const VL_WS_SetupParams& params) {
    VL_WS_release(&m_Handle);
    return VL_WS_initialize(&m_Handle, &params);
  }
  VL_WS_SetupParams2& Settings() { return m_Handle.client->m_Params; }
  // A setup record with a file cache of all kinds in folder.
  static VL_WS_SetupParams FileCache(const std::string& folder) { return VLTestSetupParams(2, 7, folder.c_str()); }
  static bool IsEmpty(const VL_WS_Handle& handle) { return handle.tag == nullptr && handle.client == nullptr; }
  // The service the handle sends account operations to.
  static soap* Routing(const VL_WS_Handle& handle) { return &static_cast<soap&>(handle.client->m_StreamDownloadAPI); }
};

// What initialisation prints: the endpoint of a fixed environment or of the one the service
// named, and the User-Agent. Where requests go, the refusals of setup values, the access type and
// the cache file are pinned by the client-* sessions.
TEST_F(Client, PrintsTheEndpointAndTheUserAgent) {
  VL_WS_SetupParams params = VLTestSetupParams();
  params.ContentType = VL_WS_SetupParams::ADULT;
  params.EnvNum = VL_WS_ENV_STG;
  params.firmwareVersion = "fw1";
  testing::internal::CaptureStdout();
  ASSERT_EQ(VL_WS_OK, Init(params));
  EXPECT_EQ("\n=======>Content type:1, envID:1, endpoint URL:https://stg.adult.ostrel.example/api/\n"
            "\n***---> User-Agent = VLSDK: fw1|",
            testing::internal::GetCapturedStdout());

  m_Sim.Store().SetDeviceEnv(kDevice, 1);
  params = VLTestSetupParams();
  params.EnvNum = VL_WS_ENV_DEFAULT;
  testing::internal::CaptureStdout();
  ASSERT_EQ(VL_WS_OK, Init(params));
  EXPECT_EQ("\n---> End-Point URL: https://stg.ostrel.example/api/ <---\n\n", testing::internal::GetCapturedStdout());
}

// Null texts in the setup record and null arguments (empty texts and values out of range are in
// the client-setup session).
TEST_F(Client, NullSetupTextsAndArgumentsAreRefused) {
  VLTestDir dir;
  typedef void (*Change)(VL_WS_SetupParams&);
  for (Change change : {Change([](VL_WS_SetupParams& p) { p.APIKey = nullptr; }),
                        Change([](VL_WS_SetupParams& p) { p.DestinationUniqueID = nullptr; }),
                        Change([](VL_WS_SetupParams& p) { p.UserName = nullptr; }),
                        Change([](VL_WS_SetupParams& p) { p.Password = nullptr; }),
                        Change([](VL_WS_SetupParams& p) { p.CachePath = nullptr; })}) {
    VL_WS_SetupParams params = FileCache(dir.path());
    change(params);
    EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, Init(params));
    EXPECT_TRUE(IsEmpty(m_Handle));
  }
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_initialize(&m_Handle, nullptr));
  EXPECT_TRUE(IsEmpty(m_Handle));
  VL_WS_SetupParams params = VLTestSetupParams();
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_initialize(nullptr, &params));
  EXPECT_TRUE(m_Sim.Requests().empty());

  VL_WS_EnvID env;
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_getDeviceEnv(nullptr, &env));
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_getVersion(nullptr));
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_getAvailableEnvLists(nullptr));
  VL_WS_FileType type;
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_getFileType(&m_Handle, &type));
  EXPECT_EQ(VL_WS_TAG_FILE_TYPE, *type.tag);  // a refused call still gives a tagged record
  VL_WS_release(&type);
}

// The connection defaults, and the proxy fields, which come only with a proxy host.
TEST_F(Client, ConnectionDefaultsAndProxy) {
  VL_WS_SetupParams params = VLTestSetupParams();
  params.ProxyHost = "";
  params.ProxyPort = 3128;
  params.ProxyUserName = "pu";
  ASSERT_EQ(VL_WS_OK, Init(params));
  EXPECT_EQ(30, Settings().SendTimeout);
  EXPECT_EQ(88, Settings().RecvTimeout);
  EXPECT_EQ(0, Settings().ProxyPort);
  EXPECT_TRUE(Settings().ProxyUserName.empty());
  EXPECT_EQ(nullptr, m_Handle.client->m_Cache);

  params.ProxyHost = "proxy.example";
  ASSERT_EQ(VL_WS_OK, Init(params));
  EXPECT_EQ("proxy.example", Settings().ProxyHost);
  EXPECT_EQ(3128, Settings().ProxyPort);
  EXPECT_EQ("pu", Settings().ProxyUserName);
  EXPECT_TRUE(Settings().ProxyPassword.empty());
}

// An empty cache folder is the current one; a file there that this process cannot open (a
// socket: not even root may) is replaced as a damaged one is.
TEST_F(Client, CacheFileInTheCurrentFolderReplacesASocket) {
  VLTestDir dir;
  VLScopedCurrentDir here(dir.path());
  const std::string path = "./0_2136887699_7_3854219358_1529820989_1509162631_7_0_1.vl";
  int fd = socket(AF_UNIX, SOCK_STREAM, 0);
  struct sockaddr_un address = {};
  address.sun_family = AF_UNIX;
  strcpy(address.sun_path, path.c_str());
  ASSERT_EQ(0, bind(fd, reinterpret_cast<sockaddr*>(&address), sizeof address));
  close(fd);
  ASSERT_EQ(VL_WS_OK, Init(FileCache("")));
  EXPECT_EQ(path, Settings().CacheParam.CachePath.c_str());
  EXPECT_EQ(0u, VLReadFile(path).find("SQLite format 3"));
  VL_WS_release(&m_Handle);
}

TEST_F(Client, DuplicateHasItsOwnConnectionsAndCacheConnectionAndOutlivesItsSource) {
  VLTestDir dir;
  VL_WS_SetupParams params = FileCache(dir.path());
  params.AccessType = UNKNOWN;
  params.firmwareVersion = "fw";
  params.AuthToken = "token-9";
  m_Sim.Store().SetAccessType(DOWNLOAD);
  ASSERT_EQ(VL_WS_OK, Init(params));
  ASSERT_TRUE(m_Handle.client->m_Cache->WriteMetaData("getNavigation", "", "answer"));
  m_Sim.ClearRequests();

  VL_WS_Handle copy = {};
  ASSERT_EQ(VL_WS_OK, VL_WS_duplicate(&copy, &m_Handle));
  EXPECT_TRUE(m_Sim.Requests().empty());  // nothing is asked again
  ASSERT_NE(nullptr, copy.client);
  EXPECT_EQ(VL_WS_TAG_HANDLE, *copy.tag);
  EXPECT_NE(m_Handle.client, copy.client);
  EXPECT_NE(m_Handle.client->m_Cache, copy.client->m_Cache);
  const VL_WS_SetupParams2& p = copy.client->m_Params;
  EXPECT_EQ(Settings().ServiceBaseURL, p.ServiceBaseURL);
  EXPECT_EQ(Settings().CacheParam.CachePath, p.CacheParam.CachePath);
  EXPECT_EQ("VLSDK: fw|", p.UserAgent);
  EXPECT_EQ(DOWNLOAD, p.AccessType);
  EXPECT_EQ(static_cast<soap*>(&copy.client->m_DownloadAPI), Routing(copy));

  VL_WS_release(&m_Handle);
  VLString value;
  EXPECT_TRUE(copy.client->m_Cache->ReadMetaData("getNavigation", "", value));
  EXPECT_EQ("answer", value);
  VL_WS_FileType type;
  EXPECT_EQ(VL_WS_OK, VL_WS_getFileType(&copy, &type));
  VL_WS_release(&type);
  ASSERT_EQ(1u, Requests(1).size());
  EXPECT_EQ("token-9", Requests(1)[0].authToken);
  EXPECT_EQ("VLSDK: fw|", Requests(1)[0].userAgent);
  EXPECT_EQ(VL_WS_OK, VL_WS_release(&copy));
  EXPECT_TRUE(IsEmpty(copy));
}

// A duplicate of a memory cache handle has no cache; a live handle is never made anew, and a
// released one is empty.
TEST_F(Client, DuplicateOfAMemoryCacheHandleAndHandlesThatAreRefused) {
  VL_WS_SetupParams params = VLTestSetupParams(1);
  ASSERT_EQ(VL_WS_OK, Init(params));
  VL_WS_Handle copy = {};
  ASSERT_EQ(VL_WS_OK, VL_WS_duplicate(&copy, &m_Handle));
  EXPECT_NE(nullptr, m_Handle.client->m_Cache);
  EXPECT_EQ(nullptr, copy.client->m_Cache);

  const VL_WS_Handle before = m_Handle, copyBefore = copy;
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_initialize(&m_Handle, &params));
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_duplicate(&copy, &m_Handle));
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_duplicate(&m_Handle, &m_Handle));
  EXPECT_EQ(before.tag, m_Handle.tag);
  EXPECT_EQ(before.client, m_Handle.client);
  EXPECT_EQ(copyBefore.client, copy.client);
  VL_WS_EnvID env;
  EXPECT_EQ(VL_WS_OK, VL_WS_getDeviceEnv(&m_Handle, &env));
  EXPECT_EQ(VL_WS_OK, VL_WS_release(&copy));

  // Without a source there is nothing to copy; the caller releases the copy.
  VL_WS_Handle empty = {};
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_duplicate(&copy, &empty));
  EXPECT_EQ(VL_WS_OK, VL_WS_release(&copy));
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_duplicate(nullptr, &m_Handle));
  EXPECT_EQ(VL_WS_OK, VL_WS_release(&m_Handle));
  EXPECT_TRUE(IsEmpty(m_Handle));
  EXPECT_EQ(VL_WS_OK, VL_WS_release(&m_Handle));
}

// Every call has its own connection; all but the first to a host resume the TLS session of the
// one before, across handles. A server that presents a wrong certificate is refused all the same.
TEST_F(Client, TlsSessionsAreResumedAndTheCertificateIsStillChecked) {
  ASSERT_EQ(VL_WS_OK, Init(VLTestSetupParams()));
  VL_WS_Handle duplicate = {};
  ASSERT_EQ(VL_WS_OK, VL_WS_duplicate(&duplicate, &m_Handle));
  auto label = [](VL_WS_Handle* handle) {
    VL_WS_GenreLabelResponse response;
    VL_WS_Status status = VL_WS_getGenreLabel(handle, 12, &response);
    VL_WS_release(&response);
    return status;
  };
  ASSERT_EQ(VL_WS_OK, label(&m_Handle));
  ASSERT_EQ(VL_WS_OK, label(&duplicate));
  std::vector<VLSimRequest> log = Requests(2);
  ASSERT_EQ(2u, log.size());
  EXPECT_TRUE(log[1].resumed);

  Fault("store.ostrel.example=tls:wronghost,times=1");
  EXPECT_EQ(VL_WS_E_TLS, label(&m_Handle));
  ASSERT_EQ(VL_WS_OK, label(&m_Handle));
  ASSERT_EQ(VL_WS_OK, label(&duplicate));
  log = Requests(5);
  ASSERT_EQ(5u, log.size());
  EXPECT_EQ("tls:wronghost", log[2].faults);
  EXPECT_EQ("TLS handshake failed", log[2].note);
  EXPECT_FALSE(log[3].resumed) << "a failed handshake forgets the session";
  EXPECT_TRUE(log[4].resumed);
  VL_WS_release(&duplicate);
}

}  // namespace
