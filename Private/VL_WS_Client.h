// VL_WS_Client.h: the client state behind a VL_WS_Handle (tag 1).
#ifndef VL_WS_CLIENT_H
#define VL_WS_CLIENT_H

#include "VL_WS_Types.h"

// Frees a handle's client state: closes and deletes its cache, then destroys its settings, the
// dispatcher and the three service objects. VL_WS_release calls it for a handle that has one.
void VLClientRelease(VL_WS_Client* client);

#endif  // VL_WS_CLIENT_H
