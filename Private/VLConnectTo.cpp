#include "VLConnectTo.h"

#include <stdlib.h>
#include <string.h>
#include <strings.h>

#include "VLWSAELog.h"

namespace {

// Splits one field off the front of *p at the next ':' (an address in brackets may contain
// colons; the brackets are dropped). Returns false when the text ends without a separator and
// one was required.
bool NextField(const char** p, const char* end, bool last, VLString* field) {
  const char* s = *p;
  const char* stop;
  if (s < end && *s == '[') {
    const char* close = static_cast<const char*>(memchr(s, ']', end - s));
    if (!close) return false;
    field->assign(s + 1, close - s - 1);
    stop = close + 1;
  } else {
    stop = static_cast<const char*>(memchr(s, ':', end - s));
    if (!stop) stop = end;
    field->assign(s, stop - s);
  }
  if (last) {
    if (stop != end) return false;
    *p = end;
    return true;
  }
  if (stop >= end || *stop != ':') return false;
  *p = stop + 1;
  return true;
}

// A port field: empty gives 0 ("any" or "same"), else 1 to 65535.
bool ParsePort(const VLString& text, int* port) {
  if (text.empty()) {
    *port = 0;
    return true;
  }
  char* end = NULL;
  long value = strtol(text.c_str(), &end, 10);
  if (*end != '\0' || value < 1 || value > 65535) return false;
  *port = static_cast<int>(value);
  return true;
}

bool ParseEntry(const char* s, const char* end, VLConnectTo::Entry* entry) {
  VLString port, addrPort;
  return NextField(&s, end, false, &entry->host) && NextField(&s, end, false, &port) &&
         NextField(&s, end, false, &entry->addr) && NextField(&s, end, true, &addrPort) &&
         ParsePort(port, &entry->port) && ParsePort(addrPort, &entry->addrPort);
}

}  // namespace

std::vector<VLConnectTo::Entry> VLConnectTo::Parse(const char* text) {
  std::vector<Entry> entries;
  if (!text) return entries;
  soap_init_vl_log();
  const char* s = text;
  for (;;) {
    const char* comma = strchr(s, ',');
    const char* end = comma ? comma : s + strlen(s);
    if (end > s) {
      Entry entry;
      if (ParseEntry(s, end, &entry)) {
        entries.push_back(entry);
      } else {
        VLLogOutputwithConfig({TEST_VLLogAreaID, 1}, "VLWS_CONNECT_TO: ignoring entry \"%.*s\"\n",
                              static_cast<int>(end - s), s);
      }
    }
    if (!comma) break;
    s = comma + 1;
  }
  return entries;
}

bool VLConnectTo::Resolve(const char* host, int port, VLString* addr, int* addrPort) {
  // Read once: the table is fixed for the life of the process.
  static const std::vector<Entry> s_Entries = Parse(getenv("VLWS_CONNECT_TO"));
  for (const Entry& e : s_Entries) {
    if (!e.host.empty() && strcasecmp(e.host.c_str(), host) != 0) continue;
    if (e.port != 0 && e.port != port) continue;
    *addr = e.addr.empty() ? VLString(host) : e.addr;
    *addrPort = e.addrPort != 0 ? e.addrPort : port;
    return true;
  }
  *addr = host;
  *addrPort = port;
  return false;
}
