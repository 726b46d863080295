// The kernel (built in, and the module that InitializeAEKernel loads) and the DRM and network
// service stand-ins.
#include <gtest/gtest.h>

#include <cstdlib>
#include <cstring>

#include "IAEKernel.h"
#include "VL_PlatformServices.h"

namespace {

TEST(Kernel, InitializeLoadsTheModuleOnceAndCountsItsUsers) {
  IAEKernel* builtin = IAEKernel::GetKernel();
  ASSERT_NE(nullptr, builtin);
  char name[] = "test";
  char* argv[] = {name, nullptr};
  IAEKernel* loaded = IAEKernel::InitializeAEKernel(1, argv);
  ASSERT_NE(nullptr, loaded) << "libIAEKernel.so was not found next to the platform library";
  EXPECT_NE(builtin, loaded);
  EXPECT_EQ(loaded, IAEKernel::GetKernel());
  EXPECT_EQ(loaded, IAEKernel::InitializeAEKernel(1, argv));
  IAEKernel::UninitializeAEKernel();
  EXPECT_EQ(loaded, IAEKernel::GetKernel());  // one user left
  IAEKernel::UninitializeAEKernel();
  EXPECT_EQ(builtin, IAEKernel::GetKernel());
  IAEKernel::UninitializeAEKernel();  // one too many: nothing happens
  EXPECT_EQ(builtin, IAEKernel::GetKernel());
}

TEST(Kernel, MutexesMemoryAndFailedChecks) {
  IAEKernel* kernel = IAEKernel::GetKernel();
  IAEKernel::Mutex* mutex = kernel->CreateMutex();
  ASSERT_NE(nullptr, mutex);
  mutex->Lock();
  mutex->Unlock();
  kernel->DestroyMutex(mutex);

  char* p = static_cast<char*>(kernel->Allocate(8, __FILE__, __LINE__));
  ASSERT_NE(nullptr, p);
  kernel->SetMemory(p, 'x', 7);
  p[7] = '\0';
  EXPECT_STREQ("xxxxxxx", p);
  kernel->CopyMemory(p, "abc", 3);
  kernel->MoveMemory(p + 1, p, 3);
  EXPECT_STREQ("aabcxxx", p);
  EXPECT_EQ(7u, kernel->StringLength(p));
  kernel->Free(p);

  testing::internal::CaptureStderr();
  kernel->ReportFailedCheck("file.cpp", 12, "m_DB != 0");
  EXPECT_EQ("Check failed: m_DB != 0, file file.cpp, line 12\n", testing::internal::GetCapturedStderr());
}

TEST(PlatformServices, ResultsComeFromTheControlThenTheEnvironmentAndCallsAreRecorded) {
  VL_PlatformResetServices();
  EXPECT_EQ(0, Ipriv_drm_Init());
  setenv("VL_NET_INIT_RESULT", "4", 1);
  EXPECT_EQ(4, init_network_msg_queue());
  VL_PlatformSetServiceResult(VL_SERVICE_NET_INIT, 0);
  EXPECT_EQ(0, init_network_msg_queue());
  unsetenv("VL_NET_INIT_RESULT");
  VL_PlatformSetServiceResult(VL_SERVICE_DRM_TERMINATE, -3);
  EXPECT_EQ(-3, Ipriv_drm_Terminate());
  EXPECT_EQ(0, uninit_network_msg_queue());

  VL_PlatformService calls[8];
  ASSERT_EQ(5u, VL_PlatformServiceCalls(calls, 8));
  const VL_PlatformService expected[] = {VL_SERVICE_DRM_INIT, VL_SERVICE_NET_INIT, VL_SERVICE_NET_INIT,
                                         VL_SERVICE_DRM_TERMINATE, VL_SERVICE_NET_UNINIT};
  for (int i = 0; i < 5; ++i) EXPECT_EQ(expected[i], calls[i]) << i;

  VL_PlatformResetServices();
  EXPECT_EQ(0u, VL_PlatformServiceCalls(calls, 8));
  EXPECT_EQ(0, Ipriv_drm_Terminate());
}

}  // namespace
