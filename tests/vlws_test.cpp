// vlws, the command-line client, run as a user runs it against the program's store simulator:
// every operation, in the order a session needs (a token from authorize, a pass from a purchase,
// a stream from the pass), its whole output, the requests the store received and what a file
// cache kept compared with a transcript; wrong usage; a store that cannot be reached.
#include <gtest/gtest.h>
#include <stdlib.h>

#include <map>
#include <set>
#include <sstream>
#include <string>

#include "VLSimServer.h"
#include "VLTestCommand.h"
#include "VLTestDir.h"
#include "VLTestTranscript.h"

namespace {

class Vlws : public testing::Test {
 protected:
  // vlws runs in processes of its own, so this program's simulator can be one that answers
  // ReturnTimeout within the client's receive time-out. Its password holds a '#', which the
  // settings file keeps.
  static void SetUpTestSuite() {
    VLSimOptions options;
    options.returnTimeoutSeconds = 1;
    options.password = "vlsim#password";
    s_Sim = new VLSimServer(options);
    std::string error;
    ASSERT_TRUE(s_Sim->Start(&error)) << error;
    setenv("SSL_CERT_FILE", s_Sim->CAFile().c_str(), 1);
    setenv("VLWS_CONNECT_TO", s_Sim->ConnectTo().c_str(), 1);
  }
  static void TearDownTestSuite() { delete s_Sim; }

  void SetUp() override {
    const VLSimOptions& sim = s_Sim->Options();
    // The settings file gives the setup of the simulator's device; rows add the token.
    ASSERT_TRUE(VLWriteFile(m_Dir / "store.conf", "# the simulator\napi-key = " + sim.apiKey + "\nuser-name = " +
                                                      sim.userName + "\npassword=" + sim.password +
                                                      "\n  # any device\ndevice-id = 00-11-22-33-44-55\n"
                                                      "device-type = 7\n"));
    m_Vars["dir"] = m_Dir.path();
    m_Vars["cache"] = "--cache-type 2 --cache-path {dir}cache";
    m_Vars["long"] = std::string(300, 'q');
    m_Vars["password"] = sim.password;
    m_Vars["store"] = "--settings " + m_Dir / "store.conf";
  }

  // Runs vlws with the arguments, after replacing each {name} by its value.
  VLCommandRun Run(const std::string& arguments, const std::string& env = "") {
    return VLRunCommand(env + " " + VL_BINARY_DIR + "/vlws " + Expand(arguments));
  }

  std::string Expand(std::string text) const {
    for (const auto& var : m_Vars) {
      for (size_t at; (at = text.find("{" + var.first + "}")) != std::string::npos;) {
        text.replace(at, var.first.size() + 2, var.second);
      }
    }
    return text;
  }

  // The value of the first member "key" of a JSON text, without its quotes.
  static std::string Member(const std::string& json, const std::string& key) {
    size_t at = json.find("\"" + key + "\": ");
    if (at == std::string::npos) return "";
    at += key.size() + 4;
    if (json[at] == '"') return json.substr(at + 1, json.find('"', at + 1) - at - 1);
    return json.substr(at, json.find_first_of(",\n", at) - at);
  }

  // The text with what differs from run to run replaced: the test's folder, the long query, the
  // token, the stream and the pass that rows pass on by {dir}, {long}, {AuthToken}, {StreamID} and
  // {PassID}, and the values of the members named in varies (words separated by spaces) by
  // <varies>.
  std::string Masked(std::string text, const char* varies) const {
    for (const char* name : {"dir", "long", "AuthToken", "StreamID", "PassID"}) {
      auto var = m_Vars.find(name);
      if (var == m_Vars.end() || var->second.empty()) continue;
      const std::string prefix = name == std::string("PassID") ? "\"PassID\": " : "";  // a number: as a member only
      for (size_t at; (at = text.find(prefix + var->second)) != std::string::npos;) {
        text.replace(at, prefix.size() + var->second.size(), prefix + "{" + name + "}");
      }
    }
    std::istringstream keys(varies ? varies : "");
    for (std::string key; keys >> key;) {
      const std::string member = "\"" + key + "\": ";
      for (size_t at = 0; (at = text.find(member, at)) != std::string::npos;) {
        at += member.size();
        text.replace(at, text.find_first_of(",\n", at) - at, "<varies>");
      }
    }
    return text;
  }

  // The operations vlws --help lists.
  std::set<std::string> Operations() {
    std::set<std::string> names;
    std::istringstream help(Run("--help").out);
    std::string line;
    while (std::getline(help, line)) {
      if (line.find(": ") != std::string::npos && line.find("  VL_WS_") != std::string::npos) {
        std::istringstream words(line);
        std::string name;
        words >> name;
        names.insert(name);
      }
    }
    return names;
  }

  static VLSimServer* s_Sim;
  VLTestDir m_Dir;
  std::map<std::string, std::string> m_Vars;
};

VLSimServer* Vlws::s_Sim = nullptr;

// Every operation; the whole transcript, each row's command, what it printed (its status and
// standard error too when it failed), the requests it sent ("> ") and the rows its file cache
// gained ("+ ") or lost ("- "), is compared with tests/data/vlws/every-operation.txt.
// An intended change of the output: the test writes the transcript it got next to its build
// output and names both files; read the diff and copy the new transcript over the old one.
TEST_F(Vlws, EveryOperationAnswers) {
  struct Row {
    const char* arguments;
    const char* capture = nullptr;  // a member of the answer kept as {capture} for later rows
    const char* varies = nullptr;   // members of the answer whose values differ from run to run
                                    // or from machine to machine
  };
  const Row rows[] = {
      {"version"},
      {"env-list"},
      {"device-id", nullptr, "Text"},  // the machine's
      {"server-time", nullptr, "serverTime"},
      // Catalogue; the first row has the setup as options instead of the settings file.
      {"navigation --api-key VLSIM-API-KEY --user-name vlsim-user --password '{password}' "
       "--device-id 00-11-22-33-44-55"},
      {"genre-label --genre 3 {store}"},
      {"titles --genre 3 --page 2 --items 5 {store}"},
      {"titles-by-genres --genres 3,10 --items 2 {store}"},
      {"title --title 1001 {store}"},
      {"episode --episode 50001 {store}"},
      {"episodes --title 1151 {store}"},
      {"episode-listings --title 1151 {store}"},
      {"tivo-title --tivo-id tivo:ts.307014 {store}"},
      {"sku-title --sku 10012 {store}"},
      {"search --query Distant {store}"},
      {"search-detail --query Kestrel --items 3 {store}"},
      {"recommended --title 1001 {store}"},
      // A file cache ({cache} rows run twice): what each answer is kept under (the rows of the
      // database that come, "+ ", and go, "- "), and the second run answered by it, with no request.
      {"navigation {cache} {store}"},
      {"genre-label --genre 3 {cache} {store}"},  // never kept
      {"genre-label --genre 999 {cache} {store}"},
      {"titles --genre 3 --page 2 --items 5 {cache} {store}"},
      {"titles --genre 3 --page 2 --items 4 {cache} {store}"},  // a page size of its own
      {"titles --genre 10 --items 3 --purchase-type 0 {cache} {store}"},  // rentals only
      {"titles-by-genres --genres 10,999,2 --items 1 {cache} {store}"},  // never kept
      {"title --title 1002 {cache} {store}"},  // with a wishlist flag: a new handle purges both
      {"title --title 999999 {cache} {store}"},
      {"episode --episode 50002 {cache} {store}"},
      {"episode --episode 1 {cache} {store}"},
      {"episodes --title 1152 {cache} {store}"},
      {"episodes --title 1001 {cache} {store}"},  // a movie
      {"episode-listings --title 1152 {cache} {store}"},
      {"episode-listings --title 999999 {cache} {store}"},  // none: not kept
      {"tivo-title --tivo-id tivo:ts.307014 {cache} {store}"},
      {"tivo-title --tivo-id tivo:none {cache} {store}"},
      {"sku-title --sku 10021 {cache} {store}"},
      {"sku-title --sku 1 {cache} {store}"},
      {"search --query harbor --items 3 {cache} {store}"},
      {"search --query harbor --items 3 --title-type 1 {cache} {store}"},  // television only
      {"search-detail --query 'Olive Stroud' --items 3 {cache} {store}"},
      // Keys far beyond 256 bytes: a cut one would serve the second query the first one's answer.
      {"search --query {long}-first --items 3 {cache} {store}"},
      {"search --query {long}-second --items 3 {cache} {store}"},
      {"recommended --title 1001 {cache} {store}"},
      {"recommended --title 999999 {cache} {store}"},
      {"should-update-cache --time 2001-01-01T00:00:00 {cache} {store}"},
      // A cache without catalogue answers keeps none.
      {"titles --genre 3 --cache-data 6 {cache} {store}"},
      {"cache-load-time {store}", "Text"},
      {"should-update-cache --time '{Text}' {store}"},
      {"update-cache --cache-type 2 --cache-path {dir}cache {store}"},
      {"boxart --size 1 --prefix t1001_ --cache-type 2 --cache-path {dir}cache {store}", nullptr, "Length"},
      {"boxart-data --size 1 --prefix t1001_ {store}"},  // JPEG bytes in Base64
      {"clear-cache --folder {dir}cache"},
      // Device and network
      {"default-env {store}"},
      {"device-env --env 1 {store}"},
      {"file-type {store}"},
      {"user-agent --firmware-version 4.2 --app-revision rev-7 --model-number BDP-1 {store}"},
      {"local-ip {store}"},
      {"bandwidth {store}", nullptr, "bitsPerSecond"},
      {"config {store}"},
      // The account: authorize prints the token that the later rows pass.
      {"authorize --pin 1234 {store}", "AuthToken"},
      {"check-token --token {AuthToken} {store}"},
      {"email --token {AuthToken} {store}"},
      {"settings-page --token {AuthToken} {store}"},
      {"country --token {AuthToken} {store}"},
      {"adult-verification --token {AuthToken} {store}"},
      {"adult-pin --pin 7 --token {AuthToken} {store}"},  // the account's "0007"
      {"adult-pin --pin 70007 --token {AuthToken} {store}"},
      {"return-error --access-type 1 --token {AuthToken} {store}"},
      {"return-timeout --access-type 1 --token {AuthToken} {store}"},
      // Billing and purchases
      {"billing-info --token {AuthToken} {store}"},
      {"billing-and-balance --token {AuthToken} {store}"},
      {"redeem-gift --code GIFT-1000 --token {AuthToken} {store}"},
      {"redeem-gift --code GIFT-1000 --token {AuthToken} {store}"},  // used
      {"redeem-gift --code GIFT-NONE --token {AuthToken} {store}"},
      {"prepaid-balance --token {AuthToken} {store}"},
      {"order-tax --sku 10021 --token {AuthToken} {store}"},
      {"purchase --sku 10021 --ip-address 127.0.0.1 --prepaid --token {AuthToken} {store}", "PassID",
       "TransactionId TransactionAuthNum"},
      {"purchased-title --title 1002 --token {AuthToken} {store}"},
      {"purchased-sku --sku 10021 --token {AuthToken} {store}"},
      {"purchased-sku --sku 10022 --token {AuthToken} {store}"},
      {"my-videos --token {AuthToken} {store}"},
      {"rental-expiration --pass {PassID} --token {AuthToken} {store}"},
      {"purchased-listings --passes {PassID},999999 --token {AuthToken} {store}"},
      // The user data a file cache keeps; a new handle purges them (and the answers that carry a
      // wishlist flag), so the second run asks again. The dispatched operations of a download handle.
      {"email --token {AuthToken} {cache} {store}"},
      {"settings-page --token {AuthToken} {cache} {store}"},
      {"billing-info --token {AuthToken} {cache} {store}"},
      {"my-videos --token {AuthToken} {cache} {store}"},
      {"my-videos --access-type 1 --token {AuthToken} {cache} {store}"},  // not kept
      {"purchased-title --title 1002 --access-type 1 --token {AuthToken} {store}"},
      {"title --title 1002 --token {AuthToken} {cache} {store}"},
      // Streaming, from a download handle: these go to the streaming service whatever the access type.
      {"stream --pass {PassID} --profile 1 --access-type 1 --token {AuthToken} {store}", "StreamID"},
      {"stream-status --stream-id {StreamID} --status 2 --stop-time 60 --access-type 1 --token {AuthToken} {store}"},
      {"last-stream --pass {PassID} --profile 1 --access-type 1 --token {AuthToken} {store}"},
      {"bonus-stream --bonus 10015 --access-type 1 --token {AuthToken} {store}"},
      {"thx --pass {PassID} --profile 1 --audio-profile 0 --access-type 1 --token {AuthToken} {store}"},
      {"thx-bonus --bonus 10015 --profile 1 --access-type 1 --token {AuthToken} {store}"},
      {"set-audio-default --audio-profile 0 --access-type 1 --token {AuthToken} {store}"},
      {"audio-default --access-type 1 --token {AuthToken} {store}"},
      // Wishlist
      {"wishlist-add --title 1001 --token {AuthToken} {store}"},
      {"wishlist-add --title 1003 --token {AuthToken} {store}"},
      {"in-wishlist --title 1001 --token {AuthToken} {store}"},
      {"in-wishlist-titles --titles 1001,1002 --token {AuthToken} {store}"},
      {"wishlist-remove --title 1001 --token {AuthToken} {store}"},
      {"wishlist --token {AuthToken} {store}"},
      {"in-wishlist --title 1003 --token {AuthToken} {cache} {store}"},
      {"in-wishlist-titles --titles 1003,1002 --token {AuthToken} {cache} {store}"},
      {"wishlist --token {AuthToken} {cache} {store}"},
      {"wishlist-clear --token {AuthToken} {store}"},
      {"remove-all-purchases --account-password wrong --token {AuthToken} {store}"},
      {"remove-all-purchases --account-password alicepw --token {AuthToken} {store}"},
      {"purchased-sku --sku 10021 --token {AuthToken} {store}"},
      {"deactivate --token {AuthToken} {store}"},
      {"check-token --token {AuthToken} {store}"},
      // Settings files, files and folders
      {"write-setting --file {dir}s.xml --key pin --value 2468 --encrypted"},
      {"read-setting --file {dir}s.xml --key pin --encrypted"},
      {"read-setting --file {dir}s.xml --key pin", nullptr, "Text"},  // encrypted anew by each write
      {"read-setting --file {dir}s.xml --key other"},
      {"create-env-xml --source {dir}s.xml --destination {dir}env.xml"},
      {"delete-env-xml --file {dir}env.xml"},
      {"md5sum --file {dir}store.conf", nullptr, "Length"},  // of a path in the temporary folder
      {"copy-file --source {dir}s.xml --destination {dir}copy.xml"},
      {"file-exists --path {dir}copy.xml"},
      {"remove-file --file {dir}copy.xml"},
      {"file-exists --path {dir}copy.xml"},
      {"create-folder --path {dir}a/b"},
      {"folder-exists --path {dir}a/b"},
      {"folder-name --path /x/y.xml"},
  };
  std::set<std::string> untried = Operations();
  EXPECT_LT(70u, untried.size());
  std::string transcript;
  std::set<std::string> kept;
  s_Sim->ClearRequests();
  for (const Row& row : rows) {
    // A row with a file cache runs twice: the second run shows what the first one kept.
    const int runs = std::string(row.arguments).find("{cache}") == std::string::npos ? 1 : 2;
    for (int run = 0; run < runs; ++run) {
      VLCommandRun ran = Run(row.arguments);
      if (row.capture) m_Vars[row.capture] = Member(ran.out, row.capture);
      transcript += std::string("$ vlws ") + row.arguments + "\n" + Masked(ran.out, row.varies);
      if (ran.status != 0) transcript += "exit status " + std::to_string(ran.status) + ": " + Masked(ran.err, nullptr);
      transcript += Masked(VLReceivedLines(*s_Sim) + VLCacheChanges(m_Dir / "cache", &kept), nullptr);
    }
    untried.erase(std::string(row.arguments).substr(0, std::string(row.arguments).find(' ')));
  }
  EXPECT_TRUE(untried.empty()) << "not tried: " << *untried.begin();
  VLExpectTranscript("vlws/every-operation.txt", transcript);
}

TEST_F(Vlws, WrongUsageIsNamedAndExitsWithTwo) {
  ASSERT_TRUE(VLWriteFile(m_Dir / "bad.conf", "api-key = k\ncolour = red\n"));
  const struct {
    const char* arguments;
    int status;
    const char* message;
  } rows[] = {
      {"", 2, "usage: vlws OPERATION [OPTIONS]"},
      {"nosuch", 2, "vlws: unknown operation \"nosuch\" (vlws --help lists them)"},
      {"titles --genre x {store}", 2, "vlws titles: --genre needs a whole number, not \"x\"\n"
                                      "(vlws titles --help lists its options)\n"},
      {"titles --genre 99999999999 {store}", 2, "--genre needs a whole number, not \"99999999999\""},
      {"in-wishlist-titles --titles 1,,2 {store}", 2, "--titles needs whole numbers separated by commas"},
      {"titles {store}", 2, "vlws titles: --genre is required"},
      {"titles --genre", 2, "--genre needs a value"},
      {"titles --genre 3", 2, "--api-key is required"},
      {"titles --genre 3 --colour red {store}", 2, "unknown option --colour"},
      {"titles --genre 3 red {store}", 2, "unexpected argument \"red\""},
      {"read-setting --file f --key k --encrypted=yes", 2, "--encrypted takes no value"},
      {"version --api-key k", 2, "unknown option --api-key"},  // only operations with a client take setup
      {"titles --genre 3 --settings {dir}missing.conf", 2, "cannot read the settings file {dir}missing.conf"},
      {"titles --genre 3 --settings {dir}bad.conf", 2,
       "{dir}bad.conf:2: expected \"name = value\" with the name of a setup option, not \"colour = red\""},
      {"titles --genre 3 --cache-type 2 {store}", 2, "--cache-type 2 needs --cache-path"},
      // Setup values the library refuses.
      {"titles --genre 3 --env -1 {store}", 1,
       "vlws titles: VL_WS_initialize: VL_WS_E_INVALID_ARGUMENT (-1000): an argument is missing"},
      {"authorize --pin 1111 {store}", 1,
       "VL_WS_E_AUTHORIZE_1 (-1005): the store refused the request; response code 1: \""},
  };
  for (const auto& row : rows) {
    VLCommandRun run = Run(row.arguments);
    SCOPED_TRACE(row.arguments);
    EXPECT_EQ(row.status, run.status);
    EXPECT_NE(std::string::npos, run.err.find(Expand(row.message))) << run.err;
    EXPECT_EQ("", run.out);
  }
  for (const std::string& name : Operations()) {
    VLCommandRun help = Run(name + " --help");
    EXPECT_EQ(0, help.status) << name;
    EXPECT_EQ(0u, help.out.find("usage: vlws " + name + " [OPTIONS]\nVL_WS_")) << help.out;
  }
}

TEST_F(Vlws, AStoreThatCannotBeReachedIsNamed) {
  // Nothing listens on port 1 of the loopback address.
  VLCommandRun run = Run("titles --genre 3 {store}", "VLWS_CONNECT_TO=store.ostrel.example:443:127.0.0.1:1");
  EXPECT_EQ(1, run.status);
  EXPECT_NE(std::string::npos, run.err.find("vlws titles: VL_WS_getTitles: VL_WS_E_CONNECT (-2011): the store could "
                                            "not be reached"))
      << run.err;
  EXPECT_EQ("", run.out);
}

}  // namespace
