// vlws: a command-line client of the store's flat interface. One run makes one call:
//
//   vlws OPERATION [OPTIONS]     e.g. vlws titles --genre 3 --page 1 --settings store.conf
//   vlws OPERATION --help        what the operation does and its options
//   vlws --help                  every operation
//
// Every operation is a row of one table (Operations()): its name, the VL_WS_ function it calls,
// its options with their types, and the call itself; the call's signature tells whether the
// operation needs a client handle and what record it fills. Operations with a handle take the
// client setup (VL_WS_SetupParams) as options or from a settings file, make the handle, call,
// and release both the result record and the handle.
//
// The result goes to standard output as JSON (VLRecordJson.h). Exit status: 0 when the call
// returned VL_WS_OK; 1 when it, or the handle's initialisation, returned a failing status, whose
// name, number and meaning (and the store's response code and message, when the record has them)
// go to standard error; 2 for wrong usage.
//
// The client reaches the store's own hosts unless VLWS_CONNECT_TO redirects them (a lab store or
// the simulator); SSL_CERT_FILE adds the CA of such a store.
#include <stdio.h>
#include <unistd.h>

#include <string>
#include <vector>

#include "VLWSOperations.h"

namespace {

using namespace vlws;

const int kExitFailed = 1;
const int kExitUsage = 2;

// ---- Command line -----------------------------------------------------------------------------

void PrintOptions(FILE* out, const std::vector<Option>& options) {
  for (const Option& option : options) {
    std::string left = std::string("--") + option.name + Placeholder(option.kind);
    std::string note = option.fallback ? std::string(" (default ") + option.fallback + ")"
                       : option.required ? " (required)" : "";
    fprintf(out, "  %-24s %s%s\n", left.c_str(), option.help, note.c_str());
  }
}

void Usage(FILE* out) {
  fprintf(out,
          "usage: vlws OPERATION [OPTIONS]   one call of the store client's interface VL_WS_\n"
          "       vlws OPERATION --help      the operation's options\n"
          "\nOperations:\n");
  for (const Operation& op : Operations()) fprintf(out, "  %-22s %s: %s\n", op.name, op.function, op.summary);
  fprintf(out,
          "\nOperations that talk to the store take the client's setup as options or from a settings file\n"
          "(see their --help). The result is written to standard output as JSON. Exit status: 0 success;\n"
          "1 the call or the client's initialisation failed (the status is named on standard error);\n"
          "2 wrong usage. VLWS_CONNECT_TO directs the client to a lab store or the simulator, SSL_CERT_FILE\n"
          "adds its CA.\n");
}

void OperationUsage(const Operation& op) {
  printf("usage: vlws %s [OPTIONS]\n%s: %s.\n", op.name, op.function, op.summary);
  if (!op.options.empty()) {
    printf("\nOptions:\n");
    PrintOptions(stdout, op.options);
  }
  if (op.handle) {
    printf("\nClient setup:\n");
    PrintOptions(stdout, SetupOptions());
  }
}

// The library prints a few progress lines (the endpoint it chose) to standard output; while it
// runs they go to standard error, so that standard output holds the JSON alone.
class LibraryOutputToStderr {
 public:
  LibraryOutputToStderr() : m_Saved(dup(STDOUT_FILENO)) {
    fflush(stdout);
    dup2(STDERR_FILENO, STDOUT_FILENO);
  }
  ~LibraryOutputToStderr() {
    fflush(stdout);
    dup2(m_Saved, STDOUT_FILENO);
    close(m_Saved);
  }
  LibraryOutputToStderr(const LibraryOutputToStderr&) = delete;
  LibraryOutputToStderr& operator=(const LibraryOutputToStderr&) = delete;

 private:
  int m_Saved;
};

// Makes the handle when the operation needs one, calls, and releases what it made.
VL_WS_Status Call(const Operation& op, const Args& args, VLJsonWriter* json, std::string* detail,
                  const char** function) {
  LibraryOutputToStderr redirect;
  VL_WS_Handle handle = {};
  if (op.handle) {
    VL_WS_SetupParams params = SetupParams(args);
    VL_WS_Status status = VL_WS_initialize(&handle, &params);
    if (status != VL_WS_OK) {
      VL_WS_release(&handle);  // VL_WS_E_TLS_SETUP leaves a handle to release
      *function = "VL_WS_initialize";
      return status;
    }
  }
  *function = op.function;
  VL_WS_Status status = op.run(args, &handle, json, detail);
  if (op.handle) VL_WS_release(&handle);
  return status;
}

int Run(const Operation& op, const Args& args) {
  VLJsonWriter json;
  std::string detail;
  const char* function = nullptr;
  VL_WS_Status status = Call(op, args, &json, &detail, &function);
  if (status != VL_WS_OK) {
    fprintf(stderr, "vlws %s: %s: %s%s%s\n", op.name, function, DescribeStatus(status, function).c_str(),
            detail.empty() ? "" : "; ", detail.c_str());
    return kExitFailed;
  }
  if (fputs(json.Text().c_str(), stdout) == EOF || fflush(stdout) != 0) {
    perror("vlws: standard output");
    return kExitFailed;
  }
  return 0;
}

}  // namespace

int main(int argc, char** argv) {
  if (argc < 2) {
    Usage(stderr);
    return kExitUsage;
  }
  std::string name = argv[1];
  if (name == "--help" || name == "-h") {
    Usage(stdout);
    return 0;
  }
  for (const Operation& op : Operations()) {
    if (name != op.name) continue;
    Args args;
    std::string error;
    switch (ParseArgs(op, argc - 2, argv + 2, &args, &error)) {
      case Parsed::kHelp:
        OperationUsage(op);
        return 0;
      case Parsed::kError:
        fprintf(stderr, "vlws %s: %s\n(vlws %s --help lists its options)\n", op.name, error.c_str(), op.name);
        return kExitUsage;
      case Parsed::kRun:
        return Run(op, args);
    }
  }
  fprintf(stderr, "vlws: unknown operation \"%s\" (vlws --help lists them)\n", name.c_str());
  return kExitUsage;
}

