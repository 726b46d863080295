// Platform logging service (stand-in). Messages are written to named areas at numeric levels;
// only messages of active areas reach the current target (the console by default, or a file).
// Each written line shows the area name and the level: "[<area>:<level>] <message>".
#ifndef VL_LOG_H
#define VL_LOG_H

#include <stddef.h>
#include <stdint.h>

#ifdef __cplusplus
extern "C" {
#endif

// Registers (or looks up) the area called name and writes its id (>= 0) to *id. Returns 0 on
// success, non-zero when name or id is null or the area table is full. Areas start inactive.
int VL_LogRegisterArea(const char* name, int* id);

// Activates (on != 0) or deactivates an area. Returns 0, or -1 for an unknown id.
int VL_LogActivateArea(int id, int on);

// A target is described by two words, filled by the two getters and installed by VL_LogSetTarget.
int VL_LogGetConsoleTarget(uintptr_t* t1, uintptr_t* t2);
// Opens (appending, created when missing) the log file path. Returns 0 on success, 1 when path
// is null or empty, 2 when the file cannot be opened. The last two arguments are accepted and
// not used by the stand-in.
int VL_LogGetFileTarget(const char* path, uintptr_t* t1, uintptr_t* t2, int reserved, int flags);
// Makes the described target current. Returns 0, or -1 for a description no getter produced.
int VL_LogSetTarget(uintptr_t t1, uintptr_t t2);

// Formats and writes one message to an area at a level. A message without a final line end gets
// one. Returns 0 when written, 1 when the area is inactive or unknown.
int VL_LogOutput(int id, int level, const char* format, ...)
#ifdef __GNUC__
    __attribute__((format(printf, 3, 4)))
#endif
    ;
// Writes len raw bytes (which may hold any byte value) as one message.
int VL_LogOutputwithLen(int id, int level, const char* data, int len);

// Stand-in only, for tests: every message that reaches a target is also handed to the observer
// (area name, level, message bytes without the added line end). A null fn removes it.
typedef void (*VL_LogObserver)(void* ctx, const char* area, int level, const char* text, size_t len);
void VL_LogSetObserver(VL_LogObserver fn, void* ctx);
// Stand-in only, for tests: whether an area is active (0 for an unknown id).
int VL_LogIsAreaActive(int id);

#ifdef __cplusplus
}
#endif

#endif  // VL_LOG_H
