// AEArray<T>: the engine SDK's growable array. Its memory comes from the kernel (IAEKernel).
//
// Growth: when an insertion needs more room than the capacity, the new capacity is the least
// multiple of twice the old capacity that exceeds the new size, or exactly the new size when the
// capacity was 0. Insert shifts the tail up; Remove closes the gap. The array owns its elements;
// copies are deep. Indexing outside [0, Size()) is a failed check that stops the process.
//
// Not thread-safe: an array is used by one thread at a time.
#ifndef AEARRAY_H
#define AEARRAY_H

#include <stddef.h>
#include <stdlib.h>

#include <new>
#include <utility>

#include "IAEKernel.h"

template <class T>
class AEArray {
 public:
  // Reserves initialCapacity elements (capacity stays 0 when that memory is not available).
  explicit AEArray(size_t initialCapacity = 0) {
    if (initialCapacity > 0) Reallocate(initialCapacity);
  }
  AEArray(const AEArray& other) { CopyFrom(other); }
  AEArray& operator=(const AEArray& other) {
    if (this != &other) {
      Release();
      CopyFrom(other);
    }
    return *this;
  }
  AEArray(AEArray&& other) noexcept { TakeFrom(other); }
  AEArray& operator=(AEArray&& other) noexcept {
    if (this != &other) {
      Release();
      TakeFrom(other);
    }
    return *this;
  }
  ~AEArray() { Release(); }

  size_t Size() const { return m_Size; }
  size_t Capacity() const { return m_Capacity; }
  bool IsEmpty() const { return m_Size == 0; }

  T& operator[](size_t index) {
    CheckIndex(index);
    return m_Data[index];
  }
  const T& operator[](size_t index) const {
    CheckIndex(index);
    return m_Data[index];
  }

  // Inserts a copy of value before position index (index == Size() appends). False when index is
  // beyond Size() or memory is exhausted; the array is then unchanged.
  bool Insert(size_t index, const T& value) {
    if (index > m_Size) return false;
    T copy(value);  // value may be an element of this array, which growing moves
    if (m_Size == m_Capacity && !Reallocate(GrownCapacity(m_Capacity, m_Size + 1))) return false;
    new (m_Data + m_Size) T(std::move(copy));
    for (size_t i = m_Size; i > index; --i) std::swap(m_Data[i], m_Data[i - 1]);
    ++m_Size;
    return true;
  }

  bool Append(const T& value) { return Insert(m_Size, value); }

  // Appends count elements in order. False when memory ran out (the ones appended so far stay).
  bool Append(const T* values, size_t count) {
    for (size_t i = 0; i < count; ++i) {
      if (!Append(values[i])) return false;
    }
    return true;
  }

  // Removes the element at index. False when index is not below Size().
  bool Remove(size_t index) {
    if (index >= m_Size) return false;
    for (size_t i = index; i + 1 < m_Size; ++i) m_Data[i] = std::move(m_Data[i + 1]);
    m_Data[--m_Size].~T();
    return true;
  }

  // Destroys the elements and keeps the capacity.
  void Clear() {
    while (m_Size > 0) m_Data[--m_Size].~T();
  }

  // The capacity that growing from capacity to hold newSize elements allocates.
  static size_t GrownCapacity(size_t capacity, size_t newSize) {
    if (capacity == 0) return newSize;
    size_t step = 2 * capacity;
    return (newSize / step + 1) * step;
  }

 private:
  void CheckIndex(size_t index) const {
    if (index >= m_Size) {
      IAEKernel::GetKernel()->ReportFailedCheck(__FILE__, __LINE__, "index < Size()");
      abort();
    }
  }

  bool Reallocate(size_t capacity) {
    if (capacity > static_cast<size_t>(-1) / sizeof(T)) return false;
    IAEKernel* kernel = IAEKernel::GetKernel();
    T* data = static_cast<T*>(kernel->Allocate(capacity * sizeof(T), __FILE__, __LINE__));
    if (!data) return false;
    for (size_t i = 0; i < m_Size; ++i) {
      new (data + i) T(std::move(m_Data[i]));
      m_Data[i].~T();
    }
    if (m_Data) kernel->Free(m_Data);
    m_Data = data;
    m_Capacity = capacity;
    return true;
  }

  void CopyFrom(const AEArray& other) {
    if (other.m_Size == 0 || !Reallocate(other.m_Size)) return;
    for (size_t i = 0; i < other.m_Size; ++i) new (m_Data + i) T(other.m_Data[i]);
    m_Size = other.m_Size;
  }

  void TakeFrom(AEArray& other) {
    std::swap(m_Data, other.m_Data);
    std::swap(m_Size, other.m_Size);
    std::swap(m_Capacity, other.m_Capacity);
  }

  void Release() {
    Clear();
    if (m_Data) IAEKernel::GetKernel()->Free(m_Data);
    m_Data = nullptr;
    m_Capacity = 0;
  }

  T* m_Data = nullptr;
  size_t m_Size = 0;
  size_t m_Capacity = 0;
};

#endif  // AEARRAY_H
