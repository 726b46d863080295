// The settings and file operations of the flat interface on real files: settings through
// VL_WS_readSetting / VL_WS_writeSetting and their statuses (the file format itself is
// CfgXMLFile's), the environment file, md5sum with hostile file names, and the file and folder
// helpers.
#include <gtest/gtest.h>

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

Read ReadSetting(const std::string& file, const char* key, bool encrypted = false) {
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

// The file format (order, replacement, damaged files kept aside) is CfgXMLFile's; here the
// statuses the flat interface gives for each outcome.
TEST(Settings, ValuesRoundTripAndEveryFailureHasItsStatus) {
  VLTestDir dir;
  std::string file = dir / "app/2_05/ffpreference.xml";  // the folder is made
  EXPECT_EQ(VL_WS_E_FILE, ReadSetting(file, "A").status);
  ASSERT_EQ(VL_WS_OK, Write(file, "A", "first"));
  ASSERT_EQ(VL_WS_OK, Write(file, "A", "third"));
  EXPECT_EQ(VL_WS_OK, ReadSetting(file, "A").status);
  EXPECT_EQ("third", ReadSetting(file, "A").text);
  EXPECT_EQ(VL_WS_E_SETTING_MISSING, ReadSetting(file, "B").status);

  const char token[] = "7f0c2a1e-token-of-the-account";
  ASSERT_EQ(VL_WS_OK, Write(file, "AuthToken", token, true));
  EXPECT_EQ(token, ReadSetting(file, "AuthToken", true).text);
  EXPECT_EQ(std::string::npos, VLReadFile(file).find("token-of-the-account"));
  // Check digits that match a cipher text that does not decrypt.
  EVPCipher cipher(EVPCipher::AES_128_CBC);
  VLString garbage = EVPCipher::SimpleEncode(reinterpret_cast<const unsigned char*>("0123456789abcdef"), 16);
  ASSERT_EQ(VL_WS_OK, Write(file, "AuthToken", CfgXMLFile::PackEncryptedValue(garbage, cipher.GeneratePswd()).c_str()));
  Read got = ReadSetting(file, "AuthToken", true);
  EXPECT_EQ(VL_WS_E_SETTING_DAMAGED, got.status);
  EXPECT_EQ("", got.text);

  std::string other = dir / "other.xml";
  ASSERT_TRUE(VLWriteFile(other, "<DUDUVud><VL1:Configuration Key=\"A\">"));
  EXPECT_EQ(VL_WS_E_SETTING_UNREADABLE, ReadSetting(other, "A").status);
  ASSERT_TRUE(VLWriteFile(dir / "blocker", "a file where a folder should be"));
  EXPECT_EQ(VL_WS_E_FILE, Write(dir / "blocker/ffpreference.xml", "A", "1"));

  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, ReadSetting(file, "").status);
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, ReadSetting("", "A").status);
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_readSetting(file.c_str(), "A", nullptr, false));
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, Write(file, "", "1"));
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, Write("", "A", "1"));
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, Write(file, "A", nullptr));
  EXPECT_EQ("third", ReadSetting(file, "A").text);
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

  EXPECT_EQ(VL_WS_OK, VL_WS_deleteEnvXML(destination.c_str()));
  EXPECT_FALSE(Exists(destination));
  EXPECT_EQ(VL_WS_OK, VL_WS_deleteEnvXML(destination.c_str()));
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_deleteEnvXML(nullptr));
}

TEST(Md5sum, FileNamesReachTheCommandAsOneWordAndAreNeverRunByTheShell) {
  VLTestDir dir;
  std::string file = dir / "VLStore.swf";
  ASSERT_TRUE(VLWriteFile(file, "hello\n"));
  VL_WS_Status status;
  EXPECT_EQ("b1946ac92492d2347c6235b4d2611184  " + file + "\n", Md5sum(file, &status));
  EXPECT_EQ(VL_WS_OK, status);

  std::string pwned = dir / "pwned";
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

// The copy itself, the folders and the names are VLFile's; here the statuses of the flat
// interface and what a failure leaves.
TEST(FileHelpers, StatusesAndWhatAFailureLeaves) {
  VLTestDir dir;
  std::string file = dir / "a.xml", copy = dir / "b.xml";
  ASSERT_TRUE(VLWriteFile(file, "content"));
  EXPECT_EQ(VL_WS_OK, VL_WS_copyFile(file.c_str(), copy.c_str()));
  EXPECT_EQ("content", VLReadFile(copy));
  EXPECT_EQ(VL_WS_E_FILE, VL_WS_copyFile(file.c_str(), file.c_str()));
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_copyFile(nullptr, copy.c_str()));
  EXPECT_EQ(VL_WS_OK, VL_WS_removeFile(copy.c_str()));
  EXPECT_FALSE(Exists(copy));
  EXPECT_EQ(VL_WS_OK, VL_WS_removeFile(copy.c_str()));
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_removeFile(nullptr));

  std::string nested = dir / "full/inner";
  bool exists = true;
  EXPECT_EQ(VL_WS_OK, VL_WS_folderExist(nested.c_str(), &exists));
  EXPECT_FALSE(exists);
  EXPECT_EQ(VL_WS_OK, VL_WS_createFolder(nested.c_str()));
  EXPECT_EQ(VL_WS_OK, VL_WS_folderExist(nested.c_str(), &exists));
  EXPECT_TRUE(exists);
  EXPECT_EQ(VL_WS_OK, VL_WS_createFolder(nested.c_str()));
  EXPECT_EQ(VL_WS_E_FILE, VL_WS_removeFile((dir / "full").c_str()));
  EXPECT_EQ(VL_WS_E_FILE, VL_WS_createFolder((file + "/sub").c_str()));
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_folderExist(nullptr, &exists));
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_fileExist("x", nullptr));
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_createFolder(nullptr));

  // A failed copy leaves no new destination: a missing source, or a folder, which opens but
  // fails every read.
  for (auto copy : {VL_WS_copyFile, VL_WS_createEnvXML}) {
    EXPECT_EQ(VL_WS_E_FILE, copy((dir / "missing.xml").c_str(), (dir / "destination.xml").c_str()));
    EXPECT_FALSE(Exists(dir / "destination.xml"));
  }
  EXPECT_EQ(VL_WS_E_FILE, VL_WS_copyFile((dir / "full").c_str(), (dir / "destination.xml").c_str()));
  EXPECT_FALSE(Exists(dir / "destination.xml"));

  VL_WS_String folder;
  EXPECT_EQ(VL_WS_OK, VL_WS_getFolderName("/data/app/2_05/ffpreference.xml", &folder));
  EXPECT_EQ("/data/app/2_05/", std::string(folder.Text, folder.Length));
  VL_WS_release(&folder);
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_getFolderName(nullptr, &folder));
  EXPECT_EQ(VL_WS_OK, VL_WS_release(&folder));
}

}  // namespace
