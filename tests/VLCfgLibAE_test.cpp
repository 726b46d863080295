// The configuration extension as a movie uses it: script calls on "com.ostrel.VLCfgLib" run
// in-process on the engine, in a temporary current folder, against real settings files; its log
// lines seen through the logging service's observer.
#include <gtest/gtest.h>
#include <stdlib.h>

#include <algorithm>
#include <regex>
#include <string>
#include <vector>

#include "VLFile.h"
#include "VLStage.h"
#include "VLTestDir.h"
#include "VL_Log.h"
#include "VL_WS.h"
#include "VeloraApp.h"

namespace {

const char kIdPattern[] = "[0-9A-F]{2}(-[0-9A-F]{2}){5}";

// One setting of a file: its status and text.
std::string Setting(const std::string& file, const char* key, bool encrypted = false) {
  VL_WS_String value;
  VL_WS_Status status = VL_WS_readSetting(file.c_str(), key, &value, encrypted);
  std::string text = status == VL_WS_OK ? value.Text : "<" + std::to_string(status) + ">";
  VL_WS_release(&value);
  return text;
}

void Put(const std::string& file, const char* key, const char* value, bool encrypted = false) {
  ASSERT_EQ(VL_WS_OK, VL_WS_writeSetting(file.c_str(), key, value, encrypted)) << file << " " << key;
}

// How many settings a file holds.
size_t SettingCount(const std::string& file) {
  std::string xml = VLReadFile(file);
  size_t count = 0;
  for (size_t at = xml.find("Key=\""); at != std::string::npos; at = xml.find("Key=\"", at + 1)) ++count;
  return count;
}

class CfgMovie : public testing::Test {
 protected:
  CfgMovie() : m_Cwd(m_Dir.path()), m_Stage(1), m_Launcher(&m_Stage) {
    unsetenv("VLTEST_CFG");
    unsetenv("VLTEST_PREF");
    m_App = createApplication2();
    m_App->init(&m_Launcher);
    int area = -1;
    VL_LogRegisterArea("VL_WSCFGAE", &area);
    VL_LogActivateArea(area, 1);
    VL_LogSetObserver(Observe, this);
    Run("var cfg = newExtension('com.ostrel.VLCfgLib');");
  }
  ~CfgMovie() override {
    VL_LogSetObserver(nullptr, nullptr);
    m_Stage.Close();
    delete m_App;
  }

  static void Observe(void* self, const char* area, int level, const char* text, size_t len) {
    if (std::string(area) == "VL_WSCFGAE")
      static_cast<CfgMovie*>(self)->m_Log.push_back(std::to_string(level) + ":" + std::string(text, len));
  }

  void Run(const std::string& script) { ASSERT_TRUE(m_Stage.Evaluate("movie.js", script)) << m_Stage.Error(); }
  // The value of a script expression as JSON.
  std::string Eval(const std::string& expression) {
    Run("var answer = JSON.stringify(" + expression + ");");
    return m_Stage.Global().GetProperty("answer").AsString().CString();
  }
  // Whether a log line equals line ("<level>:<text>", the text without its line end), or holds text.
  bool Logged(const std::string& line) const { return std::find(m_Log.begin(), m_Log.end(), line) != m_Log.end(); }
  bool LogMentions(const std::string& text) const {
    return std::any_of(m_Log.begin(), m_Log.end(), [&](const std::string& l) { return l.find(text) != l.npos; });
  }
  std::string Path(const std::string& name) const { return m_Dir / name; }

  VLTestDir m_Dir;
  VLScopedCurrentDir m_Cwd;
  vlplatform::Stage m_Stage;
  vlplatform::Launcher m_Launcher;
  scLauncher::IApplication2* m_App;
  std::vector<std::string> m_Log;
};

// Without the variables init takes the default files; the device identifier is made once and
// kept in the settings file.
TEST_F(CfgMovie, InitWithoutTheVariablesUsesTheDefaultFiles) {
  EXPECT_EQ("true", Eval("cfg.init('VLTEST_CFG', 'VLTEST_PREF')"));
  EXPECT_TRUE(Logged("4:VLCfgLibAE init exit (./ffcredentials.xml) (./ffpreference.xml)"));
  Put(Path("ffcredentials.xml"), "Server", "from the configuration");
  EXPECT_EQ("true", Eval("cfg.write('Volume', '7', false)"));
  EXPECT_EQ("7", Setting(Path("ffpreference.xml"), "Volume"));
  EXPECT_EQ("\"from the configuration\"", Eval("cfg.read('Server', false)"));
  Run("var first = cfg.read('DestinationUniqueID', false), second = cfg.read('DestinationUniqueID', false);");
  std::string first = m_Stage.Global().GetProperty("first").AsString().CString();
  EXPECT_TRUE(std::regex_match(first, std::regex(kIdPattern))) << first;
  EXPECT_EQ(first, m_Stage.Global().GetProperty("second").AsString().CString());
  EXPECT_EQ(first, Setting(Path("ffpreference.xml"), "DestinationUniqueID"));
}

TEST_F(CfgMovie, InitTakesThePathsFromTheVariables) {
  setenv("VLTEST_CFG", Path("etc/credentials.xml").c_str(), 1);
  setenv("VLTEST_PREF", Path("data/preference.xml").c_str(), 1);
  Put(Path("etc/credentials.xml"), "Server", "lab");
  EXPECT_EQ("true", Eval("cfg.init('VLTEST_CFG', 'VLTEST_PREF')"));
  EXPECT_EQ("\"lab\"", Eval("cfg.read('Server', false)"));
  EXPECT_EQ("true", Eval("cfg.write('Volume', '7', false)"));
  EXPECT_EQ("7", Setting(Path("data/preference.xml"), "Volume"));
}

TEST_F(CfgMovie, AWriteShadowsTheConfigurationFileWhichIsNeverWritten) {
  Put(Path("ffcredentials.xml"), "Greeting", "from the configuration");
  std::string configuration = VLReadFile(Path("ffcredentials.xml"));
  Run("cfg.init('VLTEST_CFG', 'VLTEST_PREF');");
  EXPECT_EQ("\"from the configuration\"", Eval("cfg.read('Greeting', false)"));
  EXPECT_EQ("true", Eval("cfg.write('Greeting', 'mine', false)"));
  EXPECT_EQ("\"mine\"", Eval("cfg.read('Greeting', false)"));
  EXPECT_EQ(configuration, VLReadFile(Path("ffcredentials.xml")));
  EXPECT_EQ("\"\"", Eval("cfg.read('Nowhere', false)"));
  EXPECT_EQ("\"\"", Eval("cfg.read('', false)"));
  EXPECT_EQ("false", Eval("cfg.write('', 'x', false)"));
}

TEST_F(CfgMovie, EncryptedValuesAreStoredEncryptedAndNeverLogged) {
  Run("cfg.init('VLTEST_CFG', 'VLTEST_PREF');");
  EXPECT_EQ("true", Eval("cfg.write('AuthToken', 'token-0815', true)"));
  EXPECT_EQ("\"token-0815\"", Eval("cfg.read('AuthToken', true)"));
  EXPECT_EQ(std::string::npos, VLReadFile(Path("ffpreference.xml")).find("token-0815"));
  EXPECT_TRUE(Logged("4:VLCfgLibAE::write (AuthToken, ********, true)"));
  EXPECT_FALSE(LogMentions("token-0815"));
  EXPECT_EQ("true", Eval("cfg.write('Language', 'de', false)"));
  EXPECT_TRUE(Logged("4:VLCfgLibAE::write (Language, de, false)"));
}

// ---- XML upgrade ----

class CfgUpgrade : public CfgMovie {
 protected:
  // New files: a settings file of XMLVersion settingsVersion with a token, an identifier and a
  // preference, and a configuration file of XMLVersion configVersion (each version left out
  // when empty); then the extension's init.
  void InitWith(const char* settingsVersion, const char* configVersion) {
    VL_WS_removeFile(Path("ffpreference.xml").c_str());
    VL_WS_removeFile(Path("ffcredentials.xml").c_str());
    if (*settingsVersion) Put(Path("ffpreference.xml"), "XMLVersion", settingsVersion);
    Put(Path("ffpreference.xml"), "AuthToken", "token-4711", true);
    Put(Path("ffpreference.xml"), "DestinationUniqueID", "00-11-22-33-44-55");
    Put(Path("ffpreference.xml"), "Volume", "7");
    if (*configVersion) Put(Path("ffcredentials.xml"), "XMLVersion", configVersion);
    Put(Path("ffcredentials.xml"), "Server", "production");
    m_Before = VLReadFile(Path("ffpreference.xml"));
    m_Log.clear();
    ASSERT_EQ("true", Eval("cfg.init('VLTEST_CFG', 'VLTEST_PREF')"));
  }
  bool Unchanged() const { return VLReadFile(Path("ffpreference.xml")) == m_Before; }

  std::string m_Before;
};

TEST_F(CfgUpgrade, ANewerOrAFirstConfigurationVersionKeepsExactlyTheThreeKeys) {
  const char* cases[][2] = {{"1.2", "1.3"}, {"", "1.0"}};  // settings version, configuration version
  for (const auto& c : cases) {
    SCOPED_TRACE(c[0]);
    InitWith(c[0], c[1]);
    std::string file = Path("ffpreference.xml");
    EXPECT_EQ(3u, SettingCount(file));
    EXPECT_EQ(c[1], Setting(file, "XMLVersion"));
    EXPECT_EQ("token-4711", Setting(file, "AuthToken", true));
    EXPECT_EQ("00-11-22-33-44-55", Setting(file, "DestinationUniqueID"));
    EXPECT_EQ("<-1906>", Setting(file, "Volume"));
    EXPECT_TRUE(LogMentions("VLCfgLibAE::checkXMLupgrade Updated SettingsFile(Only keep AuthToken, "
                            "DestinationUniqueID and added a new tag XMLVersion)."));
    EXPECT_FALSE(VLFile::Exist((file + ".upgrade").c_str()));
  }
}

TEST_F(CfgUpgrade, AFirstStartGetsAVersionAndANewIdentifier) {
  Put(Path("ffcredentials.xml"), "XMLVersion", "2.0");
  EXPECT_EQ("true", Eval("cfg.init('VLTEST_CFG', 'VLTEST_PREF')"));
  std::string file = Path("ffpreference.xml");
  EXPECT_EQ(2u, SettingCount(file));
  EXPECT_EQ("2.0", Setting(file, "XMLVersion"));
  EXPECT_TRUE(std::regex_match(Setting(file, "DestinationUniqueID"), std::regex(kIdPattern)));
}

TEST_F(CfgUpgrade, EqualOlderMissingOrInvalidVersionsChangeNothing) {
  // settings version, configuration version, the one logged as invalid (if any)
  const char* cases[][3] = {{"1.3", "1.3", nullptr}, {"1.4", "1.3", nullptr}, {"1.9", "1.10", nullptr},
                            {"1.3", "", nullptr},    {"1.2", "1..3", "1..3"}, {"1..2", "1.3", "1..2"},
                            {"1.2", "1.3a", "1.3a"}, {"v1", "1.3", "v1"}};
  for (const auto& c : cases) {
    InitWith(c[0], c[1]);
    EXPECT_TRUE(Unchanged()) << c[0] << " / " << c[1];
    if (c[2] != nullptr) {
      EXPECT_TRUE(Logged(std::string("4:VLCfgLibAE checkXMLupgrade  XMLVersion is invalid value. (") + c[2] + ")"));
    }
  }
}

TEST_F(CfgUpgrade, AFailedRebuildLeavesTheOldFile) {
  // The new file cannot take the old one's place: a folder stands where it is built.
  ASSERT_EQ(VL_WS_OK, VL_WS_createFolder(Path("ffpreference.xml.upgrade/busy").c_str()));
  InitWith("1.2", "1.3");
  EXPECT_TRUE(Unchanged());
  EXPECT_EQ("token-4711", Setting(Path("ffpreference.xml"), "AuthToken", true));
}

TEST_F(CfgUpgrade, ASettingsFileThatCannotBeReadIsNotRebuilt) {
  InitWith("1.2", "1.3");
  std::string file = Path("ffpreference.xml");
  std::string cut = VLReadFile(file).substr(0, 200);
  ASSERT_TRUE(VLWriteFile(file, cut));
  ASSERT_EQ("true", Eval("cfg.init('VLTEST_CFG', 'VLTEST_PREF')"));
  EXPECT_EQ(cut, VLReadFile(file));
  EXPECT_TRUE(Logged("1:VLCfgLibAE::checkXMLupgrade Error: SettingsFile(./ffpreference.xml) cannot be read; it is not "
                     "upgraded."));
}

// ---- Environments ----

TEST_F(CfgMovie, SelectEnvSwitchesAmongTheEnvironmentFiles) {
  Run("cfg.init('VLTEST_CFG', 'VLTEST_PREF');");
  EXPECT_EQ("true", Eval("cfg.selectEnv(0)"));
  EXPECT_TRUE(Logged("4:VLCfgLibAE::selectEnv m_SettingsFile = ./stgapiffpreference.xml"));
  EXPECT_EQ("true", Eval("cfg.write('Volume', 'stgapi', false)"));
  EXPECT_EQ("stgapi", Setting(Path("stgapiffpreference.xml"), "Volume"));
  EXPECT_EQ("true", Eval("cfg.selectEnv('2')"));  // a number as read gives it
  EXPECT_EQ("true", Eval("cfg.write('Volume', 'production', false)"));
  EXPECT_EQ("production", Setting(Path("productionffpreference.xml"), "Volume"));
  EXPECT_EQ("true", Eval("cfg.selectEnv(3)"));
  EXPECT_TRUE(Logged("4:VLCfgLibAE::selectEnv m_SettingsFile = ./ffpreference.xml"));
  EXPECT_EQ("\"\"", Eval("cfg.read('Volume', false)"));

  for (const char* bad :
       {"cfg.selectEnv(4)", "cfg.selectEnv(-1)", "cfg.selectEnv('x')", "cfg.selectEnv('')", "cfg.selectEnv()",
        "cfg.selectEnv(1, 2)"})
    EXPECT_EQ("false", Eval(bad)) << bad;
  EXPECT_TRUE(LogMentions("There is no environment 4"));
}

TEST_F(CfgMovie, EnvironmentFilesLieBesideTheBaseFile) {
  std::string base = Path("data/ffpreference.xml");
  Run("cfg.setFile('', '" + base + "');");
  EXPECT_EQ("true", Eval("cfg.selectEnv(1)"));
  EXPECT_EQ("true", Eval("cfg.write('Volume', 'stg', false)"));
  EXPECT_EQ("stg", Setting(Path("data/stgffpreference.xml"), "Volume"));

  Run("cfg.setFile('', 'pref.xml');");
  EXPECT_EQ("true", Eval("cfg.selectEnv(1)"));
  EXPECT_TRUE(Logged("4:VLCfgLibAE::selectEnv m_SettingsFile = ./stgpref.xml"));
}

TEST_F(CfgMovie, EnvironmentPathsOfAHundredBytesOrMoreAreRefused) {
  // The path of environment 0 is the folder, "stgapi" and the file name: 99 bytes fit, 100 not.
  std::string folder = "./" + std::string(32, 'f') + "/";
  std::string fits = folder + std::string(99 - folder.size() - 6, 'p');
  std::string tooLong = fits + "p";
  Run("cfg.setFile('', '" + fits + "');");
  EXPECT_EQ("true", Eval("cfg.selectEnv(0)"));
  Run("cfg.setFile('', '" + tooLong + "');");
  EXPECT_EQ("false", Eval("cfg.selectEnv(0)"));
  EXPECT_EQ("false", Eval("cfg.clearEnv(0)"));
  EXPECT_EQ("true", Eval("cfg.selectEnv(3)"));
}

TEST_F(CfgMovie, ClearEnvDeletesOneEnvironmentFileAndKeepsTheSelection) {
  Run("cfg.init('VLTEST_CFG', 'VLTEST_PREF'); cfg.write('Volume', 'base', false);"
      "cfg.selectEnv(1); cfg.write('Volume', 'stg', false);");
  EXPECT_EQ("true", Eval("cfg.clearEnv(1)"));
  EXPECT_FALSE(VLFile::Exist(Path("stgffpreference.xml").c_str()));
  EXPECT_EQ("true", Eval("cfg.clearEnv(1)"));
  EXPECT_EQ("true", Eval("cfg.clearEnv(3)"));
  EXPECT_FALSE(VLFile::Exist(Path("ffpreference.xml").c_str()));
  EXPECT_EQ("false", Eval("cfg.clearEnv(7)"));
  EXPECT_EQ("true", Eval("cfg.write('Volume', 'stg again', false)"));
  EXPECT_EQ("stg again", Setting(Path("stgffpreference.xml"), "Volume"));
}

// ---- setFile ----

// setFile takes two or four paths (empty ones keep the files in use); other counts give every
// method's initial result.
TEST_F(CfgMovie, SetFileAndWrongArgumentCounts) {
  for (const char* call : {"cfg.setFile('a.xml', 'b.xml', 'c.xml')", "cfg.setFile('a.xml')", "cfg.init('VLTEST_CFG')",
                           "cfg.write('Volume', '1')", "cfg.clearEnv()"})
    EXPECT_EQ("false", Eval(call)) << call;
  EXPECT_EQ("\"\"", Eval("cfg.read('Volume')"));
  EXPECT_TRUE(Logged("1:VLCfgLibAE::setFile Error:INVALID_PARAMETER, There should be two or four input parameters."));
  EXPECT_EQ("true", Eval("cfg.setFile('cred.xml', 'pref.xml')"));
  EXPECT_EQ("true", Eval("cfg.write('Volume', '3', false)"));
  EXPECT_EQ("3", Setting(Path("pref.xml"), "Volume"));
  EXPECT_EQ("true", Eval("cfg.setFile('', '')"));
  EXPECT_EQ("\"3\"", Eval("cfg.read('Volume', false)"));
}

class CfgMigration : public CfgMovie {
 protected:
  CfgMigration()
      : m_Settings(Path("app/2_05/ffpreference.xml")),
        m_US(Path("app/1_00/ffpreference.xml")),
        m_BC(Path("old/ffpreference.xml")),
        m_Cache(Path("oldcache/")) {
    Put(m_BC, "AuthToken", "token-of-the-old-release", true);
    VL_WS_createFolder(m_Cache.c_str());
    VLWriteFile(m_Cache + "t1_175.jpg", "jpeg");
    VLWriteFile(m_Cache + "0a1b.vl", "db");
  }
  std::string SetFile(const std::string& bc) {
    return Eval("cfg.setFile('', '" + m_Settings + "', '" + bc + "', '" + m_Cache + "')");
  }

  std::string m_Settings, m_US, m_BC, m_Cache;
};

TEST_F(CfgMigration, TheOldSettingsMoveToTheOldReleasesFolder) {
  EXPECT_EQ("true", SetFile(m_BC));
  EXPECT_EQ("token-of-the-old-release", Setting(m_US, "AuthToken", true));
  EXPECT_FALSE(VLFile::Exist(m_BC.c_str()));
  EXPECT_FALSE(VLFile::Exist((m_Cache + "t1_175.jpg").c_str()));
  EXPECT_FALSE(VLFile::Exist((m_Cache + "0a1b.vl").c_str()));
  EXPECT_TRUE(
      Logged("4:VLCfgLibAE::setFile Successfully copy BCSettingsFile(" + m_BC + ") to USSettingsFile(" + m_US + ")."));
  // Nothing is left to migrate the next time.
  m_Log.clear();
  EXPECT_EQ("true", SetFile(m_BC));
  EXPECT_FALSE(LogMentions("USSettingsFile("));
}

TEST_F(CfgMigration, TheOldFileStaysWhenItCouldNotBeCopied) {
  // A file stands where the old release's folder would be created.
  ASSERT_EQ(VL_WS_OK, VL_WS_createFolder(Path("app").c_str()));
  ASSERT_TRUE(VLWriteFile(Path("app/1_00"), "in the way"));
  EXPECT_EQ("true", SetFile(m_BC));
  EXPECT_EQ("token-of-the-old-release", Setting(m_BC, "AuthToken", true));
  EXPECT_TRUE(LogMentions("Failed to copy BCSettingsFile(" + m_BC + ")"));
  EXPECT_FALSE(LogMentions("remove BCSettingsFile"));
  EXPECT_TRUE(LogMentions("clear BCCachePath"));
}

// An old file that is the old release's file itself is left alone, and an existing file of the
// old release is never overwritten.
TEST_F(CfgMigration, AnExistingFileOfTheOldReleaseIsKept) {
  Put(m_US, "AuthToken", "token-already-there", true);
  EXPECT_EQ("true", SetFile(m_US));
  EXPECT_TRUE(VLFile::Exist((m_Cache + "t1_175.jpg").c_str()));
  EXPECT_FALSE(LogMentions("USSettingsFile("));
  EXPECT_EQ("true", SetFile(m_BC));
  EXPECT_EQ("token-already-there", Setting(m_US, "AuthToken", true));
  EXPECT_FALSE(VLFile::Exist(m_BC.c_str()));
  EXPECT_TRUE(Logged("4:VLCfgLibAE::setFile USSettingsFile(" + m_US + ") existed."));
  EXPECT_FALSE(LogMentions("copy BCSettingsFile"));
}

}  // namespace
