// The stand-in script engine behind the stage: a Duktape heap, the table of references that
// ASObject handles hold, the registered extension classes with the native instances bound to
// their script objects, the movie's globals and the frame loop. Used on one thread only.
//
// Duktape reports script errors by longjmp. Every engine call that may run script code or
// throw therefore runs inside SafeCall, and the C functions that the scripts call do their C++
// work in member functions that return before any error is thrown, so no C++ destructor is
// ever skipped.
#ifndef VL_PLATFORM_SCRIPTENGINE_H
#define VL_PLATFORM_SCRIPTENGINE_H

#include <duktape.h>
#include <stdint.h>

#include <map>
#include <memory>
#include <string>
#include <thread>
#include <unordered_map>
#include <vector>

#include "AEError.h"
#include "ASExtensionClass.h"

namespace ae {
namespace stagecraft {

// Shared between the engine and the references it handed out; engine is null once it has shut
// down.
struct EngineLink {
  ScriptEngine* engine = nullptr;
};

// One counted reference: a slot of the engine's reference table holding the object alive.
struct ObjectRef {
  ObjectRef(std::shared_ptr<EngineLink> l, uint32_t s, void* p) : link(std::move(l)), slot(s), object(p) {}
  ~ObjectRef();
  ObjectRef(const ObjectRef&) = delete;
  ObjectRef& operator=(const ObjectRef&) = delete;

  std::shared_ptr<EngineLink> link;
  uint32_t slot;
  void* object;  // Duktape heap pointer, valid while the slot holds the object
};

class ScriptEngine : public StageWindow {
 public:
  explicit ScriptEngine(int frameIntervalMs);
  ~ScriptEngine() override;
  ScriptEngine(const ScriptEngine&) = delete;
  ScriptEngine& operator=(const ScriptEngine&) = delete;

  void Quit() override;

  AEError RegisterClass(const ASExtensionClassDescriptor& descriptor);
  const ASExtensionClassDescriptor* FindClass(const char* classId) const;
  std::vector<std::string> ClassIds() const;

  bool Evaluate(const std::string& name, const std::string& source);
  void RunFrames();
  void Close();
  bool Ended() const { return m_Closed || m_Quit || !m_Error.empty(); }
  int ExitStatus() const { return m_Error.empty() ? m_ExitCode : 1; }
  const std::string& Error() const { return m_Error; }
  // Makes text the movie's error unless it already has one.
  void SetError(const std::string& text);
  ASObject Global();

  // For ASObject (engine thread only). The Duktape context; a failed check on another thread.
  duk_context* Context() const;
  // A handle to the object at idx.
  ASObject Keep(duk_idx_t idx);
  // Pushes the object of a handle (undefined for a handle of no or another engine).
  void Push(const ASObject& object);
  ASValue ToValue(duk_idx_t idx);
  void PushValue(const ASValue& value);
  // Runs fn protected; it takes nargs values from the stack and leaves nrets >= 1. On a script
  // error: records it, leaves nrets undefined values, returns false.
  bool SafeCall(duk_safe_call_function fn, void* udata, duk_idx_t nargs, duk_idx_t nrets);
  // The extension binding of an object (see ASObject).
  ASExtensionClass* NativeInstance(void* object);
  bool SetUpdates(void* object, bool on);
  bool IsExtensionObjectOf(void* object, const char* classId);
  void ReleaseSlot(uint32_t slot);

  // For the C functions that scripts call.
  static ScriptEngine* Of(duk_context* ctx);
  int ClassIndex(const char* classId) const;
  void* PrototypeOf(int classIndex) const;
  bool Construct(int classIndex, duk_idx_t objectIndex, duk_idx_t firstArgument, duk_idx_t end);
  bool Invoke(int classIndex, int methodIndex, duk_idx_t thisIndex, duk_idx_t argumentCount,
              char* error, size_t errorSize);
  void Destruct(void* object);
  void Exit(int code);

 private:
  struct ExtensionClass {
    ASExtensionClassDescriptor descriptor;
    std::string id;
    AEArray<ASExtensionClass::Method> methods;
    ASObject prototype;
  };
  struct Binding {
    int classIndex;
    ASExtensionClass* native;  // null while ConstructInstance runs
    void* object;
    bool updates;
  };

  void CheckThread() const;
  // The binding of an extension object, null for other objects.
  Binding* Find(void* object);
  // Calls the movie's onEnterFrame; false when it has none.
  bool EnterFrame();
  // Calls OnUpdate on every instance that requests updates; false when none does.
  bool DeliverUpdates();

  std::thread::id m_Thread;
  duk_context* m_Ctx = nullptr;
  std::shared_ptr<EngineLink> m_Link;
  void* m_RefTable = nullptr;
  uint32_t m_NextSlot = 0;
  std::vector<uint32_t> m_FreeSlots;
  std::vector<std::unique_ptr<ExtensionClass>> m_Classes;
  std::map<uint64_t, Binding> m_Bindings;  // by creation order
  std::unordered_map<void*, uint64_t> m_Serials;
  uint64_t m_NextSerial = 0;
  int m_FrameIntervalMs;
  bool m_Quit = false;
  bool m_Closed = false;
  int m_ExitCode = 0;
  std::string m_Error;
};

}  // namespace stagecraft
}  // namespace ae

#endif  // VL_PLATFORM_SCRIPTENGINE_H
