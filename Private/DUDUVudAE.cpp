// The web-service extension class: the method table, the request machinery, the workers that
// call the store operations and the synchronous methods.
#include "DUDUVudAE.h"

#include <stdio.h>
#include <stdlib.h>
#include <string.h>

#include <initializer_list>
#include <mutex>
#include <new>
#include <system_error>
#include <thread>
#include <utility>
#include <vector>

#include "VLAssert.h"
#include "VLWSAELog.h"

namespace {

VLLogArea s_Log(VLWSAELOG_AREA_NAME);

VLLogOutputConfig Trace() { return {s_Log.Id(), 4}; }
VLLogOutputConfig Error() { return {s_Log.Id(), 1}; }
VLLogOutputConfig Detail() { return {s_Log.Id(), 8}; }

// Immediate codes of the methods.
const int kAccepted = 0;
const int kNotInitialised = -1;
const int kBusy = -2;
const int kWrongArguments = -3;
const int kAlreadyInitialised = -4;
const int kQueryFailed = -5;

const char kClassName[] = "DUDUVudAE";

using ae::stagecraft::ASObject;
using ae::stagecraft::ASValue;
using ae::stagecraft::ASValueArray;
typedef DUDUVudAE::Param Param;

int Int(const ASObject& parameters, const char* name) { return parameters.GetProperty(name).AsInteger(); }
AEString Text(const ASObject& parameters, const char* name) { return parameters.GetProperty(name).AsString(); }

// The one argument of an asynchronous method: an "Array" of exactly `elements` valid objects,
// [callback] or [callback, parameters].
bool ReadArguments(const ASValueArray& arguments, size_t elements, ASObject* callback, ASObject* parameters) {
  if (arguments.Count() != 1) return false;
  ASObject array = arguments.Get(0).AsObject();
  if (!array.IsValid() || !array.IsInstanceOf("Array") || array.GetLength() != elements) return false;
  ASObject objects[2];
  for (size_t i = 0; i < elements; ++i) {
    objects[i] = array.GetElement(i).AsObject();
    if (!objects[i].IsValid()) return false;
  }
  *callback = objects[0];
  *parameters = objects[1];
  return true;
}

// The one argument of a synchronous method that takes a path, as text; false without one.
bool TextArgument(const ASValueArray& arguments, AEString* text) {
  if (arguments.Count() != 1 || !arguments.Get(0).IsString()) return false;
  *text = arguments.Get(0).AsString();
  return true;
}

// The record of init: the setup properties.
struct Param_init : Param {
  Param_init(DUDUVudAE* owner, const ASObject& p)
      : Param(owner),
        APIKey(Text(p, "APIKey")),
        UserName(Text(p, "UserName")),
        Password(Text(p, "Password")),
        DestinationTypeID(Int(p, "DestinationTypeID")),
        AuthToken(Text(p, "AuthToken")),
        DestinationUniqueID(Text(p, "DestinationUniqueID")),
        ServiceBaseURL(Text(p, "ServiceBaseURL")),
        Type(Int(p, "Type")),
        CacheType(Int(p, "CacheType")),
        CacheData(Int(p, "CacheData")),
        CachePath(Text(p, "CachePath")),
        CacheLimit(Int(p, "CacheLimit")),
        ProxyHost(Text(p, "ProxyHost")),
        ProxyUserName(Text(p, "ProxyUserName")),
        ProxyPort(Int(p, "ProxyPort")),
        ProxyPassword(Text(p, "ProxyPassword")),
        AccessType(Int(p, "AccessType")),
        ApplicationRevision(Text(p, "ApplicationRevision")),
        EnvNum(Int(p, "EnvNum")),
        firmwareVersion(Text(p, "firmwareVersion")),
        modelNumber(Text(p, "modelNumber")) {}

  AEString APIKey, UserName, Password;
  int DestinationTypeID;
  AEString AuthToken, DestinationUniqueID, ServiceBaseURL;
  int Type, CacheType, CacheData;
  AEString CachePath;
  int CacheLimit;
  AEString ProxyHost, ProxyUserName;
  int ProxyPort;
  AEString ProxyPassword;
  int AccessType;
  AEString ApplicationRevision;
  int EnvNum;
  AEString firmwareVersion, modelNumber;
};

// The record of every store method: its integer properties in the order its table entry names
// them, and the text, flag or identifier list of the few methods that take one.
struct Param_Store : Param {
  using Param::Param;
  int i[5] = {};
  AEString text;
  bool flag = false;
  AEArray<int> ids;
};

Param_Store& Record(void* p) { return *static_cast<Param_Store*>(static_cast<Param*>(p)); }

}  // namespace

// One entry of the method table. Entries with `own` are bound to that member function; the
// others are store methods, bound to StoreMethod<their index>, which reads `ints` (and, through
// `read`, anything else) into a Param_Store and runs `worker` on it.
struct DUDUVudAE::MethodEntry {
  const char* name;
  MethodFunction own;
  size_t elements;
  const char* ints[5];
  // Reads what is not an integer and keeps what prefetching needs; false: wrong arguments.
  bool (*read)(DUDUVudAE& owner, const ASObject& parameters, Param_Store& record);
  void (*worker)(void* record);
  Result_Type result;
};

// --- Workers: each calls its operation on the main client and finishes its record -------------

namespace DUDUVud {
namespace {

void init(void* p) {
  Param_init& r = *static_cast<Param_init*>(static_cast<Param*>(p));
  VL_WS_SetupParams setup = {};
  setup.APIKey = r.APIKey.CString();
  setup.AuthToken = r.AuthToken.CString();
  setup.DestinationUniqueID = r.DestinationUniqueID.CString();
  setup.DestinationTypeID = r.DestinationTypeID;
  setup.UserName = r.UserName.CString();
  setup.Password = r.Password.CString();
  setup.ServiceBaseURL = r.ServiceBaseURL.CString();
  setup.ContentType = static_cast<enum VL_WS_SetupParams::ContentType>(r.Type);
  setup.EnvNum = static_cast<VL_WS_EnvNum>(r.EnvNum);
  setup.CacheType = r.CacheType;
  setup.CacheData = static_cast<VL_WS_CacheParam::CacheData>(r.CacheData);
  setup.CacheLimit = static_cast<unsigned int>(r.CacheLimit);
  setup.CachePath = r.CachePath.CString();
  setup.ProxyHost = r.ProxyHost.CString();
  setup.ProxyPort = r.ProxyPort;
  setup.ProxyUserName = r.ProxyUserName.CString();
  setup.ProxyPassword = r.ProxyPassword.CString();
  setup.AccessType = static_cast<VL_WS_AccessType>(r.AccessType);
  setup.ApplicationRevision = r.ApplicationRevision.CString();
  setup.firmwareVersion = r.firmwareVersion.CString();
  setup.modelNumber = r.modelNumber.CString();
  r.FinishInit(VL_WS_initialize(r.Client(), &setup));
}

void getNavigation(void* p) {
  Param_Store& r = Record(p);
  r.Finish(VL_WS_getNavigation(r.Client(), &r.Out().Genres));
}

void getTitles(void* p) {
  Param_Store& r = Record(p);
  r.Finish(VL_WS_getTitles(r.Client(), r.i[0], r.i[1], r.i[2], r.i[3], &r.Out().Titles));
}

void getTitleListing(void* p) {
  Param_Store& r = Record(p);
  r.Finish(VL_WS_getTitleListing(r.Client(), r.i[0], &r.Out().TitleListing));
}

void searchForTitle(void* p) {
  Param_Store& r = Record(p);
  r.Finish(VL_WS_searchForTitle(r.Client(), r.i[0], r.i[1], r.i[2], r.i[3], r.text.CString(), &r.Out().Titles));
}

void getRecommendedTitles(void* p) {
  Param_Store& r = Record(p);
  r.Finish(VL_WS_getRecommendedTitles(r.Client(), r.i[0], &r.Out().Recommended));
}

void translateSkuID(void* p) {
  Param_Store& r = Record(p);
  r.Finish(VL_WS_translateSkuID(r.Client(), r.i[0], &r.Out().SkuTranslation));
}

void getTvEpisodeListing(void* p) {
  Param_Store& r = Record(p);
  r.Finish(VL_WS_getTvEpisodeListing(r.Client(), r.i[0], &r.Out().TitleListing));
}

void getTvEpisodeListByTitleID(void* p) {
  Param_Store& r = Record(p);
  r.Finish(VL_WS_getTvEpisodeListByTitleID(r.Client(), r.i[0], &r.Out().Episodes));
}

void getAllTvEpisodeListings(void* p) {
  Param_Store& r = Record(p);
  r.Finish(VL_WS_getAllTvEpisodeListings(r.Client(), r.i[0], &r.Out().AllEpisodes));
}

void authorizeDevice(void* p) {
  Param_Store& r = Record(p);
  VL_WS_Status status = VL_WS_authorizeDevice(r.Client(), r.i[0], &r.Out().Authorization);
  if (status == VL_WS_OK) r.RenewUserDataClient("DUDUVud::authorizeDevice duplicate\n");
  r.Finish(status);
}

void deactivateDevice(void* p) {
  Param_Store& r = Record(p);
  VL_WS_Status status = VL_WS_deactivateDevice(r.Client(), &r.Out().Standard);
  if (status == VL_WS_OK) r.RenewUserDataClient("DUDUVud::deactivateDevice duplicate\n");
  r.Finish(status);
}

void checkAuthToken(void* p) {
  Param_Store& r = Record(p);
  r.Finish(VL_WS_checkAuthToken(r.Client(), &r.Out().Bool));
}

void getBoxArtImage(void* p) {
  Param_Store& r = Record(p);
  VL_WS_Status status = VL_WS_getBoxArtImage(r.Client(), static_cast<VL_WS_BoxArtSize>(r.i[0]), r.text.CString(),
                                             &r.Out().String);
  VLLogOutputwithConfig(Trace(), "DUDUVud::getBoxArtImage,ret:%d,boxartprefix:%s\n", status, r.text.CString());
  r.Publish(status);
}

void getMyVideos(void* p) {
  Param_Store& r = Record(p);
  r.Finish(VL_WS_getMyVideos(r.Client(), r.i[0], r.i[1], r.i[2], r.i[3], r.i[4], &r.Out().MyVideos));
}

void getWishlistItems(void* p) {
  Param_Store& r = Record(p);
  r.Finish(VL_WS_getWishlistItems(r.Client(), static_cast<VL_WS_SortOrder>(r.i[0]), r.i[1], r.i[2], r.i[3],
                                  &r.Out().Wishlist));
}

void addItemToWishlist(void* p) {
  Param_Store& r = Record(p);
  r.Finish(VL_WS_addItemToWishlist(r.Client(), r.i[0], &r.Out().Standard));
}

void removeItemFromWishlist(void* p) {
  Param_Store& r = Record(p);
  r.Finish(VL_WS_removeItemFromWishlist(r.Client(), r.i[0], &r.Out().Standard));
}

void removeAllItemsFromWishlist(void* p) {
  Param_Store& r = Record(p);
  r.Finish(VL_WS_removeAllItemsFromWishlist(r.Client(), &r.Out().Standard));
}

void checkTitleInWishlist(void* p) {
  Param_Store& r = Record(p);
  r.Finish(VL_WS_checkTitleInWishlist(r.Client(), r.i[0], &r.Out().Bool));
}

void checkTitlesInWishlist(void* p) {
  Param_Store& r = Record(p);
  std::vector<int> ids(r.ids.Size());
  for (size_t k = 0; k < ids.size(); ++k) ids[k] = r.ids[k];
  r.Finish(VL_WS_checkTitlesInWishlist(r.Client(), static_cast<int>(ids.size()), ids.data(), r.i[0], &r.Out().Flags));
}

void doPurchaseSavedBilling(void* p) {
  Param_Store& r = Record(p);
  r.Finish(VL_WS_doPurchaseSavedBilling(r.Client(), r.i[0], r.text.CString(), r.flag, &r.Out().Purchase));
}

void checkForPurchasedTitle(void* p) {
  Param_Store& r = Record(p);
  r.Finish(VL_WS_checkForPurchasedTitle(r.Client(), r.i[0], &r.Out().Bool));
}

void checkForPurchasedSku(void* p) {
  Param_Store& r = Record(p);
  r.Finish(VL_WS_checkForPurchasedSku(r.Client(), r.i[0], &r.Out().Bool));
}

void checkAdultVerificationEnabled(void* p) {
  Param_Store& r = Record(p);
  r.Finish(VL_WS_checkAdultVerificationEnabled(r.Client(), &r.Out().AdultVerification));
}

void checkAdultVerificationPin(void* p) {
  Param_Store& r = Record(p);
  r.Finish(VL_WS_checkAdultVerificationPin(r.Client(), r.i[0], &r.Out().AdultPin));
}

void assignGiftCertificateToUser(void* p) {
  Param_Store& r = Record(p);
  r.Finish(VL_WS_assignGiftCertificateToUser(r.Client(), r.text.CString(), &r.Out().GiftCertificate));
}

void checkRentalExpiration(void* p) {
  Param_Store& r = Record(p);
  r.Finish(VL_WS_checkRentalExpiration(r.Client(), r.i[0], &r.Out().RentalExpiration));
}

void getStreamingAssetLocation(void* p) {
  Param_Store& r = Record(p);
  r.Finish(VL_WS_getStreamingAssetLocation(r.Client(), r.i[0], r.i[1], &r.Out().StreamLocation));
}

void getStreamingBonusAssetLocation(void* p) {
  Param_Store& r = Record(p);
  r.Finish(VL_WS_getStreamingBonusAssetLocation(r.Client(), r.i[0], &r.Out().StreamLocation));
}

void loadLastStreamingAssetLocation(void* p) {
  Param_Store& r = Record(p);
  r.Finish(VL_WS_loadLastStreamingAssetLocation(r.Client(), r.i[0], r.i[1], &r.Out().StreamLocation));
}

void manageStreamingInstanceStatus(void* p) {
  Param_Store& r = Record(p);
  r.Finish(VL_WS_manageStreamingInstanceStatus(r.Client(), r.text.CString(), r.i[0], r.i[1], &r.Out().Standard));
}

void getTHXMediaDirector(void* p) {
  Param_Store& r = Record(p);
  r.Finish(VL_WS_getTHXMediaDirector(r.Client(), r.i[0], r.i[1], r.i[2], &r.Out().THX));
}

void getTHXMediaDirectorBonusAsset(void* p) {
  Param_Store& r = Record(p);
  r.Finish(VL_WS_getTHXMediaDirectorBonusAsset(r.Client(), r.i[0], r.i[1], r.i[2], &r.Out().THX));
}

void getEmailAddress(void* p) {
  Param_Store& r = Record(p);
  r.Finish(VL_WS_getEmailAddress(r.Client(), &r.Out().Email));
}

void getBillingInfo(void* p) {
  Param_Store& r = Record(p);
  r.Finish(VL_WS_getBillingInfo(r.Client(), &r.Out().Billing));
}

void getPrePaidCardBalance(void* p) {
  Param_Store& r = Record(p);
  r.Finish(VL_WS_getPrePaidCardBalance(r.Client(), &r.Out().PrePaidBalance));
}

void getConfig(void* p) {
  Param_Store& r = Record(p);
  r.Finish(VL_WS_getConfig(r.Client(), &r.Out().Config));
}

void getSettingsPageInfo(void* p) {
  Param_Store& r = Record(p);
  r.Finish(VL_WS_getSettingsPageInfo(r.Client(), &r.Out().SettingsPage));
}

void getCountryID(void* p) {
  Param_Store& r = Record(p);
  r.Finish(VL_WS_getCountryID(r.Client(), &r.Out().Int));
}

void getFileType(void* p) {
  Param_Store& r = Record(p);
  r.Finish(VL_WS_getFileType(r.Client(), &r.Out().FileType));
}

void updateLocalCache(void* p) {
  Param_Store& r = Record(p);
  VL_WS_Status status = VL_WS_updateLocalCache(r.Client(), r.i[0]);
  r.Out().Bool = status == VL_WS_OK;
  r.Finish(status);
}

void checkBandwidth(void* p) {
  Param_Store& r = Record(p);
  r.Finish(VL_WS_checkBandwidth(r.Client(), reinterpret_cast<unsigned int*>(&r.Out().Int)));
}

void calcOrderTax(void* p) {
  Param_Store& r = Record(p);
  r.Finish(VL_WS_calcOrderTax(r.Client(), r.i[0], &r.Out().OrderTax));
}

void getLocalIPAddr(void* p) {
  Param_Store& r = Record(p);
  r.Finish(VL_WS_getLocalIPAddr(r.Client(), &r.Out().String));
}

void setAudioDefaultProperty(void* p) {
  Param_Store& r = Record(p);
  r.Finish(VL_WS_setAudioDefaultProperty(r.Client(), r.i[0], &r.Out().Standard));
}

void getAudioDefaultProperty(void* p) {
  Param_Store& r = Record(p);
  r.Finish(VL_WS_getAudioDefaultProperty(r.Client(), &r.Out().Int));
}

}  // namespace
}  // namespace DUDUVud

// --- The method table ---------------------------------------------------------------------------

namespace {

// The entry of a method with its own member function.
DUDUVudAE::MethodEntry Own(const char* name, void (DUDUVudAE::*method)(ae::stagecraft::StageWindow*, ASObject&,
                                                                       ASValueArray&, ASValue&)) {
  return {name, ae::stagecraft::ASExtensionClass::Method::Bind(name, method).function, 0, {}, nullptr, nullptr,
          DUDUVudAE::RESULT_NONE};
}

}  // namespace

const DUDUVudAE::MethodEntry DUDUVudAE::s_Methods[] = {
    Own("init", &DUDUVudAE::init),
    Own("clone", &DUDUVudAE::clone),
    Own("idle", &DUDUVudAE::idle),
    {"getNavigation", nullptr, 1, {}, nullptr, DUDUVud::getNavigation, RESULT_NAVIGATION},
    {"getTitles", nullptr, 2, {"genreid", "CurrentPageNumber", "ItemsPerPage", "purchasetype"},
     [](DUDUVudAE& o, const ASObject&, Param_Store& r) {
       VLLogOutputwithConfig(Detail(),
                             "DUDUVudAE::getTitles, parameters geneeid:%d, currentPageNo:%d,itemsPerPage:%d, "
                             "purchaseType:%d \n",
                             r.i[0], r.i[1], r.i[2], r.i[3]);
       o.m_PurchaseType = r.i[3];
       o.m_PrefetchWanted = o.m_CacheType == kFileCache;
       return true;
     },
     DUDUVud::getTitles, RESULT_TITLES},
    {"getTitleListing", nullptr, 2, {"titleid"}, nullptr, DUDUVud::getTitleListing, RESULT_TITLE_LISTING},
    {"searchForTitle", nullptr, 2, {"CurrentPageNumber", "ItemsPerPage", "purchasetype", "typefilter"},
     [](DUDUVudAE&, const ASObject& p, Param_Store& r) { return r.text.Set(Text(p, "query").CString()); },
     DUDUVud::searchForTitle, RESULT_TITLES},
    {"getRecommendedTitles", nullptr, 2, {"titleid"}, nullptr, DUDUVud::getRecommendedTitles,
     RESULT_RECOMMENDED_TITLES},
    {"translateSkuID", nullptr, 2, {"skuid"}, nullptr, DUDUVud::translateSkuID, RESULT_TRANSLATE_SKU_ID},
    {"getTvEpisodeListing", nullptr, 2, {"episodeid"}, nullptr, DUDUVud::getTvEpisodeListing,
     RESULT_TITLE_LISTING},
    {"getTvEpisodeListByTitleID", nullptr, 2, {"titleid"}, nullptr, DUDUVud::getTvEpisodeListByTitleID,
     RESULT_TV_EPISODE_LIST},
    {"getAllTvEpisodeListings", nullptr, 2, {"titleid"},
     [](DUDUVudAE& o, const ASObject&, Param_Store&) {
       o.m_PrefetchWanted = o.m_CacheType == kFileCache;
       return true;
     },
     DUDUVud::getAllTvEpisodeListings, RESULT_ALL_TV_EPISODE_LISTINGS},
    {"authorizeDevice", nullptr, 2, {"pin"}, nullptr, DUDUVud::authorizeDevice, RESULT_AUTHORIZE_DEVICE},
    {"deactivateDevice", nullptr, 1, {}, nullptr, DUDUVud::deactivateDevice, RESULT_STANDARD},
    {"checkAuthToken", nullptr, 1, {}, nullptr, DUDUVud::checkAuthToken, RESULT_BOOL},
    {"getBoxArtImage", nullptr, 2, {"boxartsize"},
     [](DUDUVudAE& o, const ASObject& p, Param_Store& r) {
       o.m_BoxArtSize = r.i[0];
       if (!r.text.Set(Text(p, "boxartprefix").CString())) return false;
       VLLogOutputwithConfig(Detail(), "DUDUVudAE::getBoxArtImage,boxartprefix:%s\n", r.text.CString());
       return true;
     },
     DUDUVud::getBoxArtImage, RESULT_STRING},
    {"getMyVideos", nullptr, 2, {"CurrentPageNumber", "ItemsPerPage", "purchasetype", "typefilter", "watchstatus"},
     [](DUDUVudAE& o, const ASObject&, Param_Store& r) {
       o.m_PurchaseType = r.i[2];
       o.m_TypeFilter = r.i[3];
       o.m_WatchStatus = r.i[4];
       o.m_PrefetchWanted = o.m_CacheType == kFileCache;
       return true;
     },
     DUDUVud::getMyVideos, RESULT_MY_VIDEOS},
    {"getWishlistItems", nullptr, 2, {"sortorder", "CurrentPageNumber", "ItemsPerPage", "typefilter"},
     [](DUDUVudAE& o, const ASObject&, Param_Store& r) {
       o.m_SortOrder = r.i[0];
       o.m_TypeFilter = r.i[3];
       o.m_PrefetchWanted = o.m_CacheType == kFileCache;
       return true;
     },
     DUDUVud::getWishlistItems, RESULT_WISHLIST_ITEMS},
    {"addItemToWishlist", nullptr, 2, {"titleid"}, nullptr, DUDUVud::addItemToWishlist, RESULT_STANDARD},
    {"removeItemFromWishlist", nullptr, 2, {"titleid"}, nullptr, DUDUVud::removeItemFromWishlist, RESULT_STANDARD},
    {"removeAllItemsFromWishlist", nullptr, 1, {}, nullptr, DUDUVud::removeAllItemsFromWishlist, RESULT_STANDARD},
    {"checkTitleInWishlist", nullptr, 2, {"titleid"}, nullptr, DUDUVud::checkTitleInWishlist, RESULT_BOOL},
    {"checkTitlesInWishlist", nullptr, 2, {"typefilter"},
     [](DUDUVudAE&, const ASObject& p, Param_Store& r) {
       ASObject ids = p.GetProperty("titleids").AsObject();
       if (!ids.IsInstanceOf("Array") || ids.GetLength() == 0) return false;
       for (size_t k = 0; k < ids.GetLength(); ++k) {
         if (!r.ids.Append(ids.GetElement(k).AsInteger())) return false;
       }
       return true;
     },
     DUDUVud::checkTitlesInWishlist, RESULT_BOOL_ARRAY},
    {"doPurchaseSavedBilling", nullptr, 2, {"skuid"},
     [](DUDUVudAE&, const ASObject& p, Param_Store& r) {
       r.flag = p.GetProperty("useprepaidfund").AsBoolean();
       return r.text.Set(Text(p, "ipaddress").CString());
     },
     DUDUVud::doPurchaseSavedBilling, RESULT_PURCHASE},
    {"checkForPurchasedTitle", nullptr, 2, {"titleid"}, nullptr, DUDUVud::checkForPurchasedTitle, RESULT_BOOL},
    {"checkForPurchasedSku", nullptr, 2, {"skuid"}, nullptr, DUDUVud::checkForPurchasedSku, RESULT_BOOL},
    {"checkAdultVerificationEnabled", nullptr, 1, {}, nullptr, DUDUVud::checkAdultVerificationEnabled,
     RESULT_ADULT_VERIFICATION_ENABLED},
    {"checkAdultVerificationPin", nullptr, 2, {"pin"}, nullptr, DUDUVud::checkAdultVerificationPin,
     RESULT_ADULT_VERIFICATION_PIN},
    {"assignGiftCertificateToUser", nullptr, 2, {},
     [](DUDUVudAE&, const ASObject& p, Param_Store& r) { return r.text.Set(Text(p, "giftcertificatecode").CString()); },
     DUDUVud::assignGiftCertificateToUser, RESULT_GIFT_CERTIFICATE},
    {"checkRentalExpiration", nullptr, 2, {"passid"}, nullptr, DUDUVud::checkRentalExpiration,
     RESULT_RENTAL_EXPIRATION},
    {"getStreamingAssetLocation", nullptr, 2, {"passid", "fileprofile"}, nullptr, DUDUVud::getStreamingAssetLocation,
     RESULT_STREAMING_ASSET_LOCATION},
    {"getStreamingBonusAssetLocation", nullptr, 2, {"bonusassetid"}, nullptr,
     DUDUVud::getStreamingBonusAssetLocation, RESULT_STREAMING_ASSET_LOCATION},
    {"loadLastStreamingAssetLocation", nullptr, 2, {"passid", "fileprofile"}, nullptr,
     DUDUVud::loadLastStreamingAssetLocation, RESULT_STREAMING_ASSET_LOCATION},
    {"manageStreamingInstanceStatus", nullptr, 2, {"streamstatus", "stoptimeSeconds"},
     [](DUDUVudAE&, const ASObject& p, Param_Store& r) { return r.text.Set(Text(p, "streamid").CString()); },
     DUDUVud::manageStreamingInstanceStatus, RESULT_STANDARD},
    {"getTHXMediaDirector", nullptr, 2, {"passid", "fileprofile", "audioprofile"}, nullptr,
     DUDUVud::getTHXMediaDirector, RESULT_THX_MEDIA_DIRECTOR},
    {"getTHXMediaDirectorBonusAsset", nullptr, 2, {"bonusassetid", "fileprofile", "bonusassettype"}, nullptr,
     DUDUVud::getTHXMediaDirectorBonusAsset, RESULT_THX_MEDIA_DIRECTOR},
    {"getEmailAddress", nullptr, 1, {}, nullptr, DUDUVud::getEmailAddress, RESULT_EMAIL_ADDRESS},
    {"getBillingInfo", nullptr, 1, {}, nullptr, DUDUVud::getBillingInfo, RESULT_BILLING_INFO},
    {"getPrePaidCardBalance", nullptr, 1, {}, nullptr, DUDUVud::getPrePaidCardBalance, RESULT_PREPAID_CARD_BALANCE},
    {"getConfig", nullptr, 1, {}, nullptr, DUDUVud::getConfig, RESULT_CONFIG},
    {"getSettingsPageInfo", nullptr, 1, {}, nullptr, DUDUVud::getSettingsPageInfo, RESULT_SETTINGS_PAGE},
    {"getCountryID", nullptr, 1, {}, nullptr, DUDUVud::getCountryID, RESULT_INT},
    {"getFileType", nullptr, 1, {}, nullptr, DUDUVud::getFileType, RESULT_FILE_TYPE},
    {"updateLocalCache", nullptr, 2, {"operations"}, nullptr, DUDUVud::updateLocalCache, RESULT_BOOL},
    {"checkBandwidth", nullptr, 1, {}, nullptr, DUDUVud::checkBandwidth, RESULT_INT},
    {"calcOrderTax", nullptr, 2, {"skuid"}, nullptr, DUDUVud::calcOrderTax, RESULT_ORDER_TAX},
    Own("quitFlash", &DUDUVudAE::quitFlash),
    {"getLocalIPAddr", nullptr, 1, {}, nullptr, DUDUVud::getLocalIPAddr, RESULT_STRING},
    Own("getSysInfo", &DUDUVudAE::getSysInfo),
    {"setAudioDefaultProperty", nullptr, 2, {"audioprofile"}, nullptr, DUDUVud::setAudioDefaultProperty,
     RESULT_STANDARD},
    {"getAudioDefaultProperty", nullptr, 1, {}, nullptr, DUDUVud::getAudioDefaultProperty, RESULT_INT},
    Own("getUserAgent", &DUDUVudAE::getUserAgent),
    Own("setLogAreaIDsAndTargetConfig", &DUDUVudAE::setLogAreaIDsAndTargetConfig),
    Own("fileExist", &DUDUVudAE::fileExist),
    Own("getAvailableEnvLists", &DUDUVudAE::getAvailableEnvLists),
    Own("clearLocalCache", &DUDUVudAE::clearLocalCache),
    Own("getDeviceEnv", &DUDUVudAE::getDeviceEnv),
    Own("checkVLSWFmd5sum", &DUDUVudAE::checkVLSWFmd5sum),
    Own("trace", &DUDUVudAE::trace),
};

namespace {

const int kMethodCount = sizeof DUDUVudAE::s_Methods / sizeof DUDUVudAE::s_Methods[0];
static_assert(kMethodCount == 59, "the class has 59 methods");

template <int I>
ae::stagecraft::ASExtensionClass::Method MethodAt() {
  const DUDUVudAE::MethodEntry& entry = DUDUVudAE::s_Methods[I];
  if (entry.own) return {entry.name, entry.own};
  return ae::stagecraft::ASExtensionClass::Method::Bind(entry.name, &DUDUVudAE::StoreMethod<I>);
}

template <int... I>
void AppendMethods(AEArray<ae::stagecraft::ASExtensionClass::Method>& table, std::integer_sequence<int, I...>) {
  const ae::stagecraft::ASExtensionClass::Method methods[] = {MethodAt<I>()...};
  table.Append(methods, sizeof...(I));
}

// Instances dropped while one of their threads ran, each being deleted on a thread of its own.
std::mutex s_DroppedLock;
std::vector<std::thread> s_Dropped;

}  // namespace

// --- Class functions ------------------------------------------------------------------------------

const char* DUDUVudAE::GetClassName() { return "com.ostrel.DUDUVud"; }

bool DUDUVudAE::FiresEvents() { return false; }

void DUDUVudAE::GetMethods(AEArray<Method>& table) {
  AppendMethods(table, std::make_integer_sequence<int, kMethodCount>());
}

ae::stagecraft::ASExtensionClass* DUDUVudAE::ConstructInstance(StageWindow*, ASObject&, ASValueArray&) {
  return new (std::nothrow) DUDUVudAE;
}

void DUDUVudAE::DestructInstance(StageWindow*, ASObject& object) {
  DUDUVudAE* self = static_cast<DUDUVudAE*>(object.GetNativeInstance());
  if (!self) return;
  // Script handles belong to the engine's thread: give them up here, whoever deletes.
  object.StopUpdates();
  self->m_Callback.Release();
  if (self->HasThreads()) {
    // Waiting here would hold the movie for as long as a network call takes.
    try {
      std::lock_guard<std::mutex> lock(s_DroppedLock);
      s_Dropped.emplace_back([self] { delete self; });
      return;
    } catch (const std::system_error&) {
      // No thread to spare: wait here after all.
    }
  }
  delete self;
}

void DUDUVudAE::JoinDroppedInstances() {
  std::vector<std::thread> dropped;
  {
    std::lock_guard<std::mutex> lock(s_DroppedLock);
    dropped.swap(s_Dropped);
  }
  for (std::thread& t : dropped) t.join();
}

// --- Instance -------------------------------------------------------------------------------------

DUDUVudAE::DUDUVudAE()
    : m_Thread(nullptr),
      m_PagePrefetchThread(nullptr),
      m_BoxArtPrefetchThread(nullptr),
      m_SortOrder(0),
      m_TypeFilter(0),
      m_WatchStatus(0),
      m_PurchaseType(2),
      m_BoxArtSize(1),
      m_CacheType(0),
      m_CacheData(0),
      m_Initialised(false),
      m_ResultReady(false),
      m_PrefetchWanted(false),
      m_PagePrefetchRunning(false),
      m_BoxArtPrefetchRunning(false),
      m_IdleSeen(false),
      m_WaitingBoxArts(8),
      m_RequestName("") {
  VLWSAELog log(kClassName, "DUDUVudAE", s_Log.Id());
  IAEKernel* kernel = IAEKernel::GetKernel();
  kernel->SetMemory(&m_Result, 0, sizeof m_Result);
  kernel->SetMemory(&m_Client, 0, sizeof m_Client);
  kernel->SetMemory(&m_CataloguePrefetchClient, 0, sizeof m_CataloguePrefetchClient);
  kernel->SetMemory(&m_BoxArtPrefetchClient, 0, sizeof m_BoxArtPrefetchClient);
  kernel->SetMemory(&m_UserDataPrefetchClient, 0, sizeof m_UserDataPrefetchClient);
  m_PrefetchLock = kernel->CreateMutex();
  m_Lock = kernel->CreateMutex();
  VL_ASSERT(m_PrefetchLock != 0 && m_Lock != 0);
  m_Prefetch.SetMutex(m_PrefetchLock);
}

DUDUVudAE::~DUDUVudAE() {
  VLWSAELog log(kClassName, "~DUDUVudAE", s_Log.Id());
  SafeDestroyThread(m_Thread);
  SafeDestroyThread(m_PagePrefetchThread);
  SafeDestroyThread(m_BoxArtPrefetchThread);
  if (m_ResultReady.load(std::memory_order_acquire)) DiscardResult();
  IAEKernel::GetKernel()->DestroyMutex(m_PrefetchLock);
  IAEKernel::GetKernel()->DestroyMutex(m_Lock);
  m_Callback.Release();
  VL_WS_release(&m_Client);
  VL_WS_release(&m_CataloguePrefetchClient);
  VL_WS_release(&m_BoxArtPrefetchClient);
  VL_WS_release(&m_UserDataPrefetchClient);
}

bool DUDUVudAE::HasThreads() {
  m_Lock->Lock();
  bool threads = m_Thread || m_PagePrefetchThread || m_BoxArtPrefetchThread;
  m_Lock->Unlock();
  return threads;
}

void DUDUVudAE::PrepareResult(Result_Type type) {
  IAEKernel::GetKernel()->SetMemory(&m_Result, 0, sizeof m_Result);
  m_Result.type = type;
}

void DUDUVudAE::DiscardResult() {
  // Types 1 and 2 hold a plain value; every other kind of data is a tagged record.
  if (m_Result.type > RESULT_BOOL) VL_WS_release(&m_Result.data);
  m_Result.type = RESULT_NONE;
}

void DUDUVudAE::RunThread(const char* name, void (*worker)(void*), Param* record, ASObject& object) {
  m_IdleSeen = false;
  m_RequestName = name;
  m_Lock->Lock();
  m_Thread = VLThread::CreateThread();
  VL_ASSERT(m_Thread != 0);
  if (!m_Thread->Run(name, worker, record)) {
    // The thread object stays in its slot, so the instance stays busy until the movie has heard.
    VLLogOutputwithConfig(Error(), "Failed to launch worker thread: %s!\n", name);
    delete record;
    m_Result.status = VL_WS_E_UNEXPECTED;
    m_ResultReady.store(true, std::memory_order_release);
  }
  object.RequestUpdates();
  m_Lock->Unlock();
}

VLThread* DUDUVudAE::TakeThread() {
  m_Lock->Lock();
  VLThread* thread = m_Thread;
  m_Thread = nullptr;
  m_Lock->Unlock();
  return thread;
}

void DUDUVudAE::SafeDestroyThread(VLThread*& slot) {
  if (!slot) return;
  slot->WaitUntilCompletion();
  m_Lock->Lock();
  VLThread::DestroyThread(slot);
  slot = nullptr;
  m_Lock->Unlock();
}

void DUDUVudAE::MakePrefetchClients(const VL_WS_Handle* source) {
  if (m_CacheType != kFileCache) return;
  // A copy that failed may hold a partial handle: release it, so that an absent client is empty.
  auto duplicate = [source](VL_WS_Handle* copy) {
    if (VL_WS_duplicate(copy, source) != VL_WS_OK) VL_WS_release(copy);
  };
  if (m_CacheData & VL_WS_CacheParam::CACHE_METADATA) {
    duplicate(&m_CataloguePrefetchClient);
    if (m_CacheData & VL_WS_CacheParam::CACHE_BOXART) duplicate(&m_BoxArtPrefetchClient);
  }
  if (m_CacheData & VL_WS_CacheParam::CACHE_USERDATA) duplicate(&m_UserDataPrefetchClient);
}

int DUDUVudAE::StartRequest(const MethodEntry& entry, ASObject& object, ASValueArray& arguments) {
  if (!m_Initialised.load()) return kNotInitialised;
  if (m_Thread) return kBusy;
  ASObject callback, parameters;
  if (!ReadArguments(arguments, entry.elements, &callback, &parameters)) return kWrongArguments;
  m_PrefetchWanted = false;
  Param_Store* record = new Param_Store(this);
  for (size_t k = 0; k < 5 && entry.ints[k]; ++k) record->i[k] = Int(parameters, entry.ints[k]);
  if (entry.read && !entry.read(*this, parameters, *record)) {
    delete record;
    return kWrongArguments;
  }
  // Reading the properties runs script code, which may have started a request of its own.
  if (m_Thread) {
    delete record;
    return kBusy;
  }
  m_Callback = callback;
  PrepareResult(entry.result);
  RunThread(entry.name, entry.worker, record, object);
  return kAccepted;
}

template <int I>
void DUDUVudAE::StoreMethod(StageWindow*, ASObject& object, ASValueArray& arguments, ASValue& result) {
  const MethodEntry& entry = s_Methods[I];
  VLWSAELog log(kClassName, entry.name, s_Log.Id());
  result.SetInteger(StartRequest(entry, object, arguments));
}

void DUDUVudAE::OnUpdate(StageWindow*, ASObject& object) {
  if (!m_ResultReady.load(std::memory_order_acquire)) {
    StartBoxArtDownload();
    return;
  }
  object.StopUpdates();
  m_ResultReady.store(false, std::memory_order_relaxed);
  VLThread::Sleep(10);
  ASObject callback = m_Callback;
  m_Callback.Release();
  if (!callback.IsValid()) {
    VLThread* thread = TakeThread();
    SafeDestroyThread(thread);
    DiscardResult();
    return;
  }
  if (m_Result.status == VL_WS_OK && m_CacheType == kFileCache && m_PrefetchWanted) SchedulePrefetch();
  ASValue value;
  DUDUVud::SetResult(m_Result, value, callback);
  m_Result.type = RESULT_NONE;
  VLThread* thread = TakeThread();  // from here on a new request is accepted, from onComplete too
  ASValue status;
  status.SetInteger(m_Result.status);
  callback.CallMethod("onComplete", status, value);
  callback.Release();
  SafeDestroyThread(thread);
}

// --- Worker records -------------------------------------------------------------------------------

void DUDUVudAE::Param::Publish(VL_WS_Status status) {
  DUDUVudAE* instance = owner;
  instance->m_Result.status = status;
  delete this;
  instance->m_ResultReady.store(true, std::memory_order_release);
}

void DUDUVudAE::Param::Finish(VL_WS_Status status) {
  VLLogOutputwithConfig(Trace(), "DUDUVud::%s, ret:%d\n", owner->m_RequestName, status);
  Publish(status);
}

void DUDUVudAE::Param::FinishInit(VL_WS_Status status) {
  bool initialised = status == VL_WS_OK;
  if (initialised) {
    owner->MakePrefetchClients(&owner->m_Client);
  } else {
    VL_WS_release(&owner->m_Client);  // a failed set-up may leave a partial handle; init may run again
  }
  Out().Bool = initialised;
  owner->m_Initialised.store(initialised);
  Finish(status);
}

void DUDUVudAE::Param::RenewUserDataClient(const char* logLine) {
  if (owner->m_CacheType != kFileCache || !(owner->m_CacheData & VL_WS_CacheParam::CACHE_USERDATA)) return;
  VLLogOutputwithConfig(Trace(), "%s", logLine);
  owner->SafeDestroyThread(owner->m_PagePrefetchThread);
  VL_WS_release(&owner->m_UserDataPrefetchClient);
  if (VL_WS_duplicate(&owner->m_UserDataPrefetchClient, &owner->m_Client) != VL_WS_OK) {
    VL_WS_release(&owner->m_UserDataPrefetchClient);
  }
}

// --- Methods with their own behaviour -------------------------------------------------------------

void DUDUVudAE::init(StageWindow*, ASObject& object, ASValueArray& arguments, ASValue& result) {
  VLWSAELog log(kClassName, "init", s_Log.Id());
  if (m_Initialised.load()) {
    VLLogOutputwithConfig(Error(), "DUDUVudAE::init left since Already initialized!\n");
    result.SetInteger(kAlreadyInitialised);
    return;
  }
  if (m_Thread) {
    result.SetInteger(kBusy);
    return;
  }
  ASObject callback, parameters;
  if (!ReadArguments(arguments, 2, &callback, &parameters)) {
    result.SetInteger(kWrongArguments);
    return;
  }
  Param_init* record = new Param_init(this, parameters);
  if (m_Thread) {  // started by script code that reading the properties ran
    delete record;
    result.SetInteger(kBusy);
    return;
  }
  m_CacheType = record->CacheType;
  m_CacheData = record->CacheData;
  m_Callback = callback;
  PrepareResult(RESULT_BOOL);
  RunThread("init", DUDUVud::init, record, object);
  result.SetInteger(kAccepted);
  VLLogOutputwithConfig(Trace(), "DUDUVudAE::init left\n");
}

void DUDUVudAE::clone(StageWindow*, ASObject&, ASValueArray& arguments, ASValue& result) {
  VLWSAELog log(kClassName, "clone", s_Log.Id());
  if (m_Initialised.load()) {
    result.SetInteger(kAlreadyInitialised);
    return;
  }
  ASObject otherObject = arguments.Count() == 1 ? arguments.Get(0).AsObject() : ASObject();
  DUDUVudAE* other = dynamic_cast<DUDUVudAE*>(otherObject.GetNativeInstance());
  if (!other || other == this || !other->m_Initialised.load()) {
    result.SetInteger(kWrongArguments);
    return;
  }
  // A running init of this instance, or a request of the other, has a client in use.
  if (m_Thread || other->m_Thread) {
    result.SetInteger(kBusy);
    return;
  }
  m_WatchStatus = other->m_WatchStatus;
  m_CacheType = other->m_CacheType;
  m_CacheData = other->m_CacheData;
  m_SortOrder = other->m_SortOrder;
  m_TypeFilter = other->m_TypeFilter;
  m_PurchaseType = other->m_PurchaseType;
  m_BoxArtSize = other->m_BoxArtSize;
  if (VL_WS_duplicate(&m_Client, &other->m_Client) != VL_WS_OK) {
    VL_WS_release(&m_Client);
    result.SetInteger(kQueryFailed);
    return;
  }
  MakePrefetchClients(&other->m_Client);
  m_Initialised.store(true);
  result.SetInteger(kAccepted);
}

void DUDUVudAE::idle(StageWindow*, ASObject& object, ASValueArray&, ASValue& result) {
  VLWSAELog log(kClassName, "idle", s_Log.Id());
  m_IdleSeen = true;
  object.RequestUpdates();
  result.SetInteger(kAccepted);
}

void DUDUVudAE::quitFlash(StageWindow* window, ASObject& object, ASValueArray&, ASValue& result) {
  VLWSAELog log(kClassName, "quitFlash", s_Log.Id());
  object.StopUpdates();
  if (window) window->Quit();
  result.SetInteger(kAccepted);
}

// --- Synchronous methods --------------------------------------------------------------------------

void DUDUVudAE::getUserAgent(StageWindow*, ASObject&, ASValueArray&, ASValue& result) {
  VLWSAELog log(kClassName, "getUserAgent", s_Log.Id());
  VL_WS_String agent = {};
  VL_WS_Status status = VL_WS_getUserAgent(&m_Client, &agent);
  result.SetString(status == VL_WS_OK ? agent.Text : "");
  VL_WS_release(&agent);
}

void DUDUVudAE::getDeviceEnv(StageWindow*, ASObject&, ASValueArray&, ASValue& result) {
  VLWSAELog log(kClassName, "getDeviceEnv", s_Log.Id());
  VL_WS_EnvID env = 0;
  result.SetInteger(VL_WS_getDeviceEnv(&m_Client, &env) == VL_WS_OK ? env : kQueryFailed);
}

void DUDUVudAE::getSysInfo(StageWindow*, ASObject&, ASValueArray&, ASValue& result) {
  VLWSAELog log(kClassName, "getSysInfo", s_Log.Id());
  result.SetString("");
}

void DUDUVudAE::trace(StageWindow*, ASObject&, ASValueArray& arguments, ASValue& result) {
  if (arguments.Count() != 1) {
    result.SetInteger(kWrongArguments);
    return;
  }
  printf("FLASH TRACE == %s\n", arguments.Get(0).AsString().CString());
  fflush(stdout);
  result.SetInteger(kAccepted);
}

void DUDUVudAE::checkVLSWFmd5sum(StageWindow*, ASObject&, ASValueArray& arguments, ASValue& result) {
  VLWSAELog log(kClassName, "checkVLSWFmd5sum", s_Log.Id());
  result.SetString("");
  AEString path;
  if (!TextArgument(arguments, &path)) return;
  VL_WS_String md5sum = {};
  if (VL_WS_checkVLSWFmd5sum(path.CString(), &md5sum) == VL_WS_OK) {
    result.SetString(md5sum.Text);
    VLLogOutputwithConfig(Trace(), "DUDUVudAE::checkVLSWFmd5sum result: (%s)\n", md5sum.Text);
  }
  VL_WS_release(&md5sum);
}

void DUDUVudAE::fileExist(StageWindow*, ASObject&, ASValueArray& arguments, ASValue& result) {
  VLWSAELog log(kClassName, "fileExist", s_Log.Id());
  result.SetBoolean(false);
  AEString path;
  bool exists = false;
  if (TextArgument(arguments, &path) && VL_WS_fileExist(path.CString(), &exists) == VL_WS_OK) {
    result.SetBoolean(exists);
  }
}

void DUDUVudAE::clearLocalCache(StageWindow*, ASObject&, ASValueArray& arguments, ASValue& result) {
  VLWSAELog log(kClassName, "clearLocalCache", s_Log.Id());
  result.SetBoolean(false);
  AEString folder;
  if (TextArgument(arguments, &folder) && !folder.IsEmpty()) {
    result.SetBoolean(VL_WS_clearLocalCache(folder.CString()) == VL_WS_OK);
  }
}

void DUDUVudAE::getAvailableEnvLists(StageWindow*, ASObject& object, ASValueArray&, ASValue& result) {
  VLWSAELog log(kClassName, "getAvailableEnvLists", s_Log.Id());
  VL_WS_EnvList list = {};
  VL_WS_getAvailableEnvLists(&list);
  VL_WS_EnvID defaultEnv = VL_WS_ENV_PRODUCTION;
  if (VL_WS_getDefaultEnvID(&m_Client, &defaultEnv) != VL_WS_OK) {
    result.SetInteger(kQueryFailed);
    return;
  }
  VLLogOutputwithConfig(Trace(), "<<==========Available EnvLists (%d)===========\n", list.Count);
  const char* defaultName = nullptr;
  for (int k = 0; k < list.Count; ++k) {
    if (list.Entries[k].EnvNum == defaultEnv) defaultName = list.Entries[k].Name;
  }
  ASObject array = object.NewObject("Array");
  for (int k = 0; k < list.Count; ++k) {
    const VL_WS_EnvListEntry& entry = list.Entries[k];
    VLString endpoint(entry.Name);
    if (k == 3) {
      // The "default" entry names the environment the store's service chose for this device
      // (its number, when that is none of the list).
      char chosen[160];
      if (defaultName) {
        snprintf(chosen, sizeof chosen, "%s(%s)", entry.Name, defaultName);
      } else {
        snprintf(chosen, sizeof chosen, "%s(%d)", entry.Name, defaultEnv);
      }
      endpoint = chosen;
    }
    VLLogOutputwithConfig(Trace(), "envNum: %d, endpoint:%s\n", entry.EnvNum, endpoint.c_str());
    ASObject env = object.NewObject("Object");
    ASValue value;
    value.SetInteger(entry.EnvNum);
    env.SetProperty("envNum", value);
    value.SetString(endpoint.c_str());
    env.SetProperty("endpoint", value);
    value.SetObject(env);
    array.CallMethod("push", value);
  }
  result.SetObject(array);
  VLLogOutputwithConfig(Trace(), "============Available EnvLists end============>\n");
}

void DUDUVudAE::setLogAreaIDsAndTargetConfig(StageWindow*, ASObject&, ASValueArray& arguments, ASValue& result) {
  ASObject array = arguments.Count() == 1 ? arguments.Get(0).AsObject() : ASObject();
  ASObject settings = array.IsInstanceOf("Array") ? array.GetElement(0).AsObject() : ASObject();
  if (!settings.IsValid()) {
    result.SetInteger(kWrongArguments);
    return;
  }
  unsigned int mask = static_cast<unsigned int>(strtol(Text(settings, "LogAreaIDs").CString(), nullptr, 10));
  unsigned char target = static_cast<unsigned char>(strtol(Text(settings, "LogTarget").CString(), nullptr, 10));
  AEString path = Text(settings, "SettingsFile");
  if (path.IsEmpty()) {
    const char* variable = getenv(Text(settings, "PreferenceFile").CString());
    path.Set(variable ? variable : "");
  }
  // The log file goes beside the settings file.
  const char* slash = strrchr(path.CString(), '/');
  AEString directory(path.CString(), slash ? static_cast<size_t>(slash - path.CString() + 1) : 0);
  result.SetInteger(VLWSAELog::InitWSLogs(mask, target, directory.CString()));
}
