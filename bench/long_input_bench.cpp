// Work on long input must grow in proportion to its length: writing one setting into a settings
// file of n settings, and the image URL of a box-art prefix of n bytes. Each reports its
// complexity in n; anything worse than linear is a fault.
#include <benchmark/benchmark.h>

#include <string>

#include "VLTestDir.h"
#include "VLUtilities.h"
#include "VL_WS.h"

namespace {

void BM_WriteSettingIntoAFileOfNSettings(benchmark::State& state) {
  VLTestDir dir;
  const std::string file = dir / "settings.xml";
  std::string xml = "<DUDUVud xmlns:VL1=\"http://store.ostrel.example/api/\">";
  for (int64_t i = 0; i < state.range(0); ++i)
    xml += "<VL1:Configuration Key=\"K" + std::to_string(i) + "\"><VL1:Value>v</VL1:Value></VL1:Configuration>";
  xml += "</DUDUVud>";
  if (!VLWriteFile(file, xml)) state.SkipWithError("the settings file cannot be written");
  for (auto _ : state) {
    if (VL_WS_writeSetting(file.c_str(), "Volume", "7", false) != VL_WS_OK) {
      state.SkipWithError("a write failed");
      return;
    }
  }
  state.SetComplexityN(state.range(0));
}
BENCHMARK(BM_WriteSettingIntoAFileOfNSettings)->RangeMultiplier(4)->Range(1 << 10, 1 << 16)->Complexity();

void BM_BoxArtURLOfAPrefixOfNBytes(benchmark::State& state) {
  const std::string prefix(static_cast<size_t>(state.range(0)), 'a');
  for (auto _ : state) benchmark::DoNotOptimize(VLUtilities::GetBoxArtImageURL(prefix.c_str(), VL_WS_BOXART_175));
  state.SetComplexityN(state.range(0));
}
BENCHMARK(BM_BoxArtURLOfAPrefixOfNBytes)->RangeMultiplier(4)->Range(16 << 10, 1 << 20)->Complexity();

}  // namespace

BENCHMARK_MAIN();
