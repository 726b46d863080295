// TLS of the service objects: certificate and host-name checks, the root certificate block,
// receive time-outs and peers that hang up.
#include <gtest/gtest.h>
#include <signal.h>

#include <chrono>
#include <string>

#include <openssl/pem.h>
#include <openssl/ssl.h>

#include "RealTimeBrowse.h"
#include "Setup_SSL_Client_CACerts.h"
#include "VLTestServer.h"

namespace {

std::string Base(const VLTestServer& server, const char* scheme = "https") {
  return std::string(scheme) + "://localhost:" + std::to_string(server.Port()) + "/api/";
}

// One getNavigation call of a freshly bound catalogue object against server; returns its code.
int CallNavigation(VLTestServer& server, const char* scheme = "https", int recvTimeout = 5,
                   const char* query = nullptr) {
  VL_WS_SetupParams2 params;
  VLTestFillParams(&params, Base(server, scheme));
  params.RecvTimeout = recvTimeout;
  RealTimeBrowse rtb;
  EXPECT_EQ(SOAP_OK, Setup_SSL_Client_CACerts(&rtb));
  rtb.SetParams(&params);
  EXPECT_EQ(SOAP_OK, rtb.Setup("searchForTitle"));
  _VL1__searchForTitle* req = soap_new__VL1__searchForTitle(&rtb);
  req->Query = const_cast<char*>(query);
  int rc = rtb.searchForTitle(req, soap_new__VL1__searchForTitleResponse(&rtb));
  soap_destroy(&rtb);
  soap_end(&rtb);
  return rc;
}

// The Base64 of a certificate's DER bytes, as in a root certificate block.
std::string DerBase64(X509* cert) {
  unsigned char* der = nullptr;
  int n = i2d_X509(cert, &der);
  std::string out(4 * ((n + 2) / 3) + 1, '\0');
  out.resize(EVP_EncodeBlock(reinterpret_cast<unsigned char*>(&out[0]), der, n));
  OPENSSL_free(der);
  return out;
}

int CountCerts(soap* s) {
  return sk_X509_OBJECT_num(X509_STORE_get0_objects(SSL_CTX_get_cert_store(s->ctx)));
}

int s_Adds = 0;
int RefuseSecond(X509_STORE* store, X509* cert) { return ++s_Adds == 2 ? 0 : X509_STORE_add_cert(store, cert); }

}  // namespace

TEST(SoapTls, ServerCertificateAndHostNameAreChecked) {
  const VLTestPKI& pki = VLTestPKI::Get();
  VLTestServer trusted(&pki.Trusted()), selfSigned(&pki.SelfSigned()), otherHost(&pki.OtherHost());
  trusted.SetReply(VLTestServer::HttpReply(VLTestServer::Envelope("<VL1:searchForTitleResponse/>")));
  EXPECT_EQ(SOAP_OK, CallNavigation(trusted));
  EXPECT_EQ(SOAP_SSL_ERROR, CallNavigation(selfSigned));
  EXPECT_EQ(SOAP_SSL_ERROR, CallNavigation(otherHost));
  EXPECT_EQ(1u, trusted.Requests().size());
  EXPECT_EQ(0u, selfSigned.Requests().size());
  EXPECT_EQ(0u, otherHost.Requests().size());
}

TEST(SoapTls, EmbeddedRootBlockLoadsFourCertificates) {
  RealTimeBrowse rtb;
  ASSERT_EQ(SOAP_OK, Setup_SSL_Client_CACerts(&rtb));
  int gte = 0, thawte = 0;
  STACK_OF(X509_OBJECT)* objects = X509_STORE_get0_objects(SSL_CTX_get_cert_store(rtb.ctx));
  for (int i = 0; i < sk_X509_OBJECT_num(objects); i++) {
    X509* cert = X509_OBJECT_get0_X509(sk_X509_OBJECT_value(objects, i));
    if (!cert) continue;
    char name[256];
    X509_NAME_oneline(X509_get_subject_name(cert), name, sizeof(name));
    std::string subject(name);
    gte += subject.find("CN=GTE CyberTrust") != std::string::npos;
    thawte += subject.find("CN=Thawte") != std::string::npos;
  }
  EXPECT_EQ(2, gte);
  EXPECT_EQ(2, thawte);
}

TEST(SoapTls, RootBlockWalkStopsAtDamagedEntryAndFailsOnRefusal) {
  const VLTestPKI& pki = VLTestPKI::Get();
  const std::string a = DerBase64(pki.Trusted().cert), b = DerBase64(pki.SelfSigned().cert),
                    c = DerBase64(pki.OtherHost().cert);
  {
    soap s;
    ASSERT_EQ(SOAP_OK, soap_ssl_client_context(&s, SOAP_SSL_DEFAULT, NULL, NULL, NULL, NULL, NULL));
    int before = CountCerts(&s);
    std::string block = "one-BEG-" + a + "-END-two-BEG-" + b.substr(0, 40) + "@@@@" + b.substr(44) + "-END-three-BEG-" + c + "-END-";
    EXPECT_EQ(SOAP_OK, VLAddRootCertificates(&s, block.c_str(), X509_STORE_add_cert));
    EXPECT_EQ(before + 1, CountCerts(&s));  // the damaged second entry ended the walk
    soap_destroy(&s);
    soap_end(&s);
  }
  {
    soap s;
    ASSERT_EQ(SOAP_OK, soap_ssl_client_context(&s, SOAP_SSL_DEFAULT, NULL, NULL, NULL, NULL, NULL));
    std::string block = "one-BEG-" + a + "-END-two-BEG-" + b + "-END-three-BEG-" + c + "-END-";
    s_Adds = 0;
    EXPECT_EQ(SOAP_SSL_ERROR, VLAddRootCertificates(&s, block.c_str(), RefuseSecond));
    EXPECT_EQ(2, s_Adds);  // the walk stopped at the refusal
    EXPECT_STREQ("SSL add chain certificate failed in soap_ssl_client_cacerts()", *soap_faultstring(&s));
    std::string detail = "At position " + std::to_string(block.find(b));
    EXPECT_STREQ(detail.c_str(), *soap_faultdetail(&s));
    soap_destroy(&s);
    soap_end(&s);
  }
}

TEST(SoapTls, ReceiveTimeoutTakesItsTimeOnce) {
  for (const VLTestPKI::Cert* cert : {&VLTestPKI::Get().Trusted(), static_cast<const VLTestPKI::Cert*>(nullptr)}) {
    VLTestServer server(cert);
    server.SetBehaviour(VLTestServer::kHang);
    auto start = std::chrono::steady_clock::now();
    EXPECT_EQ(SOAP_EOF, CallNavigation(server, cert ? "https" : "http", 1));
    double seconds = std::chrono::duration<double>(std::chrono::steady_clock::now() - start).count();
    EXPECT_GE(seconds, 0.9);
    EXPECT_LT(seconds, 1.9);  // one receive time-out, nothing waited on top of it
  }
}

TEST(SoapTls, PeerHangingUpDuringRequestIsAnErrorNotASignal) {
  signal(SIGPIPE, SIG_DFL);  // the default action would kill the test
  const std::string query(4 << 20, 'q');  // far more than the socket buffers take
  for (const VLTestPKI::Cert* cert : {&VLTestPKI::Get().Trusted(), static_cast<const VLTestPKI::Cert*>(nullptr)}) {
    VLTestServer server(cert);
    server.SetBehaviour(VLTestServer::kCloseAtOnce);
    int rc = CallNavigation(server, cert ? "https" : "http", 5, query.c_str());
    EXPECT_NE(SOAP_OK, rc);
    EXPECT_TRUE(server.WaitFor(1));
  }
}
