// VLSimEndpoints: routing of every request, and the store's plain HTTP endpoints — the
// device-environment query, the server time, box art and the bandwidth probe.
#include <string.h>
#include <time.h>

#include <cstdio>

#include "VLSimBoxArt.h"
#include "VLSimContext.h"
#include "VLStoreHosts.h"

namespace {

const char kDeviceEnvPath[] = "/device/env/";
const char kTimePath[] = "/device/time/";

bool KnownHost(const std::string& host) {
  for (const char* const* name = VLSimServer::Hosts(); *name; ++name)
    if (host == *name) return true;
  return false;
}

// The value of one query parameter, percent-decoded; found tells whether it was there.
std::string QueryValue(const std::string& query, const std::string& name, bool* found) {
  size_t pos = 0;
  while (pos <= query.size()) {
    size_t end = query.find('&', pos);
    if (end == std::string::npos) end = query.size();
    std::string pair = query.substr(pos, end - pos);
    size_t equals = pair.find('=');
    if (pair.substr(0, equals) == name) {
      *found = true;
      return equals == std::string::npos ? std::string() : VLSimURLDecode(pair.substr(equals + 1), true);
    }
    pos = end + 1;
  }
  *found = false;
  return std::string();
}

VLSimHttpResponse Text(const std::string& body, const char* type) {
  VLSimHttpResponse response;
  response.headers.push_back({"Content-Type", type});
  response.body = body;
  return response;
}

std::string HttpDate(time_t when) {
  struct tm tm;
  gmtime_r(&when, &tm);
  static const char* const kDays[] = {"Sun", "Mon", "Tue", "Wed", "Thu", "Fri", "Sat"};
  static const char* const kMonths[] = {"Jan", "Feb", "Mar", "Apr", "May", "Jun",
                                        "Jul", "Aug", "Sep", "Oct", "Nov", "Dec"};
  char text[64];
  snprintf(text, sizeof text, "%s, %02d %s %04d %02d:%02d:%02d GMT", kDays[tm.tm_wday], tm.tm_mday,
           kMonths[tm.tm_mon], tm.tm_year + 1900, tm.tm_hour, tm.tm_min, tm.tm_sec);
  return text;
}

bool ParseHttpDate(const std::string& text, time_t* when) {
  struct tm tm = {};
  const char* end = strptime(text.c_str(), "%a, %d %b %Y %H:%M:%S GMT", &tm);
  if (!end || *end != '\0') return false;
  *when = timegm(&tm);
  return true;
}

// "/device/env/?d=<device>&dt=<type>": one digit, the environment the store keeps for the device.
VLSimHttpResponse DeviceEnv(VLSimContext& context, const VLSimHttpRequest& request) {
  bool hasDevice = false, hasType = false;
  std::string device = QueryValue(request.query, "d", &hasDevice);
  QueryValue(request.query, "dt", &hasType);
  if (!hasDevice || device.empty() || !hasType)
    return VLSimHttpResponse::Page(400, "The query needs d (device identifier) and dt (device type).");
  return Text(std::to_string(context.store->DeviceEnv(device)), "text/plain");
}

// "/device/time/": the store's clock in UTC, "month/day/year hour:minute:second AM|PM".
VLSimHttpResponse ServerTime(VLSimContext& context) {
  time_t now = context.store->Now();
  struct tm tm;
  gmtime_r(&now, &tm);
  int hour = tm.tm_hour % 12 == 0 ? 12 : tm.tm_hour % 12;
  char text[64];
  snprintf(text, sizeof text, "%d/%d/%d %d:%02d:%02d %s", tm.tm_mon + 1, tm.tm_mday, tm.tm_year + 1900, hour,
           tm.tm_min, tm.tm_sec, tm.tm_hour < 12 ? "AM" : "PM");
  return Text(text, "text/plain");
}

VLSimHttpResponse BoxArt(VLSimContext& context, const VLSimHttpRequest& request) {
  std::string prefix;
  int size = 0;
  if (!VLSimParseBoxArtPath(request.path, &prefix, &size) || !context.catalogue.HasBoxArt(prefix))
    return VLSimHttpResponse::Page(404, "No such image.");
  time_t modified = context.store->BoxArtModified(prefix);
  time_t since = 0;
  VLSimHttpResponse response;
  if (ParseHttpDate(request.Header("If-Modified-Since"), &since) && modified <= since) {
    response.status = 304;
  } else {
    response.headers.push_back({"Content-Type", "image/jpeg"});
    response.body = VLSimBoxArtJpeg(prefix, size, context.store->BoxArtVersion(prefix));
  }
  response.headers.push_back({"Last-Modified", HttpDate(modified)});
  return response;
}

// The probe URL of the configuration, split; false when it names no host and path.
bool ProbeLocation(VLSimContext& context, bool* tls, std::string* host, std::string* path) {
  for (const auto& item : context.store->ConfigItems()) {
    if (item.first != "BandwithCheckURL") continue;
    const std::string& url = item.second;
    size_t slashes = url.find("//");
    size_t slash = slashes == std::string::npos ? slashes : url.find('/', slashes + 2);
    if (slash == std::string::npos) return false;
    *tls = strncasecmp(url.c_str(), "https:", 6) == 0;
    *host = url.substr(slashes + 2, slash - slashes - 2);
    size_t colon = host->find(':');
    if (colon != std::string::npos) host->resize(colon);
    *path = url.substr(slash);
    return true;
  }
  return false;
}

VLSimHttpResponse Probe(VLSimContext& context) {
  std::string body(static_cast<size_t>(context.options.probeBytes), '\0');
  for (size_t i = 0; i < body.size(); ++i) body[i] = static_cast<char>('A' + i % 26);
  return Text(body, "application/octet-stream");
}

}  // namespace

VLSimHttpResponse VLSimHandleRequest(VLSimContext& context, const VLSimHttpRequest& request, bool tls,
                                     VLSimRequest* entry, std::vector<VLSimFault>* faults) {
  const std::string host = request.Host();
  const std::string& path = request.path;
  const bool image = host == VL_STORE_IMAGE_HOST;

  if (tls && KnownHost(host) && !image) {
    static const struct {
      const char* file;
      VLSimService service;
    } kServices[] = {{"RealTimeBrowse.asmx", VLSimService::kRealTimeBrowse},
                     {"StreamAPI.asmx", VLSimService::kStreamAPI},
                     {"DownloadAPI.asmx", VLSimService::kDownloadAPI}};
    for (const auto& candidate : kServices) {
      bool served = path == std::string("/api/") + candidate.file ||
                    (host == VL_STORE_STAGING_API_HOST && path == std::string("/aac/api/") + candidate.file);
      if (!served) continue;
      if (request.method == "POST") return VLSimServeSoap(context, request, candidate.service, entry, faults);
      *faults = context.faults.Take("", path);
      VLSimHttpResponse response = VLSimHttpResponse::Page(405, "The service answers SOAP requests (POST) only.");
      response.headers.push_back({"Allow", "POST"});
      return response;
    }
  }

  *faults = context.faults.Take("", path);
  bool probeTls = false;
  std::string probeHost, probePath;
  enum { kNone, kEnv, kTime, kBoxArt, kProbe } route = kNone;
  if (!KnownHost(host)) entry->note = "unknown host";
  else if (tls && host == VL_STORE_PRODUCTION_HOST && path == kDeviceEnvPath) route = kEnv;
  else if (!tls && host == VL_STORE_PRODUCTION_HOST && path == kTimePath) route = kTime;
  else if (!tls && image && path.compare(0, 15, "/images/boxart/") == 0) route = kBoxArt;
  else if (ProbeLocation(context, &probeTls, &probeHost, &probePath) && tls == probeTls && host == probeHost &&
           path == probePath)
    route = kProbe;
  if (route == kNone) return VLSimHttpResponse::Page(404, "Nothing is served here.");
  if (request.method != "GET") {
    VLSimHttpResponse response = VLSimHttpResponse::Page(405, "Only GET is served here.");
    response.headers.push_back({"Allow", "GET"});
    return response;
  }
  switch (route) {
    case kEnv:
      entry->note = "device environment";
      return DeviceEnv(context, request);
    case kTime:
      entry->note = "server time";
      return ServerTime(context);
    case kBoxArt:
      entry->note = "box art";
      return BoxArt(context, request);
    default:
      entry->note = "bandwidth probe";
      return Probe(context);
  }
}
