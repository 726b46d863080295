// The client against its peers, side by side on the in-process simulator: a page of titles over
// the network by the client, the same page by node-soap, the client's request bytes posted by
// curl (a new connection each), and a box-art image downloaded to a file by the client and by
// curl. Every benchmark reports the counters "cpu" and "wall", seconds per call; the CPU of curl
// and node-soap is that of their processes, the client's that of the calling thread (the
// simulator's threads are not the client's).
//
// node-soap comes from build/bench/peer (bench/report.py installs it there with the WSDL it
// reads); without it that benchmark says so.
#include <benchmark/benchmark.h>

#include <fcntl.h>
#include <spawn.h>
#include <stdlib.h>
#include <sys/resource.h>
#include <sys/wait.h>
#include <time.h>
#include <unistd.h>

#include <string>
#include <vector>

#include "BoxArtDownloader.h"
#include "VLBenchClient.h"
#include "VLSimTestClient.h"
#include "VLUtilities.h"
#include "VL_WS_Client.h"

extern char** environ;

namespace {

const char kStoreHost[] = "store.ostrel.example";

double Seconds(clockid_t clock) {
  timespec t;
  clock_gettime(clock, &t);
  return t.tv_sec + t.tv_nsec / 1e9;
}

// The CPU and wall seconds of a benchmark's calls, reported per call when it ends.
class PerCall {
 public:
  explicit PerCall(benchmark::State& state) : m_State(state) {}
  ~PerCall() {
    m_State.counters["cpu"] = benchmark::Counter(m_Cpu, benchmark::Counter::kAvgIterations);
    m_State.counters["wall"] = benchmark::Counter(m_Wall, benchmark::Counter::kAvgIterations);
  }
  void Add(double cpu, double wall) {
    m_Cpu += cpu;
    m_Wall += wall;
  }

 private:
  benchmark::State& m_State;
  double m_Cpu = 0, m_Wall = 0;
};

struct Child {
  bool ok = false;  // ran and exited with status 0
  double cpu = 0, wall = 0;
  std::string out;  // standard output
};

// Runs argv with the process's environment and returns what it printed, its CPU and wall time.
Child Run(const std::vector<std::string>& argv) {
  Child child;
  int out[2];
  if (pipe2(out, O_CLOEXEC) != 0) return child;
  posix_spawn_file_actions_t actions;
  posix_spawn_file_actions_init(&actions);
  posix_spawn_file_actions_adddup2(&actions, out[1], 1);
  std::vector<char*> args;
  for (const std::string& a : argv) args.push_back(const_cast<char*>(a.c_str()));
  args.push_back(nullptr);
  double start = Seconds(CLOCK_MONOTONIC);
  pid_t pid;
  int spawned = posix_spawnp(&pid, args[0], &actions, nullptr, args.data(), environ);
  posix_spawn_file_actions_destroy(&actions);
  close(out[1]);
  char buffer[4096];
  for (ssize_t n; spawned == 0 && (n = read(out[0], buffer, sizeof buffer)) != 0;)
    if (n > 0) child.out.append(buffer, static_cast<size_t>(n));
  close(out[0]);
  if (spawned != 0) return child;
  int status = 0;
  rusage usage;
  if (wait4(pid, &status, 0, &usage) != pid) return child;
  child.wall = Seconds(CLOCK_MONOTONIC) - start;
  child.cpu = usage.ru_utime.tv_sec + usage.ru_utime.tv_usec / 1e6 + usage.ru_stime.tv_sec + usage.ru_stime.tv_usec / 1e6;
  child.ok = WIFEXITED(status) && WEXITSTATUS(status) == 0;
  return child;
}

// curl's options that reach the simulator as the client does: VLWS_CONNECT_TO and its CA.
std::vector<std::string> Curl() {
  VLSimServer& sim = VLTestSimulator();
  std::vector<std::string> argv = {"curl", "-sS", "-w", "%{http_code}", "--cacert", sim.CAFile()};
  std::string entries = sim.ConnectTo();
  for (size_t at = 0, end; at < entries.size(); at = end + 1) {
    end = entries.find(',', at);
    if (end == std::string::npos) end = entries.size();
    argv.insert(argv.end(), {"--connect-to", entries.substr(at, end - at)});
  }
  return argv;
}

// The page of every figure, which must hold its 20 titles.
bool TitlesPage(VL_WS_Handle* handle) {
  VL_WS_TitlesResponse page;
  VL_WS_Status status = VL_WS_getTitles(handle, 1, 1, 20, 2, &page);
  bool ok = status == VL_WS_OK && page.Titles.Count == 20;
  VL_WS_release(&page);
  return ok;
}

void BM_ClientTitles(benchmark::State& state) {
  VLTestSimulator();
  VLBenchClient client;
  if (!client.ok() || !TitlesPage(client.handle())) return state.SkipWithError("the first call failed");
  PerCall calls(state);
  for (auto _ : state) {
    double cpu = Seconds(CLOCK_THREAD_CPUTIME_ID), wall = Seconds(CLOCK_MONOTONIC);
    if (!TitlesPage(client.handle())) return state.SkipWithError("a call failed");
    calls.Add(Seconds(CLOCK_THREAD_CPUTIME_ID) - cpu, Seconds(CLOCK_MONOTONIC) - wall);
  }
}
BENCHMARK(BM_ClientTitles)->UseRealTime();

void BM_NodeSoapTitles(benchmark::State& state) {
  const std::string peer = VL_BENCH_BINARY_DIR "/peer";
  if (access((peer + "/node_modules/soap").c_str(), F_OK) != 0)
    return state.SkipWithError("node-soap is not installed in build/bench/peer (./run bench installs it)");
  VLSimOptions sim = VLTestSimulator().Options();
  setenv("NODE_PATH", (peer + "/node_modules").c_str(), 1);
  setenv("VL_USER", sim.userName.c_str(), 1);
  setenv("VL_PASSWORD", sim.password.c_str(), 1);
  setenv("VL_API_KEY", sim.apiKey.c_str(), 1);
  const int series = 50;
  PerCall calls(state);
  for (auto _ : state) {
    Child node = Run({"node", VL_BENCH_SOURCE_DIR "/peer/titles.js", peer + "/RealTimeBrowseSoap12.wsdl",
                      std::to_string(series)});
    double cpu = 0, wall = 0;
    int titles = 0;
    if (!node.ok || sscanf(node.out.c_str(), "{\"calls\":%*d,\"cpu\":%lf,\"wall\":%lf,\"titles\":%d", &cpu, &wall,
                           &titles) != 3 || titles != 20)
      return state.SkipWithError(("node-soap failed: " + node.out).c_str());
    calls.Add(cpu, wall);
  }
}
BENCHMARK(BM_NodeSoapTitles)->Iterations(1)->UseRealTime();

void BM_CurlPostsTheClientsRequest(benchmark::State& state) {
  VLTestSimulator();
  VLBenchClient client;
  // The bytes the client sends for the page; the store takes every nonce once, so each post has a
  // new UsernameToken.
  bool ok = false;
  std::string request = VLRawLogOf([&] { ok = client.ok() && TitlesPage(client.handle()); }).sent;
  size_t body = request.find("\r\n\r\n");
  size_t action = request.find("SOAPAction: ");
  if (!ok || body == std::string::npos || action == std::string::npos) return state.SkipWithError("no request captured");
  std::string soapAction = request.substr(action, request.find("\r\n", action) - action);
  VLTestDir dir;
  const std::string file = dir / "request.xml";
  std::vector<std::string> argv = Curl();
  argv.insert(argv.end(), {"-o", "/dev/null", "-H", "Content-Type: text/xml; charset=utf-8", "-H", soapAction,
                           "--data-binary", "@" + file, std::string("https://") + kStoreHost + "/api/RealTimeBrowse.asmx"});
  PerCall calls(state);
  for (auto _ : state) {
    state.PauseTiming();
    bool written =
        VLWriteFile(file, VLWithNewToken(request.substr(body + 4), VLTestSimulator().Options().password, time(nullptr)));
    state.ResumeTiming();
    Child curl = Run(argv);
    if (!written || !curl.ok || curl.out != "200") return state.SkipWithError(("curl failed: " + curl.out).c_str());
    calls.Add(curl.cpu, curl.wall);
  }
}
BENCHMARK(BM_CurlPostsTheClientsRequest)->UseRealTime();

// The largest box-art image (321) of the first title, written to a file each time.
const std::string& BoxArtPrefix() { return VLTestSimulator().Catalogue().Titles().front().boxArt; }

void BM_ClientBoxArtToFile(benchmark::State& state) {
  VLTestSimulator();
  VLBenchClient client;
  VLTestDir dir;
  const VLString file((dir / "art.jpg").c_str());
  PerCall calls(state);
  for (auto _ : state) {
    double cpu = Seconds(CLOCK_THREAD_CPUTIME_ID), wall = Seconds(CLOCK_MONOTONIC);
    BoxArtDownloader downloader(&client.handle()->client->m_RealTimeBrowse);
    if (!client.ok() || downloader.DownloadToFile(BoxArtPrefix().c_str(), VL_WS_BOXART_321, "", file) != VL_WS_OK)
      return state.SkipWithError("a download failed");
    calls.Add(Seconds(CLOCK_THREAD_CPUTIME_ID) - cpu, Seconds(CLOCK_MONOTONIC) - wall);
  }
}
BENCHMARK(BM_ClientBoxArtToFile)->UseRealTime();

void BM_CurlBoxArtToFile(benchmark::State& state) {
  VLTestDir dir;
  std::vector<std::string> argv = Curl();
  argv.insert(argv.end(), {"-o", dir / "art.jpg", VLUtilities::GetBoxArtImageURL(BoxArtPrefix().c_str(), VL_WS_BOXART_321).c_str()});
  PerCall calls(state);
  for (auto _ : state) {
    Child curl = Run(argv);
    if (!curl.ok || curl.out != "200") return state.SkipWithError(("curl failed: " + curl.out).c_str());
    calls.Add(curl.cpu, curl.wall);
  }
}
BENCHMARK(BM_CurlBoxArtToFile)->UseRealTime();

}  // namespace

BENCHMARK_MAIN();
