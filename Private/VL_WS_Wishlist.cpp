// Wishlist operations of the client: changes of the account's wishlist and the questions whether
// titles are on it. A cache of user data keeps a flag per title, so that the user interface can
// mark titles without asking the store.
#include "VLUtilities.h"
#include "VLWSAELog.h"
#include "VLWS_BoolVector.h"
#include "VLWS_IntVector.h"
#include "VL_WS.h"
#include "VL_WS_Call.h"

namespace {

VLLogArea s_Log(VLWSAELOG_AREA_NAME);

// The cache Name of wishlist pages.
const char kWishlistPages[] = "getWishlistItems";
// Pages of the wishlist scan: their size, and the page count assumed until an answer tells it.
const int kScanPageSize = 50;
const int kUnknownPageCount = 10000;

// One change of the wishlist on the store. When the store made it, the cached wishlist pages are
// out of date and update brings the flags up to date.
template <class Operation, class Fill, class Update>
VL_WS_Status ChangeWishlist(VL_WS_Handle* handle, VL_WS_StandardResponse* answer, const char* name,
                            const Operation& operation, Fill fill, Update update) {
  VL_WS_Client* client = VLClientFor(handle, answer);
  if (client == 0) return VL_WS_E_INVALID_ARGUMENT;
  bool answered = false;
  int soapError =
      VLServiceCall(*client, client->m_StreamDownloadAPI, operation, fill,
                    VLInto(VLUtilities::VL1__WishListActionResponse2VL_WS_StandardResponse, *answer, &answered));
  CacheInterface* cache = VLUserData(client);
  if (VLSucceeded(soapError, answered, answer->ResponseCode) && cache != 0) {
    cache->PurgeUserData(kWishlistPages);
    update(*cache);
  }
  return VLFoldedStatus(name, soapError, answer->ResponseCode);
}

// Marks every position of ids that holds titleID and is not marked yet; returns how many.
int Mark(int titleID, const int* ids, int count, bool* flags) {
  int marked = 0;
  for (int i = 0; i < count; ++i) {
    if (ids[i] == titleID && !flags[i]) {
      flags[i] = true;
      ++marked;
    }
  }
  return marked;
}

}  // namespace

extern "C" VL_WS_Status VL_WS_getWishlistItems(VL_WS_Handle* handle, VL_WS_SortOrder sortOrder, int currentPageNumber,
                                               int itemsPerPage, int titleType, VL_WS_WishlistItemsResponse* items) {
  VL_WS_Client* client = VLClientFor(handle, items);
  if (client == 0 || !VLPageFits(currentPageNumber, itemsPerPage)) return VL_WS_E_INVALID_ARGUMENT;
  const int order = VLUtilities::SortOrder2Int(sortOrder);
  VLCacheEntry entry = {VLCacheKind::kUserData, kWishlistPages,
                        VLCacheKey("%d,%d,%d,%d", order, currentPageNumber, itemsPerPage, titleType)};
  int soapError = VLCachedCall(
      *client, client->m_StreamDownloadAPI, VL_SERVICE_OPERATION(StreamDownloadAPI, getWishlistItems), &entry,
      [&](_VL1__getWishlistItems& request) {
        request.sortOrder = order;
        request.CurrentPageNumber = currentPageNumber;
        request.ItemsPerPage = itemsPerPage;
        request.TitleType = static_cast<VL1__TitleTypeFilter>(titleType);
      },
      VLKeptInto(VLUtilities::VL1__GetWishlistItemsResponse2VL_WS_WishlistItemsResponse, *items),
      [](CacheInterface& cache, const VL1__GetWishlistItemsResponse& page) {
        // Every title on a page of the wishlist is on the wishlist.
        if (page.Titles == 0) return;
        VLWS_IntVector titleIDs;
        for (int i = 0; i < page.Titles->__sizeTitleListingPurchased; ++i) {
          const VL1__TitleListingPurchased* title = page.Titles->TitleListingPurchased[i];
          if (title != 0) titleIDs.push_back(title->TitleID);
        }
        cache.WriteWishlistFlags(titleIDs, VLWS_BoolVector(titleIDs.size(), true));
      });
  return VLFoldedStatus("VL_WS_getWishlistItems", soapError, items->ResponseCode);
}

extern "C" VL_WS_Status VL_WS_addItemToWishlist(VL_WS_Handle* handle, int titleID, VL_WS_StandardResponse* answer) {
  return ChangeWishlist(
      handle, answer, "VL_WS_addItemToWishlist", VL_SERVICE_OPERATION(StreamDownloadAPI, addItemToWishlist),
      [titleID](_VL1__addItemToWishlist& request) { request.TitleID = titleID; },
      [titleID](CacheInterface& cache) { cache.WriteWishlistFlag(titleID, true); });
}

extern "C" VL_WS_Status VL_WS_removeItemFromWishlist(VL_WS_Handle* handle, int titleID,
                                                     VL_WS_StandardResponse* answer) {
  return ChangeWishlist(
      handle, answer, "VL_WS_removeItemFromWishlist", VL_SERVICE_OPERATION(StreamDownloadAPI, removeItemFromWishList),
      [titleID](_VL1__removeItemFromWishList& request) { request.TitleID = titleID; },
      [titleID](CacheInterface& cache) { cache.WriteWishlistFlag(titleID, false); });
}

extern "C" VL_WS_Status VL_WS_removeAllItemsFromWishlist(VL_WS_Handle* handle, VL_WS_StandardResponse* answer) {
  return ChangeWishlist(handle, answer, "VL_WS_removeAllItemsFromWishlist",
                        VL_SERVICE_OPERATION(StreamDownloadAPI, removeAllItemsFromWishList), VLNoFields(),
                        [](CacheInterface& cache) { cache.RemoveAllWishlistFlags(); });
}

extern "C" VL_WS_Status VL_WS_checkTitleInWishlist(VL_WS_Handle* handle, int titleID, bool* inWishlist) {
  VL_WS_Client* client = VLClientFor(handle, inWishlist);
  if (client == 0) return VL_WS_E_INVALID_ARGUMENT;
  if (client->m_Cache != 0 && client->m_Cache->ReadWishlistFlag(titleID, *inWishlist)) return VL_WS_OK;

  // The title's details tell whether it is on the user's wishlist; they are asked afresh, not
  // from the cached catalogue answers.
  bool answered = false;
  int responseCode = 0;
  int soapError = VLServiceCall(
      *client, client->m_RealTimeBrowse, VL_SERVICE_OPERATION(RealTimeBrowse, getTitleListing),
      [titleID](_VL1__getTitleListing& request) { request.TitleID = titleID; },
      [&](const VL1__TitleListingResponse& title) {
        answered = true;
        responseCode = title.ResponseCode;
        *inWishlist = title.IsAvailInUserWishList == true_;
      });
  CacheInterface* cache = VLUserData(client);
  if (VLSucceeded(soapError, answered, responseCode) && cache != 0) cache->WriteWishlistFlag(titleID, *inWishlist);
  VLLogBoolResult("VL_WS_checkTitleInWishlist", *inWishlist);
  return VLUtilities::To_VL_WS_Status(soapError, responseCode, "");
}

extern "C" VL_WS_Status VL_WS_checkTitlesInWishlist(VL_WS_Handle* handle, int count, const int* titleIDs, int titleType,
                                                    VL_WS_BoolArray* flags) {
  VL_WS_Client* client = VLClientFor(handle, flags);
  if (client == 0 || titleIDs == 0 || count < 1) return VL_WS_E_INVALID_ARGUMENT;
  flags->Items = new bool[count]();
  flags->Count = count;

  // The wishlist page by page, until every title was found or the last page was read. A page
  // that fails, or that the store refuses, ends the scan before it is complete: the flags found
  // so far are returned but not kept.
  int found = 0;
  int totalPages = kUnknownPageCount;
  bool complete = false;
  int soapError = SOAP_OK;
  for (int page = 1; !complete; ++page) {
    bool answered = false;
    int responseCode = 0;
    soapError = VLServiceCall(
        *client, client->m_StreamDownloadAPI, VL_SERVICE_OPERATION(StreamDownloadAPI, getWishlistItems),
        [=](_VL1__getWishlistItems& request) {
          request.sortOrder = 0;
          request.CurrentPageNumber = page;
          request.ItemsPerPage = kScanPageSize;
          request.TitleType = static_cast<VL1__TitleTypeFilter>(titleType);
        },
        [&](const VL1__GetWishlistItemsResponse& items) {
          answered = true;
          responseCode = items.ResponseCode;
          totalPages = items.TotalPages;
          if (responseCode != 0 || items.Titles == 0) return;
          const VL1__ArrayOfTitleListingPurchased& titles = *items.Titles;
          for (int i = 0; i < titles.__sizeTitleListingPurchased && found < count; ++i) {
            const VL1__TitleListingPurchased* title = titles.TitleListingPurchased[i];
            if (title != 0) found += Mark(title->TitleID, titleIDs, count, flags->Items);
          }
        });
    if (!VLSucceeded(soapError, answered, responseCode)) break;
    complete = found == count || page >= totalPages;
  }

  CacheInterface* cache = VLUserData(client);
  if (complete && cache != 0) {
    cache->WriteWishlistFlags(VLWS_IntVector(titleIDs, titleIDs + count),
                              VLWS_BoolVector(flags->Items, flags->Items + count));
  }
  VLLogOutputwithConfig({s_Log.Id(), 4}, "%s, ret:%d\n", "VL_WS_checkTitlesInWishlist", soapError);
  return VLUtilities::To_VL_WS_Status(soapError);
}
