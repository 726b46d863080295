// Account, purchase, wishlist and streaming operations: what the sessions of tests/data/sessions
// (account-*, purchase-*, streaming, wishlist-*) cannot show. Null pointers, the tags of the
// records that refused and failed calls leave, the raw SOAP logs, and a receive time-out.
#include <gtest/gtest.h>

#include <map>
#include <string>

#include "VLTestAccountClient.h"
#include "VLWSAELog.h"
#include "VL_Log.h"

namespace {

using AccountOperations = VLTestAccountClient;

TEST_F(AccountOperations, NullArgumentsAreRefusedBeforeAnyRequest) {
  Init();
  VL_WS_Handle none = {};
  VL_WS_ConfigResponse config;
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_getConfig(&none, &config));
  EXPECT_EQ(VL_WS_TAG_CONFIG_RESPONSE, *config.tag);
  VL_WS_release(&config);
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_getConfig(&m_Handle, nullptr));
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_getCountryID(&m_Handle, nullptr));
  bool flag = true;
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_checkAuthToken(nullptr, &flag));
  EXPECT_FALSE(flag);
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_checkTitleInWishlist(&m_Handle, 1003, nullptr));

  VLAnswer<VL_WS_PurchaseResponse> purchase;
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_doPurchaseSavedBilling(&m_Handle, 10012, nullptr, false, purchase.Fresh()));
  EXPECT_EQ(VL_WS_TAG_PURCHASE_RESPONSE, *purchase->tag);
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, Call(VL_WS_removeAllMyPurchases, static_cast<const char*>(nullptr)));
  const int ids[] = {1002, 1100};
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, Call(VL_WS_getTitleListingPurchaseds, 0, ids));
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, Call(VL_WS_getTitleListingPurchaseds, 2, static_cast<const int*>(nullptr)));
  VLAnswer<VL_WS_StandardResponse> standard;
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_manageStreamingInstanceStatus(&m_Handle, nullptr, 2, 0, standard.Fresh()));
  EXPECT_EQ(VL_WS_TAG_STANDARD_RESPONSE, *standard->tag);
  VLAnswer<VL_WS_BoolArray> flags;
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_checkTitlesInWishlist(&m_Handle, 0, ids, 0, flags.Fresh()));
  EXPECT_EQ(VL_WS_TAG_BOOL_ARRAY, *flags->tag);
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_checkTitlesInWishlist(&m_Handle, 2, nullptr, 0, flags.Fresh()));
  EXPECT_TRUE(RequestsNow().empty());
  EXPECT_TRUE(TakeLog().empty());
}

// The fault matrix has every fault of an account answer; here the records a failure leaves.
TEST_F(AccountOperations, FailedCallsLeaveTaggedRecords) {
  Init();
  Fault("getConfig=soapfault,times=1");
  VL_WS_ConfigResponse config;
  EXPECT_EQ(VL_WS_E_SOAP_FAULT(2), VL_WS_getConfig(&m_Handle, &config));
  ASSERT_NE(nullptr, config.tag);
  EXPECT_EQ(VL_WS_TAG_CONFIG_RESPONSE, *config.tag);
  EXPECT_EQ(VL_WS_OK, VL_WS_release(&config));

  Fault("getBillingInfoAndPPCBalance=code:2,times=1");
  VLAnswer<VL_WS_BillingInfoAndPPCBalance> info;
  EXPECT_EQ(VL_WS_E_UNEXPECTED, VL_WS_getBillingInfoAndPPCBalance(&m_Handle, info.Fresh()));
  EXPECT_EQ(VL_WS_TAG_BILLING_INFO_RESPONSE, *info->BillingInfo.tag);

  Fault("checkAuthToken=status:503,times=1");
  bool valid = true;
  EXPECT_EQ(VL_WS_E_HTTP_STATUS(503), VL_WS_checkAuthToken(&m_Handle, &valid));
  EXPECT_FALSE(valid);
}

// The raw logs of the SOAP messages hold every byte but the values of the account's token and
// password.
TEST_F(AccountOperations, RawLogsMaskTheTokenAndThePassword) {
  Init();
  const std::string oldToken = Settings().AuthToken.c_str();
  VLTestDir dir;
  VLWSAELog::InitWSLogs(0x1800, 2, dir.path().c_str());  // "soap_recv" and "soap_sent"
  std::map<std::string, std::string> raw;
  VL_LogSetObserver(
      [](void* ctx, const char* area, int, const char* text, size_t len) {
        (*static_cast<std::map<std::string, std::string>*>(ctx))[area].append(text, len);
      },
      &raw);
  VLAnswer<VL_WS_AuthorizeDeviceResponse> answer;
  ASSERT_EQ(VL_WS_OK, VL_WS_authorizeDevice(&m_Handle, kPinNumber, answer.Fresh()));
  const std::string newToken = answer->AuthToken;
  Call(VL_WS_removeAllMyPurchases, "alicepw");
  VL_LogSetObserver(nullptr, nullptr);

  const std::string& sent = raw["soap_sent"];
  const std::string& received = raw["soap_recv"];
  for (const std::string& secret : {oldToken, newToken, std::string("alicepw")}) {
    EXPECT_EQ(std::string::npos, sent.find(secret)) << secret;
    EXPECT_EQ(std::string::npos, received.find(secret)) << secret;
  }
  EXPECT_NE(std::string::npos, sent.find("<VL1:AuthToken>********</VL1:AuthToken>"));
  EXPECT_NE(std::string::npos, sent.find("<VL1:password>********</VL1:password>"));
  EXPECT_NE(std::string::npos, received.find("AuthToken>********</"));
  EXPECT_NE(std::string::npos, sent.find("<VL1:DestinationUniqueID>00-11-22-33-44-55</VL1:DestinationUniqueID>"));
}

// The store holds the answer of the streaming service's test operation longer than the handle
// waits.
TEST_F(AccountOperations, AnswerAfterTheReceiveTimeOutIsAnEndOfFile) {
  Init(DOWNLOAD);
  m_Handle.client->m_StreamAPI.recv_timeout = 1;
  VLAnswer<VL_WS_StandardResponse> answer;
  EXPECT_EQ(VL_WS_E_EOF, VL_WS_returnTimeout(&m_Handle, answer.Fresh()));
  EXPECT_EQ(nullptr, answer->ResponseMessage);
  EXPECT_TRUE(TakeLog().empty());
}

}  // namespace
