// The three extension classes: class ids, method tables appended to the host's table, and their
// objects as a movie constructs and calls them.
#include <gtest/gtest.h>

#include <map>
#include <set>
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

// The names a class appends to a table that already holds an entry (which must stay first), each
// with its function.
std::vector<std::string> AppendedNames(const ASExtensionClassDescriptor& d) {
  AEArray<ASExtensionClass::Method> table;
  table.Append(ASExtensionClass::Method{"existing", nullptr});
  d.GetMethods(table);
  std::vector<std::string> names;
  for (size_t i = 1; i < table.Size(); ++i) {
    names.push_back(table[i].name);
    EXPECT_NE(nullptr, table[i].function) << table[i].name;
  }
  EXPECT_STREQ("existing", table[0].name);
  return names;
}

// The class ids are those the lifecycle test sees registered.
TEST(ExtensionClasses, TablesAreAppendedAfterExistingEntries) {
  for (const ASExtensionClassDescriptor& d :
       {ae::stagecraft::DescribeExtensionClass<DUDUVudAE>(), ae::stagecraft::DescribeExtensionClass<VLCfgLibAE>(),
        ae::stagecraft::DescribeExtensionClass<VLPlayerLibAE>()}) {
    std::vector<std::string> names = AppendedNames(d);
    EXPECT_FALSE(names.empty()) << d.GetClassName();
    std::set<std::string> distinct(names.begin(), names.end());
    EXPECT_EQ(names.size(), distinct.size()) << d.GetClassName() << ": a method listed twice";
  }
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
  for (const std::string& name : AppendedNames(ae::stagecraft::DescribeExtensionClass<DUDUVudAE>())) {
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
  std::vector<std::string> methods = AppendedNames(ae::stagecraft::DescribeExtensionClass<VLPlayerLibAE>());
  EXPECT_EQ(std::string(methods.size(), '0'), Text("answers"));
  auto* player = dynamic_cast<VLPlayerLibAE*>(stage.Global().GetProperty("player").AsObject().GetNativeInstance());
  ASSERT_NE(nullptr, player);
  ASSERT_EQ(methods.size(), player->Calls().Size());
  for (size_t i = 0; i < methods.size(); ++i) EXPECT_EQ(methods[i], player->Calls()[i]);
}

}  // namespace
