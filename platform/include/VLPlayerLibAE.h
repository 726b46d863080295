// VLPlayerLibAE: the media player's script extension class (class id "com.ostrel.VLPlayerLibAE").
//
// The player library "libVL_PlayerLibAE.so" implements the 19 methods and the instance
// construction and destruction. The application that registers the class supplies the class
// id, the event flag and the method table (GetClassName, FiresEvents, GetMethods).
//
// Stand-in behaviour: no player is asked for. Every method records its call and returns 0.
#ifndef VLPLAYERLIBAE_H
#define VLPLAYERLIBAE_H

#include "AEArray.h"
#include "ASExtensionClass.h"

class VLPlayerLibAE : public ae::stagecraft::ASExtensionClass {
 public:
  // Supplied by the application.
  static const char* GetClassName();
  static bool FiresEvents();
  static void GetMethods(AEArray<Method>& table);

  // Supplied by the player library.
  static ae::stagecraft::ASExtensionClass* ConstructInstance(StageWindow* window, ASObject& object,
                                                             ASValueArray& arguments);
  static void DestructInstance(StageWindow* window, ASObject& object);

  void Initialize(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void Shutdown(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void GetVersion(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void CreatePlayer(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void ReleasePlayer(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void Play(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void Pause(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void Stop(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void GetPlaybackTime(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void GetPlaybackState(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void GetDuration(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void GetCurrentBandwidth(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void RegisterEventHandler(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void THX_ProcessContentDescriptors(StageWindow* window, ASObject& object, ASValueArray& arguments,
                                     ASValue& result);
  void THX_IsSupportedOnDevice(StageWindow* window, ASObject& object, ASValueArray& arguments,
                               ASValue& result);
  void getSupported3DFormats(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void getConfigured3DFormat(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void set3DMode(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void SetLogAreaIDsConfig(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);

  // Stand-in only: the names of the methods called on this instance, in call order.
  const AEArray<const char*>& Calls() const { return m_Calls; }

 private:
  VLPlayerLibAE() = default;
  void Record(const char* method, ASValue& result);

  AEArray<const char*> m_Calls;
};

#endif  // VLPLAYERLIBAE_H
