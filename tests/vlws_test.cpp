// vlws, the command-line client, run as a user runs it against the program's store simulator:
// every operation once, in the order a session needs (a token from authorize, a pass from a
// purchase, a stream from the pass); wrong usage; a store that cannot be reached.
#include <gtest/gtest.h>
#include <stdlib.h>

#include <map>
#include <set>
#include <sstream>
#include <string>

#include "VLSimServer.h"
#include "VLTestCommand.h"
#include "VLTestDir.h"

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

TEST_F(Vlws, EveryOperationAnswers) {
  struct Row {
    const char* arguments;
    int status;
    const char* expected;  // in standard output, or in standard error for a failure
    const char* capture = nullptr;  // a member of the answer kept as {capture} for later rows
  };
  const Row rows[] = {
      {"version", 0, "{\n  \"Major\": 1,\n  \"Minor\": 3,\n  \"Revision\": 1\n}\n"},
      {"env-list", 0, "\"Name\": \"production\""},
      {"device-id", 0, "\"Length\": 17"},
      {"server-time", 0, "\"serverTime\": "},
      // Catalogue; the first row has the setup as options instead of the settings file.
      {"navigation --api-key VLSIM-API-KEY --user-name vlsim-user --password '{password}' "
       "--device-id 00-11-22-33-44-55", 0, "\"ParentId\": "},
      {"genre-label --genre 3 {store}", 0, "\"Label\": \"New Releases\""},
      {"titles --genre 3 --page 2 --items 5 {store}", 0, "\"CurrentPageNumber\": 2,\n  \"ItemsPerPage\": 5"},
      {"titles-by-genres --genres 3,10 --items 2 {store}", 0, "\"GenreID\": 10"},
      {"title --title 1001 {store}", 0, "\"Directors\": \"Maya Kestrel\""},
      {"episode --episode 50001 {store}", 0, "\"TitleName\": \"Harbor Lights: Episode 1: Restless Harbor\""},
      {"episodes --title 1151 {store}", 0, "\"EpisodeName\": \"Episode 1: Restless Harbor\""},
      {"episode-listings --title 1151 {store}", 0, "\"EpisodeNumber\": 2"},
      {"tivo-title --tivo-id tivo:ts.307014 {store}", 0, "\"TitleId\": 1002"},
      {"sku-title --sku 10012 {store}", 0, "\"TitleId\": 1001"},
      {"search --query Distant {store}", 0, "\"TitleName\": \"Distant Horizon\""},
      {"search-detail --query Kestrel {store}", 0, "\"TitleName\": \"Distant Horizon\""},
      {"recommended --title 1001 {store}", 0, "\"TitleID\": "},
      {"cache-load-time {store}", 0, "\"Text\": \"", "Text"},
      {"should-update-cache --time '{Text}' {store}", 0, "\"update\": false"},
      {"update-cache --cache-type 2 --cache-path {dir}cache {store}", 0, "{}\n"},
      {"boxart --size 1 --prefix t1001_ --cache-type 2 --cache-path {dir}cache {store}", 0, "t1001_175.jpg\""},
      {"boxart-data --size 1 --prefix t1001_ {store}", 0, "\"Data\": \"/9j/"},  // JPEG bytes in Base64
      {"clear-cache --folder {dir}cache", 0, "{}\n"},
      // Device and network
      {"default-env {store}", 0, "\"envID\": 2"},
      {"device-env --env 1 {store}", 0, "\"envID\": 1"},
      {"file-type {store}", 0, "\"File_AccessType\": 2"},
      {"user-agent --firmware-version 4.2 {store}", 0, "\"Text\": \"VLSDK: 4.2"},
      {"local-ip {store}", 0, "\"Text\": \""},
      {"bandwidth {store}", 0, "\"bitsPerSecond\": "},
      {"config {store}", 0, "\"Key\": \"SupportPhone\""},
      // The account: authorize prints the token that the later rows pass.
      {"authorize --pin 1234 {store}", 0, "\"EmailAddress\": \"alice@example.com\"", "AuthToken"},
      {"check-token --token {AuthToken} {store}", 0, "\"valid\": true"},
      {"email --token {AuthToken} {store}", 0, "\"EmailAddress\": \"alice@example.com\""},
      {"settings-page --token {AuthToken} {store}", 0, "\"DeviceID\": \"00-11-22-33-44-55\""},
      {"country --token {AuthToken} {store}", 0, "\"countryID\": 1"},
      {"adult-verification --token {AuthToken} {store}", 0, "\"IsAdultVerificationEnabled\": true"},
      {"adult-pin --pin 7 --token {AuthToken} {store}", 0, "\"IsPinVerified\": true"},
      {"return-error --token {AuthToken} {store}", 1,
       "vlws return-error: VL_WS_returnError: VL_WS_E_UNEXPECTED (-1004): "},
      {"return-timeout --token {AuthToken} {store}", 0, "\"ResponseCode\": 0"},
      // Billing and purchases
      {"billing-info --token {AuthToken} {store}", 0, "\"CCLastFour\": \"4242\""},
      {"billing-and-balance --token {AuthToken} {store}", 0, "\"PPCardBalance\": {"},
      {"redeem-gift --code GIFT-1000 --token {AuthToken} {store}", 0, "\"Balance\": 3500"},
      {"prepaid-balance --token {AuthToken} {store}", 0, "\"Balance\": 3500"},
      {"order-tax --sku 10021 --token {AuthToken} {store}", 0, "\"SubTotal\": \"2.99\""},
      {"purchase --sku 10021 --ip-address 127.0.0.1 --prepaid --token {AuthToken} {store}", 0, "\"TransactionId\": ",
       "PassID"},
      {"purchased-title --title 1002 --token {AuthToken} {store}", 0, "\"purchased\": true"},
      {"purchased-sku --sku 10021 --token {AuthToken} {store}", 0, "\"purchased\": true"},
      {"my-videos --token {AuthToken} {store}", 0, "\"PassID\": {PassID}"},
      {"rental-expiration --pass {PassID} --token {AuthToken} {store}", 0, "\"HoursRemaining\": "},
      {"purchased-listings --passes {PassID} --token {AuthToken} {store}", 0, "\"TitleName\": \"Distant Lantern\""},
      // Streaming
      {"stream --pass {PassID} --profile 1 --token {AuthToken} {store}", 0, "\"HeartbeatURL\": ", "StreamID"},
      {"last-stream --pass {PassID} --profile 1 --token {AuthToken} {store}", 0, "\"StreamID\": \"{StreamID}\""},
      {"stream-status --stream-id {StreamID} --status 2 --stop-time 60 --token {AuthToken} {store}", 0,
       "\"ResponseCode\": 0"},
      {"bonus-stream --bonus 10015 --token {AuthToken} {store}", 0, "\"StreamingAssetLocation\": \"http"},
      {"thx --pass {PassID} --profile 1 --audio-profile 0 --token {AuthToken} {store}", 0, "\"LongFormat\": "},
      {"thx-bonus --bonus 10015 --profile 1 --token {AuthToken} {store}", 0, "\"ShortFormat\": "},
      {"set-audio-default --audio-profile 3 --token {AuthToken} {store}", 0, "\"ResponseCode\": 0"},
      {"audio-default --token {AuthToken} {store}", 0, "\"audioProfile\": 3"},
      // Wishlist
      {"wishlist-add --title 1001 --token {AuthToken} {store}", 0, "\"ResponseCode\": 0"},
      {"wishlist-add --title 1003 --token {AuthToken} {store}", 0, "\"ResponseCode\": 0"},
      {"in-wishlist --title 1001 --token {AuthToken} {store}", 0, "\"inWishlist\": true"},
      {"in-wishlist-titles --titles 1001,1002 --token {AuthToken} {store}", 0, "[\n  true,\n  false\n]\n"},
      {"wishlist-remove --title 1001 --token {AuthToken} {store}", 0, "\"ResponseCode\": 0"},
      {"wishlist --token {AuthToken} {store}", 0, "\"TotalItems\": 1"},
      {"wishlist-clear --token {AuthToken} {store}", 0, "\"ResponseCode\": 0"},
      {"remove-all-purchases --account-password alicepw --token {AuthToken} {store}", 0, "\"ResponseCode\": 0"},
      {"deactivate --token {AuthToken} {store}", 0, "\"ResponseCode\": 0"},
      {"check-token --token {AuthToken} {store}", 0, "\"valid\": false"},
      // Settings files, files and folders
      {"write-setting --file {dir}s.xml --key pin --value 2468 --encrypted", 0, "{}\n"},
      {"read-setting --file {dir}s.xml --key pin --encrypted", 0, "\"Text\": \"2468\""},
      {"read-setting --file {dir}s.xml --key pin", 0, "\"Text\": \""},
      {"read-setting --file {dir}s.xml --key other", 1, "VL_WS_E_SETTING_MISSING (-1906): "},
      {"create-env-xml --source {dir}s.xml --destination {dir}env.xml", 0, "{}\n"},
      {"delete-env-xml --file {dir}env.xml", 0, "{}\n"},
      {"md5sum --file {dir}s.xml", 0, "s.xml\\n\""},
      {"copy-file --source {dir}s.xml --destination {dir}copy.xml", 0, "{}\n"},
      {"file-exists --path {dir}copy.xml", 0, "\"exist\": true"},
      {"remove-file --file {dir}copy.xml", 0, "{}\n"},
      {"file-exists --path {dir}copy.xml", 0, "\"exist\": false"},
      {"create-folder --path {dir}a/b", 0, "{}\n"},
      {"folder-exists --path {dir}a/b", 0, "\"exist\": true"},
      {"folder-name --path /x/y.xml", 0, "\"Text\": \"/x/\""},
  };
  std::set<std::string> untried = Operations();
  EXPECT_LT(70u, untried.size());
  for (const Row& row : rows) {
    VLCommandRun run = Run(row.arguments);
    std::string expected = Expand(row.expected);
    SCOPED_TRACE(Expand(row.arguments));
    EXPECT_EQ(row.status, run.status) << run.err;
    EXPECT_NE(std::string::npos, (row.status == 0 ? run.out : run.err).find(expected)) << run.out << run.err;
    if (row.status != 0) {
      EXPECT_EQ("", run.out);
    }
    if (row.capture) m_Vars[row.capture] = Member(run.out, row.capture);
    untried.erase(std::string(row.arguments).substr(0, std::string(row.arguments).find(' ')));
  }
  EXPECT_TRUE(untried.empty()) << "not tried: " << *untried.begin();
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
