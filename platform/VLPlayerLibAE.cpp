// The stand-in player library "libVL_PlayerLibAE.so": instances of the player's extension class
// and its 19 methods. No player is asked for: every method records its call and returns 0.
#include "VLPlayerLibAE.h"

#include <new>

ae::stagecraft::ASExtensionClass* VLPlayerLibAE::ConstructInstance(StageWindow*, ASObject&, ASValueArray&) {
  return new (std::nothrow) VLPlayerLibAE;
}

void VLPlayerLibAE::DestructInstance(StageWindow*, ASObject& object) { delete object.GetNativeInstance(); }

void VLPlayerLibAE::Record(const char* method, ASValue& result) {
  m_Calls.Append(method);
  result.SetInteger(0);
}

#define VL_PLAYER_METHOD(name)                                                    \
  void VLPlayerLibAE::name(StageWindow*, ASObject&, ASValueArray&, ASValue& result) { \
    Record(#name, result);                                                        \
  }

VL_PLAYER_METHOD(Initialize)
VL_PLAYER_METHOD(Shutdown)
VL_PLAYER_METHOD(GetVersion)
VL_PLAYER_METHOD(CreatePlayer)
VL_PLAYER_METHOD(ReleasePlayer)
VL_PLAYER_METHOD(Play)
VL_PLAYER_METHOD(Pause)
VL_PLAYER_METHOD(Stop)
VL_PLAYER_METHOD(GetPlaybackTime)
VL_PLAYER_METHOD(GetPlaybackState)
VL_PLAYER_METHOD(GetDuration)
VL_PLAYER_METHOD(GetCurrentBandwidth)
VL_PLAYER_METHOD(RegisterEventHandler)
VL_PLAYER_METHOD(THX_ProcessContentDescriptors)
VL_PLAYER_METHOD(THX_IsSupportedOnDevice)
VL_PLAYER_METHOD(getSupported3DFormats)
VL_PLAYER_METHOD(getConfigured3DFormat)
VL_PLAYER_METHOD(set3DMode)
VL_PLAYER_METHOD(SetLogAreaIDsConfig)
