// VLSimCertificates: the simulator's own small PKI, made with the OpenSSL API at start-up.
//
// A test CA signs the server certificate whose subject alternative names list every logical
// store host, so that a client that trusts the CA (SSL_CERT_FILE) and verifies host names accepts
// the simulator as any of them. Its common name deliberately matches no host: OpenSSL falls back
// to the CN in some modes, and a CN that matched by accident would hide a SAN mistake. Three more
// certificates exist only to be refused: a self-signed one, one for another host name and an
// expired one (all with the same SANs or, for the wrong host, none of the store's).
#ifndef VLSIMCERTIFICATES_H
#define VLSIMCERTIFICATES_H

#include <openssl/evp.h>
#include <openssl/x509.h>

#include <memory>
#include <string>
#include <vector>

class VLSimCertificates {
 public:
  // Which certificate the TLS port presents.
  enum Kind { kGood = 0, kSelfSigned, kWrongHost, kExpired, kKindCount };

  struct KeyDeleter {
    void operator()(EVP_PKEY* key) const { EVP_PKEY_free(key); }
  };
  struct CertDeleter {
    void operator()(X509* cert) const { X509_free(cert); }
  };
  using Key = std::unique_ptr<EVP_PKEY, KeyDeleter>;
  using Cert = std::unique_ptr<X509, CertDeleter>;

  // Makes the CA and the four server certificates for the given names (host names, or IPv4
  // addresses, which become IP entries). False with a message when OpenSSL fails.
  bool Create(const std::vector<std::string>& names, std::string* error);

  // Writes the CA certificate as PEM (the file a client names in SSL_CERT_FILE).
  bool WriteCA(const std::string& path, std::string* error) const;

  X509* CACertificate() const { return m_CACert.get(); }
  X509* Certificate(Kind kind) const { return m_Certs[kind].get(); }
  EVP_PKEY* PrivateKey(Kind kind) const { return m_Keys[kind].get(); }

  // The name of a kind as used in fault specifications: "good", "selfsigned", "wronghost",
  // "expired"; Parse gives kKindCount for an unknown name.
  static const char* Name(Kind kind);
  static Kind Parse(const std::string& name);

 private:
  Key m_CAKey;
  Cert m_CACert;
  Key m_Keys[kKindCount];
  Cert m_Certs[kKindCount];
};

#endif  // VLSIMCERTIFICATES_H
