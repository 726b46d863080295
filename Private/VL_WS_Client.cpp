// The client state behind a handle.
#include "VL_WS_Client.h"

// The client state is created by VL_WS_initialize and VL_WS_duplicate, which are not part of the
// library yet: no handle can carry client state, so there is nothing to free here.
void VLClientRelease(VL_WS_Client* client) {}
