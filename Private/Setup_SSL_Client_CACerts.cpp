#include "Setup_SSL_Client_CACerts.h"

#include <stdio.h>
#include <string.h>

#include <openssl/evp.h>
#include <openssl/ssl.h>

namespace {

// The root certificates the library trusts besides OpenSSL's default verify paths, in this
// order: GTE CyberTrust Root CA, GTE CyberTrust Global Root, Thawte Premium Server CA, Thawte
// Server CA. Produced once from their PEM files: for each, the label, "-BEG-", the PEM body
// (the Base64 of the DER bytes) with its line breaks and BEGIN/END lines removed, and "-END-".
// Check with: openssl x509 -in <file>.pem -outform DER | base64 -w0
const char kRootCertificates[] =
    "GTE CyberTrust Root CA"
    "-BEG-"
    "MIIB+jCCAWMCAgGjMA0GCSqGSIb3DQEBBAUAMEUxCzAJBgNVBAYTAlVTMRgwFgYDVQQKEw9HVEUgQ29ycG9yYXRpb2"
    "4xHDAaBgNVBAMTE0dURSBDeWJlclRydXN0IFJvb3QwHhcNOTYwMjIzMjMwMTAwWhcNMDYwMjIzMjM1OTAwWjBFMQsw"
    "CQYDVQQGEwJVUzEYMBYGA1UEChMPR1RFIENvcnBvcmF0aW9uMRwwGgYDVQQDExNHVEUgQ3liZXJUcnVzdCBSb290MI"
    "GfMA0GCSqGSIb3DQEBAQUAA4GNADCBiQKBgQC45k+625h8cXyvRLfTD0bZZOWTwUKOx7pJjTUteueLveUFMVnGsS8K"
    "DPufpz+iCWaEVh43KRuH6X4MypqfpX/1FZSj1aJGgthoTNE3FQZor734sLPwKfWVWgkWYXcKIiXUT0Wqx73llt/51K"
    "iOQswkwB6RJ0q1bQaAYznEol44AwIDAQABMA0GCSqGSIb3DQEBBAUAA4GBABKzdcZfHeFhVYAA1IFLezEPI2PnPfMD"
    "+fQ2qLvZ46WXTeorKeDWanOB5sCJo9Px4KWlIjeaY8JIILTbcuPI9tl8vrGvU9oUtCG41tWW4/5ODFlitppK+ULdjG"
    "+BqXH/9ApybW1EDp3zdHSo1TRJ6V6e6bR64eVaH4QwnNOfpSXY"
    "-END-"
    "GTE CyberTrust Global Root"
    "-BEG-"
    "MIICWjCCAcMCAgGlMA0GCSqGSIb3DQEBBAUAMHUxCzAJBgNVBAYTAlVTMRgwFgYDVQQKEw9HVEUgQ29ycG9yYXRpb2"
    "4xJzAlBgNVBAsTHkdURSBDeWJlclRydXN0IFNvbHV0aW9ucywgSW5jLjEjMCEGA1UEAxMaR1RFIEN5YmVyVHJ1c3Qg"
    "R2xvYmFsIFJvb3QwHhcNOTgwODEzMDAyOTAwWhcNMTgwODEzMjM1OTAwWjB1MQswCQYDVQQGEwJVUzEYMBYGA1UECh"
    "MPR1RFIENvcnBvcmF0aW9uMScwJQYDVQQLEx5HVEUgQ3liZXJUcnVzdCBTb2x1dGlvbnMsIEluYy4xIzAhBgNVBAMT"
    "GkdURSBDeWJlclRydXN0IEdsb2JhbCBSb290MIGfMA0GCSqGSIb3DQEBAQUAA4GNADCBiQKBgQCVD6C28FCc6HrHiM"
    "3dFw4usJTQGz0O9pTAipTHBsiQl8i4ZBp6fmw8U+E3KHNgf7KXUwefU/ltWJTSr41tiGeA5u2ylc9yMcqlHHK6XALn"
    "ZELn+aks1joNrI1CqiQBOeacPwGFVw1Yh0X404Wqk2kmhXBIgD8SFcd5tB8FLztimQIDAQABMA0GCSqGSIb3DQEBBA"
    "UAA4GBAG3rGwnpXtlR22ciYaQqPEh346B8pt5zohQDhT37qw4wxYMWM4ETCJ57NE7fQMh017l93PR2VX2bY1QY6fDq"
    "81yx2YtCHrnAlU66+tXifPVoYb+O7AWXX1uw16OFNMQkpw0PlZPvy5TYnh+dXIVtx6quTx8itc2VrbqnzPmrC3p/"
    "-END-"
    "Thawte Premium Server CA"
    "-BEG-"
    "MIIDJzCCApCgAwIBAgIBATANBgkqhkiG9w0BAQQFADCBzjELMAkGA1UEBhMCWkExFTATBgNVBAgTDFdlc3Rlcm4gQ2"
    "FwZTESMBAGA1UEBxMJQ2FwZSBUb3duMR0wGwYDVQQKExRUaGF3dGUgQ29uc3VsdGluZyBjYzEoMCYGA1UECxMfQ2Vy"
    "dGlmaWNhdGlvbiBTZXJ2aWNlcyBEaXZpc2lvbjEhMB8GA1UEAxMYVGhhd3RlIFByZW1pdW0gU2VydmVyIENBMSgwJg"
    "YJKoZIhvcNAQkBFhlwcmVtaXVtLXNlcnZlckB0aGF3dGUuY29tMB4XDTk2MDgwMTAwMDAwMFoXDTIwMTIzMTIzNTk1"
    "OVowgc4xCzAJBgNVBAYTAlpBMRUwEwYDVQQIEwxXZXN0ZXJuIENhcGUxEjAQBgNVBAcTCUNhcGUgVG93bjEdMBsGA1"
    "UEChMUVGhhd3RlIENvbnN1bHRpbmcgY2MxKDAmBgNVBAsTH0NlcnRpZmljYXRpb24gU2VydmljZXMgRGl2aXNpb24x"
    "ITAfBgNVBAMTGFRoYXd0ZSBQcmVtaXVtIFNlcnZlciBDQTEoMCYGCSqGSIb3DQEJARYZcHJlbWl1bS1zZXJ2ZXJAdG"
    "hhd3RlLmNvbTCBnzANBgkqhkiG9w0BAQEFAAOBjQAwgYkCgYEA0jY2aovXwlue2oFBYo847kkEVdbQ7xwblRZH7xhI"
    "NTpS9CtqBo87L+pW46+GjZ4X9560ZXUCTe/LCaIhUdib0GfQug2SBhRz1JPLlyoAnFxODLz6FVL88kRu2hFKbgifLy"
    "3j+ao6hnO2RlNYyIkFvYMRuHM/qgeN9EJN50CdHDcCAwEAAaMTMBEwDwYDVR0TAQH/BAUwAwEB/zANBgkqhkiG9w0B"
    "AQQFAAOBgQAmSCwWwlj66BZ0DKqqX1Q/8tfJeGBeXm43YyJ3Nn6yF8Q0ufUIhfzJATj/Tb7yFkJD57taRvvBxhEf8U"
    "qwKEbJw8RCfbz6q1lu1bdRiBHjpIUZa4JMpAwSremkrj/xw0llmozFyD4lt5SZu5IycQfwhl7tUCemDaYj+bvLpgcU"
    "Qg=="
    "-END-"
    "Thawte Server CA"
    "-BEG-"
    "MIIDEzCCAnygAwIBAgIBATANBgkqhkiG9w0BAQQFADCBxDELMAkGA1UEBhMCWkExFTATBgNVBAgTDFdlc3Rlcm4gQ2"
    "FwZTESMBAGA1UEBxMJQ2FwZSBUb3duMR0wGwYDVQQKExRUaGF3dGUgQ29uc3VsdGluZyBjYzEoMCYGA1UECxMfQ2Vy"
    "dGlmaWNhdGlvbiBTZXJ2aWNlcyBEaXZpc2lvbjEZMBcGA1UEAxMQVGhhd3RlIFNlcnZlciBDQTEmMCQGCSqGSIb3DQ"
    "EJARYXc2VydmVyLWNlcnRzQHRoYXd0ZS5jb20wHhcNOTYwODAxMDAwMDAwWhcNMjAxMjMxMjM1OTU5WjCBxDELMAkG"
    "A1UEBhMCWkExFTATBgNVBAgTDFdlc3Rlcm4gQ2FwZTESMBAGA1UEBxMJQ2FwZSBUb3duMR0wGwYDVQQKExRUaGF3dG"
    "UgQ29uc3VsdGluZyBjYzEoMCYGA1UECxMfQ2VydGlmaWNhdGlvbiBTZXJ2aWNlcyBEaXZpc2lvbjEZMBcGA1UEAxMQ"
    "VGhhd3RlIFNlcnZlciBDQTEmMCQGCSqGSIb3DQEJARYXc2VydmVyLWNlcnRzQHRoYXd0ZS5jb20wgZ8wDQYJKoZIhv"
    "cNAQEBBQADgY0AMIGJAoGBANOkUG7I/1Zr5s9dtuoMaHVHoqrC2oQl/Kj0R1HahbUgdJSGHg91yekIYfUGbTBuFRkC"
    "6VLAYttNmZ7iagxEOM3+vuNkCXDF/rFrKbYvScg71CcEJRCXL+eQbcAoQpnXTEPew/UhbVSfXcNY4cDk2VuwuNy0e9"
    "82OsK1ZiIS1ocNAgMBAAGjEzARMA8GA1UdEwEB/wQFMAMBAf8wDQYJKoZIhvcNAQEEBQADgYEAB/pMaVz7lcxG7oWD"
    "TSEwjsrZqG9JGubaUeNgcGyEYRGhGshIPllDfU+VPaGLtwtimHp1it2ITk6eQNuozDJ0uW8NxuOzRAvZim+aKZuZGC"
    "g70eNAKJpaPNW15yAbi8qkq43pUdniTCxZqdq5snUb9kLy78fyGPmJvKP/iiMucEc="
    "-END-";

const char kBegin[] = "-BEG-";
const char kEnd[] = "-END-";

}  // namespace

int VLAddRootCertificates(soap* s, const char* block, int (*add)(X509_STORE*, X509*)) {
  X509_STORE* store = SSL_CTX_get_cert_store(s->ctx);
  unsigned char* der = NULL;
  size_t capacity = 0;
  X509* cert = NULL;
  int rc = SOAP_OK;
  for (const char* p = block;;) {
    const char* begin = strstr(p, kBegin);
    const char* end = begin ? strstr(begin + sizeof(kBegin) - 1, kEnd) : NULL;
    if (!end) break;
    const char* text = begin + sizeof(kBegin) - 1;
    size_t length = end - text;
    size_t size = (length + 3) / 4 * 3;
    if (size > capacity) {
      unsigned char* grown = static_cast<unsigned char*>(OPENSSL_realloc(der, size));
      if (!grown) {
        rc = soap_set_receiver_error(s, "out of memory", "in soap_ssl_client_cacerts()", SOAP_EOM);
        break;
      }
      der = grown;
      capacity = size;
    }
    int n = EVP_DecodeBlock(der, reinterpret_cast<const unsigned char*>(text), static_cast<int>(length));
    X509_free(cert);
    const unsigned char* in = der;
    cert = n > 0 ? d2i_X509(NULL, &in, n) : NULL;
    if (!cert) break;  // a damaged entry ends the walk; the certificates before it stay
    if (add(store, cert) != 1) {
      char detail[64];
      snprintf(detail, sizeof(detail), "At position %lu", static_cast<unsigned long>(text - block));
      rc = soap_set_receiver_error(s, "SSL add chain certificate failed in soap_ssl_client_cacerts()",
                                   soap_strdup(s, detail), SOAP_SSL_ERROR);
      break;
    }
    p = end + sizeof(kEnd) - 1;
  }
  X509_free(cert);
  OPENSSL_free(der);
  return rc;
}

int Setup_SSL_Client_CACerts(soap* s) {
  if (soap_ssl_client_context(s, SOAP_SSL_DEFAULT, NULL, NULL, NULL, NULL, NULL) != SOAP_OK) return s->error;
  SSL_CTX_set_verify_depth(s->ctx, 9);
  if (SSL_CTX_set_default_verify_paths(s->ctx) != 1)
    return soap_set_receiver_error(s, "SSL error", "default verify paths not loaded", SOAP_SSL_ERROR);
  return VLAddRootCertificates(s, kRootCertificates, X509_STORE_add_cert);
}
