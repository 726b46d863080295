// Logging: lazy area registration, entry and exit trace, bounded formatting, and InitWSLogs with
// its area masks, targets and return codes. (The SOAP areas are seen at work in the raw-log tests
// of the account operations.)
#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "VLTestDir.h"
#include "VLWSAELog.h"
#include "VL_Log.h"

namespace {

// Captures every message that reaches a log target while it lives.
class CapturedLog {
 public:
  CapturedLog() { VL_LogSetObserver(Observe, this); }
  ~CapturedLog() { VL_LogSetObserver(nullptr, nullptr); }
  std::vector<std::string> lines;

 private:
  static void Observe(void* ctx, const char* area, int level, const char* text, size_t len) {
    static_cast<CapturedLog*>(ctx)->lines.push_back(std::string(area) + ":" + std::to_string(level) +
                                                    ":" + std::string(text, len));
  }
};

// Back to the console with every area off, whatever a test did.
class VLWSAELogTest : public testing::Test {
 protected:
  void TearDown() override { VLWSAELog::InitWSLogs(0, 1, ""); }
};

std::vector<int> ActiveAreas() {
  std::vector<int> active;
  for (const VLWSAELog::AreaInfo& area : VLWSAELog::m_areainfos) active.push_back(VL_LogIsAreaActive(area.id));
  return active;
}

TEST_F(VLWSAELogTest, MaskActivatesExactlyItsAreas) {
  const struct {
    unsigned mask;
    std::vector<int> active;
  } rows[] = {{256, {1, 0, 0, 0, 0, 0}},
              {16128, {1, 1, 1, 1, 1, 1}},
              {0x800 | 0x2000 | 0x1, {0, 0, 0, 1, 0, 1}},
              {0, {0, 0, 0, 0, 0, 0}}};
  for (const auto& row : rows) {
    EXPECT_EQ(0, VLWSAELog::InitWSLogs(row.mask, 1, "")) << row.mask;
    EXPECT_EQ(row.active, ActiveAreas()) << row.mask;
  }
}

TEST_F(VLWSAELogTest, FileTargetInTheGivenOrCurrentDirectory) {
  VLTestDir dir;
  EXPECT_EQ(0, VLWSAELog::InitWSLogs(0x100, 2, dir.path().c_str()));
  VL_LogOutput(VLWSAELog::m_areainfos[0].id, 1, "into the file");
  EXPECT_EQ("[VL_WSAE:1] into the file\n", VLReadFile(dir / "log.txt"));

  // Target 0 selects nothing: result 1, the file stays the target, the areas still change.
  EXPECT_EQ(1, VLWSAELog::InitWSLogs(0x200, 0, ""));
  EXPECT_EQ(std::vector<int>({0, 1, 0, 0, 0, 0}), ActiveAreas());
  VL_LogOutput(VLWSAELog::m_areainfos[1].id, 4, "still the file");
  const std::string written = "[VL_WSAE:1] into the file\n[VL_WSCFGAE:4] still the file\n";
  EXPECT_EQ(written, VLReadFile(dir / "log.txt"));

  // Bit 0 wins over bit 1: the console.
  EXPECT_EQ(0, VLWSAELog::InitWSLogs(0x200, 3, dir.path().c_str()));
  VL_LogOutput(VLWSAELog::m_areainfos[1].id, 4, "to the console");
  EXPECT_EQ(written, VLReadFile(dir / "log.txt"));

  EXPECT_EQ(2, VLWSAELog::InitWSLogs(0x100, 2, (dir.path() + "missing/").c_str()));

  // An empty or missing directory means the current one.
  VLTestDir current;
  {
    VLScopedCurrentDir inside(current.path());
    EXPECT_EQ(0, VLWSAELog::InitWSLogs(0x400, 2, ""));
    VL_LogOutput(VLWSAELog::m_areainfos[2].id, 8, "here");
    EXPECT_EQ(0, VLWSAELog::InitWSLogs(0x400, 2, nullptr));
    VL_LogOutput(VLWSAELog::m_areainfos[2].id, 8, "again");
  }
  EXPECT_EQ("[soap_proxy:8] here\n[soap_proxy:8] again\n", VLReadFile(current / "log.txt"));
}

TEST_F(VLWSAELogTest, ScopeTraceLazyAreaAndBoundedFormatting) {
  static VLLogArea s_Log(VLWSAELOG_AREA_NAME);
  int id = s_Log.Id();
  int registered = -1;
  ASSERT_EQ(0, VL_LogRegisterArea("VL_WSAE", &registered));
  EXPECT_EQ(registered, id);
  EXPECT_EQ(id, s_Log.Id());
  VLLogArea broken(nullptr);  // cannot register: stays unusable
  EXPECT_EQ(-1, broken.Id());
  EXPECT_EQ(-1, broken.Id());

  VLWSAELog::InitWSLogs(0x100, 1, "");
  CapturedLog log;
  {
    VLWSAELog trace("DUDUVudAE", "getTitles", id);
    VLLogOutputwithConfig({id, 8}, "genre %d", 12);
  }
  // A formatted message is cut at 511 characters and not formatted again.
  VLLogOutputwithConfig({id, 4}, "url %s", "a%20b%s%n");
  VLLogOutputwithConfig({id, 1}, "%s", std::string(600, 'x').c_str());
  VLLogOutputwithConfig({VLWSAELog::m_areainfos[1].id, 1}, "inactive area");
  EXPECT_EQ(std::vector<std::string>({"VL_WSAE:4:Entering DUDUVudAE::getTitles", "VL_WSAE:8:genre 12",
                                      "VL_WSAE:4:Exiting DUDUVudAE::getTitles", "VL_WSAE:4:url a%20b%s%n",
                                      "VL_WSAE:1:" + std::string(511, 'x')}),
            log.lines);
}

}  // namespace
