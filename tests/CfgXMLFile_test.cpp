// CfgXMLFile: settings files on disk, encrypted values and their packed form, the file format
// pinned by a file written by an earlier build, and whole-file replacement under SIGKILL and a
// full disk. (What plain settings files hold, and how their reads and writes answer, the session
// settings-xml shows.)
#include <gtest/gtest.h>

#include <signal.h>
#include <sys/resource.h>
#include <sys/stat.h>
#include <sys/wait.h>
#include <unistd.h>

#include <chrono>
#include <set>
#include <string>
#include <vector>

#include "CfgXMLFile.h"
#include "EVPCipher.h"
#include "VLFile.h"
#include "VLTestDir.h"

namespace {

std::string Str(const VLString& s) { return std::string(s.c_str(), s.length()); }

// Result and value of one read.
struct Got {
  CfgXMLFile::Result result;
  std::string value;
};

Got ReadSetting(const std::string& path, const char* key, bool encrypted = false) {
  VLString value("left over");
  CfgXMLFile::Result result = CfgXMLFile(path.c_str()).Read(key, value, encrypted);
  return {result, Str(value)};
}

CfgXMLFile::Result WriteSetting(const std::string& path, const char* key, const std::string& value,
                                bool encrypted = false) {
  return CfgXMLFile(path.c_str()).Write(key, VLString(value.data(), value.size()), encrypted);
}

#define EXPECT_READ(path, key, encrypted, code, text)     \
  do {                                                    \
    Got got = ReadSetting(path, key, encrypted);          \
    EXPECT_EQ(CfgXMLFile::code, got.result) << key;       \
    EXPECT_EQ(std::string(text), got.value) << key;       \
  } while (0)

// A file that does not parse may hold the account's token: it reads as unreadable, not as
// missing a key, and a write keeps its bytes as NAME.damaged before the new file replaces it.
TEST(CfgXMLFile, AFileThatDoesNotParseIsKeptAside) {
  VLTestDir dir;
  std::string whole = dir / "whole.xml";
  ASSERT_EQ(CfgXMLFile::CFG_OK, WriteSetting(whole, "AuthToken", "token-4711", true));
  ASSERT_EQ(CfgXMLFile::CFG_OK, WriteSetting(whole, "DestinationUniqueID", "00-11-22-33-44-55"));
  std::string text = VLReadFile(whole);
  std::string tooMany = "<DUDUVud xmlns:VL1=\"http://store.ostrel.example/api/\">";
  for (int i = 0; i < 200000; ++i) tooMany += "<VL1:Configuration Key=\"K\"/>";
  tooMany += "</DUDUVud>";
  const std::string damaged[] = {text.substr(0, text.size() / 2), "\x1F\x8B not a settings file",
                                 "<other>" + text + "</other>", tooMany};
  for (const std::string& bytes : damaged) {
    SCOPED_TRACE(bytes.substr(0, 40));
    std::string path = dir / "settings.xml";
    ASSERT_TRUE(VLWriteFile(path, bytes));
    ASSERT_EQ(0, chmod(path.c_str(), 0640));
    EXPECT_READ(path, "DestinationUniqueID", false, CFG_UNREADABLE, "");
    ASSERT_EQ(CfgXMLFile::CFG_OK, WriteSetting(path, "Volume", "7"));
    EXPECT_READ(path, "Volume", false, CFG_OK, "7");
    EXPECT_READ(path, "DestinationUniqueID", false, CFG_NOT_FOUND, "");
    EXPECT_EQ(bytes, VLReadFile(path + ".damaged"));
    struct stat st;
    ASSERT_EQ(0, stat((path + ".damaged").c_str(), &st));
    EXPECT_EQ(0640u, st.st_mode & 07777);
  }
  // A file that exists but cannot be read is left alone.
  ASSERT_EQ(0, mkdir((dir / "folder.xml").c_str(), 0755));
  EXPECT_EQ(CfgXMLFile::CFG_FILE_ERROR, WriteSetting(dir / "folder.xml", "A", "1"));
  EXPECT_FALSE(VLFile::Exist((dir / "folder.xml.damaged").c_str()));

  // A file that holds an encrypted value is its owner's alone.
  std::string open = dir / "open.xml";
  ASSERT_EQ(CfgXMLFile::CFG_OK, WriteSetting(open, "Volume", "7"));
  ASSERT_EQ(0, chmod(open.c_str(), 0644));
  ASSERT_EQ(CfgXMLFile::CFG_OK, WriteSetting(open, "AuthToken", "token-4711", true));
  struct stat st;
  ASSERT_EQ(0, stat(open.c_str(), &st));
  EXPECT_EQ(0600u, st.st_mode & 07777);
  ASSERT_EQ(0, stat(whole.c_str(), &st));
  EXPECT_EQ(0600u, st.st_mode & 07777);
}

TEST(CfgXMLFile, TextIsKeptAsUtf8Bytes) {
  VLTestDir dir;
  std::string path = dir / "settings.xml";
  // Written by hand (or another tool): UTF-8 text, characters beyond U+00FF included.
  ASSERT_TRUE(VLWriteFile(path, "<DUDUVud xmlns:VL1=\"http://store.ostrel.example/api/\">"
                                "<VL1:Configuration Key=\"Caf\xC3\xA9\"><VL1:Value>caf\xC3\xA9 "
                                "\xE2\x82\xAC</VL1:Value></VL1:Configuration></DUDUVud>"));
  EXPECT_READ(path, "Caf\xC3\xA9", false, CFG_OK, "caf\xC3\xA9 \xE2\x82\xAC");

  ASSERT_EQ(CfgXMLFile::CFG_OK, WriteSetting(path, "Euro", "\xE2\x82\xAC 5"));
  EXPECT_NE(std::string::npos, VLReadFile(path).find("<VL1:Value>\xE2\x82\xAC 5</VL1:Value>"));
  // Every character comes back as it went in, control characters included.
  std::string text;
  for (int c = 1; c < 128; ++c) text += static_cast<char>(c);
  text += "\xC2\x80\xDF\xBF\xE0\xA0\x80\xEF\xBF\xBD\xF0\x9F\x8E\xAC\xF4\x8F\xBF\xBF";
  ASSERT_EQ(CfgXMLFile::CFG_OK, WriteSetting(path, "Text", text));
  EXPECT_READ(path, "Text", false, CFG_OK, text);
  // A byte that is no part of a UTF-8 character is taken for the Latin-1 character it would be.
  ASSERT_EQ(CfgXMLFile::CFG_OK, WriteSetting(path, "Latin1", "caf\xE9"));
  EXPECT_READ(path, "Latin1", false, CFG_OK, "caf\xC3\xA9");
  EXPECT_READ(path, "Caf\xC3\xA9", false, CFG_OK, "caf\xC3\xA9 \xE2\x82\xAC");
}

TEST(CfgXMLFile, EncryptedValues) {
  VLTestDir dir;
  std::string path = dir / "credentials.xml";
  const std::string token = "tok-\xC3\xA9-0123456789abcdefghijklmnopqrstuvwxyz";
  ASSERT_EQ(CfgXMLFile::CFG_OK, WriteSetting(path, "AuthToken", token, true));
  EXPECT_READ(path, "AuthToken", true, CFG_OK, token);
  Got packed = ReadSetting(path, "AuthToken");
  ASSERT_EQ(CfgXMLFile::CFG_OK, packed.result);
  EXPECT_EQ(32 + 2 * 48 + 4, packed.value.size());  // password, three AES blocks, check
  EXPECT_EQ(std::string::npos, packed.value.find("tok"));

  ASSERT_EQ(CfgXMLFile::CFG_OK, WriteSetting(path, "AuthToken", token, true));
  Got again = ReadSetting(path, "AuthToken");
  EXPECT_NE(packed.value, again.value);  // a new password every time
  EXPECT_READ(path, "AuthToken", true, CFG_OK, token);

  // An empty value is stored as password and check only, and reads back as damaged.
  ASSERT_EQ(CfgXMLFile::CFG_OK, WriteSetting(path, "Empty", "", true));
  EXPECT_EQ(36u, ReadSetting(path, "Empty").value.size());
  EXPECT_READ(path, "Empty", true, CFG_DAMAGED, "");

  // A stored empty text is no encrypted value at all: it reads as empty.
  ASSERT_EQ(CfgXMLFile::CFG_OK, WriteSetting(path, "Blank", ""));
  EXPECT_READ(path, "Blank", true, CFG_OK, "");
}

TEST(CfgXMLFile, DamagedPackedValues) {
  const char password[] = "00112233445566778899aabbccddeeff";
  EVPCipher cipher(EVPCipher::AES_128_CBC);
  VLString cipherText = cipher.Encrypt("a secret value", password);
  VLString packed = CfgXMLFile::PackEncryptedValue(cipherText, password);
  VLTestDir dir;
  std::string path = dir / "settings.xml";
  ASSERT_EQ(CfgXMLFile::CFG_OK, WriteSetting(path, "S", Str(packed)));
  EXPECT_READ(path, "S", true, CFG_OK, "a secret value");

  const std::string original = Str(packed);
  std::vector<std::string> damaged = {
      original.substr(0, 36),  // too short
      original.substr(0, original.size() - 1),
      "short",
      // Check digits that match over a cipher text that does not decrypt.
      Str(CfgXMLFile::PackEncryptedValue(VLString(std::string(32, '0').c_str()), password)),
      Str(CfgXMLFile::PackEncryptedValue(cipherText.substr(0, 30), password)),
      Str(CfgXMLFile::PackEncryptedValue(VLString("zz"), password)),
      Str(CfgXMLFile::PackEncryptedValue(cipherText, "0011223344556677889900")),
  };
  // Every single changed character of password, cipher text or check is caught.
  for (size_t i = 0; i < original.size(); ++i) {
    damaged.push_back(original);
    damaged.back()[i] = original[i] == '7' ? '8' : '7';
  }
  for (const std::string& value : damaged) {
    ASSERT_EQ(CfgXMLFile::CFG_OK, WriteSetting(path, "S", value));
    EXPECT_READ(path, "S", true, CFG_DAMAGED, "");
  }
}

// A file written by an earlier build: every later build must read it, and rewriting a value
// with the same text must give the same bytes (alphabet, IV constants, check and XML format).
TEST(CfgXMLFile, ReadsTheFileOfTheFirstRelease) {
  std::string pinned = VLReadFile(VL_SOURCE_DIR "/tests/data/settings-v1.xml");
  ASSERT_FALSE(pinned.empty());
  VLTestDir dir;
  std::string path = dir / "settings.xml";
  ASSERT_TRUE(VLWriteFile(path, pinned));
  EXPECT_READ(path, "Environment", false, CFG_OK, "production");
  EXPECT_READ(path, "Greeting", false, CFG_OK, "Gr\xC3\xBC\xC3\x9F" "e & <hallo>");
  EXPECT_READ(path, "AuthToken", true, CFG_OK, "tok-0123456789-\xC3\xA9t\xC3\xA9");
  ASSERT_EQ(CfgXMLFile::CFG_OK, WriteSetting(path, "Environment", "production"));
  EXPECT_EQ(pinned, VLReadFile(path));
}

TEST(CfgXMLFile, ReplacingKeepsLinksPermissionsAndBareNames) {
  VLTestDir dir;
  std::string real = dir / "real.xml", link = dir / "link.xml";
  ASSERT_EQ(CfgXMLFile::CFG_OK, WriteSetting(real, "A", "1"));
  ASSERT_EQ(0, symlink("real.xml", link.c_str()));
  ASSERT_EQ(0, chmod(real.c_str(), 0640));
  ASSERT_EQ(CfgXMLFile::CFG_OK, WriteSetting(link, "A", "2"));
  struct stat st;
  ASSERT_EQ(0, lstat(link.c_str(), &st));
  EXPECT_TRUE(S_ISLNK(st.st_mode));
  ASSERT_EQ(0, stat(real.c_str(), &st));
  EXPECT_EQ(0640u, st.st_mode & 07777);
  EXPECT_READ(real, "A", false, CFG_OK, "2");

  mode_t mask = umask(027);
  ASSERT_EQ(CfgXMLFile::CFG_OK, WriteSetting(dir / "new.xml", "A", "1"));
  umask(mask);
  ASSERT_EQ(0, stat((dir / "new.xml").c_str(), &st));
  EXPECT_EQ(0640u, st.st_mode & 07777);  // as fopen would have created it

  VLScopedCurrentDir here(dir.path());
  ASSERT_EQ(CfgXMLFile::CFG_OK, WriteSetting("bare.xml", "A", "3"));
  EXPECT_READ(dir / "bare.xml", "A", false, CFG_OK, "3");
}

// A file of about 400 KB: 100 small settings and one large value.
struct LargeFile {
  std::string path, oldText, newText, oldValue, newValue;
};

LargeFile MakeLargeFile(const VLTestDir& dir) {
  LargeFile file;
  file.path = dir / "large.xml";
  for (int i = 0; i < 100; ++i) {
    std::string key = "key" + std::to_string(i);
    EXPECT_EQ(CfgXMLFile::CFG_OK, WriteSetting(file.path, key.c_str(), "value " + key));
  }
  EXPECT_EQ(CfgXMLFile::CFG_OK, WriteSetting(file.path, "Token", "secret", true));
  for (int i = 0; i < 40000; ++i) {
    file.oldValue += "old " + std::to_string(i) + ",";
    file.newValue += "new " + std::to_string(i) + ",";
  }
  EXPECT_EQ(CfgXMLFile::CFG_OK, WriteSetting(file.path, "Large", file.newValue));
  file.newText = VLReadFile(file.path);
  EXPECT_EQ(CfgXMLFile::CFG_OK, WriteSetting(file.path, "Large", file.oldValue));
  file.oldText = VLReadFile(file.path);
  return file;
}

TEST(CfgXMLFile, KilledWriterLeavesTheOldOrTheNewFile) {
  VLTestDir dir;
  LargeFile file = MakeLargeFile(dir);
  auto start = std::chrono::steady_clock::now();
  ASSERT_EQ(CfgXMLFile::CFG_OK, WriteSetting(file.path, "Large", file.oldValue));
  auto oneWrite = std::chrono::duration_cast<std::chrono::microseconds>(
                      std::chrono::steady_clock::now() - start).count();

  // Rounds go on until each outcome has been seen at least once: the old file, the new file, and
  // a writer killed between creating and renaming its new file (which it leaves behind, unused).
  // Where a kill lands is up to the scheduler, so no fixed number of rounds is sure to see all.
  int seenOld = 0, seenNew = 0;
  bool seenLeftover = false;
  const int kMaxRounds = 1000;
  for (int round = 0; round < kMaxRounds && !(seenOld && seenNew && seenLeftover); ++round) {
    int done[2];
    ASSERT_EQ(0, pipe(done));
    pid_t child = fork();
    ASSERT_GE(child, 0);
    if (child == 0) {
      // The writer: new and old content in turn, one byte into the pipe after each write.
      close(done[0]);
      for (int i = 0;; ++i) {
        if (WriteSetting(file.path, "Large", i % 2 ? file.oldValue : file.newValue) !=
                CfgXMLFile::CFG_OK ||
            write(done[1], "w", 1) != 1) {
          _exit(1);
        }
      }
    }
    close(done[1]);
    // Kill after 0, 1 or 2 finished writes, at a point spread over the next write.
    char byte;
    for (int finished = 0; finished < round % 3; ++finished) ASSERT_EQ(1, read(done[0], &byte, 1));
    usleep(static_cast<useconds_t>(oneWrite * (round * 37 % 100) / 100));
    kill(child, SIGKILL);
    int status = 0;
    ASSERT_EQ(child, waitpid(child, &status, 0));
    close(done[0]);
    ASSERT_TRUE(WIFSIGNALED(status)) << "the writer failed in round " << round;

    std::string text = VLReadFile(file.path);
    ASSERT_TRUE(text == file.oldText || text == file.newText) << "round " << round;
    seenOld += text == file.oldText;
    seenNew += text == file.newText;
    seenLeftover = seenLeftover || VLFolderFiles(dir.path()).size() > 1;
    EXPECT_READ(file.path, "key99", false, CFG_OK, "value key99");
    EXPECT_READ(file.path, "Token", true, CFG_OK, "secret");
  }
  EXPECT_GT(seenOld, 0);
  EXPECT_GT(seenNew, 0);
  EXPECT_TRUE(seenLeftover) << "no writer was killed in the middle of a write";
}

TEST(CfgXMLFile, FullDiskLeavesTheOldFile) {
  VLTestDir dir;
  LargeFile file = MakeLargeFile(dir);
  pid_t child = fork();
  ASSERT_GE(child, 0);
  if (child == 0) {
    // No file of this process may grow beyond the old file's size: the new one cannot be written.
    signal(SIGXFSZ, SIG_IGN);
    struct rlimit limit = {file.oldText.size() / 2, file.oldText.size() / 2};
    if (setrlimit(RLIMIT_FSIZE, &limit) != 0) _exit(100);
    _exit(WriteSetting(file.path, "Large", file.newValue));
  }
  int status = 0;
  ASSERT_EQ(child, waitpid(child, &status, 0));
  ASSERT_TRUE(WIFEXITED(status));
  EXPECT_EQ(CfgXMLFile::CFG_FILE_ERROR, WEXITSTATUS(status));
  EXPECT_EQ(file.oldText, VLReadFile(file.path));
  EXPECT_EQ(std::set<std::string>{"large.xml"}, VLFolderFiles(dir.path()));  // temp file removed
}

}  // namespace
