#include "VLTestCommand.h"

#include <gtest/gtest.h>
#include <stdio.h>
#include <stdlib.h>
#include <sys/wait.h>
#include <unistd.h>

#include "VLTestDir.h"

VLCommandRun VLRunCommand(const std::string& command) {
  VLCommandRun run = {-1, "", ""};
  std::string base = testing::TempDir();
  if (base.empty() || base.back() != '/') base += '/';
  std::string errFile = base + "vlcommand_XXXXXX";
  int fd = mkstemp(&errFile[0]);
  if (fd < 0) {
    ADD_FAILURE() << "cannot create a file below " << base;
    return run;
  }
  close(fd);
  FILE* p = popen(("{ " + command + "\n} 2>" + errFile).c_str(), "r");
  if (!p) {
    ADD_FAILURE() << "cannot run " << command;
    return run;
  }
  char buffer[4096];
  size_t n;
  while ((n = fread(buffer, 1, sizeof buffer, p)) > 0) run.out.append(buffer, n);
  int status = pclose(p);
  run.status = WIFEXITED(status) ? WEXITSTATUS(status) : -1;
  run.err = VLReadFile(errFile);
  remove(errFile.c_str());
  return run;
}
