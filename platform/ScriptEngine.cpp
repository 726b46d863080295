// The Duktape heap behind the stage: references, extension classes, movie globals, frames.
#include "ScriptEngine.h"

#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <chrono>

#include "IAEKernel.h"

namespace ae {
namespace stagecraft {

namespace {

void Fatal(void*, const char* message) {
  fprintf(stderr, "script engine: fatal error: %s\n", message ? message : "(none)");
  abort();
}

// this.<method>(...args) of an extension object: the method's class and table index are
// hidden properties of the function.
duk_ret_t CallExtensionMethod(duk_context* ctx) {
  duk_idx_t argumentCount = duk_get_top(ctx);
  duk_push_current_function(ctx);
  duk_get_prop_literal(ctx, -1, DUK_HIDDEN_SYMBOL("class"));
  int classIndex = duk_get_int(ctx, -1);
  duk_get_prop_literal(ctx, -2, DUK_HIDDEN_SYMBOL("method"));
  int methodIndex = duk_get_int(ctx, -1);
  duk_pop_3(ctx);
  duk_push_this(ctx);
  char error[256];
  if (!ScriptEngine::Of(ctx)->Invoke(classIndex, methodIndex, argumentCount, argumentCount, error,
                                     sizeof error)) {
    return duk_error(ctx, DUK_ERR_TYPE_ERROR, "%s", error);
  }
  return 1;
}

duk_ret_t FinalizeExtensionObject(duk_context* ctx) {
  ScriptEngine::Of(ctx)->Destruct(duk_get_heapptr(ctx, 0));
  return 0;
}

// newExtension(classId, ...args)
duk_ret_t NewExtension(duk_context* ctx) {
  ScriptEngine* engine = ScriptEngine::Of(ctx);
  const char* classId = duk_require_string(ctx, 0);
  int classIndex = engine->ClassIndex(classId);
  if (classIndex < 0) {
    return duk_error(ctx, DUK_ERR_TYPE_ERROR, "no extension class is registered as \"%s\"", classId);
  }
  duk_idx_t end = duk_get_top(ctx);
  duk_push_object(ctx);
  duk_push_heapptr(ctx, engine->PrototypeOf(classIndex));
  duk_set_prototype(ctx, -2);
  duk_push_c_function(ctx, FinalizeExtensionObject, 1);
  duk_set_finalizer(ctx, -2);
  if (!engine->Construct(classIndex, -1, 1, end)) {
    return duk_error(ctx, DUK_ERR_ERROR, "the extension class \"%s\" made no instance", classId);
  }
  return 1;
}

// print(...values)
duk_ret_t Print(duk_context* ctx) {
  duk_idx_t count = duk_get_top(ctx);
  for (duk_idx_t i = 0; i < count; ++i) duk_to_string(ctx, i);  // may throw: before any output
  for (duk_idx_t i = 0; i < count; ++i) {
    duk_size_t length = 0;
    const char* text = duk_get_lstring(ctx, i, &length);
    if (i > 0) fputc(' ', stdout);
    fwrite(text, 1, length, stdout);
  }
  fputc('\n', stdout);
  fflush(stdout);
  return 0;
}

duk_ret_t QuitMovie(duk_context* ctx) {
  ScriptEngine::Of(ctx)->Quit();
  return 0;
}

// exit(code)
duk_ret_t ExitMovie(duk_context* ctx) {
  ScriptEngine::Of(ctx)->Exit(duk_is_undefined(ctx, 0) ? 0 : duk_to_int32(ctx, 0));
  return 0;
}

// getenv(name)
duk_ret_t GetEnv(duk_context* ctx) {
  const char* value = getenv(duk_require_string(ctx, 0));
  if (value) {
    duk_push_string(ctx, value);
  } else {
    duk_push_undefined(ctx);
  }
  return 1;
}

const duk_function_list_entry kGlobals[] = {
    {"newExtension", NewExtension, DUK_VARARGS},
    {"print", Print, DUK_VARARGS},
    {"quit", QuitMovie, 0},
    {"exit", ExitMovie, 1},
    {"getenv", GetEnv, 1},
    {nullptr, nullptr, 0}};

}  // namespace

ObjectRef::~ObjectRef() {
  if (link->engine) link->engine->ReleaseSlot(slot);
}

ScriptEngine::ScriptEngine(int frameIntervalMs)
    : m_Thread(std::this_thread::get_id()),
      m_Link(std::make_shared<EngineLink>()),
      m_FrameIntervalMs(frameIntervalMs) {
  m_Ctx = duk_create_heap(nullptr, nullptr, nullptr, this, Fatal);
  if (!m_Ctx) Fatal(nullptr, "cannot create the script heap");
  m_Link->engine = this;
  duk_push_heap_stash(m_Ctx);
  duk_push_bare_object(m_Ctx);
  m_RefTable = duk_get_heapptr(m_Ctx, -1);
  duk_put_prop_literal(m_Ctx, -2, "references");
  duk_pop(m_Ctx);
  duk_push_global_object(m_Ctx);
  duk_put_function_list(m_Ctx, -1, kGlobals);
  duk_pop(m_Ctx);
}

ScriptEngine::~ScriptEngine() { Close(); }

ScriptEngine* ScriptEngine::Of(duk_context* ctx) {
  duk_memory_functions functions;
  duk_get_memory_functions(ctx, &functions);
  return static_cast<ScriptEngine*>(functions.udata);
}

void ScriptEngine::CheckThread() const {
  if (std::this_thread::get_id() != m_Thread) {
    IAEKernel::GetKernel()->ReportFailedCheck(__FILE__, __LINE__,
                                              "std::this_thread::get_id() == m_Thread");
    abort();
  }
}

duk_context* ScriptEngine::Context() const {
  CheckThread();
  return m_Ctx;
}

void ScriptEngine::Quit() { m_Quit = true; }

void ScriptEngine::Exit(int code) {
  m_ExitCode = code;
  m_Quit = true;
}

void ScriptEngine::SetError(const std::string& text) {
  if (m_Error.empty()) m_Error = text.empty() ? "unknown script error" : text;
}

// --- References --------------------------------------------------------------------------------

ASObject ScriptEngine::Keep(duk_idx_t idx) {
  CheckThread();
  idx = duk_normalize_index(m_Ctx, idx);
  uint32_t slot;
  if (m_FreeSlots.empty()) {
    slot = m_NextSlot++;
  } else {
    slot = m_FreeSlots.back();
    m_FreeSlots.pop_back();
  }
  duk_push_heapptr(m_Ctx, m_RefTable);
  duk_dup(m_Ctx, idx);
  duk_put_prop_index(m_Ctx, -2, slot);
  duk_pop(m_Ctx);
  return ASObject(std::make_shared<ObjectRef>(m_Link, slot, duk_get_heapptr(m_Ctx, idx)));
}

void ScriptEngine::ReleaseSlot(uint32_t slot) {
  CheckThread();
  duk_push_heapptr(m_Ctx, m_RefTable);
  duk_del_prop_index(m_Ctx, -1, slot);
  duk_pop(m_Ctx);
  m_FreeSlots.push_back(slot);
}

void ScriptEngine::Push(const ASObject& object) {
  if (object.m_Ref && object.m_Ref->link == m_Link) {
    duk_push_heapptr(m_Ctx, object.m_Ref->object);
  } else {
    duk_push_undefined(m_Ctx);
  }
}

ASValue ScriptEngine::ToValue(duk_idx_t idx) {
  ASValue value;
  switch (duk_get_type(m_Ctx, idx)) {
    case DUK_TYPE_NULL:
      value.SetNull();
      break;
    case DUK_TYPE_BOOLEAN:
      value.SetBoolean(duk_get_boolean(m_Ctx, idx) != 0);
      break;
    case DUK_TYPE_NUMBER:
      value.SetNumber(duk_get_number(m_Ctx, idx));
      break;
    case DUK_TYPE_STRING:
      if (!duk_is_symbol(m_Ctx, idx)) {
        duk_size_t length = 0;
        const char* text = duk_get_lstring(m_Ctx, idx, &length);
        value.SetString(text, length);
      }
      break;
    case DUK_TYPE_OBJECT:
      value.SetObject(Keep(idx));
      break;
    default:  // undefined, and engine-internal kinds the movie API does not carry
      break;
  }
  return value;
}

void ScriptEngine::PushValue(const ASValue& value) {
  switch (value.m_Kind) {
    case ASValue::kNull: duk_push_null(m_Ctx); break;
    case ASValue::kBoolean: duk_push_boolean(m_Ctx, value.m_Boolean); break;
    case ASValue::kNumber: duk_push_number(m_Ctx, value.m_Number); break;
    case ASValue::kString: duk_push_lstring(m_Ctx, value.m_String.data(), value.m_String.size()); break;
    case ASValue::kObject: Push(value.m_Object); break;
    case ASValue::kUndefined: duk_push_undefined(m_Ctx); break;
  }
}

bool ScriptEngine::SafeCall(duk_safe_call_function fn, void* udata, duk_idx_t nargs, duk_idx_t nrets) {
  CheckThread();
  if (duk_safe_call(m_Ctx, fn, udata, nargs, nrets) == DUK_EXEC_SUCCESS) return true;
  SetError(duk_safe_to_stacktrace(m_Ctx, -nrets));
  duk_push_undefined(m_Ctx);
  duk_replace(m_Ctx, -nrets - 1);
  return false;
}

ASObject ScriptEngine::Global() {
  if (m_Closed) return ASObject();
  duk_push_global_object(m_Ctx);
  ASObject global = Keep(-1);
  duk_pop(m_Ctx);
  return global;
}

// --- Extension classes and their objects -------------------------------------------------------

AEError ScriptEngine::RegisterClass(const ASExtensionClassDescriptor& descriptor) {
  CheckThread();
  if (m_Closed) return AEError_Usage;
  if (!descriptor.GetClassName || !descriptor.GetMethods || !descriptor.FiresEvents ||
      !descriptor.ConstructInstance || !descriptor.DestructInstance) {
    return AEError_InvalidParameters;
  }
  const char* id = descriptor.GetClassName();
  if (!id || !*id) return AEError_InvalidParameters;
  if (ClassIndex(id) >= 0) return AEError_Usage;
  std::unique_ptr<ExtensionClass> c(new ExtensionClass);
  c->descriptor = descriptor;
  c->id = id;
  descriptor.GetMethods(c->methods);
  int classIndex = static_cast<int>(m_Classes.size());
  duk_push_object(m_Ctx);
  for (size_t i = 0; i < c->methods.Size(); ++i) {
    const ASExtensionClass::Method& m = c->methods[i];
    if (!m.name || !m.function) continue;
    duk_push_c_function(m_Ctx, CallExtensionMethod, DUK_VARARGS);
    duk_push_int(m_Ctx, classIndex);
    duk_put_prop_literal(m_Ctx, -2, DUK_HIDDEN_SYMBOL("class"));
    duk_push_int(m_Ctx, static_cast<int>(i));
    duk_put_prop_literal(m_Ctx, -2, DUK_HIDDEN_SYMBOL("method"));
    duk_put_prop_string(m_Ctx, -2, m.name);
  }
  c->prototype = Keep(-1);
  duk_pop(m_Ctx);
  m_Classes.push_back(std::move(c));
  return AEError_OK;
}

int ScriptEngine::ClassIndex(const char* classId) const {
  for (size_t i = 0; i < m_Classes.size(); ++i) {
    if (m_Classes[i]->id == classId) return static_cast<int>(i);
  }
  return -1;
}

const ASExtensionClassDescriptor* ScriptEngine::FindClass(const char* classId) const {
  int i = ClassIndex(classId);
  return i < 0 ? nullptr : &m_Classes[i]->descriptor;
}

std::vector<std::string> ScriptEngine::ClassIds() const {
  std::vector<std::string> ids;
  for (const auto& c : m_Classes) ids.push_back(c->id);
  return ids;
}

void* ScriptEngine::PrototypeOf(int classIndex) const {
  return m_Classes[classIndex]->prototype.m_Ref->object;
}

ScriptEngine::Binding* ScriptEngine::Find(void* object) {
  auto serial = m_Serials.find(object);
  return serial == m_Serials.end() ? nullptr : &m_Bindings.at(serial->second);
}

ASExtensionClass* ScriptEngine::NativeInstance(void* object) {
  Binding* b = Find(object);
  return b ? b->native : nullptr;
}

bool ScriptEngine::SetUpdates(void* object, bool on) {
  Binding* b = Find(object);
  if (!b) return false;
  b->updates = on;
  return true;
}

bool ScriptEngine::IsExtensionObjectOf(void* object, const char* classId) {
  Binding* b = Find(object);
  return b && m_Classes[b->classIndex]->id == classId;
}

bool ScriptEngine::Construct(int classIndex, duk_idx_t objectIndex, duk_idx_t firstArgument,
                             duk_idx_t end) {
  ASObject object = Keep(objectIndex);
  ASValueArray arguments;
  for (duk_idx_t i = firstArgument; i < end; ++i) arguments.Append(ToValue(i));
  uint64_t serial = m_NextSerial++;
  void* heapObject = object.m_Ref->object;
  m_Bindings[serial] = Binding{classIndex, nullptr, heapObject, false};
  m_Serials[heapObject] = serial;
  ASExtensionClass* native = m_Classes[classIndex]->descriptor.ConstructInstance(this, object, arguments);
  if (!native) {
    m_Serials.erase(heapObject);
    m_Bindings.erase(serial);
    return false;
  }
  m_Bindings[serial].native = native;
  return true;
}

bool ScriptEngine::Invoke(int classIndex, int methodIndex, duk_idx_t thisIndex,
                          duk_idx_t argumentCount, char* error, size_t errorSize) {
  const ExtensionClass& c = *m_Classes.at(classIndex);
  const ASExtensionClass::Method& method = c.methods[methodIndex];
  const Binding* b = duk_is_object(m_Ctx, thisIndex) ? Find(duk_get_heapptr(m_Ctx, thisIndex)) : nullptr;
  if (!b || !b->native || b->classIndex != classIndex) {
    snprintf(error, errorSize, "%s is a method of live \"%s\" objects only", method.name, c.id.c_str());
    return false;
  }
  ASExtensionClass* native = b->native;
  ASObject self = Keep(thisIndex);
  ASValueArray arguments;
  for (duk_idx_t i = 0; i < argumentCount; ++i) arguments.Append(ToValue(i));
  ASValue result;
  (native->*method.function)(this, self, arguments, result);
  PushValue(result);
  return true;
}

void ScriptEngine::Destruct(void* object) {
  auto serial = m_Serials.find(object);
  if (serial == m_Serials.end()) return;
  uint64_t key = serial->second;
  Binding b = m_Bindings.at(key);
  duk_push_heapptr(m_Ctx, object);
  ASObject handle = Keep(-1);
  duk_pop(m_Ctx);
  if (b.native) m_Classes[b.classIndex]->descriptor.DestructInstance(this, handle);
  // Unbind before the handle goes: dropping it may finalize the object, which must find no
  // binding then.
  m_Serials.erase(object);
  m_Bindings.erase(key);
}

// --- The movie ---------------------------------------------------------------------------------

bool ScriptEngine::Evaluate(const std::string& name, const std::string& source) {
  CheckThread();
  if (Ended()) return false;
  duk_push_lstring(m_Ctx, name.data(), name.size());
  if (duk_pcompile_lstring_filename(m_Ctx, 0, source.data(), source.size()) != 0 ||
      duk_pcall(m_Ctx, 0) != DUK_EXEC_SUCCESS) {
    SetError(duk_safe_to_stacktrace(m_Ctx, -1));
    duk_pop(m_Ctx);
    return false;
  }
  duk_pop(m_Ctx);
  return true;
}

bool ScriptEngine::EnterFrame() {
  bool handled = false;
  SafeCall(
      [](duk_context* ctx, void* udata) -> duk_ret_t {
        duk_get_global_literal(ctx, "onEnterFrame");
        bool callable = duk_is_callable(ctx, -1);
        *static_cast<bool*>(udata) = callable;
        if (callable) duk_call(ctx, 0);
        return 1;
      },
      &handled, 0, 1);
  duk_pop(m_Ctx);
  return handled;
}

bool ScriptEngine::DeliverUpdates() {
  std::vector<void*> objects;
  for (const auto& entry : m_Bindings) {
    if (entry.second.updates && entry.second.native) objects.push_back(entry.second.object);
  }
  for (void* object : objects) {
    if (Ended()) break;
    const Binding* b = Find(object);  // an earlier OnUpdate may have changed the bindings
    if (!b || !b->updates || !b->native) continue;
    ASExtensionClass* native = b->native;
    duk_push_heapptr(m_Ctx, object);
    ASObject handle = Keep(-1);
    duk_pop(m_Ctx);
    native->OnUpdate(this, handle);
  }
  for (const auto& entry : m_Bindings) {
    if (entry.second.updates) return true;
  }
  return false;
}

void ScriptEngine::RunFrames() {
  CheckThread();
  auto next = std::chrono::steady_clock::now();
  while (!Ended()) {
    bool handler = EnterFrame();
    bool updates = !Ended() && DeliverUpdates();
    if (Ended() || (!handler && !updates)) break;
    next += std::chrono::milliseconds(m_FrameIntervalMs);
    auto now = std::chrono::steady_clock::now();
    if (next < now) next = now;
    std::this_thread::sleep_until(next);
  }
}

void ScriptEngine::Close() {
  if (m_Closed) return;
  CheckThread();
  while (!m_Bindings.empty()) Destruct(m_Bindings.begin()->second.object);
  m_Classes.clear();
  m_Link->engine = nullptr;  // handles still held become invalid
  m_Closed = true;
  duk_destroy_heap(m_Ctx);  // runs the remaining finalizers, which find no bindings
  m_Ctx = nullptr;
}

}  // namespace stagecraft
}  // namespace ae
