// ae::stagecraft::ASExtensionClass: base of the native instances of script extension classes,
// the method table entry, and the descriptor that registers a class with the stage.
//
// A class is described by five functions (see ASExtensionClassDescriptor). The movie constructs
// objects of the class by its class id; the engine then calls ConstructInstance and keeps the
// returned native instance bound to the script object (ASObject::GetNativeInstance). The entries
// of the method table become the script object's methods: calling one calls the bound member
// function with the window, the script object, the arguments and the value to return (undefined
// unless the method sets it). When the script object is collected, or the engine shuts down,
// the engine calls DestructInstance, which deletes the native instance.
#ifndef ASEXTENSIONCLASS_H
#define ASEXTENSIONCLASS_H

#include "AEArray.h"
#include "ASObject.h"
#include "ASValue.h"
#include "StageWindow.h"

namespace ae {
namespace stagecraft {

class ASExtensionClass {
 public:
  // The types of the method signature, by their short names also in derived classes.
  typedef ae::stagecraft::StageWindow StageWindow;
  typedef ae::stagecraft::ASObject ASObject;
  typedef ae::stagecraft::ASValue ASValue;
  typedef ae::stagecraft::ASValueArray ASValueArray;

  // The common signature of extension methods.
  typedef void (ASExtensionClass::*MethodFunction)(StageWindow* window, ASObject& object,
                                                   ASValueArray& arguments, ASValue& result);

  // One method table entry: the script name (a static string) and the member function.
  struct Method {
    const char* name;
    MethodFunction function;

    // An entry for a member function of a derived class C.
    template <class C>
    static constexpr Method Bind(const char* name,
                                 void (C::*function)(StageWindow*, ASObject&, ASValueArray&, ASValue&)) {
      return Method{name, static_cast<MethodFunction>(function)};
    }
  };

  // Called by the engine once every frame while updates are requested for the object
  // (ASObject::RequestUpdates). Does nothing unless a class overrides it.
  virtual void OnUpdate(StageWindow* window, ASObject& object) {}
  virtual ~ASExtensionClass() {}
};

// The five class functions that describe an extension class to the stage.
struct ASExtensionClassDescriptor {
  // The class id by which the movie names the class (a static string).
  const char* (*GetClassName)();
  // Appends the class's method entries at the end of table.
  void (*GetMethods)(AEArray<ASExtensionClass::Method>& table);
  bool (*FiresEvents)();
  // Makes the native instance for a new script object (null when that is impossible).
  ASExtensionClass* (*ConstructInstance)(StageWindow* window, ASObject& object,
                                         ASValueArray& arguments);
  // Deletes the native instance bound to the script object.
  void (*DestructInstance)(StageWindow* window, ASObject& object);
};

// The descriptor of a class C that declares the five class functions as static members.
template <class C>
ASExtensionClassDescriptor DescribeExtensionClass() {
  return ASExtensionClassDescriptor{&C::GetClassName, &C::GetMethods, &C::FiresEvents,
                                    &C::ConstructInstance, &C::DestructInstance};
}

}  // namespace stagecraft
}  // namespace ae

#endif  // ASEXTENSIONCLASS_H
