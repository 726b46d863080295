// Client sessions: operations on one handle, one after another, as a movie makes them. Each file
// of tests/data/sessions is a transcript: the commands of a session ("$ " lines), each followed
// by what it printed, and comments ("#" lines) and blank lines. The test runs the commands on the
// program's store simulator and compares the transcript it gets with the file.
//
// A command is a vlws operation with its own options (vlws OPERATION --help), run on the
// session's handle, or one of:
//   init [SETUP OPTIONS]       makes the handle anew from vlws's setup options, which start as
//                              the simulator's device with access type 2 (streaming)
//   release                    releases the handle: operations then get an empty one
//   fault SPEC                 the simulator's answers fail so (the written form of VLSimFaults.h)
//   store load-time TEXT       the catalogue's load time the store answers
//   store device-env DIGIT     the environment the device-environment service answers
//   store access-type N        the access type the store answers
//   store revoke TOKEN         the store forgets the device's token
//   store clock SECONDS        the store's clock moves on (back when negative): rentals expire
//   store wishlist N           titles 1001 to 1000+N are added to the account's wishlist in order
//   store prepaid CENTS        the account's prepaid balance
//   store now SECONDS          the store's clock, seconds since 1970 UTC
//   hosts                      from now on each SOAP request also shows where it went and its
//                              User-Agent ("@ host/path agent")
//   flag TITLE [0|1]           the title's wishlist flag in the handle's cache: printed, or written
//   cached NAME KEY            whether the handle's cache keeps an answer under Name and Key
//   cache-write NAME KEY TEXT  writes TEXT there
//   js EXPRESSION              evaluates the expression in a movie of the application (made at
//                              the first js command) and prints its value as JSON (or undefined)
//   setenv NAME [VALUE]        sets or unsets an environment variable
//   write-file PATH TEXT       writes a file; truncate PATH N cuts one to N bytes
//   same PATH PATH             whether two files hold the same bytes; show PATH prints one
//   files FOLDER               the names in the folder, one a line
//   sql STATEMENT              the rows the statement gives on the file cache in {dir}cache
// Words are separated by spaces; '...' makes one word of what it quotes. In commands, {token} is
// the token of the simulator's account of PIN 1234 (authorised when the session starts), {dir}
// the session's own folder, which is the current folder, and {cache} "--cache-type 2
// --cache-path {dir}cache". Values the store numbers as it goes print as names, in the order they
// first show, so that a session reads the same in any process, and commands may use the names:
// tokens {token2}, {token3}, ..., passes {pass}, {pass2}, ... and transactions {transaction}, ...
// In what commands print, {token} and {dir} are written as those names too, and the first device
// identifier the session made as {id}.
//
// What a command printed: an operation's result as vlws writes it, and when the call failed, first
// "status NAME (number): meaning" and then the record as the call left it (a text it left null
// shows as null); then the lines the library logged ("| ", the settings class's with their level
// first, and none that trace entering or leaving a function), the requests the store received
// ("> ", "@ ") and the rows the file cache in {dir}cache gained ("+ ") or lost ("- ").
#include <gtest/gtest.h>
#include <stdlib.h>

#include <algorithm>
#include <memory>
#include <map>
#include <regex>
#include <set>
#include <sstream>
#include <string>
#include <vector>

#include "VLTestAccountClient.h"
#include "VLTestMovie.h"
#include "VLTestTranscript.h"
#include "VLWSAELog.h"
#include "VLWSOperations.h"
#include "VL_Log.h"

namespace {

const char kSessions[] = VL_SOURCE_DIR "/tests/data/sessions/";

// The words of a command: separated by spaces, '...' quoting one word.
std::vector<std::string> Words(const std::string& command) {
  std::vector<std::string> words;
  std::string word;
  bool inWord = false, quoted = false;
  for (char c : command) {
    if (c == '\'') {
      quoted = !quoted;
      inWord = true;
    } else if (c == ' ' && !quoted) {
      if (inWord) words.push_back(word);
      word.clear();
      inWord = false;
    } else {
      word += c;
      inWord = true;
    }
  }
  if (inWord) words.push_back(word);
  return words;
}

std::string Replaced(std::string text, const std::string& from, const std::string& to) {
  for (size_t at = 0; (at = text.find(from, at)) != std::string::npos; at += to.size()) text.replace(at, from.size(), to);
  return text;
}

class Session : public VLTestAccountClient, public testing::WithParamInterface<std::string> {
 protected:
  void SetUp() override {
    VLTestAccountClient::SetUp();
    int account = 0;
    std::string token;
    ASSERT_EQ(0, m_Sim.Store().Authorize(kPin, "00-11-22-33-44-55", 7, &token, &account));
    m_LoadTime = m_Sim.Store().LastCacheLoadTime();
    int area = -1;
    VL_LogRegisterArea("VL_WSCFGAE", &area);
    VL_LogActivateArea(area, 1);
    VL_LogSetObserver(Observe, this);
    m_Numbered["token"] = {token};
  }
  void TearDown() override {
    m_Movie.reset();
    for (const std::string& name : m_Variables) unsetenv(name.c_str());
    m_Sim.Store().SetLastCacheLoadTime(m_LoadTime);
    m_Sim.Store().SetDeviceEnv("00-11-22-33-44-55", 2);
    m_Sim.Store().SetAccessType(STREAM);
    m_Sim.Store().SetNow(time(nullptr));
    VLTestAccountClient::TearDown();
  }

  // The transcript of the session in file: its commands run, their output written anew.
  std::string Transcript(const std::string& file) {
    std::istringstream lines(VLReadFile(file));
    std::string transcript;
    std::set<std::string> kept;
    for (std::string line; std::getline(lines, line);) {
      if (line.compare(0, 2, "$ ") == 0) {
        // A script keeps its quotes.
        std::string command = Expand(line.substr(2));
        std::string printed = command.compare(0, 3, "js ") == 0 ? Js(command.substr(3)) : Command(Words(command));
        for (const std::string& logged : m_Lines) printed += "| " + logged + "\n";
        m_Lines.clear();
        if (m_Hosts) printed += Hosts();
        printed += VLReceivedLines(m_Sim) + VLCacheChanges(m_Dir / "cache", &kept);
        transcript += line + "\n" + Masked(printed);
      } else if (line.empty() || line[0] == '#') {
        transcript += line + "\n";
      }
    }
    return transcript;
  }

  // The output with the numbered values written as their names, the folder as {dir} and the first
  // device identifier the session made as {id}.
  std::string Masked(const std::string& printed) {
    static const std::regex id("[0-9A-F]{2}(-[0-9A-F]{2}){5}");
    std::smatch made;
    if (m_Id.empty() && std::regex_search(printed, made, id) && made.str() != "00-11-22-33-44-55") m_Id = made.str();
    std::string text = Replaced(Named(printed), m_Dir.path(), "{dir}");
    return m_Id.empty() ? text : Replaced(text, m_Id, "{id}");
  }

  static std::string Name(const std::string& kind, size_t n) {
    return "{" + kind + (n == 0 ? "" : std::to_string(n + 1)) + "}";
  }

  // The output with each numbered value (the whole match of its pattern, or the first group)
  // written as its name.
  std::string Named(std::string text) {
    static const std::pair<const char*, std::regex> kKinds[] = {
        {"token", std::regex("SIMTOKEN-[0-9]+-[0-9]+")},
        {"pass", std::regex("\"PassID\": ([1-9][0-9]*)")},
        {"transaction", std::regex("(?:\"TransactionId\": |AUTH)([1-9][0-9]*)")}};
    for (const auto& kind : kKinds) {
      std::vector<std::string>& values = m_Numbered[kind.first];
      std::string named;
      size_t from = 0;
      for (std::sregex_iterator it(text.begin(), text.end(), kind.second), end; it != end; ++it) {
        const size_t group = it->size() - 1;
        size_t n = std::find(values.begin(), values.end(), it->str(group)) - values.begin();
        if (n == values.size()) values.push_back(it->str(group));
        named += text.substr(from, it->position(group) - from) + Name(kind.first, n);
        from = it->position(group) + it->length(group);
      }
      text = named + text.substr(from);
    }
    return text;
  }

  // Where the SOAP requests the store received went, and with which User-Agent.
  std::string Hosts() {
    std::string lines;
    for (const VLSimRequest& r : VLRequestsByConnection(m_Sim)) {
      if (!r.service.empty()) lines += "@ " + r.host + r.path + " " + r.userAgent + "\n";
    }
    return lines;
  }

  std::string Expand(const std::string& command) const {
    std::string cache = "--cache-type 2 --cache-path " + m_Dir / "cache";
    std::string expanded = Replaced(Replaced(command, "{cache}", cache), "{dir}", m_Dir.path());
    for (const auto& kind : m_Numbered) {
      for (size_t n = 0; n < kind.second.size(); ++n) {
        expanded = Replaced(expanded, Name(kind.first, n), kind.second[n]);
      }
    }
    return expanded;
  }

  // Runs a command; what it printed.
  std::string Command(const std::vector<std::string>& words) {
    if (words.empty()) return "usage: an empty command\n";
    const std::string& name = words[0];
    std::vector<std::string> rest(words.begin() + 1, words.end());
    if (name == "init") return Init(rest);
    if (name == "release") {
      VL_WS_release(&m_Handle);
      return "";
    }
    if (name == "fault" && rest.size() == 1) {
      std::string error;
      return m_Sim.AddFault(rest[0], &error) ? "" : "usage: " + error + "\n";
    }
    if (name == "store" && rest.size() == 2) return Store(rest[0], rest[1]);
    if (name == "hosts" && rest.empty()) {
      m_Hosts = true;
      return "";
    }
    if (name == "setenv" && rest.size() == 1) return unsetenv(rest[0].c_str()) == 0 ? "" : "not unset\n";
    if (name == "setenv" && rest.size() == 2) {
      m_Variables.push_back(rest[0]);
      return setenv(rest[0].c_str(), rest[1].c_str(), 1) == 0 ? "" : "not set\n";
    }
    if (name == "write-file" && rest.size() == 2) return VLWriteFile(rest[0], rest[1]) ? "" : "not written\n";
    if (name == "truncate" && rest.size() == 2) {
      return VLWriteFile(rest[0], VLReadFile(rest[0]).substr(0, std::stoul(rest[1]))) ? "" : "not written\n";
    }
    if (name == "same" && rest.size() == 2) return VLReadFile(rest[0]) == VLReadFile(rest[1]) ? "same\n" : "different\n";
    if (name == "show" && rest.size() == 1) {
      std::string text = VLReadFile(rest[0]);
      return text.empty() || text.back() == '\n' ? text : text + "\n";
    }
    if (name == "flag" || name == "cached" || name == "cache-write") {
      return m_Handle.client && m_Handle.client->m_Cache ? CacheCommand(name, rest) : "no cache\n";
    }
    if (name == "files" && rest.size() == 1) return Files(rest[0]);
    if (name == "sql" && rest.size() == 1) {
      std::string file = VLCacheFileIn(m_Dir / "cache/");
      std::string rows = file.empty() ? "no cache file" : VLRunSql(file, rest[0]);
      return (rows.empty() ? "no rows" : rows) + "\n";
    }
    for (const vlws::Operation& op : vlws::Operations()) {
      if (name == op.name) return Operation(op, rest);
    }
    return "usage: unknown command " + name + "\n";
  }

  std::string Js(const std::string& expression) {
    if (!m_Movie) m_Movie.reset(new VLTestMovie);
    if (!m_Movie->stage.Evaluate("movie.js", "var answer = String(JSON.stringify(" + expression + "));")) {
      return "error: " + m_Movie->stage.Error() + "\n";
    }
    return std::string(m_Movie->stage.Global().GetProperty("answer").AsString().CString()) + "\n";
  }

  std::string Init(std::vector<std::string> words) {
    const VLSimOptions& sim = m_Sim.Options();
    words.insert(words.begin(), {"--api-key", sim.apiKey, "--user-name", sim.userName, "--password", sim.password,
                                 "--device-id", "00-11-22-33-44-55", "--device-type", "7", "--access-type", "2"});
    // Later words win, so the command's own override the simulator's.
    vlws::Operation setup = {"init", "VL_WS_initialize", "", {}, true, nullptr};
    vlws::Args args;
    std::string error = Parse(setup, words, &args);
    if (!error.empty()) return error;
    VL_WS_release(&m_Handle);
    VL_WS_SetupParams params = vlws::SetupParams(args);
    VL_WS_Status status = VL_WS_initialize(&m_Handle, &params);
    return status == VL_WS_OK ? "" : "status " + vlws::DescribeStatus(status, setup.function) + "\n";
  }

  // The options of op in words, as vlws reads them; "usage: ..." when they are wrong.
  static std::string Parse(const vlws::Operation& op, std::vector<std::string> words, vlws::Args* args) {
    std::vector<char*> argv;
    for (std::string& word : words) argv.push_back(&word[0]);
    std::string error;
    if (vlws::ParseArgs(op, static_cast<int>(argv.size()), argv.data(), args, &error) == vlws::Parsed::kRun) return "";
    return "usage: " + error + "\n";
  }

  std::string Operation(vlws::Operation op, const std::vector<std::string>& words) {
    op.handle = false;  // the session's handle: the operation's own options only
    vlws::Args args;
    std::string error = Parse(op, words, &args);
    if (!error.empty()) return error;
    VLJsonWriter json;
    std::string detail;
    VL_WS_Status status = op.run(args, &m_Handle, &json, &detail);
    if (status == VL_WS_OK) return json.Text();
    return "status " + vlws::DescribeStatus(status, op.function) + (detail.empty() ? "" : "; " + detail) + "\n" +
           json.Text();
  }

  std::string Store(const std::string& what, const std::string& value) {
    if (what == "load-time") {
      m_Sim.Store().SetLastCacheLoadTime(value);
    } else if (what == "device-env") {
      m_Sim.Store().SetDeviceEnv("00-11-22-33-44-55", std::stoi(value));
    } else if (what == "access-type") {
      m_Sim.Store().SetAccessType(std::stoi(value));
    } else if (what == "revoke") {
      m_Sim.Store().Deactivate(value, "00-11-22-33-44-55");
    } else if (what == "clock") {
      m_Sim.Store().AdvanceClock(std::stol(value));
    } else if (what == "wishlist") {
      for (int title = 1001; title <= 1000 + std::stoi(value); ++title) m_Sim.Store().WishlistAdd(Account(), title);
    } else if (what == "prepaid") {
      m_Sim.Store().SetPrepaidCents(Account(), std::stoi(value));
    } else if (what == "now") {
      m_Sim.Store().SetNow(std::stol(value));
    } else {
      return "usage: unknown store setting " + what + "\n";
    }
    return "";
  }

  std::string Files(const std::string& folder) {
    std::string names;
    for (const std::string& name : VLFolderFiles(folder)) names += name + "\n";
    return names.empty() ? "no files\n" : names;
  }

  std::string CacheCommand(const std::string& name, const std::vector<std::string>& words) {
    if (name == "flag" && words.size() == 1) {
      return std::to_string(Flag(std::stoi(words[0]))) + "\n";
    }
    if (name == "flag" && words.size() == 2) {
      return Cache().WriteWishlistFlag(std::stoi(words[0]), words[1] == "1") ? "" : "not written\n";
    }
    VLString value;
    if (name == "cached" && words.size() == 2) {
      return Cache().ReadMetaData(words[0].c_str(), words[1].c_str(), value) ? "kept\n" : "not kept\n";
    }
    if (name == "cache-write" && words.size() == 3) {
      return Cache().WriteMetaData(words[0].c_str(), words[1].c_str(), words[2].c_str()) ? "" : "not written\n";
    }
    return "usage: " + name + " with wrong arguments\n";
  }

  // The library's result lines, and every line of the settings class with its level; but not the
  // lines that trace entering and leaving a function.
  static void Observe(void* self, const char* area, int level, const char* text, size_t length) {
    if (length > 0 && text[length - 1] == '\n') --length;
    std::string line(text, length);
    if (line.compare(0, 9, "Entering ") == 0 || line.compare(0, 8, "Exiting ") == 0) return;
    if (std::string(area) == VLWSAELOG_AREA_NAME && level == 4) {
      static_cast<Session*>(self)->m_Lines.push_back(line);
    } else if (std::string(area) == "VL_WSCFGAE") {
      static_cast<Session*>(self)->m_Lines.push_back(std::to_string(level) + ":" + line);
    }
  }

  VLTestDir m_Dir;
  VLScopedCurrentDir m_Cwd{m_Dir.path()};
  std::unique_ptr<VLTestMovie> m_Movie;
  std::vector<std::string> m_Lines;
  std::vector<std::string> m_Variables;
  std::string m_Id;
  std::map<std::string, std::vector<std::string>> m_Numbered;  // values by kind, in the order they showed
  std::string m_LoadTime;
  bool m_Hosts = false;
};

TEST_P(Session, PrintsItsTranscript) {
  VLExpectTranscript("sessions/" + GetParam() + ".txt", Transcript(kSessions + GetParam() + ".txt"));
}

INSTANTIATE_TEST_SUITE_P(, Session, testing::ValuesIn(VLTranscriptsIn(kSessions)), VLTranscriptTestName);

}  // namespace
