// The TLS set-up of a SOAP context: a client TLS context that verifies the server's certificate
// chain and host name, trusting the library's embedded root certificates plus OpenSSL's default
// verify paths (which honour SSL_CERT_FILE and SSL_CERT_DIR, so a lab or a test adds its own CA
// there). A certificate that fails the check fails the call with SOAP_SSL_ERROR (30).
#ifndef SETUP_SSL_CLIENT_CACERTS_H
#define SETUP_SSL_CLIENT_CACERTS_H

#include <openssl/x509.h>

#include "stdsoap2.h"

// Creates the context's TLS client context and loads the root certificate block into its trust
// store. Returns SOAP_OK or the context's error code. Called once per service object.
int Setup_SSL_Client_CACerts(soap* soap);

// Walks a root certificate block: entries of a label (ignored), "-BEG-", the certificate's DER
// bytes in Base64 without line breaks and "-END-", one after the other. Each certificate is
// handed to add (X509_STORE_add_cert; tests inject failures) with the TLS context's store. An
// entry that does not parse as a certificate ends the walk without error; a certificate that add
// refuses ends it with SOAP_SSL_ERROR, the fault "SSL add chain certificate failed in
// soap_ssl_client_cacerts()" and the detail "At position <offset of its Base64 text>".
// Requires the context's TLS context.
int VLAddRootCertificates(soap* soap, const char* block, int (*add)(X509_STORE*, X509*));

#endif  // SETUP_SSL_CLIENT_CACERTS_H
