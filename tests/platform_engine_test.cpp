// The script engine behind the stage, seen from an extension class as the store's classes see
// it: construction by class id, method calls, kept references across garbage collections,
// OnUpdate delivery, value factories ("Date", "Object", "push"), callbacks ("onComplete"),
// destruction, script errors and the movie's end.
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
    static const Method kMethods[] = {
        Method::Bind("describe", &Probe::describe),   Method::Bind("keep", &Probe::keep),
        Method::Bind("release", &Probe::release),     Method::Bind("completeAfter", &Probe::completeAfter),
        Method::Bind("makeDate", &Probe::makeDate),   Method::Bind("fill", &Probe::fill),
        Method::Bind("read", &Probe::read),           Method::Bind("isInstance", &Probe::isInstance),
        Method::Bind("quitMovie", &Probe::quitMovie), Method::Bind("label", &Probe::label),
    };
    table.Append(kMethods, sizeof kMethods / sizeof kMethods[0]);
  }
  static ASExtensionClass* ConstructInstance(StageWindow*, ASObject&, ASValueArray& arguments) {
    ++s_Constructed;
    Probe* probe = new Probe;
    probe->m_Label = arguments.Get(0).AsString();
    return probe;
  }
  static void DestructInstance(StageWindow*, ASObject& object) {
    ++s_Destructed;
    delete object.GetNativeInstance();
  }

  // describe(...values): "<count>|" then "<kind>,<integer>,<boolean>,<string>;" per value
  void describe(StageWindow*, ASObject&, ASValueArray& arguments, ASValue& result) {
    std::string text = std::to_string(arguments.Count()) + "|";
    for (size_t i = 0; i < arguments.Count(); ++i) {
      const ASValue& v = arguments.Get(i);
      text += std::to_string(v.GetKind()) + "," + std::to_string(v.AsInteger()) + "," +
              (v.AsBoolean() ? "true" : "false") + "," + v.AsString().CString() + ";";
    }
    result.SetString(text.c_str());
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
  // makeDate(year, month, day, hours, minutes, seconds)
  void makeDate(StageWindow*, ASObject& object, ASValueArray& arguments, ASValue& result) {
    result.SetObject(object.NewObject("Date", arguments));
  }
  // fill(array, n): pushes n new objects {index: i} onto the array
  void fill(StageWindow*, ASObject& object, ASValueArray& arguments, ASValue& result) {
    ASObject array = arguments.Get(0).AsObject();
    bool ok = array.IsInstanceOf("Array");
    for (int i = 0; i < arguments.Get(1).AsInteger(); ++i) {
      ASObject element = object.NewObject("Object");
      ASValue index, value;
      index.SetInteger(i);
      ok = element.SetProperty("index", index) && ok;
      value.SetObject(element);
      ok = array.CallMethod("push", value) && ok;
    }
    result.SetBoolean(ok);
  }
  // read(object, name)
  void read(StageWindow*, ASObject&, ASValueArray& arguments, ASValue& result) {
    result = arguments.Get(0).AsObject().GetProperty(arguments.Get(1).AsString().CString());
  }
  // isInstance(object, className)
  void isInstance(StageWindow*, ASObject&, ASValueArray& arguments, ASValue& result) {
    result.SetBoolean(arguments.Get(0).AsObject().IsInstanceOf(arguments.Get(1).AsString().CString()));
  }
  void quitMovie(StageWindow* window, ASObject&, ASValueArray&, ASValue&) { window->Quit(); }
  void label(StageWindow*, ASObject&, ASValueArray&, ASValue& result) { result.SetString(m_Label); }

 private:
  AEString m_Label;
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

TEST_F(Engine, ExtensionObjectsAreMadeByClassIdAndTheirMethodsGetArgumentsAndReturnValues) {
  Play(
      "var p = newExtension('test.Probe', 'first');"
      "var d = p.describe(12, '0x1F', ' 7 ', 2.9, -2.9, true, null, undefined, {}, [1, 2], 'abc');"
      "var l = p.label();"
      "var none = p.release();");
  EXPECT_EQ(1, Probe::s_Constructed);
  EXPECT_EQ("first", Text("l"));
  EXPECT_EQ(
      "11|3,12,true,12;4,31,true,0x1F;4,7,true, 7 ;3,2,true,2.9;3,-2,true,-2.9;2,1,true,true;"
      "1,0,false,;0,0,false,;5,0,true,[object Object];5,0,true,1,2;4,0,true,abc;",
      Text("d"));
  EXPECT_TRUE(stage.Global().GetProperty("none").IsUndefined());
}

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

TEST_F(Engine, OnUpdateRunsEveryFrameWhileRequestedAndTheMovieEndsWhenNothingIsLeft) {
  Play(
      "var frames = 0, done = 0;"
      "var p = newExtension('test.Probe');"
      "p.keep({ onComplete: function () { done = frames; } });"
      "p.completeAfter(4, 0);"
      "onEnterFrame = function () { ++frames; if (done) onEnterFrame = null; };");
  // OnUpdate follows onEnterFrame in each frame: the fourth update is in the fourth frame.
  EXPECT_EQ(4, stage.Global().GetProperty("done").AsInteger());
  EXPECT_EQ(5, stage.Global().GetProperty("frames").AsInteger());
  EXPECT_FALSE(stage.Ended());
}

TEST_F(Engine, FactoriesMakeDatesObjectsAndPushOntoArrays) {
  Play(
      "var p = newExtension('test.Probe');"
      "var d = p.makeDate(2011, 0, 2, 3, 4, 5);"
      "var date = [d instanceof Date, d.getFullYear(), d.getMonth(), d.getDate(),"
      "            d.getHours(), d.getMinutes(), d.getSeconds()].join(' ');"
      "var zero = p.makeDate(0, -1, 0, 0, 0, 0);"
      "var zeroDate = zero instanceof Date && !isNaN(zero.getTime());"
      "var list = ['existing'];"
      "var filled = p.fill(list, 3);"
      "var listed = list.length + ' ' + list[0] + ' ' + list[3].index;"
      "var kinds = [p.isInstance([], 'Array'), p.isInstance({}, 'Array'), p.isInstance(d, 'Date'),"
      "             p.isInstance(p, 'test.Probe'), p.isInstance({}, 'test.Probe'),"
      "             p.isInstance({}, 'NoSuchClass')].join(' ');"
      "var property = p.read({ a: 'x' }, 'a') + p.read({}, 'missing');");
  EXPECT_EQ("true 2011 0 2 3 4 5", Text("date"));
  EXPECT_TRUE(stage.Global().GetProperty("zeroDate").AsBoolean());
  EXPECT_TRUE(stage.Global().GetProperty("filled").AsBoolean());
  EXPECT_EQ("4 existing 2", Text("listed"));
  EXPECT_EQ("true false true true false false", Text("kinds"));
  EXPECT_EQ("xundefined", Text("property"));
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

TEST_F(Engine, ScriptErrorsAndMisuseAreReported) {
  Play(
      "var p = newExtension('test.Probe');"
      "var misuse = '';"
      "try { p.label.call({}); } catch (e) { misuse = e.name; }");
  EXPECT_EQ("TypeError", Text("misuse"));
  EXPECT_FALSE(stage.Evaluate("unknown.js", "newExtension('no.such.Class');"));
  EXPECT_NE(std::string::npos, stage.Error().find("no extension class is registered as \"no.such.Class\""));
  EXPECT_EQ(1, stage.ExitStatus());
}

TEST_F(Engine, QuitAndExitEndTheMovie) {
  Play("var p = newExtension('test.Probe'); onEnterFrame = function () { p.quitMovie(); };");
  EXPECT_TRUE(stage.Ended());
  EXPECT_EQ(0, stage.ExitStatus());

  vlplatform::Stage other(1);
  EXPECT_TRUE(other.Evaluate("exit.js", "var n = 0; onEnterFrame = function () { if (++n == 3) exit(4); };"));
  other.RunFrames();
  EXPECT_EQ(4, other.ExitStatus());
  EXPECT_EQ(3, other.Global().GetProperty("n").AsInteger());
}

TEST_F(Engine, RegistrationRejectsDuplicatesAndIncompleteDescriptors) {
  EXPECT_EQ(AEError_Usage, stage.RegisterExtensionClass(ae::stagecraft::DescribeExtensionClass<Probe>()));
  ae::stagecraft::ASExtensionClassDescriptor incomplete = ae::stagecraft::DescribeExtensionClass<Probe>();
  incomplete.DestructInstance = nullptr;
  EXPECT_EQ(AEError_InvalidParameters, stage.RegisterExtensionClass(incomplete));
  EXPECT_EQ(std::vector<std::string>{"test.Probe"}, stage.ClassIds());
  EXPECT_NE(nullptr, stage.FindClass("test.Probe"));
  EXPECT_EQ(nullptr, stage.FindClass("other"));
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
  v.SetString("-Infinity");
  EXPECT_TRUE(std::isinf(v.AsNumber()));
  v.SetString("");
  EXPECT_FALSE(v.AsBoolean());
  v.SetBoolean(true);
  EXPECT_EQ(1, v.AsInteger());
  EXPECT_FALSE(v.AsObject().IsValid());
  ASValueArray arguments;
  EXPECT_TRUE(arguments.Get(3).IsUndefined());
}

}  // namespace
