// Catalogue and box-art operations beyond the sessions catalog-*.txt and boxart-*.txt: what only
// the C interface can pass (null texts, arrays and results, no handle, counts below 1) and the
// files VL_WS_clearLocalCache removes.
#include <gtest/gtest.h>
#include <sys/stat.h>

#include <string>
#include <vector>

#include "VLFile.h"
#include "VLTestAccountClient.h"

namespace {

class Catalog : public VLTestAccountClient {};

TEST_F(Catalog, NullArgumentsAreRefusedBeforeAnyRequest) {
  Init();
  const int genres[] = {1};
  const int* noGenres = nullptr;
  const char* none = nullptr;
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_getTitles(&m_Handle, 1, 1, 5, 2, nullptr));
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, Call(VL_WS_getTitlesByGenreIDs, 1, noGenres, 1, 3, 2));
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, Call(VL_WS_getTitlesByGenreIDs, 0, genres, 1, 3, 2));
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, Call(VL_WS_getTitlesByGenreIDs, -1, genres, 1, 3, 2));
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, Call(VL_WS_translateTivoExternalID, none));
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, Call(VL_WS_searchForTitle, 1, 10, 2, 0, none));
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, Call(VL_WS_searchForTitleDetail, 1, 10, 2, 0, none));
  bool update = true;
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_shouldUpdateCache(&m_Handle, nullptr, &update));
  EXPECT_FALSE(update);
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_shouldUpdateCache(&m_Handle, "2001-01-01T00:00:00", nullptr));
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_clearLocalCache(nullptr));
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, Call(VL_WS_getBoxArtImage, VL_WS_BOXART_95, none));
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, Call(VL_WS_getBoxArtImageData, VL_WS_BOXART_95, none));
  VL_WS_String location;
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_getBoxArtImage(nullptr, VL_WS_BOXART_95, "t1001_", &location));
  VL_WS_release(&location);
  EXPECT_TRUE(RequestsNow().empty());
}

TEST(ClearLocalCache, RemovesImagesDatabasesAndTemporaryFilesOnly) {
  VLTestDir dir;
  ASSERT_EQ(0, mkdir((dir / "sub").c_str(), 0755));
  const std::vector<const char*> gone = {"t1001_175.jpg", "a b.jpg", ".hidden.jpg", "0_1_7_2.vl", "vlwsAb12Cd", "vlws"};
  const std::vector<const char*> kept = {"keep.txt", "photo.jpeg", "cache.vl.bak", "settings.xml", "sub/inner.jpg"};
  for (const auto* names : {&gone, &kept})
    for (const char* name : *names) ASSERT_TRUE(VLWriteFile(dir / name, "x")) << name;
  // Without its separator.
  std::string folder = dir.path().substr(0, dir.path().size() - 1);
  EXPECT_EQ(VL_WS_OK, VL_WS_clearLocalCache(folder.c_str()));
  for (const char* name : gone) EXPECT_FALSE(VLFile::Exist((dir / name).c_str())) << name;
  for (const char* name : kept) EXPECT_TRUE(VLFile::Exist((dir / name).c_str())) << name;
  EXPECT_EQ(VL_WS_OK, VL_WS_clearLocalCache(dir.path().c_str()));  // nothing left to remove
}

}  // namespace
