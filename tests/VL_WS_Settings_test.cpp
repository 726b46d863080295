// The settings and file operations of the flat interface: what the settings-* sessions cannot
// write (null arguments, the tag of a refused record, names with quotes and new lines) and md5sum
// with hostile file names.
#include <gtest/gtest.h>

#include <string>

#include "VLTestDir.h"
#include "VL_WS.h"

namespace {

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

TEST(Settings, NullArgumentsAreRefusedAndARefusedRecordIsTagged) {
  VLTestDir dir;
  std::string file = dir / "ffpreference.xml";
  VL_WS_String value;
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_readSetting(file.c_str(), "", &value, false));
  EXPECT_NE(nullptr, value.tag);
  EXPECT_EQ(VL_WS_OK, VL_WS_release(&value));
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_readSetting(file.c_str(), "A", nullptr, false));
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_writeSetting(file.c_str(), "A", nullptr, false));
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_createEnvXML(nullptr, file.c_str()));
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_deleteEnvXML(nullptr));
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_copyFile(nullptr, file.c_str()));
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_removeFile(nullptr));
  bool exists = true;
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_folderExist(nullptr, &exists));
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_fileExist("x", nullptr));
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_createFolder(nullptr));
  VL_WS_String text;
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_getFolderName(nullptr, &text));
  EXPECT_EQ(VL_WS_OK, VL_WS_release(&text));
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_checkVLSWFmd5sum(nullptr, &text));
  EXPECT_EQ(VL_WS_OK, VL_WS_release(&text));
  EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT, VL_WS_checkVLSWFmd5sum("x", nullptr));
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
  EXPECT_EQ("b1946ac92492d2347c6235b4d2611184  " + quoted + "\n", Md5sum(quoted, &status));
}

}  // namespace
