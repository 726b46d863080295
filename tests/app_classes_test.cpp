// The three extension classes: class ids, method tables appended in table order, and their
// objects as a movie constructs and calls them.
#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "DUDUVudAE.h"
#include "VLCfgLibAE.h"
#include "VLPlayerLibAE.h"
#include "VLStage.h"
#include "VeloraApp.h"

namespace {

using ae::stagecraft::ASExtensionClass;
using ae::stagecraft::ASExtensionClassDescriptor;

const std::vector<std::string> kDUDUVudMethods = {
    "init", "clone", "idle", "getNavigation", "getTitles", "getTitleListing", "searchForTitle",
    "getRecommendedTitles", "translateSkuID", "getTvEpisodeListing", "getTvEpisodeListByTitleID",
    "getAllTvEpisodeListings", "authorizeDevice", "deactivateDevice", "checkAuthToken", "getBoxArtImage",
    "getMyVideos", "getWishlistItems", "addItemToWishlist", "removeItemFromWishlist",
    "removeAllItemsFromWishlist", "checkTitleInWishlist", "checkTitlesInWishlist", "doPurchaseSavedBilling",
    "checkForPurchasedTitle", "checkForPurchasedSku", "checkAdultVerificationEnabled",
    "checkAdultVerificationPin", "assignGiftCertificateToUser", "checkRentalExpiration",
    "getStreamingAssetLocation", "getStreamingBonusAssetLocation", "loadLastStreamingAssetLocation",
    "manageStreamingInstanceStatus", "getTHXMediaDirector", "getTHXMediaDirectorBonusAsset", "getEmailAddress",
    "getBillingInfo", "getPrePaidCardBalance", "getConfig", "getSettingsPageInfo", "getCountryID", "getFileType",
    "updateLocalCache", "checkBandwidth", "calcOrderTax", "quitFlash", "getLocalIPAddr", "getSysInfo",
    "setAudioDefaultProperty", "getAudioDefaultProperty", "getUserAgent", "setLogAreaIDsAndTargetConfig",
    "fileExist", "getAvailableEnvLists", "clearLocalCache", "getDeviceEnv", "checkVLSWFmd5sum", "trace"};
const std::vector<std::string> kCfgMethods = {"init", "setFile", "read", "write", "selectEnv", "clearEnv"};
const std::vector<std::string> kPlayerMethods = {
    "Initialize", "Shutdown", "GetVersion", "CreatePlayer", "ReleasePlayer", "Play", "Pause", "Stop",
    "GetPlaybackTime", "GetPlaybackState", "GetDuration", "GetCurrentBandwidth", "RegisterEventHandler",
    "THX_ProcessContentDescriptors", "THX_IsSupportedOnDevice", "getSupported3DFormats",
    "getConfigured3DFormat", "set3DMode", "SetLogAreaIDsConfig"};

// The names the class appends to a table that already holds two entries (which must stay first).
std::vector<std::string> AppendedNames(const ASExtensionClassDescriptor& d) {
  AEArray<ASExtensionClass::Method> table;
  table.Append(ASExtensionClass::Method{"existing0", nullptr});
  table.Append(ASExtensionClass::Method{"existing1", nullptr});
  d.GetMethods(table);
  std::vector<std::string> names;
  for (size_t i = 0; i < table.Size(); ++i) {
    names.push_back(table[i].name);
    if (i >= 2) {
      EXPECT_NE(nullptr, table[i].function) << table[i].name;
    }
  }
  EXPECT_EQ("existing0", names.at(0));
  EXPECT_EQ("existing1", names.at(1));
  return std::vector<std::string>(names.begin() + 2, names.end());
}

TEST(ExtensionClasses, IdsAndTablesInOrderAppendedAfterExistingEntries) {
  const struct {
    ASExtensionClassDescriptor descriptor;
    const char* id;
    const std::vector<std::string>* methods;
  } classes[] = {
      {ae::stagecraft::DescribeExtensionClass<DUDUVudAE>(), "com.ostrel.DUDUVud", &kDUDUVudMethods},
      {ae::stagecraft::DescribeExtensionClass<VLCfgLibAE>(), "com.ostrel.VLCfgLib", &kCfgMethods},
      {ae::stagecraft::DescribeExtensionClass<VLPlayerLibAE>(), "com.ostrel.VLPlayerLibAE", &kPlayerMethods},
  };
  for (const auto& c : classes) {
    EXPECT_STREQ(c.id, c.descriptor.GetClassName());
    EXPECT_FALSE(c.descriptor.FiresEvents());
    EXPECT_EQ(*c.methods, AppendedNames(c.descriptor)) << c.id;
  }
  EXPECT_EQ(59u, kDUDUVudMethods.size());
  EXPECT_EQ(19u, kPlayerMethods.size());
}

// A movie that constructs the three classes of an initialised application.
class ClassesInAMovie : public testing::Test {
 protected:
  ClassesInAMovie() : stage(1), launcher(&stage) {
    app = createApplication2();
    app->init(&launcher);
  }
  ~ClassesInAMovie() override {
    stage.Close();
    delete app;
  }
  std::string Text(const char* global) { return stage.Global().GetProperty(global).AsString().CString(); }

  vlplatform::Stage stage;
  vlplatform::Launcher launcher;
  scLauncher::IApplication2* app;
};

TEST_F(ClassesInAMovie, MethodsNotBuiltYetGiveTheirInitialResults) {
  ASSERT_TRUE(stage.Evaluate("movie.js",
                             "var store = newExtension('com.ostrel.DUDUVud');"
                             "var cfg = newExtension('com.ostrel.VLCfgLib');"
                             "function results(object) {"
                             "  var proto = Object.getPrototypeOf(object), out = [];"
                             "  for (var name in proto) out.push(JSON.stringify(object[name]([{}, {}])));"
                             "  return out.join(' ');"
                             "}"
                             "var storeResults = results(store), cfgResults = results(cfg);"))
      << stage.Error();
  std::string notInitialised = "-1";
  for (int i = 1; i < 59; ++i) notInitialised += " -1";
  EXPECT_EQ(notInitialised, Text("storeResults"));
  EXPECT_EQ("false false \"\" false false false", Text("cfgResults"));
  EXPECT_NE(nullptr, dynamic_cast<DUDUVudAE*>(stage.Global().GetProperty("store").AsObject().GetNativeInstance()));
}

TEST_F(ClassesInAMovie, ThePlayerRecordsEachOfItsMethodsAndAnswersZero) {
  ASSERT_TRUE(stage.Evaluate("movie.js",
                             "var player = newExtension('com.ostrel.VLPlayerLibAE');"
                             "var answers = [];"
                             "for (var name in Object.getPrototypeOf(player)) answers.push(player[name]());"
                             "answers = answers.join('');"))
      << stage.Error();
  EXPECT_EQ(std::string(19, '0'), Text("answers"));
  auto* player = dynamic_cast<VLPlayerLibAE*>(stage.Global().GetProperty("player").AsObject().GetNativeInstance());
  ASSERT_NE(nullptr, player);
  ASSERT_EQ(19u, player->Calls().Size());
  for (size_t i = 0; i < 19; ++i) EXPECT_EQ(kPlayerMethods[i], player->Calls()[i]);
}

}  // namespace
