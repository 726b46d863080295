// VLFile: a file opened as a standard I/O stream, plus static operations on files and folders
// by path. Failures are reported through the boolean or count results only; nothing here logs.
#ifndef VLFILE_H
#define VLFILE_H

#include <stdint.h>
#include <stdio.h>

#include "VLString.h"

typedef int64_t vl_int64;

class VLFile {
 public:
  static constexpr char PATH_SEPERATOR = '/';

  VLFile();
  ~VLFile();  // closes an open stream
  VLFile(const VLFile&) = delete;
  VLFile& operator=(const VLFile&) = delete;

  // Closes any open stream, then opens filename with the fopen mode; true when it opened.
  bool Open(const char* filename, const char* mode);
  // Closes the stream if one is open. False when its buffered data could not be written or the
  // close failed; true when nothing was open.
  bool Close();
  // Bytes read or written: size unless end of file or an error came first (reads and writes
  // interrupted by a signal are retried). 0 when no stream is open or size is not positive.
  vl_int64 Read(void* buffer, vl_int64 size);
  vl_int64 Write(const void* buffer, vl_int64 size);
  // False when no stream is open or the buffered data could not be written.
  bool Flush();
  // Size of the open file (the position is kept); 0 when no stream is open.
  vl_int64 GetSize();
  // whence is SEEK_SET, SEEK_CUR or SEEK_END; false when no stream is open.
  bool Seek(vl_int64 offset, int whence);
  // Current position; -1 when no stream is open.
  vl_int64 Position();

  // Size of the file at filename; 0 when it cannot be opened.
  static vl_int64 GetSize(const char* filename);
  // True when filename can be opened for reading.
  static bool Exist(const char* filename);
  static bool Remove(const char* filename);
  static bool Rename(const char* oldname, const char* newname);
  // True when the path exists and is a directory.
  static bool FolderExist(const char* filename);
  // Creates the folder and every missing parent (mode 0755). True when the folder exists
  // afterwards; false when a part of the path exists but is not a folder, or cannot be made.
  static bool CreateFolder(const char* filename);
  // The path up to and including its last "/" ("a/b/c.jpg" gives "a/b/"); a path without "/"
  // gives the path followed by "/", and the empty path "./".
  static VLString GetFolderName(const char* path);
  // The text after the last "/", or the whole path when it has none.
  static VLString GetFileName(const char* path);
  // Removes the files of one folder whose names match the wildcard pattern after the last "/"
  // (fnmatch; a leading "*" also matches hidden files; "." and ".." are never touched). False
  // when the folder cannot be listed or a removal fails (the scan stops there).
  static bool RemoveWithWildcard(const char* filename);
  // Creates a new empty file "vlwsXXXXXX" (owner read and write only) in the folder of path and
  // returns its name; the empty string when no file could be created.
  static VLString CreateTempFileName(const char* path);
  // Copies src to dst (created or truncated). True only when every byte was read and written;
  // on false dst may hold part of the data. Null paths, and dst naming the same file as src
  // (which truncating would destroy), give false.
  static bool CopyFile(const char* src, const char* dst);

 private:
  FILE* m_File;
};

#endif  // VLFILE_H
