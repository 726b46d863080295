// The stage that the launcher offers applications, and the launcher's run of one application.
#include "VLStage.h"

#include <cerrno>
#include <cstring>
#include <fstream>
#include <sstream>

#include "ScriptEngine.h"

namespace vlplatform {

Stage::Stage(int frameIntervalMs) : m_Impl(new ae::stagecraft::ScriptEngine(frameIntervalMs)) {}

Stage::~Stage() = default;

AEError Stage::RegisterExtensionClass(const ae::stagecraft::ASExtensionClassDescriptor& descriptor) {
  return m_Impl->RegisterClass(descriptor);
}

void Stage::SendKeyPress(unsigned int keyCode, unsigned int modifiers) {
  m_Keys.push_back(KeyEvent{keyCode, true, modifiers});
}

void Stage::SendKeyRelease(unsigned int keyCode) { m_Keys.push_back(KeyEvent{keyCode, false, 0}); }

bool Stage::Evaluate(const std::string& name, const std::string& source) {
  return m_Impl->Evaluate(name, source);
}

bool Stage::EvaluateFile(const std::string& path) {
  std::ifstream in(path, std::ios::binary);
  std::stringstream source;
  source << in.rdbuf();
  if (!in) {
    m_Impl->SetError("cannot read the movie script " + path + ": " + strerror(errno));
    return false;
  }
  return m_Impl->Evaluate(path, source.str());
}

void Stage::RunFrames() { m_Impl->RunFrames(); }

void Stage::Close() { m_Impl->Close(); }

bool Stage::Ended() const { return m_Impl->Ended(); }

int Stage::ExitStatus() const { return m_Impl->ExitStatus(); }

const std::string& Stage::Error() const { return m_Impl->Error(); }

ae::stagecraft::ASObject Stage::Global() const { return m_Impl->Global(); }

ae::stagecraft::StageWindow* Stage::Window() { return m_Impl.get(); }

const ae::stagecraft::ASExtensionClassDescriptor* Stage::FindClass(const char* classId) const {
  return m_Impl->FindClass(classId);
}

std::vector<std::string> Stage::ClassIds() const { return m_Impl->ClassIds(); }

int RunApplication(scLauncher::IApplication2* application, Stage& stage,
                   const std::vector<std::string>& scriptFiles) {
  Launcher launcher(&stage);
  application->init(&launcher);
  for (const std::string& file : scriptFiles) {
    if (!stage.EvaluateFile(file) || stage.Ended()) break;
  }
  stage.RunFrames();
  stage.Close();
  application->onTerminate();
  delete application;
  return stage.ExitStatus();
}

}  // namespace vlplatform
