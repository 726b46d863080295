// The stand-in engine host: a stage that plays movie scripts (ECMAScript, run by Duktape) with
// the extension classes an application registered, a launcher that offers the stage to an
// application, and the launcher's whole run of one application. The launcher tool vlhost and
// the tests use it.
//
// Globals of a movie script:
//   newExtension(classId, ...args)  constructs an object of a registered extension class
//                                    (TypeError for an unknown class id)
//   print(...values)                 writes the values, separated by blanks, as one line to
//                                    standard output
//   quit()                           quits the movie (what StageWindow::Quit does)
//   exit(code)                       ends the movie with that exit status (default 0)
//   getenv(name)                     the environment variable name, or undefined
//   onEnterFrame                     when the movie defines this function, the stage calls it
//                                    once every frame
// quit() and exit() take effect when the running script code returns. Duktape's own globals are
// there too (Duktape.gc() forces a garbage collection).
//
// The movie ends when it quits or exits, when a script error is not caught, or when nothing is
// left that could run script code: no onEnterFrame and no extension object requesting updates.
//
// Threads: a stage and everything it hands out belong to the thread that made it.
#ifndef VLSTAGE_H
#define VLSTAGE_H

#include <memory>
#include <string>
#include <vector>

#include "ASExtensionClass.h"
#include "IApplication.h"
#include "ILauncher.h"
#include "IStagecraft.h"

namespace ae {
namespace stagecraft {
class ScriptEngine;
}
}  // namespace ae

namespace vlplatform {

// A key delivered to the stage.
struct KeyEvent {
  unsigned int keyCode;
  bool pressed;            // press, else release
  unsigned int modifiers;  // the press's second argument (0 for releases)
};

class Stage : public ae::stagecraft::IStagecraft {
 public:
  // frameIntervalMs: the time between the starts of two frames.
  explicit Stage(int frameIntervalMs = 20);
  ~Stage() override;
  Stage(const Stage&) = delete;
  Stage& operator=(const Stage&) = delete;

  // IStagecraft. Keys are recorded (see Keys()).
  AEError RegisterExtensionClass(const ae::stagecraft::ASExtensionClassDescriptor& descriptor) override;
  void SendKeyPress(unsigned int keyCode, unsigned int modifiers) override;
  void SendKeyRelease(unsigned int keyCode) override;

  // Runs a movie script's top-level code. False when it failed to compile or threw (the
  // movie's error is then set) or when the movie has already ended or been closed.
  bool Evaluate(const std::string& name, const std::string& source);
  // The same for the script file path (a file that cannot be read is the movie's error).
  bool EvaluateFile(const std::string& path);
  // Runs frames until the movie ends (see above).
  void RunFrames();
  // Ends the movie: destructs every extension object (DestructInstance) and shuts the engine
  // down; handles still held become invalid. Idempotent; the destructor does it too.
  void Close();

  // Whether the movie has ended (quit, exit, error) or the stage was closed.
  bool Ended() const;
  // The movie's exit status: 0, the code given to exit(), or 1 after a script error.
  int ExitStatus() const;
  // The first uncaught script error (message and script stack), empty when there was none.
  const std::string& Error() const;

  // The movie's global object (a null handle once closed).
  ae::stagecraft::ASObject Global() const;
  ae::stagecraft::StageWindow* Window();
  // The descriptor registered under classId, or null.
  const ae::stagecraft::ASExtensionClassDescriptor* FindClass(const char* classId) const;
  // The class ids in registration order.
  std::vector<std::string> ClassIds() const;
  // Every key delivered so far, in order.
  const std::vector<KeyEvent>& Keys() const { return m_Keys; }

 private:
  std::unique_ptr<ae::stagecraft::ScriptEngine> m_Impl;
  std::vector<KeyEvent> m_Keys;
};

// A launcher that offers the given stage (null: a launcher without a stage).
class Launcher : public scLauncher::ILauncher {
 public:
  explicit Launcher(ae::stagecraft::IStagecraft* stage) : m_Stage(stage) {}
  ae::stagecraft::IStagecraft* GetStagecraft() override { return m_Stage; }

 private:
  ae::stagecraft::IStagecraft* m_Stage;
};

// The launcher's run of one application: init with a launcher of stage, the movie scripts in
// order (the first that fails or ends the movie stops the rest), the frame loop, closing the
// movie, onTerminate, and deleting the application. Returns the movie's exit status.
int RunApplication(scLauncher::IApplication2* application, Stage& stage,
                   const std::vector<std::string>& scriptFiles);

}  // namespace vlplatform

#endif  // VLSTAGE_H
