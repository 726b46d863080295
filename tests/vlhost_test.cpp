// The launcher tool run as the device's launcher would run it: movie scripts, exit statuses,
// error messages, and the platform services' results chosen through the environment.
#include <gtest/gtest.h>

#include <fstream>
#include <string>

#include "VLTestCommand.h"

namespace {

// Runs vlhost with the movie source (and the environment assignments env, e.g. "A=1 ").
VLCommandRun RunMovie(const std::string& name, const std::string& source, const std::string& env = "",
                      const std::string& options = "") {
  std::string movie = testing::TempDir() + name + ".js";
  std::ofstream(movie) << source;
  return VLRunCommand("env " + env + " " + VL_BINARY_DIR + "/vlhost " + options + " " + movie);
}

TEST(Vlhost, RunsTheMovieBetweenInitAndTermination) {
  VLCommandRun run = RunMovie("lifecycle",
                              "var player = newExtension('com.ostrel.VLPlayerLibAE');"
                              "var frames = 0;"
                              "onEnterFrame = function () { if (++frames == 3) { print('frames', frames, player.Play()); quit(); } };");
  EXPECT_EQ(0, run.status) << run.err;
  EXPECT_EQ(0u, run.out.find("[VL_FLASH]Enter createApplication2 ,line = 169 \n")) << run.out;
  size_t init = run.out.find("[VL_FLASH] Init network ipc \n");
  size_t movie = run.out.find("frames 3 0\n");
  size_t terminate = run.out.find("[VL_FLASH]Enter onTerminate ,line = 133 \n");
  size_t keys = run.out.find("vlhost: key press 0x00400100\nvlhost: key release 0x00400100\n");
  EXPECT_LT(init, movie);
  EXPECT_LT(movie, terminate);
  EXPECT_LT(terminate, keys);
  EXPECT_NE(std::string::npos, keys);
}

TEST(Vlhost, AScriptErrorExitsNonZeroWithTheMessage) {
  VLCommandRun thrown = RunMovie("thrown", "throw new Error('the movie broke');");
  EXPECT_EQ(1, thrown.status);
  EXPECT_NE(std::string::npos, thrown.err.find("the movie broke")) << thrown.err;
  EXPECT_NE(std::string::npos, thrown.out.find("[VL_FLASH]Enter ~VeloraApp ,line = 78 \n"));  // still shut down

  VLCommandRun syntax = RunMovie("syntax", "var x = ;");
  EXPECT_EQ(1, syntax.status);
  EXPECT_NE(std::string::npos, syntax.err.find("SyntaxError")) << syntax.err;

  EXPECT_EQ(3, RunMovie("exit", "exit(3);").status);
  EXPECT_EQ(2, RunMovie("nolibrary", "", "", "--library /nonexistent/libDUDUVud.so").status);
}

TEST(Vlhost, ServiceResultsComeFromTheEnvironment) {
  const char* movie = "newExtension('com.ostrel.DUDUVud'); print('constructed');";
  VLCommandRun drm = RunMovie("drm", movie, "VL_DRM_INIT_RESULT=5");
  EXPECT_EQ(0, drm.status) << drm.err;
  EXPECT_NE(std::string::npos, drm.out.find("\n[VL_FLASH] Ipriv_drm_Init fail.ret = 5 \n"));
  EXPECT_NE(std::string::npos, drm.out.find("constructed\n"));

  VLCommandRun network = RunMovie("network", movie, "VL_NET_INIT_RESULT=1");
  EXPECT_EQ(1, network.status);
  EXPECT_NE(std::string::npos, network.out.find("[VL_FLASH] init_network_msg_queue Error \n"));
  EXPECT_NE(std::string::npos, network.err.find("no extension class is registered as \"com.ostrel.DUDUVud\""));
}

}  // namespace
