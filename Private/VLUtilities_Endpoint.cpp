// Endpoint query: which base URL a client handle sends its SOAP requests to, from the content
// type and the environment, asking the store's device-environment service for the "default"
// environment.
#include <stdio.h>

#include "VLHttpGet.h"
#include "VLStoreHosts.h"
#include "VLUtilities.h"

namespace {

const int kProductionEnv = 2;

// Any answer but a digit chooses production; only a connection that cannot be made fails.
const VLHttpGet::Kind kEnvironmentQuery = {false, VL_WS_E_UNEXPECTED, VL_WS_E_NETWORK, VL_WS_E_NETWORK};

// The endpoint table: environment 0 is the staging API host, 1 the staging host and anything
// else production. Adult content lives under "/aac/api/" on the staging API host.
const char* BaseURL(int contentType, int env) {
  if (contentType == VL_WS_SetupParams::ADULT) {
    if (env == 0) return "https://" VL_STORE_STAGING_API_HOST "/aac/api/";
    if (env == 1) return "https://" VL_STORE_ADULT_STAGING_HOST "/api/";
    return "https://" VL_STORE_ADULT_PRODUCTION_HOST "/api/";
  }
  if (env == 0) return "https://" VL_STORE_STAGING_API_HOST "/api/";
  if (env == 1) return "https://" VL_STORE_STAGING_HOST "/api/";
  return "https://" VL_STORE_PRODUCTION_HOST "/api/";
}

// Asks the device-environment service of the production host for the device's environment: the
// digit of an "HTTP/1.1 200 OK" answer whose body is that one digit, production for any other
// answer (none included). False when no connection could be opened.
bool AskDeviceEnvironment(soap* context, const char* destinationUniqueID, int destinationTypeID, int* env) {
  char type[16];
  snprintf(type, sizeof(type), "%d", destinationTypeID);
  VLString url = "https://" VL_STORE_PRODUCTION_HOST "/device/env/?d=" + VLUtilities::URLEncode(destinationUniqueID) +
                 "&dt=" + type;
  VLHttpGet get(context);
  VL_WS_Status status = get.Get(url.c_str(), kEnvironmentQuery);
  if (status == VL_WS_E_CONNECT) return false;
  bool digit = status == VL_WS_OK && get.ContentLength() == 1 && get.ReceiveBody() && get.Body()[0] >= '0' &&
               get.Body()[0] <= '9';
  *env = digit ? get.Body()[0] - '0' : kProductionEnv;
  return true;
}

}  // namespace

const char* VLUtilities::QueryServiceBaseURL(enum VL_WS_SetupParams::ContentType contentType, soap* context,
                                             const char* destinationUniqueID, int destinationTypeID,
                                             VL_WS_EnvNum envNum, VL_WS_EnvID& envID) {
  if (envNum >= VL_WS_ENV_STGAPI && envNum <= VL_WS_ENV_PRODUCTION) {
    envID = envNum;
    const char* url = BaseURL(contentType, envNum);
    printf("\n=======>Content type:%d, envID:%d, endpoint URL:%s\n", static_cast<int>(contentType), envID, url);
    return url;
  }
  int env = kProductionEnv;
  if (!AskDeviceEnvironment(context, destinationUniqueID, destinationTypeID, &env)) return "";
  envID = env;
  const char* url = BaseURL(contentType, env);
  printf("\n---> End-Point URL: %s <---\n\n", url);
  return url;
}
