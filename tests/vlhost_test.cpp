// The launcher tool run as the device's launcher would run it: movie scripts, exit statuses,
// error messages, and the platform services' results chosen through the environment.
#include <gtest/gtest.h>
#include <sys/wait.h>

#include <cstdio>
#include <fstream>
#include <sstream>
#include <string>

namespace {

struct HostRun {
  int status;
  std::string out;
  std::string err;
};

// Runs vlhost with the movie source (and the environment assignments env, e.g. "A=1 ").
HostRun RunMovie(const std::string& name, const std::string& source, const std::string& env = "",
             const std::string& options = "") {
  std::string dir = testing::TempDir();
  std::string movie = dir + name + ".js";
  std::string err = dir + name + ".err";
  std::ofstream(movie) << source;
  std::string command = "env " + env + " " + VL_BINARY_DIR + "/vlhost " + options + " " + movie + " 2>" + err;
  HostRun run;
  FILE* p = popen(command.c_str(), "r");
  char buf[4096];
  size_t n;
  while ((n = fread(buf, 1, sizeof buf, p)) > 0) run.out.append(buf, n);
  int status = pclose(p);
  run.status = WIFEXITED(status) ? WEXITSTATUS(status) : -1;
  std::stringstream e;
  e << std::ifstream(err).rdbuf();
  run.err = e.str();
  return run;
}

TEST(Vlhost, RunsTheMovieBetweenInitAndTermination) {
  HostRun run = RunMovie("lifecycle",
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
  HostRun thrown = RunMovie("thrown", "throw new Error('the movie broke');");
  EXPECT_EQ(1, thrown.status);
  EXPECT_NE(std::string::npos, thrown.err.find("the movie broke")) << thrown.err;
  EXPECT_NE(std::string::npos, thrown.out.find("[VL_FLASH]Enter ~VeloraApp ,line = 78 \n"));  // still shut down

  HostRun syntax = RunMovie("syntax", "var x = ;");
  EXPECT_EQ(1, syntax.status);
  EXPECT_NE(std::string::npos, syntax.err.find("SyntaxError")) << syntax.err;

  EXPECT_EQ(3, RunMovie("exit", "exit(3);").status);
  EXPECT_EQ(2, RunMovie("nolibrary", "", "", "--library /nonexistent/libDUDUVud.so").status);
}

TEST(Vlhost, ServiceResultsComeFromTheEnvironment) {
  const char* movie = "newExtension('com.ostrel.DUDUVud'); print('constructed');";
  HostRun drm = RunMovie("drm", movie, "VL_DRM_INIT_RESULT=5");
  EXPECT_EQ(0, drm.status) << drm.err;
  EXPECT_NE(std::string::npos, drm.out.find("\n[VL_FLASH] Ipriv_drm_Init fail.ret = 5 \n"));
  EXPECT_NE(std::string::npos, drm.out.find("constructed\n"));

  HostRun network = RunMovie("network", movie, "VL_NET_INIT_RESULT=1");
  EXPECT_EQ(1, network.status);
  EXPECT_NE(std::string::npos, network.out.find("[VL_FLASH] init_network_msg_queue Error \n"));
  EXPECT_NE(std::string::npos, network.err.find("no extension class is registered as \"com.ostrel.DUDUVud\""));
}

}  // namespace
