// VLString: the library's byte string. The text lives in one heap block that always ends in a
// 0 byte, so c_str() can be handed to any C function; the bytes before it may themselves be 0
// (a string built from a buffer and a length keeps them, and length() counts them).
//
// Allocation: a string of length n occupies the smallest multiple of 8 bytes above n (capacity is
// that size minus one). assign() and append() grow by half of the old capacity when that is
// enough, else to the requested size, so that a text built a character at a time costs time in
// proportion to its length.
#ifndef VLSTRING_H
#define VLSTRING_H

#include <stddef.h>
#include <stdint.h>

class VLString {
 public:
  // Not-found result of find(); as a count for substr() it means "up to the end".
  static constexpr size_t npos = 0xFFFFFFFFu;

  VLString();                              // empty, capacity 7
  VLString(const char* str);               // copies strlen(str) bytes
  VLString(const char* buf, size_t n);     // copies exactly n bytes, 0 bytes included
  VLString(const VLString& other);         // allocation sized to other's length
  ~VLString();

  const char* c_str() const;
  size_t length() const;
  size_t size() const { return length(); }
  bool empty() const { return length() == 0; }
  size_t capacity() const;

  char& operator[](size_t idx);
  const char& operator[](size_t idx) const;

  // Index of the first ch at or after pos, or npos.
  size_t find(char ch, size_t pos = 0) const;
  // The min(n, length() - pos) bytes from pos; empty when pos is not below length().
  VLString substr(size_t pos, size_t n = npos) const;

  // Replaces the content with n bytes of buf (which may point into this string).
  VLString& assign(const char* buf, size_t n);
  // Adds n bytes of buf (which may point into this string).
  VLString& append(const char* buf, size_t n);
  // Removes leading and trailing spaces (byte 0x20 only). The result ends at the first 0 byte
  // after the leading spaces: a string holding a 0 byte is cut there.
  VLString& trim();
  void swap(VLString& other);

  VLString& operator=(const char* buf);
  VLString& operator=(const VLString& other);
  VLString& operator+=(const char* buf);
  VLString& operator+=(char ch);
  VLString& operator+=(const VLString& other);

 private:
  struct Rep;

  Rep* m_Rep;
};

// Equality of two VLStrings compares all length() bytes, 0 bytes included. Against a C text it
// compares up to the first 0 byte (strcmp of c_str()).
bool operator==(const VLString& a, const VLString& b);
bool operator==(const VLString& a, const char* b);
bool operator==(const char* b, const VLString& a);
bool operator!=(const VLString& a, const VLString& b);
bool operator!=(const VLString& a, const char* b);
bool operator!=(const char* b, const VLString& a);

// Ordering is strcmp of the two c_str().
bool operator<(const VLString& a, const VLString& b);
bool operator>(const VLString& a, const VLString& b);
bool operator<=(const VLString& a, const VLString& b);
bool operator>=(const VLString& a, const VLString& b);

VLString operator+(const VLString& a, const VLString& b);
VLString operator+(const VLString& a, const char* b);
VLString operator+(const char* a, const VLString& b);

#endif  // VLSTRING_H
