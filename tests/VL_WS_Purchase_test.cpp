// Purchase operations against the store simulator: buying with the saved card or prepaid funds
// and what it does to the cached wishlist, the statuses of refused purchases, tax, gift
// certificates and balances, and the questions about purchased titles and rentals.
#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "VLTestAccountClient.h"

namespace {

using Lines = std::vector<std::string>;
// Response codes of the store and the statuses they give.
using Codes = std::vector<std::pair<int, VL_WS_Status>>;
const VL_WS_Status kOther = VL_WS_E_UNEXPECTED;  // a code without a row of its own

const char kIPAddress[] = "192.0.2.17";
const int kRentalSku = 10021;  // title 1002, rented for 48 hours, 2.99
const int kBuySku = 10012;     // title 1001, 19.99

class Purchase : public VLTestAccountClient {
 protected:
  void SetUp() override {
    VLTestAccountClient::SetUp();
    ResetAccount();
  }
  void TearDown() override {
    ResetAccount();
    VLTestAccountClient::TearDown();
  }
  void ResetAccount() {
    m_Sim.Store().RemoveAllPurchases(Account(), "alicepw");
    m_Sim.Store().SetPrepaidCents(Account(), 2500);
  }

  int PrepaidCents() {
    VLSimAccountData data;
    m_Sim.Store().Account(Account(), &data);
    return data.prepaidCents;
  }
  // Buys sku with the saved card or the prepaid funds; the new pass.
  int Buy(int sku, bool prepaid = false) {
    VLAnswer<VL_WS_PurchaseResponse> answer;
    EXPECT_EQ(VL_WS_OK, VL_WS_doPurchaseSavedBilling(&m_Handle, sku, kIPAddress, prepaid, answer.Fresh()));
    return answer->PassID;
  }
};

TEST_F(Purchase, MissingIPAddressOrPasswordIsRefusedBeforeAnyRequest) {
  Init();
  for (const char* ip : {static_cast<const char*>(nullptr), ""}) {
    VLAnswer<VL_WS_PurchaseResponse> answer;
    EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_doPurchaseSavedBilling(&m_Handle, kBuySku, ip, false, answer.Fresh()));
    EXPECT_EQ(VL_WS_TAG_PURCHASE_RESPONSE, *answer->tag);
    EXPECT_EQ(nullptr, answer->ResponseMessage);
  }
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, Call(VL_WS_removeAllMyPurchases, static_cast<const char*>(nullptr)));
  EXPECT_TRUE(RequestsNow().empty());
  EXPECT_TRUE(TakeLog().empty());
}

TEST_F(Purchase, PurchaseDropsTheCachedWishlist) {
  Init(STREAM, 7);
  ASSERT_TRUE(Cache().WriteUserData("getWishlistItems", "0,1,10,0", "a cached page"));
  ASSERT_TRUE(Cache().WriteUserData("getEmailAddress", "", "an e-mail answer"));
  ASSERT_TRUE(Cache().WriteWishlistFlag(1001, true));

  VLAnswer<VL_WS_PurchaseResponse> answer;
  ASSERT_EQ(VL_WS_OK, VL_WS_doPurchaseSavedBilling(&m_Handle, kBuySku, kIPAddress, false, answer.Fresh()));
  EXPECT_LT(0, answer->PassID);
  EXPECT_LT(0, answer->TransactionId);
  EXPECT_STRNE("", answer->TransactionAuthNum);
  EXPECT_EQ(2500, PrepaidCents());  // "no": the saved card paid

  VLString value;
  bool flag = false;
  EXPECT_FALSE(Cache().ReadUserData("getWishlistItems", "0,1,10,0", value));
  EXPECT_FALSE(Cache().ReadWishlistFlag(1001, flag));
  EXPECT_TRUE(Cache().ReadUserData("getEmailAddress", "", value));
  EXPECT_EQ(Lines{"VL_WS_doPurchaseSavedBilling, ret:0,responseCode:0"}, TakeLog());

  Buy(kRentalSku, true);  // "yes": the prepaid funds pay
  EXPECT_EQ(2500 - 299, PrepaidCents());
}

TEST_F(Purchase, RefusedPurchasesHaveTheirOwnStatuses) {
  Init(STREAM, 7);
  Buy(kBuySku);
  ASSERT_TRUE(Cache().WriteWishlistFlag(1001, true));
  VLAnswer<VL_WS_PurchaseResponse> answer;
  EXPECT_EQ(VL_WS_E_PURCHASE_3, VL_WS_doPurchaseSavedBilling(&m_Handle, kBuySku, kIPAddress, false, answer.Fresh()));
  EXPECT_EQ(3, answer->ResponseCode);
  EXPECT_STREQ("The title is already owned", answer->ResponseMessage);

  // The operation's own row of the status table (the table itself is the code's), and a code
  // without one.
  const Codes codes = {{1, -1007}, {21, -1021}, {23, kOther}};
  for (const auto& c : codes) {
    SCOPED_TRACE(c.first);
    Fault("doPurchaseSavedbilling=code:" + std::to_string(c.first) + ",times=1");
    EXPECT_EQ(c.second, VL_WS_doPurchaseSavedBilling(&m_Handle, kRentalSku, kIPAddress, false, answer.Fresh()));
    EXPECT_EQ(c.first, answer->ResponseCode);
  }
  bool flag = false;
  EXPECT_TRUE(Cache().ReadWishlistFlag(1001, flag));  // a refusal changes nothing
}

TEST_F(Purchase, TaxOfAnOrder) {
  Init();
  const Codes codes = {{1, -1023}, {11, -1026}, {4, kOther}};
  for (const auto& c : codes) {
    Fault("calcOrderTax=code:" + std::to_string(c.first) + ",times=1");
    EXPECT_EQ(c.second, Call(VL_WS_calcOrderTax, kBuySku)) << "code " << c.first;
  }
  EXPECT_TRUE(TakeLog().empty());
}

TEST_F(Purchase, BalanceAndGiftCertificateRefusals) {
  Init();
  VLAnswer<VL_WS_BillingInfoAndPPCBalance> info;
  ASSERT_EQ(VL_WS_OK, VL_WS_getBillingInfoAndPPCBalance(&m_Handle, info.Fresh()));
  EXPECT_EQ(VL_WS_TAG_BILLING_INFO_RESPONSE, *info->BillingInfo.tag);
  Fault("getBillingInfoAndPPCBalance=code:2,times=1");
  EXPECT_EQ(VL_WS_E_UNEXPECTED, Call(VL_WS_getBillingInfoAndPPCBalance));

  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, Call(VL_WS_assignGiftCertificateToUser, ""));
}

TEST_F(Purchase, RentalsCountDownAndPassListsNeedPasses) {
  Init();
  const int pass = Buy(kRentalSku);

  // Just rented, and 30 hours later.
  for (int hoursLeft : {48, 18}) {
    VLAnswer<VL_WS_RentalExpirationResponse> rental;
    m_Sim.Store().AdvanceClock((48 - hoursLeft) * 3600);
    ASSERT_EQ(VL_WS_OK, VL_WS_checkRentalExpiration(&m_Handle, pass, rental.Fresh()));
    m_Sim.Store().AdvanceClock(-(48 - hoursLeft) * 3600);
    EXPECT_EQ(hoursLeft < 48, rental->ShouldDisplay);
    EXPECT_EQ(hoursLeft, rental->HoursRemaining);
  }

  const int passes[] = {pass, 999999};
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, Call(VL_WS_getTitleListingPurchaseds, 0, passes));
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, Call(VL_WS_getTitleListingPurchaseds, 2, static_cast<const int*>(nullptr)));

  EXPECT_EQ((Lines{"VL_WS_doPurchaseSavedBilling, ret:0,responseCode:0", "VL_WS_checkRentalExpiration, ret:0,responseCode:0",
                   "VL_WS_checkRentalExpiration, ret:0,responseCode:0"}),
            TakeLog());
}

TEST_F(Purchase, PurchasedTitleFollowsTheStoresFileType) {
  Init(STREAM);
  bool purchased = true;
  EXPECT_EQ(VL_WS_OK, VL_WS_checkForPurchasedTitle(&m_Handle, 1002, &purchased));
  EXPECT_FALSE(purchased);
  m_Sim.Store().SetAccessType(DOWNLOAD);
  EXPECT_EQ(VL_WS_OK, Call(VL_WS_getFileType));
  m_Sim.Store().SetAccessType(STREAM);
  EXPECT_EQ(VL_WS_OK, VL_WS_checkForPurchasedTitle(&m_Handle, 1002, &purchased));
  EXPECT_EQ(VL_WS_OK, Call(VL_WS_getPrePaidCardBalance));  // a dispatched operation keeps its service

  std::vector<VLSimRequest> requests = Requests(4);
  ASSERT_EQ(4u, requests.size());
  EXPECT_EQ("StreamAPI", requests[0].service);
  EXPECT_EQ("checkForPurchasedStreamByTitleID", requests[0].operation);
  EXPECT_EQ("DownloadAPI", requests[2].service);
  EXPECT_EQ("checkForPurchasedTitle", requests[2].operation);
  EXPECT_EQ("StreamAPI", requests[3].service);
}

TEST_F(Purchase, BillingInfoIsKeptAndHasItsOwnStatuses) {
  Init(STREAM, VL_WS_CacheParam::CACHE_USERDATA);
  const Codes codes = {{1, -1008}, {4, -1012}, {5, kOther}};
  VLAnswer<VL_WS_BillingInfoResponse> info;
  for (const auto& c : codes) {
    SCOPED_TRACE(c.first);
    Fault("getBillingInfo=code:" + std::to_string(c.first) + ",times=1");
    EXPECT_EQ(c.second, VL_WS_getBillingInfo(&m_Handle, info.Fresh()));
    EXPECT_EQ(c.first, info->ResponseCode);
  }
  for (int i = 0; i < 2; ++i) {  // the second from the cache
    ASSERT_EQ(VL_WS_OK, VL_WS_getBillingInfo(&m_Handle, info.Fresh()));
    EXPECT_STREQ("Visa", info->CCType);
  }
  EXPECT_EQ(codes.size() + 1, Requests(codes.size() + 1).size());
}

TEST_F(Purchase, MyVideosAreKeptPerPurchaseType) {
  Init(STREAM, 7);
  const int pass = Buy(kRentalSku);
  Buy(kBuySku);
  VLAnswer<VL_WS_MyVideosResponse> videos;
  for (int i = 0; i < 2; ++i) {
    ASSERT_EQ(VL_WS_OK, VL_WS_getMyVideos(&m_Handle, 1, 10, 0, 0, 3, videos.Fresh()));  // rentals, any watch status
    ASSERT_EQ(1, videos->Titles.Count);
    EXPECT_EQ(pass, videos->Titles.Items[0].PassID);
    EXPECT_EQ(1002, videos->Titles.Items[0].TitleID);
    EXPECT_EQ(1, videos->TotalItems);
  }
  ASSERT_EQ(VL_WS_OK, VL_WS_getMyVideos(&m_Handle, 1, 10, 1, 0, 3, videos.Fresh()));  // another purchase type asks
  ASSERT_EQ(1, videos->Titles.Count);
  EXPECT_EQ(1001, videos->Titles.Items[0].TitleID);
  EXPECT_EQ(4u, Requests(4).size());
}

}  // namespace
