// What page prefetching saves when a person pages through a genre, one 20-title page after the
// other: the next page after a second handle on the same cache file fetched it (as the store
// class's prefetch thread does, between the two pages), against a page that nobody fetched
// before, and against the page shown asked for again (a plain cache hit). Only the main handle's
// call is timed; the untimed work makes every timed page one that the main handle has not read.
#include <benchmark/benchmark.h>

#include <memory>

#include "VLBenchClient.h"

namespace {

// Genre 1 holds every film: eight pages of 20 titles.
const int kPages = 8;

enum Kind { NOT_PREFETCHED, PREFETCHED, SHOWN_AGAIN };

// The main handle on a new cache file and its prefetching duplicate.
struct Handles {
  Handles() { ok = main.ok() && VL_WS_duplicate(&prefetch, main.handle()) == VL_WS_OK; }
  ~Handles() { VL_WS_release(&prefetch); }
  VLBenchClient main{2, VL_WS_CacheParam::CACHE_METADATA};
  VL_WS_Handle prefetch = {};
  bool ok;
};

void BM_NextPage(benchmark::State& state, Kind kind) {
  VLTestSimulator();
  std::unique_ptr<Handles> handles;
  int page = 0;
  for (auto _ : state) {
    state.PauseTiming();
    if (page == kPages || !handles) {  // every page is in the cache: start again on a new file
      handles.reset();
      handles.reset(new Handles);
      page = 0;
    }
    ++page;
    bool ready = handles->ok && (kind == NOT_PREFETCHED ||
                                 VLBenchTitlesPage(kind == PREFETCHED ? &handles->prefetch : handles->main.handle(),
                                                   page) == VL_WS_OK);
    state.ResumeTiming();
    if (!ready || VLBenchTitlesPage(handles->main.handle(), page) != VL_WS_OK) return state.SkipWithError("a call failed");
  }
}
// A fixed count: the untimed work (a page from the store, kept in the cache file) takes far
// longer than the timed page.
const int kIterations = 8 * kPages;
BENCHMARK_CAPTURE(BM_NextPage, not_prefetched, NOT_PREFETCHED)->Iterations(kIterations)->UseRealTime();
BENCHMARK_CAPTURE(BM_NextPage, prefetched, PREFETCHED)->Iterations(kIterations)->UseRealTime();
BENCHMARK_CAPTURE(BM_NextPage, shown_again, SHOWN_AGAIN)->Iterations(kIterations)->UseRealTime();

}  // namespace

BENCHMARK_MAIN();
