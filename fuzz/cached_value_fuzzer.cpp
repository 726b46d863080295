// The cached value loader: the input (after a byte that picks the entry) is a value of the
// handle's cache, as a damaged or foreign cache file could hold it, under the name and key of a
// cached operation's answer. The operation then reads it back (Serializer: gzip or plain XML),
// converts what it finds into the interface's record and releases it; a value that is no such
// answer is a miss, which asks the store, here a connection that ends at once.
#include <stddef.h>
#include <stdint.h>

#include "FuzzAnswer.h"
#include "VL_WS.h"
#include "VL_WS_Client.h"

namespace {

// A cached answer: where the operation keeps it, and the call that reads it.
const struct Entry {
  bool userData;
  const char* name;
  const char* key;
  void (*call)(VL_WS_Handle*);
} kEntries[] = {
    {false, "getNavigation", "", [](VL_WS_Handle* h) { FuzzRun<VL_WS_GenreArray>(VL_WS_getNavigation, h); }},
    {false, "getTitles", "1,1,10,2",
     [](VL_WS_Handle* h) { FuzzRun<VL_WS_TitlesResponse>(VL_WS_getTitles, h, 1, 1, 10, 2); }},
    {false, "getTitleListing", "1001",
     [](VL_WS_Handle* h) { FuzzRun<VL_WS_TitleListingResponse>(VL_WS_getTitleListing, h, 1001); }},
    {false, "getAllTvEpisodeListings", "1001",
     [](VL_WS_Handle* h) { FuzzRun<VL_WS_TitleListingResponseArray>(VL_WS_getAllTvEpisodeListings, h, 1001); }},
    {false, "getTvEpisodeListByTitleID", "1001",
     [](VL_WS_Handle* h) { FuzzRun<VL_WS_TvEpisodeListResponse>(VL_WS_getTvEpisodeListByTitleID, h, 1001); }},
    {false, "getRecommendedTitles", "1001",
     [](VL_WS_Handle* h) { FuzzRun<VL_WS_RecommendedTitlesResponse>(VL_WS_getRecommendedTitles, h, 1001); }},
    {false, "translateSkuId", "10012",
     [](VL_WS_Handle* h) { FuzzRun<VL_WS_TranslateSkuIDResponse>(VL_WS_translateSkuID, h, 10012); }},
    {true, "getMyVideos", "1,10,2,0,3",
     [](VL_WS_Handle* h) { FuzzRun<VL_WS_MyVideosResponse>(VL_WS_getMyVideos, h, 1, 10, 2, 0, 3); }},
    {true, "getWishlistItems", "0,1,10,0",
     [](VL_WS_Handle* h) { FuzzRun<VL_WS_WishlistItemsResponse>(VL_WS_getWishlistItems, h, VL_WS_SORT_0, 1, 10, 0); }},
    {true, "getEmailAddress", "",
     [](VL_WS_Handle* h) { FuzzRun<VL_WS_EmailAddressResponse>(VL_WS_getEmailAddress, h); }},
};

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
  if (size < 1) return 0;
  VL_WS_Handle* handle = FuzzAnswer::Handle(1);
  const Entry& entry = kEntries[data[0] % (sizeof kEntries / sizeof kEntries[0])];
  VLString value(reinterpret_cast<const char*>(data + 1), size - 1);
  CacheInterface& cache = *handle->client->m_Cache;
  if (!(entry.userData ? cache.WriteUserData(entry.name, entry.key, value)
                       : cache.WriteMetaData(entry.name, entry.key, value)))
    return 0;  // an empty value is never stored
  FuzzAnswer::Set(nullptr, 0, 1);
  entry.call(handle);
  return 0;
}
