// Purchase operations against the store simulator: buying with the saved card or prepaid funds
// and what it does to the cached wishlist, the statuses of refused purchases, tax, gift
// certificates and balances, and the questions about purchased titles and rentals.
#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "VLTestAccountClient.h"

namespace {

const char kIPAddress[] = "192.0.2.17";
const int kRentalSku = 10021;  // title 1002, rented for 48 hours, 2.99
const int kBuySku = 10012;     // title 1001, 19.99

class Purchase : public VLTestAccountClient {
 protected:
  void SetUp() override {
    VLTestAccountClient::SetUp();
    m_Sim.Store().RemoveAllPurchases(Account(), "alicepw");
    m_Sim.Store().SetPrepaidCents(Account(), 2500);
  }
  void TearDown() override {
    m_Sim.Store().RemoveAllPurchases(Account(), "alicepw");
    m_Sim.Store().SetPrepaidCents(Account(), 2500);
    VLTestAccountClient::TearDown();
  }

  int PrepaidCents() {
    VLSimAccountData data;
    m_Sim.Store().Account(Account(), &data);
    return data.prepaidCents;
  }
  // Buys sku with the saved card; the new pass.
  int Buy(int sku) {
    VL_WS_PurchaseResponse answer;
    EXPECT_EQ(VL_WS_OK, VL_WS_doPurchaseSavedBilling(&m_Handle, sku, kIPAddress, false, &answer));
    int pass = answer.PassID;
    VL_WS_release(&answer);
    return pass;
  }
};

TEST_F(Purchase, MissingIPAddressIsRefusedBeforeAnyRequest) {
  Init();
  for (const char* ip : {static_cast<const char*>(nullptr), ""}) {
    VL_WS_PurchaseResponse answer;
    EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_doPurchaseSavedBilling(&m_Handle, kBuySku, ip, false, &answer));
    EXPECT_EQ(VL_WS_TAG_PURCHASE_RESPONSE, *answer.tag);
    EXPECT_EQ(nullptr, answer.ResponseMessage);
    VL_WS_release(&answer);
  }
  EXPECT_TRUE(RequestsNow().empty());
  EXPECT_TRUE(TakeLog().empty());
}

TEST_F(Purchase, PurchaseDropsTheCachedWishlist) {
  Init(STREAM, 7);
  ASSERT_TRUE(Cache().WriteUserData("getWishlistItems", "0,1,10,0", "a cached page"));
  ASSERT_TRUE(Cache().WriteUserData("getEmailAddress", "", "an e-mail answer"));
  ASSERT_TRUE(Cache().WriteWishlistFlag(1001, true));

  VL_WS_PurchaseResponse answer;
  ASSERT_EQ(VL_WS_OK, VL_WS_doPurchaseSavedBilling(&m_Handle, kBuySku, kIPAddress, false, &answer));
  EXPECT_LT(0, answer.PassID);
  EXPECT_LT(0, answer.TransactionId);
  EXPECT_STRNE("", answer.TransactionAuthNum);
  EXPECT_EQ(2500, PrepaidCents());  // "no": the saved card paid
  VL_WS_release(&answer);

  VLString value;
  bool flag = false;
  EXPECT_FALSE(Cache().ReadUserData("getWishlistItems", "0,1,10,0", value));
  EXPECT_FALSE(Cache().ReadWishlistFlag(1001, flag));
  EXPECT_TRUE(Cache().ReadUserData("getEmailAddress", "", value));
  EXPECT_EQ(std::vector<std::string>{"VL_WS_doPurchaseSavedBilling, ret:0,responseCode:0"}, TakeLog());

  // "yes": the prepaid funds pay.
  ASSERT_EQ(VL_WS_OK, VL_WS_doPurchaseSavedBilling(&m_Handle, kRentalSku, kIPAddress, true, &answer));
  EXPECT_EQ(2500 - 299, PrepaidCents());
  VL_WS_release(&answer);
}

TEST_F(Purchase, RefusedPurchasesHaveTheirOwnStatuses) {
  Init(STREAM, 7);
  Buy(kBuySku);
  ASSERT_TRUE(Cache().WriteWishlistFlag(1001, true));
  VL_WS_PurchaseResponse answer;
  EXPECT_EQ(VL_WS_E_PURCHASE_3, VL_WS_doPurchaseSavedBilling(&m_Handle, kBuySku, kIPAddress, false, &answer));
  EXPECT_EQ(3, answer.ResponseCode);
  EXPECT_STREQ("The title is already owned", answer.ResponseMessage);
  VL_WS_release(&answer);
  bool flag = false;
  EXPECT_TRUE(Cache().ReadWishlistFlag(1001, flag));  // a refusal changes nothing

  const std::vector<std::pair<int, VL_WS_Status>> codes = {
      {1, -1007},  {2, -1008},  {5, -1011},  {11, -1017}, {12, -1018}, {13, VL_WS_E_UNEXPECTED},
      {19, VL_WS_E_UNEXPECTED}, {20, -1028}, {21, -1021}, {22, -1022}, {23, VL_WS_E_UNEXPECTED}};
  for (const auto& c : codes) {
    SCOPED_TRACE(c.first);
    Fault("doPurchaseSavedbilling=code:" + std::to_string(c.first) + ",times=1");
    EXPECT_EQ(c.second, VL_WS_doPurchaseSavedBilling(&m_Handle, kRentalSku, kIPAddress, false, &answer));
    EXPECT_EQ(c.first, answer.ResponseCode);
    VL_WS_release(&answer);
  }
  EXPECT_TRUE(Cache().ReadWishlistFlag(1001, flag));
}

TEST_F(Purchase, TaxOfAnOrder) {
  Init();
  VL_WS_OrderTaxResponse tax;
  ASSERT_EQ(VL_WS_OK, VL_WS_calcOrderTax(&m_Handle, kBuySku, &tax));
  EXPECT_STREQ("19.99", tax.SubTotal);
  EXPECT_STRNE("", tax.Tax);
  EXPECT_STRNE("", tax.TotalPrice);
  VL_WS_release(&tax);

  const std::vector<std::pair<int, VL_WS_Status>> codes = {
      {1, -1023}, {2, -1024}, {3, -1025}, {4, VL_WS_E_UNEXPECTED}, {11, -1026}, {12, -1027}, {20, -1028},
      {21, VL_WS_E_UNEXPECTED}};
  for (const auto& c : codes) {
    SCOPED_TRACE(c.first);
    Fault("calcOrderTax=code:" + std::to_string(c.first) + ",times=1");
    EXPECT_EQ(c.second, VL_WS_calcOrderTax(&m_Handle, kBuySku, &tax));
    VL_WS_release(&tax);
  }
  EXPECT_EQ("StreamAPI", Requests(1)[0].service);
  EXPECT_TRUE(TakeLog().empty());
}

TEST_F(Purchase, BalancesAndGiftCertificates) {
  Init();
  VL_WS_BillingInfoAndPPCBalance info;
  ASSERT_EQ(VL_WS_OK, VL_WS_getBillingInfoAndPPCBalance(&m_Handle, &info));
  EXPECT_EQ(VL_WS_TAG_BILLING_INFO_RESPONSE, *info.BillingInfo.tag);
  EXPECT_STREQ("4242", info.BillingInfo.CCLastFour);
  EXPECT_EQ(1, info.BillingInfo.CCTypeId);
  EXPECT_STREQ("Visa", info.BillingInfo.CCType);
  EXPECT_EQ(2500, info.PPCardBalance.Balance);
  VL_WS_release(&info);
  Fault("getBillingInfoAndPPCBalance=code:2,times=1");
  EXPECT_EQ(VL_WS_E_UNEXPECTED, VL_WS_getBillingInfoAndPPCBalance(&m_Handle, &info));
  VL_WS_release(&info);

  VL_WS_GiftCertificateResponse gift;
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_assignGiftCertificateToUser(&m_Handle, "", &gift));
  VL_WS_release(&gift);
  EXPECT_EQ(VL_WS_E_GIFT_CERTIFICATE_1, VL_WS_assignGiftCertificateToUser(&m_Handle, "GIFT-NONE", &gift));
  VL_WS_release(&gift);
  ASSERT_EQ(VL_WS_OK, VL_WS_assignGiftCertificateToUser(&m_Handle, "GIFT-0500", &gift));
  EXPECT_EQ(3000, gift.Balance);
  VL_WS_release(&gift);
  EXPECT_EQ(VL_WS_E_GIFT_CERTIFICATE_2, VL_WS_assignGiftCertificateToUser(&m_Handle, "GIFT-0500", &gift));
  VL_WS_release(&gift);

  VL_WS_PrePaidCardBalanceResponse balance;
  ASSERT_EQ(VL_WS_OK, VL_WS_getPrePaidCardBalance(&m_Handle, &balance));
  EXPECT_EQ(3000, balance.Balance);
  VL_WS_release(&balance);
  EXPECT_EQ((std::vector<std::string>{"VL_WS_assignGiftCertificateToUser, ret:0,responseCode:1",
                                      "VL_WS_assignGiftCertificateToUser, ret:0,responseCode:0",
                                      "VL_WS_assignGiftCertificateToUser, ret:0,responseCode:2",
                                      "VL_WS_getPrePaidCardBalance, ret:0,responseCode:0"}),
            TakeLog());
}

TEST_F(Purchase, PurchasedTitlesAndRentals) {
  Init();
  const int pass = Buy(kRentalSku);
  bool purchased = false;
  EXPECT_EQ(VL_WS_OK, VL_WS_checkForPurchasedTitle(&m_Handle, 1002, &purchased));
  EXPECT_TRUE(purchased);
  EXPECT_EQ(VL_WS_OK, VL_WS_checkForPurchasedSku(&m_Handle, kRentalSku, &purchased));
  EXPECT_TRUE(purchased);
  EXPECT_EQ(VL_WS_OK, VL_WS_checkForPurchasedSku(&m_Handle, kRentalSku + 1, &purchased));
  EXPECT_FALSE(purchased);

  VL_WS_RentalExpirationResponse rental;
  ASSERT_EQ(VL_WS_OK, VL_WS_checkRentalExpiration(&m_Handle, pass, &rental));
  EXPECT_FALSE(rental.ShouldDisplay);
  EXPECT_EQ(48, rental.HoursRemaining);
  VL_WS_release(&rental);
  m_Sim.Store().AdvanceClock(30 * 3600);
  ASSERT_EQ(VL_WS_OK, VL_WS_checkRentalExpiration(&m_Handle, pass, &rental));
  m_Sim.Store().AdvanceClock(-30 * 3600);
  EXPECT_TRUE(rental.ShouldDisplay);
  EXPECT_EQ(18, rental.HoursRemaining);
  VL_WS_release(&rental);

  const int passes[] = {pass, 999999};
  VL_WS_TitleListingPurchasedForPassArray titles;
  ASSERT_EQ(VL_WS_OK, VL_WS_getTitleListingPurchaseds(&m_Handle, 2, passes, &titles));
  ASSERT_EQ(2, titles.Count);
  EXPECT_EQ(0, titles.Items[0].ResponseCode);
  EXPECT_EQ(1002, titles.Items[0].TitleID);
  EXPECT_EQ(pass, titles.Items[0].PassID);
  EXPECT_EQ(2, titles.Items[1].ResponseCode);
  VL_WS_release(&titles);
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_getTitleListingPurchaseds(&m_Handle, 0, passes, &titles));
  VL_WS_release(&titles);
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_getTitleListingPurchaseds(&m_Handle, 2, nullptr, &titles));
  VL_WS_release(&titles);

  EXPECT_EQ((std::vector<std::string>{"VL_WS_doPurchaseSavedBilling, ret:0,responseCode:0",
                                      "VL_WS_checkForPurchasedTitle, result:1", "VL_WS_checkForPurchasedSku, result:1",
                                      "VL_WS_checkForPurchasedSku, result:0",
                                      "VL_WS_checkRentalExpiration, ret:0,responseCode:0",
                                      "VL_WS_checkRentalExpiration, ret:0,responseCode:0"}),
            TakeLog());
}

TEST_F(Purchase, PurchasedTitleFollowsTheStoresFileType) {
  Init(STREAM);
  bool purchased = true;
  EXPECT_EQ(VL_WS_OK, VL_WS_checkForPurchasedTitle(&m_Handle, 1002, &purchased));
  EXPECT_FALSE(purchased);
  m_Sim.Store().SetAccessType(DOWNLOAD);
  VL_WS_FileType type;
  EXPECT_EQ(VL_WS_OK, VL_WS_getFileType(&m_Handle, &type));
  m_Sim.Store().SetAccessType(STREAM);
  VL_WS_release(&type);
  EXPECT_EQ(VL_WS_OK, VL_WS_checkForPurchasedTitle(&m_Handle, 1002, &purchased));
  VL_WS_PrePaidCardBalanceResponse balance;  // a dispatched operation keeps its service
  EXPECT_EQ(VL_WS_OK, VL_WS_getPrePaidCardBalance(&m_Handle, &balance));
  VL_WS_release(&balance);

  std::vector<VLSimRequest> requests = Requests(4);
  ASSERT_EQ(4u, requests.size());
  EXPECT_EQ("StreamAPI", requests[0].service);
  EXPECT_EQ("checkForPurchasedStreamByTitleID", requests[0].operation);
  EXPECT_EQ("DownloadAPI", requests[2].service);
  EXPECT_EQ("checkForPurchasedTitle", requests[2].operation);
  EXPECT_EQ("StreamAPI", requests[3].service);
}

TEST_F(Purchase, RemovingAllPurchasesNeedsThePassword) {
  Init();
  Buy(kBuySku);
  VL_WS_StandardResponse answer;
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_removeAllMyPurchases(&m_Handle, nullptr, &answer));
  VL_WS_release(&answer);
  EXPECT_EQ(VL_WS_E_UNEXPECTED, VL_WS_removeAllMyPurchases(&m_Handle, "wrong", &answer));
  EXPECT_EQ(2, answer.ResponseCode);
  VL_WS_release(&answer);
  EXPECT_EQ(VL_WS_OK, VL_WS_removeAllMyPurchases(&m_Handle, "alicepw", &answer));
  VL_WS_release(&answer);
  bool purchased = true;
  EXPECT_EQ(VL_WS_OK, VL_WS_checkForPurchasedSku(&m_Handle, kBuySku, &purchased));
  EXPECT_FALSE(purchased);
}

}  // namespace
