// The box-art operations against the store simulator's image host: the file cache (image files
// beside the database, revalidation), the memory cache, no cache, failures and the proxy.
#include <gtest/gtest.h>

#include <stdint.h>

#include <set>
#include <string>
#include <vector>

#include "CacheInterface.h"
#include "VLFile.h"
#include "VLSimBoxArt.h"
#include "VLTestDir.h"
#include "VLTestServer.h"
#include "VLTestSimulator.h"
#include "VL_WS.h"
#include "VL_WS_Client.h"

namespace {

// The names in a folder that are not the cache database.
std::set<std::string> ImageFolderFiles(const std::string& folder) {
  std::set<std::string> names;
  for (const std::string& name : VLFolderFiles(folder))
    if (name.find(".vl") == std::string::npos) names.insert(name);
  return names;
}

// A box-art row of the cache.
struct Row {
  bool found = false;
  unsigned int length = 0, needUpdate = 9;
  std::string lastModified, data;
};

class BoxArt : public VLSimClientTest {
 protected:
  // A setup with a cache of cacheType that stores every kind of data (file caches in m_Dir).
  VL_WS_SetupParams Setup(int cacheType) { return VLTestSetupParams(cacheType, 7, m_Dir.path().c_str()); }
  // Makes m_Handle anew; the request log then starts empty.
  void Init(const VL_WS_SetupParams& params) {
    VL_WS_release(&m_Handle);
    ASSERT_EQ(VL_WS_OK, VL_WS_initialize(&m_Handle, &params));
    m_Sim.ClearRequests();
  }
  void Init(int cacheType) { Init(Setup(cacheType)); }
  // The answer of VL_WS_getBoxArtImage, which must have the status.
  std::string Location(VL_WS_BoxArtSize size, const char* prefix, VL_WS_Status status = VL_WS_OK) {
    VL_WS_String location;
    EXPECT_EQ(status, VL_WS_getBoxArtImage(&m_Handle, size, prefix, &location));
    EXPECT_EQ(VL_WS_TAG_STRING, *location.tag);
    std::string text = location.Text ? std::string(location.Text, location.Length) : "(null)";
    VL_WS_release(&location);
    return text;
  }
  VL_WS_Status Data(VL_WS_BoxArtSize size, const char* prefix, std::string* bytes) {
    VL_WS_Image image;
    VL_WS_Status status = VL_WS_getBoxArtImageData(&m_Handle, size, prefix, &image);
    EXPECT_EQ(VL_WS_TAG_IMAGE, *image.tag);
    EXPECT_EQ(0, image.Kind);
    *bytes = image.Data ? std::string(image.Data, image.Length) : "";
    VL_WS_release(&image);
    return status;
  }
  // The image the simulator serves now.
  std::string Served(const std::string& prefix, VL_WS_BoxArtSize size) {
    return VLSimBoxArtJpeg(prefix, size, m_Sim.Store().BoxArtVersion(prefix));
  }
  // The requests the image host answered, once the log holds count requests.
  std::vector<VLSimRequest> Images(size_t count) {
    std::vector<VLSimRequest> images;
    for (const VLSimRequest& r : Requests(count))
      if (r.host == "images.ostrel.example") images.push_back(r);
    return images;
  }
  Row ReadRow(const char* prefix, VL_WS_BoxArtSize size) {
    Row row;
    VLString modified, bytes;
    row.found = m_Handle.client->m_Cache->ReadBoxArt(prefix, size, row.length, modified, row.needUpdate, bytes);
    row.lastModified = modified.c_str();
    row.data = std::string(bytes.c_str(), bytes.length());
    return row;
  }

  VLTestDir m_Dir;
};

// The size word of the path ("135s") and the prefix, percent-encoded in the path, as they are in
// the file name ("135").
TEST_F(BoxArt, FileCacheDownloadsOnceAndThenAnswersFromTheFile) {
  Init(2);
  std::string file = m_Dir / "night owl_135.jpg";
  EXPECT_EQ(file, Location(VL_WS_BOXART_135S, "night owl_"));
  EXPECT_EQ(Served("night owl_", VL_WS_BOXART_135S), VLReadFile(file));
  std::vector<VLSimRequest> images = Images(1);
  ASSERT_EQ(1u, images.size());
  EXPECT_EQ("/images/boxart/135s/night%20owl_135.jpg", images[0].path);
  EXPECT_EQ("DUDUVud", images[0].userAgent);
  EXPECT_EQ("", images[0].ifModifiedSince);

  Row row = ReadRow("night owl_", VL_WS_BOXART_135S);
  ASSERT_TRUE(row.found);
  EXPECT_EQ(VLReadFile(file).size(), row.length);
  EXPECT_NE("", row.lastModified);
  EXPECT_EQ(0u, row.needUpdate);
  EXPECT_EQ("", row.data);  // the image is the file

  EXPECT_EQ(file, Location(VL_WS_BOXART_135S, "night owl_"));
  EXPECT_EQ(1u, Images(1).size());

  // An image file that disappeared is fetched again.
  ASSERT_EQ(0, remove(file.c_str()));
  EXPECT_EQ(file, Location(VL_WS_BOXART_135S, "night owl_"));
  EXPECT_EQ(2u, Images(2).size());
  EXPECT_EQ(Served("night owl_", VL_WS_BOXART_135S), VLReadFile(file));
}

TEST_F(BoxArt, MarkedImagesAreRevalidatedOnceWithAConditionalGet) {
  Init(2);
  std::string file = m_Dir / "t1002_95.jpg";
  ASSERT_EQ(file, Location(VL_WS_BOXART_95, "t1002_"));
  std::string first = VLReadFile(file);
  const Row before = ReadRow("t1002_", VL_WS_BOXART_95);
  ASSERT_TRUE(before.found);

  ASSERT_EQ(VL_WS_OK, VL_WS_updateLocalCache(&m_Handle, VL_WS_CacheParam::CACHE_BOXART));
  EXPECT_EQ(file, Location(VL_WS_BOXART_95, "t1002_"));
  std::vector<VLSimRequest> images = Images(2);
  ASSERT_EQ(2u, images.size());
  EXPECT_EQ(before.lastModified, images[1].ifModifiedSince);
  EXPECT_EQ(304, images[1].status);
  EXPECT_EQ(first, VLReadFile(file));
  Row row = ReadRow("t1002_", VL_WS_BOXART_95);
  ASSERT_TRUE(row.found);
  EXPECT_EQ(0u, row.needUpdate);
  EXPECT_EQ(first.size(), row.length);
  EXPECT_EQ(file, Location(VL_WS_BOXART_95, "t1002_"));
  EXPECT_EQ(2u, Images(2).size());

  // A new picture on the server replaces the file and the row.
  m_Sim.Store().TouchBoxArt("t1002_");
  ASSERT_EQ(VL_WS_OK, VL_WS_updateLocalCache(&m_Handle, VL_WS_CacheParam::CACHE_BOXART));
  EXPECT_EQ(file, Location(VL_WS_BOXART_95, "t1002_"));
  ASSERT_EQ(3u, Images(3).size());
  EXPECT_EQ(200, Images(3)[2].status);
  EXPECT_EQ(Served("t1002_", VL_WS_BOXART_95), VLReadFile(file));
  EXPECT_NE(first, VLReadFile(file));
  row = ReadRow("t1002_", VL_WS_BOXART_95);
  ASSERT_TRUE(row.found);
  EXPECT_NE(before.lastModified, row.lastModified);
  EXPECT_EQ(0u, row.needUpdate);
}

TEST_F(BoxArt, WithoutAnImageTheAnswerIsItsUrlAndNothingIsLeftBehind) {
  Init(2);
  EXPECT_EQ("http://images.ostrel.example/images/boxart/175/no%20such_175.jpg", Location(VL_WS_BOXART_175, "no such_"));
  ASSERT_EQ(1u, Images(1).size());
  EXPECT_EQ(404, Images(1)[0].status);

  // A download cut in the middle leaves neither the image nor its temporary file.
  Fault("/images/boxart/=cut,times=1");
  EXPECT_EQ("http://images.ostrel.example/images/boxart/203/t1003_203.jpg", Location(VL_WS_BOXART_203, "t1003_"));
  EXPECT_TRUE(ImageFolderFiles(m_Dir.path()).empty());
  EXPECT_FALSE(ReadRow("t1003_", VL_WS_BOXART_203).found);
  EXPECT_EQ(m_Dir / "t1003_203.jpg", Location(VL_WS_BOXART_203, "t1003_"));
}

// Only a JPEG image reaches the cache: a compressed, malformed or short body is refused, and a
// cached image that is no JPEG is fetched again.
TEST_F(BoxArt, OnlyJpegImagesAreKept) {
  for (int cacheType : {2, 1}) {
    SCOPED_TRACE(cacheType);
    Init(cacheType);
    std::string bytes;
    for (const char* fault : {"gzip", "deflate", "malformed", "truncated", "badlength:-64"}) {
      SCOPED_TRACE(fault);
      Fault(std::string("/images/boxart/=") + fault + ",times=1");
      EXPECT_EQ(VL_WS_E_NETWORK, Data(VL_WS_BOXART_102, "t1006_", &bytes));
      EXPECT_EQ("", bytes);
      EXPECT_FALSE(ReadRow("t1006_", VL_WS_BOXART_102).found);
      EXPECT_TRUE(ImageFolderFiles(m_Dir.path()).empty());
    }
    ASSERT_EQ(VL_WS_OK, Data(VL_WS_BOXART_102, "t1006_", &bytes));
    EXPECT_EQ(Served("t1006_", VL_WS_BOXART_102), bytes);

    // A cached copy that is no image any more is a miss.
    if (cacheType == 2) {
      ASSERT_TRUE(VLWriteFile(m_Dir / "t1006_102.jpg", "<html>not an image</html>"));
    } else {
      Row row = ReadRow("t1006_", VL_WS_BOXART_102);
      ASSERT_TRUE(m_Handle.client->m_Cache->WriteBoxArt("t1006_", VL_WS_BOXART_102, row.length, row.lastModified.c_str(),
                                                        0, VLString(row.data.data(), row.data.size() / 2)));
    }
    m_Sim.ClearRequests();
    ASSERT_EQ(VL_WS_OK, Data(VL_WS_BOXART_102, "t1006_", &bytes));
    EXPECT_EQ(Served("t1006_", VL_WS_BOXART_102), bytes);
    EXPECT_EQ(1u, Images(1).size());
    VLFile::Remove((m_Dir / "t1006_102.jpg").c_str());
  }
}

TEST_F(BoxArt, PrefixesWithAPathSeparatorAreNeverFiles) {
  std::string folder = m_Dir / "cache/";
  VL_WS_SetupParams params = Setup(2);
  params.CachePath = folder.c_str();
  Init(params);
  EXPECT_EQ("http://images.ostrel.example/images/boxart/175/..%2Fescape_175.jpg", Location(VL_WS_BOXART_175, "../escape_"));
  std::string bytes;
  EXPECT_EQ(VL_WS_E_HTTP_NOT_FOUND, Data(VL_WS_BOXART_175, "../escape_", &bytes));
  EXPECT_EQ(1u, Images(1).size());
  EXPECT_FALSE(VLFile::Exist((m_Dir / "escape_175.jpg").c_str()));
  EXPECT_TRUE(ImageFolderFiles(folder).empty());
}

TEST_F(BoxArt, OnlyAFileCacheMakesLocalFiles) {
  for (int cacheType : {0, 1}) {
    SCOPED_TRACE(cacheType);
    Init(cacheType);
    EXPECT_EQ("http://images.ostrel.example/images/boxart/95/t1001_95.jpg", Location(VL_WS_BOXART_95, "t1001_"));
    EXPECT_TRUE(Images(0).empty());
  }
}

TEST_F(BoxArt, MemoryCacheKeepsTheBytes) {
  Init(1);
  std::string bytes;
  ASSERT_EQ(VL_WS_OK, Data(VL_WS_BOXART_177, "t1004_", &bytes));
  EXPECT_EQ(Served("t1004_", VL_WS_BOXART_177), bytes);
  const Row row = ReadRow("t1004_", VL_WS_BOXART_177);
  ASSERT_TRUE(row.found);
  EXPECT_EQ(bytes, row.data);
  EXPECT_EQ(bytes.size(), row.length);

  ASSERT_EQ(VL_WS_OK, Data(VL_WS_BOXART_177, "t1004_", &bytes));
  EXPECT_EQ(row.data, bytes);
  EXPECT_EQ(1u, Images(1).size());

  // Revalidation: 304 keeps the stored bytes, a new picture replaces them.
  ASSERT_EQ(VL_WS_OK, VL_WS_updateLocalCache(&m_Handle, VL_WS_CacheParam::CACHE_BOXART));
  ASSERT_EQ(VL_WS_OK, Data(VL_WS_BOXART_177, "t1004_", &bytes));
  EXPECT_EQ(row.data, bytes);
  ASSERT_EQ(2u, Images(2).size());
  EXPECT_EQ(304, Images(2)[1].status);
  m_Sim.Store().TouchBoxArt("t1004_");
  ASSERT_EQ(VL_WS_OK, VL_WS_updateLocalCache(&m_Handle, VL_WS_CacheParam::CACHE_BOXART));
  ASSERT_EQ(VL_WS_OK, Data(VL_WS_BOXART_177, "t1004_", &bytes));
  EXPECT_EQ(Served("t1004_", VL_WS_BOXART_177), bytes);
  EXPECT_NE(row.data, bytes);
  EXPECT_EQ(bytes, ReadRow("t1004_", VL_WS_BOXART_177).data);
  EXPECT_EQ(3u, Images(3).size());
}

TEST_F(BoxArt, ImageDataComesFromTheFileCacheOrEveryTimeFromTheHost) {
  for (int cacheType : {2, 0}) {
    SCOPED_TRACE(cacheType);
    Init(cacheType);
    std::string first, second;
    ASSERT_EQ(VL_WS_OK, Data(VL_WS_BOXART_269, "t1005_", &first));
    ASSERT_EQ(VL_WS_OK, Data(VL_WS_BOXART_269, "t1005_", &second));
    EXPECT_EQ(Served("t1005_", VL_WS_BOXART_269), first);
    EXPECT_EQ(first, second);
    size_t downloads = cacheType == 2 ? 1 : 2;
    EXPECT_EQ(downloads, Images(downloads).size());
  }
  // The same image through both operations: one file.
  EXPECT_EQ(Served("t1005_", VL_WS_BOXART_269), VLReadFile(m_Dir / "t1005_269.jpg"));
  Init(2);
  EXPECT_EQ(m_Dir / "t1005_269.jpg", Location(VL_WS_BOXART_269, "t1005_"));
  EXPECT_TRUE(Images(0).empty());

  std::string bytes = "x";
  EXPECT_EQ(VL_WS_E_HTTP_NOT_FOUND, Data(VL_WS_BOXART_321, "no such_", &bytes));
  EXPECT_EQ("", bytes);
}

TEST_F(BoxArt, ImagesBypassTheProxy) {
  // A proxy that is not there: SOAP calls fail, images still come.
  VL_WS_SetupParams params = Setup(1);
  params.ProxyHost = "127.0.0.1";
  params.ProxyPort = VLClosedPort();
  Init(params);
  std::string bytes;
  EXPECT_EQ(VL_WS_OK, Data(VL_WS_BOXART_65, "t1007_", &bytes));
  EXPECT_EQ(Served("t1007_", VL_WS_BOXART_65), bytes);
  EXPECT_STREQ("127.0.0.1", m_Handle.client->m_RealTimeBrowse.proxy_host);
  VL_WS_String time;
  EXPECT_EQ(VL_WS_E_CONNECT, VL_WS_getLastCacheLoadTimeUTC(&m_Handle, &time));
  VL_WS_release(&time);
}

TEST_F(BoxArt, RequestsNamingNoImageAreRefused) {
  Init(2);
  EXPECT_EQ("(null)", Location(VL_WS_BOXART_95, "", VL_WS_E_INVALID_ARGUMENT));
  EXPECT_EQ("(null)", Location(VL_WS_BOXART_95, nullptr, VL_WS_E_INVALID_ARGUMENT));
  EXPECT_EQ("(null)", Location(static_cast<VL_WS_BoxArtSize>(13), "t1001_", VL_WS_E_INVALID_ARGUMENT));
  VL_WS_Image image;
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_getBoxArtImageData(&m_Handle, VL_WS_BOXART_95, "", &image));
  EXPECT_EQ(VL_WS_TAG_IMAGE, *image.tag);
  EXPECT_EQ(nullptr, image.Data);
  VL_WS_release(&image);
  std::string bytes;
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, Data(static_cast<VL_WS_BoxArtSize>(-1), "t1001_", &bytes));
  VL_WS_Handle empty = {};
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_getBoxArtImageData(&empty, VL_WS_BOXART_95, "t1001_", &image));
  VL_WS_release(&image);
  VL_WS_String location;
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_getBoxArtImage(nullptr, VL_WS_BOXART_95, "t1001_", &location));
  VL_WS_release(&location);
  EXPECT_TRUE(Images(0).empty());
}

}  // namespace
