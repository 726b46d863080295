// The operations of vlws, the command-line client of the flat interface: one table of rows, each
// with its name, the VL_WS_ function it calls, its options with their types and the call itself;
// the call's signature tells whether the operation needs a client handle and what record it fills.
// Operations with a handle take the client setup (VL_WS_SetupParams) as options or from a
// settings file. vlws runs one row per process; the test of client sessions runs several rows on
// one handle.
#ifndef VLWSOPERATIONS_H
#define VLWSOPERATIONS_H

#include <functional>
#include <map>
#include <string>
#include <vector>

#include "VLJsonWriter.h"
#include "VL_WS.h"

namespace vlws {

enum class Kind { kInt, kText, kFlag, kIntList };

struct Option {
  const char* name;      // without the leading "--"
  Kind kind;
  const char* help;
  const char* fallback;  // the value when the option is not given; null: none
  bool required;
};

// " N", " TEXT", ...: what follows the option's name in a usage text.
const char* Placeholder(Kind kind);

// The options of one run, checked against their kinds when they were set.
class Args {
 public:
  void Set(const std::string& name, const std::string& value) { m_Values[name] = value; }
  bool Has(const std::string& name) const { return m_Values.count(name) != 0; }

  // The value given, else the option's fallback (set by ParseArgs), else null.
  const char* Text(const char* name) const;
  int Int(const char* name) const;
  std::vector<int> Ints(const char* name) const;
  bool Flag(const char* name) const { return Has(name); }

 private:
  const std::string& Value(const char* name) const;

  std::map<std::string, std::string> m_Values;
};

// The client setup options, and the setup record they give (its texts point into args).
const std::vector<Option>& SetupOptions();
VL_WS_SetupParams SetupParams(const Args& args);

// "NAME (number): meaning" of a status that the function returned.
std::string DescribeStatus(VL_WS_Status status, const char* function);

struct Operation {
  const char* name;
  const char* function;  // the VL_WS_ function called
  const char* summary;
  std::vector<Option> options;
  bool handle;  // needs a client handle: takes the setup options
  // Calls the function and writes the result as the call left it (a record that failed is
  // written too); on failure the store's answer goes to detail.
  std::function<VL_WS_Status(const Args&, VL_WS_Handle*, VLJsonWriter*, std::string* detail)> run;
};

const std::vector<Operation>& Operations();

enum class Parsed { kRun, kHelp, kError };

// Reads the operation's options (and, for a handle, the setup options and the settings file) and
// applies the fallbacks; the message says what is wrong.
Parsed ParseArgs(const Operation& op, int argc, char** argv, Args* args, std::string* error);

}  // namespace vlws

#endif  // VLWSOPERATIONS_H
