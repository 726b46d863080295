// Account operations against the store simulator: linking and unlinking the device and what it
// does to the token and the user data, the token check, the account's settings and the store's
// configuration, the adult-content PIN, and the routing of the dispatched operations by access
// type.
#include <gtest/gtest.h>

#include <functional>
#include <string>
#include <vector>

#include "VLTestAccountClient.h"

namespace {

class Account : public VLTestAccountClient {
 protected:
  // A user-data entry that shows whether the user data were purged.
  void MarkUserData() { ASSERT_TRUE(Cache().WriteWishlistFlag(4711, true)); }
  bool UserDataKept() {
    bool flag = false;
    return Cache().ReadWishlistFlag(4711, flag);
  }
};

TEST_F(Account, WrongPinKeepsTokenAndUserData) {
  Init(STREAM, 7);
  const std::string token = Settings().AuthToken.c_str();
  MarkUserData();
  VL_WS_AuthorizeDeviceResponse answer;
  EXPECT_EQ(VL_WS_E_AUTHORIZE_1, VL_WS_authorizeDevice(&m_Handle, 9999, &answer));
  EXPECT_EQ(1, answer.ResponseCode);
  EXPECT_STREQ("Wrong PIN", answer.ResponseMessage);
  EXPECT_STREQ("", answer.AuthToken);
  EXPECT_EQ(token, Settings().AuthToken.c_str());
  EXPECT_TRUE(UserDataKept());
  EXPECT_EQ(std::vector<std::string>{"VL_WS_authorizeDevice, ret:0,responseCode:1"}, TakeLog());
  VL_WS_release(&answer);

  Fault("authorizeDevice=code:2,times=1");
  EXPECT_EQ(VL_WS_E_AUTHORIZE_2, VL_WS_authorizeDevice(&m_Handle, kPinNumber, &answer));
  VL_WS_release(&answer);
  Fault("authorizeDevice=code:3,times=1");
  EXPECT_EQ(VL_WS_E_UNEXPECTED, VL_WS_authorizeDevice(&m_Handle, kPinNumber, &answer));
  VL_WS_release(&answer);
  EXPECT_EQ(token, Settings().AuthToken.c_str());
  EXPECT_TRUE(UserDataKept());
}

TEST_F(Account, AuthorisationReplacesTheTokenAndPurgesUserData) {
  Init(STREAM, 7);
  const std::string old = Settings().AuthToken.c_str();
  MarkUserData();
  VL_WS_AuthorizeDeviceResponse answer;
  ASSERT_EQ(VL_WS_OK, VL_WS_authorizeDevice(&m_Handle, kPinNumber, &answer));
  EXPECT_NE(old, answer.AuthToken);
  EXPECT_STREQ("alice@example.com", answer.EmailAddress);
  EXPECT_TRUE(answer.IsAdultVerificationEnabled);
  EXPECT_STREQ("00-11-22-33-44-55", answer.DeviceID);
  EXPECT_FALSE(UserDataKept());

  int country = 0;
  EXPECT_EQ(VL_WS_OK, VL_WS_getCountryID(&m_Handle, &country));
  EXPECT_EQ(1, country);
  std::vector<VLSimRequest> requests = Requests(2);
  ASSERT_EQ(2u, requests.size());
  EXPECT_EQ(old, requests[0].authToken);
  EXPECT_EQ("GetCountryID", requests[1].operation);
  EXPECT_EQ(answer.AuthToken, requests[1].authToken);
  EXPECT_EQ((std::vector<std::string>{"VL_WS_authorizeDevice, ret:0,responseCode:0",
                                      "VL_WS_getCountryID, ret:0,countryid:1"}),
            TakeLog());
  VL_WS_release(&answer);
}

TEST_F(Account, DeactivationEmptiesTheToken) {
  Init(STREAM, 7);
  MarkUserData();
  VL_WS_StandardResponse answer;
  ASSERT_EQ(VL_WS_OK, VL_WS_deactivateDevice(&m_Handle, &answer));
  EXPECT_TRUE(Settings().AuthToken.empty());
  EXPECT_FALSE(UserDataKept());
  VL_WS_release(&answer);

  // The store no longer knows the device: the next request carries an empty token.
  EXPECT_EQ(VL_WS_E_UNEXPECTED, VL_WS_deactivateDevice(&m_Handle, &answer));
  EXPECT_EQ(1, answer.ResponseCode);
  std::vector<VLSimRequest> requests = Requests(2);
  ASSERT_EQ(2u, requests.size());
  EXPECT_TRUE(requests[1].hasAuthToken);
  EXPECT_EQ("", requests[1].authToken);
  VL_WS_release(&answer);
}

TEST_F(Account, TokenCheckPurgesUserDataWhenTheAnswerChanges) {
  Init(STREAM, 7);
  MarkUserData();
  bool valid = false;
  ASSERT_EQ(VL_WS_OK, VL_WS_checkAuthToken(&m_Handle, &valid));
  EXPECT_TRUE(valid);
  EXPECT_TRUE(Settings().AuthTokenValid);
  EXPECT_FALSE(UserDataKept());  // a new handle starts from "not valid"

  MarkUserData();
  ASSERT_EQ(VL_WS_OK, VL_WS_checkAuthToken(&m_Handle, &valid));
  EXPECT_TRUE(valid);
  EXPECT_TRUE(UserDataKept());

  Settings().AuthToken = "SIMTOKEN-UNKNOWN";
  ASSERT_EQ(VL_WS_OK, VL_WS_checkAuthToken(&m_Handle, &valid));
  EXPECT_FALSE(valid);
  EXPECT_FALSE(Settings().AuthTokenValid);
  EXPECT_FALSE(UserDataKept());
  EXPECT_EQ((std::vector<std::string>{"VL_WS_checkAuthToken, result:1", "VL_WS_checkAuthToken, result:1",
                                      "VL_WS_checkAuthToken, result:0"}),
            TakeLog());

  // A failed check changes nothing.
  MarkUserData();
  Fault("checkAuthToken=status:503,times=1");
  valid = true;
  EXPECT_EQ(VL_WS_E_HTTP_STATUS(503), VL_WS_checkAuthToken(&m_Handle, &valid));
  EXPECT_FALSE(valid);
  EXPECT_TRUE(UserDataKept());
}

TEST_F(Account, ConfigurationItemsInTheStoresOrder) {
  Init();
  VL_WS_ConfigResponse config;
  ASSERT_EQ(VL_WS_OK, VL_WS_getConfig(&m_Handle, &config));
  std::vector<std::pair<std::string, std::string>> expected = m_Sim.Store().ConfigItems();
  ASSERT_EQ(static_cast<int>(expected.size()), config.Count);
  for (int i = 0; i < config.Count; ++i) {
    EXPECT_EQ(VL_WS_TAG_CONFIGURATION_ITEM, *config.Items[i].tag);
    EXPECT_EQ(expected[i].first, config.Items[i].Key);
    EXPECT_EQ(expected[i].second, config.Items[i].Value);
  }
  EXPECT_EQ(std::vector<std::string>{"VL_WS_getConfig, ret:0,responseCode:0"}, TakeLog());
  VL_WS_release(&config);

  Fault("getConfig=code:5,times=1");
  EXPECT_EQ(VL_WS_E_UNEXPECTED, VL_WS_getConfig(&m_Handle, &config));
  EXPECT_EQ(5, config.ResponseCode);
  VL_WS_release(&config);
}

TEST_F(Account, FailedCallsLeaveATaggedEmptyRecord) {
  Init();
  struct {
    const char* fault;
    VL_WS_Status status;
  } cases[] = {
      {"getConfig=soapfault", VL_WS_E_SOAP_FAULT(2)},
      {"getConfig=status:503", VL_WS_E_HTTP_STATUS(503)},
      {"getConfig=close", VL_WS_E_EOF},
  };
  for (const auto& c : cases) {
    SCOPED_TRACE(c.fault);
    m_Sim.ClearFaults();
    Fault(c.fault);
    VL_WS_ConfigResponse config;
    EXPECT_EQ(c.status, VL_WS_getConfig(&m_Handle, &config));
    ASSERT_NE(nullptr, config.tag);
    EXPECT_EQ(VL_WS_TAG_CONFIG_RESPONSE, *config.tag);
    EXPECT_EQ(0, config.Count);
    EXPECT_EQ(nullptr, config.ResponseMessage);
    EXPECT_EQ(VL_WS_OK, VL_WS_release(&config));
  }

  const size_t asked = Requests(3).size();
  VL_WS_Handle none = {};
  VL_WS_ConfigResponse config;
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

TEST_F(Account, AdultPinIsSentWithFourDigits) {
  Init();
  VL_WS_AdultVerificationEnabledResponse enabled;
  ASSERT_EQ(VL_WS_OK, VL_WS_checkAdultVerificationEnabled(&m_Handle, &enabled));
  EXPECT_TRUE(enabled.IsAdultVerificationEnabled);
  VL_WS_release(&enabled);

  VL_WS_AdultVerificationPinResponse answer;
  ASSERT_EQ(VL_WS_OK, VL_WS_checkAdultVerificationPin(&m_Handle, 7, &answer));  // the account's "0007"
  EXPECT_TRUE(answer.IsPinVerified);
  VL_WS_release(&answer);
  ASSERT_EQ(VL_WS_OK, VL_WS_checkAdultVerificationPin(&m_Handle, 70007, &answer));
  EXPECT_FALSE(answer.IsPinVerified);
  VL_WS_release(&answer);
}

TEST_F(Account, TestOperationsOfTheStreamingService) {
  Init(DOWNLOAD);
  VL_WS_StandardResponse answer;
  EXPECT_EQ(VL_WS_E_UNEXPECTED, VL_WS_returnError(&m_Handle, &answer));
  EXPECT_EQ(99, answer.ResponseCode);
  VL_WS_release(&answer);

  // The store holds its answer longer than the handle waits.
  m_Handle.client->m_StreamAPI.recv_timeout = 1;
  EXPECT_EQ(VL_WS_E_EOF, VL_WS_returnTimeout(&m_Handle, &answer));
  EXPECT_EQ(nullptr, answer.ResponseMessage);
  VL_WS_release(&answer);
  std::vector<VLSimRequest> requests = Requests(1);
  ASSERT_LE(1u, requests.size());
  EXPECT_EQ("StreamAPI", requests[0].service);
  EXPECT_TRUE(TakeLog().empty());
}

}  // namespace
