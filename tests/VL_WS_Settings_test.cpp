// The settings and file operations of the flat interface on real files: settings through
// VL_WS_readSetting / VL_WS_writeSetting and their statuses, the environment file, md5sum with
// hostile file names, the file and folder helpers and VL_WS_clearLocalCache.
#include <gtest/gtest.h>
#include <sys/stat.h>

#include <string>

#include "CfgXMLFile.h"
#include "EVPCipher.h"
#include "VLTestDir.h"
#include "VL_WS.h"

namespace {

// Status and text of one VL_WS_readSetting.
struct Read {
  VL_WS_Status status;
  std::string text;
};

Read ReadSetting(const std::string& file, const char* key, bool encrypted) {
  VL_WS_String value;
  Read got;
  got.status = VL_WS_readSetting(file.c_str(), key, &value, encrypted);
  EXPECT_NE(nullptr, value.tag);
  if (value.Text) got.text = value.Text;
  EXPECT_EQ(VL_WS_OK, VL_WS_release(&value));
  return got;
}

VL_WS_Status Write(const std::string& file, const char* key, const char* value, bool encrypted = false) {
  return VL_WS_writeSetting(file.c_str(), key, value, encrypted);
}

bool Exists(const std::string& path) {
  bool exists = false;
  EXPECT_EQ(VL_WS_OK, VL_WS_fileExist(path.c_str(), &exists));
  return exists;
}

std::string Md5sum(const std::string& file, VL_WS_Status* status) {
  VL_WS_String sum;
  *status = VL_WS_checkVLSWFmd5sum(file.c_str(), &sum);
  std::string text = sum.Text ? sum.Text : "";
  VL_WS_release(&sum);
  return text;
}

TEST(Settings, WritesKeepTheOrderAndReplaceInPlace) {
  VLTestDir dir;
  std::string file = dir / "ffpreference.xml";
  ASSERT_EQ(VL_WS_OK, Write(file, "A", "first"));
  ASSERT_EQ(VL_WS_OK, Write(file, "B", "second"));
  ASSERT_EQ(VL_WS_OK, Write(file, "A", "third"));
  std::string xml = VLReadFile(file);
  size_t a = xml.find("Key=\"A\""), b = xml.find("Key=\"B\"");
  ASSERT_NE(std::string::npos, a);
  ASSERT_NE(std::string::npos, b);
  EXPECT_LT(a, b);
  EXPECT_EQ(std::string::npos, xml.find("Key=\"A\"", a + 1));
  EXPECT_EQ(std::string::npos, xml.find("first"));
  Read got = ReadSetting(file, "A", false);
  EXPECT_EQ(VL_WS_OK, got.status);
  EXPECT_EQ("third", got.text);
  EXPECT_EQ("second", ReadSetting(file, "B", false).text);
}

TEST(Settings, EncryptedValuesRoundTripWithAFreshPasswordEachWrite) {
  VLTestDir dir;
  std::string file = dir / "ffpreference.xml";
  const char token[] = "7f0c2a1e-token-of-the-account";
  ASSERT_EQ(VL_WS_OK, Write(file, "AuthToken", token, true));
  Read got = ReadSetting(file, "AuthToken", true);
  EXPECT_EQ(VL_WS_OK, got.status);
  EXPECT_EQ(token, got.text);
  EXPECT_EQ(std::string::npos, VLReadFile(file).find("token-of-the-account"));

  std::string packed = ReadSetting(file, "AuthToken", false).text;
  EXPECT_GE(packed.size(), 64u + 4u);
  ASSERT_EQ(VL_WS_OK, Write(file, "AuthToken", token, true));
  EXPECT_NE(packed, ReadSetting(file, "AuthToken", false).text);
  EXPECT_EQ(token, ReadSetting(file, "AuthToken", true).text);
}

TEST(Settings, DamagedEncryptedValuesAreReportedAsDamaged) {
  VLTestDir dir;
  std::string file = dir / "ffpreference.xml";
  ASSERT_EQ(VL_WS_OK, Write(file, "AuthToken", "secret", true));
  std::string packed = ReadSetting(file, "AuthToken", false).text;

  // Check digits that do not match.
  std::string wrongCheck = packed;
  wrongCheck.back() = wrongCheck.back() == '0' ? '1' : '0';
  // Check digits that match a cipher text that does not decrypt.
  EVPCipher cipher(EVPCipher::AES_128_CBC);
  VLString password = cipher.GeneratePswd();
  VLString garbage = EVPCipher::SimpleEncode(reinterpret_cast<const unsigned char*>("0123456789abcdef"), 16);
  VLString undecryptable = CfgXMLFile::PackEncryptedValue(garbage, password);

  for (const std::string& stored : {wrongCheck, std::string(undecryptable.c_str()), std::string("abc"),
                                    std::string("a plain value that was never encrypted at all, long enough")}) {
    ASSERT_EQ(VL_WS_OK, Write(file, "AuthToken", stored.c_str()));
    Read got = ReadSetting(file, "AuthToken", true);
    EXPECT_EQ(VL_WS_E_SETTING_DAMAGED, got.status) << stored;
    EXPECT_EQ("", got.text);
  }
}

TEST(Settings, AnEmptyEncryptedValueStoresPasswordAndCheckOnlyAndReadsBackDamaged) {
  VLTestDir dir;
  std::string file = dir / "ffpreference.xml";
  ASSERT_EQ(VL_WS_OK, Write(file, "AuthToken", "", true));
  EXPECT_EQ(36u, ReadSetting(file, "AuthToken", false).text.size());
  EXPECT_EQ(VL_WS_E_SETTING_DAMAGED, ReadSetting(file, "AuthToken", true).status);
}

TEST(Settings, MissingFilesKeysAndArgumentsHaveTheirStatuses) {
  VLTestDir dir;
  std::string file = dir / "ffpreference.xml";
  EXPECT_EQ(VL_WS_E_FILE, ReadSetting(file, "A", false).status);
  ASSERT_TRUE(VLWriteFile(file, ""));
  EXPECT_EQ(VL_WS_E_SETTING_MISSING, ReadSetting(file, "A", false).status);
  ASSERT_EQ(VL_WS_OK, Write(file, "A", "1"));
  EXPECT_EQ(VL_WS_E_SETTING_MISSING, ReadSetting(file, "B", false).status);

  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, ReadSetting(file, "", false).status);
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, ReadSetting("", "A", false).status);
  VL_WS_String value;
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_readSetting(nullptr, "A", &value, false));
  VL_WS_release(&value);
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_readSetting(file.c_str(), nullptr, &value, false));
  VL_WS_release(&value);
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_readSetting(file.c_str(), "A", nullptr, false));
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, Write(file, "", "1"));
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, Write("", "A", "1"));
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, Write(file, "A", nullptr));
  EXPECT_EQ("1", ReadSetting(file, "A", false).text);
}

TEST(Settings, WritingCreatesTheFolderOfTheFile) {
  VLTestDir dir;
  std::string file = dir / "app/2_05/ffpreference.xml";
  ASSERT_EQ(VL_WS_OK, Write(file, "A", "1"));
  EXPECT_EQ("1", ReadSetting(file, "A", false).text);

  ASSERT_TRUE(VLWriteFile(dir / "blocker", "a file where a folder should be"));
  EXPECT_EQ(VL_WS_E_FILE, Write(dir / "blocker/ffpreference.xml", "A", "1"));
}

TEST(EnvXML, CreateCopiesOnlyWhenTheDestinationIsMissing) {
  VLTestDir dir;
  std::string source = dir / "env.xml", destination = dir / "stgenv.xml";
  ASSERT_TRUE(VLWriteFile(source, "<source/>"));
  ASSERT_EQ(VL_WS_OK, VL_WS_createEnvXML(source.c_str(), destination.c_str()));
  EXPECT_EQ("<source/>", VLReadFile(destination));

  ASSERT_TRUE(VLWriteFile(destination, "<mine/>"));
  EXPECT_EQ(VL_WS_OK, VL_WS_createEnvXML(source.c_str(), destination.c_str()));
  EXPECT_EQ("<mine/>", VLReadFile(destination));

  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_createEnvXML(nullptr, destination.c_str()));
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_createEnvXML(source.c_str(), nullptr));

  EXPECT_EQ(VL_WS_OK, VL_WS_deleteEnvXML(destination.c_str()));
  EXPECT_FALSE(Exists(destination));
  EXPECT_EQ(VL_WS_OK, VL_WS_deleteEnvXML(destination.c_str()));
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_deleteEnvXML(nullptr));
}

TEST(FileHelpers, AFailedCopyLeavesNoNewDestination) {
  VLTestDir dir;
  std::string missing = dir / "missing.xml", destination = dir / "destination.xml";
  for (auto copy : {VL_WS_copyFile, VL_WS_createEnvXML}) {
    EXPECT_EQ(VL_WS_E_FILE, copy(missing.c_str(), destination.c_str()));
    EXPECT_FALSE(Exists(destination));
  }
  // A source that cannot be read to its end: a folder opens, but every read fails.
  ASSERT_EQ(VL_WS_OK, VL_WS_createFolder((dir / "folder").c_str()));
  EXPECT_EQ(VL_WS_E_FILE, VL_WS_copyFile((dir / "folder").c_str(), destination.c_str()));
  EXPECT_FALSE(Exists(destination));
}

TEST(Md5sum, GivesTheCommandsOutput) {
  VLTestDir dir;
  std::string file = dir / "VLStore.swf";
  ASSERT_TRUE(VLWriteFile(file, "hello\n"));
  VL_WS_Status status;
  EXPECT_EQ("b1946ac92492d2347c6235b4d2611184  " + file + "\n", Md5sum(file, &status));
  EXPECT_EQ(VL_WS_OK, status);
}

TEST(Md5sum, FileNamesReachTheCommandAsOneWordAndAreNeverRunByTheShell) {
  VLTestDir dir;
  std::string pwned = dir / "pwned";
  VL_WS_Status status;
  for (const std::string& name : {"x; touch " + pwned, "x' ; touch '" + pwned, "$(touch " + pwned + ")",
                                  "`touch " + pwned + "`", "x\ntouch " + pwned, "-c; touch " + pwned}) {
    Md5sum(name, &status);
    EXPECT_EQ(VL_WS_OK, status) << name;
    EXPECT_FALSE(Exists(pwned)) << name;
  }
  // A name with a quote is still summed.
  std::string quoted = dir / "it's a movie.swf";
  ASSERT_TRUE(VLWriteFile(quoted, "hello\n"));
  EXPECT_EQ(0u, Md5sum(quoted, &status).find("b1946ac92492d2347c6235b4d2611184  "));
}

TEST(Md5sum, RefusesWhatItCannotRun) {
  VL_WS_Status status;
  EXPECT_EQ("", Md5sum(std::string(1100, 'a'), &status));
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, status);
  VL_WS_String sum;
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_checkVLSWFmd5sum(nullptr, &sum));
  EXPECT_EQ(VL_WS_OK, VL_WS_release(&sum));
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_checkVLSWFmd5sum("x", nullptr));
}

TEST(FileHelpers, RemoveAndCopy) {
  VLTestDir dir;
  std::string file = dir / "a.xml", copy = dir / "b.xml";
  ASSERT_TRUE(VLWriteFile(file, "content"));
  EXPECT_EQ(VL_WS_OK, VL_WS_copyFile(file.c_str(), copy.c_str()));
  EXPECT_EQ("content", VLReadFile(copy));
  EXPECT_EQ(VL_WS_E_FILE, VL_WS_copyFile(file.c_str(), file.c_str()));
  EXPECT_EQ("content", VLReadFile(file));
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_copyFile(nullptr, copy.c_str()));

  EXPECT_EQ(VL_WS_OK, VL_WS_removeFile(copy.c_str()));
  EXPECT_FALSE(Exists(copy));
  EXPECT_EQ(VL_WS_OK, VL_WS_removeFile(copy.c_str()));
  ASSERT_EQ(VL_WS_OK, VL_WS_createFolder((dir / "full/inner").c_str()));
  EXPECT_EQ(VL_WS_E_FILE, VL_WS_removeFile((dir / "full").c_str()));
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_removeFile(nullptr));
}

TEST(FileHelpers, FoldersAndExistence) {
  VLTestDir dir;
  VL_WS_String folder;
  EXPECT_EQ(VL_WS_OK, VL_WS_getFolderName("/data/app/2_05/ffpreference.xml", &folder));
  EXPECT_STREQ("/data/app/2_05/", folder.Text);
  EXPECT_EQ(15, folder.Length);
  VL_WS_release(&folder);
  EXPECT_EQ(VL_WS_OK, VL_WS_getFolderName("", &folder));
  EXPECT_STREQ("./", folder.Text);
  VL_WS_release(&folder);
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_getFolderName(nullptr, &folder));
  EXPECT_EQ(VL_WS_OK, VL_WS_release(&folder));

  std::string nested = dir / "a/b/c";
  bool exists = true;
  EXPECT_EQ(VL_WS_OK, VL_WS_folderExist(nested.c_str(), &exists));
  EXPECT_FALSE(exists);
  EXPECT_EQ(VL_WS_OK, VL_WS_createFolder(nested.c_str()));
  EXPECT_EQ(VL_WS_OK, VL_WS_folderExist(nested.c_str(), &exists));
  EXPECT_TRUE(exists);
  EXPECT_EQ(VL_WS_OK, VL_WS_createFolder(nested.c_str()));
  ASSERT_TRUE(VLWriteFile(dir / "file", "x"));
  EXPECT_EQ(VL_WS_E_FILE, VL_WS_createFolder((dir / "file/sub").c_str()));
  EXPECT_TRUE(Exists(dir / "file"));
  EXPECT_FALSE(Exists(dir / "nothing"));
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_folderExist(nullptr, &exists));
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_fileExist("x", nullptr));
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_createFolder(nullptr));
}

TEST(ClearLocalCache, RemovesImagesDatabasesAndTemporaryFilesOnly) {
  VLTestDir dir;
  std::string cache = dir / "cache";
  ASSERT_EQ(VL_WS_OK, VL_WS_createFolder(cache.c_str()));
  for (const char* name : {"t1001_175.jpg", "0123abcd.vl", "vlwsA1b2C3", "keep.txt", "ffpreference.xml"})
    ASSERT_TRUE(VLWriteFile(cache + "/" + name, "x"));
  EXPECT_EQ(VL_WS_OK, VL_WS_clearLocalCache(cache.c_str()));  // no "/" at the end
  for (const char* name : {"t1001_175.jpg", "0123abcd.vl", "vlwsA1b2C3"}) EXPECT_FALSE(Exists(cache + "/" + name));
  EXPECT_TRUE(Exists(cache + "/keep.txt"));
  EXPECT_TRUE(Exists(cache + "/ffpreference.xml"));
  EXPECT_EQ(VL_WS_OK, VL_WS_clearLocalCache((cache + "/").c_str()));

  EXPECT_EQ(VL_WS_E_FILE, VL_WS_clearLocalCache((dir / "missing").c_str()));
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_clearLocalCache(""));
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_clearLocalCache(nullptr));
}

}  // namespace
