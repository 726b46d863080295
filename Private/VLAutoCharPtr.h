// VLAutoCharPtr: owns one character array made with new[] (such as the texts VLUtilities::StrDup
// hands out) and releases it with delete[] when it goes out of scope.
#ifndef VLAUTOCHARPTR_H
#define VLAUTOCHARPTR_H

class VLAutoCharPtr {
 public:
  explicit VLAutoCharPtr(char* p = nullptr) : m_Ptr(p) {}
  ~VLAutoCharPtr();
  VLAutoCharPtr(const VLAutoCharPtr&) = delete;
  VLAutoCharPtr& operator=(const VLAutoCharPtr&) = delete;

  char* get() const { return m_Ptr; }
  // Gives up ownership and returns the array.
  char* release();
  // Releases the owned array and takes p.
  void reset(char* p = nullptr);

 private:
  char* m_Ptr;
};

#endif  // VLAUTOCHARPTR_H
