// The configuration extension class: class functions, method table and methods.
#include "VLCfgLibAE.h"

#include <new>

const char* VLCfgLibAE::GetClassName() { return "com.ostrel.VLCfgLib"; }

bool VLCfgLibAE::FiresEvents() { return false; }

void VLCfgLibAE::GetMethods(AEArray<Method>& table) {
  static const Method kMethods[] = {
      Method::Bind("init", &VLCfgLibAE::init),
      Method::Bind("setFile", &VLCfgLibAE::setFile),
      Method::Bind("read", &VLCfgLibAE::read),
      Method::Bind("write", &VLCfgLibAE::write),
      Method::Bind("selectEnv", &VLCfgLibAE::selectEnv),
      Method::Bind("clearEnv", &VLCfgLibAE::clearEnv),
  };
  table.Append(kMethods, sizeof kMethods / sizeof kMethods[0]);
}

ae::stagecraft::ASExtensionClass* VLCfgLibAE::ConstructInstance(StageWindow*, ASObject&, ASValueArray&) {
  return new (std::nothrow) VLCfgLibAE;
}

void VLCfgLibAE::DestructInstance(StageWindow*, ASObject& object) { delete object.GetNativeInstance(); }

// Methods not built yet: they give the result each method starts from.
void VLCfgLibAE::init(StageWindow*, ASObject&, ASValueArray&, ASValue& result) { result.SetBoolean(false); }

void VLCfgLibAE::setFile(StageWindow*, ASObject&, ASValueArray&, ASValue& result) { result.SetBoolean(false); }

void VLCfgLibAE::read(StageWindow*, ASObject&, ASValueArray&, ASValue& result) { result.SetString(""); }

void VLCfgLibAE::write(StageWindow*, ASObject&, ASValueArray&, ASValue& result) { result.SetBoolean(false); }

void VLCfgLibAE::selectEnv(StageWindow*, ASObject&, ASValueArray&, ASValue& result) { result.SetBoolean(false); }

void VLCfgLibAE::clearEnv(StageWindow*, ASObject&, ASValueArray&, ASValue& result) { result.SetBoolean(false); }
