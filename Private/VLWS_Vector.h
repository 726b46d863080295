// VLWS_Vector: the growable array behind VLWS_IntVector and VLWS_BoolVector, with the interface
// of the standard vector for plain element types. Differences: it throws nothing (a size beyond
// MaxSize is a precondition failure), at() checks no range (like operator[]), a full array grows
// to twice its size (1 when empty), and pop_back() on an empty array does nothing.
#ifndef VLWS_VECTOR_H
#define VLWS_VECTOR_H

#include <stddef.h>
#include <string.h>

#include <functional>
#include <new>
#include <type_traits>
#include <utility>

#include "VLAssert.h"

template <class T, size_t MaxSize>
class VLWS_Vector {
  static_assert(std::is_trivially_copyable<T>::value, "elements are moved as bytes");

 public:
  typedef T value_type;
  typedef size_t size_type;
  typedef T& reference;
  typedef const T& const_reference;
  typedef T* iterator;
  typedef const T* const_iterator;

  VLWS_Vector() : m_Begin(nullptr), m_End(nullptr), m_Capacity(nullptr) {}
  explicit VLWS_Vector(size_type n) : VLWS_Vector() { resize(n); }
  VLWS_Vector(size_type n, const T& value) : VLWS_Vector() { insert(end(), n, value); }
  VLWS_Vector(const T* first, const T* last) : VLWS_Vector() { insert(end(), first, last); }
  VLWS_Vector(const VLWS_Vector& other) : VLWS_Vector(other.begin(), other.end()) {}
  VLWS_Vector(VLWS_Vector&& other) noexcept : VLWS_Vector() { swap(other); }
  ~VLWS_Vector() { ::operator delete(m_Begin); }

  VLWS_Vector& operator=(const VLWS_Vector& other) {
    if (this != &other) {
      clear();
      insert(end(), other.begin(), other.end());
    }
    return *this;
  }
  VLWS_Vector& operator=(VLWS_Vector&& other) noexcept {
    swap(other);
    return *this;
  }

  iterator begin() { return m_Begin; }
  const_iterator begin() const { return m_Begin; }
  iterator end() { return m_End; }
  const_iterator end() const { return m_End; }

  size_type size() const { return static_cast<size_type>(m_End - m_Begin); }
  size_type capacity() const { return static_cast<size_type>(m_Capacity - m_Begin); }
  bool empty() const { return m_Begin == m_End; }
  static constexpr size_type max_size() { return MaxSize; }

  reference operator[](size_type i) { return m_Begin[i]; }
  const_reference operator[](size_type i) const { return m_Begin[i]; }
  reference at(size_type i) { return m_Begin[i]; }
  const_reference at(size_type i) const { return m_Begin[i]; }
  reference front() { return *m_Begin; }
  const_reference front() const { return *m_Begin; }
  reference back() { return m_End[-1]; }
  const_reference back() const { return m_End[-1]; }

  void push_back() { push_back(T()); }
  void push_back(const T& value) {
    if (m_End != m_Capacity) {
      *m_End++ = value;
    } else {
      insert(end(), 1, value);
    }
  }
  void pop_back() {
    if (m_End != m_Begin) --m_End;
  }

  iterator insert(iterator pos, const T& value) { return insert(pos, 1, value); }
  // Returns the first inserted element.
  iterator insert(iterator pos, size_type n, const T& value) {
    const T copy = value;  // value may be an element that the gap moves
    T* gap = OpenGap(pos, n);
    for (size_type i = 0; i < n; ++i) gap[i] = copy;
    return gap;
  }
  iterator insert(iterator pos, const T* first, const T* last) {
    size_type n = static_cast<size_type>(last - first);
    std::less<const T*> before;
    if (n != 0 && !before(first, m_Begin) && before(first, m_Capacity)) {
      VLWS_Vector source(first, last);  // a range inside this array: copy it out first
      return insert(pos, source.begin(), source.end());
    }
    T* gap = OpenGap(pos, n);
    Copy(gap, first, n);
    return gap;
  }

  // Both return the element after the removed ones.
  iterator erase(iterator pos) { return erase(pos, pos + 1); }
  iterator erase(iterator first, iterator last) {
    Copy(first, last, static_cast<size_type>(m_End - last));
    m_End -= last - first;
    return first;
  }

  void assign(size_type n, const T& value) {
    const T copy = value;
    clear();
    insert(end(), n, copy);
  }
  void resize(size_type n) { resize(n, T()); }
  void resize(size_type n, const T& value) {
    if (n <= size()) {
      m_End = m_Begin + n;
    } else {
      insert(end(), n - size(), value);
    }
  }
  // Makes room for exactly n elements when there is less.
  void reserve(size_type n) {
    if (n > capacity()) Reallocate(n, end(), 0);
  }
  void clear() { m_End = m_Begin; }
  void swap(VLWS_Vector& other) {
    std::swap(m_Begin, other.m_Begin);
    std::swap(m_End, other.m_End);
    std::swap(m_Capacity, other.m_Capacity);
  }

 private:
  // Copies n elements; the ranges may overlap, and may be null when n is 0.
  static void Copy(T* to, const T* from, size_type n) {
    if (n != 0) memmove(to, from, n * sizeof(T));
  }

  // Makes n uninitialised places at pos (growing the storage when it is too small) and returns
  // the first of them. Kept out of line: the call costs nothing next to the copying, and inlined
  // into a constructor GCC warns about null and out-of-bounds copies on paths that cannot run.
  __attribute__((noinline)) T* OpenGap(T* pos, size_type n) {
    size_type index = static_cast<size_type>(pos - m_Begin);
    size_type count = size();
    VL_ASSERT(n <= MaxSize - count);
    if (count + n > capacity()) {
      size_type grown = count == 0 ? 1 : (count <= MaxSize / 2 ? 2 * count : MaxSize);
      Reallocate(grown < count + n ? count + n : grown, pos, n);
    } else {
      Copy(pos + n, pos, count - index);
      m_End += n;
    }
    return m_Begin + index;
  }

  // Moves the elements to new storage for newCapacity elements, leaving n places free at pos.
  void Reallocate(size_type newCapacity, T* pos, size_type n) {
    T* storage = static_cast<T*>(::operator new(newCapacity * sizeof(T)));
    size_type head = static_cast<size_type>(pos - m_Begin);
    size_type tail = static_cast<size_type>(m_End - pos);
    Copy(storage, m_Begin, head);
    Copy(storage + head + n, pos, tail);
    ::operator delete(m_Begin);
    m_Begin = storage;
    m_End = storage + head + n + tail;
    m_Capacity = storage + newCapacity;
  }

  T* m_Begin;
  T* m_End;       // end of the used part
  T* m_Capacity;  // end of the storage
};

#endif  // VLWS_VECTOR_H
