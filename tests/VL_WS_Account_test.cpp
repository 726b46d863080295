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

// Calls an operation that fills a record of type Record and releases the record.
template <class Record, class Call>
VL_WS_Status CallAndRelease(Call call) {
  Record record;
  VL_WS_Status status = call(&record);
  VL_WS_release(&record);
  return status;
}

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

TEST_F(Account, AccountAnswersAreKeptAsUserData) {
  Init(STREAM, VL_WS_CacheParam::CACHE_USERDATA);
  Fault("getEmailAddress=code:1,times=1");
  VL_WS_EmailAddressResponse email;
  EXPECT_EQ(VL_WS_E_UNEXPECTED, VL_WS_getEmailAddress(&m_Handle, &email));
  VL_WS_release(&email);
  for (int i = 0; i < 2; ++i) {  // the refused answer was not kept; the next one is
    ASSERT_EQ(VL_WS_OK, VL_WS_getEmailAddress(&m_Handle, &email));
    EXPECT_STREQ("alice@example.com", email.EmailAddress);
    VL_WS_release(&email);
  }
  VL_WS_SettingsPageResponse settings;
  for (int i = 0; i < 2; ++i) {
    ASSERT_EQ(VL_WS_OK, VL_WS_getSettingsPageInfo(&m_Handle, &settings));
    EXPECT_STREQ("alice@example.com", settings.Account);
    EXPECT_STREQ("00-11-22-33-44-55", settings.DeviceID);
    VL_WS_release(&settings);
  }
  EXPECT_EQ(3u, Requests(3).size());
  EXPECT_EQ((std::vector<std::string>{
                "VL_WS_getEmailAddress, ret:0,responseCode:1", "VL_WS_getEmailAddress, ret:0,responseCode:0",
                "VL_WS_getEmailAddress, ret:0,responseCode:0", "VL_WS_getSettingsPageInfo, ret:0,responseCode:0",
                "VL_WS_getSettingsPageInfo, ret:0,responseCode:0"}),
            TakeLog());

  // A new authorisation drops them.
  EXPECT_EQ(VL_WS_OK, CallAndRelease<VL_WS_AuthorizeDeviceResponse>([&](VL_WS_AuthorizeDeviceResponse* r) {
              return VL_WS_authorizeDevice(&m_Handle, kPinNumber, r);
            }));
  ASSERT_EQ(VL_WS_OK, VL_WS_getEmailAddress(&m_Handle, &email));
  VL_WS_release(&email);
  EXPECT_EQ(5u, Requests(5).size());
}

TEST_F(Account, DispatchedOperationsFollowTheAccessTypeOfTheHandle) {
  // Eighteen operations that both account services offer, each called once.
  const std::vector<std::pair<const char*, std::function<void(VL_WS_Handle*)>>> operations = {
      {"authorizeDevice",
       [](VL_WS_Handle* h) {
         CallAndRelease<VL_WS_AuthorizeDeviceResponse>(
             [&](VL_WS_AuthorizeDeviceResponse* r) { return VL_WS_authorizeDevice(h, 9999, r); });
       }},
      {"doPurchaseSavedbilling",
       [](VL_WS_Handle* h) {
         CallAndRelease<VL_WS_PurchaseResponse>(
             [&](VL_WS_PurchaseResponse* r) { return VL_WS_doPurchaseSavedBilling(h, 1, "192.0.2.17", false, r); });
       }},
      {"checkRentalExpiration",
       [](VL_WS_Handle* h) {
         CallAndRelease<VL_WS_RentalExpirationResponse>(
             [&](VL_WS_RentalExpirationResponse* r) { return VL_WS_checkRentalExpiration(h, 1, r); });
       }},
      {"getBillingInfo",
       [](VL_WS_Handle* h) {
         CallAndRelease<VL_WS_BillingInfoResponse>(
             [&](VL_WS_BillingInfoResponse* r) { return VL_WS_getBillingInfo(h, r); });
       }},
      {"showPrePaidCardBalance",
       [](VL_WS_Handle* h) {
         CallAndRelease<VL_WS_PrePaidCardBalanceResponse>(
             [&](VL_WS_PrePaidCardBalanceResponse* r) { return VL_WS_getPrePaidCardBalance(h, r); });
       }},
      {"getEmailAddress",
       [](VL_WS_Handle* h) {
         CallAndRelease<VL_WS_EmailAddressResponse>(
             [&](VL_WS_EmailAddressResponse* r) { return VL_WS_getEmailAddress(h, r); });
       }},
      {"getSettingsPageInfo",
       [](VL_WS_Handle* h) {
         CallAndRelease<VL_WS_SettingsPageResponse>(
             [&](VL_WS_SettingsPageResponse* r) { return VL_WS_getSettingsPageInfo(h, r); });
       }},
      {"assignGiftCertificateToUser",
       [](VL_WS_Handle* h) {
         CallAndRelease<VL_WS_GiftCertificateResponse>(
             [&](VL_WS_GiftCertificateResponse* r) { return VL_WS_assignGiftCertificateToUser(h, "GIFT-NONE", r); });
       }},
      {"getWishlistItems",
       [](VL_WS_Handle* h) {
         CallAndRelease<VL_WS_WishlistItemsResponse>(
             [&](VL_WS_WishlistItemsResponse* r) { return VL_WS_getWishlistItems(h, VL_WS_SORT_0, 1, 10, 0, r); });
       }},
      {"removeItemFromWishList",
       [](VL_WS_Handle* h) {
         CallAndRelease<VL_WS_StandardResponse>(
             [&](VL_WS_StandardResponse* r) { return VL_WS_removeItemFromWishlist(h, 1001, r); });
       }},
      {"removeAllItemsFromWishList",
       [](VL_WS_Handle* h) {
         CallAndRelease<VL_WS_StandardResponse>(
             [&](VL_WS_StandardResponse* r) { return VL_WS_removeAllItemsFromWishlist(h, r); });
       }},
      {"addItemToWishlist",
       [](VL_WS_Handle* h) {
         CallAndRelease<VL_WS_StandardResponse>(
             [&](VL_WS_StandardResponse* r) { return VL_WS_addItemToWishlist(h, 1001, r); });
       }},
      {"checkAdultVerificationEnabled",
       [](VL_WS_Handle* h) {
         CallAndRelease<VL_WS_AdultVerificationEnabledResponse>(
             [&](VL_WS_AdultVerificationEnabledResponse* r) { return VL_WS_checkAdultVerificationEnabled(h, r); });
       }},
      {"checkAdultVerificationPin",
       [](VL_WS_Handle* h) {
         CallAndRelease<VL_WS_AdultVerificationPinResponse>(
             [&](VL_WS_AdultVerificationPinResponse* r) { return VL_WS_checkAdultVerificationPin(h, 7, r); });
       }},
      {"getConfig",
       [](VL_WS_Handle* h) {
         CallAndRelease<VL_WS_ConfigResponse>([&](VL_WS_ConfigResponse* r) { return VL_WS_getConfig(h, r); });
       }},
      {"checkAuthToken",
       [](VL_WS_Handle* h) {
         bool valid;
         VL_WS_checkAuthToken(h, &valid);
       }},
      {"GetCountryID",
       [](VL_WS_Handle* h) {
         int country;
         VL_WS_getCountryID(h, &country);
       }},
      {"deactivateDevice",
       [](VL_WS_Handle* h) {
         CallAndRelease<VL_WS_StandardResponse>(
             [&](VL_WS_StandardResponse* r) { return VL_WS_deactivateDevice(h, r); });
       }},
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
    for (const auto& operation : operations) operation.second(&m_Handle);
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
