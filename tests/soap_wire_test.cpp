// The requests the service objects put on the wire, captured on a loopback server: HTTP request
// head, envelope, header blocks, body, the UsernameToken digest, routing and proxies.
#include <gtest/gtest.h>

#include <regex>
#include <string>

#include <openssl/evp.h>

#include "DownloadAPI.h"
#include "RealTimeBrowse.h"
#include "Setup_SSL_Client_CACerts.h"
#include "StreamAPI.h"
#include "StreamDownloadAPI.h"
#include "VLSimTestClient.h"
#include "VLTestServer.h"

namespace {

const std::string kEmptyReply(const char* op) {
  return VLTestServer::HttpReply(VLTestServer::Envelope(std::string("<VL1:") + op + "Response/>"));
}

std::string Base(const VLTestServer& server) { return "https://localhost:" + std::to_string(server.Port()) + "/api/"; }

// The three varying texts of a UsernameToken.
struct Token {
  std::string password, nonce, created;
};

Token TokenOf(const std::string& body) {
  std::smatch m;
  Token t;
  if (std::regex_search(body, m, std::regex("#PasswordDigest\">([^<]*)</wsse:Password>"))) t.password = m[1];
  if (std::regex_search(body, m, std::regex("<wsse:Nonce>([^<]*)</wsse:Nonce>"))) t.nonce = m[1];
  if (std::regex_search(body, m, std::regex("<wsu:Created>([^<]*)</wsu:Created>"))) t.created = m[1];
  return t;
}

std::string Unbase64(const std::string& text) {
  std::string out(text.size(), '\0');
  int n = EVP_DecodeBlock(reinterpret_cast<unsigned char*>(&out[0]),
                          reinterpret_cast<const unsigned char*>(text.data()), static_cast<int>(text.size()));
  size_t pad = text.size() - text.find_last_not_of('=') - 1;
  out.resize(n - pad);
  return out;
}

std::string SoapBody(const std::string& request) {
  std::string body = VLTestServer::Body(request);
  size_t b = body.find("<SOAP-ENV:Body>");
  return b == std::string::npos ? "" : body.substr(b);
}

// A service object of kind T bound to params, with its TLS set up.
template <class T>
void Bind(T* service, const VL_WS_SetupParams2* params) {
  ASSERT_EQ(SOAP_OK, Setup_SSL_Client_CACerts(service));
  service->SetParams(params);
}

template <class T>
void Release(T* service) {
  soap_destroy(service);
  soap_end(service);
}

const char kNamespaces[] =
    "xmlns:SOAP-ENV=\"http://schemas.xmlsoap.org/soap/envelope/\" "
    "xmlns:SOAP-ENC=\"http://schemas.xmlsoap.org/soap/encoding/\" "
    "xmlns:xsi=\"http://www.w3.org/2001/XMLSchema-instance\" "
    "xmlns:xsd=\"http://www.w3.org/2001/XMLSchema\" "
    "xmlns:c14n=\"http://www.w3.org/2001/10/xml-exc-c14n#\" "
    "xmlns:wsu=\"http://docs.oasis-open.org/wss/2004/01/oasis-200401-wss-wssecurity-utility-1.0.xsd\" "
    "xmlns:ds=\"http://www.w3.org/2000/09/xmldsig#\" "
    "xmlns:wsse=\"http://docs.oasis-open.org/wss/2004/01/oasis-200401-wss-wssecurity-secext-1.0.xsd\" "
    "xmlns:wsa=\"http://schemas.xmlsoap.org/ws/2004/08/addressing\" "
    "xmlns:VL2=\"http://store.ostrel.example/api/StreamAPISoap12\" "
    "xmlns:VL3=\"http://store.ostrel.example/api/RealTimeBrowseSoap12\" "
    "xmlns:VL4=\"http://store.ostrel.example/api/DownloadAPISoap12\" "
    "xmlns:VL1=\"http://store.ostrel.example/api/\" "
    "xmlns:VL5=\"http://store.ostrel.example/api/DownloadAuthenticateSoap12\"";

// A TLS server and settings that point to it.
class SoapWire : public ::testing::Test {
 protected:
  SoapWire() : m_Server(&VLTestPKI::Get().Trusted()) { VLTestFillParams(&m_Params, Base(m_Server)); }
  VLTestServer m_Server;
  VL_WS_SetupParams2 m_Params;
};

}  // namespace

TEST_F(SoapWire, GoldenCatalogueRequest) {
  m_Server.SetReply(kEmptyReply("searchForTitle"));
  RealTimeBrowse rtb;
  Bind(&rtb, &m_Params);
  ASSERT_EQ(SOAP_OK, rtb.Setup("searchForTitle"));
  _VL1__searchForTitle* req = soap_new__VL1__searchForTitle(&rtb);
  req->Query = NULL;  // optional: left out, the integers and enumerations after it still written
  req->ItemsPerPage = 10;
  req->CurrentPageNumber = 2;
  req->PurchaseType = VL1__StreamAPIPurchaseType__any;
  req->TitleType = VL1__TitleTypeFilter__movies;
  EXPECT_EQ(SOAP_OK, rtb.searchForTitle(req, soap_new__VL1__searchForTitleResponse(&rtb)));
  Release(&rtb);

  ASSERT_EQ(1u, m_Server.Requests().size());
  const std::string request = m_Server.Requests()[0];
  const std::string body = VLTestServer::Body(request);
  const std::string port = std::to_string(m_Server.Port());
  EXPECT_EQ("POST /api/RealTimeBrowse.asmx HTTP/1.1\r\n"
            "Host: localhost:" + port + "\r\n"
            "User-Agent: gSOAP/2.7\r\n"
            "Content-Type: text/xml; charset=utf-8\r\n"
            "Content-Length: " + std::to_string(body.size()) + "\r\n"
            "Connection: close\r\n"
            "Accept-Encoding: gzip, deflate\r\n"
            "SOAPAction: \"http://store.ostrel.example/api/searchForTitle\"\r\n\r\n",
            VLTestServer::Head(request));

  Token t = TokenOf(body);
  std::string golden = std::string("<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n<SOAP-ENV:Envelope ") + kNamespaces +
      "><SOAP-ENV:Header>"
      "<wsse:Security SOAP-ENV:mustUnderstand=\"1\"><wsse:UsernameToken wsu:Id=\"User\">"
      "<wsse:Username>user</wsse:Username>"
      "<wsse:Password Type=\"http://docs.oasis-open.org/wss/2004/01/oasis-200401-wss-username-token-profile-1.0#PasswordDigest\">" + t.password + "</wsse:Password>"
      "<wsse:Nonce>" + t.nonce + "</wsse:Nonce>"
      "<wsu:Created>" + t.created + "</wsu:Created></wsse:UsernameToken></wsse:Security>"
      "<wsa:MessageID>uuid:searchForTitle</wsa:MessageID>"
      "<wsa:ReplyTo SOAP-ENV:mustUnderstand=\"1\"><wsa:Address>http://schemas.xmlsoap.org/ws/2004/08/addressing/role/anonymous</wsa:Address></wsa:ReplyTo>"
      "<wsa:To SOAP-ENV:mustUnderstand=\"1\">https://localhost:" + port + "/api/RealTimeBrowse.asmx</wsa:To>"
      "<wsa:Action SOAP-ENV:mustUnderstand=\"1\">http://store.ostrel.example/api/searchForTitle</wsa:Action>"
      "<VL1:DeviceSettings SOAP-ENV:mustUnderstand=\"1\"><VL1:APIKey>key</VL1:APIKey>"
      "<VL1:DestinationUniqueID>00-11-22-33-44-55</VL1:DestinationUniqueID>"
      "<VL1:DestinationTypeID>7</VL1:DestinationTypeID><VL1:AuthToken/></VL1:DeviceSettings>"
      "</SOAP-ENV:Header><SOAP-ENV:Body><VL1:searchForTitle>"
      "<VL1:ItemsPerPage>10</VL1:ItemsPerPage><VL1:CurrentPageNumber>2</VL1:CurrentPageNumber>"
      "<VL1:PurchaseType>any</VL1:PurchaseType><VL1:TitleType>movies</VL1:TitleType>"
      "</VL1:searchForTitle></SOAP-ENV:Body></SOAP-ENV:Envelope>\r\n";
  EXPECT_EQ(golden, body);

  // The digest, recomputed: Base64(SHA-1(nonce bytes + created + password)).
  EXPECT_TRUE(std::regex_match(t.created, std::regex("\\d{4}-\\d\\d-\\d\\dT\\d\\d:\\d\\d:\\d\\dZ")));
  std::string nonce = Unbase64(t.nonce);
  ASSERT_EQ(20u, nonce.size());
  EXPECT_EQ(VLPasswordDigest(nonce, t.created, "secret"), t.password);
  EXPECT_EQ(std::string::npos, body.find("secret"));
}

TEST_F(SoapWire, HeaderBlockOfEachServiceAndSettingsReadAtSetup) {
  m_Params.UserAgent = "VLSDK: 2.1|5.0 VLMODEL:BD-42";
  StreamAPI st;
  DownloadAPI dl;
  Bind(&st, &m_Params);
  Bind(&dl, &m_Params);
  m_Params.AuthToken = "token-1";  // changed after binding: seen by the next Setup

  m_Server.SetReply(kEmptyReply("getConfig"));
  ASSERT_EQ(SOAP_OK, st.Setup("getConfig"));
  EXPECT_EQ(SOAP_OK, st.getConfig(soap_new__VL1__getConfig(&st), soap_new__VL1__getConfigResponse(&st)));
  Release(&st);
  ASSERT_EQ(SOAP_OK, dl.Setup("getConfig"));
  EXPECT_EQ(SOAP_OK, dl.getConfig(soap_new__VL1__getConfig(&dl), soap_new__VL1__getConfigResponse(&dl)));
  Release(&dl);

  auto requests = m_Server.Requests();
  ASSERT_EQ(2u, requests.size());
  const char kBlock[] =
      " SOAP-ENV:mustUnderstand=\"1\"><VL1:APIKey>key</VL1:APIKey><VL1:DestinationUniqueID>00-11-22-33-44-55"
      "</VL1:DestinationUniqueID><VL1:DestinationTypeID>7</VL1:DestinationTypeID><VL1:AuthToken>token-1</VL1:AuthToken>";
  EXPECT_NE(std::string::npos, requests[0].find(std::string("<VL1:StreamDeviceRequestSettings") + kBlock));
  EXPECT_NE(std::string::npos, requests[1].find(std::string("<VL1:DownloadDeviceRequestSettings") + kBlock));
  EXPECT_EQ(std::string::npos, requests[0].find("<VL1:DeviceSettings"));
  EXPECT_EQ(std::string::npos, requests[1].find("<VL1:StreamDeviceRequestSettings"));
  EXPECT_EQ("POST /api/StreamAPI.asmx HTTP/1.1", requests[0].substr(0, requests[0].find("\r\n")));
  EXPECT_EQ("POST /api/DownloadAPI.asmx HTTP/1.1", requests[1].substr(0, requests[1].find("\r\n")));
  // Two calls in one second carry different nonces, and so different digests.
  EXPECT_NE(TokenOf(requests[0]).nonce, TokenOf(requests[1]).nonce);
  EXPECT_NE(TokenOf(requests[0]).password, TokenOf(requests[1]).password);
  for (const std::string& r : requests) {
    EXPECT_EQ(r.find("User-Agent:"), r.rfind("User-Agent:"));
    EXPECT_EQ("VLSDK: 2.1|5.0 VLMODEL:BD-42", VLTestServer::Header(r, "User-Agent"));
    // The action is the SOAPAction without its quotes; the message ID names the operation.
    EXPECT_EQ("\"http://store.ostrel.example/api/getConfig\"", VLTestServer::Header(r, "SOAPAction"));
    EXPECT_NE(std::string::npos, r.find(">http://store.ostrel.example/api/getConfig</wsa:Action>"));
    EXPECT_NE(std::string::npos, r.find("<wsa:MessageID>uuid:getConfig</wsa:MessageID>"));
    EXPECT_NE(std::string::npos, r.find("<SOAP-ENV:Body><VL1:getConfig/></SOAP-ENV:Body>") +
                                     r.find("<SOAP-ENV:Body><VL1:getConfig></VL1:getConfig></SOAP-ENV:Body>") + 1);
  }
}

TEST_F(SoapWire, ArraysOfIntAndEmptyOrNullLists) {
  m_Server.SetReply(kEmptyReply("getTitlesByGenreArray"));
  RealTimeBrowse rtb;
  Bind(&rtb, &m_Params);
  int ids[3] = {12, 7, 30};
  for (int size : {3, 0, -1}) {
    ASSERT_EQ(SOAP_OK, rtb.Setup("getTitlesByGenreArray"));
    _VL1__getTitlesByGenreArray* req = soap_new__VL1__getTitlesByGenreArray(&rtb);
    if (size >= 0) {
      req->GenreIDs = soap_new_VL1__ArrayOfInt(&rtb);
      req->GenreIDs->__sizeint = size;
      req->GenreIDs->int_ = ids;
    }
    req->PurchaseType = VL1__StreamAPIPurchaseType__buy;
    EXPECT_EQ(SOAP_OK, rtb.getTitlesByGenreArray(req, soap_new__VL1__getTitlesByGenreArrayResponse(&rtb)));
    Release(&rtb);
  }
  auto requests = m_Server.Requests();
  ASSERT_EQ(3u, requests.size());
  const std::string tail =
      "<VL1:CurrentPageNumber>0</VL1:CurrentPageNumber><VL1:ItemsPerPage>0</VL1:ItemsPerPage>"
      "<VL1:PurchaseType>buy</VL1:PurchaseType></VL1:getTitlesByGenreArray>";
  EXPECT_NE(std::string::npos, SoapBody(requests[0]).find(
      "<VL1:getTitlesByGenreArray><VL1:GenreIDs><VL1:int>12</VL1:int><VL1:int>7</VL1:int><VL1:int>30</VL1:int>"
      "</VL1:GenreIDs>" + tail));
  EXPECT_NE(std::string::npos, SoapBody(requests[1]).find("<VL1:getTitlesByGenreArray><VL1:GenreIDs></VL1:GenreIDs>" + tail));
  EXPECT_NE(std::string::npos, SoapBody(requests[2]).find("<VL1:getTitlesByGenreArray>" + tail));
}

TEST_F(SoapWire, DispatcherRoutesByAccessTypeWithIdenticalBodies) {
  VLTestServer download(&VLTestPKI::Get().Trusted());
  m_Server.SetReply(kEmptyReply("addItemToWishlist"));
  download.SetReply(kEmptyReply("addItemToWishlist"));
  VL_WS_SetupParams2 dlParams;
  VLTestFillParams(&dlParams, Base(download));
  StreamAPI st;
  DownloadAPI dl;
  Bind(&st, &m_Params);
  Bind(&dl, &dlParams);
  for (VL_WS_AccessType type : {UNKNOWN, STREAM, DOWNLOAD, static_cast<VL_WS_AccessType>(3)}) {
    StreamDownloadAPI api;
    api.Init(&st, &dl, type);
    soap& ctx = api;
    EXPECT_EQ(type == DOWNLOAD ? static_cast<soap*>(&dl) : static_cast<soap*>(&st), &ctx);
    ASSERT_EQ(SOAP_OK, api.Setup("addItemToWishlist"));
    _VL1__addItemToWishlist* req = soap_new__VL1__addItemToWishlist(&ctx);
    req->TitleID = 4711;
    EXPECT_EQ(SOAP_OK, api.addItemToWishlist(req, soap_new__VL1__addItemToWishlistResponse(&ctx)));
    soap_destroy(&ctx);
    soap_end(&ctx);
  }
  ASSERT_EQ(3u, m_Server.Requests().size());
  ASSERT_EQ(1u, download.Requests().size());
  const std::string streamBody = SoapBody(m_Server.Requests()[0]);
  EXPECT_EQ("<SOAP-ENV:Body><VL1:addItemToWishlist><VL1:TitleID>4711</VL1:TitleID></VL1:addItemToWishlist>"
            "</SOAP-ENV:Body></SOAP-ENV:Envelope>\r\n", streamBody);
  EXPECT_EQ(streamBody, SoapBody(download.Requests()[0]));
  EXPECT_NE(std::string::npos, download.Requests()[0].find("<VL1:DownloadDeviceRequestSettings"));
}

TEST_F(SoapWire, PlainHttpThroughProxyWithCredentials) {
  VLTestServer proxy;  // plays the proxy: gets the request with the full URL
  proxy.SetReply(kEmptyReply("getNavigation"));
  VLTestFillParams(&m_Params, "http://store.ostrel.example/api/");
  m_Params.ProxyHost = "127.0.0.1";
  m_Params.ProxyPort = proxy.Port();
  m_Params.ProxyUserName = "proxyuser";
  m_Params.ProxyPassword = "proxypass";
  RealTimeBrowse rtb;
  Bind(&rtb, &m_Params);
  ASSERT_EQ(SOAP_OK, rtb.Setup("getNavigation"));
  EXPECT_EQ(SOAP_OK, rtb.getNavigation(soap_new__VL1__getNavigation(&rtb), soap_new__VL1__getNavigationResponse(&rtb)));
  Release(&rtb);
  ASSERT_EQ(1u, proxy.Requests().size());
  const std::string r = proxy.Requests()[0];
  EXPECT_EQ("POST http://store.ostrel.example/api/RealTimeBrowse.asmx HTTP/1.1", r.substr(0, r.find("\r\n")));
  EXPECT_EQ("store.ostrel.example", VLTestServer::Header(r, "Host"));
  EXPECT_EQ("Basic cHJveHl1c2VyOnByb3h5cGFzcw==", VLTestServer::Header(r, "Proxy-Authorization"));
}

TEST_F(SoapWire, HttpsThroughProxyOpensTunnel) {
  VLTestServer proxy;
  proxy.SetReply("HTTP/1.1 407 Proxy Authentication Required\r\nContent-Length: 0\r\n\r\n");
  VLTestFillParams(&m_Params, "https://store.ostrel.example/api/");
  m_Params.ProxyHost = "127.0.0.1";
  m_Params.ProxyPort = proxy.Port();
  m_Params.ProxyUserName = std::string(400, 'u').c_str();
  m_Params.ProxyPassword = std::string(360, 'p').c_str();
  DownloadAPI dl;
  Bind(&dl, &m_Params);
  for (size_t password : {360, 361}) {  // 760 bytes together are still sent, 761 are not
    m_Params.ProxyPassword = std::string(password, 'p').c_str();
    ASSERT_EQ(SOAP_OK, dl.Setup("checkAuthToken"));
    EXPECT_EQ(407, dl.checkAuthToken(soap_new__VL1__checkAuthToken(&dl), soap_new__VL1__checkAuthTokenResponse(&dl)));
    Release(&dl);
  }
  auto requests = proxy.Requests();
  ASSERT_EQ(2u, requests.size());
  EXPECT_EQ("CONNECT store.ostrel.example:443 HTTP/1.1", requests[0].substr(0, requests[0].find("\r\n")));
  EXPECT_EQ("store.ostrel.example:443", VLTestServer::Header(requests[0], "Host"));
  EXPECT_EQ(0u, VLTestServer::Header(requests[0], "Proxy-Authorization").find("Basic dXV1"));
  EXPECT_EQ(std::string::npos, requests[1].find("Proxy-Authorization"));
}

TEST(SoapWireSettings, EmptyProxyHostLeavesProxyUnset) {
  VL_WS_SetupParams2 params;
  VLTestFillParams(&params, "https://store.ostrel.example/api/");
  params.ProxyPort = 3128;
  params.ProxyUserName = "u";
  params.ProxyPassword = "p";
  RealTimeBrowse rtb;
  Bind(&rtb, &params);
  EXPECT_EQ(nullptr, rtb.proxy_host);
  EXPECT_EQ(nullptr, rtb.proxy_userid);
  EXPECT_STREQ("https://store.ostrel.example/api/RealTimeBrowse.asmx", rtb.soap_endpoint);
}
