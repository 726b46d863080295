// An integrator's program, built by the test of the installed package against that package: it
// prints the interface's version.
#include <stdio.h>

#include "VL_WS.h"

int main() {
  VL_WS_Version version = {};
  if (VL_WS_getVersion(&version) != VL_WS_OK) return 1;
  printf("DUDUVud %d.%d.%d\n", version.Major, version.Minor, version.Revision);
  VL_WS_release(&version);
  return 0;
}
