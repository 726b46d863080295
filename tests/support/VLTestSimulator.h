// The store simulator of a test program that drives the client library through its flat
// interface, and setup records that fit it.
#ifndef VLTESTSIMULATOR_H
#define VLTESTSIMULATOR_H

#include <gtest/gtest.h>

#include <vector>

#include "VLSimServer.h"
#include "VL_WS.h"

// The program's simulator, started on ephemeral ports at the first call (with the options of
// that call), with SSL_CERT_FILE and VLWS_CONNECT_TO pointing at it. The library reads
// VLWS_CONNECT_TO at its first connection and never again, so a program has this one simulator
// for all its tests: call it before any client connects. Tests that change the simulator's
// faults or store should undo what they change.
VLSimServer& VLTestSimulator(const VLSimOptions& options = VLSimOptions());

// A setup record the simulator accepts: its user, password and API key, device
// "00-11-22-33-44-55" of type 7, the general catalogue in production, access type STREAM (no
// question to the store), no proxy, and a cache of the type given (none by default) of the kinds
// in cacheData in the folder cachePath. The strings are static, but for cachePath.
VL_WS_SetupParams VLTestSetupParams(int cacheType = 0, int cacheData = 7, const char* cachePath = nullptr);

// The simulator's request log in the order the client connected: the simulator logs a request
// as it answers it, but a failed TLS handshake only once the client has given up and may be on to
// its next request.
std::vector<VLSimRequest> VLRequestsByConnection(VLSimServer& sim);

// Calls operation with the arguments and a record of its own, checks that the record carries a
// tag (the given one, unless that is VL_WS_TAG_NONE) and that it is released; returns the
// operation's status.
template <class Record, class... Params, class... Args>
VL_WS_Status VLReleasedCall(int tag, VL_WS_Status (*operation)(VL_WS_Handle*, Params...), VL_WS_Handle* handle,
                            Args... args) {
  Record record;
  VL_WS_Status status = operation(handle, args..., &record);
  EXPECT_TRUE(record.tag != nullptr && (tag == VL_WS_TAG_NONE || *record.tag == tag));
  EXPECT_EQ(VL_WS_OK, VL_WS_release(&record));
  return status;
}

// A test on the program's simulator with one client handle: it starts without faults and with an
// empty request log, and its handle is released at its end.
class VLSimClientTest : public testing::Test {
 protected:
  void SetUp() override;
  void TearDown() override;

  // The request log once it holds count requests (waiting up to 5 s), in the order the client
  // connected.
  std::vector<VLSimRequest> Requests(size_t count);
  void Fault(const std::string& spec);

  VLSimServer& m_Sim = VLTestSimulator();
  VL_WS_Handle m_Handle = {};
};

#endif  // VLTESTSIMULATOR_H
