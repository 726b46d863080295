// Named error values of the engine's SDK: a name of at most 31 characters and an integer code.
#ifndef AEERROR_H
#define AEERROR_H

struct AEError {
  char name[32];
  int code;
};

inline bool operator==(const AEError& a, const AEError& b) { return a.code == b.code; }
inline bool operator!=(const AEError& a, const AEError& b) { return a.code != b.code; }

inline constexpr AEError AEError_OK = {"AEError_OK", 0};
inline constexpr AEError AEError_NoMemory = {"AEError_NoMemory", 1};
inline constexpr AEError AEError_Timeout = {"AEError_Timeout", 2};
inline constexpr AEError AEError_Generic = {"AEError_Generic", 3};
inline constexpr AEError AEError_NotFound = {"AEError_NotFound", 4};
inline constexpr AEError AEError_Usage = {"AEError_Usage", 5};
inline constexpr AEError AEError_InvalidParameters = {"AEError_InvalidParameters", 6};

#endif  // AEERROR_H
