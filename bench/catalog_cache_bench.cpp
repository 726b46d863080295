// What the local cache saves on a device: a page of titles and a box-art image asked for again,
// answered by the store over TLS (no cache), from the in-memory cache and from the file cache.
// A cached benchmark fails when any of its timed calls reaches the store.
#include <benchmark/benchmark.h>

#include <string>

#include "VLBenchClient.h"

namespace {

enum CacheType { NO_CACHE = 0, MEMORY_CACHE = 1, FILE_CACHE = 2 };

// Runs call once untimed (which fills a cache), then times it; fails the benchmark when a call
// fails, or when a cached client sends any request while timed.
template <class Call>
void RunRepeated(benchmark::State& state, int cacheType, Call call) {
  VLSimServer& sim = VLTestSimulator();
  VLBenchClient client(cacheType);
  if (!client.ok() || call(client.handle()) != VL_WS_OK) {
    state.SkipWithError("the first call failed");
    return;
  }
  sim.ClearRequests();
  for (auto _ : state) {
    if (call(client.handle()) != VL_WS_OK) {
      state.SkipWithError("a call failed");
      return;
    }
  }
  if (cacheType != NO_CACHE && !sim.Requests().empty()) state.SkipWithError("a cached call reached the store");
}

void BM_TitlesPage(benchmark::State& state) {
  RunRepeated(state, static_cast<int>(state.range(0)), [](VL_WS_Handle* handle) { return VLBenchTitlesPage(handle); });
}
BENCHMARK(BM_TitlesPage)->ArgName("cache")->Arg(NO_CACHE)->Arg(MEMORY_CACHE)->Arg(FILE_CACHE)->UseRealTime();

// The largest box-art image (321) of the first title.
void BM_BoxArtImage(benchmark::State& state) {
  const std::string prefix = VLTestSimulator().Catalogue().Titles().front().boxArt;
  RunRepeated(state, static_cast<int>(state.range(0)), [&prefix](VL_WS_Handle* handle) {
    VL_WS_Image image;
    VL_WS_Status status = VL_WS_getBoxArtImageData(handle, VL_WS_BOXART_321, prefix.c_str(), &image);
    VL_WS_release(&image);
    return status;
  });
}
BENCHMARK(BM_BoxArtImage)->ArgName("cache")->Arg(NO_CACHE)->Arg(MEMORY_CACHE)->Arg(FILE_CACHE)->UseRealTime();

}  // namespace

BENCHMARK_MAIN();
