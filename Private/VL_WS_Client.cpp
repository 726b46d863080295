// Client handles: VL_WS_initialize, VL_WS_duplicate and the release of a handle's client state;
// the environment queries and VL_WS_getVersion.
#include "VL_WS_Client.h"

#include <stdio.h>
#include <string.h>

#include "AutoSSL.h"
#include "CacheMgr.h"
#include "Setup_SSL_Client_CACerts.h"
#include "VLFile.h"
#include "VLRecord.h"
#include "VLUtilities.h"
#include "VL_WS.h"

namespace {

const size_t kMaxDestinationUniqueIDLength = 350;
const unsigned int kMinCacheLimit = 358400;  // 350 KiB

const VL_WS_EnvListEntry kEnvironments[] = {
    {VL_WS_ENV_STGAPI, "stgapi"}, {VL_WS_ENV_STG, "stg"}, {VL_WS_ENV_PRODUCTION, "production"}, {VL_WS_ENV_DEFAULT, "default"}};

bool Given(const char* text) { return text != 0 && *text != 0; }

// The setup record's rules. Besides the required fields, values that mean nothing (a content
// type, cache type or negative environment number outside the enumerations) are refused too.
bool ValidSetup(const VL_WS_SetupParams& in) {
  if (!Given(in.APIKey) || !Given(in.DestinationUniqueID) || !Given(in.UserName) || !Given(in.Password)) return false;
  if (in.CacheType == kFileCache && in.CachePath == 0) return false;
  if (strlen(in.DestinationUniqueID) > kMaxDestinationUniqueIDLength) return false;
  if (in.CacheType != kNoCache && in.CacheLimit != 0 && in.CacheLimit < kMinCacheLimit) return false;
  if (in.ContentType != VL_WS_SetupParams::GENERAL && in.ContentType != VL_WS_SetupParams::ADULT) return false;
  if (in.CacheType < kNoCache || in.CacheType > kFileCache) return false;
  return in.EnvNum >= 0;
}

// Gives the handle its tag cell and a new client state, three service objects included. Null for
// a handle that is not empty: making it anew would lose (and leak) what it holds.
VL_WS_Client* NewClient(VL_WS_Handle* handle) {
  if (handle->tag != 0 || handle->client != 0) return 0;
  VLRecordInit(*handle);
  handle->client = new VL_WS_Client;
  return handle->client;
}

// Releases a handle whose initialisation failed and passes the status on.
VL_WS_Status Fail(VL_WS_Handle* handle, VL_WS_Status status) {
  VL_WS_release(handle);
  return status;
}

unsigned int HashOf(const VLString& text) {
  return VLUtilities::Hash(0, text.c_str(), static_cast<unsigned int>(text.length()));
}

// The cache database file in folder: its name tells devices, keys, accounts and cache settings
// apart, so that they never share a cache. Never change it: a new name loses every cache.
VLString CacheFilePath(const VL_WS_SetupParams2& p, const char* folder) {
  VLString path(*folder ? folder : ".");
  if (path[path.length() - 1] != VLFile::PATH_SEPERATOR) path += VLFile::PATH_SEPERATOR;
  char name[100];
  // The first field hashed the endpoint before one was chosen: it is always 0.
  VLUtilities::safe_snprintf(name, sizeof(name), "%u_%u_%d_%u_%u_%u_%u_%u_%u", 0u, HashOf(p.DestinationUniqueID),
                             p.DestinationTypeID, HashOf(p.APIKey), HashOf(p.UserName), HashOf(p.Password),
                             static_cast<unsigned int>(p.CacheParam.CacheData),
                             static_cast<unsigned int>(p.CacheParam.CacheLimit), 1u);
  path += name;
  path += ".vl";
  return path;
}

// OpenSSL's process-wide set-up, made by the first initialisation and kept to the process's end.
void InitAutoSSL() { static AutoSSL s_AutoSSL; }

bool SetupTLS(VL_WS_Client* client) {
  return Setup_SSL_Client_CACerts(&client->m_RealTimeBrowse) == SOAP_OK &&
         Setup_SSL_Client_CACerts(&client->m_StreamAPI) == SOAP_OK &&
         Setup_SSL_Client_CACerts(&client->m_DownloadAPI) == SOAP_OK;
}

// "VLSDK: <firmware>|<revision>" when either is given, then " VLMODEL:<model>" when given.
void BuildUserAgent(VL_WS_SetupParams2& p) {
  if (!p.ApplicationRevision.empty() || !p.firmwareVersion.empty())
    p.UserAgent = "VLSDK: " + p.firmwareVersion + "|" + p.ApplicationRevision;
  if (!p.modelNumber.empty()) p.UserAgent += " VLMODEL:" + p.modelNumber;
  if (!p.UserAgent.empty()) printf("\n***---> User-Agent = %s", p.UserAgent.c_str());
}

// Binds the three service objects to the client's settings and the dispatcher to them.
void BindServices(VL_WS_Client* client) {
  client->m_RealTimeBrowse.SetParams(&client->m_Params);
  client->m_StreamAPI.SetParams(&client->m_Params);
  client->m_DownloadAPI.SetParams(&client->m_Params);
}

void InitDispatcher(VL_WS_Client* client) {
  client->m_StreamDownloadAPI.Init(&client->m_StreamAPI, &client->m_DownloadAPI, client->m_Params.AccessType);
}

// DOWNLOAD and STREAM are taken as given; anything else is asked of the store, and a failed
// question gives UNKNOWN (which routes account operations to the streaming service).
VL_WS_AccessType ResolveAccessType(VL_WS_Handle* handle, VL_WS_AccessType given) {
  if (given == DOWNLOAD || given == STREAM) return given;
  VL_WS_FileType fileType;
  VL_WS_AccessType type = UNKNOWN;
  if (VL_WS_getFileType(handle, &fileType) == VL_WS_OK) type = static_cast<VL_WS_AccessType>(fileType.File_AccessType);
  VL_WS_release(&fileType);
  return type;
}

// A new open cache, or null. With deleteDamaged, a cache file that cannot be opened (a damaged
// database, not one at all, or a file this process may not open) is deleted and the open tried
// once more.
CacheInterface* OpenCache(const VL_WS_CacheParam2& params, bool deleteDamaged) {
  CacheInterface* cache = new CacheMgr;
  if (cache->Open(params) == 0) return cache;
  if (deleteDamaged && params.CacheType == kFileCache && CacheMgr::RemoveDatabaseFile(params.CachePath) &&
      cache->Open(params) == 0) {
    return cache;
  }
  delete cache;
  return 0;
}

}  // namespace

VL_WS_Client* VLClientOf(const VL_WS_Handle* handle) { return handle != 0 ? handle->client : 0; }

void VLClientRelease(VL_WS_Client* client) {
  if (client->m_Cache) {
    client->m_Cache->Close();
    delete client->m_Cache;
    client->m_Cache = nullptr;
  }
  delete client;
}

extern "C" VL_WS_Status VL_WS_initialize(VL_WS_Handle* handle, const VL_WS_SetupParams* params) {
  if (handle == 0) return VL_WS_E_INVALID_ARGUMENT;
  VL_WS_Client* client = NewClient(handle);
  if (client == 0) return VL_WS_E_INVALID_ARGUMENT;  // the live handle stays as it is
  if (params == 0 || !ValidSetup(*params)) return Fail(handle, VL_WS_E_INVALID_ARGUMENT);
  const VL_WS_SetupParams& in = *params;
  if (in.CacheType == kFileCache && *in.CachePath && !VLFile::CreateFolder(in.CachePath))
    return Fail(handle, VL_WS_E_CACHE_FOLDER);

  VL_WS_SetupParams2& p = client->m_Params;
  p.APIKey = in.APIKey;
  if (in.AuthToken) p.AuthToken = in.AuthToken;
  p.DestinationUniqueID = in.DestinationUniqueID;
  p.DestinationTypeID = in.DestinationTypeID;
  p.UserName = in.UserName;
  p.Password = in.Password;
  if (in.ProxyHost) {
    p.ProxyHost = in.ProxyHost;
    if (*in.ProxyHost) {
      p.ProxyPort = in.ProxyPort;
      if (in.ProxyUserName) p.ProxyUserName = in.ProxyUserName;
      if (in.ProxyPassword) p.ProxyPassword = in.ProxyPassword;
    }
  }
  p.CacheParam.CacheType = in.CacheType;
  p.CacheParam.CacheData = in.CacheData;
  p.CacheParam.CacheLimit = static_cast<int>(in.CacheLimit);
  if (in.CacheType == kFileCache) p.CacheParam.CachePath = CacheFilePath(p, in.CachePath);

  InitAutoSSL();
  if (!SetupTLS(client)) return VL_WS_E_TLS_SETUP;  // the caller releases the handle

  const char* base = VLUtilities::QueryServiceBaseURL(in.ContentType, &client->m_StreamAPI, in.DestinationUniqueID,
                                                      in.DestinationTypeID, in.EnvNum, p.EnvID);
  if (!*base) return Fail(handle, VL_WS_E_CONNECT);
  p.ServiceBaseURL = base;

  if (in.ApplicationRevision) p.ApplicationRevision = in.ApplicationRevision;
  if (in.firmwareVersion) p.firmwareVersion = in.firmwareVersion;
  if (in.modelNumber) p.modelNumber = in.modelNumber;
  BuildUserAgent(p);
  BindServices(client);

  p.AccessType = ResolveAccessType(handle, in.AccessType);
  InitDispatcher(client);

  if (in.CacheType == kNoCache) return VL_WS_OK;
  client->m_Cache = OpenCache(p.CacheParam, true);
  if (client->m_Cache == 0) return Fail(handle, VL_WS_E_CACHE_OPEN);
  client->m_Memo = std::make_shared<VLAnswerMemo>();
  VL_WS_updateLocalCache(handle, VL_WS_CacheParam::CACHE_METADATA | VL_WS_CacheParam::CACHE_USERDATA);
  return VL_WS_OK;
}

extern "C" VL_WS_Status VL_WS_duplicate(VL_WS_Handle* copy, const VL_WS_Handle* source) {
  if (copy == 0 || copy == source) return VL_WS_E_INVALID_ARGUMENT;
  VL_WS_Client* client = NewClient(copy);
  if (client == 0) return VL_WS_E_INVALID_ARGUMENT;  // the live copy stays as it is
  const VL_WS_Client* from = VLClientOf(source);
  if (from == 0) return VL_WS_E_INVALID_ARGUMENT;
  if (!SetupTLS(client)) return VL_WS_E_TLS_SETUP;
  client->m_Params = from->m_Params;
  BindServices(client);
  InitDispatcher(client);
  // A memory cache belongs to its one handle; a file cache is shared through its file.
  if (client->m_Params.CacheParam.CacheType == kFileCache) {
    client->m_Cache = OpenCache(client->m_Params.CacheParam, false);
    if (client->m_Cache == 0) return VL_WS_E_CACHE_OPEN;
    client->m_Memo = from->m_Memo;
  }
  return VL_WS_OK;
}

extern "C" VL_WS_Status VL_WS_getVersion(VL_WS_Version* version) {
  if (version == 0) return VL_WS_E_INVALID_ARGUMENT;
  VLRecordInit(*version);
  version->Major = 1;
  version->Minor = 3;
  version->Revision = 1;
  return VL_WS_OK;
}

extern "C" VL_WS_Status VL_WS_getAvailableEnvLists(VL_WS_EnvList* list) {
  if (list == 0) return VL_WS_E_INVALID_ARGUMENT;
  list->Count = sizeof(kEnvironments) / sizeof(kEnvironments[0]);
  list->Entries = kEnvironments;
  return VL_WS_OK;
}

extern "C" VL_WS_Status VL_WS_getDefaultEnvID(VL_WS_Handle* handle, VL_WS_EnvID* envID) {
  VL_WS_Client* client = VLClientOf(handle);
  if (client == 0 || envID == 0) return VL_WS_E_INVALID_ARGUMENT;
  const char* base = VLUtilities::QueryServiceBaseURL(VL_WS_SetupParams::GENERAL, &client->m_StreamAPI,
                                                      client->m_Params.DestinationUniqueID.c_str(),
                                                      client->m_Params.DestinationTypeID, VL_WS_ENV_DEFAULT, *envID);
  return *base ? VL_WS_OK : VL_WS_E_NETWORK;
}

extern "C" VL_WS_Status VL_WS_getDeviceEnv(VL_WS_Handle* handle, VL_WS_EnvID* envID) {
  VL_WS_Client* client = VLClientOf(handle);
  if (client == 0 || envID == 0) return VL_WS_E_INVALID_ARGUMENT;
  *envID = client->m_Params.EnvID;
  return VL_WS_OK;
}
