// The installed package as an integrator uses it: cmake --install into a temporary prefix, then a
// small program built against the installation with pkg-config and with CMake's find_package,
// and run; and the installed vlws.
#include <gtest/gtest.h>

#include <string>

#include "VLTestCommand.h"
#include "VLTestDir.h"

namespace {

TEST(Install, AProgramBuildsAgainstTheInstalledPackageBothWays) {
  VLTestDir dir;
  const std::string prefix = dir / "prefix", lib = prefix + "/" + VL_INSTALL_LIBDIR;
  const std::string consumer = std::string(VL_SOURCE_DIR) + "/tests/install";
  VLCommandRun install =
      VLRunCommand(std::string(VL_CMAKE_COMMAND) + " --install " + VL_BINARY_DIR + " --prefix " + prefix);
  ASSERT_EQ(0, install.status) << install.out << install.err;

  VLCommandRun pkgconfig = VLRunCommand("export PKG_CONFIG_PATH=" + lib + "/pkgconfig && " + VL_CXX_COMPILER + " " +
                                        VL_CONSUMER_FLAGS + " -o " + dir / "consumer" + " " + consumer +
                                        "/consumer.cpp $(pkg-config --cflags --libs DUDUVud) && LD_LIBRARY_PATH=" +
                                        lib + " " + dir / "consumer");
  EXPECT_EQ(0, pkgconfig.status) << pkgconfig.err;
  EXPECT_EQ("DUDUVud 1.3.1\n", pkgconfig.out);

  // CMake gives the program the library's folder as its run path.
  VLCommandRun cmake = VLRunCommand(std::string(VL_CMAKE_COMMAND) + " -S " + consumer + " -B " + dir / "build" +
                                    " -DCMAKE_PREFIX_PATH=" + prefix + " -DCMAKE_CXX_COMPILER=" + VL_CXX_COMPILER +
                                    " '-DCMAKE_CXX_FLAGS=" + VL_CONSUMER_FLAGS + "' >/dev/null && " +
                                    VL_CMAKE_COMMAND + " --build " + dir / "build" + " >/dev/null && " +
                                    dir / "build/consumer");
  EXPECT_EQ(0, cmake.status) << cmake.err;
  EXPECT_EQ("DUDUVud 1.3.1\n", cmake.out);

  VLCommandRun vlws = VLRunCommand(prefix + "/bin/vlws version");
  EXPECT_EQ(0, vlws.status) << vlws.err;
  EXPECT_NE(std::string::npos, vlws.out.find("\"Minor\": 3")) << vlws.out;
}

}  // namespace
