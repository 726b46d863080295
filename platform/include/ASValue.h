// ae::stagecraft::ASValue and ASValueArray: script values as plain C++ values.
//
// An ASValue is undefined, null, a boolean, a number, a string or an object. Primitive values
// are held by the ASValue itself (copies are independent, nothing to release); an object value
// holds an ASObject handle, with that handle's ownership rules (see ASObject.h). Any value can
// be made without the engine: ASValue v; v.SetInteger(3). Objects come from the engine
// (arguments, properties, ASObject::NewObject).
//
// Reading converts like the script language does: AsInteger is ToInt32 ("12" gives 12, 2.9
// gives 2, NaN and non-numeric text give 0), AsBoolean is ToBoolean, AsString is ToString
// ("1.5", "true", "[object Object]") except that undefined and null read as the empty string.
#ifndef ASVALUE_H
#define ASVALUE_H

#include <stddef.h>

#include <string>
#include <vector>

#include "AEString.h"
#include "ASObject.h"

namespace ae {
namespace stagecraft {

class ASValue {
 public:
  enum Kind { kUndefined, kNull, kBoolean, kNumber, kString, kObject };

  // The undefined value (the engine's empty value).
  ASValue() = default;

  Kind GetKind() const { return m_Kind; }
  bool IsUndefined() const { return m_Kind == kUndefined; }
  bool IsNull() const { return m_Kind == kNull; }
  bool IsBoolean() const { return m_Kind == kBoolean; }
  bool IsNumber() const { return m_Kind == kNumber; }
  bool IsString() const { return m_Kind == kString; }
  bool IsObject() const { return m_Kind == kObject; }

  int AsInteger() const;
  double AsNumber() const;
  bool AsBoolean() const;
  // The value as text, copied into a new AEString.
  AEString AsString() const;
  // The object (a null handle when the value is not an object).
  ASObject AsObject() const;

  void SetUndefined();
  void SetNull();
  void SetInteger(int value);
  void SetNumber(double value);
  void SetBoolean(bool value);
  // Copies text (null gives the empty string).
  void SetString(const char* text);
  void SetString(const char* bytes, size_t length);
  void SetString(const AEString& text) { SetString(text.CString(), text.Length()); }
  // Holds a copy of the handle (a null handle gives the undefined value).
  void SetObject(const ASObject& object);

 private:
  friend class ScriptEngine;

  Kind m_Kind = kUndefined;
  bool m_Boolean = false;
  double m_Number = 0;
  std::string m_String;
  ASObject m_Object;
};

// The arguments of a call: a list of values.
class ASValueArray {
 public:
  size_t Count() const { return m_Values.size(); }
  // Element index; the undefined value when index is not below Count().
  const ASValue& Get(size_t index) const;
  void Append(const ASValue& value) { m_Values.push_back(value); }

 private:
  std::vector<ASValue> m_Values;
};

}  // namespace stagecraft
}  // namespace ae

#endif  // ASVALUE_H
