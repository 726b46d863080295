// Catalogue operations of the client: the genre tree, pages of titles, title and episode details,
// search, recommendations and the translation of TiVo and SKU identifiers, all answered by the
// catalogue service and, where they are cached, by the handle's cache first (VL_WS_Call.h).
#include <string.h>

#include "VL_WS_Call.h"
#include "VLRecord.h"
#include "VLUtilities.h"
#include "VLWSAELog.h"
#include "VLWS_BoolVector.h"
#include "VLWS_IntVector.h"
#include "VL_WS.h"

namespace {

VLLogArea s_Log(VLWSAELOG_AREA_NAME);

bool InWishlist(const VL1__TitleListingResponse& details) { return details.IsAvailInUserWishList == true_; }

// getTitleListing and getTvEpisodeListing: the details of one title or episode, cached by the
// ID asked for. The answer's wishlist membership is not part of the record; a kept answer stores
// it as the wishlist flag of the title that wishlistTitle picks.
template <class Operation, class Fill, class WishlistTitle>
VL_WS_Status TitleDetails(const char* name, const char* cacheName, const Operation& operation, VL_WS_Handle* handle,
                          int id, VL_WS_TitleListingResponse* details, Fill fill, WishlistTitle wishlistTitle) {
  VL_WS_Client* client = VLClientFor(handle, details);
  if (client == 0) return VL_WS_E_INVALID_ARGUMENT;
  VLCacheEntry entry = {VLCacheKind::kMetaData, cacheName, VLCacheKey("%d", id)};
  int soapError = VLCachedCall(
      *client, client->m_RealTimeBrowse, operation, &entry, fill,
      VLKeptInto(VLUtilities::VL1__TitleListingResponse2VL_WS_TitleListingResponse, *details),
      [&](CacheInterface& cache, const VL1__TitleListingResponse& result) {
        cache.WriteWishlistFlag(wishlistTitle(result), InWishlist(result));
      });
  return VLFoldedStatus(name, soapError, details->ResponseCode);
}

// searchForTitle and searchForTitleDetail: one page of the titles that match a query.
template <class Operation>
VL_WS_Status Search(const char* name, const char* cacheName, const Operation& operation, VL_WS_Handle* handle,
                    int currentPageNumber, int itemsPerPage, int purchaseType, int titleType, const char* query,
                    VL_WS_TitlesResponse* titles) {
  VL_WS_Client* client = VLClientFor(handle, titles);
  if (client == 0 || query == 0 || *query == 0 || !VLPageFits(currentPageNumber, itemsPerPage))
    return VL_WS_E_INVALID_ARGUMENT;
  return VLKeptRecord(
      *client, client->m_RealTimeBrowse, operation,
      {VLCacheKind::kMetaData, cacheName,
       VLCacheKey("%d,%d,%d,%d,%s", currentPageNumber, itemsPerPage, purchaseType, titleType, query)},
      [&](auto& request) {
        request.Query = const_cast<char*>(query);
        request.ItemsPerPage = itemsPerPage;
        request.CurrentPageNumber = currentPageNumber;
        request.PurchaseType = static_cast<VL1__StreamAPIPurchaseType>(purchaseType);
        request.TitleType = static_cast<VL1__TitleTypeFilter>(titleType);
      },
      VLUtilities::VL1__GetTitlesResponse2VL_WS_TitlesResponse, *titles, name, VLSoapStatus);
}

}  // namespace

extern "C" VL_WS_Status VL_WS_getNavigation(VL_WS_Handle* handle, VL_WS_GenreArray* genres) {
  VL_WS_Client* client = VLClientFor(handle, genres);
  if (client == 0) return VL_WS_E_INVALID_ARGUMENT;
  // One genre tree per cache: the Key is empty.
  VLCacheEntry entry = {VLCacheKind::kMetaData, "getNavigation", VLString()};
  int soapError = VLCachedCall(*client, client->m_RealTimeBrowse, VL_SERVICE_OPERATION(RealTimeBrowse, getNavigation),
                               &entry, [](_VL1__getNavigation&) {},
                               [&](const VL1__GenreRequest& result) {
                                 if (result.Genres != 0) VLUtilities::VL1__ArrayOfGenre2VL_WS_GenreArray(result.Genres, *genres);
                                 return genres->Count > 0;
                               });
  VLLogOutputwithConfig({s_Log.Id(), 4}, "%s, ret:%d\n", "VL_WS_getNavigation", soapError);
  return VLUtilities::To_VL_WS_Status(soapError);
}

extern "C" VL_WS_Status VL_WS_getGenreLabel(VL_WS_Handle* handle, int genreID, VL_WS_GenreLabelResponse* label) {
  VL_WS_Client* client = VLClientFor(handle, label);
  if (client == 0) return VL_WS_E_INVALID_ARGUMENT;
  int soapError = VLServiceCall(
      *client, client->m_RealTimeBrowse, VL_SERVICE_OPERATION(RealTimeBrowse, getGenreLabel),
      [&](_VL1__getGenreLabel& request) { request.GenreID = genreID; },
      VLKeptInto(VLUtilities::VL1__GetGenreLabelResponse2VL_WS_GenreLabelResponse, *label));
  return VLFoldedStatus("VL_WS_getGenreLabel", soapError, label->ResponseCode);
}

extern "C" VL_WS_Status VL_WS_getTitles(VL_WS_Handle* handle, int genreID, int currentPageNumber, int itemsPerPage,
                                        int purchaseType, VL_WS_TitlesResponse* titles) {
  VL_WS_Client* client = VLClientFor(handle, titles);
  if (client == 0 || !VLPageFits(currentPageNumber, itemsPerPage)) return VL_WS_E_INVALID_ARGUMENT;
  return VLKeptRecord(
      *client, client->m_RealTimeBrowse, VL_SERVICE_OPERATION(RealTimeBrowse, getTitlesByNavigation),
      {VLCacheKind::kMetaData, "getTitles",
       VLCacheKey("%d,%d,%d,%d", genreID, currentPageNumber, itemsPerPage, purchaseType)},
      [&](_VL1__getTitlesByNavigation& request) {
        request.GenreID = genreID;
        request.CurrentPageNumber = currentPageNumber;
        request.ItemsPerPage = itemsPerPage;
        request.PurchaseType = static_cast<VL1__StreamAPIPurchaseType>(purchaseType);
      },
      VLUtilities::VL1__GetTitlesResponse2VL_WS_TitlesResponse, *titles, "VL_WS_getTitles", VLFoldedStatus);
}

extern "C" VL_WS_Status VL_WS_getTitlesByGenreIDs(VL_WS_Handle* handle, int count, const int* genreIDs,
                                                  int currentPageNumber, int itemsPerPage, int purchaseType,
                                                  VL_WS_TitlesResponseArray* pages) {
  VL_WS_Client* client = VLClientFor(handle, pages);
  if (client == 0 || count < 1 || genreIDs == 0 || !VLPageFits(currentPageNumber, itemsPerPage))
    return VL_WS_E_INVALID_ARGUMENT;
  soap& context = client->m_RealTimeBrowse;
  int soapError = VLServiceCall(
      *client, client->m_RealTimeBrowse, VL_SERVICE_OPERATION(RealTimeBrowse, getTitlesByGenreArray),
      [&](_VL1__getTitlesByGenreArray& request) {
        request.GenreIDs = soap_new_VL1__ArrayOfInt(&context);
        int* ids = static_cast<int*>(soap_malloc(&context, count * sizeof(int)));
        if (request.GenreIDs != 0 && ids != 0) {
          memcpy(ids, genreIDs, count * sizeof(int));
          request.GenreIDs->int_ = ids;
          request.GenreIDs->__sizeint = count;
        }
        request.CurrentPageNumber = currentPageNumber;
        request.ItemsPerPage = itemsPerPage;
        request.PurchaseType = static_cast<VL1__StreamAPIPurchaseType>(purchaseType);
      },
      [&](const VL1__ArrayOfGetTitlesResponse& result) {
        VLUtilities::VL1__ArrayOfGetTitlesResponse2VL_WS_TitlesResponseArray(&result, *pages);
      });
  return VLSoapStatus("VL_WS_getTitlesByGenreIDs", soapError, pages->Count > 0 ? pages->Items[0].ResponseCode : 0);
}

extern "C" VL_WS_Status VL_WS_getTitleListing(VL_WS_Handle* handle, int titleID, VL_WS_TitleListingResponse* details) {
  return TitleDetails("VL_WS_getTitleListing", "getTitleListing", VL_SERVICE_OPERATION(RealTimeBrowse, getTitleListing),
                      handle, titleID, details,
                      [&](_VL1__getTitleListing& request) { request.TitleID = titleID; },
                      [&](const VL1__TitleListingResponse&) { return titleID; });
}

extern "C" VL_WS_Status VL_WS_getTvEpisodeListing(VL_WS_Handle* handle, int episodeID,
                                                  VL_WS_TitleListingResponse* details) {
  return TitleDetails("VL_WS_getTvEpisodeListing", "getTvEpisodeListing",
                      VL_SERVICE_OPERATION(RealTimeBrowse, getTvEpisodeListing), handle, episodeID, details,
                      [&](_VL1__getTvEpisodeListing& request) { request.EpisodeID = episodeID; },
                      [](const VL1__TitleListingResponse& result) { return result.TitleID; });
}

extern "C" VL_WS_Status VL_WS_getTvEpisodeListByTitleID(VL_WS_Handle* handle, int titleID,
                                                        VL_WS_TvEpisodeListResponse* episodes) {
  VL_WS_Client* client = VLClientFor(handle, episodes);
  if (client == 0) return VL_WS_E_INVALID_ARGUMENT;
  return VLKeptRecord(*client, client->m_RealTimeBrowse,
                      VL_SERVICE_OPERATION(RealTimeBrowse, getTvEpisodeListByTitleID),
                      {VLCacheKind::kMetaData, "getTvEpisodeListByTitleID", VLCacheKey("%d", titleID)},
                      [&](_VL1__getTvEpisodeListByTitleID& request) { request.TitleID = titleID; },
                      VLUtilities::VL1__TvEpisodeList2VL_WS_TvEpisodeListResponse, *episodes,
                      "VL_WS_getTvEpisodeListByTitleID", VLFoldedStatus);
}

extern "C" VL_WS_Status VL_WS_getAllTvEpisodeListings(VL_WS_Handle* handle, int titleID,
                                                      VL_WS_TitleListingResponseArray* listings) {
  VL_WS_Client* client = VLClientFor(handle, listings);
  if (client == 0) return VL_WS_E_INVALID_ARGUMENT;
  VLCacheEntry entry = {VLCacheKind::kMetaData, "getAllTvEpisodeListings", VLCacheKey("%d", titleID)};
  int soapError = VLCachedCall(
      *client, client->m_RealTimeBrowse, VL_SERVICE_OPERATION(RealTimeBrowse, getAllTvEpisodeListings), &entry,
      [&](_VL1__getAllTvEpisodeListings& request) { request.TitleID = titleID; },
      [&](const VL1__ArrayOfTitleListingResponse& result) {
        VLUtilities::VL1__ArrayOfTitleListingResponse2VL_WS_TitleListingResponseArray(&result, *listings);
        // Kept when there is a listing and none of them is a refusal: an error is never served
        // from the cache.
        bool refused = false;
        for (int i = 0; i < listings->Count; ++i) refused = refused || listings->Items[i].ResponseCode != 0;
        return listings->Count > 0 && !refused;
      },
      [](CacheInterface& cache, const VL1__ArrayOfTitleListingResponse& result) {
        VLWS_IntVector titles;
        VLWS_BoolVector flags;
        for (int i = 0; i < result.__sizeTitleListingResponse; ++i) {
          const VL1__TitleListingResponse* listing = result.TitleListingResponse[i];
          if (listing == 0) continue;
          titles.push_back(listing->TitleID);
          flags.push_back(InWishlist(*listing));
        }
        cache.WriteWishlistFlags(titles, flags);
      });
  return VLSoapStatus("VL_WS_getAllTvEpisodeListings", soapError,
                  listings->Count > 0 ? listings->Items[0].ResponseCode : 0);
}

extern "C" VL_WS_Status VL_WS_translateTivoExternalID(VL_WS_Handle* handle, const char* tivoExternalID,
                                                      VL_WS_TranslateTivoExternalIDResponse* translation) {
  VL_WS_Client* client = VLClientFor(handle, translation);
  if (client == 0 || tivoExternalID == 0) return VL_WS_E_INVALID_ARGUMENT;
  return VLKeptRecord(
      *client, client->m_RealTimeBrowse, VL_SERVICE_OPERATION(RealTimeBrowse, translateTivoExternalId),
      {VLCacheKind::kMetaData, "translateTivoExternalId", VLCacheKey("%s", tivoExternalID)},
      [&](_VL1__translateTivoExternalId& request) { request.TivoExternalId = const_cast<char*>(tivoExternalID); },
      VLUtilities::VL1__TranslateTivoExternalIDResponse2VL_WS_TranslateTivoExternalIDResponse, *translation,
      "VL_WS_translateTivoExternalID", VLSoapStatus);
}

extern "C" VL_WS_Status VL_WS_translateSkuID(VL_WS_Handle* handle, int skuID, VL_WS_TranslateSkuIDResponse* translation) {
  VL_WS_Client* client = VLClientFor(handle, translation);
  if (client == 0) return VL_WS_E_INVALID_ARGUMENT;
  return VLKeptRecord(*client, client->m_RealTimeBrowse, VL_SERVICE_OPERATION(RealTimeBrowse, translateSkuId),
                      {VLCacheKind::kMetaData, "translateSkuId", VLCacheKey("%d", skuID)},
                      [&](_VL1__translateSkuId& request) { request.SkuId = skuID; },
                      VLUtilities::VL1__TranslateSkuIdResponse2VL_WS_TranslateSkuIDResponse, *translation,
                      "VL_WS_translateSkuID", VLSoapStatus);
}

extern "C" VL_WS_Status VL_WS_searchForTitle(VL_WS_Handle* handle, int currentPageNumber, int itemsPerPage,
                                             int purchaseType, int titleType, const char* query,
                                             VL_WS_TitlesResponse* titles) {
  return Search("VL_WS_searchForTitle", "searchForTitle", VL_SERVICE_OPERATION(RealTimeBrowse, searchForTitle), handle,
                currentPageNumber, itemsPerPage, purchaseType, titleType, query, titles);
}

extern "C" VL_WS_Status VL_WS_searchForTitleDetail(VL_WS_Handle* handle, int currentPageNumber, int itemsPerPage,
                                                   int purchaseType, int titleType, const char* query,
                                                   VL_WS_TitlesResponse* titles) {
  return Search("VL_WS_searchForTitleDetail", "searchForTitleDetail",
                VL_SERVICE_OPERATION(RealTimeBrowse, searchForTitleDetail), handle, currentPageNumber, itemsPerPage,
                purchaseType, titleType, query, titles);
}

extern "C" VL_WS_Status VL_WS_getRecommendedTitles(VL_WS_Handle* handle, int titleID,
                                                   VL_WS_RecommendedTitlesResponse* titles) {
  VL_WS_Client* client = VLClientFor(handle, titles);
  if (client == 0) return VL_WS_E_INVALID_ARGUMENT;
  return VLKeptRecord(*client, client->m_RealTimeBrowse, VL_SERVICE_OPERATION(RealTimeBrowse, getRecommendedTitles),
                      {VLCacheKind::kMetaData, "getRecommendedTitles", VLCacheKey("%d", titleID)},
                      [&](_VL1__getRecommendedTitles& request) { request.TitleId = titleID; },
                      VLUtilities::VL1__RecommendedTitlesResponse2VL_WS_RecommendedTitlesResponse, *titles,
                      "VL_WS_getRecommendedTitles", VLFoldedStatus);
}
