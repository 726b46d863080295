// The application object from createApplication2 through init, onTerminate and destruction:
// trace lines, service start and stop order, failure handling, keys and registration.
#include <gtest/gtest.h>

#include <chrono>
#include <string>
#include <vector>

#include "VLStage.h"
#include "VL_PlatformServices.h"
#include "VeloraApp.h"

namespace {

const unsigned int kSpFlagKey = 0x01000009;
const unsigned int kTerminateKey = 0x00400100;

std::string Trace(const char* function, int line) {
  return "[VL_FLASH]Enter " + std::string(function) + " ,line = " + std::to_string(line) + " \n";
}

std::vector<VL_PlatformService> ServiceCalls() {
  VL_PlatformService calls[16];
  size_t n = VL_PlatformServiceCalls(calls, 16);
  return std::vector<VL_PlatformService>(calls, calls + std::min<size_t>(n, 16));
}

class Lifecycle : public testing::Test {
 protected:
  Lifecycle() : stage(1), launcher(&stage) {
    VL_PlatformResetServices();
    sp_flag = 0;
  }
  ~Lifecycle() override {
    sp_flag = 0;
    VL_PlatformResetServices();
  }

  // Runs the whole lifecycle with launcher, calling onTerminate terminations times; returns what
  // it printed, and in *first how long the first onTerminate took.
  static std::string RunLifecycle(scLauncher::ILauncher* with, int terminations = 1,
                                  std::chrono::steady_clock::duration* first = nullptr) {
    testing::internal::CaptureStdout();
    scLauncher::IApplication2* app = createApplication2();
    app->init(with);
    auto start = std::chrono::steady_clock::now();
    app->onTerminate();
    if (first) *first = std::chrono::steady_clock::now() - start;
    for (int i = 1; i < terminations; ++i) app->onTerminate();
    delete app;
    return testing::internal::GetCapturedStdout();
  }

  vlplatform::Stage stage;
  vlplatform::Launcher launcher;
};

TEST_F(Lifecycle, StartsTheServicesRegistersTheClassesAndStopsTheServices) {
  std::string out = RunLifecycle(&launcher);
  EXPECT_EQ(Trace("createApplication2", 169) + Trace("VeloraApp", 71) + Trace("init", 94) +
                Trace("init", 99) + "[VL_FLASH] Init network ipc \n" + Trace("onTerminate", 133) +
                "\n[VL_FLASH] Now send  AEKEY_TERMINATEANIMATION \n" + Trace("~VeloraApp", 78) +
                "[VL_FLASH] Uninit network ipc \n",
            out);
  EXPECT_EQ((std::vector<VL_PlatformService>{VL_SERVICE_DRM_INIT, VL_SERVICE_NET_INIT, VL_SERVICE_NET_UNINIT,
                                             VL_SERVICE_DRM_TERMINATE}),
            ServiceCalls());
  EXPECT_EQ((std::vector<std::string>{"com.ostrel.DUDUVud", "com.ostrel.VLCfgLib", "com.ostrel.VLPlayerLibAE"}),
            stage.ClassIds());
}

TEST_F(Lifecycle, WithoutAStageNothingStartsAndNoKeyIsSent) {
  vlplatform::Launcher stageless(nullptr);
  std::string out = RunLifecycle(&stageless);
  EXPECT_EQ(Trace("createApplication2", 169) + Trace("VeloraApp", 71) + Trace("init", 94) +
                Trace("onTerminate", 133) + Trace("~VeloraApp", 78) + "[VL_FLASH] Uninit network ipc \n",
            out);
  // The destructor stops both services whether or not init started them.
  EXPECT_EQ((std::vector<VL_PlatformService>{VL_SERVICE_NET_UNINIT, VL_SERVICE_DRM_TERMINATE}), ServiceCalls());
  EXPECT_TRUE(stage.Keys().empty());
  EXPECT_TRUE(stage.ClassIds().empty());
}

// onTerminate sends the terminate key, pressed and released, at once, each time it is called;
// with sp_flag set it sends its own key first and pauses.
TEST_F(Lifecycle, OnTerminateSendsItsKeysAndPausesOnlyWithSpFlag) {
  const std::string pause = "\n[VL_FLASH] Now send  AEKEY_TERMINATEANIMATION \nIn Sleep FUNCTION, delay time is :800 ms\n";
  for (int flag : {0, 1}) {
    SCOPED_TRACE(flag);
    vlplatform::Stage own(1);
    vlplatform::Launcher with(&own);
    sp_flag = flag;
    std::chrono::steady_clock::duration first;
    std::string out = RunLifecycle(&with, 2 - flag, &first);
    EXPECT_EQ(flag == 1, first >= std::chrono::milliseconds(800));
    EXPECT_EQ(flag == 1, out.find(flag ? pause : "In Sleep FUNCTION") != std::string::npos);
    const unsigned int codes[] = {flag ? kSpFlagKey : kTerminateKey, flag ? kSpFlagKey : kTerminateKey,
                                  kTerminateKey, kTerminateKey};
    ASSERT_EQ(4u, own.Keys().size());
    for (size_t i = 0; i < 4; ++i) {
      EXPECT_EQ(codes[i], own.Keys()[i].keyCode) << i;
      EXPECT_EQ(i % 2 == 0, own.Keys()[i].pressed) << i;
      EXPECT_EQ(0u, own.Keys()[i].modifiers) << i;
    }
  }
}

// A failing DRM start or stop is reported and the rest goes on; a failing network queue leaves
// every class unregistered.
TEST_F(Lifecycle, FailingServicesAreReported) {
  const struct {
    VL_PlatformService service;
    int result;
    std::string printed;
    size_t classes;
  } cases[] = {
      {VL_SERVICE_DRM_INIT, 5,
       Trace("init", 99) + "\n[VL_FLASH] Ipriv_drm_Init fail.ret = 5 \n[VL_FLASH] Init network ipc \n", 3},
      {VL_SERVICE_NET_INIT, 1,
       "[VL_FLASH] Init network ipc \n[VL_FLASH] init_network_msg_queue Error \n" + Trace("onTerminate", 133), 0},
      {VL_SERVICE_DRM_TERMINATE, -2, "[VL_FLASH] Uninit network ipc \n\n[VL_FLASH] Ipriv_drm_Terminate fail.ret = -2 \n", 3},
  };
  for (const auto& c : cases) {
    vlplatform::Stage own(1);
    vlplatform::Launcher with(&own);
    VL_PlatformResetServices();
    VL_PlatformSetServiceResult(c.service, c.result);
    std::string out = RunLifecycle(&with);
    EXPECT_NE(std::string::npos, out.find(c.printed)) << out;
    EXPECT_EQ(c.classes, own.ClassIds().size());
    EXPECT_EQ(2u, own.Keys().size());
    if (c.classes == 0) EXPECT_FALSE(own.Evaluate("movie.js", "newExtension('com.ostrel.VLPlayerLibAE');"));
  }
}

TEST_F(Lifecycle, KeyFilterLetsEveryKeyThroughAndEventsAreIgnored) {
  testing::internal::CaptureStdout();
  scLauncher::IApplication2* app = createApplication2();
  EXPECT_TRUE(app->filterKeyEvent(0, false));
  EXPECT_TRUE(app->filterKeyEvent(kTerminateKey, true));
  EXPECT_TRUE(app->filterKeyEvent(0xFFFFFFFFu, true));
  app->onEvent(ADDON_HOST_EVENT_SUSPEND);
  delete app;
  std::string out = testing::internal::GetCapturedStdout();
  EXPECT_NE(std::string::npos,
            out.find(Trace("filterKeyEvent", 159) + Trace("filterKeyEvent", 159) + Trace("filterKeyEvent", 159) +
                     Trace("onEvent", 154)));
}

}  // namespace
