// The script class "com.ostrel.DUDUVud" driven by movie scripts (tests/movies/) against the
// in-process store simulator. Each movie checks its results itself (tests/movies/common.js) and
// ends with exit status 0 only when every check passed.
#include <gtest/gtest.h>

#include <stdlib.h>

#include <iterator>
#include <regex>
#include <sstream>
#include <set>
#include <string>
#include <vector>

#include "DUDUVudAE.h"
#include "VLTestDir.h"
#include "VLTestMovie.h"
#include "VLTestSimulator.h"

namespace {

const std::string kMovies = VL_SOURCE_DIR "/tests/movies/";

using ae::stagecraft::ASExtensionClass;

// "test.SimProbe": count(what) is the number of requests so far whose SOAP operation is `what`
// or whose path starts with it, so that a movie can wait for its store's background work.
class SimProbe : public ASExtensionClass {
 public:
  static const char* GetClassName() { return "test.SimProbe"; }
  static bool FiresEvents() { return false; }
  static void GetMethods(AEArray<Method>& table) { table.Append(Method::Bind("count", &SimProbe::count)); }
  static ASExtensionClass* ConstructInstance(StageWindow*, ASObject&, ASValueArray&) { return new SimProbe; }
  static void DestructInstance(StageWindow*, ASObject& object) { delete object.GetNativeInstance(); }

  void count(StageWindow*, ASObject&, ASValueArray& arguments, ASValue& result) {
    std::string what = arguments.Get(0).AsString().CString();
    int n = 0;
    for (const VLSimRequest& r : VLTestSimulator().Requests()) n += r.operation == what || r.path.rfind(what, 0) == 0;
    result.SetInteger(n);
  }
};

// The captures of pattern's first group in text, joined by blanks.
std::string Matches(const std::string& text, const char* pattern) {
  std::string joined;
  std::regex re(pattern);
  for (auto m = std::sregex_iterator(text.begin(), text.end(), re); m != std::sregex_iterator(); ++m) {
    joined += (joined.empty() ? "" : " ") + (*m)[1].str();
  }
  return joined;
}

// Plays common.js and then the movie file (or, for an empty name, the inline source) with the
// simulator faults given, and returns what the movie printed and logged.
std::string PlayMovie(const std::string& file, const std::vector<std::string>& faults = {},
                      const std::string& source = "") {
  VLSimServer& sim = VLTestSimulator();
  sim.ClearFaults();
  sim.ClearRequests();
  for (const std::string& fault : faults) {
    std::string error;
    EXPECT_TRUE(sim.AddFault(fault, &error)) << error;
  }
  const VLSimOptions& o = sim.Options();
  const std::string setup = "var SIM = {APIKey: '" + o.apiKey + "', UserName: '" + o.userName + "', Password: '" +
                            o.password + "', sourceDir: '" VL_SOURCE_DIR "'};";
  testing::internal::CaptureStdout();
  testing::internal::CaptureStderr();  // where the console log target writes
  bool finished = false;
  int exitStatus = 0;
  std::string error;
  {
    VLTestMovie movie(2);
    vlplatform::Stage& stage = movie.stage;
    stage.RegisterExtensionClass(ae::stagecraft::DescribeExtensionClass<SimProbe>());
    if (stage.Evaluate("setup.js", setup) && stage.EvaluateFile(kMovies + "common.js") &&
        (file.empty() ? stage.Evaluate("inline.js", source) : stage.EvaluateFile(kMovies + file))) {
      stage.RunFrames();
    }
    finished = stage.Global().GetProperty("finished").AsBoolean();
    exitStatus = stage.ExitStatus();
    error = stage.Error();
  }
  std::string output = testing::internal::GetCapturedStdout() + testing::internal::GetCapturedStderr();
  sim.ClearFaults();
  EXPECT_TRUE(exitStatus == 0 && finished)
      << "exit status " << exitStatus << (finished ? "" : ", the movie did not reach its end") << "\n"
      << error << "\n--- movie output ---\n" << output;
  return output;
}

TEST(DUDUVudAEMovie, CatalogueMethodsDeliverTheirResultShapes) { PlayMovie("catalogue.js"); }

TEST(DUDUVudAEMovie, AccountMethodsFromAuthorisationToDeactivation) { PlayMovie("account.js"); }

TEST(DUDUVudAEMovie, ImmediateCodesSynchronousMethodsFailuresAndDroppedObjects) {
  std::string output = PlayMovie("contract.js", {"getRecommendedTitles=status:503", "GetCountryID=delay:1500"});
  EXPECT_NE(std::string::npos, output.find("FLASH TRACE == hello movie\n")) << output;
  EXPECT_EQ(std::string::npos, output.find("FLASH TRACE == two")) << output;
}

TEST(DUDUVudAEMovie, EachFaultCompletesWithItsStatusAndTheNextRequestIsAnswered) {
  PlayMovie("faults.js", {"store.ostrel.example=tls:wronghost,times=1", "getTitlesByNavigation=status:503,times=1",
                          "authorizeDevice=cut,times=1", "getEmailAddress=close,times=1",
                          "showPrePaidCardBalance=soapfault,times=1", "getBonusAssetLocation=code:5,times=1",
                          "/speedtest/=status:404,times=1"});
}

TEST(DUDUVudAEMovie, ThreeHundredRequestsCachedAndUncached) { PlayMovie("many.js"); }

TEST(DUDUVudAEMovie, EnvListNamesADefaultOutsideTheListByItsNumber) {
  VLTestSimulator().Store().SetDefaultEnv(7);
  PlayMovie("", {},
            "var store = newExtension(ID); ask(store, 'init', initParams(), ok('b'));"
            "step(function (next) { eq(store.getAvailableEnvLists()[3], {envNum: 3, endpoint: 'default(7)'}, 'entry 3'); next(); });"
            "run();");
  VLTestSimulator().Store().SetDefaultEnv(2);
}

TEST(DUDUVudAEMovie, PrefetchesPagesAroundThePageShownAndBoxArtWhileIdle) {
  VLTestDir cache;
  setenv("VL_TEST_CACHE_DIR", cache.path().c_str(), 1);
  std::string output = PlayMovie("prefetch.js");
  // Around page 5 of 10: the next and previous pages alternately, nearest first; around page 6
  // only page 10 is new; another purchase type starts afresh; a single page starts nothing. The
  // store dropped at the end finishes its prefetch before it goes.
  EXPECT_EQ("6 4 7 3 8 2 9 1 10 6 4 7 3 8 2 9 1 6 4 7 3 8 2 9 1", Matches(output, "prefetch_getTitles, page:(\\d+) begin"));
  EXPECT_EQ("2 3", Matches(output, "prefetch_getWishlistItems, page:(\\d+) begin"));
  EXPECT_EQ("2", Matches(output, "prefetch_getMyVideos, page:(\\d+) begin"));

  // Box art: one download at a time, first waiting first: the titles of the first page prefetched
  // for purchase type 0 (page 6), from its last title back.
  VL_WS_SetupParams params = VLTestSetupParams();
  VL_WS_Handle handle = {};
  VL_WS_TitlesResponse page6;
  ASSERT_EQ(VL_WS_OK, VL_WS_initialize(&handle, &params));
  ASSERT_EQ(VL_WS_OK, VL_WS_getTitles(&handle, 1, 6, 15, 0, &page6));
  std::string expected;
  for (int t = page6.Titles.Count - 1; t >= page6.Titles.Count - 5; --t) {
    expected += std::string(expected.empty() ? "" : " ") + page6.Titles.Items[t].BoxArtPrefix;
  }
  VL_WS_release(&page6);
  VL_WS_release(&handle);
  std::istringstream lines(Matches(output, "prefetch_getBoxArts \\((\\S+)\\) (?:begin|end)"));
  std::vector<std::string> marks{std::istream_iterator<std::string>(lines), std::istream_iterator<std::string>()};
  std::string firstFive;
  std::set<std::string> files = VLFolderFiles(cache.path());
  for (size_t k = 0; k + 1 < marks.size(); k += 2) {
    EXPECT_EQ(marks[k], marks[k + 1]) << "a download began before the one before it ended";
    if (k < 10) firstFive += (k ? " " : "") + marks[k];
    EXPECT_EQ(1u, files.count(marks[k] + "175.jpg")) << marks[k];
  }
  EXPECT_EQ(expected, firstFive);
}

TEST(PrefetchMgr, PagesAroundTheCurrentOneNearestFirstSkippingThoseCounted) {
  IAEKernel* kernel = IAEKernel::GetKernel();
  IAEKernel::Mutex* lock = kernel->CreateMutex();
  DUDUVudAE::PrefetchMgr mgr;
  mgr.SetMutex(lock);
  AEArray<AEString> waiting;
  auto around = [&](unsigned total, unsigned current, int purchaseType) {
    mgr.Update(waiting, DUDUVudAE::RESULT_TITLES, total, total * 10, 10, 1, purchaseType, 0);
    unsigned pages[8];
    unsigned found = 99;
    mgr.GetPagesForPrefetch(current, 8, pages, found);
    std::string joined;
    for (unsigned k = 0; k < found; ++k) joined += (k ? " " : "") + std::to_string(pages[k]);
    return joined;
  };
  EXPECT_EQ("6 4 7 3 8 2 9 1", around(10, 5, 2));
  mgr.MarkPagePrefetched(6);
  mgr.MarkPagePrefetched(4);
  EXPECT_EQ("7 3 8 2 9 1", around(10, 5, 2));
  EXPECT_EQ("6 4 7 3 8 2 9 1", around(10, 5, 1));  // another query: nothing counted
  EXPECT_EQ("2 3", around(3, 1, 1));
  EXPECT_EQ("", around(3, 0, 1));
  EXPECT_EQ("", around(3, 4, 1));
  kernel->DestroyMutex(lock);

  // Twenty new box-art prefixes before forty waiting: the new ones, then the first 31 old ones.
  AEArray<AEString> old, added;
  for (int k = 0; k < 40; ++k) old.Append(AEString(("old" + std::to_string(k)).c_str()));
  for (int k = 0; k < 20; ++k) added.Append(AEString(("new" + std::to_string(k)).c_str()));
  DUDUVudAE::MergeWaitingBoxArts(old, added);
  ASSERT_EQ(51u, old.Size());
  EXPECT_STREQ("new0", old[0].CString());
  EXPECT_STREQ("old0", old[20].CString());
  EXPECT_STREQ("old30", old[50].CString());
}

}  // namespace
