#include "VLFile.h"

#include <dirent.h>
#include <errno.h>
#include <fcntl.h>
#include <fnmatch.h>
#include <string.h>
#include <sys/stat.h>
#include <sys/types.h>
#include <unistd.h>

#include "VLAssert.h"

namespace {

// Repeats step(done, missing), a read or write of up to `missing` bytes behind the `done` ones
// that returns the count it moved, until size bytes are moved, the stream ends (when stopAtEnd),
// or a step moves nothing for another reason than an interrupting signal.
template <class Step>
vl_int64 Repeat(FILE* file, vl_int64 size, bool stopAtEnd, Step step) {
  vl_int64 total = 0;
  while (total < size) {
    errno = 0;
    size_t moved = step(static_cast<size_t>(total), static_cast<size_t>(size - total));
    total += static_cast<vl_int64>(moved);
    if (stopAtEnd && feof(file)) break;
    if (moved == 0) {
      if (!ferror(file) || errno != EINTR) break;
      clearerr(file);
    }
  }
  return total;
}

// Makes sure path is a folder: true when it is one or was made one (also by a concurrent
// creator), false when it is something else or cannot be created.
bool MakeFolder(const char* path) {
  if (VLFile::FolderExist(path)) return true;
  struct stat info;
  if (stat(path, &info) == 0) return false;
  return mkdir(path, 0755) == 0 || (errno == EEXIST && VLFile::FolderExist(path));
}

}  // namespace

VLFile::VLFile() : m_File(nullptr) {}

VLFile::~VLFile() { Close(); }

bool VLFile::Open(const char* filename, const char* mode) {
  VL_ASSERT(filename != 0);
  VL_ASSERT(mode != 0);
  Close();
  m_File = fopen(filename, mode);
  return m_File != nullptr;
}

bool VLFile::Close() {
  if (!m_File) return true;
  bool closed = fclose(m_File) == 0;
  m_File = nullptr;
  return closed;
}

vl_int64 VLFile::Read(void* buffer, vl_int64 size) {
  VL_ASSERT(buffer != 0);
  if (!m_File || size <= 0) return 0;
  char* bytes = static_cast<char*>(buffer);
  return Repeat(m_File, size, true,
                [&](size_t done, size_t missing) { return fread(bytes + done, 1, missing, m_File); });
}

vl_int64 VLFile::Write(const void* buffer, vl_int64 size) {
  VL_ASSERT(buffer != 0);
  if (!m_File || size <= 0) return 0;
  const char* bytes = static_cast<const char*>(buffer);
  return Repeat(m_File, size, false,
                [&](size_t done, size_t missing) { return fwrite(bytes + done, 1, missing, m_File); });
}

bool VLFile::Flush() { return m_File && fflush(m_File) == 0; }

vl_int64 VLFile::GetSize() {
  if (!m_File) return 0;
  off_t position = ftello(m_File);
  if (position < 0 || fseeko(m_File, 0, SEEK_END) != 0) return 0;
  off_t size = ftello(m_File);
  fseeko(m_File, position, SEEK_SET);
  return size < 0 ? 0 : size;
}

bool VLFile::Seek(vl_int64 offset, int whence) {
  return m_File && fseeko(m_File, static_cast<off_t>(offset), whence) == 0;
}

vl_int64 VLFile::Position() { return m_File ? ftello(m_File) : -1; }

vl_int64 VLFile::GetSize(const char* filename) {
  VLFile file;
  return file.Open(filename, "r") ? file.GetSize() : 0;
}

bool VLFile::Exist(const char* filename) {
  VLFile file;
  return file.Open(filename, "r");
}

bool VLFile::Remove(const char* filename) {
  VL_ASSERT(filename != 0);
  return remove(filename) == 0;
}

bool VLFile::Rename(const char* oldname, const char* newname) {
  VL_ASSERT(oldname != 0);
  VL_ASSERT(newname != 0);
  return rename(oldname, newname) == 0;
}

bool VLFile::FolderExist(const char* filename) {
  VL_ASSERT(filename != 0);
  struct stat info;
  return stat(filename, &info) == 0 && S_ISDIR(info.st_mode);
}

bool VLFile::CreateFolder(const char* filename) {
  VL_ASSERT(filename != 0);
  // Every parent first ("/a/b/c": "/a", then "/a/b"), then the whole path.
  for (const char* slash = strchr(filename + (filename[0] ? 1 : 0), PATH_SEPERATOR); slash;
       slash = strchr(slash + 1, PATH_SEPERATOR)) {
    VLString parent(filename, slash - filename);
    if (!MakeFolder(parent.c_str())) return false;
  }
  return MakeFolder(filename);
}

VLString VLFile::GetFolderName(const char* path) {
  VL_ASSERT(path != 0);
  const char* slash = strrchr(path, PATH_SEPERATOR);
  if (slash) return VLString(path, slash - path + 1);
  if (!*path) return VLString("./");
  VLString folder(path);
  folder += PATH_SEPERATOR;
  return folder;
}

VLString VLFile::GetFileName(const char* path) {
  VL_ASSERT(path != 0);
  const char* slash = strrchr(path, PATH_SEPERATOR);
  return VLString(slash ? slash + 1 : path);
}

bool VLFile::RemoveWithWildcard(const char* filename) {
  VL_ASSERT(filename != 0);
  VL_ASSERT((strchr(filename, '?') != 0) || (strchr(filename, '*') != 0));
  VLString folder = GetFolderName(filename);
  VLString mask = GetFileName(filename);
  DIR* listing = opendir(folder.c_str());
  if (!listing) return false;
  bool removedAll = true;
  while (struct dirent* entry = readdir(listing)) {
    const char* name = entry->d_name;
    // No FNM_PERIOD: "*" also matches hidden files, so "." and ".." must be left out by name.
    if (fnmatch(mask.c_str(), name, FNM_PATHNAME | FNM_NOESCAPE) != 0) continue;
    if (strcmp(name, ".") == 0 || strcmp(name, "..") == 0) continue;
    if (!Remove((folder + name).c_str())) {
      removedAll = false;
      break;
    }
  }
  closedir(listing);
  return removedAll;
}

VLString VLFile::CreateTempFileName(const char* path) {
  VL_ASSERT(path != 0);
  VLString name = GetFolderName(path) + "vlwsXXXXXX";
  int fd = mkstemp(&name[0]);
  if (fd < 0) return VLString();  // the template is no file name: never hand it out
  close(fd);
  return name;
}

bool VLFile::CopyFile(const char* src, const char* dst) {
  if (!src || !dst) return false;
  VLFile in, out;
  if (!in.Open(src, "rb")) return false;
  struct stat source, target;
  if (fstat(fileno(in.m_File), &source) == 0 && stat(dst, &target) == 0 &&
      source.st_dev == target.st_dev && source.st_ino == target.st_ino) {
    return false;
  }
  if (!out.Open(dst, "wb")) return false;
  char block[1024];
  for (;;) {
    vl_int64 got = in.Read(block, sizeof block);
    if (got == 0) break;
    if (out.Write(block, got) != got) return false;
  }
  // A read error ends the loop like the end of the file; the buffered tail of dst is written
  // (and may fail, as on a full disk) only by the close.
  return !ferror(in.m_File) && out.Close();
}
