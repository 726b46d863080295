// Wishlist operations against the store simulator: the per-title flags of a cache of user data
// (kept by the changes and the pages, read by the title check without a request), the page by
// page scan of several titles, and the wishlist pages kept as user data.
#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "VLTestAccountClient.h"

namespace {

class Wishlist : public VLTestAccountClient {
 protected:
  // Puts titles on the account's wishlist in this order (the store lists the last added first).
  void AddToStore(int first, int last) {
    for (int title = first; title <= last; ++title) ASSERT_EQ(0, m_Sim.Store().WishlistAdd(Account(), title));
  }
  // The answer of VL_WS_checkTitleInWishlist, which must succeed.
  bool InWishlist(int titleID) {
    bool inWishlist = false;
    EXPECT_EQ(VL_WS_OK, VL_WS_checkTitleInWishlist(&m_Handle, titleID, &inWishlist)) << titleID;
    return inWishlist;
  }
  // The flags of VL_WS_checkTitlesInWishlist for ids, and its status.
  std::vector<bool> Scan(const std::vector<int>& ids, VL_WS_Status expected = VL_WS_OK) {
    VLAnswer<VL_WS_BoolArray> flags;
    EXPECT_EQ(expected,
              VL_WS_checkTitlesInWishlist(&m_Handle, static_cast<int>(ids.size()), ids.data(), 0, flags.Fresh()));
    return std::vector<bool>(flags->Items, flags->Items + flags->Count);
  }
  // The titles of the first wishlist page of the given order and size, which must come.
  std::vector<int> Page(VL_WS_SortOrder order = VL_WS_SORT_0, int size = 10) {
    VLAnswer<VL_WS_WishlistItemsResponse> page;
    EXPECT_EQ(VL_WS_OK, VL_WS_getWishlistItems(&m_Handle, order, 1, size, 0, page.Fresh()));
    std::vector<int> titles;
    for (int i = 0; i < page->Titles.Count; ++i) titles.push_back(page->Titles.Items[i].TitleID);
    return titles;
  }
};

TEST_F(Wishlist, ChangesKeepTheFlagsThatTheCheckReads) {
  Init(STREAM, 7);
  ASSERT_EQ(VL_WS_OK, Call(VL_WS_addItemToWishlist, 1001));
  EXPECT_TRUE(InWishlist(1001));
  EXPECT_EQ(1u, Requests(1).size()) << "the check asked the store";

  ASSERT_EQ(VL_WS_OK, Call(VL_WS_removeItemFromWishlist, 1001));
  EXPECT_FALSE(InWishlist(1001));
  EXPECT_EQ(2u, Requests(2).size());
  EXPECT_EQ((std::vector<std::string>{"VL_WS_addItemToWishlist, ret:0,responseCode:0",
                                      "VL_WS_removeItemFromWishlist, ret:0,responseCode:0"}),
            TakeLog());

  ASSERT_EQ(VL_WS_OK, Call(VL_WS_addItemToWishlist, 1002));
  ASSERT_EQ(VL_WS_OK, Call(VL_WS_removeAllItemsFromWishlist));
  EXPECT_EQ(-1, Flag(1002));
  EXPECT_EQ(-1, Flag(1001));

  // A change the store refuses changes no flag.
  ASSERT_TRUE(Cache().WriteWishlistFlag(1003, true));
  EXPECT_EQ(VL_WS_E_UNEXPECTED, Call(VL_WS_removeItemFromWishlist, 99999));
  EXPECT_EQ(1, Flag(1003));
  EXPECT_EQ(-1, Flag(99999));
}

TEST_F(Wishlist, CheckWithoutAFlagAsksForTheTitleAndKeepsTheAnswer) {
  Init(STREAM, 7);
  AddToStore(1003, 1003);
  EXPECT_TRUE(InWishlist(1003));
  EXPECT_FALSE(InWishlist(1004));
  EXPECT_EQ(2u, Requests(2).size());
  EXPECT_EQ(1, Flag(1003));
  EXPECT_EQ(0, Flag(1004));
  EXPECT_EQ((std::vector<std::string>{"VL_WS_checkTitleInWishlist, result:1", "VL_WS_checkTitleInWishlist, result:0"}),
            TakeLog());

  // Answered from the flags: no request, no result line.
  EXPECT_TRUE(InWishlist(1003));
  EXPECT_EQ(2u, RequestsNow().size());
  EXPECT_TRUE(TakeLog().empty());

  // An unknown title is refused and leaves no flag.
  bool inWishlist = false;
  EXPECT_EQ(VL_WS_E_UNEXPECTED, VL_WS_checkTitleInWishlist(&m_Handle, 99999, &inWishlist));
  EXPECT_EQ(-1, Flag(99999));
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_checkTitleInWishlist(&m_Handle, 1003, nullptr));
}

TEST_F(Wishlist, WithoutUserDataEveryCheckAsks) {
  Init(STREAM, VL_WS_CacheParam::CACHE_METADATA);
  AddToStore(1003, 1003);
  ASSERT_EQ(VL_WS_OK, Call(VL_WS_addItemToWishlist, 1005));
  for (int title : {1003, 1003, 1005}) EXPECT_TRUE(InWishlist(title));
  EXPECT_EQ(4u, Requests(4).size());
}

TEST_F(Wishlist, ScanReadsPagesUntilEveryTitleIsFound) {
  Init(STREAM, 7);
  AddToStore(1001, 1060);  // page 1 of 50: 1060 down to 1011; page 2: 1010 down to 1001
  EXPECT_EQ((std::vector<bool>{true, true, false}), Scan({1050, 1005, 1100}));
  EXPECT_EQ(2u, Requests(2).size());
  EXPECT_EQ(1, Flag(1050));
  EXPECT_EQ(1, Flag(1005));
  EXPECT_EQ(0, Flag(1100));
  EXPECT_EQ(std::vector<std::string>{"VL_WS_checkTitlesInWishlist, ret:0"}, TakeLog());

  // All of them on page 1: page 2 is not asked for.
  m_Sim.ClearRequests();
  EXPECT_EQ((std::vector<bool>{true, true, true}), Scan({1011, 1060, 1011}));
  EXPECT_EQ(1u, Requests(1).size());
}

TEST_F(Wishlist, UnfinishedScanKeepsNoFlags) {
  Init(STREAM, 7);
  AddToStore(1001, 1003);
  Fault("getWishlistItems=status:503,times=1");
  EXPECT_EQ((std::vector<bool>{false, false}), Scan({1002, 1100}, VL_WS_E_HTTP_STATUS(503)));
  EXPECT_EQ(-1, Flag(1100));

  // A refused page (a token the store does not know) ends the scan as well.
  Settings().AuthToken = "SIMTOKEN-UNKNOWN";
  m_Sim.ClearRequests();
  EXPECT_EQ((std::vector<bool>{false, false}), Scan({1002, 1100}));
  EXPECT_EQ(1u, Requests(1).size());
  EXPECT_EQ(-1, Flag(1002));

  VLAnswer<VL_WS_BoolArray> flags;
  const int ids[] = {1002, 1100};
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_checkTitlesInWishlist(&m_Handle, 0, ids, 0, flags.Fresh()));
  EXPECT_EQ(VL_WS_TAG_BOOL_ARRAY, *flags->tag);
  EXPECT_EQ(0, flags->Count);
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_checkTitlesInWishlist(&m_Handle, 2, nullptr, 0, flags.Fresh()));
  EXPECT_EQ(1u, RequestsNow().size());
}

TEST_F(Wishlist, PagesAreKeptAsUserDataUntilTheWishlistChanges) {
  Init(STREAM, 7);
  AddToStore(1001, 1003);
  VLAnswer<VL_WS_WishlistItemsResponse> page;
  ASSERT_EQ(VL_WS_OK, VL_WS_getWishlistItems(&m_Handle, VL_WS_SORT_0, 1, 10, 0, page.Fresh()));
  ASSERT_EQ(3, page->Titles.Count);
  EXPECT_EQ(1003, page->Titles.Items[0].TitleID);
  EXPECT_EQ(3, page->TotalItems);
  EXPECT_EQ(0, page->SortOrder);
  EXPECT_EQ(1, Flag(1001));
  EXPECT_EQ(1, Flag(1003));

  // The same page again, and a sort order outside 0 to 3 (sent as 0), come from the cache.
  EXPECT_EQ(3u, Page().size());
  EXPECT_EQ(3u, Page(static_cast<VL_WS_SortOrder>(9)).size());
  EXPECT_EQ(1u, Requests(1).size());

  // Another page size asks; a change of the wishlist drops the kept pages.
  EXPECT_EQ(2u, Page(VL_WS_SORT_0, 2).size());
  ASSERT_EQ(VL_WS_OK, Call(VL_WS_addItemToWishlist, 1004));
  EXPECT_EQ(4u, Page().size());
  EXPECT_EQ(4u, Requests(4).size());

  // A refused page is returned and not kept.
  Fault("getWishlistItems=code:3,times=1");
  EXPECT_EQ(VL_WS_E_UNEXPECTED, VL_WS_getWishlistItems(&m_Handle, VL_WS_SORT_1, 1, 10, 0, page.Fresh()));
  EXPECT_EQ(3, page->ResponseCode);
  EXPECT_EQ((std::vector<int>{1001, 1002, 1003, 1004}), Page(VL_WS_SORT_1));  // the oldest first
  EXPECT_EQ(6u, Requests(6).size());
}

}  // namespace
