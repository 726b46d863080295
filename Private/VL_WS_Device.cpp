// The device and network operations of the flat interface: the bandwidth to the store, the
// device's identifier, its local address and User-Agent, and the store's clock.
#include <arpa/inet.h>
#include <netdb.h>
#include <netinet/in.h>
#include <stdio.h>
#include <string.h>
#include <strings.h>
#include <sys/socket.h>
#include <time.h>

#include "VLHttpGet.h"
#include "VLProxySuspension.h"
#include "VLRecord.h"
#include "VLSoapTransport.h"
#include "VLStoreHosts.h"
#include "VLTransportConnection.h"
#include "VLUtilities.h"
#include "VLWSAELog.h"
#include "VL_WS.h"
#include "VL_WS_Client.h"

namespace {

VLLogArea s_Log(VLWSAELOG_AREA_NAME);

// The bandwidth probe reads at most this many body bytes, in pieces of at most kProbePiece.
const unsigned int kProbeBytes = 204800;
const size_t kProbePiece = 2048;
// The probe names the host before the agent, and its URL, which the store's configuration gives,
// may not split.
const VLHttpGet::Kind kProbe = {true, VL_WS_E_BANDWIDTH_BAD_URL, VL_WS_E_HTTP_NOT_FOUND, VL_WS_E_NETWORK};
// The store's time service: any answer but the time is a network failure.
const VLHttpGet::Kind kTime = {false, VL_WS_E_UNEXPECTED, VL_WS_E_NETWORK, VL_WS_E_NETWORK};

// The probe URL of the store's configuration: the value of its last item "BandwithCheckURL"
// (the key in any letter case); url is left as it is when there is none. Returns the status of
// VL_WS_getConfig.
VL_WS_Status ConfiguredProbeURL(VL_WS_Handle* handle, VLString* url) {
  VL_WS_ConfigResponse config;
  VL_WS_Status status = VL_WS_getConfig(handle, &config);
  for (int i = 0; status == VL_WS_OK && i < config.Count; ++i) {
    if (strcasecmp(config.Items[i].Key, "BandwithCheckURL") == 0) *url = config.Items[i].Value;
  }
  VL_WS_release(&config);
  return status;
}

// The store's clock as the time service writes it: "month/day/year hour:minute:second AM|PM"
// in UTC, the hour on the 12-hour clock. False when fewer than the seven fields are there or a
// field is out of its range.
bool ParseServerTime(const char* text, time_t* when) {
  int month, day, year, hour, minute, second;
  char marker[3] = {0};
  if (sscanf(text, "%d/%d/%d %d:%d:%d %2s", &month, &day, &year, &hour, &minute, &second, marker) < 7)
    return false;
  if (strcmp(marker, "PM") == 0 && hour >= 1 && hour <= 11) hour += 12;
  if (strcmp(marker, "AM") == 0 && hour == 12) hour = 0;
  if (month < 1 || month > 12 || day < 1 || day > 31 || year < 1970 || hour < 0 || hour > 23 || minute < 0 ||
      minute > 59 || second < 0 || second > 60)
    return false;
  struct tm t = {};
  t.tm_year = year - 1900;
  t.tm_mon = month - 1;
  t.tm_mday = day;
  t.tm_hour = hour;
  t.tm_min = minute;
  t.tm_sec = second;
  *when = soap_timegm(&t);
  return true;
}

// The dotted text of an IPv4 address; empty when it has none.
VLString DottedAddress(const struct sockaddr_in& address) {
  char text[INET_ADDRSTRLEN];
  return inet_ntop(AF_INET, &address.sin_addr, text, sizeof text) ? VLString(text) : VLString();
}

// The device's address by the system resolver: the one IPv4 address of the empty host name that
// is not a loopback address; empty when there is not exactly one such address.
VLString ResolverAddress() {
  struct addrinfo hints = {};
  hints.ai_family = AF_INET;
  hints.ai_socktype = SOCK_STREAM;
  struct addrinfo* found = 0;
  if (getaddrinfo("", 0, &hints, &found) != 0) return VLString();
  VLString address;
  int count = 0;
  for (struct addrinfo* a = found; a != 0; a = a->ai_next, ++count)
    address = DottedAddress(*reinterpret_cast<const struct sockaddr_in*>(a->ai_addr));
  freeaddrinfo(found);
  if (count != 1 || address.empty() || strncmp(address.c_str(), "127.", 4) == 0) return VLString();
  return address;
}

}  // namespace

extern "C" VL_WS_Status VL_WS_checkBandwidth(VL_WS_Handle* handle, unsigned int* bitsPerSecond) {
  if (bitsPerSecond == 0) return VL_WS_E_INVALID_ARGUMENT;
  *bitsPerSecond = 0;
  VL_WS_Client* client = VLClientOf(handle);
  if (client == 0) return VL_WS_E_INVALID_ARGUMENT;
  VLString& probeURL = client->m_Params.BandwithCheckURL;
  if (probeURL.empty()) {
    VL_WS_Status status = ConfiguredProbeURL(handle, &probeURL);
    if (status != VL_WS_OK) return status;
    if (probeURL.empty()) return VL_WS_E_BANDWIDTH_NO_URL;
  }
  VLProxySuspension direct(client->m_RealTimeBrowse);
  VLHttpGet get(&client->m_RealTimeBrowse);
  VL_WS_Status status = get.Get(probeURL.c_str(), kProbe);
  if (status != VL_WS_OK) return status;
  // Only the body after the header is timed; the bytes that came with the header count as if
  // they had been.
  unsigned int length = get.ContentLength() < kProbeBytes ? static_cast<unsigned int>(get.ContentLength()) : kProbeBytes;
  unsigned int start = VLUtilities::MillisecondTime();
  size_t remaining = length > get.BodyReceived() ? length - get.BodyReceived() : 0;
  char piece[kProbePiece];
  while (remaining > 0) {
    size_t received = get.Receive(piece, remaining < sizeof piece ? remaining : sizeof piece);
    if (received == 0) return VL_WS_E_NETWORK;
    remaining -= received;
  }
  unsigned int elapsed = VLUtilities::MillisecondTime() - start;
  get.Close();
  *bitsPerSecond = length * 8000u / (elapsed == 0 ? 1 : elapsed);
  return VL_WS_OK;
}

extern "C" VL_WS_Status VL_WS_getDestinationUniqueID(VL_WS_String* id) {
  if (id == 0) return VL_WS_E_INVALID_ARGUMENT;
  VLRecordInit(*id);
  VLRecordSetString(*id, VLUtilities::GetUniqueIdentifier().c_str());
  return VL_WS_OK;
}

extern "C" VL_WS_Status VL_WS_getUserAgent(VL_WS_Handle* handle, VL_WS_String* userAgent) {
  VL_WS_Client* client = VLClientOf(handle);
  if (client == 0 || userAgent == 0) return VL_WS_E_INVALID_ARGUMENT;
  VLRecordInit(*userAgent);
  VLRecordSetString(*userAgent, client->m_Params.UserAgent.c_str());
  VLLogOutputwithConfig({s_Log.Id(), 4}, "%s,User Agent:%s\n", "VL_WS_getUserAgent", userAgent->Text);
  return VL_WS_OK;
}

extern "C" VL_WS_Status VL_WS_getLocalIPAddr(VL_WS_Handle* handle, VL_WS_String* address) {
  if (address == 0) return VL_WS_E_INVALID_ARGUMENT;
  VLRecordInit(*address);
  VL_WS_Client* client = VLClientOf(handle);
  if (client == 0) return VL_WS_E_INVALID_ARGUMENT;

  VLString found = ResolverAddress();
  if (found.empty()) {
    // The address of the interface that reaches the store: the local end of a connection to the
    // catalogue service. Only an IPv4 address is wanted, so only IPv4 addresses of the store are
    // tried: a dual-stack device whose store name resolves to IPv6 first has one too.
    VLString url = client->m_Params.ServiceBaseURL + "RealTimeBrowse.asmx";
    VLHttpURL parts;
    if (!VLHttpGet::SplitURL(url.c_str(), &parts)) return VL_WS_E_UNEXPECTED;
    VLTransportConnection connection(&client->m_RealTimeBrowse);
    VLSoapTransport::SetNextFamily(&client->m_RealTimeBrowse, AF_INET);
    if (!connection.Open(url.c_str(), parts.host.c_str(), parts.port)) return VL_WS_E_CONNECT;
    struct sockaddr_in local = {};
    socklen_t length = sizeof local;
    if (getsockname(client->m_RealTimeBrowse.socket, reinterpret_cast<struct sockaddr*>(&local), &length) != 0 ||
        local.sin_family != AF_INET)
      return VL_WS_E_NETWORK;
    found = DottedAddress(local);
    if (found.empty()) return VL_WS_E_NETWORK;
  }
  VLRecordSetString(*address, found.c_str());
  return VL_WS_OK;
}

namespace {

// One question to the store's time service on context: the time, or the status of the failure.
VL_WS_Status AskServerTime(soap* context, time_t* serverTime) {
  VLHttpGet get(context);
  VL_WS_Status status = get.Get("http://" VL_STORE_PRODUCTION_HOST "/device/time/", kTime);
  if (status != VL_WS_OK) return status;
  if (!get.ReceiveBody() || !ParseServerTime(get.Body(), serverTime)) return VL_WS_E_UNEXPECTED;
  return VL_WS_OK;
}

}  // namespace

extern "C" VL_WS_Status VL_WS_getServerTime(time_t* serverTime) {
  if (serverTime == 0) return VL_WS_E_INVALID_ARGUMENT;
  *serverTime = -1;
  VLSoapContext context;  // the call needs no handle
  time_t when = -1;
  VL_WS_Status status = AskServerTime(&context, &when);
  if (status == VL_WS_OK) *serverTime = when;
  return status;
}
