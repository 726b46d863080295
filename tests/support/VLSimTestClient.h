// Test helpers for what the store simulator must refuse: the bytes a client handle sends and
// receives, taken from its raw logs, and such bytes, edited, sent again over TLS.
#ifndef VLSIMTESTCLIENT_H
#define VLSIMTESTCLIENT_H

#include <time.h>

#include <functional>
#include <string>

// What the raw logs "soap_sent" and "soap_recv" hold while call runs: every byte of the SOAP
// exchanges, the values of AuthToken and password elements masked.
struct VLRawExchange {
  std::string sent, received;
};
VLRawExchange VLRawLogOf(const std::function<void()>& call);

// The UsernameToken's password digest: Base64(SHA-1(nonce bytes + created + password)).
std::string VLPasswordDigest(const std::string& nonce, const std::string& created, const std::string& password);

// A request as the client sent it (HTTP header and envelope) with a new UsernameToken: a new
// nonce, the created time given and the password digest of both, each as long as before.
std::string VLWithNewToken(std::string request, const std::string& password, time_t created);

// Sends request to 127.0.0.1:port over TLS with SNI host, the certificate verified against caFile
// for host, and returns every byte received until the server closed ("" when the connection or
// the handshake fails).
std::string VLSimExchange(int port, const std::string& caFile, const std::string& host, const std::string& request);

#endif  // VLSIMTESTCLIENT_H
