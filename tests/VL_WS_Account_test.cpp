// Account operations against the store simulator: linking and unlinking the device and what it
// does to the token and the user data, the token check, the account's settings and the store's
// configuration, the adult-content PIN, and the routing of the dispatched operations by access
// type.
#include <gtest/gtest.h>

#include <functional>
#include <map>
#include <string>
#include <vector>

#include "VLTestAccountClient.h"
#include "VLWSAELog.h"
#include "VL_Log.h"

namespace {

using Lines = std::vector<std::string>;

class Account : public VLTestAccountClient {
 protected:
  // A user-data entry that shows whether the user data were purged.
  void MarkUserData() { ASSERT_TRUE(Cache().WriteWishlistFlag(4711, true)); }
  bool UserDataKept() { return Flag(4711) == 1; }
};

TEST_F(Account, WrongPinKeepsTokenAndUserData) {
  Init(STREAM, 7);
  const std::string token = Settings().AuthToken.c_str();
  MarkUserData();
  VLAnswer<VL_WS_AuthorizeDeviceResponse> answer;
  EXPECT_EQ(VL_WS_E_AUTHORIZE_1, VL_WS_authorizeDevice(&m_Handle, 9999, answer.Fresh()));
  EXPECT_EQ(1, answer->ResponseCode);
  EXPECT_STREQ("Wrong PIN", answer->ResponseMessage);
  EXPECT_STREQ("", answer->AuthToken);
  EXPECT_EQ(Lines{"VL_WS_authorizeDevice, ret:0,responseCode:1"}, TakeLog());

  Fault("authorizeDevice=code:2,times=1");
  EXPECT_EQ(VL_WS_E_AUTHORIZE_2, Call(VL_WS_authorizeDevice, kPinNumber));
  Fault("authorizeDevice=code:3,times=1");
  EXPECT_EQ(VL_WS_E_UNEXPECTED, Call(VL_WS_authorizeDevice, kPinNumber));
  EXPECT_EQ(token, Settings().AuthToken.c_str());
  EXPECT_TRUE(UserDataKept());
}

TEST_F(Account, AuthorisationReplacesTheTokenAndPurgesUserData) {
  Init(STREAM, 7);
  const std::string old = Settings().AuthToken.c_str();
  MarkUserData();
  VLAnswer<VL_WS_AuthorizeDeviceResponse> answer;
  ASSERT_EQ(VL_WS_OK, VL_WS_authorizeDevice(&m_Handle, kPinNumber, answer.Fresh()));
  EXPECT_NE(old, answer->AuthToken);
  EXPECT_FALSE(UserDataKept());

  EXPECT_EQ(VL_WS_OK, Call(VL_WS_getCountryID));
  std::vector<VLSimRequest> requests = Requests(2);
  ASSERT_EQ(2u, requests.size());
  EXPECT_EQ(old, requests[0].authToken);
  EXPECT_EQ("GetCountryID", requests[1].operation);
  EXPECT_EQ(answer->AuthToken, requests[1].authToken);
  EXPECT_EQ((Lines{"VL_WS_authorizeDevice, ret:0,responseCode:0", "VL_WS_getCountryID, ret:0,countryid:1"}), TakeLog());
}

// The raw logs of the SOAP messages hold every byte but the values of the account's token and
// password.
TEST_F(Account, RawLogsMaskTheTokenAndThePassword) {
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

TEST_F(Account, DeactivationEmptiesTheToken) {
  Init(STREAM, 7);
  MarkUserData();
  ASSERT_EQ(VL_WS_OK, Call(VL_WS_deactivateDevice));
  EXPECT_TRUE(Settings().AuthToken.empty());
  EXPECT_FALSE(UserDataKept());

  // The store no longer knows the device: the next request carries an empty token.
  VLAnswer<VL_WS_StandardResponse> answer;
  EXPECT_EQ(VL_WS_E_UNEXPECTED, VL_WS_deactivateDevice(&m_Handle, answer.Fresh()));
  EXPECT_EQ(1, answer->ResponseCode);
  std::vector<VLSimRequest> requests = Requests(2);
  ASSERT_EQ(2u, requests.size());
  EXPECT_TRUE(requests[1].hasAuthToken);
  EXPECT_EQ("", requests[1].authToken);
}

TEST_F(Account, TokenCheckPurgesUserDataWhenTheAnswerChanges) {
  Init(STREAM, 7);
  bool valid = false;
  // A new handle starts from "not valid": the first true purges, the second does not.
  for (bool purged : {true, false}) {
    MarkUserData();
    ASSERT_EQ(VL_WS_OK, VL_WS_checkAuthToken(&m_Handle, &valid));
    EXPECT_TRUE(valid);
    EXPECT_TRUE(Settings().AuthTokenValid);
    EXPECT_EQ(!purged, UserDataKept());
  }
  Settings().AuthToken = "SIMTOKEN-UNKNOWN";
  ASSERT_EQ(VL_WS_OK, VL_WS_checkAuthToken(&m_Handle, &valid));
  EXPECT_FALSE(valid);
  EXPECT_FALSE(Settings().AuthTokenValid);
  EXPECT_FALSE(UserDataKept());
  EXPECT_EQ(
      (Lines{"VL_WS_checkAuthToken, result:1", "VL_WS_checkAuthToken, result:1", "VL_WS_checkAuthToken, result:0"}),
      TakeLog());

  // A failed check changes nothing.
  MarkUserData();
  Fault("checkAuthToken=status:503,times=1");
  valid = true;
  EXPECT_EQ(VL_WS_E_HTTP_STATUS(503), VL_WS_checkAuthToken(&m_Handle, &valid));
  EXPECT_FALSE(valid);
  EXPECT_TRUE(UserDataKept());
}

// The fault matrix has every fault of an account answer; here the record of an array answer.
TEST_F(Account, FailedCallsLeaveATaggedEmptyRecord) {
  Init();
  EXPECT_EQ(VL_WS_OK, Call(VL_WS_getConfig));
  EXPECT_EQ(Lines{"VL_WS_getConfig, ret:0,responseCode:0"}, TakeLog());
  Fault("getConfig=soapfault,times=1");
  VL_WS_ConfigResponse config;
  EXPECT_EQ(VL_WS_E_SOAP_FAULT(2), VL_WS_getConfig(&m_Handle, &config));
  ASSERT_NE(nullptr, config.tag);
  EXPECT_EQ(VL_WS_TAG_CONFIG_RESPONSE, *config.tag);
  EXPECT_EQ(0, config.Count);
  EXPECT_EQ(nullptr, config.ResponseMessage);
  EXPECT_EQ(VL_WS_OK, VL_WS_release(&config));

  const size_t asked = Requests(1).size();
  VL_WS_Handle none = {};
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_getConfig(&none, &config));
  EXPECT_EQ(VL_WS_TAG_CONFIG_RESPONSE, *config.tag);
  VL_WS_release(&config);
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_getConfig(&m_Handle, nullptr));
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_getCountryID(&m_Handle, nullptr));
  bool valid = true;
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_checkAuthToken(nullptr, &valid));
  EXPECT_FALSE(valid);
  EXPECT_EQ(asked, RequestsNow().size());
}

TEST_F(Account, TestOperationsOfTheStreamingService) {
  Init(DOWNLOAD);
  VLAnswer<VL_WS_StandardResponse> answer;
  EXPECT_EQ(VL_WS_E_UNEXPECTED, VL_WS_returnError(&m_Handle, answer.Fresh()));
  EXPECT_EQ(99, answer->ResponseCode);

  // The store holds its answer longer than the handle waits.
  m_Handle.client->m_StreamAPI.recv_timeout = 1;
  EXPECT_EQ(VL_WS_E_EOF, VL_WS_returnTimeout(&m_Handle, answer.Fresh()));
  EXPECT_EQ(nullptr, answer->ResponseMessage);
  EXPECT_TRUE(TakeLog().empty());
}

TEST_F(Account, AccountAnswersAreKeptAsUserData) {
  Init(STREAM, VL_WS_CacheParam::CACHE_USERDATA);
  Fault("getEmailAddress=code:1,times=1");
  EXPECT_EQ(VL_WS_E_UNEXPECTED, Call(VL_WS_getEmailAddress));
  VLAnswer<VL_WS_EmailAddressResponse> email;
  VLAnswer<VL_WS_SettingsPageResponse> settings;
  for (int i = 0; i < 2; ++i) {  // the refused answer was not kept; the next one is, whole
    ASSERT_EQ(VL_WS_OK, VL_WS_getEmailAddress(&m_Handle, email.Fresh()));
    EXPECT_STREQ("alice@example.com", email->EmailAddress);
  }
  for (int i = 0; i < 2; ++i) {
    ASSERT_EQ(VL_WS_OK, VL_WS_getSettingsPageInfo(&m_Handle, settings.Fresh()));
    EXPECT_STREQ("00-11-22-33-44-55", settings->DeviceID);
  }
  EXPECT_EQ(3u, Requests(3).size());
  EXPECT_EQ((Lines{"VL_WS_getEmailAddress, ret:0,responseCode:1", "VL_WS_getEmailAddress, ret:0,responseCode:0",
                   "getEmailAddress, answered from the cache", "VL_WS_getEmailAddress, ret:0,responseCode:0",
                   "VL_WS_getSettingsPageInfo, ret:0,responseCode:0", "getSettingsPageInfo, answered from the cache",
                   "VL_WS_getSettingsPageInfo, ret:0,responseCode:0"}),
            TakeLog());

  // A new authorisation drops them.
  EXPECT_EQ(VL_WS_OK, Call(VL_WS_authorizeDevice, kPinNumber));
  ASSERT_EQ(VL_WS_OK, Call(VL_WS_getEmailAddress));
  EXPECT_EQ(5u, Requests(5).size());
}

TEST_F(Account, DispatchedOperationsFollowTheAccessTypeOfTheHandle) {
  // Eighteen operations that both account services offer, each called once.
  const std::vector<std::pair<const char*, std::function<void()>>> operations = {
      {"authorizeDevice", [&] { Call(VL_WS_authorizeDevice, 9999); }},
      {"doPurchaseSavedbilling", [&] { Call(VL_WS_doPurchaseSavedBilling, 1, "192.0.2.17", false); }},
      {"checkRentalExpiration", [&] { Call(VL_WS_checkRentalExpiration, 1); }},
      {"getBillingInfo", [&] { Call(VL_WS_getBillingInfo); }},
      {"showPrePaidCardBalance", [&] { Call(VL_WS_getPrePaidCardBalance); }},
      {"getEmailAddress", [&] { Call(VL_WS_getEmailAddress); }},
      {"getSettingsPageInfo", [&] { Call(VL_WS_getSettingsPageInfo); }},
      {"assignGiftCertificateToUser", [&] { Call(VL_WS_assignGiftCertificateToUser, "GIFT-NONE"); }},
      {"getWishlistItems", [&] { Call(VL_WS_getWishlistItems, VL_WS_SORT_0, 1, 10, 0); }},
      {"removeItemFromWishList", [&] { Call(VL_WS_removeItemFromWishlist, 1001); }},
      {"removeAllItemsFromWishList", [&] { Call(VL_WS_removeAllItemsFromWishlist); }},
      {"addItemToWishlist", [&] { Call(VL_WS_addItemToWishlist, 1001); }},
      {"checkAdultVerificationEnabled", [&] { Call(VL_WS_checkAdultVerificationEnabled); }},
      {"checkAdultVerificationPin", [&] { Call(VL_WS_checkAdultVerificationPin, 7); }},
      {"getConfig", [&] { Call(VL_WS_getConfig); }},
      {"checkAuthToken", [&] { Call(VL_WS_checkAuthToken); }},
      {"GetCountryID", [&] { Call(VL_WS_getCountryID); }},
      {"deactivateDevice", [&] { Call(VL_WS_deactivateDevice); }},
  };
  struct {
    VL_WS_AccessType given;
    int storeType;  // what the store answers to a handle that asks
    const char* service;
    const char* settings;
  } cases[] = {
      {DOWNLOAD, STREAM, "DownloadAPI", "VL1:DownloadDeviceRequestSettings"},
      {STREAM, DOWNLOAD, "StreamAPI", "VL1:StreamDeviceRequestSettings"},
      {UNKNOWN, UNKNOWN, "StreamAPI", "VL1:StreamDeviceRequestSettings"},
  };
  for (const auto& c : cases) {
    SCOPED_TRACE(c.service);
    m_Sim.Store().SetAccessType(c.storeType);
    Init(c.given);
    m_Sim.Store().SetAccessType(STREAM);
    for (const auto& operation : operations) operation.second();
    std::vector<VLSimRequest> requests = Requests(operations.size());
    ASSERT_EQ(operations.size(), requests.size());
    for (size_t i = 0; i < operations.size(); ++i) {
      EXPECT_EQ(operations[i].first, requests[i].operation);
      EXPECT_EQ(c.service, requests[i].service) << requests[i].operation;
      EXPECT_EQ(c.settings, requests[i].settingsElement) << requests[i].operation;
    }
  }
}

}  // namespace
