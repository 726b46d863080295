// The web-service extension class: class functions, method table and methods.
#include "DUDUVudAE.h"

#include <new>

namespace {

// Immediate result of a method called on an instance that init has not initialised.
const int kNotInitialised = -1;

}  // namespace

const char* DUDUVudAE::GetClassName() { return "com.ostrel.DUDUVud"; }

bool DUDUVudAE::FiresEvents() { return false; }

void DUDUVudAE::GetMethods(AEArray<Method>& table) {
  static const Method kMethods[] = {
      Method::Bind("init", &DUDUVudAE::init),
      Method::Bind("clone", &DUDUVudAE::clone),
      Method::Bind("idle", &DUDUVudAE::idle),
      Method::Bind("getNavigation", &DUDUVudAE::getNavigation),
      Method::Bind("getTitles", &DUDUVudAE::getTitles),
      Method::Bind("getTitleListing", &DUDUVudAE::getTitleListing),
      Method::Bind("searchForTitle", &DUDUVudAE::searchForTitle),
      Method::Bind("getRecommendedTitles", &DUDUVudAE::getRecommendedTitles),
      Method::Bind("translateSkuID", &DUDUVudAE::translateSkuID),
      Method::Bind("getTvEpisodeListing", &DUDUVudAE::getTvEpisodeListing),
      Method::Bind("getTvEpisodeListByTitleID", &DUDUVudAE::getTvEpisodeListByTitleID),
      Method::Bind("getAllTvEpisodeListings", &DUDUVudAE::getAllTvEpisodeListings),
      Method::Bind("authorizeDevice", &DUDUVudAE::authorizeDevice),
      Method::Bind("deactivateDevice", &DUDUVudAE::deactivateDevice),
      Method::Bind("checkAuthToken", &DUDUVudAE::checkAuthToken),
      Method::Bind("getBoxArtImage", &DUDUVudAE::getBoxArtImage),
      Method::Bind("getMyVideos", &DUDUVudAE::getMyVideos),
      Method::Bind("getWishlistItems", &DUDUVudAE::getWishlistItems),
      Method::Bind("addItemToWishlist", &DUDUVudAE::addItemToWishlist),
      Method::Bind("removeItemFromWishlist", &DUDUVudAE::removeItemFromWishlist),
      Method::Bind("removeAllItemsFromWishlist", &DUDUVudAE::removeAllItemsFromWishlist),
      Method::Bind("checkTitleInWishlist", &DUDUVudAE::checkTitleInWishlist),
      Method::Bind("checkTitlesInWishlist", &DUDUVudAE::checkTitlesInWishlist),
      Method::Bind("doPurchaseSavedBilling", &DUDUVudAE::doPurchaseSavedBilling),
      Method::Bind("checkForPurchasedTitle", &DUDUVudAE::checkForPurchasedTitle),
      Method::Bind("checkForPurchasedSku", &DUDUVudAE::checkForPurchasedSku),
      Method::Bind("checkAdultVerificationEnabled", &DUDUVudAE::checkAdultVerificationEnabled),
      Method::Bind("checkAdultVerificationPin", &DUDUVudAE::checkAdultVerificationPin),
      Method::Bind("assignGiftCertificateToUser", &DUDUVudAE::assignGiftCertificateToUser),
      Method::Bind("checkRentalExpiration", &DUDUVudAE::checkRentalExpiration),
      Method::Bind("getStreamingAssetLocation", &DUDUVudAE::getStreamingAssetLocation),
      Method::Bind("getStreamingBonusAssetLocation", &DUDUVudAE::getStreamingBonusAssetLocation),
      Method::Bind("loadLastStreamingAssetLocation", &DUDUVudAE::loadLastStreamingAssetLocation),
      Method::Bind("manageStreamingInstanceStatus", &DUDUVudAE::manageStreamingInstanceStatus),
      Method::Bind("getTHXMediaDirector", &DUDUVudAE::getTHXMediaDirector),
      Method::Bind("getTHXMediaDirectorBonusAsset", &DUDUVudAE::getTHXMediaDirectorBonusAsset),
      Method::Bind("getEmailAddress", &DUDUVudAE::getEmailAddress),
      Method::Bind("getBillingInfo", &DUDUVudAE::getBillingInfo),
      Method::Bind("getPrePaidCardBalance", &DUDUVudAE::getPrePaidCardBalance),
      Method::Bind("getConfig", &DUDUVudAE::getConfig),
      Method::Bind("getSettingsPageInfo", &DUDUVudAE::getSettingsPageInfo),
      Method::Bind("getCountryID", &DUDUVudAE::getCountryID),
      Method::Bind("getFileType", &DUDUVudAE::getFileType),
      Method::Bind("updateLocalCache", &DUDUVudAE::updateLocalCache),
      Method::Bind("checkBandwidth", &DUDUVudAE::checkBandwidth),
      Method::Bind("calcOrderTax", &DUDUVudAE::calcOrderTax),
      Method::Bind("quitFlash", &DUDUVudAE::quitFlash),
      Method::Bind("getLocalIPAddr", &DUDUVudAE::getLocalIPAddr),
      Method::Bind("getSysInfo", &DUDUVudAE::getSysInfo),
      Method::Bind("setAudioDefaultProperty", &DUDUVudAE::setAudioDefaultProperty),
      Method::Bind("getAudioDefaultProperty", &DUDUVudAE::getAudioDefaultProperty),
      Method::Bind("getUserAgent", &DUDUVudAE::getUserAgent),
      Method::Bind("setLogAreaIDsAndTargetConfig", &DUDUVudAE::setLogAreaIDsAndTargetConfig),
      Method::Bind("fileExist", &DUDUVudAE::fileExist),
      Method::Bind("getAvailableEnvLists", &DUDUVudAE::getAvailableEnvLists),
      Method::Bind("clearLocalCache", &DUDUVudAE::clearLocalCache),
      Method::Bind("getDeviceEnv", &DUDUVudAE::getDeviceEnv),
      Method::Bind("checkVLSWFmd5sum", &DUDUVudAE::checkVLSWFmd5sum),
      Method::Bind("trace", &DUDUVudAE::trace),
  };
  table.Append(kMethods, sizeof kMethods / sizeof kMethods[0]);
}

ae::stagecraft::ASExtensionClass* DUDUVudAE::ConstructInstance(StageWindow*, ASObject&, ASValueArray&) {
  return new (std::nothrow) DUDUVudAE;
}

void DUDUVudAE::DestructInstance(StageWindow*, ASObject& object) { delete object.GetNativeInstance(); }

// Methods not built yet: they answer as an uninitialised instance does.
#define VL_NOT_INITIALISED(name)                                               \
  void DUDUVudAE::name(StageWindow*, ASObject&, ASValueArray&, ASValue& result) { \
    result.SetInteger(kNotInitialised);                                        \
  }

VL_NOT_INITIALISED(init)
VL_NOT_INITIALISED(clone)
VL_NOT_INITIALISED(idle)
VL_NOT_INITIALISED(getNavigation)
VL_NOT_INITIALISED(getTitles)
VL_NOT_INITIALISED(getTitleListing)
VL_NOT_INITIALISED(searchForTitle)
VL_NOT_INITIALISED(getRecommendedTitles)
VL_NOT_INITIALISED(translateSkuID)
VL_NOT_INITIALISED(getTvEpisodeListing)
VL_NOT_INITIALISED(getTvEpisodeListByTitleID)
VL_NOT_INITIALISED(getAllTvEpisodeListings)
VL_NOT_INITIALISED(authorizeDevice)
VL_NOT_INITIALISED(deactivateDevice)
VL_NOT_INITIALISED(checkAuthToken)
VL_NOT_INITIALISED(getBoxArtImage)
VL_NOT_INITIALISED(getMyVideos)
VL_NOT_INITIALISED(getWishlistItems)
VL_NOT_INITIALISED(addItemToWishlist)
VL_NOT_INITIALISED(removeItemFromWishlist)
VL_NOT_INITIALISED(removeAllItemsFromWishlist)
VL_NOT_INITIALISED(checkTitleInWishlist)
VL_NOT_INITIALISED(checkTitlesInWishlist)
VL_NOT_INITIALISED(doPurchaseSavedBilling)
VL_NOT_INITIALISED(checkForPurchasedTitle)
VL_NOT_INITIALISED(checkForPurchasedSku)
VL_NOT_INITIALISED(checkAdultVerificationEnabled)
VL_NOT_INITIALISED(checkAdultVerificationPin)
VL_NOT_INITIALISED(assignGiftCertificateToUser)
VL_NOT_INITIALISED(checkRentalExpiration)
VL_NOT_INITIALISED(getStreamingAssetLocation)
VL_NOT_INITIALISED(getStreamingBonusAssetLocation)
VL_NOT_INITIALISED(loadLastStreamingAssetLocation)
VL_NOT_INITIALISED(manageStreamingInstanceStatus)
VL_NOT_INITIALISED(getTHXMediaDirector)
VL_NOT_INITIALISED(getTHXMediaDirectorBonusAsset)
VL_NOT_INITIALISED(getEmailAddress)
VL_NOT_INITIALISED(getBillingInfo)
VL_NOT_INITIALISED(getPrePaidCardBalance)
VL_NOT_INITIALISED(getConfig)
VL_NOT_INITIALISED(getSettingsPageInfo)
VL_NOT_INITIALISED(getCountryID)
VL_NOT_INITIALISED(getFileType)
VL_NOT_INITIALISED(updateLocalCache)
VL_NOT_INITIALISED(checkBandwidth)
VL_NOT_INITIALISED(calcOrderTax)
VL_NOT_INITIALISED(quitFlash)
VL_NOT_INITIALISED(getLocalIPAddr)
VL_NOT_INITIALISED(getSysInfo)
VL_NOT_INITIALISED(setAudioDefaultProperty)
VL_NOT_INITIALISED(getAudioDefaultProperty)
VL_NOT_INITIALISED(getUserAgent)
VL_NOT_INITIALISED(setLogAreaIDsAndTargetConfig)
VL_NOT_INITIALISED(fileExist)
VL_NOT_INITIALISED(getAvailableEnvLists)
VL_NOT_INITIALISED(clearLocalCache)
VL_NOT_INITIALISED(getDeviceEnv)
VL_NOT_INITIALISED(checkVLSWFmd5sum)
VL_NOT_INITIALISED(trace)
