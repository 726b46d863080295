// What page prefetching saves when a person pages through a genre: the next page of titles after
// a second handle on the same cache file fetched it (as the store class's prefetch thread does),
// against a page that nobody fetched before.
#include <benchmark/benchmark.h>

#include <stdint.h>

#include "VLTestDir.h"
#include "VLTestSimulator.h"
#include "VL_WS.h"

namespace {

// Genre 1 holds every film; one title per page gives enough pages that no timed page repeats.
const int kGenre = 1;
const int kItemsPerPage = 1;
const int kPages = 100;

VL_WS_Status TitlesPage(VL_WS_Handle* handle, int page) {
  VL_WS_TitlesResponse response;
  VL_WS_Status status = VL_WS_getTitles(handle, kGenre, page, kItemsPerPage, 2, &response);
  VL_WS_release(&response);
  return status;
}

void BM_NextPage(benchmark::State& state) {
  const bool prefetched = state.range(0) != 0;
  VLSimServer& sim = VLTestSimulator();
  VLTestDir dir;
  VL_WS_SetupParams params = VLTestSetupParams();
  params.CacheType = 2;
  params.CacheData = VL_WS_CacheParam::CACHE_METADATA;
  params.CachePath = dir.path().c_str();
  VL_WS_Handle main = {}, prefetch = {};
  if (VL_WS_initialize(&main, &params) != VL_WS_OK || VL_WS_duplicate(&prefetch, &main) != VL_WS_OK) {
    state.SkipWithError("no client");
  } else if (prefetched) {
    for (int page = 1; page <= kPages; ++page) {
      if (TitlesPage(&prefetch, page) != VL_WS_OK) {
        state.SkipWithError("the prefetch failed");
        break;
      }
    }
  }
  sim.WaitForRequests(SIZE_MAX, 100);
  sim.ClearRequests();
  int page = 0;
  for (auto _ : state) {
    if (TitlesPage(&main, ++page) != VL_WS_OK) {
      state.SkipWithError("a call failed");
      break;
    }
  }
  if (prefetched && !sim.Requests().empty()) state.SkipWithError("a prefetched page reached the store");
  VL_WS_release(&prefetch);
  VL_WS_release(&main);
}
BENCHMARK(BM_NextPage)->ArgName("prefetched")->Arg(0)->Arg(1)->Iterations(kPages)->UseRealTime();

}  // namespace

BENCHMARK_MAIN();
