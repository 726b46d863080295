// The script class "com.ostrel.DUDUVud" driven by movie scripts (tests/movies/) against the
// in-process store simulator. Each movie checks its results itself (tests/movies/common.js) and
// ends with exit status 0 only when every check passed.
#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "VLStage.h"
#include "VLTestSimulator.h"
#include "VeloraApp.h"

namespace {

const std::string kMovies = VL_SOURCE_DIR "/tests/movies/";

// Plays common.js and then the movie file (or, for an empty name, the inline source) with the
// simulator faults given, and returns what the movie printed.
std::string PlayMovie(const std::string& file, const std::vector<std::string>& faults = {},
                      const std::string& source = "") {
  VLSimServer& sim = VLTestSimulator();
  sim.ClearFaults();
  for (const std::string& fault : faults) {
    std::string error;
    EXPECT_TRUE(sim.AddFault(fault, &error)) << error;
  }
  const VLSimOptions& o = sim.Options();
  const std::string setup = "var SIM = {APIKey: '" + o.apiKey + "', UserName: '" + o.userName + "', Password: '" +
                            o.password + "', sourceDir: '" VL_SOURCE_DIR "'};";
  testing::internal::CaptureStdout();
  vlplatform::Stage stage(2);
  vlplatform::Launcher launcher(&stage);
  scLauncher::IApplication2* app = createApplication2();
  app->init(&launcher);
  if (stage.Evaluate("setup.js", setup) && stage.EvaluateFile(kMovies + "common.js") &&
      (file.empty() ? stage.Evaluate("inline.js", source) : stage.EvaluateFile(kMovies + file))) {
    stage.RunFrames();
  }
  bool finished = stage.Global().GetProperty("finished").AsBoolean();
  stage.Close();
  delete app;  // which waits for the deletion of objects dropped while their request ran
  std::string output = testing::internal::GetCapturedStdout();
  sim.ClearFaults();
  EXPECT_TRUE(stage.ExitStatus() == 0 && finished)
      << "exit status " << stage.ExitStatus() << (finished ? "" : ", the movie did not reach its end") << "\n"
      << stage.Error() << "\n--- movie output ---\n" << output;
  return output;
}

TEST(DUDUVudAEMovie, CatalogueMethodsDeliverTheirResultShapes) { PlayMovie("catalogue.js"); }

TEST(DUDUVudAEMovie, AccountMethodsFromAuthorisationToDeactivation) { PlayMovie("account.js"); }

TEST(DUDUVudAEMovie, ImmediateCodesSynchronousMethodsFailuresAndDroppedObjects) {
  std::string output = PlayMovie("contract.js", {"getRecommendedTitles=status:503", "GetCountryID=delay:1500"});
  EXPECT_NE(std::string::npos, output.find("FLASH TRACE == hello movie\n")) << output;
  EXPECT_EQ(std::string::npos, output.find("FLASH TRACE == two")) << output;
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

}  // namespace
