// VL_ASSERT: the library's precondition check. A failed check is reported to the kernel with the
// condition exactly as written, the file and the line, and then stops the process. It stays in
// every build type (NDEBUG does not remove it): continuing past a broken precondition would only
// move the damage somewhere harder to find.
#ifndef VLASSERT_H
#define VLASSERT_H

#include <cstdlib>

#include "IAEKernel.h"

[[noreturn]] inline void VLAssertFailed(const char* file, int line, const char* condition) {
  IAEKernel::GetKernel()->ReportFailedCheck(file, line, condition);
  std::abort();
}

#define VL_ASSERT(cond) ((cond) ? static_cast<void>(0) : VLAssertFailed(__FILE__, __LINE__, #cond))

#endif  // VLASSERT_H
