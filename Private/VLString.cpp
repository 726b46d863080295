#include "VLString.h"

#include <string.h>

#include "VLAssert.h"

namespace {

// Longest text a string can hold: its length and capacity are 32-bit, and npos must never be a
// valid index.
const size_t kMaxLength = VLString::npos - 1;

// Bytes allocated for a text of n bytes: the smallest multiple of 8 above n.
size_t AllocationFor(size_t n) {
  VL_ASSERT(n <= kMaxLength);
  return (n + 8) & ~static_cast<size_t>(7);
}

// The capacity to allocate when a text of n bytes no longer fits into capacity: half as much
// again when that covers n, so that a text growing in small pieces (a character at a time) is
// copied only a logarithmic number of times; otherwise exactly what n needs.
size_t GrownCapacity(size_t capacity, size_t n) {
  size_t grown = (capacity / 2 > n / 3) ? capacity + capacity / 2 : n;
  return grown > kMaxLength ? kMaxLength : grown;
}

}  // namespace

struct VLString::Rep {
  uint32_t length;
  uint32_t capacity;  // allocated bytes minus one (the terminator's place)
  char* data;

  // Room for n bytes, holding the empty text.
  explicit Rep(size_t n)
      : length(0), capacity(static_cast<uint32_t>(AllocationFor(n) - 1)), data(new char[capacity + 1u]) {
    data[0] = 0;
  }
  ~Rep() { delete[] data; }
  Rep(const Rep&) = delete;
  Rep& operator=(const Rep&) = delete;

  // Copies n bytes (which fit the capacity, and may overlap data) to the start of the buffer.
  void Set(const char* buf, size_t n) {
    memmove(data, buf, n);
    data[n] = 0;
    length = static_cast<uint32_t>(n);
  }
};

VLString::VLString() : m_Rep(new Rep(0)) {}

VLString::VLString(const char* str) : m_Rep(nullptr) {
  VL_ASSERT(str != 0);
  size_t n = strlen(str);
  m_Rep = new Rep(n);
  m_Rep->Set(str, n);
}

VLString::VLString(const char* buf, size_t n) : m_Rep(nullptr) {
  VL_ASSERT(buf != 0);
  m_Rep = new Rep(n);
  m_Rep->Set(buf, n);
}

VLString::VLString(const VLString& other) : m_Rep(new Rep(other.length())) {
  m_Rep->Set(other.c_str(), other.length());
}

VLString::~VLString() { delete m_Rep; }

const char* VLString::c_str() const { return m_Rep->data; }

size_t VLString::length() const { return m_Rep->length; }

size_t VLString::capacity() const { return m_Rep->capacity; }

char& VLString::operator[](size_t idx) {
  VL_ASSERT(idx < length());
  return m_Rep->data[idx];
}

const char& VLString::operator[](size_t idx) const {
  VL_ASSERT(idx < length());
  return m_Rep->data[idx];
}

size_t VLString::find(char ch, size_t pos) const {
  if (pos >= length()) return npos;
  const void* hit = memchr(m_Rep->data + pos, ch, length() - pos);
  return hit ? static_cast<const char*>(hit) - m_Rep->data : npos;
}

VLString VLString::substr(size_t pos, size_t n) const {
  if (pos >= length()) return VLString();
  size_t rest = length() - pos;
  return VLString(m_Rep->data + pos, n < rest ? n : rest);
}

VLString& VLString::assign(const char* buf, size_t n) {
  VL_ASSERT(buf != 0);
  size_t cap = m_Rep->capacity;
  if (n > cap) {
    Rep* fresh = new Rep(GrownCapacity(cap, n));
    fresh->Set(buf, n);  // buf may still point into the old buffer: copy before freeing it
    delete m_Rep;
    m_Rep = fresh;
    return *this;
  }
  m_Rep->Set(buf, n);
  return *this;
}

VLString& VLString::append(const char* buf, size_t n) {
  if (n == 0) return *this;
  VL_ASSERT(buf != 0);
  size_t oldLength = length();
  VL_ASSERT(n <= kMaxLength - oldLength);
  size_t newLength = oldLength + n;
  if (newLength > m_Rep->capacity) {
    Rep* fresh = new Rep(GrownCapacity(m_Rep->capacity, newLength));
    memcpy(fresh->data, m_Rep->data, oldLength);
    memcpy(fresh->data + oldLength, buf, n);  // before the old buffer (maybe holding buf) goes
    delete m_Rep;
    m_Rep = fresh;
  } else {
    memmove(m_Rep->data + oldLength, buf, n);
  }
  m_Rep->data[newLength] = 0;
  m_Rep->length = static_cast<uint32_t>(newLength);
  return *this;
}

VLString& VLString::trim() {
  if (empty()) return *this;
  char* data = m_Rep->data;
  size_t first = 0;
  while (first < length() && data[first] == ' ') ++first;
  for (size_t i = length(); i > first && data[i - 1] == ' '; --i) data[i - 1] = 0;
  return assign(data + first, strlen(data + first));
}

void VLString::swap(VLString& other) {
  Rep* mine = m_Rep;
  m_Rep = other.m_Rep;
  other.m_Rep = mine;
}

VLString& VLString::operator=(const char* buf) {
  VL_ASSERT(buf != 0);
  return assign(buf, strlen(buf));
}

VLString& VLString::operator=(const VLString& other) {
  if (this != &other) assign(other.c_str(), other.length());
  return *this;
}

VLString& VLString::operator+=(const char* buf) {
  VL_ASSERT(buf != 0);
  return append(buf, strlen(buf));
}

VLString& VLString::operator+=(char ch) { return append(&ch, 1); }

VLString& VLString::operator+=(const VLString& other) { return append(other.c_str(), other.length()); }

bool operator==(const VLString& a, const VLString& b) {
  return a.length() == b.length() && memcmp(a.c_str(), b.c_str(), a.length()) == 0;
}

bool operator==(const VLString& a, const char* b) {
  VL_ASSERT(b != 0);
  return strcmp(a.c_str(), b) == 0;
}

bool operator==(const char* b, const VLString& a) { return a == b; }

bool operator!=(const VLString& a, const VLString& b) { return !(a == b); }

bool operator!=(const VLString& a, const char* b) { return !(a == b); }

bool operator!=(const char* b, const VLString& a) { return !(a == b); }

bool operator<(const VLString& a, const VLString& b) { return strcmp(a.c_str(), b.c_str()) < 0; }

bool operator>(const VLString& a, const VLString& b) { return b < a; }

bool operator<=(const VLString& a, const VLString& b) { return !(b < a); }

bool operator>=(const VLString& a, const VLString& b) { return !(a < b); }

VLString operator+(const VLString& a, const VLString& b) {
  VLString sum(a);
  sum += b;
  return sum;
}

VLString operator+(const VLString& a, const char* b) {
  VL_ASSERT(b != 0);
  VLString sum(a);
  sum += b;
  return sum;
}

VLString operator+(const char* a, const VLString& b) {
  VL_ASSERT(a != 0);
  VLString sum(a);
  sum += b;
  return sum;
}
