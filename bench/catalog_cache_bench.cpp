// What the local cache saves on a device: a page of titles and a box-art image asked for again,
// answered by the store over TLS (no cache), from the in-memory cache and from the file cache.
// A cached benchmark fails when any of its timed calls reaches the store.
#include <benchmark/benchmark.h>

#include <stdint.h>

#include <string>

#include "VLTestDir.h"
#include "VLTestSimulator.h"
#include "VL_WS.h"

namespace {

enum CacheType { NO_CACHE = 0, MEMORY_CACHE = 1, FILE_CACHE = 2 };

// A client handle with the cache type given (all kinds of data cached), on the simulator.
class BenchClient {
 public:
  explicit BenchClient(int cacheType) {
    VL_WS_SetupParams params = VLTestSetupParams();
    params.CacheType = cacheType;
    params.CacheData = cacheType == NO_CACHE ? VL_WS_CacheParam::CACHE_NONE
                                             : static_cast<VL_WS_CacheParam::CacheData>(7);
    params.CachePath = m_Dir.path().c_str();
    m_Status = VL_WS_initialize(&m_Handle, &params);
  }
  ~BenchClient() { VL_WS_release(&m_Handle); }
  BenchClient(const BenchClient&) = delete;
  BenchClient& operator=(const BenchClient&) = delete;

  VL_WS_Status status() const { return m_Status; }
  VL_WS_Handle* handle() { return &m_Handle; }

 private:
  VLTestDir m_Dir;
  VL_WS_Handle m_Handle = {};
  VL_WS_Status m_Status;
};

// Runs call once untimed (which fills a cache), then times it; fails the benchmark when a call
// fails, or when a cached client sends any request while timed.
template <class Call>
void RunRepeated(benchmark::State& state, int cacheType, Call call) {
  VLSimServer& sim = VLTestSimulator();
  BenchClient client(cacheType);
  if (client.status() != VL_WS_OK || call(client.handle()) != VL_WS_OK) {
    state.SkipWithError("the first call failed");
    return;
  }
  // The simulator logs a request just after it answered it: let the log settle before emptying it.
  sim.WaitForRequests(SIZE_MAX, 100);
  sim.ClearRequests();
  for (auto _ : state) {
    if (call(client.handle()) != VL_WS_OK) {
      state.SkipWithError("a call failed");
      return;
    }
  }
  if (cacheType != NO_CACHE && !sim.Requests().empty()) state.SkipWithError("a cached call reached the store");
}

// Page 1 of 20 titles of genre 1, all purchase types.
void BM_TitlesPage(benchmark::State& state) {
  RunRepeated(state, static_cast<int>(state.range(0)), [](VL_WS_Handle* handle) {
    VL_WS_TitlesResponse page;
    VL_WS_Status status = VL_WS_getTitles(handle, 1, 1, 20, 2, &page);
    VL_WS_release(&page);
    return status;
  });
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
