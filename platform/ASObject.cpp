// Operations on script objects through their handles. Whatever may run script code runs in
// ScriptEngine::SafeCall; the functions given to it hold no C++ objects that need destruction.
#include "ASObject.h"

#include <cmath>
#include <cstring>

#include "ASValue.h"
#include "ScriptEngine.h"

namespace ae {
namespace stagecraft {

namespace {

struct CallRequest {
  ScriptEngine* engine;
  const char* name;
  const ASValueArray* arguments;
  bool found;
};

// [object] -> [object.name(...arguments)], or [undefined] when there is no such method.
duk_ret_t CallNamedMethod(duk_context* ctx, void* udata) {
  CallRequest* request = static_cast<CallRequest*>(udata);
  duk_get_prop_string(ctx, -1, request->name);
  request->found = duk_is_callable(ctx, -1) != 0;
  if (!request->found) {
    duk_push_undefined(ctx);
    return 1;
  }
  duk_dup(ctx, -2);
  for (size_t i = 0; i < request->arguments->Count(); ++i) {
    request->engine->PushValue(request->arguments->Get(i));
  }
  duk_call_method(ctx, static_cast<duk_idx_t>(request->arguments->Count()));
  return 1;
}

// [] -> [new <name>(...arguments)], or [undefined] when there is no such constructor.
duk_ret_t ConstructNamed(duk_context* ctx, void* udata) {
  CallRequest* request = static_cast<CallRequest*>(udata);
  duk_get_global_string(ctx, request->name);
  if (!duk_is_constructable(ctx, -1)) {
    duk_push_undefined(ctx);
    return 1;
  }
  for (size_t i = 0; i < request->arguments->Count(); ++i) {
    request->engine->PushValue(request->arguments->Get(i));
  }
  duk_new(ctx, static_cast<duk_idx_t>(request->arguments->Count()));
  return 1;
}

}  // namespace

ScriptEngine* ASObject::Engine() const {
  ScriptEngine* engine = m_Ref ? m_Ref->link->engine : nullptr;
  if (engine) engine->Context();  // the failed check for a call on another thread
  return engine;
}

bool ASObject::IsValid() const { return Engine() != nullptr; }

bool ASObject::IsSameObject(const ASObject& other) const {
  if (!m_Ref || !other.m_Ref) return !m_Ref && !other.m_Ref;
  return m_Ref->link == other.m_Ref->link && m_Ref->object == other.m_Ref->object;
}

bool ASObject::IsInstanceOf(const char* className) const {
  ScriptEngine* engine = Engine();
  if (!engine || !className) return false;
  duk_context* ctx = engine->Context();
  if (strcmp(className, "Array") == 0) {
    engine->Push(*this);
    bool isArray = duk_is_array(ctx, -1) != 0;
    duk_pop(ctx);
    return isArray;
  }
  if (engine->ClassIndex(className) >= 0) return engine->IsExtensionObjectOf(m_Ref->object, className);
  engine->Push(*this);
  engine->SafeCall(
      [](duk_context* c, void* name) -> duk_ret_t {
        duk_get_global_string(c, static_cast<const char*>(name));
        bool result = duk_is_callable(c, -1) && duk_instanceof(c, -2, -1);
        duk_push_boolean(c, result);
        return 1;
      },
      const_cast<char*>(className), 1, 1);
  bool result = duk_get_boolean(ctx, -1) != 0;
  duk_pop(ctx);
  return result;
}

size_t ASObject::GetLength() const {
  ScriptEngine* engine = Engine();
  if (!engine) return 0;
  engine->Push(*this);
  engine->SafeCall(
      [](duk_context* c, void*) -> duk_ret_t {
        duk_push_number(c, static_cast<double>(duk_get_length(c, -1)));
        return 1;
      },
      nullptr, 1, 1);
  duk_context* ctx = engine->Context();
  size_t length = static_cast<size_t>(duk_get_number_default(ctx, -1, 0));
  duk_pop(ctx);
  return length;
}

ASValue ASObject::GetElement(size_t index) const {
  ScriptEngine* engine = Engine();
  if (!engine) return ASValue();
  engine->Push(*this);
  duk_push_number(engine->Context(), static_cast<double>(index));
  engine->SafeCall(
      [](duk_context* c, void*) -> duk_ret_t {
        duk_get_prop(c, -2);
        return 1;
      },
      nullptr, 2, 1);
  ASValue value = engine->ToValue(-1);
  duk_pop(engine->Context());
  return value;
}

ASValue ASObject::GetProperty(const char* name) const {
  ScriptEngine* engine = Engine();
  if (!engine || !name) return ASValue();
  engine->Push(*this);
  engine->SafeCall(
      [](duk_context* c, void* key) -> duk_ret_t {
        duk_get_prop_string(c, -1, static_cast<const char*>(key));
        return 1;
      },
      const_cast<char*>(name), 1, 1);
  ASValue value = engine->ToValue(-1);
  duk_pop(engine->Context());
  return value;
}

bool ASObject::SetProperty(const char* name, const ASValue& value) const {
  ScriptEngine* engine = Engine();
  if (!engine || !name) return false;
  engine->Push(*this);
  engine->PushValue(value);
  bool ok = engine->SafeCall(
      [](duk_context* c, void* key) -> duk_ret_t {
        duk_put_prop_string(c, -2, static_cast<const char*>(key));
        duk_push_true(c);
        return 1;
      },
      const_cast<char*>(name), 2, 1);
  duk_pop(engine->Context());
  return ok;
}

bool ASObject::CallMethod(const char* name, const ASValueArray& arguments, ASValue* result) const {
  ScriptEngine* engine = Engine();
  if (!engine || !name) return false;
  CallRequest request{engine, name, &arguments, false};
  engine->Push(*this);
  bool ok = engine->SafeCall(CallNamedMethod, &request, 1, 1) && request.found;
  if (result) *result = engine->ToValue(-1);
  duk_pop(engine->Context());
  return ok;
}

bool ASObject::CallMethod(const char* name, const ASValue& argument, ASValue* result) const {
  ASValueArray arguments;
  arguments.Append(argument);
  return CallMethod(name, arguments, result);
}

bool ASObject::CallMethod(const char* name, const ASValue& first, const ASValue& second,
                          ASValue* result) const {
  ASValueArray arguments;
  arguments.Append(first);
  arguments.Append(second);
  return CallMethod(name, arguments, result);
}

ASObject ASObject::NewObject(const char* className) const { return NewObject(className, ASValueArray()); }

ASObject ASObject::NewObject(const char* className, const ASValueArray& arguments) const {
  ScriptEngine* engine = Engine();
  if (!engine || !className) return ASObject();
  CallRequest request{engine, className, &arguments, false};
  engine->SafeCall(ConstructNamed, &request, 0, 1);
  ASObject object = engine->ToValue(-1).AsObject();
  duk_pop(engine->Context());
  return object;
}

ASExtensionClass* ASObject::GetNativeInstance() const {
  ScriptEngine* engine = Engine();
  return engine ? engine->NativeInstance(m_Ref->object) : nullptr;
}

bool ASObject::RequestUpdates() const {
  ScriptEngine* engine = Engine();
  return engine && engine->SetUpdates(m_Ref->object, true);
}

void ASObject::StopUpdates() const {
  ScriptEngine* engine = Engine();
  if (engine) engine->SetUpdates(m_Ref->object, false);
}

double ASObject::ToNumber() const {
  ScriptEngine* engine = Engine();
  if (!engine) return NAN;
  engine->Push(*this);
  engine->SafeCall(
      [](duk_context* c, void*) -> duk_ret_t {
        duk_to_number(c, -1);
        return 1;
      },
      nullptr, 1, 1);
  duk_context* ctx = engine->Context();
  double number = duk_get_number_default(ctx, -1, NAN);
  duk_pop(ctx);
  return number;
}

std::string ASObject::ToText() const {
  ScriptEngine* engine = Engine();
  if (!engine) return std::string();
  engine->Push(*this);
  engine->SafeCall(
      [](duk_context* c, void*) -> duk_ret_t {
        duk_to_string(c, -1);
        return 1;
      },
      nullptr, 1, 1);
  duk_context* ctx = engine->Context();
  duk_size_t length = 0;
  const char* text = duk_get_lstring(ctx, -1, &length);
  std::string result(text ? text : "", text ? length : 0);
  duk_pop(ctx);
  return result;
}

}  // namespace stagecraft
}  // namespace ae
