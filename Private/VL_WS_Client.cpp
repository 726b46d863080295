// The client state behind a handle.
#include "VL_WS_Client.h"

void VLClientRelease(VL_WS_Client* client) {
  if (client->m_Cache) {
    client->m_Cache->Close();
    delete client->m_Cache;
    client->m_Cache = nullptr;
  }
  delete client;
}
