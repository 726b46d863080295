// The three extension classes: class ids, method tables appended in table order, and their
// objects as a movie constructs and calls them.
#include <gtest/gtest.h>

#include <map>
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

// Every method called with one Array argument [{}, {}] on a store that was never initialised (all
// but init, which would start, and quitFlash, which would end the movie): the store methods
// answer -1, the synchronous ones what they answer without a client.
TEST_F(ClassesInAMovie, AnUninitialisedStoreAnswersAtOnce) {
  ASSERT_TRUE(stage.Evaluate("movie.js",
                             "var store = newExtension('com.ostrel.DUDUVud');"
                             "var cfg = newExtension('com.ostrel.VLCfgLib');"
                             "function results(object, skip) {"
                             "  var proto = Object.getPrototypeOf(object), out = [];"
                             "  for (var name in proto)"
                             "    if (skip.indexOf(name) < 0) out.push(name + '=' + JSON.stringify(object[name]([{}, {}])));"
                             "  return out.join(' ');"
                             "}"
                             "var storeResults = results(store, ['init', 'quitFlash']), cfgResults = results(cfg, []);"))
      << stage.Error();
  const std::map<std::string, std::string> synchronous = {
      {"clone", "-3"}, {"idle", "0"}, {"getSysInfo", "\"\""}, {"getUserAgent", "\"\""},
      {"setLogAreaIDsAndTargetConfig", "1"}, {"fileExist", "false"}, {"getAvailableEnvLists", "-5"},
      {"clearLocalCache", "false"}, {"getDeviceEnv", "-5"}, {"checkVLSWFmd5sum", "\"\""}, {"trace", "0"}};
  std::string expected;
  for (const std::string& name : kDUDUVudMethods) {
    if (name == "init" || name == "quitFlash") continue;
    auto it = synchronous.find(name);
    expected += (expected.empty() ? "" : " ") + name + "=" + (it == synchronous.end() ? "-1" : it->second);
  }
  EXPECT_EQ(expected, Text("storeResults"));
  EXPECT_EQ("init=false setFile=false read=\"\" write=false selectEnv=false clearEnv=false", Text("cfgResults"));
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
