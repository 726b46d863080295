// VLFile: stream operations, folder creation, path splitting, wildcard removal, temporary files
// and copying, on real files in a per-test temporary directory.
#include <gtest/gtest.h>

#include <sys/stat.h>

#include <string>

#include "VLFile.h"
#include "VLTestDir.h"

namespace {

std::string Str(const VLString& s) { return std::string(s.c_str(), s.length()); }

bool IsFolder(const std::string& path) { return VLFile::FolderExist(path.c_str()); }

TEST(VLFile, StreamOperations) {
  VLTestDir dir;
  std::string path = dir / "data.bin";
  const std::string content("ab\0cdefghij", 11);
  VLFile file;
  EXPECT_EQ(-1, file.Position());
  ASSERT_TRUE(file.Open(path.c_str(), "wb+"));
  EXPECT_EQ(11, file.Write(content.data(), 11));
  EXPECT_TRUE(file.Flush());
  EXPECT_EQ(11, file.Position());
  ASSERT_TRUE(file.Seek(3, SEEK_SET));
  EXPECT_EQ(11, file.GetSize());
  EXPECT_EQ(3, file.Position());  // GetSize keeps the position
  char buf[32] = {0};
  EXPECT_EQ(8, file.Read(buf, sizeof buf));  // stops at the end of the file
  EXPECT_EQ(content.substr(3), std::string(buf, 8));
  EXPECT_EQ(0, file.Read(buf, sizeof buf));
  ASSERT_TRUE(file.Seek(-2, SEEK_END));
  EXPECT_EQ(2, file.Read(buf, 2));
  EXPECT_EQ("ij", std::string(buf, 2));
  EXPECT_EQ(0, file.Read(buf, 0));
  EXPECT_FALSE(file.Seek(-100, SEEK_SET));

  // Open on an open file closes the first stream.
  ASSERT_TRUE(file.Open(path.c_str(), "rb"));
  EXPECT_EQ(0, file.Position());
  EXPECT_EQ(11, file.Read(buf, 11));
  EXPECT_FALSE(file.Open((dir / "missing").c_str(), "rb"));
  EXPECT_EQ(-1, file.Position());

  VLFile closed;
  EXPECT_EQ(0, closed.Read(buf, 4));
  EXPECT_EQ(0, closed.Write(buf, 4));
  EXPECT_FALSE(closed.Flush());
  EXPECT_EQ(0, closed.GetSize());
  EXPECT_FALSE(closed.Seek(0, SEEK_SET));
  EXPECT_TRUE(closed.Close());
}

TEST(VLFile, PathOperations) {
  VLTestDir dir;
  std::string a = dir / "a.txt", b = dir / "b.txt";
  ASSERT_TRUE(VLWriteFile(a, "12345"));
  EXPECT_TRUE(VLFile::Exist(a.c_str()));
  EXPECT_EQ(5, VLFile::GetSize(a.c_str()));
  EXPECT_EQ(0, VLFile::GetSize(b.c_str()));
  EXPECT_FALSE(VLFile::FolderExist(a.c_str()));
  EXPECT_TRUE(VLFile::FolderExist(dir.path().c_str()));
  EXPECT_TRUE(VLFile::Rename(a.c_str(), b.c_str()));
  EXPECT_FALSE(VLFile::Exist(a.c_str()));
  EXPECT_FALSE(VLFile::Rename(a.c_str(), b.c_str()));
  EXPECT_TRUE(VLFile::Remove(b.c_str()));
  EXPECT_FALSE(VLFile::Remove(b.c_str()));
  EXPECT_FALSE(VLFile::FolderExist(b.c_str()));
}

TEST(VLFile, CreateFolderMakesEveryParent) {
  VLTestDir dir;
  EXPECT_TRUE(VLFile::CreateFolder((dir / "x/y/z").c_str()));
  EXPECT_TRUE(IsFolder(dir / "x/y/z"));
  EXPECT_TRUE(VLFile::CreateFolder((dir / "x/y/z").c_str()));  // already there
  EXPECT_TRUE(VLFile::CreateFolder((dir / "t/u/").c_str()));   // trailing slash
  EXPECT_TRUE(IsFolder(dir / "t/u"));
  EXPECT_TRUE(VLFile::CreateFolder((dir / "d//e").c_str()));
  EXPECT_TRUE(IsFolder(dir / "d/e"));
  EXPECT_FALSE(VLFile::CreateFolder(""));

  // A regular file in the way: false, and nothing is created below it or beside it.
  ASSERT_TRUE(VLWriteFile(dir / "a", "file"));
  EXPECT_FALSE(VLFile::CreateFolder((dir / "a/b/c").c_str()));
  EXPECT_EQ("file", VLReadFile(dir / "a"));
  EXPECT_FALSE(VLFile::CreateFolder((dir / "a").c_str()));
  EXPECT_FALSE(VLFile::CreateFolder((dir / "a/").c_str()));

  {
    VLScopedCurrentDir inside(dir.path());
    EXPECT_TRUE(VLFile::CreateFolder("rel/ative"));
  }
  EXPECT_TRUE(IsFolder(dir / "rel/ative"));
}

TEST(VLFile, FolderAndFileNames) {
  EXPECT_EQ("a/b/", Str(VLFile::GetFolderName("a/b/c.jpg")));
  EXPECT_EQ("/", Str(VLFile::GetFolderName("/x")));
  EXPECT_EQ("a/b/", Str(VLFile::GetFolderName("a/b/")));
  EXPECT_EQ("file.jpg/", Str(VLFile::GetFolderName("file.jpg")));
  EXPECT_EQ("./", Str(VLFile::GetFolderName("")));
  EXPECT_EQ("b", Str(VLFile::GetFileName("/a/b")));
  EXPECT_EQ("name", Str(VLFile::GetFileName("name")));
  EXPECT_EQ("", Str(VLFile::GetFileName("a/b/")));
  EXPECT_EQ('/', VLFile::PATH_SEPERATOR);
}

TEST(VLFile, RemoveWithWildcardTakesHiddenFilesButNeverDotEntries) {
  VLTestDir dir;
  for (const char* name : {"a.jpg", ".hidden.jpg", "b.png", "c.jpg.txt", "x.png"}) VLWriteFile(dir / name, name);
  ASSERT_TRUE(VLFile::CreateFolder((dir / "sub").c_str()));
  VLWriteFile(dir / "sub/d.jpg", "deeper");

  EXPECT_TRUE(VLFile::RemoveWithWildcard((dir / "*.jpg").c_str()));
  EXPECT_FALSE(VLFile::Exist((dir / "a.jpg").c_str()));
  EXPECT_FALSE(VLFile::Exist((dir / ".hidden.jpg").c_str()));
  EXPECT_TRUE(VLFile::Exist((dir / "b.png").c_str()));
  EXPECT_TRUE(VLFile::Exist((dir / "c.jpg.txt").c_str()));
  EXPECT_TRUE(VLFile::Exist((dir / "sub/d.jpg").c_str()));  // one folder only

  EXPECT_TRUE(VLFile::RemoveWithWildcard((dir / "?.png").c_str()));
  EXPECT_FALSE(VLFile::Exist((dir / "b.png").c_str()));
  EXPECT_FALSE(VLFile::Exist((dir / "x.png").c_str()));

  // "*" matches "." and "..", which stay; the non-empty folder "sub" cannot go: false.
  EXPECT_FALSE(VLFile::RemoveWithWildcard((dir / "*").c_str()));
  EXPECT_TRUE(IsFolder(dir.path()));
  EXPECT_TRUE(VLFile::Remove((dir / "sub/d.jpg").c_str()));
  EXPECT_TRUE(VLFile::RemoveWithWildcard((dir / "*").c_str()));
  EXPECT_TRUE(IsFolder(dir.path()));
  EXPECT_FALSE(VLFile::Exist((dir / "c.jpg.txt").c_str()));
  EXPECT_FALSE(IsFolder(dir / "sub"));

  EXPECT_FALSE(VLFile::RemoveWithWildcard((dir / "missing/*.jpg").c_str()));
  EXPECT_TRUE(VLFile::RemoveWithWildcard((dir / "*.none").c_str()));
}

TEST(VLFile, CreateTempFileNameMakesAnEmptyPrivateFile) {
  VLTestDir dir;
  std::string first = Str(VLFile::CreateTempFileName((dir / "image.jpg").c_str()));
  std::string second = Str(VLFile::CreateTempFileName((dir / "image.jpg").c_str()));
  ASSERT_EQ(dir.path().size() + 10, first.size());
  EXPECT_EQ(dir / "vlws", first.substr(0, dir.path().size() + 4));
  EXPECT_NE(first, second);
  struct stat info;
  ASSERT_EQ(0, stat(first.c_str(), &info));
  EXPECT_TRUE(S_ISREG(info.st_mode));
  EXPECT_EQ(0, info.st_size);
  EXPECT_EQ(0600u, info.st_mode & 0777u);

  // No folder to create it in: no name at all, not the bare template.
  EXPECT_TRUE(VLFile::CreateTempFileName((dir / "missing/image.jpg").c_str()).empty());
}

TEST(VLFile, CopyFileCopiesEveryByte) {
  VLTestDir dir;
  std::string content;
  for (int i = 0; i < 5000; ++i) content += static_cast<char>(i * 7);  // several blocks, 0 bytes
  std::string src = dir / "src.bin", dst = dir / "dst.bin";
  ASSERT_TRUE(VLWriteFile(src, content));
  ASSERT_TRUE(VLWriteFile(dst, std::string(9000, 'x')));  // longer: must be truncated
  EXPECT_TRUE(VLFile::CopyFile(src.c_str(), dst.c_str()));
  EXPECT_EQ(content, VLReadFile(dst));

  std::string empty = dir / "empty", emptyCopy = dir / "empty.copy";
  ASSERT_TRUE(VLWriteFile(empty, ""));
  EXPECT_TRUE(VLFile::CopyFile(empty.c_str(), emptyCopy.c_str()));
  EXPECT_TRUE(VLFile::Exist(emptyCopy.c_str()));
  EXPECT_EQ("", VLReadFile(emptyCopy));
}

TEST(VLFile, CopyFileReportsEveryFailure) {
  VLTestDir dir;
  std::string src = dir / "src.txt";
  ASSERT_TRUE(VLWriteFile(src, std::string(3000, 's')));
  std::string missingCopy = dir / "copy";
  EXPECT_FALSE(VLFile::CopyFile((dir / "missing").c_str(), missingCopy.c_str()));
  EXPECT_FALSE(VLFile::Exist(missingCopy.c_str()));
  EXPECT_FALSE(VLFile::CopyFile(src.c_str(), (dir / "no/copy").c_str()));
  EXPECT_FALSE(VLFile::CopyFile(nullptr, missingCopy.c_str()));
  EXPECT_FALSE(VLFile::CopyFile(src.c_str(), nullptr));

  // A short write (the device is full) is a failed copy, not a success.
  EXPECT_FALSE(VLFile::CopyFile(src.c_str(), "/dev/full"));
  ASSERT_TRUE(VLWriteFile(dir / "small", "abc"));
  EXPECT_FALSE(VLFile::CopyFile((dir / "small").c_str(), "/dev/full"));

  // Copying a file onto itself would truncate it: refused, the content stays.
  EXPECT_FALSE(VLFile::CopyFile(src.c_str(), src.c_str()));
  EXPECT_EQ(std::string(3000, 's'), VLReadFile(src));
  // A directory reads as an error, not as an empty file.
  EXPECT_FALSE(VLFile::CopyFile(dir.path().c_str(), missingCopy.c_str()));
}

TEST(VLFileDeathTest, PreconditionsReportTheirCondition) {
  GTEST_FLAG_SET(death_test_style, "threadsafe");
  VLFile file;
  EXPECT_DEATH(file.Open(nullptr, "r"), "filename != 0");
  EXPECT_DEATH(file.Open("x", nullptr), "mode != 0");
  EXPECT_DEATH(file.Read(nullptr, 4), "buffer != 0");
  EXPECT_DEATH(file.Write(nullptr, 4), "buffer != 0");
  EXPECT_DEATH(VLFile::GetSize(nullptr), "filename != 0");
  EXPECT_DEATH(VLFile::Exist(nullptr), "filename != 0");
  EXPECT_DEATH(VLFile::Remove(nullptr), "filename != 0");
  EXPECT_DEATH(VLFile::Rename(nullptr, "b"), "oldname != 0");
  EXPECT_DEATH(VLFile::Rename("a", nullptr), "newname != 0");
  EXPECT_DEATH(VLFile::FolderExist(nullptr), "filename != 0");
  EXPECT_DEATH(VLFile::CreateFolder(nullptr), "filename != 0");
  EXPECT_DEATH(VLFile::GetFolderName(nullptr), "path != 0");
  EXPECT_DEATH(VLFile::GetFileName(nullptr), "path != 0");
  EXPECT_DEATH(VLFile::CreateTempFileName(nullptr), "path != 0");
  EXPECT_DEATH(VLFile::RemoveWithWildcard(nullptr), "filename != 0");
  EXPECT_DEATH(VLFile::RemoveWithWildcard("/tmp/file.jpg"),
               "\\(strchr\\(filename, '\\?'\\) != 0\\) \\|\\| \\(strchr\\(filename, '\\*'\\) != 0\\)");
}

}  // namespace
