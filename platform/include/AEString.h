// AEString: the engine SDK's byte string, an AEArray of bytes whose size counts the terminating
// NUL; an empty string has size 0 and no storage. The bytes may include NUL bytes; Length()
// counts the bytes before the terminating one.
#ifndef AESTRING_H
#define AESTRING_H

#include <string.h>

#include "AEArray.h"

class AEString : private AEArray<char> {
 public:
  AEString() = default;
  // Copies text (null is the empty string).
  explicit AEString(const char* text) { Set(text); }
  AEString(const char* bytes, size_t length) { Set(bytes, length); }

  // Replace the contents with a copy. False when memory is exhausted (the string is then
  // unchanged).
  bool Set(const char* text) { return Set(text, text ? strlen(text) : 0); }
  bool Set(const char* bytes, size_t length) {
    AEArray<char> copy(length > 0 ? length + 1 : 0);
    if (copy.Capacity() < (length > 0 ? length + 1 : 0)) return false;
    if (length > 0) {
      copy.Append(bytes, length);
      copy.Append('\0');
    }
    AEArray<char>::operator=(std::move(copy));
    return true;
  }

  // The bytes with their terminating NUL; "" for the empty string. Valid until the next change.
  const char* CString() const { return IsEmpty() ? "" : &(*this)[0]; }
  size_t Length() const { return IsEmpty() ? 0 : Size() - 1; }

  using AEArray<char>::Size;
  using AEArray<char>::Capacity;
  using AEArray<char>::IsEmpty;

  bool operator==(const AEString& other) const {
    return Length() == other.Length() && memcmp(CString(), other.CString(), Length()) == 0;
  }
  bool operator!=(const AEString& other) const { return !(*this == other); }
};

#endif  // AESTRING_H
