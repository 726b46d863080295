// The store's SOAP answers as the client reads them: the input (after a byte that picks the
// operation and one that cuts the answer into pieces) is the whole HTTP answer of a store host,
// status line, header and body, chunked or compressed as the runtime accepts it. It goes through
// an operation's whole road: the runtime's reading, the status, the conversion into the
// interface's records and their release.
#include <stddef.h>
#include <stdint.h>

#include "FuzzAnswer.h"
#include "VL_WS.h"
#include "VL_WS_Client.h"

namespace {

const int kTwo[] = {1001, 1002};

// One operation for each kind of answer the client reads.
void (*const kOperations[])(VL_WS_Handle*) = {
    [](VL_WS_Handle* h) { FuzzRun<VL_WS_GenreArray>(VL_WS_getNavigation, h); },
    [](VL_WS_Handle* h) { FuzzRun<VL_WS_TitlesResponse>(VL_WS_getTitles, h, 1, 1, 10, 2); },
    [](VL_WS_Handle* h) { FuzzRun<VL_WS_TitlesResponseArray>(VL_WS_getTitlesByGenreIDs, h, 2, kTwo, 1, 10, 2); },
    [](VL_WS_Handle* h) { FuzzRun<VL_WS_TitleListingResponse>(VL_WS_getTitleListing, h, 1001); },
    [](VL_WS_Handle* h) { FuzzRun<VL_WS_TitleListingResponseArray>(VL_WS_getAllTvEpisodeListings, h, 1001); },
    [](VL_WS_Handle* h) { FuzzRun<VL_WS_TvEpisodeListResponse>(VL_WS_getTvEpisodeListByTitleID, h, 1001); },
    [](VL_WS_Handle* h) { FuzzRun<VL_WS_RecommendedTitlesResponse>(VL_WS_getRecommendedTitles, h, 1001); },
    [](VL_WS_Handle* h) { FuzzRun<VL_WS_TranslateTivoExternalIDResponse>(VL_WS_translateTivoExternalID, h, "T1"); },
    [](VL_WS_Handle* h) { FuzzRun<VL_WS_AuthorizeDeviceResponse>(VL_WS_authorizeDevice, h, 1234); },
    [](VL_WS_Handle* h) { FuzzRun<VL_WS_MyVideosResponse>(VL_WS_getMyVideos, h, 1, 10, 2, 0, 3); },
    [](VL_WS_Handle* h) { FuzzRun<VL_WS_WishlistItemsResponse>(VL_WS_getWishlistItems, h, VL_WS_SORT_0, 1, 10, 0); },
    [](VL_WS_Handle* h) { FuzzRun<VL_WS_ConfigResponse>(VL_WS_getConfig, h); },
    [](VL_WS_Handle* h) { FuzzRun<VL_WS_BillingInfoAndPPCBalance>(VL_WS_getBillingInfoAndPPCBalance, h); },
    [](VL_WS_Handle* h) { FuzzRun<VL_WS_PurchaseResponse>(VL_WS_doPurchaseSavedBilling, h, 10012, "10.0.0.7", false); },
    [](VL_WS_Handle* h) { FuzzRun<VL_WS_StreamingAssetLocationResponse>(VL_WS_getStreamingAssetLocation, h, 1, 1); },
    [](VL_WS_Handle* h) { FuzzRun<VL_WS_THXMediaDirectorResponse>(VL_WS_getTHXMediaDirector, h, 1, 1, 3); },
    [](VL_WS_Handle* h) {
      FuzzRun<VL_WS_TitleListingPurchasedForPassArray>(VL_WS_getTitleListingPurchaseds, h, 2, kTwo);
    },
    [](VL_WS_Handle* h) { FuzzRun<VL_WS_FileType>(VL_WS_getFileType, h); },
    [](VL_WS_Handle* h) { FuzzRun<VL_WS_String>(VL_WS_getLastCacheLoadTimeUTC, h); },
    [](VL_WS_Handle* h) {
      bool valid;
      VL_WS_checkAuthToken(h, &valid);
    },
};

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
  uint8_t selector;
  if (!FuzzAnswer::Take(data, size, &selector)) return 0;
  kOperations[selector % (sizeof kOperations / sizeof kOperations[0])](FuzzAnswer::Handle(0));
  return 0;
}
