// Client handles against the store simulator: validation, environments and endpoints, the
// device-environment service, access type, User-Agent, the cache file and its refresh, and
// duplicates.
#include <gtest/gtest.h>
#include <string.h>
#include <sys/socket.h>
#include <sys/stat.h>
#include <sys/un.h>
#include <unistd.h>

#include <string>
#include <vector>

#include "CacheInterface.h"
#include "VLFile.h"
#include "VLTestDir.h"
#include "VLTestSimulator.h"
#include "VLUtilities.h"
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

// A fixed environment takes its endpoint without asking; the default one (and any number from 3)
// is the digit the device-environment service answers.
TEST_F(Client, EnvironmentsChooseTheEndpoint) {
  struct {
    enum VL_WS_SetupParams::ContentType content;
    int env;    // given
    int digit;  // what the store answers, -1 for a fixed environment
    const char* host;
    const char* path;
  } cases[] = {
      {VL_WS_SetupParams::GENERAL, VL_WS_ENV_STGAPI, -1, "stgapi.ostrel.example", "/api/"},
      {VL_WS_SetupParams::GENERAL, VL_WS_ENV_STG, -1, "stg.ostrel.example", "/api/"},
      {VL_WS_SetupParams::GENERAL, VL_WS_ENV_PRODUCTION, -1, "store.ostrel.example", "/api/"},
      {VL_WS_SetupParams::ADULT, VL_WS_ENV_STGAPI, -1, "stgapi.ostrel.example", "/aac/api/"},
      {VL_WS_SetupParams::ADULT, VL_WS_ENV_STG, -1, "stg.adult.ostrel.example", "/api/"},
      {VL_WS_SetupParams::ADULT, VL_WS_ENV_PRODUCTION, -1, "adult.ostrel.example", "/api/"},
      {VL_WS_SetupParams::GENERAL, VL_WS_ENV_DEFAULT, 0, "stgapi.ostrel.example", "/api/"},
      {VL_WS_SetupParams::GENERAL, VL_WS_ENV_DEFAULT, 1, "stg.ostrel.example", "/api/"},
      {VL_WS_SetupParams::GENERAL, 9, 7, "store.ostrel.example", "/api/"},
      {VL_WS_SetupParams::ADULT, VL_WS_ENV_DEFAULT, 0, "stgapi.ostrel.example", "/aac/api/"},
      {VL_WS_SetupParams::ADULT, VL_WS_ENV_DEFAULT, 1, "stg.adult.ostrel.example", "/api/"},
      {VL_WS_SetupParams::ADULT, VL_WS_ENV_DEFAULT, 2, "adult.ostrel.example", "/api/"},
  };
  for (const auto& c : cases) {
    SCOPED_TRACE(std::string(c.host) + c.path + " " + std::to_string(c.digit));
    m_Sim.ClearRequests();
    if (c.digit >= 0) m_Sim.Store().SetDeviceEnv(kDevice, c.digit);
    VL_WS_SetupParams params = VLTestSetupParams();
    params.ContentType = c.content;
    params.EnvNum = static_cast<VL_WS_EnvNum>(c.env);
    params.AccessType = UNKNOWN;  // the file type question shows where requests go
    testing::internal::CaptureStdout();
    ASSERT_EQ(VL_WS_OK, Init(params));
    std::string printed = testing::internal::GetCapturedStdout();
    std::string base = std::string("https://") + c.host + c.path;
    EXPECT_EQ(base, Settings().ServiceBaseURL.c_str());
    VL_WS_EnvID env = -1;
    EXPECT_EQ(VL_WS_OK, VL_WS_getDeviceEnv(&m_Handle, &env));
    std::vector<VLSimRequest> requests = Requests(c.digit >= 0 ? 2 : 1);
    ASSERT_EQ(c.digit >= 0 ? 2u : 1u, requests.size());
    if (c.digit >= 0) {
      EXPECT_EQ("\n---> End-Point URL: " + base + " <---\n\n", printed.substr(0, printed.find("\n=======>")));
      EXPECT_EQ(c.digit, env);
      EXPECT_TRUE(requests[0].tls);
      EXPECT_EQ("store.ostrel.example", requests[0].host);
      EXPECT_EQ("/device/env/", requests[0].path.substr(0, 12));
      EXPECT_EQ("d=00-11-22-33-44-55&dt=7", requests[0].query);
      EXPECT_EQ("DUDUVud", requests[0].userAgent);
    } else {
      EXPECT_EQ("\n=======>Content type:" + std::to_string(c.content) + ", envID:" + std::to_string(c.env) +
                    ", endpoint URL:" + base + "\n",
                printed);
      EXPECT_EQ(c.env, env);
    }
    EXPECT_EQ("getFileType", requests.back().operation);
    EXPECT_EQ(c.host, requests.back().host);
    EXPECT_EQ(std::string(c.path) + "RealTimeBrowse.asmx", requests.back().path);
  }
}

TEST_F(Client, UnreadableEnvironmentAnswersSelectProductionAndNoAnswerFailsInitialisation) {
  m_Sim.Store().SetDeviceEnv(kDevice, 1);
  VL_WS_SetupParams params = VLTestSetupParams();
  params.EnvNum = VL_WS_ENV_DEFAULT;
  // No "Content-Length: 1" (the endpoint tests have the other answers that are not taken).
  Fault("/device/env/=badlength:1,times=1");
  ASSERT_EQ(VL_WS_OK, Init(params));
  EXPECT_EQ(2, Settings().EnvID);
  EXPECT_EQ("https://store.ostrel.example/api/", Settings().ServiceBaseURL);
  ASSERT_EQ(VL_WS_OK, Init(params));
  EXPECT_EQ(1, Settings().EnvID);

  // A service that cannot be reached.
  Fault("store.ostrel.example=tls:selfsigned,times=1");
  EXPECT_EQ(VL_WS_E_CONNECT, Init(params));
  EXPECT_TRUE(IsEmpty(m_Handle));
}

TEST_F(Client, DefaultEnvIdAsksWithoutChangingTheHandle) {
  m_Sim.Store().SetDeviceEnv(kDevice, 1);
  ASSERT_EQ(VL_WS_OK, Init(VLTestSetupParams()));
  VL_WS_EnvID env = -1;
  EXPECT_EQ(VL_WS_OK, VL_WS_getDefaultEnvID(&m_Handle, &env));
  EXPECT_EQ(1, env);
  EXPECT_EQ(2, Settings().EnvID);
  EXPECT_EQ("https://store.ostrel.example/api/", Settings().ServiceBaseURL);

  Fault("store.ostrel.example=tls:selfsigned,times=1");
  env = -1;
  EXPECT_EQ(VL_WS_E_NETWORK, VL_WS_getDefaultEnvID(&m_Handle, &env));
  EXPECT_EQ(-1, env);

  VL_WS_Handle empty = {};
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_getDefaultEnvID(&empty, &env));
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_getDeviceEnv(&empty, &env));
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_getDeviceEnv(nullptr, &env));
}

TEST_F(Client, InvalidSetupIsRefusedBeforeAnythingElse) {
  static const std::string longId(351, 'x');
  typedef void (*Change)(VL_WS_SetupParams&);
  const std::pair<const char*, Change> cases[] = {
      {"no key", [](VL_WS_SetupParams& p) { p.APIKey = nullptr; }},
      {"empty key", [](VL_WS_SetupParams& p) { p.APIKey = ""; }},
      {"no device", [](VL_WS_SetupParams& p) { p.DestinationUniqueID = nullptr; }},
      {"empty device", [](VL_WS_SetupParams& p) { p.DestinationUniqueID = ""; }},
      {"device of 351 bytes", [](VL_WS_SetupParams& p) { p.DestinationUniqueID = longId.c_str(); }},
      {"no user", [](VL_WS_SetupParams& p) { p.UserName = nullptr; }},
      {"empty user", [](VL_WS_SetupParams& p) { p.UserName = ""; }},
      {"no password", [](VL_WS_SetupParams& p) { p.Password = nullptr; }},
      {"empty password", [](VL_WS_SetupParams& p) { p.Password = ""; }},
      {"file cache without path", [](VL_WS_SetupParams& p) { p.CachePath = nullptr; }},
      {"limit below 350 KiB", [](VL_WS_SetupParams& p) { p.CacheLimit = 358399; }},
      {"content type 2",
       [](VL_WS_SetupParams& p) { p.ContentType = static_cast<enum VL_WS_SetupParams::ContentType>(2); }},
      {"cache type 3", [](VL_WS_SetupParams& p) { p.CacheType = 3; }},
      {"environment -1", [](VL_WS_SetupParams& p) { p.EnvNum = static_cast<VL_WS_EnvNum>(-1); }},
  };
  // Validation comes before the cache folder (one that cannot be made) and the environment
  // service (which would be asked).
  VLTestDir dir;
  ASSERT_TRUE(VLWriteFile(dir / "file", "x"));
  std::string underFile = dir / "file/cache";
  for (const auto& c : cases) {
    SCOPED_TRACE(c.first);
    VL_WS_SetupParams params = FileCache(underFile);
    params.EnvNum = VL_WS_ENV_DEFAULT;
    c.second(params);
    EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, Init(params));
    EXPECT_TRUE(IsEmpty(m_Handle));
  }
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_initialize(&m_Handle, nullptr));
  EXPECT_TRUE(IsEmpty(m_Handle));
  VL_WS_SetupParams params = VLTestSetupParams();
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_initialize(nullptr, &params));
  EXPECT_TRUE(m_Sim.Requests().empty());

  // The edges that are taken: the limit is checked only with a cache; the longest device name.
  params.CacheLimit = 1;
  EXPECT_EQ(VL_WS_OK, Init(params));
  params.CacheType = 1;
  params.CacheData = static_cast<VL_WS_CacheParam::CacheData>(7);
  for (int limit : {358400, 0}) {
    params.CacheLimit = limit;
    EXPECT_EQ(VL_WS_OK, Init(params));
  }
  std::string longestId(350, 'x');
  params.DestinationUniqueID = longestId.c_str();
  EXPECT_EQ(VL_WS_OK, Init(params));
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_getVersion(nullptr));
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_getAvailableEnvLists(nullptr));
}

TEST_F(Client, CacheFolderComesBeforeTheEnvironmentServiceAndTheCache) {
  VLTestDir dir;
  ASSERT_TRUE(VLWriteFile(dir / "file", "x"));
  std::string underFile = dir / "file/cache";
  VL_WS_SetupParams params = FileCache(underFile);
  params.EnvNum = VL_WS_ENV_DEFAULT;
  Fault("store.ostrel.example=tls:selfsigned,times=1");
  EXPECT_EQ(VL_WS_E_CACHE_FOLDER, Init(params));
  EXPECT_TRUE(IsEmpty(m_Handle));
  EXPECT_TRUE(m_Sim.Requests().empty());

  // A missing folder is made, with its parents.
  std::string nested = dir / "a/b/c";
  params.CachePath = nested.c_str();
  EXPECT_EQ(VL_WS_E_CONNECT, Init(params));  // the fault is still there
  EXPECT_TRUE(VLFile::FolderExist(nested.c_str()));
  EXPECT_EQ(VL_WS_OK, Init(params));
}

TEST_F(Client, SettingsAreTheHandlesOwnCopy) {
  std::string key = VLTestSetupParams().APIKey, token = "token-1", proxyUser = "pu";
  VL_WS_SetupParams params = VLTestSetupParams();
  params.APIKey = key.c_str();
  params.AuthToken = token.c_str();
  params.ProxyHost = "";  // an empty proxy host takes none of the proxy fields
  params.ProxyPort = 3128;
  params.ProxyUserName = proxyUser.c_str();
  ASSERT_EQ(VL_WS_OK, Init(params));
  key.assign(key.size(), '#');
  token.assign(token.size(), '#');
  EXPECT_EQ(VLTestSetupParams().APIKey, Settings().APIKey);
  EXPECT_EQ("token-1", Settings().AuthToken);
  EXPECT_EQ(30, Settings().SendTimeout);
  EXPECT_EQ(88, Settings().RecvTimeout);
  EXPECT_EQ(STREAM, Settings().AccessType);
  EXPECT_TRUE(Settings().ProxyHost.empty());
  EXPECT_EQ(0, Settings().ProxyPort);
  EXPECT_TRUE(Settings().ProxyUserName.empty());
  EXPECT_TRUE(Settings().CacheParam.CachePath.empty());
  EXPECT_EQ(nullptr, m_Handle.client->m_Cache);

  params.ProxyHost = "proxy.example";
  ASSERT_EQ(VL_WS_OK, Init(params));
  EXPECT_EQ("proxy.example", Settings().ProxyHost);
  EXPECT_EQ(3128, Settings().ProxyPort);
  EXPECT_EQ("pu", Settings().ProxyUserName);
  EXPECT_TRUE(Settings().ProxyPassword.empty());
}

TEST_F(Client, UserAgentTellsFirmwareRevisionAndModel) {
  struct {
    const char* firmware;
    const char* revision;
    const char* model;
    const char* userAgent;  // the handle's text; the store's HTTP parser drops a leading blank
  } cases[] = {
      {"fw1", "r2", "M3", "VLSDK: fw1|r2 VLMODEL:M3"},
      {"fw1", nullptr, nullptr, "VLSDK: fw1|"},
      {"", "r2", "", "VLSDK: |r2"},
      {nullptr, nullptr, "M3", " VLMODEL:M3"},
      {nullptr, "", nullptr, ""},
  };
  for (const auto& c : cases) {
    SCOPED_TRACE(c.userAgent);
    m_Sim.ClearRequests();
    VL_WS_SetupParams params = VLTestSetupParams();
    params.firmwareVersion = c.firmware;
    params.ApplicationRevision = c.revision;
    params.modelNumber = c.model;
    params.AccessType = UNKNOWN;
    testing::internal::CaptureStdout();
    ASSERT_EQ(VL_WS_OK, Init(params));
    std::string printed = testing::internal::GetCapturedStdout();
    EXPECT_EQ(c.userAgent, Settings().UserAgent);
    std::string expected = "\n=======>Content type:0, envID:2, endpoint URL:https://store.ostrel.example/api/\n";
    if (*c.userAgent) expected += std::string("\n***---> User-Agent = ") + c.userAgent;
    EXPECT_EQ(expected, printed);
    ASSERT_EQ(1u, Requests(1).size());
    std::string sent = *c.userAgent ? std::string(c.userAgent + (*c.userAgent == ' ')) : "gSOAP/2.7";
    EXPECT_EQ(sent, Requests(1)[0].userAgent);
  }
}

TEST_F(Client, UnknownAccessTypeIsAskedOfTheStore) {
  VL_WS_SetupParams params = VLTestSetupParams();
  params.AccessType = UNKNOWN;
  m_Sim.Store().SetAccessType(DOWNLOAD);
  ASSERT_EQ(VL_WS_OK, Init(params));
  EXPECT_EQ(DOWNLOAD, Settings().AccessType);
  EXPECT_EQ(static_cast<soap*>(&m_Handle.client->m_DownloadAPI), Routing(m_Handle));
  ASSERT_EQ(1u, Requests(1).size());
  EXPECT_EQ("RealTimeBrowse", Requests(1)[0].service);
  EXPECT_EQ("VL1:DeviceSettings", Requests(1)[0].settingsElement);

  // Any value but DOWNLOAD and STREAM asks.
  m_Sim.Store().SetAccessType(STREAM);
  params.AccessType = static_cast<VL_WS_AccessType>(7);
  ASSERT_EQ(VL_WS_OK, Init(params));
  EXPECT_EQ(STREAM, Settings().AccessType);

  // A failed question leaves UNKNOWN, which routes account operations to the streaming service.
  m_Sim.Store().SetAccessType(DOWNLOAD);
  Fault("getFileType=close,times=1");
  params.AccessType = UNKNOWN;
  ASSERT_EQ(VL_WS_OK, Init(params));
  EXPECT_EQ(UNKNOWN, Settings().AccessType);
  EXPECT_EQ(static_cast<soap*>(&m_Handle.client->m_StreamAPI), Routing(m_Handle));

  // A given access type is kept without asking.
  m_Sim.ClearRequests();
  params.AccessType = DOWNLOAD;
  m_Sim.Store().SetAccessType(STREAM);
  ASSERT_EQ(VL_WS_OK, Init(params));
  EXPECT_EQ(DOWNLOAD, Settings().AccessType);
  EXPECT_TRUE(m_Sim.Requests().empty());
}

TEST_F(Client, FileTypeRewritesTheAccessTypeButNotTheRouting) {
  ASSERT_EQ(VL_WS_OK, Init(VLTestSetupParams()));
  m_Sim.Store().SetAccessType(DOWNLOAD);
  VL_WS_FileType type;
  ASSERT_EQ(VL_WS_OK, VL_WS_getFileType(&m_Handle, &type));
  ASSERT_NE(nullptr, type.tag);
  EXPECT_EQ(VL_WS_TAG_FILE_TYPE, *type.tag);
  EXPECT_EQ(DOWNLOAD, type.File_AccessType);
  EXPECT_EQ(DOWNLOAD, Settings().AccessType);
  EXPECT_EQ(static_cast<soap*>(&m_Handle.client->m_StreamAPI), Routing(m_Handle));
  EXPECT_EQ(VL_WS_OK, VL_WS_release(&type));

  // A failure leaves the access type and gives a tagged, empty record.
  Fault("getFileType=soapfault:server,times=1");
  EXPECT_EQ(VL_WS_E_SOAP_FAULT(2), VL_WS_getFileType(&m_Handle, &type));
  EXPECT_EQ(VL_WS_TAG_FILE_TYPE, *type.tag);
  EXPECT_EQ(0, type.File_AccessType);
  EXPECT_EQ(DOWNLOAD, Settings().AccessType);
  VL_WS_release(&type);

  VL_WS_Handle empty = {};
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_getFileType(&empty, &type));
  EXPECT_EQ(VL_WS_TAG_FILE_TYPE, *type.tag);
  VL_WS_release(&type);
}

TEST_F(Client, CacheFileNameTellsDevicesKeysAccountsAndSettingsApart) {
  VLTestDir dir;
  VL_WS_SetupParams params = FileCache(dir.path());
  params.CacheLimit = 400000;
  ASSERT_EQ(VL_WS_OK, Init(params));
  auto hash = [](const char* s) { return std::to_string(VLUtilities::Hash(0, s, static_cast<unsigned>(strlen(s)))); };
  std::string name = "0_" + hash(params.DestinationUniqueID) + "_7_" + hash(params.APIKey) + "_" +
                     hash(params.UserName) + "_" + hash(params.Password) + "_7_400000_1.vl";
  EXPECT_EQ(dir / name, Settings().CacheParam.CachePath.c_str());
  EXPECT_TRUE(VLFile::Exist((dir / name).c_str()));
  std::string first = Settings().CacheParam.CachePath.c_str();

  // Only the password differs: another file in the same folder.
  params.Password = "other-password";
  ASSERT_EQ(VL_WS_OK, Init(params));
  std::string second = Settings().CacheParam.CachePath.c_str();
  EXPECT_NE(first, second);
  EXPECT_EQ(dir.path(), VLFile::GetFolderName(second.c_str()).c_str());
  EXPECT_TRUE(VLFile::Exist(first.c_str()));
  EXPECT_TRUE(VLFile::Exist(second.c_str()));

  // A folder without its separator gets one; the empty folder is the current one.
  std::string bare = dir.path().substr(0, dir.path().size() - 1);
  params.CachePath = bare.c_str();
  ASSERT_EQ(VL_WS_OK, Init(params));
  EXPECT_EQ(second, Settings().CacheParam.CachePath.c_str());
  {
    VLScopedCurrentDir here(dir.path());
    params.CachePath = "";
    ASSERT_EQ(VL_WS_OK, Init(params));
    EXPECT_EQ("./" + VLFile::GetFileName(second.c_str()), Settings().CacheParam.CachePath.c_str());
    VL_WS_release(&m_Handle);
  }
}

TEST_F(Client, DamagedOrUnopenableCacheFileIsReplacedAndAFolderFails) {
  VLTestDir dir;
  VL_WS_SetupParams params = FileCache(dir.path());
  ASSERT_EQ(VL_WS_OK, Init(params));
  std::string path = Settings().CacheParam.CachePath.c_str();
  VL_WS_release(&m_Handle);

  ASSERT_TRUE(VLWriteFile(path, std::string(4096, 'x')));
  ASSERT_EQ(VL_WS_OK, Init(params));
  EXPECT_EQ(0u, VLReadFile(path).find("SQLite format 3"));
  EXPECT_TRUE(m_Handle.client->m_Cache->WriteMetaData("n", "k", "v"));
  VL_WS_release(&m_Handle);

  // A file this process cannot open (a socket: not even root may) is deleted too.
  ASSERT_TRUE(VLFile::Remove(path.c_str()));
  int fd = socket(AF_UNIX, SOCK_STREAM, 0);
  struct sockaddr_un address = {};
  address.sun_family = AF_UNIX;
  ASSERT_LT(path.size(), sizeof address.sun_path);
  strcpy(address.sun_path, path.c_str());
  ASSERT_EQ(0, bind(fd, reinterpret_cast<sockaddr*>(&address), sizeof address));
  close(fd);
  ASSERT_EQ(VL_WS_OK, Init(params));
  EXPECT_EQ(0u, VLReadFile(path).find("SQLite format 3"));
  VL_WS_release(&m_Handle);

  // A folder in the file's place cannot be opened nor deleted.
  ASSERT_TRUE(VLFile::Remove(path.c_str()));
  ASSERT_EQ(0, mkdir(path.c_str(), 0755));
  ASSERT_TRUE(VLWriteFile(path + "/keep", "x"));
  EXPECT_EQ(VL_WS_E_CACHE_OPEN, Init(params));
  EXPECT_TRUE(IsEmpty(m_Handle));
}

TEST_F(Client, InitialisationRefreshesMetadataAndPurgesUserData) {
  VLTestDir dir;
  VL_WS_SetupParams params = FileCache(dir.path());
  const std::string loaded = m_Sim.Store().LastCacheLoadTime();
  ASSERT_EQ(VL_WS_OK, Init(params));
  ASSERT_EQ(1u, Requests(1).size());
  EXPECT_EQ("getLastCacheLoadTimeUTC", Requests(1)[0].operation);
  CacheInterface* cache = m_Handle.client->m_Cache;
  ASSERT_TRUE(cache->WriteMetaData("getNavigation", "", "answer"));
  ASSERT_TRUE(cache->WriteWishlistFlag(1001, true));

  // The same catalogue: the answers stay, the user data go.
  ASSERT_EQ(VL_WS_OK, Init(params));
  cache = m_Handle.client->m_Cache;
  VLString value;
  bool flag = false;
  EXPECT_TRUE(cache->ReadMetaData("getNavigation", "", value));
  EXPECT_FALSE(cache->ReadWishlistFlag(1001, flag));

  // A newly loaded catalogue: the answers go too.
  m_Sim.Store().SetLastCacheLoadTime("2012-02-02T02:02:02");
  ASSERT_EQ(VL_WS_OK, Init(params));
  m_Sim.Store().SetLastCacheLoadTime(loaded);
  EXPECT_FALSE(m_Handle.client->m_Cache->ReadMetaData("getNavigation", "", value));
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
