// Runs a program of the project as a user runs it from a shell, for tests of its output and exit
// status.
#ifndef VLTESTCOMMAND_H
#define VLTESTCOMMAND_H

#include <string>

struct VLCommandRun {
  int status;       // the exit status; -1 when the command did not exit normally
  std::string out;  // standard output
  std::string err;  // standard error
};

// Runs the command line with /bin/sh and waits for it.
VLCommandRun VLRunCommand(const std::string& command);

#endif  // VLTESTCOMMAND_H
