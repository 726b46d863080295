// VLConnectTo: the lab override of network destinations, read from the environment variable
// VLWS_CONNECT_TO once per process.
//
// The variable holds comma-separated entries "HOST:PORT:ADDR:PORT" (the form of curl's
// --connect-to): a connection that the library opens to HOST:PORT goes to ADDR:PORT instead.
// Only the TCP destination changes: URLs, the HTTP "Host" header and the TLS host-name check keep
// the logical host. An empty HOST or first PORT matches any host or port, an empty ADDR or second
// PORT keeps the original one; an IPv6 address is written in brackets ("[::1]"). The first
// matching entry wins; malformed entries are ignored (and logged to "soap_test").
#ifndef VLCONNECTTO_H
#define VLCONNECTTO_H

#include <vector>

#include "VLString.h"

class VLConnectTo {
 public:
  struct Entry {
    VLString host;  // empty: any host
    int port;       // 0: any port
    VLString addr;  // empty: the original host
    int addrPort;   // 0: the original port
  };

  // Where a connection to host:port goes: *addr and *addrPort receive the destination (host and
  // port themselves when no entry matches). Returns true when an entry matched.
  static bool Resolve(const char* host, int port, VLString* addr, int* addrPort);

  // Parses the variable's text into entries; malformed ones are skipped. Used by Resolve on the
  // first call of the process.
  static std::vector<Entry> Parse(const char* text);
};

#endif  // VLCONNECTTO_H
