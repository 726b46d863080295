// The box-art operations against the store simulator's image host, beyond the sessions
// boxart-*.txt: the conditional GET that revalidates a marked image, with either cache.
#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "CacheInterface.h"
#include "VLSimBoxArt.h"
#include "VLTestDir.h"
#include "VLTestSimulator.h"
#include "VL_WS.h"
#include "VL_WS_Client.h"

namespace {

class BoxArt : public VLSimClientTest {
 protected:
  // Makes m_Handle anew with a cache of cacheType that keeps every kind (a file cache in m_Dir);
  // the request log then starts empty.
  void Init(int cacheType) {
    VL_WS_release(&m_Handle);
    VL_WS_SetupParams params = VLTestSetupParams(cacheType, 7, m_Dir.path().c_str());
    ASSERT_EQ(VL_WS_OK, VL_WS_initialize(&m_Handle, &params));
    m_Sim.ClearRequests();
  }
  // The image's bytes as VL_WS_getBoxArtImageData gives them ("" on failure).
  std::string Data(const char* prefix) {
    VL_WS_Image image;
    EXPECT_EQ(VL_WS_OK, VL_WS_getBoxArtImageData(&m_Handle, VL_WS_BOXART_95, prefix, &image));
    std::string bytes = image.Data ? std::string(image.Data, image.Length) : "";
    VL_WS_release(&image);
    return bytes;
  }
  // The image the simulator serves now.
  std::string Served(const std::string& prefix) {
    return VLSimBoxArtJpeg(prefix, VL_WS_BOXART_95, m_Sim.Store().BoxArtVersion(prefix));
  }
  // The image's cache row: its Last-Modified and the bytes it keeps.
  bool ReadRow(const char* prefix, std::string* lastModified, std::string* data) {
    unsigned int length = 0, needUpdate = 0;
    VLString modified, bytes;
    if (!m_Handle.client->m_Cache->ReadBoxArt(prefix, VL_WS_BOXART_95, length, modified, needUpdate, bytes)) return false;
    *lastModified = modified.c_str();
    *data = std::string(bytes.c_str(), bytes.length());
    return true;
  }

  VLTestDir m_Dir;
};

// A marked image is asked for with the row's Last-Modified: "304 Not Modified" keeps what the
// cache has, a new picture replaces it. A damaged copy in a memory cache is a miss.
TEST_F(BoxArt, MarkedImagesAreRevalidatedWithAConditionalGet) {
  for (int cacheType : {2, 1}) {
    SCOPED_TRACE(cacheType);
    Init(cacheType);
    ASSERT_EQ(Served("t1002_"), Data("t1002_"));
    std::string lastModified, data;
    ASSERT_TRUE(ReadRow("t1002_", &lastModified, &data));
    for (int status : {304, 200}) {
      if (status == 200) m_Sim.Store().TouchBoxArt("t1002_");
      ASSERT_EQ(VL_WS_OK, VL_WS_updateLocalCache(&m_Handle, VL_WS_CacheParam::CACHE_BOXART));
      EXPECT_EQ(Served("t1002_"), Data("t1002_"));
      std::vector<VLSimRequest> requests = Requests(status == 304 ? 2 : 3);
      EXPECT_EQ(lastModified, requests.back().ifModifiedSince);
      EXPECT_EQ(status, requests.back().status);
    }
    std::string newModified;
    ASSERT_TRUE(ReadRow("t1002_", &newModified, &data));
    EXPECT_NE(lastModified, newModified);
    EXPECT_EQ(Served("t1002_"), cacheType == 2 ? VLReadFile(m_Dir / "t1002_95.jpg") : data);
  }
  std::string lastModified, data;
  ASSERT_TRUE(ReadRow("t1002_", &lastModified, &data));
  const VLString half(data.data(), data.size() / 2);
  ASSERT_TRUE(m_Handle.client->m_Cache->WriteBoxArt("t1002_", VL_WS_BOXART_95, data.size(), lastModified.c_str(), 0, half));
  m_Sim.ClearRequests();
  EXPECT_EQ(Served("t1002_"), Data("t1002_"));
  EXPECT_EQ(1u, Requests(1).size());
}

}  // namespace
