// ae::stagecraft::ASObject: a handle to one script object of the engine.
//
// Ownership. Script objects belong to the engine. An ASObject is a counted reference that keeps
// its object alive, across garbage collections, for as long as the handle (or a copy of it)
// exists; Release() or the handle's destruction gives the reference up. So:
//   * the objects the engine passes to an extension method are valid for the call;
//   * to keep an object beyond the call (a completion callback, say), copy the handle into the
//     instance, and Release() it when done;
//   * a handle never dangles: once the engine has shut down, IsValid() is false and every
//     operation does nothing and returns an empty result.
// A handle that an instance keeps to its own script object keeps that object alive until the
// engine shuts down.
//
// Threads. The engine has one thread: create, copy, use and destroy handles only on it. Doing
// otherwise is a failed check that stops the process. (Worker threads hand plain data back
// and let the engine's thread build script values.)
//
// Script errors. Operations that run script code (getters, setters, toString, called methods,
// constructors) never throw into the caller: an uncaught script error is recorded by the engine
// as the movie's error, which ends the movie, and the operation returns its empty result.
#ifndef ASOBJECT_H
#define ASOBJECT_H

#include <stddef.h>

#include <memory>
#include <string>

namespace ae {
namespace stagecraft {

class ASExtensionClass;
class ASValue;
class ASValueArray;
class ScriptEngine;
struct ObjectRef;

class ASObject {
 public:
  // A null handle: IsValid() is false.
  ASObject() = default;

  // Whether the handle refers to a script object of a running engine.
  bool IsValid() const;

  // Whether the object is an instance of the named class: "Array" tests for a real array; the
  // class id of a registered extension class tests for an object of that class; any other name
  // is looked up as a global constructor and tested with instanceof.
  bool IsInstanceOf(const char* className) const;

  // The "length" of the object (the element count of an array), 0 when it has none.
  size_t GetLength() const;
  // Element index of an array (or the property of that index of any object).
  ASValue GetElement(size_t index) const;

  // The property name; an absent property gives the undefined value.
  ASValue GetProperty(const char* name) const;
  // Sets the property name to a copy of value. False when the object is not valid, the property
  // cannot be set, or a setter threw.
  bool SetProperty(const char* name, const ASValue& value) const;

  // Calls the method name of the object with the arguments and stores its return value in
  // *result (when result is not null). False when the object has no such method or the method
  // threw (the engine records the error).
  bool CallMethod(const char* name, const ASValueArray& arguments, ASValue* result = nullptr) const;
  bool CallMethod(const char* name, const ASValue& argument, ASValue* result = nullptr) const;
  bool CallMethod(const char* name, const ASValue& first, const ASValue& second,
                  ASValue* result = nullptr) const;

  // A new object of the named global class ("Object", "Array", "Date", ...) built by its
  // constructor with the arguments; a null handle when there is no such class or the
  // constructor threw. Date takes (year, month 0-11, day, hours, minutes, seconds) in local time.
  ASObject NewObject(const char* className) const;
  ASObject NewObject(const char* className, const ASValueArray& arguments) const;

  // For objects of registered extension classes: the native instance that the class's
  // ConstructInstance returned (null for other objects, or once the instance was destructed).
  ASExtensionClass* GetNativeInstance() const;
  // Asks the engine to call the instance's OnUpdate once every frame, until StopUpdates. False
  // when the object is not an extension object. Requesting does not keep the object alive.
  bool RequestUpdates() const;
  void StopUpdates() const;

  // This handle gives up its reference and becomes null (other copies keep theirs).
  void Release() { m_Ref.reset(); }

  // Whether both handles refer to the same script object (two null handles are the same).
  bool IsSameObject(const ASObject& other) const;

 private:
  friend class ScriptEngine;
  friend class ASValue;

  explicit ASObject(std::shared_ptr<ObjectRef> ref) : m_Ref(std::move(ref)) {}
  // The engine of a valid handle, else null.
  ScriptEngine* Engine() const;
  // The script language's ToNumber and ToString of the object (NaN and "" when not valid).
  double ToNumber() const;
  std::string ToText() const;

  std::shared_ptr<ObjectRef> m_Ref;
};

}  // namespace stagecraft
}  // namespace ae

#endif  // ASOBJECT_H
