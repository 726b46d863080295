// Catalogue operations against a store without a catalogue: every list comes back empty, is
// returned as such and is never kept in the cache. A program of its own, because a program's
// client connects to one simulator only.
#include <gtest/gtest.h>
#include <stdlib.h>

#include <fstream>
#include <string>

#include "CacheInterface.h"
#include "VLSimServer.h"
#include "VLTestDir.h"
#include "VLTestSimulator.h"
#include "VL_WS.h"
#include "VL_WS_Client.h"

namespace {

// The store's data files with their column lines only.
void WriteEmptyStore(const std::string& folder) {
  for (const char* name : {"genres.tsv", "titles.tsv", "episodes.tsv", "products.tsv", "bonus.tsv", "accounts.tsv",
                           "giftcertificates.tsv", "config.tsv"}) {
    std::ifstream in(std::string(VL_SOURCE_DIR) + "/simulator/data/" + name);
    std::string line;
    while (std::getline(in, line) && (line.empty() || line[0] == '#')) {
    }
    ASSERT_TRUE(VLWriteFile(folder + name, line + "\n")) << name;
  }
}

TEST(EmptyStore, EmptyGenreTreeIsReturnedAndAskedForEveryTime) {
  VLTestDir data;
  WriteEmptyStore(data.path());
  VLSimOptions options;
  options.dataFolder = data.path();
  VLSimServer sim(options);
  std::string error;
  ASSERT_TRUE(sim.Start(&error)) << error;
  setenv("SSL_CERT_FILE", sim.CAFile().c_str(), 1);
  setenv("VLWS_CONNECT_TO", sim.ConnectTo().c_str(), 1);

  VL_WS_SetupParams params = VLTestSetupParams(1);
  VL_WS_Handle handle = {};
  ASSERT_EQ(VL_WS_OK, VL_WS_initialize(&handle, &params));
  for (int round = 0; round < 2; ++round) {
    VL_WS_GenreArray genres;
    ASSERT_EQ(VL_WS_OK, VL_WS_getNavigation(&handle, &genres));
    EXPECT_EQ(VL_WS_TAG_GENRE_ARRAY, *genres.tag);
    EXPECT_EQ(0, genres.Count);
    EXPECT_EQ(nullptr, genres.Items);
    EXPECT_EQ(VL_WS_OK, VL_WS_release(&genres));
    VLString value;
    EXPECT_FALSE(handle.client->m_Cache->ReadMetaData("getNavigation", "", value));
  }
  ASSERT_TRUE(sim.WaitForRequests(3, 5000));  // the load time and both trees
  EXPECT_EQ(3u, sim.Requests().size());
  VL_WS_release(&handle);
}

}  // namespace
