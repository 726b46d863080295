// The simulator's SOAP services over real TLS: what it checks before an operation runs, the
// paging arithmetic, per-account wishlist and purchase state, the SOAP-level faults and the
// request log that client tests read.
#include <gtest/gtest.h>

#include "VLSimServer.h"
#include "VLSimTestClient.h"
#include "VLStoreHosts.h"

namespace {

class SimulatorSoap : public testing::Test {
 protected:
  void SetUp() override {
    std::string error;
    ASSERT_TRUE(m_Sim.Start(&error)) << error;
  }

  template <typename Request, typename Response>
  int Call(VLSimSoapExchange& exchange, const VLSimSoapCall& call, const char* operation, Request* request,
           Response* response) {
    return exchange.Run(m_Sim.TlsPort(), m_Sim.CAFile(), call, operation, request, response);
  }

  static VLSimSoapCall Stream(const std::string& token, const std::string& device = "00-11-22-33-44-55") {
    VLSimSoapCall call;
    call.path = "/api/StreamAPI.asmx";
    call.settingsElement = "StreamDeviceRequestSettings";
    call.token = token;
    call.deviceId = device;
    return call;
  }

  // Authorises a device with an account's PIN and returns the new token.
  std::string Authorize(int pin, const std::string& device = "00-11-22-33-44-55") {
    VLSimSoapExchange exchange;
    _VL1__authorizeDevice request;
    request.Pin = pin;
    _VL1__authorizeDeviceResponse response;
    EXPECT_EQ(SOAP_OK, Call(exchange, Stream("", device), "authorizeDevice", &request, &response));
    if (!response.authorizeDeviceResult || response.authorizeDeviceResult->ResponseCode != 0) return "";
    return response.authorizeDeviceResult->AuthToken;
  }

  // A page of a genre's titles.
  void GenrePage(VLSimSoapExchange& exchange, int genre, int page, int itemsPerPage, int purchaseType,
                 _VL1__getTitlesByNavigationResponse* response) {
    _VL1__getTitlesByNavigation request;
    request.GenreID = genre;
    request.CurrentPageNumber = page;
    request.ItemsPerPage = itemsPerPage;
    request.PurchaseType = static_cast<VL1__StreamAPIPurchaseType>(purchaseType);
    ASSERT_EQ(SOAP_OK, Call(exchange, VLSimSoapCall(), "getTitlesByNavigation", &request, response));
    ASSERT_NE(nullptr, response->getTitlesByNavigationResult);
  }

  VLSimServer m_Sim;
};

// ---- What the store checks before an operation ----

TEST_F(SimulatorSoap, AcceptsTheClientRuntimesUsernameTokenDigest) {
  VLSimSoapExchange exchange;
  _VL1__getNavigation request;
  _VL1__getNavigationResponse response;
  ASSERT_EQ(SOAP_OK, Call(exchange, VLSimSoapCall(), "getNavigation", &request, &response)) << exchange.reply.raw;
  ASSERT_NE(nullptr, response.getNavigationResult);
  ASSERT_NE(nullptr, response.getNavigationResult->Genres);
  EXPECT_EQ(static_cast<int>(m_Sim.Catalogue().Genres().size()), response.getNavigationResult->Genres->__sizeGenre);
  EXPECT_EQ(200, exchange.reply.status);
  EXPECT_EQ("ok", m_Sim.Requests().back().authentication);
}

TEST_F(SimulatorSoap, RefusesWrongStaleFutureAndReplayedDigests) {
  struct Case {
    const char* name;
    VLSimSoapCall call;
    const char* reason;
  } cases[] = {{"wrong password", VLSimSoapCall(), "wrong password digest"},
               {"stale", VLSimSoapCall(), "stale wsu:Created"},
               {"future", VLSimSoapCall(), "wsu:Created in the future"},
               {"unknown user", VLSimSoapCall(), "unknown user name"},
               {"just inside the skew", VLSimSoapCall(), "ok"}};
  cases[0].call.password = "guessed";
  cases[1].call.created = time(nullptr) - 400;  // the skew is 300 s: margins for a loaded machine
  cases[2].call.created = time(nullptr) + 400;
  cases[3].call.user = "somebody";
  cases[4].call.created = time(nullptr) - 200;
  for (const Case& c : cases) {
    SCOPED_TRACE(c.name);
    VLSimSoapExchange exchange;
    _VL1__getNavigation request;
    _VL1__getNavigationResponse response;
    int error = Call(exchange, c.call, "getNavigation", &request, &response);
    EXPECT_EQ(c.reason, m_Sim.Requests().back().authentication);
    if (std::string(c.reason) == "ok") {
      EXPECT_EQ(SOAP_OK, error);
    } else {
      EXPECT_EQ(500, exchange.reply.status);
      EXPECT_EQ(SOAP_FAULT, error);  // faultcode wsse:FailedAuthentication
      EXPECT_NE(std::string::npos, exchange.reply.body.find("FailedAuthentication"));
      EXPECT_EQ(nullptr, response.getNavigationResult);
    }
  }

  // The same request bytes a second time: the nonce was used.
  VLSimSoapCall call;
  _VL1__getNavigation request;
  std::string bytes = VLSimSoapRequest(call, "getNavigation", &request);
  EXPECT_EQ(200, VLSimExchange(m_Sim.TlsPort(), m_Sim.CAFile(), call.host, bytes).status);
  EXPECT_EQ(500, VLSimExchange(m_Sim.TlsPort(), m_Sim.CAFile(), call.host, bytes).status);
  EXPECT_EQ("replayed nonce", m_Sim.Requests().back().authentication);
}

TEST_F(SimulatorSoap, NeedsTheSettingsBlockOfTheServiceWithTheApiKeyAndAMatchingAction) {
  struct Case {
    const char* name;
    std::string path, element, apiKey, action;
    bool accepted;
  } cases[] = {
      {"browse with its block", "/api/RealTimeBrowse.asmx", "DeviceSettings", "VLSIM-API-KEY", "", true},
      {"browse with the stream block", "/api/RealTimeBrowse.asmx", "StreamDeviceRequestSettings", "VLSIM-API-KEY", "", false},
      {"stream with its block", "/api/StreamAPI.asmx", "StreamDeviceRequestSettings", "VLSIM-API-KEY", "", true},
      {"download with its block", "/api/DownloadAPI.asmx", "DownloadDeviceRequestSettings", "VLSIM-API-KEY", "", true},
      {"download without a block", "/api/DownloadAPI.asmx", "", "VLSIM-API-KEY", "", false},
      {"wrong API key", "/api/StreamAPI.asmx", "StreamDeviceRequestSettings", "OTHER", "", false},
      {"action of another operation", "/api/StreamAPI.asmx", "StreamDeviceRequestSettings", "VLSIM-API-KEY",
       VL_API_NAMESPACE "getEmailAddress", false},
  };
  for (const Case& c : cases) {
    SCOPED_TRACE(c.name);
    VLSimSoapCall call;
    call.path = c.path;
    call.settingsElement = c.element;
    call.apiKey = c.apiKey;
    call.soapAction = c.action;
    VLSimSoapExchange exchange;
    _VL1__getConfig request;
    _VL1__getConfigResponse response;
    int error = Call(exchange, call, "getConfig", &request, &response);
    if (c.path == "/api/RealTimeBrowse.asmx" && c.accepted) {
      EXPECT_EQ(SOAP_CLI_FAULT, error) << "the browse service has no getConfig";
      EXPECT_NE(std::string::npos, exchange.FaultString().find("not implemented")) << exchange.FaultString();
      continue;
    }
    EXPECT_EQ(c.accepted ? SOAP_OK : SOAP_CLI_FAULT, error) << exchange.reply.body;
    EXPECT_EQ(c.accepted, response.getConfigResult != nullptr);
  }
}

// ---- Paging ----

TEST_F(SimulatorSoap, PagesCountTotalPagesAndEndWithAPartialPage) {
  const int total = static_cast<int>(m_Sim.Catalogue().TitlesInGenre(1).size());
  ASSERT_GT(total, 100);
  ASSERT_NE(0, total % 7) << "choose a page size that leaves a partial last page";
  const int pages = (total + 6) / 7;
  std::vector<int> seen;
  for (int page = 1; page <= pages + 1; ++page) {
    VLSimSoapExchange exchange;
    _VL1__getTitlesByNavigationResponse response;
    GenrePage(exchange, 1, page, 7, 2, &response);
    const VL1__GetTitlesResponse& result = *response.getTitlesByNavigationResult;
    EXPECT_EQ(0, result.ResponseCode);
    EXPECT_EQ(total, result.TotalItems);
    EXPECT_EQ(pages, result.TotalPages);
    EXPECT_EQ(page, result.CurrentPageNumber);
    int expected = page < pages ? 7 : page == pages ? total % 7 : 0;
    ASSERT_NE(nullptr, result.Titles);
    ASSERT_EQ(expected, result.Titles->__sizeTitleListing) << "page " << page;
    for (int i = 0; i < expected; ++i) {
      EXPECT_EQ((page - 1) * 7 + i + 1, result.Titles->TitleListing[i]->TitlePosition);
      seen.push_back(result.Titles->TitleListing[i]->TitleID);
    }
  }
  std::sort(seen.begin(), seen.end());
  EXPECT_EQ(seen.end(), std::unique(seen.begin(), seen.end())) << "no title on two pages";
  EXPECT_EQ(static_cast<size_t>(total), seen.size());
}

TEST_F(SimulatorSoap, PurchaseTypeFiltersTitlesAndProductsAndBadPagingGetsACode) {
  VLSimSoapExchange rent, any, zero, unknown;
  _VL1__getTitlesByNavigationResponse rentPage, anyPage, zeroPage, unknownPage;
  GenrePage(rent, 1, 1, 500, 0, &rentPage);
  GenrePage(any, 1, 1, 500, 2, &anyPage);
  EXPECT_LT(rentPage.getTitlesByNavigationResult->TotalItems, anyPage.getTitlesByNavigationResult->TotalItems);
  const VL1__ArrayOfTitleListing& titles = *rentPage.getTitlesByNavigationResult->Titles;
  for (int i = 0; i < titles.__sizeTitleListing; ++i) {
    const VL1__ArrayOfProductListing& products = *titles.TitleListing[i]->AvailableProducts;
    ASSERT_GT(products.__sizeProductListing, 0);
    for (int p = 0; p < products.__sizeProductListing; ++p)
      EXPECT_EQ(VL1__StreamAPIPurchaseType__rent, products.ProductListing[p]->PurchaseType);
  }
  GenrePage(zero, 1, 1, 0, 2, &zeroPage);
  EXPECT_EQ(3, zeroPage.getTitlesByNavigationResult->ResponseCode);
  GenrePage(unknown, 4711, 1, 10, 2, &unknownPage);
  EXPECT_EQ(2, unknownPage.getTitlesByNavigationResult->ResponseCode);
}

// ---- Accounts, wishlists and purchases ----

TEST_F(SimulatorSoap, TokensAuthoriseTheirAccountOnTheirDeviceUntilDeactivated) {
  EXPECT_EQ("", Authorize(9999));
  std::string alice = Authorize(1234, "AA-AA-AA-AA-AA-AA");
  std::string bob = Authorize(5678, "BB-BB-BB-BB-BB-BB");
  ASSERT_FALSE(alice.empty());
  ASSERT_FALSE(bob.empty());
  EXPECT_NE(alice, bob);

  auto email = [this](const std::string& token, const std::string& device, std::string* address) {
    VLSimSoapExchange exchange;
    _VL1__getEmailAddress request;
    _VL1__getEmailAddressResponse response;
    EXPECT_EQ(SOAP_OK, Call(exchange, Stream(token, device), "getEmailAddress", &request, &response));
    *address = response.getEmailAddressResult->EmailAddress ? response.getEmailAddressResult->EmailAddress : "";
    return response.getEmailAddressResult->ResponseCode;
  };
  std::string address;
  EXPECT_EQ(0, email(alice, "AA-AA-AA-AA-AA-AA", &address));
  EXPECT_EQ("alice@example.com", address);
  EXPECT_EQ(0, email(bob, "BB-BB-BB-BB-BB-BB", &address));
  EXPECT_EQ("bob@example.com", address);
  EXPECT_EQ(1, email(alice, "BB-BB-BB-BB-BB-BB", &address)) << "a token belongs to its device";
  EXPECT_EQ(1, email("", "AA-AA-AA-AA-AA-AA", &address));
  EXPECT_EQ(1, email("forged", "AA-AA-AA-AA-AA-AA", &address));

  VLSimSoapExchange exchange;
  _VL1__deactivateDevice request;
  _VL1__deactivateDeviceResponse response;
  ASSERT_EQ(SOAP_OK, Call(exchange, Stream(alice, "AA-AA-AA-AA-AA-AA"), "deactivateDevice", &request, &response));
  EXPECT_EQ(0, response.deactivateDeviceResult->ResponseCode);
  EXPECT_EQ(1, email(alice, "AA-AA-AA-AA-AA-AA", &address));
  EXPECT_EQ(0, email(bob, "BB-BB-BB-BB-BB-BB", &address));

  // Dave's account allows one device.
  EXPECT_FALSE(Authorize(1357, "D1-D1-D1-D1-D1-D1").empty());
  EXPECT_EQ("", Authorize(1357, "D2-D2-D2-D2-D2-D2"));
  EXPECT_FALSE(Authorize(1357, "D1-D1-D1-D1-D1-D1").empty()) << "the same device may authorise again";
}

TEST_F(SimulatorSoap, WishlistsAreKeptPerAccountAndListedInTheSortOrders) {
  std::string alice = Authorize(1234, "AA-AA-AA-AA-AA-AA");
  std::string bob = Authorize(5678, "BB-BB-BB-BB-BB-BB");
  const std::vector<VLSimTitle>& titles = m_Sim.Catalogue().Titles();
  auto add = [&](const std::string& token, const std::string& device, int title) {
    VLSimSoapExchange exchange;
    _VL1__addItemToWishlist request;
    request.TitleID = title;
    _VL1__addItemToWishlistResponse response;
    EXPECT_EQ(SOAP_OK, Call(exchange, Stream(token, device), "addItemToWishlist", &request, &response));
    return response.addItemToWishlistResult->ResponseCode;
  };
  auto list = [&](const std::string& token, const std::string& device, int sortOrder, int page, int perPage,
                  int* totalPages) {
    VLSimSoapExchange exchange;
    _VL1__getWishlistItems request;
    request.sortOrder = sortOrder;
    request.CurrentPageNumber = page;
    request.ItemsPerPage = perPage;
    _VL1__getWishlistItemsResponse response;
    EXPECT_EQ(SOAP_OK, Call(exchange, Stream(token, device), "getWishlistItems", &request, &response));
    std::vector<int> ids;
    const VL1__GetWishlistItemsResponse& result = *response.getWishlistItemsResult;
    *totalPages = result.TotalPages;
    for (int i = 0; result.Titles && i < result.Titles->__sizeTitleListingPurchased; ++i)
      ids.push_back(result.Titles->TitleListingPurchased[i]->TitleID);
    return ids;
  };
  int a = titles[5].id, b = titles[1].id, c = titles[9].id;
  EXPECT_EQ(0, add(alice, "AA-AA-AA-AA-AA-AA", a));
  EXPECT_EQ(0, add(alice, "AA-AA-AA-AA-AA-AA", b));
  EXPECT_EQ(0, add(alice, "AA-AA-AA-AA-AA-AA", c));
  EXPECT_EQ(0, add(alice, "AA-AA-AA-AA-AA-AA", b)) << "adding twice keeps one entry";
  EXPECT_EQ(2, add(alice, "AA-AA-AA-AA-AA-AA", 999999));
  EXPECT_EQ(1, add("", "AA-AA-AA-AA-AA-AA", a));
  EXPECT_EQ(0, add(bob, "BB-BB-BB-BB-BB-BB", c));

  int pages = 0;
  EXPECT_EQ((std::vector<int>{c, b, a}), list(alice, "AA-AA-AA-AA-AA-AA", 0, 1, 10, &pages));
  EXPECT_EQ((std::vector<int>{a, b, c}), list(alice, "AA-AA-AA-AA-AA-AA", 1, 1, 10, &pages));
  std::vector<int> byName = {a, b, c};
  std::sort(byName.begin(), byName.end(), [&](int x, int y) {
    return m_Sim.Catalogue().FindTitle(x)->name < m_Sim.Catalogue().FindTitle(y)->name;
  });
  EXPECT_EQ(byName, list(alice, "AA-AA-AA-AA-AA-AA", 2, 1, 10, &pages));
  EXPECT_EQ(std::vector<int>(byName.rbegin(), byName.rend()), list(alice, "AA-AA-AA-AA-AA-AA", 3, 1, 10, &pages));
  EXPECT_EQ((std::vector<int>{c}), list(alice, "AA-AA-AA-AA-AA-AA", 1, 2, 2, &pages)) << "the partial last page";
  EXPECT_EQ(2, pages);
  EXPECT_EQ((std::vector<int>{c}), list(bob, "BB-BB-BB-BB-BB-BB", 0, 1, 10, &pages));

  VLSimSoapExchange exchange;
  _VL1__removeAllItemsFromWishList request;
  _VL1__removeAllItemsFromWishListResponse response;
  ASSERT_EQ(SOAP_OK, Call(exchange, Stream(alice, "AA-AA-AA-AA-AA-AA"), "removeAllItemsFromWishList", &request, &response));
  EXPECT_TRUE(list(alice, "AA-AA-AA-AA-AA-AA", 0, 1, 10, &pages).empty());
  EXPECT_EQ(0, pages);
  EXPECT_EQ((std::vector<int>{c}), list(bob, "BB-BB-BB-BB-BB-BB", 0, 1, 10, &pages));

  // The title listing tells the calling account's wishlist.
  VLSimSoapCall browse;
  browse.token = bob;
  browse.deviceId = "BB-BB-BB-BB-BB-BB";
  VLSimSoapExchange listing;
  _VL1__getTitleListing titleRequest;
  titleRequest.TitleID = c;
  _VL1__getTitleListingResponse titleResponse;
  ASSERT_EQ(SOAP_OK, Call(listing, browse, "getTitleListing", &titleRequest, &titleResponse));
  EXPECT_EQ(true_, titleResponse.getTitleListingResult->IsAvailInUserWishList);
}

TEST_F(SimulatorSoap, PurchasesChargeTheRightFundsCreatePassesAndRefuseWithCodes) {
  std::string carol = Authorize(2468);  // no saved card, 800 cents prepaid
  auto buy = [&](int sku, bool prepaid, const char* ip, VL1__PurchaseResponse* out) {
    VLSimSoapExchange exchange;
    _VL1__doPurchaseSavedbilling request;
    request.SkuID = sku;
    std::string address = ip ? ip : "";
    request.IPAddress = ip ? &address[0] : nullptr;
    std::string yesNo = prepaid ? "yes" : "no";
    request.UsePrePaidFunds = &yesNo[0];
    _VL1__doPurchaseSavedbillingResponse response;
    EXPECT_EQ(SOAP_OK, Call(exchange, Stream(carol), "doPurchaseSavedbilling", &request, &response));
    if (out) *out = *response.doPurchaseSavedbillingResult;
    return response.doPurchaseSavedbillingResult->ResponseCode;
  };
  const VLSimCatalogue& catalogue = m_Sim.Catalogue();
  int cheapRent = 0, dearBuy = 0;
  for (const VLSimTitle& title : catalogue.Titles())
    for (int sku : title.products) {
      const VLSimProduct* product = catalogue.FindProduct(sku);
      if (!cheapRent && product->purchaseType == 0 && product->priceCents <= 800) cheapRent = sku;
      if (!dearBuy && product->purchaseType == 1 && product->priceCents > 800) dearBuy = sku;
    }
  ASSERT_NE(0, cheapRent);
  ASSERT_NE(0, dearBuy);

  EXPECT_EQ(2, buy(999999, true, "10.0.0.1", nullptr)) << "unknown SKU";
  EXPECT_EQ(6, buy(cheapRent, true, nullptr, nullptr)) << "no IP address";
  EXPECT_EQ(5, buy(cheapRent, false, "10.0.0.1", nullptr)) << "no saved card";
  EXPECT_EQ(4, buy(dearBuy, true, "10.0.0.1", nullptr)) << "not enough prepaid funds";
  VL1__PurchaseResponse purchase;
  ASSERT_EQ(0, buy(cheapRent, true, "10.0.0.1", &purchase));
  EXPECT_GT(purchase.PassID, 0);
  EXPECT_NE(nullptr, purchase.TransactionAuthNum);
  EXPECT_EQ(3, buy(cheapRent, true, "10.0.0.1", nullptr)) << "already owned";

  VLSimAccountData data;
  ASSERT_TRUE(m_Sim.Store().Account(3, &data));
  EXPECT_EQ(800 - catalogue.FindProduct(cheapRent)->priceCents, data.prepaidCents);

  VLSimSoapExchange exchange;
  _VL1__getMyStreamingVideos request;
  request.CurrentPageNumber = 1;
  request.ItemsPerPage = 10;
  request.PurchaseType = VL1__StreamAPIPurchaseType__any;
  request.WatchStatusFilter = VL1__WatchStatus__Undefined;
  _VL1__getMyStreamingVideosResponse response;
  ASSERT_EQ(SOAP_OK, Call(exchange, Stream(carol), "getMyStreamingVideos", &request, &response));
  ASSERT_EQ(1, response.getMyStreamingVideosResult->TotalItems);
  const VL1__TitleListingPurchased& video = *response.getMyStreamingVideosResult->Titles->TitleListingPurchased[0];
  EXPECT_EQ(purchase.PassID, video.PassID);
  EXPECT_EQ(VL1__WatchStatus__WatchNow, video.Status);

  // The rental runs out by the store's clock.
  m_Sim.Store().AdvanceClock(49 * 3600);
  VLSimSoapExchange later;
  _VL1__getMyStreamingVideosResponse laterResponse;
  ASSERT_EQ(SOAP_OK, Call(later, Stream(carol), "getMyStreamingVideos", &request, &laterResponse));
  EXPECT_EQ(VL1__WatchStatus__RentAgain, laterResponse.getMyStreamingVideosResult->Titles->TitleListingPurchased[0]->Status);
  EXPECT_EQ(0, buy(cheapRent, true, "10.0.0.1", nullptr)) << "an expired rental can be rented again";
}

// ---- SOAP-level faults and the request log ----

TEST_F(SimulatorSoap, SoapFaultsAndInjectedResponseCodes) {
  std::string error;
  ASSERT_TRUE(m_Sim.AddFault("getGenreLabel=soapfault,times=1", &error)) << error;
  ASSERT_TRUE(m_Sim.AddFault("getConfig=soapfault:client", &error)) << error;
  ASSERT_TRUE(m_Sim.AddFault("getEmailAddress=code:12", &error)) << error;

  _VL1__getGenreLabel label;
  label.GenreID = 10;
  VLSimSoapExchange first, second;
  _VL1__getGenreLabelResponse firstResponse, secondResponse;
  EXPECT_EQ(SOAP_SVR_FAULT, Call(first, VLSimSoapCall(), "getGenreLabel", &label, &firstResponse));
  EXPECT_EQ("Fault injected by the simulator", first.FaultString());
  EXPECT_EQ(SOAP_OK, Call(second, VLSimSoapCall(), "getGenreLabel", &label, &secondResponse)) << "times=1";
  EXPECT_STREQ("Action", secondResponse.getGenreLabelResult->Label);

  VLSimSoapExchange config;
  _VL1__getConfig configRequest;
  _VL1__getConfigResponse configResponse;
  EXPECT_EQ(SOAP_CLI_FAULT, Call(config, Stream(""), "getConfig", &configRequest, &configResponse));

  VLSimSoapExchange email;
  _VL1__getEmailAddress emailRequest;
  _VL1__getEmailAddressResponse emailResponse;
  ASSERT_EQ(SOAP_OK, Call(email, Stream(Authorize(1234)), "getEmailAddress", &emailRequest, &emailResponse));
  EXPECT_EQ(12, emailResponse.getEmailAddressResult->ResponseCode);
  EXPECT_EQ(12, m_Sim.Requests().back().responseCode);
}

TEST_F(SimulatorSoap, TheRequestLogShowsWhatEachRequestCarried) {
  m_Sim.ClearRequests();
  VLSimSoapCall call = Stream("SOME-TOKEN", "0A-0B-0C-0D-0E-0F");
  call.host = VL_STORE_STAGING_API_HOST;
  call.path = "/aac/api/StreamAPI.asmx";
  VLSimSoapExchange exchange;
  _VL1__checkAuthToken request;
  _VL1__checkAuthTokenResponse response;
  ASSERT_EQ(SOAP_OK, Call(exchange, call, "checkAuthToken", &request, &response));
  EXPECT_EQ(false_, response.checkAuthTokenResult);
  call.sendToken = false;
  VLSimSoapExchange second;
  ASSERT_EQ(SOAP_OK, Call(second, call, "checkAuthToken", &request, &response));

  std::vector<VLSimRequest> log = m_Sim.Requests();
  ASSERT_EQ(2u, log.size());
  const VLSimRequest& entry = log[0];
  EXPECT_TRUE(entry.tls);
  EXPECT_EQ(VL_STORE_STAGING_API_HOST, entry.host);
  EXPECT_EQ(VL_STORE_STAGING_API_HOST, entry.serverName);
  EXPECT_EQ("/aac/api/StreamAPI.asmx", entry.path);
  EXPECT_EQ("StreamAPI", entry.service);
  EXPECT_EQ("checkAuthToken", entry.operation);
  EXPECT_EQ(VL_API_NAMESPACE "checkAuthToken", entry.soapAction);
  EXPECT_EQ(VL_API_NAMESPACE "checkAuthToken", entry.wsaAction);
  EXPECT_EQ("uuid:checkAuthToken", entry.messageID);
  EXPECT_EQ("VL1:StreamDeviceRequestSettings", entry.settingsElement);
  EXPECT_EQ("VLSIM-API-KEY", entry.apiKey);
  EXPECT_TRUE(entry.hasAuthToken);
  EXPECT_EQ("SOME-TOKEN", entry.authToken);
  EXPECT_EQ("0A-0B-0C-0D-0E-0F", entry.destinationUniqueID);
  EXPECT_EQ(7, entry.destinationTypeID);
  EXPECT_EQ("vlsim-user", entry.userName);
  EXPECT_EQ(200, entry.status);
  EXPECT_FALSE(log[1].hasAuthToken);
  EXPECT_EQ("", log[1].authToken);
}

}  // namespace
