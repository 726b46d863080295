// The script engine behind the stage, where a lax stand-in would hide a fault of the store's
// classes: a reference kept beyond a call survives garbage collection only while kept, OnUpdate
// runs on the engine's thread, instances are destructed when collected or at the close, handles
// are for the engine's thread only, an error in a callback ends the movie, arrays are told from
// other objects, and values convert as the script language converts them.
#include <gtest/gtest.h>

#include <cmath>
#include <string>
#include <thread>

#include "ASExtensionClass.h"
#include "VLStage.h"

namespace {

using ae::stagecraft::ASExtensionClass;
using ae::stagecraft::ASObject;
using ae::stagecraft::ASValue;
using ae::stagecraft::ASValueArray;
using ae::stagecraft::StageWindow;

// An extension class whose methods exercise one engine service each.
class Probe : public ASExtensionClass {
 public:
  static int s_Constructed;
  static int s_Destructed;
  static std::thread::id s_UpdateThread;

  static const char* GetClassName() { return "test.Probe"; }
  static bool FiresEvents() { return false; }
  static void GetMethods(AEArray<Method>& table) {
    static const Method kMethods[] = {Method::Bind("keep", &Probe::keep), Method::Bind("release", &Probe::release),
                                      Method::Bind("completeAfter", &Probe::completeAfter),
                                      Method::Bind("isInstance", &Probe::isInstance)};
    table.Append(kMethods, sizeof kMethods / sizeof kMethods[0]);
  }
  static ASExtensionClass* ConstructInstance(StageWindow*, ASObject&, ASValueArray&) {
    ++s_Constructed;
    return new Probe;
  }
  static void DestructInstance(StageWindow*, ASObject& object) {
    ++s_Destructed;
    delete object.GetNativeInstance();
  }

  // keep(callback): keeps a reference beyond the call
  void keep(StageWindow*, ASObject&, ASValueArray& arguments, ASValue& result) {
    m_Kept = arguments.Get(0).AsObject();
    result.SetBoolean(m_Kept.IsValid());
  }
  void release(StageWindow*, ASObject&, ASValueArray&, ASValue&) { m_Kept.Release(); }
  // completeAfter(frames, status): after that many updates calls kept.onComplete(status, "done")
  void completeAfter(StageWindow*, ASObject& object, ASValueArray& arguments, ASValue& result) {
    m_Frames = arguments.Get(0).AsInteger();
    m_Status = arguments.Get(1).AsInteger();
    result.SetBoolean(object.RequestUpdates());
  }
  void OnUpdate(StageWindow*, ASObject& object) override {
    s_UpdateThread = std::this_thread::get_id();
    if (--m_Frames > 0) return;
    object.StopUpdates();
    ASValue status, text;
    status.SetInteger(m_Status);
    text.SetString("done");
    m_Kept.CallMethod("onComplete", status, text);
    m_Kept.Release();
  }
  // isInstance(object, className): the store's classes tell an Array argument from other objects
  void isInstance(StageWindow*, ASObject&, ASValueArray& arguments, ASValue& result) {
    result.SetBoolean(arguments.Get(0).AsObject().IsInstanceOf(arguments.Get(1).AsString().CString()));
  }

 private:
  ASObject m_Kept;
  int m_Frames = 0;
  int m_Status = 0;
};

int Probe::s_Constructed = 0;
int Probe::s_Destructed = 0;
std::thread::id Probe::s_UpdateThread;

class Engine : public testing::Test {
 protected:
  Engine() : stage(1) {
    Probe::s_Constructed = Probe::s_Destructed = 0;
    EXPECT_EQ(AEError_OK, stage.RegisterExtensionClass(ae::stagecraft::DescribeExtensionClass<Probe>()));
  }
  // Runs the script's top-level code and then the frames; expects no script error.
  void Play(const std::string& source) {
    EXPECT_TRUE(stage.Evaluate("movie.js", source)) << stage.Error();
    stage.RunFrames();
    EXPECT_EQ("", stage.Error());
  }
  std::string Text(const char* global) { return stage.Global().GetProperty(global).AsString().CString(); }

  vlplatform::Stage stage;
};

TEST_F(Engine, KeptReferenceSurvivesGarbageCollectionUntilReleased) {
  Play(
      "var p = newExtension('test.Probe');"
      "var collected = false, result = '';"
      "(function () {"
      "  var callback = { onComplete: function (status, text) { result = status + ':' + text; } };"
      "  Duktape.fin(callback, function () { collected = true; });"
      "  p.keep(callback);"
      "})();"
      "Duktape.gc(); Duktape.gc();"
      "var keptAfterGc = !collected;"
      "p.completeAfter(3, -7);");
  EXPECT_TRUE(stage.Global().GetProperty("keptAfterGc").AsBoolean());
  EXPECT_EQ("-7:done", Text("result"));  // called through the kept reference, then released
  EXPECT_EQ(std::this_thread::get_id(), Probe::s_UpdateThread);
  ASSERT_TRUE(stage.Evaluate("gc.js", "Duktape.gc(); Duktape.gc();"));
  EXPECT_TRUE(stage.Global().GetProperty("collected").AsBoolean());
}

// An instance that keeps its own object is not collected, and is destructed once at the close.
TEST_F(Engine, InstancesAreDestructedWhenCollectedOrWhenTheStageCloses) {
  Play(
      "var kept = newExtension('test.Probe');"
      "var dropped = newExtension('test.Probe');"
      "dropped = null;"
      "(function () { var self = newExtension('test.Probe'); self.keep(self); })(); Duktape.gc();");
  EXPECT_EQ(3, Probe::s_Constructed);
  EXPECT_EQ(1, Probe::s_Destructed);
  ASObject kept = stage.Global().GetProperty("kept").AsObject();
  EXPECT_NE(nullptr, kept.GetNativeInstance());
  stage.Close();
  EXPECT_EQ(3, Probe::s_Destructed);
  EXPECT_FALSE(kept.IsValid());
  EXPECT_EQ(nullptr, kept.GetNativeInstance());
  EXPECT_TRUE(kept.GetProperty("anything").IsUndefined());
  EXPECT_FALSE(stage.Evaluate("late.js", "1"));
}

TEST_F(Engine, AnErrorInACallbackIsTheMoviesErrorAndEndsIt) {
  stage.Evaluate("movie.js",
                 "var p = newExtension('test.Probe');"
                 "p.keep({ onComplete: function () { throw new Error('callback failed'); } });"
                 "p.completeAfter(1, 0);"
                 "onEnterFrame = function () {};");
  stage.RunFrames();
  EXPECT_TRUE(stage.Ended());
  EXPECT_EQ(1, stage.ExitStatus());
  EXPECT_NE(std::string::npos, stage.Error().find("callback failed")) << stage.Error();
}

TEST_F(Engine, ArraysAreToldFromOtherObjects) {
  Play(
      "var p = newExtension('test.Probe');"
      "var kinds = [p.isInstance([], 'Array'), p.isInstance({}, 'Array'), p.isInstance(p, 'test.Probe'),"
      "             p.isInstance({}, 'test.Probe')].join(' ');");
  EXPECT_EQ("true false true false", Text("kinds"));
}

TEST(EngineDeathTest, HandlesAreForTheEnginesThreadOnly) {
  vlplatform::Stage stage(1);
  ASObject global = stage.Global();
  EXPECT_DEATH(std::thread([&] { global.GetProperty("x"); }).join(), "m_Thread");
}

TEST(ScriptValue, ConvertsLikeTheScriptLanguage) {
  ASValue v;
  EXPECT_EQ(0, v.AsInteger());
  EXPECT_STREQ("", v.AsString().CString());
  const struct {
    double number;
    const char* text;
    int integer;
  } numbers[] = {{1.5, "1.5", 1},       {100, "100", 100},         {1e21, "1e+21", -559939584},
                 {1.5e-7, "1.5e-7", 0}, {-0.0, "0", 0},            {4294967297.0, "4294967297", 1},
                 {-2.5, "-2.5", -2},    {0.000001, "0.000001", 0}, {NAN, "NaN", 0},
                 {INFINITY, "Infinity", 0}};
  for (const auto& n : numbers) {
    v.SetNumber(n.number);
    EXPECT_STREQ(n.text, v.AsString().CString());
    EXPECT_EQ(n.integer, v.AsInteger()) << n.text;
  }
  const struct {
    const char* text;
    int integer;
  } texts[] = {{"", 0}, {"  42\n", 42}, {"0x10", 16}, {"-1e3", -1000}, {"12abc", 0}, {"inf", 0}, {".5", 0}};
  for (const auto& t : texts) {
    v.SetString(t.text);
    EXPECT_EQ(t.integer, v.AsInteger()) << t.text;
  }
  v.SetBoolean(true);
  EXPECT_EQ(1, v.AsInteger());
  ASValueArray arguments;
  EXPECT_TRUE(arguments.Get(3).IsUndefined());
}

}  // namespace
