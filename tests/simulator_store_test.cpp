// The simulator's sample store and its rules without the network, the fault language, and the
// vlstore-sim program's options, exit codes and shutdown.
#include <arpa/inet.h>
#include <gtest/gtest.h>
#include <netinet/in.h>
#include <signal.h>
#include <sys/socket.h>
#include <sys/wait.h>
#include <unistd.h>

#include <cstdio>
#include <fstream>
#include <set>

#include "VLSimBoxArt.h"
#include "VLSimServer.h"
#include "VLTestDir.h"

namespace {

const std::string kData = VL_SOURCE_DIR "/simulator/data";
const std::string kProgram = VL_BINARY_DIR "/simulator/vlstore-sim";

TEST(SimulatorCatalogue, SampleStoreIsLargeEnoughToPageAndHasEveryKindOfRecord) {
  VLSimCatalogue catalogue;
  std::string error;
  ASSERT_TRUE(catalogue.Load(kData, &error)) << error;
  EXPECT_GE(catalogue.Titles().size(), 150u);
  std::set<int> genresUsed;
  bool tv = false, hiddenUsed = false, spacePrefix = false, bonus = false, rent = false, buy = false;
  for (const VLSimTitle& title : catalogue.Titles()) {
    genresUsed.insert(title.genres.begin(), title.genres.end());
    if (title.tv && !title.episodes.empty()) tv = true;
    if (title.boxArt.find(' ') != std::string::npos) spacePrefix = true;
    if (!title.bonus.empty()) bonus = true;
    for (int genre : title.genres)
      if (!catalogue.FindGenre(genre)->visible) hiddenUsed = true;
    for (int sku : title.products) {
      const VLSimProduct* product = catalogue.FindProduct(sku);
      (product->purchaseType == 0 ? rent : buy) = true;
      EXPECT_FALSE(product->profiles.empty());
      EXPECT_FALSE(product->audio.empty());
      EXPECT_FALSE(product->expireDate.empty());
    }
    EXPECT_NE(nullptr, catalogue.FindTivo(title.tivoId)) << title.id;
  }
  EXPECT_GE(genresUsed.size(), 10u);
  EXPECT_TRUE(tv && hiddenUsed && spacePrefix && bonus && rent && buy);
  EXPECT_FALSE(catalogue.Search("harbor", false).empty());
  EXPECT_EQ(10u, catalogue.Recommendations(catalogue.Titles()[0].id).size());
}

TEST(SimulatorCatalogue, DataErrorsNameTheFileAndLine) {
  VLTestDir dir;
  for (const char* name : {"genres.tsv", "titles.tsv", "products.tsv", "episodes.tsv", "bonus.tsv", "accounts.tsv",
                           "giftcertificates.tsv", "config.tsv"})
    ASSERT_TRUE(VLWriteFile(dir / name, VLReadFile(kData + "/" + name)));
  struct Case {
    const char* file;
    const char* line;  // appended
    const char* expected;
  } cases[] = {{"products.tsv", "9999\t1001\t0\trent\t3.9\t48\tx\tSTANDARD\tStereo_Standard\n", "price"},
               {"products.tsv", "9998\t1001\t0\trent\t3.99\t48\tx\tHD\tStereo_Standard\n", "unknown value \"HD\""},
               {"genres.tsv", "77\t76\t1\tOrphan\tNo parent\n", "unknown parent"},
               {"episodes.tsv", "1\t1001\t1\tNot a series\n", "not a television series"},
               {"titles.tsv", "5000\tmovie\ttoo few fields\n", "expected 21 fields"}};
  for (const Case& c : cases) {
    SCOPED_TRACE(c.file);
    std::string original = VLReadFile(dir / c.file);
    ASSERT_TRUE(VLWriteFile(dir / c.file, original + c.line));
    VLSimCatalogue catalogue;
    std::string error;
    EXPECT_FALSE(catalogue.Load(dir.path(), &error));
    EXPECT_EQ(0u, error.find(std::string(c.file) + ":")) << error;
    EXPECT_NE(std::string::npos, error.find(c.expected)) << error;
    ASSERT_TRUE(VLWriteFile(dir / c.file, original));
  }
  VLSimOptions options;
  options.dataFolder = dir.path() + "missing";
  VLSimServer server(options);
  std::string error;
  EXPECT_FALSE(server.Start(&error));
  EXPECT_NE(std::string::npos, error.find("genres.tsv")) << error;
}

TEST(SimulatorStore, GiftCertificatesTaxAndStreamsFollowTheAccount) {
  VLSimCatalogue catalogue;
  std::string error;
  ASSERT_TRUE(catalogue.Load(kData, &error)) << error;
  VLSimStore store(catalogue);
  int carol = store.AccountForPin("2468");
  ASSERT_NE(0, carol);
  int balance = 0;
  EXPECT_EQ(VLSimCode::kUnknownGift, store.RedeemGift(carol, "NOPE", &balance));
  EXPECT_EQ(0, store.RedeemGift(carol, "GIFT-1000", &balance));
  EXPECT_EQ(1800, balance);
  EXPECT_EQ(VLSimCode::kGiftRedeemed, store.RedeemGift(store.AccountForPin("1234"), "GIFT-1000", &balance));
  EXPECT_EQ(VLSimCode::kGiftNotAuthorised, store.RedeemGift(0, "GIFT-2500", &balance));

  VLSimTax tax;
  int alice = store.AccountForPin("1234");
  const VLSimProduct* product = catalogue.FindProduct(catalogue.Titles()[0].products[0]);
  ASSERT_EQ(0, store.OrderTax(alice, product->sku, &tax));
  EXPECT_EQ(product->price, tax.subTotal);
  EXPECT_EQ(VLSimCode::kTaxNoBilling, store.OrderTax(carol, product->sku, &tax));
  EXPECT_EQ(VLSimCode::kTaxUnknownSku, store.OrderTax(alice, 1, &tax));

  VLSimPurchase purchase = store.Purchase(alice, product->sku, "10.0.0.1", false);
  ASSERT_EQ(0, purchase.code);
  VLSimStream stream;
  EXPECT_EQ(VLSimCode::kNoPreviousStream, store.LastStream(alice, purchase.pass, &stream));
  EXPECT_EQ(VLSimCode::kUnknownItem, store.StartStream(carol, purchase.pass, product->profiles[0], &stream));
  EXPECT_EQ(VLSimCode::kProfileUnavailable, store.StartStream(alice, purchase.pass, 10, &stream));
  ASSERT_EQ(0, store.StartStream(alice, purchase.pass, product->profiles[0], &stream));
  EXPECT_EQ(0, stream.startSeconds);
  EXPECT_EQ(0, store.ReportStream(alice, stream.id, 2, 1234));
  EXPECT_EQ(VLSimCode::kUnknownItem, store.ReportStream(carol, stream.id, 2, 1));
  ASSERT_EQ(0, store.LastStream(alice, purchase.pass, &stream));
  EXPECT_EQ(1234, stream.startSeconds) << "playback resumes where it stopped";
  EXPECT_EQ(1u, store.StatusReports().size());
  if (product->purchaseType == 0) {
    store.AdvanceClock(product->rentalHours * 3600 + 1);
    EXPECT_EQ(VLSimCode::kRentalExpired, store.StartStream(alice, purchase.pass, product->profiles[0], &stream));
  }
}

TEST(SimulatorFaults, ParseTheWrittenFormAndRefuseNonsense) {
  VLSimFault fault;
  std::string error;
  for (const char* good : {"getTitlesByNavigation=status:503", "/device/time/=delay:2000,times=2", "*=gzip",
                           "stg.ostrel.example=tls:wronghost", "getConfig=code:4", "x=soapfault:client",
                           "x=badlength:-3", "x=trickle:0"}) {
    EXPECT_TRUE(VLSimFault::Parse(good, &fault, &error)) << good << ": " << error;
    EXPECT_EQ(good, fault.ToString()) << "the written form survives a round trip";
  }
  for (const char* bad : {"noequals", "=close", "x=explode", "x=status", "x=status:99", "x=delay:-1",
                          "x=tls:nice", "x=close:3", "x=close,times=0", "x=gzip,often", "x=soapfault:maybe"}) {
    EXPECT_FALSE(VLSimFault::Parse(bad, &fault, &error)) << bad;
    EXPECT_FALSE(error.empty());
  }
  VLSimFaults faults;
  VLSimFault::Parse("/images/=close,times=1", &fault, &error);
  faults.Add(fault);
  VLSimFault::Parse("getConfig=gzip", &fault, &error);
  faults.Add(fault);
  EXPECT_TRUE(faults.Take("", "/device/time/").empty());
  EXPECT_EQ(1u, faults.Take("", "/images/boxart/95/a95.jpg").size());
  EXPECT_TRUE(faults.Take("", "/images/boxart/95/a95.jpg").empty()) << "times=1 is used up";
  EXPECT_EQ(1u, faults.Take("getConfig", "/api/StreamAPI.asmx").size());
  EXPECT_EQ(1u, faults.Take("getConfig", "/api/StreamAPI.asmx").size());
}

TEST(SimulatorBoxArt, PathsCarryTheSizeWordsAndAnEncodedPrefix) {
  std::string prefix;
  int size = -1;
  EXPECT_TRUE(VLSimParseBoxArtPath("/images/boxart/135s/abc135.jpg", &prefix, &size));
  EXPECT_EQ("abc", prefix);
  EXPECT_EQ(6, size);
  EXPECT_TRUE(VLSimParseBoxArtPath("/images/boxart/321/a%20b321.jpg", &prefix, &size));
  EXPECT_EQ("a b", prefix);
  EXPECT_EQ(12, size);
  for (const char* bad : {"/images/boxart/135/abc135.jpg", "/images/boxart/175/abc95.jpg", "/images/boxart/175/175.jpg",
                          "/images/other/175/a175.jpg", "/images/boxart/175"})
    EXPECT_FALSE(VLSimParseBoxArtPath(bad, &prefix, &size)) << bad;
}

// ---- The program ----

struct ProgramRun {
  int status = -1;
  std::string output;
};

// Runs vlstore-sim with args; with stopAfterStart it sends SIGTERM once the settings are printed.
ProgramRun RunProgram(const std::vector<std::string>& args, bool stopAfterStart) {
  int pipeFds[2];
  ProgramRun run;
  if (pipe(pipeFds) != 0) return run;
  pid_t pid = fork();
  if (pid == 0) {
    dup2(pipeFds[1], 1);
    dup2(pipeFds[1], 2);
    close(pipeFds[0]);
    std::vector<char*> argv = {const_cast<char*>(kProgram.c_str())};
    for (const std::string& arg : args) argv.push_back(const_cast<char*>(arg.c_str()));
    argv.push_back(nullptr);
    execv(kProgram.c_str(), argv.data());
    _exit(127);
  }
  close(pipeFds[1]);
  char buffer[4096];
  ssize_t n;
  bool signalled = false;
  while ((n = read(pipeFds[0], buffer, sizeof buffer)) > 0) {
    run.output.append(buffer, n);
    if (stopAfterStart && !signalled && run.output.find("export VLWS_CONNECT_TO=") != std::string::npos &&
        run.output.find('\n', run.output.find("export VLWS_CONNECT_TO=")) != std::string::npos) {
      kill(pid, SIGTERM);
      signalled = true;
    }
  }
  close(pipeFds[0]);
  int status = 0;
  waitpid(pid, &status, 0);
  run.status = WIFEXITED(status) ? WEXITSTATUS(status) : 128 + WTERMSIG(status);
  return run;
}

TEST(SimulatorProgram, HelpBadOptionsAndBusyPortsHaveTheirExitCodes) {
  ProgramRun help = RunProgram({"--help"}, false);
  EXPECT_EQ(0, help.status);
  EXPECT_NE(std::string::npos, help.output.find("usage: vlstore-sim"));

  for (std::vector<std::string> bad : std::vector<std::vector<std::string>>{
           {"--frobnicate"}, {"--tls-port"}, {"--tls-port", "70000"}, {"--fault", "x=explode"},
           {"--device-env", "nodigit"}}) {
    ProgramRun run = RunProgram(bad, false);
    EXPECT_EQ(2, run.status) << bad[0] << ": " << run.output;
    EXPECT_NE(std::string::npos, run.output.find("vlstore-sim: ")) << run.output;
  }

  int busy = socket(AF_INET, SOCK_STREAM, 0);
  struct sockaddr_in sin = {};
  sin.sin_family = AF_INET;
  sin.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
  ASSERT_EQ(0, bind(busy, reinterpret_cast<struct sockaddr*>(&sin), sizeof sin));
  ASSERT_EQ(0, listen(busy, 1));
  socklen_t length = sizeof sin;
  getsockname(busy, reinterpret_cast<struct sockaddr*>(&sin), &length);
  ProgramRun run = RunProgram({"--http-port", std::to_string(ntohs(sin.sin_port)), "--quiet"}, false);
  close(busy);
  EXPECT_EQ(3, run.status) << run.output;
  EXPECT_NE(std::string::npos, run.output.find("in use")) << run.output;
}

TEST(SimulatorProgram, PrintsTheClientSettingsAndStopsCleanlyOnSigterm) {
  VLTestDir dir;
  ProgramRun run = RunProgram({"--cert-dir", dir.path(), "--env-file", dir / "env.sh", "--quiet"}, true);
  EXPECT_EQ(0, run.status) << run.output;
  EXPECT_NE(std::string::npos, run.output.find("export SSL_CERT_FILE=" + dir.path() + "/ca.pem"));
  EXPECT_NE(std::string::npos, run.output.find("SIGTERM, stopping"));
  std::string env = VLReadFile(dir / "env.sh");
  EXPECT_EQ(0u, env.find("export SSL_CERT_FILE="));
  EXPECT_NE(std::string::npos, env.find("export VLWS_CONNECT_TO=store.ostrel.example:443:127.0.0.1:"));
  EXPECT_NE(std::string::npos, VLReadFile(dir / "ca.pem").find("BEGIN CERTIFICATE"));
}

}  // namespace
