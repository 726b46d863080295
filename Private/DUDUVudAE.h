// DUDUVudAE: the native side of the script class "com.ostrel.DUDUVud", through which the movie
// reaches the store's web services. Every method has the common extension method signature and
// writes its immediate result into its last argument.
#ifndef DUDUVUDAE_H
#define DUDUVUDAE_H

#include "AEArray.h"
#include "ASExtensionClass.h"

class DUDUVudAE : public ae::stagecraft::ASExtensionClass {
 public:
  // The class functions that register the class with the stage.
  static const char* GetClassName();
  static bool FiresEvents();
  // Appends the 59 method entries, in table order, at the end of table.
  static void GetMethods(AEArray<Method>& table);
  static ae::stagecraft::ASExtensionClass* ConstructInstance(StageWindow* window, ASObject& object,
                                                             ASValueArray& arguments);
  static void DestructInstance(StageWindow* window, ASObject& object);

  void init(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void clone(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void idle(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void getNavigation(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void getTitles(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void getTitleListing(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void searchForTitle(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void getRecommendedTitles(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void translateSkuID(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void getTvEpisodeListing(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void getTvEpisodeListByTitleID(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void getAllTvEpisodeListings(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void authorizeDevice(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void deactivateDevice(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void checkAuthToken(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void getBoxArtImage(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void getMyVideos(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void getWishlistItems(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void addItemToWishlist(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void removeItemFromWishlist(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void removeAllItemsFromWishlist(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void checkTitleInWishlist(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void checkTitlesInWishlist(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void doPurchaseSavedBilling(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void checkForPurchasedTitle(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void checkForPurchasedSku(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void checkAdultVerificationEnabled(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void checkAdultVerificationPin(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void assignGiftCertificateToUser(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void checkRentalExpiration(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void getStreamingAssetLocation(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void getStreamingBonusAssetLocation(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void loadLastStreamingAssetLocation(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void manageStreamingInstanceStatus(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void getTHXMediaDirector(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void getTHXMediaDirectorBonusAsset(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void getEmailAddress(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void getBillingInfo(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void getPrePaidCardBalance(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void getConfig(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void getSettingsPageInfo(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void getCountryID(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void getFileType(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void updateLocalCache(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void checkBandwidth(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void calcOrderTax(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void quitFlash(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void getLocalIPAddr(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void getSysInfo(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void setAudioDefaultProperty(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void getAudioDefaultProperty(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void getUserAgent(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void setLogAreaIDsAndTargetConfig(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void fileExist(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void getAvailableEnvLists(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void clearLocalCache(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void getDeviceEnv(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void checkVLSWFmd5sum(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
  void trace(StageWindow* window, ASObject& object, ASValueArray& arguments, ASValue& result);
};

#endif  // DUDUVUDAE_H
