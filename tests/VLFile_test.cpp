// VLFile: stream operations, folder creation, path splitting, wildcard removal, temporary files
// and copying, on real files in a per-test temporary directory.
#include <gtest/gtest.h>

#include <sys/stat.h>

#include <set>
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
  EXPECT_TRUE(closed.Close());
}

TEST(VLFile, CreateFolderMakesEveryParent) {
  VLTestDir dir;
  // The second time it is already there; then a trailing slash and a double one.
  for (const char* path : {"x/y/z", "x/y/z", "t/u/", "d//e"}) {
    EXPECT_TRUE(VLFile::CreateFolder((dir / path).c_str())) << path;
    EXPECT_TRUE(IsFolder(dir / path)) << path;
  }
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
  const struct {
    const char *path, *folder, *file;
  } names[] = {{"a/b/c.jpg", "a/b/", "c.jpg"}, {"/x", "/", "x"},          {"a/b/", "a/b/", ""},
               {"name", "name/", "name"},      {"", "./", ""},            {"/a/b", "/a/", "b"}};
  for (const auto& n : names) {
    EXPECT_EQ(n.folder, Str(VLFile::GetFolderName(n.path))) << n.path;
    EXPECT_EQ(n.file, Str(VLFile::GetFileName(n.path))) << n.path;
  }
}

TEST(VLFile, RemoveWithWildcardTakesHiddenFilesButNeverDotEntries) {
  VLTestDir dir;
  for (const char* name : {"a.jpg", ".hidden.jpg", "b.png", "c.jpg.txt", "x.png"}) VLWriteFile(dir / name, name);
  ASSERT_TRUE(VLFile::CreateFolder((dir / "sub").c_str()));
  VLWriteFile(dir / "sub/d.jpg", "deeper");

  EXPECT_TRUE(VLFile::RemoveWithWildcard((dir / "*.jpg").c_str()));
  EXPECT_EQ((std::set<std::string>{"b.png", "c.jpg.txt", "sub", "x.png"}), VLFolderFiles(dir.path()));
  EXPECT_TRUE(VLFile::Exist((dir / "sub/d.jpg").c_str()));  // one folder only
  EXPECT_TRUE(VLFile::RemoveWithWildcard((dir / "?.png").c_str()));
  EXPECT_EQ((std::set<std::string>{"c.jpg.txt", "sub"}), VLFolderFiles(dir.path()));

  // "*" matches "." and "..", which stay; the non-empty folder "sub" cannot go: false.
  EXPECT_FALSE(VLFile::RemoveWithWildcard((dir / "*").c_str()));
  EXPECT_TRUE(IsFolder(dir.path()));
  EXPECT_TRUE(VLFile::Remove((dir / "sub/d.jpg").c_str()));
  EXPECT_TRUE(VLFile::RemoveWithWildcard((dir / "*").c_str()));
  EXPECT_TRUE(IsFolder(dir.path()));
  EXPECT_TRUE(VLFolderFiles(dir.path()).empty());

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

TEST(VLFile, CopyFileCopiesEveryByteAndReportsEveryFailure) {
  VLTestDir dir;
  std::string content;
  for (int i = 0; i < 5000; ++i) content += static_cast<char>(i * 7);  // several blocks, 0 bytes
  std::string src = dir / "src.bin", dst = dir / "dst.bin", empty = dir / "empty";
  ASSERT_TRUE(VLWriteFile(src, content));
  ASSERT_TRUE(VLWriteFile(dst, std::string(9000, 'x')));  // longer: must be truncated
  EXPECT_TRUE(VLFile::CopyFile(src.c_str(), dst.c_str()));
  EXPECT_EQ(content, VLReadFile(dst));
  ASSERT_TRUE(VLWriteFile(empty, ""));
  EXPECT_TRUE(VLFile::CopyFile(empty.c_str(), (empty + ".copy").c_str()));
  EXPECT_TRUE(VLFile::Exist((empty + ".copy").c_str()));
  EXPECT_EQ("", VLReadFile(empty + ".copy"));

  std::string copy = dir / "copy";
  EXPECT_FALSE(VLFile::CopyFile((dir / "missing").c_str(), copy.c_str()));
  EXPECT_FALSE(VLFile::Exist(copy.c_str()));
  EXPECT_FALSE(VLFile::CopyFile(src.c_str(), (dir / "no/copy").c_str()));
  EXPECT_FALSE(VLFile::CopyFile(nullptr, copy.c_str()));
  EXPECT_FALSE(VLFile::CopyFile(src.c_str(), nullptr));
  // A short write (the device is full) is a failed copy, not a success, even of a small file.
  EXPECT_FALSE(VLFile::CopyFile(src.c_str(), "/dev/full"));
  ASSERT_TRUE(VLWriteFile(dir / "small", "abc"));
  EXPECT_FALSE(VLFile::CopyFile((dir / "small").c_str(), "/dev/full"));
  // Copying a file onto itself would truncate it: refused, the content stays.
  EXPECT_FALSE(VLFile::CopyFile(src.c_str(), src.c_str()));
  EXPECT_EQ(content, VLReadFile(src));
  // A directory reads as an error, not as an empty file.
  EXPECT_FALSE(VLFile::CopyFile(dir.path().c_str(), copy.c_str()));
}

TEST(VLFileDeathTest, PreconditionsReportTheirCondition) {
  GTEST_FLAG_SET(death_test_style, "threadsafe");
  VLFile file;
  EXPECT_DEATH(file.Open(nullptr, "r"), "filename != 0");
  EXPECT_DEATH(VLFile::RemoveWithWildcard("/tmp/file.jpg"),
               "\\(strchr\\(filename, '\\?'\\) != 0\\) \\|\\| \\(strchr\\(filename, '\\*'\\) != 0\\)");
}

}  // namespace
