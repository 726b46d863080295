// The application's part of the player class: its class id, event flag and method table. The
// methods themselves, and the instances, come from the player library.
#include "VLPlayerLibAE.h"

const char* VLPlayerLibAE::GetClassName() { return "com.ostrel.VLPlayerLibAE"; }

bool VLPlayerLibAE::FiresEvents() { return false; }

void VLPlayerLibAE::GetMethods(AEArray<Method>& table) {
  static const Method kMethods[] = {
      Method::Bind("Initialize", &VLPlayerLibAE::Initialize),
      Method::Bind("Shutdown", &VLPlayerLibAE::Shutdown),
      Method::Bind("GetVersion", &VLPlayerLibAE::GetVersion),
      Method::Bind("CreatePlayer", &VLPlayerLibAE::CreatePlayer),
      Method::Bind("ReleasePlayer", &VLPlayerLibAE::ReleasePlayer),
      Method::Bind("Play", &VLPlayerLibAE::Play),
      Method::Bind("Pause", &VLPlayerLibAE::Pause),
      Method::Bind("Stop", &VLPlayerLibAE::Stop),
      Method::Bind("GetPlaybackTime", &VLPlayerLibAE::GetPlaybackTime),
      Method::Bind("GetPlaybackState", &VLPlayerLibAE::GetPlaybackState),
      Method::Bind("GetDuration", &VLPlayerLibAE::GetDuration),
      Method::Bind("GetCurrentBandwidth", &VLPlayerLibAE::GetCurrentBandwidth),
      Method::Bind("RegisterEventHandler", &VLPlayerLibAE::RegisterEventHandler),
      Method::Bind("THX_ProcessContentDescriptors", &VLPlayerLibAE::THX_ProcessContentDescriptors),
      Method::Bind("THX_IsSupportedOnDevice", &VLPlayerLibAE::THX_IsSupportedOnDevice),
      Method::Bind("getSupported3DFormats", &VLPlayerLibAE::getSupported3DFormats),
      Method::Bind("getConfigured3DFormat", &VLPlayerLibAE::getConfigured3DFormat),
      Method::Bind("set3DMode", &VLPlayerLibAE::set3DMode),
      Method::Bind("SetLogAreaIDsConfig", &VLPlayerLibAE::SetLogAreaIDsConfig),
  };
  table.Append(kMethods, sizeof kMethods / sizeof kMethods[0]);
}
