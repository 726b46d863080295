#include "VLAutoCharPtr.h"

VLAutoCharPtr::~VLAutoCharPtr() { delete[] m_Ptr; }

char* VLAutoCharPtr::release() {
  char* p = m_Ptr;
  m_Ptr = nullptr;
  return p;
}

void VLAutoCharPtr::reset(char* p) {
  if (p == m_Ptr) return;
  delete[] m_Ptr;
  m_Ptr = p;
}
