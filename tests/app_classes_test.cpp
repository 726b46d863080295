// The three extension classes: method tables appended to the host's table, and the player as a
// movie constructs and calls it.
#include <gtest/gtest.h>

#include <set>
#include <string>
#include <vector>

#include "DUDUVudAE.h"
#include "VLCfgLibAE.h"
#include "VLPlayerLibAE.h"
#include "VLTestMovie.h"

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

// The player in a movie of an initialised application. (What the store and settings classes answer
// before their init, the sessions show.)
TEST(ClassesInAMovie, ThePlayerRecordsEachOfItsMethodsAndAnswersZero) {
  VLTestMovie movie;
  vlplatform::Stage& stage = movie.stage;
  ASSERT_TRUE(stage.Evaluate("movie.js",
                             "var player = newExtension('com.ostrel.VLPlayerLibAE');"
                             "var answers = [];"
                             "for (var name in Object.getPrototypeOf(player)) answers.push(player[name]());"
                             "answers = answers.join('');"))
      << stage.Error();
  std::vector<std::string> methods = AppendedNames(ae::stagecraft::DescribeExtensionClass<VLPlayerLibAE>());
  EXPECT_EQ(std::string(methods.size(), '0'), stage.Global().GetProperty("answers").AsString().CString());
  auto* player = dynamic_cast<VLPlayerLibAE*>(stage.Global().GetProperty("player").AsObject().GetNativeInstance());
  ASSERT_NE(nullptr, player);
  ASSERT_EQ(methods.size(), player->Calls().Size());
  for (size_t i = 0; i < methods.size(); ++i) EXPECT_EQ(methods[i], player->Calls()[i]);
}

}  // namespace
