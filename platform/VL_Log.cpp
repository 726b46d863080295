// Stand-in for the device's logging service: a fixed table of named areas, a console target
// (standard error) and file targets, one lock over all of it.
#include "VL_Log.h"

#include <cstdarg>
#include <cstdio>
#include <cstring>
#include <mutex>
#include <string>
#include <vector>

namespace {

struct Area {
  std::string name;
  bool active = false;
};

// A target: kind 1 = console, kind 2 = file (t2 is the FILE*).
const uintptr_t kConsoleTarget = 1;
const uintptr_t kFileTarget = 2;
const size_t kMaxAreas = 256;

struct LogState {
  std::mutex lock;
  std::vector<Area> areas;
  uintptr_t kind = kConsoleTarget;
  FILE* file = nullptr;
  std::vector<FILE*> openFiles;  // every file handed out by VL_LogGetFileTarget
  VL_LogObserver observer = nullptr;
  void* observerCtx = nullptr;
};

LogState& State() {
  static LogState* state = new LogState;  // lives until exit: loggers run during static teardown
  return *state;
}

int Write(int id, int level, const char* text, size_t len) {
  LogState& s = State();
  std::lock_guard<std::mutex> guard(s.lock);
  if (id < 0 || static_cast<size_t>(id) >= s.areas.size() || !s.areas[id].active) return 1;
  const std::string& area = s.areas[id].name;
  FILE* out = (s.kind == kFileTarget && s.file) ? s.file : stderr;
  size_t body = (len > 0 && text[len - 1] == '\n') ? len - 1 : len;
  fprintf(out, "[%s:%d] ", area.c_str(), level);
  fwrite(text, 1, body, out);
  fputc('\n', out);
  fflush(out);
  if (s.observer) s.observer(s.observerCtx, area.c_str(), level, text, body);
  return 0;
}

}  // namespace

extern "C" {

int VL_LogRegisterArea(const char* name, int* id) {
  if (!name || !id) return -1;
  LogState& s = State();
  std::lock_guard<std::mutex> guard(s.lock);
  for (size_t i = 0; i < s.areas.size(); ++i) {
    if (s.areas[i].name == name) {
      *id = static_cast<int>(i);
      return 0;
    }
  }
  if (s.areas.size() >= kMaxAreas) return -1;
  s.areas.push_back(Area{name, false});
  *id = static_cast<int>(s.areas.size() - 1);
  return 0;
}

int VL_LogActivateArea(int id, int on) {
  LogState& s = State();
  std::lock_guard<std::mutex> guard(s.lock);
  if (id < 0 || static_cast<size_t>(id) >= s.areas.size()) return -1;
  s.areas[id].active = on != 0;
  return 0;
}

int VL_LogIsAreaActive(int id) {
  LogState& s = State();
  std::lock_guard<std::mutex> guard(s.lock);
  if (id < 0 || static_cast<size_t>(id) >= s.areas.size()) return 0;
  return s.areas[id].active ? 1 : 0;
}

int VL_LogGetConsoleTarget(uintptr_t* t1, uintptr_t* t2) {
  if (t1) *t1 = kConsoleTarget;
  if (t2) *t2 = 0;
  return 0;
}

int VL_LogGetFileTarget(const char* path, uintptr_t* t1, uintptr_t* t2, int, int) {
  if (!path || !*path || !t1 || !t2) return 1;
  FILE* f = fopen(path, "a");
  if (!f) return 2;
  LogState& s = State();
  std::lock_guard<std::mutex> guard(s.lock);
  s.openFiles.push_back(f);
  *t1 = kFileTarget;
  *t2 = reinterpret_cast<uintptr_t>(f);
  return 0;
}

int VL_LogSetTarget(uintptr_t t1, uintptr_t t2) {
  LogState& s = State();
  std::lock_guard<std::mutex> guard(s.lock);
  if (t1 == kConsoleTarget) {
    s.kind = kConsoleTarget;
    s.file = nullptr;
    return 0;
  }
  if (t1 == kFileTarget) {
    for (FILE* f : s.openFiles) {
      if (reinterpret_cast<uintptr_t>(f) == t2) {
        s.kind = kFileTarget;
        s.file = f;
        return 0;
      }
    }
  }
  return -1;
}

int VL_LogOutput(int id, int level, const char* format, ...) {
  if (!format) return 1;
  char stackBuf[1024];
  va_list ap;
  va_start(ap, format);
  int n = vsnprintf(stackBuf, sizeof stackBuf, format, ap);
  va_end(ap);
  if (n < 0) return 1;
  if (static_cast<size_t>(n) < sizeof stackBuf) return Write(id, level, stackBuf, n);
  std::string big(static_cast<size_t>(n) + 1, '\0');
  va_start(ap, format);
  vsnprintf(&big[0], big.size(), format, ap);
  va_end(ap);
  return Write(id, level, big.data(), static_cast<size_t>(n));
}

int VL_LogOutputwithLen(int id, int level, const char* data, int len) {
  if (!data || len < 0) return 1;
  return Write(id, level, data, static_cast<size_t>(len));
}

void VL_LogSetObserver(VL_LogObserver fn, void* ctx) {
  LogState& s = State();
  std::lock_guard<std::mutex> guard(s.lock);
  s.observer = fn;
  s.observerCtx = ctx;
}

}  // extern "C"
