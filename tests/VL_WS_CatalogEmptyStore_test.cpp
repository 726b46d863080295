// Catalogue operations against a store without a catalogue: every list comes back empty, is
// returned as such and is never kept in the cache. A program of its own, because a program's
// client connects to one simulator only.
#include <gtest/gtest.h>
#include <stdlib.h>

#include <fstream>
#include <memory>
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

class EmptyStore : public testing::Test {
 protected:
  static void SetUpTestSuite() {
    s_Data = new VLTestDir;
    WriteEmptyStore(s_Data->path());
    VLSimOptions options;
    options.dataFolder = s_Data->path();
    s_Sim = new VLSimServer(options);
    std::string error;
    ASSERT_TRUE(s_Sim->Start(&error)) << error;
    setenv("SSL_CERT_FILE", s_Sim->CAFile().c_str(), 1);
    setenv("VLWS_CONNECT_TO", s_Sim->ConnectTo().c_str(), 1);
  }
  static void TearDownTestSuite() {
    delete s_Sim;
    delete s_Data;
  }
  void SetUp() override {
    VL_WS_SetupParams params = VLTestSetupParams();
    params.CacheType = 1;
    params.CacheData = static_cast<VL_WS_CacheParam::CacheData>(7);
    ASSERT_EQ(VL_WS_OK, VL_WS_initialize(&m_Handle, &params));
  }
  void TearDown() override { VL_WS_release(&m_Handle); }

  bool Cached(const char* name, const char* key) {
    VLString value;
    return m_Handle.client->m_Cache->ReadMetaData(name, key, value);
  }

  static VLTestDir* s_Data;
  static VLSimServer* s_Sim;
  VL_WS_Handle m_Handle = {};
};

VLTestDir* EmptyStore::s_Data = nullptr;
VLSimServer* EmptyStore::s_Sim = nullptr;

TEST_F(EmptyStore, EmptyGenreTreeIsReturnedAndAskedForEveryTime) {
  for (int round = 0; round < 2; ++round) {
    VL_WS_GenreArray genres;
    ASSERT_EQ(VL_WS_OK, VL_WS_getNavigation(&m_Handle, &genres));
    EXPECT_EQ(VL_WS_TAG_GENRE_ARRAY, *genres.tag);
    EXPECT_EQ(0, genres.Count);
    EXPECT_EQ(nullptr, genres.Items);
    EXPECT_EQ(VL_WS_OK, VL_WS_release(&genres));
    EXPECT_FALSE(Cached("getNavigation", ""));
  }
  ASSERT_TRUE(s_Sim->WaitForRequests(3, 5000));  // the load time and both trees
  EXPECT_EQ(3u, s_Sim->Requests().size());
}

}  // namespace
