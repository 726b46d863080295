// Wishlist operations of the client: changes of the account's wishlist and the questions whether
// titles are on it. A cache of user data keeps a flag per title, so that the user interface can
// mark titles without asking the store.
#include "VLRecord.h"
#include "VLUtilities.h"
#include "VLWSAELog.h"
#include "VLWS_BoolVector.h"
#include "VLWS_IntVector.h"
#include "VL_WS.h"
#include "VL_WS_Call.h"
#include "VL_WS_Client.h"

namespace {

VLLogArea s_Log(VLWSAELOG_AREA_NAME);

// The cache Name of wishlist pages.
const char kWishlistPages[] = "getWishlistItems";
// Pages of the wishlist scan: their size, and the page count assumed until an answer tells it.
const int kScanPageSize = 50;
const int kUnknownPageCount = 10000;

// One change of the wishlist on the store. When the store made it, the cached wishlist pages are
// out of date and update brings the flags up to date.
template <class Proxy, class Request, class Response, class Fill, class Update>
VL_WS_Status ChangeWishlist(VL_WS_Handle* handle, VL_WS_StandardResponse* answer, const char* name,
                            const char* operation, int (Proxy::*send)(Request*, Response*), Fill fill,
                            VL1__WishListActionResponse* Response::*result, Update update) {
  VL_WS_Client* client = VLBeginCall(handle, answer);
  if (client == 0) return VL_WS_E_INVALID_ARGUMENT;
  bool answered = false;
  int error = VLCallInto(client->m_StreamDownloadAPI, operation, send, fill, result,
                         VLUtilities::VL1__WishListActionResponse2VL_WS_StandardResponse, *answer, &answered);
  CacheInterface* cache = VLUserData(client);
  if (VLSucceeded(error, answered, answer->ResponseCode) && cache != 0) {
    cache->PurgeUserData(kWishlistPages);
    update(*cache);
  }
  return VLFoldedStatus(name, error, *answer);
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

extern "C" VL_WS_Status VL_WS_addItemToWishlist(VL_WS_Handle* handle, int titleID, VL_WS_StandardResponse* answer) {
  return ChangeWishlist(
      handle, answer, "VL_WS_addItemToWishlist", "addItemToWishlist", &StreamDownloadAPI::addItemToWishlist,
      [titleID](_VL1__addItemToWishlist& request) { request.TitleID = titleID; },
      &_VL1__addItemToWishlistResponse::addItemToWishlistResult,
      [titleID](CacheInterface& cache) { cache.WriteWishlistFlag(titleID, true); });
}

extern "C" VL_WS_Status VL_WS_removeItemFromWishlist(VL_WS_Handle* handle, int titleID,
                                                     VL_WS_StandardResponse* answer) {
  return ChangeWishlist(
      handle, answer, "VL_WS_removeItemFromWishlist", "removeItemFromWishList",
      &StreamDownloadAPI::removeItemFromWishList,
      [titleID](_VL1__removeItemFromWishList& request) { request.TitleID = titleID; },
      &_VL1__removeItemFromWishListResponse::removeItemFromWishListResult,
      [titleID](CacheInterface& cache) { cache.WriteWishlistFlag(titleID, false); });
}

extern "C" VL_WS_Status VL_WS_removeAllItemsFromWishlist(VL_WS_Handle* handle, VL_WS_StandardResponse* answer) {
  return ChangeWishlist(handle, answer, "VL_WS_removeAllItemsFromWishlist", "removeAllItemsFromWishList",
                        &StreamDownloadAPI::removeAllItemsFromWishList, VLNoFields(),
                        &_VL1__removeAllItemsFromWishListResponse::removeAllItemsFromWishListResult,
                        [](CacheInterface& cache) { cache.RemoveAllWishlistFlags(); });
}

extern "C" VL_WS_Status VL_WS_checkTitleInWishlist(VL_WS_Handle* handle, int titleID, bool* inWishlist) {
  VL_WS_Client* client = VLBeginCall(handle, inWishlist);
  if (client == 0) return VL_WS_E_INVALID_ARGUMENT;
  if (client->m_Cache != 0 && client->m_Cache->ReadWishlistFlag(titleID, *inWishlist)) return VL_WS_OK;

  // The title's details tell whether it is on the user's wishlist; they are asked afresh, not
  // from the cached catalogue answers.
  bool answered = false;
  int responseCode = 0;
  int error = VLCall(client->m_RealTimeBrowse, "getTitleListing", &RealTimeBrowse::getTitleListing,
                     [titleID](_VL1__getTitleListing& request) { request.TitleID = titleID; },
                     [&](const _VL1__getTitleListingResponse& response) {
                       const VL1__TitleListingResponse* title = response.getTitleListingResult;
                       if (title == 0) return;
                       answered = true;
                       responseCode = title->ResponseCode;
                       *inWishlist = title->IsAvailInUserWishList == true_;
                     });
  CacheInterface* cache = VLUserData(client);
  if (VLSucceeded(error, answered, responseCode) && cache != 0) cache->WriteWishlistFlag(titleID, *inWishlist);
  VLLogBoolResult("VL_WS_checkTitleInWishlist", *inWishlist);
  return VLUtilities::To_VL_WS_Status(error, responseCode, "");
}

extern "C" VL_WS_Status VL_WS_checkTitlesInWishlist(VL_WS_Handle* handle, int count, const int* titleIDs,
                                                    int titleType, VL_WS_BoolArray* flags) {
  VL_WS_Client* client = VLBeginCall(handle, flags);
  if (client == 0 || titleIDs == 0 || count < 1) return VL_WS_E_INVALID_ARGUMENT;
  flags->Items = new bool[count]();
  flags->Count = count;

  // The wishlist page by page, until every title was found or the last page was read. A page
  // that fails, or that the store refuses, ends the scan before it is complete: the flags found
  // so far are returned but not kept.
  int found = 0;
  int totalPages = kUnknownPageCount;
  bool complete = false;
  int error = SOAP_OK;
  for (int page = 1; !complete; ++page) {
    bool answered = false;
    int responseCode = 0;
    error = VLCall(client->m_StreamDownloadAPI, "getWishlistItems", &StreamDownloadAPI::getWishlistItems,
                   [=](_VL1__getWishlistItems& request) {
                     request.sortOrder = 0;
                     request.CurrentPageNumber = page;
                     request.ItemsPerPage = kScanPageSize;
                     request.TitleType = static_cast<VL1__TitleTypeFilter>(titleType);
                   },
                   [&](const _VL1__getWishlistItemsResponse& response) {
                     const VL1__GetWishlistItemsResponse* items = response.getWishlistItemsResult;
                     if (items == 0) return;
                     answered = true;
                     responseCode = items->ResponseCode;
                     totalPages = items->TotalPages;
                     if (responseCode != 0 || items->Titles == 0) return;
                     for (int i = 0; i < items->Titles->__sizeTitleListingPurchased && found < count; ++i) {
                       const VL1__TitleListingPurchased* title = items->Titles->TitleListingPurchased[i];
                       if (title != 0) found += Mark(title->TitleID, titleIDs, count, flags->Items);
                     }
                   });
    if (!VLSucceeded(error, answered, responseCode)) break;
    complete = found == count || page >= totalPages;
  }

  CacheInterface* cache = VLUserData(client);
  if (complete && cache != 0) {
    cache->WriteWishlistFlags(VLWS_IntVector(titleIDs, titleIDs + count),
                              VLWS_BoolVector(flags->Items, flags->Items + count));
  }
  VLLogOutputwithConfig({s_Log.Id(), 4}, "%s, ret:%d\n", "VL_WS_checkTitlesInWishlist", error);
  return VLUtilities::To_VL_WS_Status(error);
}
