// The simulator's sample store: client tests compare what they get with this data, so every kind
// of record the client copies must be in it, or the copying code would go untested.
#include <gtest/gtest.h>

#include <set>

#include "VLSimServer.h"

namespace {

TEST(SimulatorCatalogue, SampleStoreIsLargeEnoughToPageAndHasEveryKindOfRecord) {
  VLSimCatalogue catalogue;
  std::string error;
  ASSERT_TRUE(catalogue.Load(VL_SOURCE_DIR "/simulator/data", &error)) << error;
  EXPECT_GE(catalogue.Titles().size(), 150u);
  std::set<int> genresUsed;
  bool tv = false, hiddenUsed = false, spacePrefix = false, bonus = false, rent = false, buy = false;
  for (const VLSimTitle& title : catalogue.Titles()) {
    genresUsed.insert(title.genres.begin(), title.genres.end());
    if (title.tv && !title.episodes.empty()) tv = true;
    if (title.boxArt.find(' ') != std::string::npos) spacePrefix = true;
    if (!title.bonus.empty()) bonus = true;
    for (int genre : title.genres)
      if (!catalogue.FindGenre(genre)->visible) hiddenUsed = true;
    for (int sku : title.products) {
      const VLSimProduct* product = catalogue.FindProduct(sku);
      (product->purchaseType == 0 ? rent : buy) = true;
      EXPECT_FALSE(product->profiles.empty());
      EXPECT_FALSE(product->audio.empty());
      EXPECT_FALSE(product->expireDate.empty());
    }
    EXPECT_NE(nullptr, catalogue.FindTivo(title.tivoId)) << title.id;
  }
  EXPECT_GE(genresUsed.size(), 10u);
  EXPECT_TRUE(tv && hiddenUsed && spacePrefix && bonus && rent && buy);
  EXPECT_FALSE(catalogue.Search("harbor", false).empty());
  EXPECT_EQ(10u, catalogue.Recommendations(catalogue.Titles()[0].id).size());
}

}  // namespace
