// The soak: a main handle and its duplicates on one cache file, each in a thread of its own,
// run a few thousand mixed operations (catalogue pages and details, account answers kept as user
// data, wishlist changes, THX settings of the streaming service, box art, the environment query,
// the server time, cache refreshes) while the store answers about a third of the requests with a
// random fault. Every call must end with a status of the interface and a record that can be
// released, the cache file must stay sound, and the heap in use must not grow from the first half
// of the run to the second. The operations and faults of each thread come from a fixed seed.
#include <gtest/gtest.h>

#include <malloc.h>

#include <atomic>
#include <random>
#include <set>
#include <string>
#include <thread>
#include <vector>

#if defined(__SANITIZE_ADDRESS__)
// AddressSanitizer's count of the bytes in use (its allocator replaces glibc's; g++ ships no
// header that declares it).
extern "C" size_t __sanitizer_get_current_allocated_bytes();
#endif

#include "VLTestDir.h"
#include "VLTestSimulator.h"
#include "VL_WS.h"

namespace {

// glibc's figures of the heap in use cover its main arena only: every thread allocates there.
const int s_OneArena = mallopt(M_ARENA_MAX, 1);

const int kThreads = 4;         // the main handle and three duplicates
const int kCallsPerHalf = 600;  // of each thread, in each half of the run

// The statuses a failed store exchange may end with (VL_WS_Records.h).
bool IsInterfaceStatus(VL_WS_Status status) {
  static const std::set<int> s_Soap = {1, 2, 3, 5, 6, 8, 9, 12, 13, 23, 24, 25, 26, 39, 42, 43, 44, 45};
  static const std::set<VL_WS_Status> s_Plain = {VL_WS_OK,       VL_WS_E_NETWORK, VL_WS_E_UNEXPECTED,
                                                 VL_WS_E_HTTP_NOT_FOUND, VL_WS_E_CONNECT, VL_WS_E_EOF,
                                                 VL_WS_E_TLS};
  int http = VL_WS_E_HTTP - status, soap = VL_WS_E_SOAP - status;
  return s_Plain.count(status) || (http >= 100 && http <= 599) || (http >= 14 && http <= 19) || http == 29 ||
         s_Soap.count(soap);
}

// The operations of the mix, each with the simulator's fault target of its request. Arguments
// come from small ranges, so that the cache answers many calls after the first half's.
const struct Operation {
  const char* target;
  VL_WS_Status (*call)(VL_WS_Handle* handle, int a, int b);
} kOperations[] = {
    {"getTitlesByNavigation",
     [](VL_WS_Handle* h, int a, int b) {
       return VLReleasedCall<VL_WS_TitlesResponse>(VL_WS_TAG_NONE, VL_WS_getTitles, h, 10 + a % 4, 1 + b % 3, 5, 2);
     }},
    {"getTitleListing",
     [](VL_WS_Handle* h, int a, int) {
       return VLReleasedCall<VL_WS_TitleListingResponse>(VL_WS_TAG_NONE, VL_WS_getTitleListing, h, 1001 + a % 12);
     }},
    {"getNavigation",
     [](VL_WS_Handle* h, int, int) {
       return VLReleasedCall<VL_WS_GenreArray>(VL_WS_TAG_NONE, VL_WS_getNavigation, h);
     }},
    {"getEmailAddress",
     [](VL_WS_Handle* h, int, int) {
       return VLReleasedCall<VL_WS_EmailAddressResponse>(VL_WS_TAG_NONE, VL_WS_getEmailAddress, h);
     }},
    {"showPrePaidCardBalance",
     [](VL_WS_Handle* h, int, int) {
       return VLReleasedCall<VL_WS_PrePaidCardBalanceResponse>(VL_WS_TAG_NONE, VL_WS_getPrePaidCardBalance, h);
     }},
    {"getMyStreamingVideos",
     [](VL_WS_Handle* h, int, int b) {
       return VLReleasedCall<VL_WS_MyVideosResponse>(VL_WS_TAG_NONE, VL_WS_getMyVideos, h, 1 + b % 2, 10, 2, 0, 3);
     }},
    {"addItemToWishlist",
     [](VL_WS_Handle* h, int a, int) {
       return VLReleasedCall<VL_WS_StandardResponse>(VL_WS_TAG_NONE, VL_WS_addItemToWishlist, h, 1001 + a % 12);
     }},
    {"removeItemFromWishlist",
     [](VL_WS_Handle* h, int a, int) {
       return VLReleasedCall<VL_WS_StandardResponse>(VL_WS_TAG_NONE, VL_WS_removeItemFromWishlist, h, 1001 + a % 12);
     }},
    {"getTitleListing",
     [](VL_WS_Handle* h, int a, int) {
       bool in = false;
       return VL_WS_checkTitleInWishlist(h, 1001 + a % 12, &in);
     }},
    {"getTHXMediaDirectorBonusAsset",
     [](VL_WS_Handle* h, int, int) {
       return VLReleasedCall<VL_WS_THXMediaDirectorResponse>(VL_WS_TAG_NONE, VL_WS_getTHXMediaDirectorBonusAsset, h,
                                                             10015, 1, 0);
     }},
    {"/images/boxart/",
     [](VL_WS_Handle* h, int a, int b) {
       std::string prefix = "t" + std::to_string(1001 + a % 8) + "_";
       VL_WS_Image image;
       VL_WS_Status status =
           VL_WS_getBoxArtImageData(h, b % 2 ? VL_WS_BOXART_175 : VL_WS_BOXART_65, prefix.c_str(), &image);
       EXPECT_EQ(status == VL_WS_OK, image.Data != nullptr);
       EXPECT_EQ(VL_WS_OK, VL_WS_release(&image));
       return status;
     }},
    {"/device/env/",
     [](VL_WS_Handle* h, int, int) {
       VL_WS_EnvID env = 0;
       return VL_WS_getDefaultEnvID(h, &env);
     }},
    {"/device/time/",
     [](VL_WS_Handle*, int, int) {
       time_t now = 0;
       return VL_WS_getServerTime(&now);
     }},
    {"getLastCacheLoadTimeUTC",
     [](VL_WS_Handle* h, int a, int) {
       return VL_WS_updateLocalCache(h, a % 2 ? VL_WS_CacheParam::CACHE_USERDATA : VL_WS_CacheParam::CACHE_METADATA);
     }},
};

// The faults drawn: every mode that ends an exchange at once, and a certificate of another host.
const char* const kFaults[] = {"close",     "cut",       "status:404", "status:500",   "status:503",
                               "soapfault", "code:5",    "malformed",  "truncated",    "gzip",
                               "deflate",   "badlength:64", "badlength:-64", "trickle:1"};

class Soak : public VLSimClientTest {
 protected:
  // The heap in use must show the client's memory: the simulator in the same process keeps each
  // request's nonce only as long as its clock skew allows.
  static void SetUpTestSuite() {
    VLSimOptions options;
    options.clockSkewSeconds = 2;
    VLTestSimulator(options);
  }

  // A thread's half of the run: its calls on its handle, each failed one with a status of the
  // interface. About one request in three is given a fault; it may hit another thread's
  // request of the same kind, which makes no difference to what is checked.
  void Run(VL_WS_Handle* handle, std::mt19937* random) {
    std::uniform_int_distribution<int> operations(0, sizeof kOperations / sizeof kOperations[0] - 1);
    std::uniform_int_distribution<int> faults(0, sizeof kFaults / sizeof kFaults[0] - 1);
    std::uniform_int_distribution<int> dice(0, 99);
    for (int call = 0; call < kCallsPerHalf; ++call) {
      const Operation& operation = kOperations[operations(*random)];
      int roll = dice(*random);
      std::string error;
      if (roll < 3) {
        EXPECT_TRUE(m_Sim.AddFault("store.ostrel.example=tls:wronghost,times=1", &error)) << error;
      } else if (roll < 33) {
        std::string spec = std::string(operation.target) + "=" + kFaults[faults(*random)] + ",times=1";
        EXPECT_TRUE(m_Sim.AddFault(spec, &error)) << error;
      }
      VL_WS_Status status = operation.call(handle, dice(*random), dice(*random));
      EXPECT_TRUE(IsInterfaceStatus(status)) << operation.target << ": " << status;
      m_Failed += status != VL_WS_OK;
    }
  }

  // Runs one half on every handle at once; the heap in use afterwards, with the simulator's
  // request log and leftover faults gone.
  size_t Half(std::vector<VL_WS_Handle>& handles, std::vector<std::mt19937>& randoms) {
    std::vector<std::thread> threads;
    for (int t = 0; t < kThreads; ++t) threads.emplace_back(&Soak::Run, this, &handles[t], &randoms[t]);
    for (std::thread& thread : threads) thread.join();
    m_Sim.ClearFaults();
    m_Sim.ClearRequests();
#if defined(__SANITIZE_ADDRESS__)
    return __sanitizer_get_current_allocated_bytes();
#else
    struct mallinfo2 heap = mallinfo2();
    return heap.uordblks + heap.hblkhd;
#endif
  }

  std::atomic<int> m_Failed{0};
};

TEST_F(Soak, HandlesOnOneCacheFileUnderRandomFaults) {
  VLTestDir dir;
  VL_WS_SetupParams params = VLTestSetupParams(2, 7, dir.path().c_str());
  std::vector<VL_WS_Handle> handles(kThreads);
  ASSERT_EQ(VL_WS_OK, VL_WS_initialize(&handles[0], &params));
  ASSERT_EQ(VL_WS_OK,
            VLReleasedCall<VL_WS_AuthorizeDeviceResponse>(VL_WS_TAG_NONE, VL_WS_authorizeDevice, &handles[0], 1234));
  for (int t = 1; t < kThreads; ++t) ASSERT_EQ(VL_WS_OK, VL_WS_duplicate(&handles[t], &handles[0]));
  std::vector<std::mt19937> randoms;
  for (int t = 0; t < kThreads; ++t) randoms.emplace_back(20101231 + t);

  size_t first = Half(handles, randoms);
  size_t second = Half(handles, randoms);
  printf("%d calls, %d failed; heap in use after the first half %zu bytes, after the second %zu\n",
         2 * kThreads * kCallsPerHalf, m_Failed.load(), first, second);
  // What the caches and buffers hold varies by some 70 KB from one half to the next.
  EXPECT_LT(second, first + 256 * 1024) << "the heap grew by " << second - first << " bytes";

  for (VL_WS_Handle& handle : handles) {
    EXPECT_EQ(VL_WS_OK, VLReleasedCall<VL_WS_TitlesResponse>(VL_WS_TAG_NONE, VL_WS_getTitles, &handle, 10, 1, 5, 2));
    VL_WS_release(&handle);
  }
  EXPECT_EQ("ok", VLRunSql(VLCacheFileIn(dir.path()), "PRAGMA integrity_check"));
}

}  // namespace
