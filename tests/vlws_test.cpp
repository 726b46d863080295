// vlws, the command-line client, run as a user runs it against the program's store simulator:
// every operation, in the order a session needs (a token from authorize, a pass from a purchase,
// a stream from the pass), its whole output, the requests the store received and what a file
// cache kept compared with a transcript, and wrong usage; the help of every operation; a store
// that cannot be reached.
#include <gtest/gtest.h>
#include <stdlib.h>

#include <map>
#include <regex>
#include <set>
#include <sstream>
#include <string>
#include <utility>
#include <vector>

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
    ASSERT_TRUE(VLWriteFile(m_Dir / "bad.conf", "api-key = k\ncolour = red\n"));
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

// Every operation, run as at a shell: tests/data/vlws/every-operation.txt is the transcript of
// a session in the order it needs (a token from authorize, a pass from a purchase, a stream from
// the pass). Each "$ vlws ARGUMENTS" line of it is run, after each {name} in it is replaced by its
// value, and followed by what it printed (its exit status and standard error too when it failed),
// the requests the store received ("> ") and the rows its file cache gained ("+ ") or lost ("- ");
// the test compares the transcript it gets with the file. Its last rows are wrong usage (exit status
// 2) and setup values the library refuses (1). A member whose value differs from run
// to run or from machine to machine is <varies> in the file, and masked so in what the row
// printed. The first AuthToken, PassID and StreamID that rows print are passed on to later rows
// as {AuthToken}, {PassID} and {StreamID}.
TEST_F(Vlws, EveryOperationAnswers) {
  std::vector<std::pair<std::string, std::string>> rows;  // arguments, and what the file says they print
  std::istringstream file(VLReadFile(VL_SOURCE_DIR "/tests/data/vlws/every-operation.txt"));
  for (std::string line; std::getline(file, line);) {
    if (line.compare(0, 7, "$ vlws ") == 0) {
      rows.push_back({line.substr(7), ""});
    } else if (!rows.empty()) {
      rows.back().second += line + "\n";
    }
  }
  std::set<std::string> untried = Operations();
  EXPECT_LT(70u, untried.size());
  std::string transcript;
  std::set<std::string> kept;
  s_Sim->ClearRequests();
  for (const auto& row : rows) {
    VLCommandRun ran = Run(row.first);
    for (const char* name : {"AuthToken", "PassID", "StreamID"}) {
      if (!m_Vars.count(name) && !Member(ran.out, name).empty()) m_Vars[name] = Member(ran.out, name);
    }
    std::string varies;
    static const std::regex masked("\"(\\w+)\": <varies>");
    for (std::sregex_iterator it(row.second.begin(), row.second.end(), masked), end; it != end; ++it) {
      varies += (*it)[1].str() + " ";
    }
    transcript += "$ vlws " + row.first + "\n" + Masked(ran.out, varies.c_str());
    if (ran.status != 0) transcript += "exit status " + std::to_string(ran.status) + ": " + Masked(ran.err, nullptr);
    transcript += Masked(VLReceivedLines(*s_Sim) + VLCacheChanges(m_Dir / "cache", &kept), nullptr);
    untried.erase(row.first.substr(0, row.first.find(' ')));
  }
  EXPECT_TRUE(untried.empty()) << "not tried: " << *untried.begin();
  VLExpectTranscript("vlws/every-operation.txt", transcript);
}

TEST_F(Vlws, EveryOperationHasItsHelp) {
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
