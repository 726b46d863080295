// Reading replies: a record decoded from a canned answer of a loopback server past unknown and
// missing elements, faults classified by namespace in both SOAP versions, HTTP statuses and the
// proxy's log lines. (Enumerations, empty and missing arrays and untyped elements are read in the
// record conversion tests, compressed replies against the store simulator.)
#include <gtest/gtest.h>

#include <mutex>
#include <string>
#include <vector>

#include "RealTimeBrowse.h"
#include "VLTestServer.h"
#include "VLWSAELog.h"
#include "VL_Log.h"

namespace {

// Catches the messages of the "soap_proxy" and "soap_test" areas.
class LogCapture {
 public:
  LogCapture() {
    int id;
    for (const char* area : {"soap_proxy", "soap_test"}) {
      VL_LogRegisterArea(area, &id);
      VL_LogActivateArea(id, 1);
    }
    VL_LogSetObserver(Observe, this);
  }
  ~LogCapture() { VL_LogSetObserver(nullptr, nullptr); }
  bool Has(const std::string& area, const std::string& text) {
    std::lock_guard<std::mutex> lock(m_Mutex);
    for (const auto& m : m_Messages)
      if (m.first == area && m.second.find(text) != std::string::npos) return true;
    return false;
  }

 private:
  static void Observe(void* ctx, const char* area, int, const char* text, size_t len) {
    LogCapture* self = static_cast<LogCapture*>(ctx);
    std::lock_guard<std::mutex> lock(self->m_Mutex);
    self->m_Messages.emplace_back(area, std::string(text, len));
  }
  std::mutex m_Mutex;
  std::vector<std::pair<std::string, std::string>> m_Messages;
};

// A catalogue service object talking plain HTTP to a loopback server.
class SoapDecode : public ::testing::Test {
 protected:
  SoapDecode() {
    VLTestFillParams(&m_Params, "http://127.0.0.1:" + std::to_string(m_Server.Port()) + "/api/");
    m_Rtb.SetParams(&m_Params);
  }
  ~SoapDecode() override {
    soap_destroy(&m_Rtb);
    soap_end(&m_Rtb);
  }

  // getTitlesByNavigation answered with the given response element content; what an earlier call
  // left in the context is released first.
  int GetTitles(const std::string& responseContent, _VL1__getTitlesByNavigationResponse** response) {
    soap_destroy(&m_Rtb);
    soap_end(&m_Rtb);
    m_Server.SetReply(VLTestServer::HttpReply(VLTestServer::Envelope(
        "<VL1:getTitlesByNavigationResponse>" + responseContent + "</VL1:getTitlesByNavigationResponse>")));
    EXPECT_EQ(SOAP_OK, m_Rtb.Setup("getTitlesByNavigation"));
    *response = soap_new__VL1__getTitlesByNavigationResponse(&m_Rtb);
    return m_Rtb.getTitlesByNavigation(soap_new__VL1__getTitlesByNavigation(&m_Rtb), *response);
  }

  VLTestServer m_Server;
  VL_WS_SetupParams2 m_Params;
  RealTimeBrowse m_Rtb;
};

// A result element whose page holds one title listing with inner.
std::string OneListing(const std::string& inner) {
  return "<VL1:getTitlesByNavigationResult><VL1:Titles><VL1:TitleListing>" + inner +
         "</VL1:TitleListing></VL1:Titles></VL1:getTitlesByNavigationResult>";
}

}  // namespace

TEST_F(SoapDecode, TitleListingToleratesUnknownAndMissingElements) {
  LogCapture log;
  _VL1__getTitlesByNavigationResponse* r;
  ASSERT_EQ(SOAP_OK, GetTitles(OneListing("<VL1:TitleName>Heat</VL1:TitleName><VL1:Surprise><x>1</x></VL1:Surprise>"
                                          "<VL1:TitleID>42</VL1:TitleID><VL1:IsTvListing>true</VL1:IsTvListing>"
                                          "<VL1:AvailableProducts><VL1:ProductListing><VL1:Price>9.99</VL1:Price>"
                                          "<VL1:PurchaseType>any</VL1:PurchaseType></VL1:ProductListing>"
                                          "</VL1:AvailableProducts>"),
                               &r));
  ASSERT_NE(nullptr, r->getTitlesByNavigationResult->Titles);
  ASSERT_EQ(1, r->getTitlesByNavigationResult->Titles->__sizeTitleListing);
  VL1__TitleListing* t = r->getTitlesByNavigationResult->Titles->TitleListing[0];
  EXPECT_EQ(42, t->TitleID);
  EXPECT_STREQ("Heat", t->TitleName);
  EXPECT_EQ(0, t->TitlePosition);
  EXPECT_EQ(nullptr, t->BoxArtPrefix);
  EXPECT_EQ(true_, t->IsTvListing);
  ASSERT_EQ(1, t->AvailableProducts->__sizeProductListing);
  EXPECT_STREQ("9.99", t->AvailableProducts->ProductListing[0]->Price);
  EXPECT_EQ(VL1__StreamAPIPurchaseType__any, t->AvailableProducts->ProductListing[0]->PurchaseType);
  EXPECT_TRUE(log.Has("soap_proxy", "Entering RealTimeBrowseSoap12Proxy::getTitlesByNavigation"));
  EXPECT_TRUE(log.Has("soap_proxy", "Exiting RealTimeBrowseSoap12Proxy::getTitlesByNavigation"));
  // An enumeration word the schema does not know fails the whole answer.
  EXPECT_EQ(SOAP_TYPE, GetTitles(OneListing("<VL1:AvailableProducts><VL1:ProductListing><VL1:PurchaseType>HD"
                                            "</VL1:PurchaseType></VL1:ProductListing></VL1:AvailableProducts>"), &r));
}

TEST_F(SoapDecode, FaultsAndHttpStatuses) {
  LogCapture log;
  auto fault = [](const std::string& code) {
    return VLTestServer::HttpReply(VLTestServer::Envelope("<SOAP-ENV:Fault><faultcode>" + code + "</faultcode>"
                                                          "<faultstring>Store is down</faultstring></SOAP-ENV:Fault>"),
                                   "500 Internal Server Error");
  };
  // The same codes under other prefixes of the envelope's namespace, in both SOAP versions.
  auto other = [](const std::string& envelope, const std::string& fault) {
    return VLTestServer::HttpReply("<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n<e:Envelope xmlns:e=\"" + envelope +
                                       "\"><e:Body><e:Fault>" + fault + "</e:Fault></e:Body></e:Envelope>",
                                   "500 Internal Server Error");
  };
  const std::string v11 = "http://schemas.xmlsoap.org/soap/envelope/", v12 = "http://www.w3.org/2003/05/soap-envelope";
  auto code12 = [](const std::string& code) {
    return "<e:Code><e:Value>" + code + "</e:Value></e:Code><e:Reason><e:Text xml:lang=\"en\">Store is down</e:Text></e:Reason>";
  };
  const struct {
    std::string reply;
    int code;
  } cases[] = {{fault("SOAP-ENV:Server"), SOAP_SVR_FAULT},
               {fault("VL1:Throttled"), SOAP_FAULT},
               {other(v11, "<faultcode>e:Server</faultcode><faultstring>Store is down</faultstring>"), SOAP_SVR_FAULT},
               {other(v11, "<faultcode>e:Client</faultcode><faultstring>Store is down</faultstring>"), SOAP_CLI_FAULT},
               {other(v12, code12("e:Receiver")), SOAP_SVR_FAULT},
               {other(v12, code12("e:Sender")), SOAP_CLI_FAULT},
               {VLTestServer::HttpReply("<html>gone</html>", "404 Not Found"), 404}};
  for (const auto& c : cases) {
    m_Server.SetReply(c.reply);
    ASSERT_EQ(SOAP_OK, m_Rtb.Setup("getFileType"));
    EXPECT_EQ(c.code,
              m_Rtb.getFileType(soap_new__VL1__getFileType(&m_Rtb), soap_new__VL1__getFileTypeResponse(&m_Rtb)));
    if (c.code != 404) {
      EXPECT_STREQ("Store is down", m_Rtb.soap_fault_string());
    }
    soap_destroy(&m_Rtb);
    soap_end(&m_Rtb);
  }
  EXPECT_TRUE(log.Has("soap_test", "HTTP error 404"));
}
