// Endpoint query: which base URL a client handle sends its SOAP requests to, from the content
// type and the environment, asking the store's device-environment service for the "default"
// environment.
#include <stdio.h>
#include <string.h>

#include "VLStoreHosts.h"
#include "VLTransportConnection.h"
#include "VLUtilities.h"

namespace {

const int kProductionEnv = 2;

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

// The environment in the service's answer: the digit after the blank line of an
// "HTTP/1.1 200 OK" answer with "Content-Length: 1"; production for anything else. A missing or
// non-digit body byte is such an answer too, so the environment is always a digit.
int ParseEnvironment(const char* answer) {
  const char* status = strstr(answer, "HTTP/1.1 200 OK\r\n");
  const char* length = status ? strstr(status, "Content-Length: 1\r\n") : 0;
  const char* blank = length ? strstr(length, "\r\n\r\n") : 0;
  if (!blank || blank[4] < '0' || blank[4] > '9') return kProductionEnv;
  return blank[4] - '0';
}

// Asks the device-environment service of the production host for the device's environment.
// False when no connection could be opened.
bool AskDeviceEnvironment(soap* context, const char* destinationUniqueID, int destinationTypeID, int* env) {
  char type[16];
  snprintf(type, sizeof(type), "%d", destinationTypeID);
  VLString target = "/device/env/?d=" + VLUtilities::URLEncode(destinationUniqueID) + "&dt=" + type;
  VLString url = "https://" VL_STORE_PRODUCTION_HOST + target;

  VLTransportConnection connection(context);
  if (!connection.Open(url.c_str(), VL_STORE_PRODUCTION_HOST, 443)) return false;
  VLString request = "GET " + target + " HTTP/1.1\r\n";
  request += "User-Agent: DUDUVud\r\nHost: " VL_STORE_PRODUCTION_HOST "\r\n\r\n";
  char answer[2048];
  size_t received = 0;
  if (connection.Send(request.c_str(), request.length())) received = connection.Receive(answer, sizeof(answer) - 1);
  answer[received] = 0;
  *env = ParseEnvironment(answer);
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
