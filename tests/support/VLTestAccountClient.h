// A test fixture for the account, wishlist, purchase and streaming operations: a client handle
// on the program's store simulator, made with the token of a simulated account, and the means
// to look at what the client did (the simulator's request log, the handle's cache, the lines
// the library logged).
#ifndef VLTESTACCOUNTCLIENT_H
#define VLTESTACCOUNTCLIENT_H

#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "CacheInterface.h"
#include "VLTestDir.h"
#include "VLTestSimulator.h"
#include "VL_WS.h"
#include "VL_WS_Client.h"

class VLTestAccountClient : public testing::Test {
 protected:
  // The simulator's account of PIN 1234 (alice: saved card, prepaid funds, adult PIN "0007").
  static const char kPin[];
  static const int kPinNumber = 1234;

  // Clears the simulator's faults and request log and the account's wishlist.
  void SetUp() override;
  // Releases the handle and clears the faults.
  void TearDown() override;

  // Makes m_Handle (released first) with the test setup, the account's token from the store,
  // the access type, and a memory cache of the given kinds (none for 0), then clears the request
  // log so that it shows the operation under test only.
  void Init(VL_WS_AccessType accessType = STREAM, int cacheData = 0);
  int Account() const { return m_Account; }
  VL_WS_SetupParams2& Settings() { return m_Handle.client->m_Params; }
  CacheInterface& Cache() { return *m_Handle.client->m_Cache; }

  void Fault(const std::string& spec);
  // The request log once it holds count requests (the simulator may log a request just after
  // the client read its answer).
  std::vector<VLSimRequest> Requests(size_t count);
  // The request log as it is: for checking that nothing was asked.
  std::vector<VLSimRequest> RequestsNow() { return m_Sim.Requests(); }
  // The lines the library logged to "VL_WSAE" at level 4 since the last call.
  std::vector<std::string> TakeLog();

  VLSimServer& m_Sim = VLTestSimulator();
  VL_WS_Handle m_Handle = {};

 private:
  static void Observe(void* ctx, const char* area, int level, const char* text, size_t len);

  int m_Account = 0;
  VLTestDir m_LogDir;
  std::vector<std::string> m_Log;
};

#endif  // VLTESTACCOUNTCLIENT_H
