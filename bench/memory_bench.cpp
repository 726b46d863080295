// The memory of a process that uses the client: 200 calls that reach the store and 1,000 that a
// cache answers, in two halves alike. Each half makes a handle with a new file cache, asks it for
// 100 pages of titles under keys of their own (pages 1 to 5 of 16 to 35 titles), each followed by
// five cache hits of the same page, and releases it. The store simulator runs in a child process,
// so that the heap counted is the client's alone. Counters, in bytes: the heap in use above what
// the process had before its first client call, at the end of each half (before the release) and
// at its highest (sampled after every call), the growth from the first half to the second, and
// the resident size likewise (after giving free memory back to the system).
//
// Run it with GLIBC_TUNABLES=glibc.malloc.tcache_count=0 (bench/report.py does): glibc counts the
// freed blocks its per-thread cache keeps as in use, which would show as growth.
#include <benchmark/benchmark.h>

#include <malloc.h>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>
#include <sys/wait.h>
#include <unistd.h>

#include <algorithm>
#include <string>

#include "VLBenchClient.h"

namespace {

double HeapInUse() {
  struct mallinfo2 info = mallinfo2();
  return static_cast<double>(info.uordblks + info.hblkhd);
}

// A field of /proc/self/status in bytes ("VmRSS", "VmHWM").
double Status(const char* field) {
  FILE* status = fopen("/proc/self/status", "r");
  char line[256];
  double kib = 0;
  size_t length = strlen(field);
  while (status && fgets(line, sizeof line, status))
    if (strncmp(line, field, length) == 0 && line[length] == ':') kib = atof(line + length + 1);
  if (status) fclose(status);
  return kib * 1024;
}

void BM_CachedAndNetworkCalls(benchmark::State& state) {
  const int kNetworkCalls = 100, kCachedPerNetworkCall = 5;  // per half
  for (auto _ : state) {
    malloc_trim(0);
    double base = HeapInUse(), rssBase = Status("VmRSS"), peak = 0;
    double heap[2] = {0, 0}, rss[2] = {0, 0};
    for (int half = 0; half < 2; ++half) {
      bool ok;
      {
        VLBenchClient client(2, VL_WS_CacheParam::CACHE_METADATA);
        ok = client.ok();
        for (int call = 0; ok && call < kNetworkCalls; ++call) {
          int page = call % 5 + 1, items = 16 + call / 5;
          for (int again = 0; ok && again <= kCachedPerNetworkCall; ++again)
            ok = VLBenchTitlesPage(client.handle(), page, items) == VL_WS_OK;
          peak = std::max(peak, HeapInUse() - base);
        }
        heap[half] = HeapInUse() - base;
        malloc_trim(0);
        rss[half] = Status("VmRSS") - rssBase;
      }
      if (!ok) return state.SkipWithError("a call failed");
    }
    state.counters["heap_peak"] = peak;
    state.counters["heap_half1"] = heap[0];
    state.counters["heap_half2"] = heap[1];
    state.counters["heap_growth"] = heap[1] - heap[0];
    state.counters["rss_peak"] = Status("VmHWM") - rssBase;
    state.counters["rss_half1"] = rss[0];
    state.counters["rss_half2"] = rss[1];
    state.counters["rss_growth"] = rss[1] - rss[0];
  }
}
BENCHMARK(BM_CachedAndNetworkCalls)->Iterations(1);

// The simulator's process and the pipe that keeps it serving while open.
pid_t s_Simulator = -1;
int s_Alive = -1;

// Starts the simulator in a child process, made before this process has a thread, and points
// the client at it. The child serves until StopSimulatorChild (or this process's end).
bool StartSimulatorChild() {
  int settings[2], alive[2];
  if (pipe(settings) != 0 || pipe(alive) != 0) return false;
  pid_t pid = fork();
  if (pid < 0) return false;
  if (pid == 0) {
    close(settings[0]);
    close(alive[1]);
    VLSimServer sim;
    std::string error;
    if (!sim.Start(&error)) _exit(1);
    std::string text = sim.CAFile() + "\n" + sim.ConnectTo() + "\n";
    if (write(settings[1], text.data(), text.size()) != static_cast<ssize_t>(text.size())) _exit(1);
    close(settings[1]);
    char byte;
    while (read(alive[0], &byte, 1) > 0) {
    }
    sim.Stop();
    _exit(0);
  }
  s_Simulator = pid;
  s_Alive = alive[1];
  close(settings[1]);
  close(alive[0]);
  std::string text;
  char buffer[4096];
  for (ssize_t n; (n = read(settings[0], buffer, sizeof buffer)) > 0;) text.append(buffer, static_cast<size_t>(n));
  close(settings[0]);
  size_t line = text.find('\n');
  if (line == std::string::npos || text.size() < line + 2) return false;
  setenv("SSL_CERT_FILE", text.substr(0, line).c_str(), 1);
  setenv("VLWS_CONNECT_TO", text.substr(line + 1, text.size() - line - 2).c_str(), 1);
  return true;
}

void StopSimulatorChild() {
  close(s_Alive);
  waitpid(s_Simulator, nullptr, 0);
}

}  // namespace

int main(int argc, char** argv) {
  if (!StartSimulatorChild()) {
    fprintf(stderr, "the store simulator does not start\n");
    return 1;
  }
  benchmark::Initialize(&argc, argv);
  benchmark::RunSpecifiedBenchmarks();
  benchmark::Shutdown();
  StopSimulatorChild();
  return 0;
}
