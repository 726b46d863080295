// A test fixture for the account, purchase, wishlist and streaming operations: a client handle on
// the program's store simulator, made with the token of a simulated account, and the means to
// look at what the client did (the simulator's request log, the handle's cache, the lines the
// library logged).
#ifndef VLTESTACCOUNTCLIENT_H
#define VLTESTACCOUNTCLIENT_H

#include <string>
#include <tuple>
#include <type_traits>
#include <vector>

#include "CacheInterface.h"
#include "VLTestDir.h"
#include "VLTestSimulator.h"
#include "VL_WS_Client.h"

// A record of the interface that is given back before it is filled again and at the end of its
// scope: pass Fresh() to the operation, read the fields through ->.
template <class Record>
class VLAnswer {
 public:
  VLAnswer() = default;
  VLAnswer(const VLAnswer&) = delete;
  VLAnswer& operator=(const VLAnswer&) = delete;
  ~VLAnswer() { VL_WS_release(&m_Record); }

  Record* Fresh() {
    VL_WS_release(&m_Record);
    return &m_Record;
  }
  const Record* operator->() const { return &m_Record; }

 private:
  Record m_Record{};
};

class VLTestAccountClient : public VLSimClientTest {
 protected:
  // The simulator's account of PIN 1234 (alice: saved card, prepaid funds, adult PIN "0007").
  static const char kPin[];
  static const int kPinNumber = 1234;

  // Also empties the account's wishlist and captures the log.
  void SetUp() override;
  void TearDown() override;

  // Makes m_Handle (released first) with the test setup, the account's token from the store,
  // the access type, and a memory cache of the given kinds (none for 0), then clears the request
  // log (the catalogue's load time a cache of service answers asks for included) so that it shows
  // the operations under test only.
  void Init(VL_WS_AccessType accessType = STREAM, int cacheData = 0);
  int Account() const { return m_Account; }
  VL_WS_SetupParams2& Settings() { return m_Handle.client->m_Params; }
  CacheInterface& Cache() { return *m_Handle.client->m_Cache; }
  // The title's wishlist flag in the cache: -1 without one, else 0 or 1.
  int Flag(int titleID) {
    bool flag = false;
    return Cache().ReadWishlistFlag(titleID, flag) ? flag : -1;
  }

  // Calls an operation on m_Handle whose last parameter is the record (or value) it fills, and
  // gives the record back: for calls whose effect shows in the status, the store, the request log
  // or the cache.
  template <class... Params, class... Args>
  VL_WS_Status Call(VL_WS_Status (*operation)(VL_WS_Handle*, Params...), Args... args) {
    using Filled = std::remove_pointer_t<std::tuple_element_t<sizeof...(Params) - 1, std::tuple<Params...>>>;
    Filled filled{};
    VL_WS_Status status = operation(&m_Handle, args..., &filled);
    if constexpr (std::is_class_v<Filled>) VL_WS_release(&filled);
    return status;
  }

  // The request log as it is: for checking that nothing was asked.
  std::vector<VLSimRequest> RequestsNow() { return m_Sim.Requests(); }
  // The lines the library logged to "VL_WSAE" at level 4 since the last call (without their line
  // end).
  std::vector<std::string> TakeLog();

 private:
  static void Observe(void* ctx, const char* area, int level, const char* text, size_t len);

  int m_Account = 0;
  VLTestDir m_LogDir;
  std::vector<std::string> m_Log;
};

#endif  // VLTESTACCOUNTCLIENT_H
