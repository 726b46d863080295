#include "VLSimCertificates.h"

#include <arpa/inet.h>
#include <openssl/bn.h>
#include <openssl/err.h>
#include <openssl/pem.h>
#include <openssl/x509v3.h>

#include <cstdio>

namespace {

const long kDay = 24 * 60 * 60;

std::string OpenSSLError(const char* what) {
  unsigned long code = ERR_get_error();
  char text[256] = "";
  if (code) ERR_error_string_n(code, text, sizeof text);
  ERR_clear_error();
  return std::string(what) + (code ? std::string(": ") + text : std::string());
}

bool AddExtension(X509* cert, X509V3_CTX* ctx, int nid, const std::string& value) {
  X509_EXTENSION* ext = X509V3_EXT_conf_nid(nullptr, ctx, nid, value.c_str());
  if (!ext) return false;
  bool ok = X509_add_ext(cert, ext, -1) == 1;
  X509_EXTENSION_free(ext);
  return ok;
}

struct CertSpec {
  std::string commonName;
  std::string altNames;     // subjectAltName value; empty for the CA
  bool isCA = false;
  long notBefore = -kDay;   // seconds relative to now
  long notAfter = 30 * kDay;
};

// A certificate for key, signed by issuerKey under issuer's name (self-signed when issuer is null).
VLSimCertificates::Cert MakeCert(const CertSpec& spec, EVP_PKEY* key, X509* issuer, EVP_PKEY* issuerKey) {
  VLSimCertificates::Cert cert(X509_new());
  if (!cert || !X509_set_version(cert.get(), 2)) return nullptr;
  BIGNUM* serial = BN_new();
  bool ok = serial && BN_rand(serial, 63, BN_RAND_TOP_ANY, BN_RAND_BOTTOM_ANY) &&
            BN_to_ASN1_INTEGER(serial, X509_get_serialNumber(cert.get()));
  BN_free(serial);
  if (!ok) return nullptr;
  X509_gmtime_adj(X509_getm_notBefore(cert.get()), spec.notBefore);
  X509_gmtime_adj(X509_getm_notAfter(cert.get()), spec.notAfter);
  X509_NAME* name = X509_get_subject_name(cert.get());
  if (!X509_set_pubkey(cert.get(), key) ||
      !X509_NAME_add_entry_by_txt(name, "O", MBSTRING_ASC,
                                  reinterpret_cast<const unsigned char*>("vlstore-sim"), -1, -1, 0) ||
      !X509_NAME_add_entry_by_txt(name, "CN", MBSTRING_ASC,
                                  reinterpret_cast<const unsigned char*>(spec.commonName.c_str()), -1, -1, 0) ||
      !X509_set_issuer_name(cert.get(), issuer ? X509_get_subject_name(issuer) : name))
    return nullptr;

  X509V3_CTX ctx;
  X509V3_set_ctx_nodb(&ctx);
  X509V3_set_ctx(&ctx, issuer ? issuer : cert.get(), cert.get(), nullptr, nullptr, 0);
  ok = AddExtension(cert.get(), &ctx, NID_basic_constraints, spec.isCA ? "critical,CA:TRUE" : "critical,CA:FALSE") &&
       AddExtension(cert.get(), &ctx, NID_key_usage,
                    spec.isCA ? "critical,keyCertSign,cRLSign" : "critical,digitalSignature,keyEncipherment") &&
       AddExtension(cert.get(), &ctx, NID_subject_key_identifier, "hash") &&
       AddExtension(cert.get(), &ctx, NID_authority_key_identifier, "keyid:always");
  if (ok && !spec.isCA)
    ok = AddExtension(cert.get(), &ctx, NID_ext_key_usage, "serverAuth") &&
         AddExtension(cert.get(), &ctx, NID_subject_alt_name, spec.altNames);
  if (!ok || !X509_sign(cert.get(), issuerKey ? issuerKey : key, EVP_sha256())) return nullptr;
  return cert;
}

}  // namespace

bool VLSimCertificates::Create(const std::vector<std::string>& names, std::string* error) {
  std::string altNames;
  for (const std::string& name : names) {
    struct in_addr address;
    altNames += std::string(altNames.empty() ? "" : ",") + (inet_pton(AF_INET, name.c_str(), &address) == 1 ? "IP:" : "DNS:") + name;
  }

  m_CAKey.reset(EVP_EC_gen("P-256"));
  Key serverKey(EVP_EC_gen("P-256"));
  if (!m_CAKey || !serverKey) {
    *error = OpenSSLError("cannot generate a key");
    return false;
  }
  CertSpec ca;
  ca.commonName = "vlstore-sim test CA";
  ca.isCA = true;
  m_CACert = MakeCert(ca, m_CAKey.get(), nullptr, nullptr);
  if (!m_CACert) {
    *error = OpenSSLError("cannot make the CA certificate");
    return false;
  }

  CertSpec server;
  server.commonName = "vlstore-sim server";
  server.altNames = altNames;
  CertSpec wrongHost = server;
  wrongHost.commonName = "wrong-host.invalid";
  wrongHost.altNames = "DNS:wrong-host.invalid";
  CertSpec expired = server;
  expired.notBefore = -30 * kDay;
  expired.notAfter = -kDay;

  m_Certs[kGood] = MakeCert(server, serverKey.get(), m_CACert.get(), m_CAKey.get());
  m_Certs[kSelfSigned] = MakeCert(server, serverKey.get(), nullptr, nullptr);
  m_Certs[kWrongHost] = MakeCert(wrongHost, serverKey.get(), m_CACert.get(), m_CAKey.get());
  m_Certs[kExpired] = MakeCert(expired, serverKey.get(), m_CACert.get(), m_CAKey.get());
  for (int kind = 0; kind < kKindCount; ++kind) {
    if (!m_Certs[kind]) {
      *error = OpenSSLError("cannot make a server certificate");
      return false;
    }
    EVP_PKEY_up_ref(serverKey.get());
    m_Keys[kind].reset(serverKey.get());
  }
  return true;
}

bool VLSimCertificates::WriteCA(const std::string& path, std::string* error) const {
  FILE* file = fopen(path.c_str(), "w");
  if (!file) {
    *error = "cannot write " + path;
    return false;
  }
  bool ok = PEM_write_X509(file, m_CACert.get()) == 1;
  ok = (fclose(file) == 0) && ok;
  if (!ok) *error = "cannot write " + path;
  return ok;
}

const char* VLSimCertificates::Name(Kind kind) {
  static const char* const kNames[kKindCount] = {"good", "selfsigned", "wronghost", "expired"};
  return kind < kKindCount ? kNames[kind] : "";
}

VLSimCertificates::Kind VLSimCertificates::Parse(const std::string& name) {
  for (int kind = 0; kind < kKindCount; ++kind)
    if (name == Name(static_cast<Kind>(kind))) return static_cast<Kind>(kind);
  return kKindCount;
}
