/*
 * VL_WS.h: the flat client interface of the store. Include this header only; it brings the
 * setup types (VL_WS_Types.h) and the status values and records (VL_WS_Records.h).
 *
 * Every operation returns a VL_WS_Status: VL_WS_OK (0) or a negative VL_WS_E_... value. Records
 * that an operation fills are owned by the caller and given back with VL_WS_release.
 */
#ifndef VL_WS_H
#define VL_WS_H

#include "VL_WS_Types.h"
#include "VL_WS_Records.h"

#include <time.h> /* time_t */

extern "C" {

/* ---------------------------------------------------------------------------------------------
 * Handles and environments
 * ------------------------------------------------------------------------------------------- */

/*
 * VL_WS_initialize - make a client handle from a setup record.
 *
 * `handle` must be empty (both words null, as after VL_WS_release); `params` and its strings are
 * read during the call only. The handle gets its own copy of the settings, an endpoint chosen
 * from ContentType and EnvNum (EnvNum VL_WS_ENV_DEFAULT or above asks the store's
 * device-environment service), a User-Agent "VLSDK: <firmwareVersion>|<ApplicationRevision>"
 * with " VLMODEL:<modelNumber>" (each part only when given), the access type (AccessType
 * UNKNOWN asks the store through VL_WS_getFileType; a failed question leaves UNKNOWN) and, for
 * CacheType 1 or 2, an open cache refreshed with VL_WS_updateLocalCache(handle, 5). The cache
 * file of CacheType 2 is "<CachePath>/<hashes of device, key, account and cache settings>.vl"
 * (CachePath "" is the current folder); a file that cannot be opened as a database is deleted
 * and made anew, and so is a database that SQLite finds damaged later, by the operation that
 * finds it (which misses).
 *
 * Returns VL_WS_OK, or:
 *   VL_WS_E_INVALID_ARGUMENT  a null argument; a handle that is not empty (it is left as it
 *                             is); APIKey, DestinationUniqueID, UserName or Password
 *                             missing or empty; DestinationUniqueID longer than 350 bytes;
 *                             CachePath null with CacheType 2; CacheLimit neither 0 nor at
 *                             least 358400 with a cache; ContentType not 0 or 1; CacheType not
 *                             0, 1 or 2; a negative EnvNum
 *   VL_WS_E_CACHE_FOLDER      the folder CachePath does not exist and cannot be created
 *   VL_WS_E_TLS_SETUP         the TLS set-up failed: the handle stays allocated, release it
 *   VL_WS_E_CONNECT           the device-environment service could not be reached
 *   VL_WS_E_CACHE_OPEN        the cache could not be opened
 * On every failure but VL_WS_E_TLS_SETUP the handle is left empty.
 */
VL_WS_Status VL_WS_initialize(VL_WS_Handle* handle, const VL_WS_SetupParams* params);

/*
 * VL_WS_duplicate - make a second handle with the settings of `source`, for another thread.
 *
 * `copy` must be empty and differ from `source`. The copy has its own SOAP connections and, for
 * a file cache, its own connection to the same cache file; with a memory cache it has no cache.
 * Nothing is asked of the store again: endpoint, environment, User-Agent, access type and token
 * are the source's. Source and copy share nothing in memory and may be released in any order.
 *
 * Returns VL_WS_OK, VL_WS_E_INVALID_ARGUMENT (null `copy`, `copy` equal to `source`, a `copy`
 * that is not empty, which is left as it is, or a source without client state),
 * VL_WS_E_TLS_SETUP or VL_WS_E_CACHE_OPEN. On a failure the copy may hold a partial handle:
 * release it.
 */
VL_WS_Status VL_WS_duplicate(VL_WS_Handle* copy, const VL_WS_Handle* source);

/*
 * VL_WS_getVersion - the interface's version, 1.3.1, into a version record (release it).
 *
 * Returns VL_WS_OK, or VL_WS_E_INVALID_ARGUMENT for a null `version`.
 */
VL_WS_Status VL_WS_getVersion(VL_WS_Version* version);

/*
 * VL_WS_getAvailableEnvLists - the environments a handle can be made for: (0, "stgapi"),
 * (1, "stg"), (2, "production"), (3, "default").
 *
 * The list points at a static table of the library and is never released. Returns VL_WS_OK, or
 * VL_WS_E_INVALID_ARGUMENT for a null `list`.
 */
VL_WS_Status VL_WS_getAvailableEnvLists(VL_WS_EnvList* list);

/*
 * VL_WS_getDefaultEnvID - ask the store's device-environment service which environment this
 * device belongs to.
 *
 * `envID` receives the digit the service answered, or 2 (production) for an answer that cannot
 * be read; it is left as it was when the service cannot be reached. The handle keeps its own
 * endpoint and environment.
 *
 * Returns VL_WS_OK, VL_WS_E_INVALID_ARGUMENT (no client state, null `envID`) or
 * VL_WS_E_NETWORK (the service could not be reached).
 */
VL_WS_Status VL_WS_getDefaultEnvID(VL_WS_Handle* handle, VL_WS_EnvID* envID);

/*
 * VL_WS_getDeviceEnv - the environment the handle works in.
 *
 * Returns VL_WS_OK, or VL_WS_E_INVALID_ARGUMENT (no client state, null `envID`).
 */
VL_WS_Status VL_WS_getDeviceEnv(VL_WS_Handle* handle, VL_WS_EnvID* envID);

/* ---------------------------------------------------------------------------------------------
 * Account
 * ------------------------------------------------------------------------------------------- */

/*
 * VL_WS_getFileType - the store's file type for this device (DRM provider, access type, file
 * profile, video format, file extension) into a file type record (release it).
 *
 * On success the handle's access type becomes the answer's File_AccessType; it decides the
 * service of the operations that choose theirs by access type (the account operations already
 * routed keep the access type the handle was made with).
 *
 * Returns VL_WS_OK or the status of the SOAP call; VL_WS_E_INVALID_ARGUMENT for no client state
 * or a null `fileType`.
 */
VL_WS_Status VL_WS_getFileType(VL_WS_Handle* handle, VL_WS_FileType* fileType);

/*
 * Account operations in general
 *
 * Unless said otherwise, an account operation goes to the download service when the handle was
 * made with access type DOWNLOAD and to the streaming service otherwise. It prepares its result
 * before anything else: a record is cleared and tagged (release it whatever the status), a bool
 * or int result is set to false or 0. It returns VL_WS_E_INVALID_ARGUMENT for a handle without
 * client state, a null result pointer, a required argument that is missing or empty, or a page
 * number or page size outside -32768 to 32767 (the store answers them in 16-bit fields), before
 * any request.
 *
 * A failed call (no connection, TLS, HTTP or SOAP failure) returns its status (VL_WS_E_CONNECT,
 * VL_WS_E_EOF, VL_WS_E_TLS, VL_WS_E_HTTP_STATUS(n), VL_WS_E_SOAP_FAULT(n), VL_WS_E_UNEXPECTED)
 * and leaves the record cleared. An answer without its result leaves the record cleared with
 * status VL_WS_OK. The store's ResponseCode and ResponseMessage are always in the record; where
 * an operation says "the code counts", a non-zero code gives VL_WS_E_UNEXPECTED unless the
 * operation lists its own statuses. Nothing changes in the handle or the cache unless the call
 * succeeded with ResponseCode 0.
 */

/*
 * VL_WS_authorizeDevice - link the device to the store account whose PIN is `pin`.
 *
 * On success the handle's token becomes the answer's AuthToken: every later request of this
 * handle (not of its duplicates) carries it. Keep it and pass it as VL_WS_SetupParams::AuthToken
 * at the next initialisation. With a cache of user data, all user data of the previous account
 * are deleted, the wishlist flags included.
 *
 * The code counts: VL_WS_E_AUTHORIZE_1 (code 1: wrong PIN), VL_WS_E_AUTHORIZE_2 (code 2).
 */
VL_WS_Status VL_WS_authorizeDevice(VL_WS_Handle* handle, int pin, VL_WS_AuthorizeDeviceResponse* answer);

/*
 * VL_WS_deactivateDevice - unlink the device from its account.
 *
 * On success the handle's token becomes empty and, with a cache of user data, all user data are
 * deleted. The code counts.
 */
VL_WS_Status VL_WS_deactivateDevice(VL_WS_Handle* handle, VL_WS_StandardResponse* answer);

/*
 * VL_WS_checkAuthToken - whether the store accepts the handle's token.
 *
 * With a cache of user data, the user data are deleted whenever the answer differs from the
 * previous answer on this handle (a new handle starts from "not valid", so its first "valid"
 * deletes them once). The status is the SOAP call's.
 */
VL_WS_Status VL_WS_checkAuthToken(VL_WS_Handle* handle, bool* valid);

/*
 * Answers kept as user data
 *
 * With a cache of user data (CACHE_USERDATA) the answers of VL_WS_getEmailAddress,
 * VL_WS_getSettingsPageInfo, VL_WS_getBillingInfo, VL_WS_getWishlistItems and (on the streaming
 * service) VL_WS_getMyVideos are kept, those with ResponseCode 0 only, and the next call with the
 * same arguments is answered from the cache without a request. They are deleted with the user
 * data: when the device is authorised or deactivated, when the token check changes its answer,
 * by VL_WS_updateLocalCache(handle, CACHE_USERDATA), and (wishlist pages) when the wishlist
 * changes or a purchase succeeds.
 */

/*
 * VL_WS_getEmailAddress - the account's e-mail address; kept as user data. The code counts.
 */
VL_WS_Status VL_WS_getEmailAddress(VL_WS_Handle* handle, VL_WS_EmailAddressResponse* answer);

/*
 * VL_WS_getSettingsPageInfo - the account and the device's name for the settings page; kept as
 * user data. The code counts.
 */
VL_WS_Status VL_WS_getSettingsPageInfo(VL_WS_Handle* handle, VL_WS_SettingsPageResponse* answer);

/*
 * VL_WS_getConfig - the store's configuration for the device: key and value texts, in the
 * store's order (the bandwidth probe's URL among them). The code counts.
 */
VL_WS_Status VL_WS_getConfig(VL_WS_Handle* handle, VL_WS_ConfigResponse* config);

/*
 * VL_WS_getCountryID - the store's number of the account's country. The status is the SOAP
 * call's.
 */
VL_WS_Status VL_WS_getCountryID(VL_WS_Handle* handle, int* countryID);

/*
 * VL_WS_checkAdultVerificationEnabled - whether adult titles need the account's adult-content
 * PIN. The code counts.
 */
VL_WS_Status VL_WS_checkAdultVerificationEnabled(VL_WS_Handle* handle, VL_WS_AdultVerificationEnabledResponse* answer);

/*
 * VL_WS_checkAdultVerificationPin - whether `pin` is the account's adult-content PIN. The PIN is
 * sent as at least four digits ("%04d": 7 is sent as "0007"). The code counts; a wrong PIN is a
 * successful answer with IsPinVerified false.
 */
VL_WS_Status VL_WS_checkAdultVerificationPin(VL_WS_Handle* handle, int pin, VL_WS_AdultVerificationPinResponse* answer);

/*
 * VL_WS_returnError, VL_WS_returnTimeout - test operations of the streaming service: the store
 * answers with an error code, or holds its answer past the handle's receive time-out. They always
 * go to the streaming service. The code counts.
 */
VL_WS_Status VL_WS_returnError(VL_WS_Handle* handle, VL_WS_StandardResponse* answer);
VL_WS_Status VL_WS_returnTimeout(VL_WS_Handle* handle, VL_WS_StandardResponse* answer);

/* ---------------------------------------------------------------------------------------------
 * Purchases and billing (account operations: see "Account operations in general")
 * ------------------------------------------------------------------------------------------- */

/*
 * VL_WS_doPurchaseSavedBilling - buy or rent the product `skuID` with the account's saved card,
 * or with its prepaid funds when `usePrePaidFunds` is true. `ipAddress` (required) is the
 * client's IP address as text.
 *
 * On success the answer holds the new pass (PassID, for the streaming operations) and the
 * transaction. The store takes a bought title off the wishlist: with a cache of user data, the
 * cached wishlist pages and every wishlist flag are deleted.
 *
 * The code counts: VL_WS_E_PURCHASE_1 to VL_WS_E_PURCHASE_12 for codes 1 to 12 (code n gives
 * -1006 - n), VL_WS_E_PURCHASE_20, _21 and _22 for codes 20 to 22.
 */
VL_WS_Status VL_WS_doPurchaseSavedBilling(VL_WS_Handle* handle, int skuID, const char* ipAddress,
                                          bool usePrePaidFunds, VL_WS_PurchaseResponse* answer);

/*
 * VL_WS_calcOrderTax - sub-total, tax and total of buying the product `skuID`, as the store's
 * decimal texts. Always the streaming service.
 *
 * The code counts: VL_WS_E_ORDER_TAX_1, _2, _3, _11, _12 and _20 for codes 1, 2, 3, 11, 12 and 20.
 */
VL_WS_Status VL_WS_calcOrderTax(VL_WS_Handle* handle, int skuID, VL_WS_OrderTaxResponse* tax);

/*
 * VL_WS_getBillingInfo - the account's saved card; kept as user data.
 *
 * The code counts: VL_WS_E_BILLING_INFO_1 to _4 for codes 1 to 4.
 */
VL_WS_Status VL_WS_getBillingInfo(VL_WS_Handle* handle, VL_WS_BillingInfoResponse* info);

/*
 * VL_WS_getBillingInfoAndPPCBalance - the saved card and the prepaid balance in one answer, each
 * part with its own code and message (a part the answer lacks stays empty). Always the streaming
 * service. The code of the billing part counts.
 */
VL_WS_Status VL_WS_getBillingInfoAndPPCBalance(VL_WS_Handle* handle, VL_WS_BillingInfoAndPPCBalance* info);

/*
 * VL_WS_getPrePaidCardBalance - the account's prepaid balance. The code counts.
 */
VL_WS_Status VL_WS_getPrePaidCardBalance(VL_WS_Handle* handle, VL_WS_PrePaidCardBalanceResponse* balance);

/*
 * VL_WS_assignGiftCertificateToUser - redeem the gift certificate `code` (required) for the
 * account; the answer holds the new balance.
 *
 * The code counts: VL_WS_E_GIFT_CERTIFICATE_1 and _2 for codes 1 and 2.
 */
VL_WS_Status VL_WS_assignGiftCertificateToUser(VL_WS_Handle* handle, const char* code,
                                               VL_WS_GiftCertificateResponse* answer);

/*
 * VL_WS_getMyVideos - one page (`currentPageNumber` from 1, `itemsPerPage` titles) of the
 * account's purchased and rented titles of a purchase type, title type and watch status.
 *
 * The handle's access type as it stands (VL_WS_getFileType may have changed it) chooses the
 * service: DOWNLOAD asks the download service and keeps nothing; any other type asks the
 * streaming service, whose pages are kept as user data. The code counts.
 */
VL_WS_Status VL_WS_getMyVideos(VL_WS_Handle* handle, int currentPageNumber, int itemsPerPage, int purchaseType,
                               int titleType, int watchStatusFilter, VL_WS_MyVideosResponse* videos);

/*
 * VL_WS_checkRentalExpiration - whether to warn that the rental of pass `passID` runs out, and
 * the hours it has left. The code counts.
 */
VL_WS_Status VL_WS_checkRentalExpiration(VL_WS_Handle* handle, int passID, VL_WS_RentalExpirationResponse* answer);

/*
 * VL_WS_checkForPurchasedTitle - whether the account holds a pass for title `titleID`.
 *
 * The handle's access type as it stands (VL_WS_getFileType may have changed it) chooses the
 * service: DOWNLOAD asks the download service, any other type the streaming service. The status
 * is the SOAP call's.
 */
VL_WS_Status VL_WS_checkForPurchasedTitle(VL_WS_Handle* handle, int titleID, bool* purchased);

/*
 * VL_WS_checkForPurchasedSku - whether the account holds a pass for the product `skuID`. Always
 * the streaming service. The status is the SOAP call's.
 */
VL_WS_Status VL_WS_checkForPurchasedSku(VL_WS_Handle* handle, int skuID, bool* purchased);

/*
 * VL_WS_removeAllMyPurchases - delete every pass of the account; `password` (required) is the
 * account's password. Always the streaming service. The code counts.
 */
VL_WS_Status VL_WS_removeAllMyPurchases(VL_WS_Handle* handle, const char* password, VL_WS_StandardResponse* answer);

/*
 * VL_WS_getTitleListingPurchaseds - the purchased title of each of the `count` passes in
 * `passIDs` (both required), each with the store's code and message for its pass. Always the
 * streaming service. The status is the SOAP call's.
 */
VL_WS_Status VL_WS_getTitleListingPurchaseds(VL_WS_Handle* handle, int count, const int* passIDs,
                                             VL_WS_TitleListingPurchasedForPassArray* titles);

/* ---------------------------------------------------------------------------------------------
 * Wishlist (account operations: see "Account operations in general")
 *
 * With a cache of user data (CACHE_USERDATA) the client keeps a flag per title: whether it is on
 * the wishlist. The changes below keep the flags up to date, and VL_WS_checkTitleInWishlist
 * answers from them without asking the store.
 * ------------------------------------------------------------------------------------------- */

/*
 * VL_WS_getWishlistItems - one page of the wishlist (`currentPageNumber` from 1, `itemsPerPage`
 * titles of `titleType`) in `sortOrder` (values other than 0 to 3 are sent as 0).
 *
 * Kept as user data; a page that comes from the store also sets the flag of every title on it.
 * The code counts.
 */
VL_WS_Status VL_WS_getWishlistItems(VL_WS_Handle* handle, VL_WS_SortOrder sortOrder, int currentPageNumber,
                                    int itemsPerPage, int titleType, VL_WS_WishlistItemsResponse* items);

/*
 * VL_WS_addItemToWishlist, VL_WS_removeItemFromWishlist, VL_WS_removeAllItemsFromWishlist -
 * change the wishlist. On success, with a cache of user data, the cached wishlist pages are
 * deleted and the title's flag is set (added: true, removed: false), or every flag is deleted.
 * The code counts.
 */
VL_WS_Status VL_WS_addItemToWishlist(VL_WS_Handle* handle, int titleID, VL_WS_StandardResponse* answer);
VL_WS_Status VL_WS_removeItemFromWishlist(VL_WS_Handle* handle, int titleID, VL_WS_StandardResponse* answer);
VL_WS_Status VL_WS_removeAllItemsFromWishlist(VL_WS_Handle* handle, VL_WS_StandardResponse* answer);

/*
 * VL_WS_checkTitleInWishlist - whether title `titleID` is on the wishlist.
 *
 * A cache of user data that holds the title's flag answers at once (VL_WS_OK, no request).
 * Otherwise the catalogue service's details of the title tell, and the answer is kept as the
 * title's flag. The code counts.
 */
VL_WS_Status VL_WS_checkTitleInWishlist(VL_WS_Handle* handle, int titleID, bool* inWishlist);

/*
 * VL_WS_checkTitlesInWishlist - whether each of the `count` titles in `titleIDs` (both required)
 * is on the wishlist, one flag per title in the given order, into a bool array record.
 *
 * The wishlist is read page by page (50 titles per page, titles of `titleType`) until every
 * title was found or the last page was read. With a cache of user data the flags of all given
 * titles are then kept. A page that fails ends the reading with its status and the flags found
 * so far; a page that the store refuses (a non-zero code) ends it with VL_WS_OK and the flags
 * found so far. Flags of an unfinished reading are not kept. The status is the SOAP call's.
 */
VL_WS_Status VL_WS_checkTitlesInWishlist(VL_WS_Handle* handle, int count, const int* titleIDs, int titleType,
                                         VL_WS_BoolArray* flags);

/* ---------------------------------------------------------------------------------------------
 * Streaming
 *
 * Playing a purchased title or a bonus asset. These operations always go to the streaming
 * service, whatever the handle's access type, and use no cache. Results, null arguments and
 * failed calls are handled as by the account operations (see "Account operations in general").
 * File profile, audio profile, stream status and bonus asset type are the store's numbers.
 * ------------------------------------------------------------------------------------------- */

/*
 * VL_WS_getStreamingAssetLocation - where pass `passID` streams from in `fileProfile`: the
 * stream's URL, its DRM servers, a new stream instance (StreamID) with its heartbeat, and where
 * playback resumes. VL_WS_loadLastStreamingAssetLocation answers the pass's last stream instance
 * instead of a new one; VL_WS_getStreamingBonusAssetLocation the stream of a bonus asset. The
 * code counts.
 */
VL_WS_Status VL_WS_getStreamingAssetLocation(VL_WS_Handle* handle, int passID, int fileProfile,
                                             VL_WS_StreamingAssetLocationResponse* location);
VL_WS_Status VL_WS_getStreamingBonusAssetLocation(VL_WS_Handle* handle, int bonusAssetID,
                                                  VL_WS_StreamingAssetLocationResponse* location);
VL_WS_Status VL_WS_loadLastStreamingAssetLocation(VL_WS_Handle* handle, int passID, int fileProfile,
                                                  VL_WS_StreamingAssetLocationResponse* location);

/*
 * VL_WS_manageStreamingInstanceStatus - report that stream instance `streamID` (required) is in
 * `status`, `stopTimeSeconds` into the title. The code counts.
 */
VL_WS_Status VL_WS_manageStreamingInstanceStatus(VL_WS_Handle* handle, const char* streamID, int status,
                                                 int stopTimeSeconds, VL_WS_StandardResponse* answer);

/*
 * VL_WS_getTHXMediaDirector, VL_WS_getTHXMediaDirectorBonusAsset - THX media director settings
 * of a pass in a file and audio profile, or of a bonus asset. The status is the SOAP call's: a
 * title without settings is an answer with a non-zero code and status VL_WS_OK.
 */
VL_WS_Status VL_WS_getTHXMediaDirector(VL_WS_Handle* handle, int passID, int fileProfile, int audioProfile,
                                       VL_WS_THXMediaDirectorResponse* settings);
VL_WS_Status VL_WS_getTHXMediaDirectorBonusAsset(VL_WS_Handle* handle, int bonusAssetID, int fileProfile,
                                                 int bonusAssetType, VL_WS_THXMediaDirectorResponse* settings);

/*
 * VL_WS_setAudioDefaultProperty, VL_WS_getAudioDefaultProperty - set or read the account's
 * default audio profile. The status is the SOAP call's; the code of the setting stays in the
 * record.
 */
VL_WS_Status VL_WS_setAudioDefaultProperty(VL_WS_Handle* handle, int audioProfile, VL_WS_StandardResponse* answer);
VL_WS_Status VL_WS_getAudioDefaultProperty(VL_WS_Handle* handle, int* audioProfile);

/* ---------------------------------------------------------------------------------------------
 * Catalogue
 *
 * Every catalogue operation fills the record it is given (tagged even when the call fails, so
 * always release it) and asks the store's catalogue service. Pages are given as a pair of ints,
 * CurrentPageNumber then ItemsPerPage; purchase types (0 rent, 1 buy, 2 any) and title types
 * (0 all, 1 television, 2 movies) are the store's numbers.
 *
 * A handle that caches catalogue answers (CACHE_METADATA) answers repeated requests with the
 * same arguments from its cache, without a request; only successful answers are kept (response
 * code 0, or a list that is not empty) and VL_WS_updateLocalCache drops them all when the store
 * loaded a new catalogue. Operations marked "code folded" return VL_WS_E_UNEXPECTED for a
 * non-zero ResponseCode of the store (the record still holds it); the others return VL_WS_OK and
 * leave the code in the record for the caller.
 *
 * Besides the failures named, every operation returns VL_WS_E_INVALID_ARGUMENT for a null record,
 * a handle without client state or a page number or page size outside -32768 to 32767 (the
 * store answers them in 16-bit fields), and the status of a failed SOAP call (VL_WS_E_CONNECT,
 * VL_WS_E_TLS, VL_WS_E_HTTP_STATUS(n), VL_WS_E_SOAP_FAULT(n), ...), after which the record holds
 * nothing but its tags.
 * ------------------------------------------------------------------------------------------- */

/*
 * VL_WS_getNavigation - the store's genre tree as a flat list of genres (each with its parent's
 * ID) into a genre array (release it). Cached (one tree per cache); a tree without genres is
 * returned but never kept. The status is the SOAP call's.
 */
VL_WS_Status VL_WS_getNavigation(VL_WS_Handle* handle, VL_WS_GenreArray* genres);

/*
 * VL_WS_getGenreLabel - the label and label message of a genre. Never cached; code folded.
 */
VL_WS_Status VL_WS_getGenreLabel(VL_WS_Handle* handle, int genreID, VL_WS_GenreLabelResponse* label);

/*
 * VL_WS_getTitles - one page of the titles of a genre (and of the genres below it). Cached by
 * all four arguments; code folded.
 */
VL_WS_Status VL_WS_getTitles(VL_WS_Handle* handle, int genreID, int currentPageNumber, int itemsPerPage,
                             int purchaseType, VL_WS_TitlesResponse* titles);

/*
 * VL_WS_getTitlesByGenreIDs - the same page of each of `count` genres, one VL_WS_TitlesResponse
 * per page the store returned, in its order (read each page's ResponseCode). Never cached; the
 * status is the SOAP call's. VL_WS_E_INVALID_ARGUMENT also for a count below 1 or a null
 * `genreIDs`.
 */
VL_WS_Status VL_WS_getTitlesByGenreIDs(VL_WS_Handle* handle, int count, const int* genreIDs, int currentPageNumber,
                                       int itemsPerPage, int purchaseType, VL_WS_TitlesResponseArray* pages);

/*
 * VL_WS_getTitleListing - the details of a title. Cached by the title ID; code folded. The
 * answer also tells whether the title is in the account's wishlist: when the answer is kept,
 * that is stored as the title's wishlist flag (with CACHE_USERDATA).
 */
VL_WS_Status VL_WS_getTitleListing(VL_WS_Handle* handle, int titleID, VL_WS_TitleListingResponse* details);

/*
 * VL_WS_getTvEpisodeListing - the details of one episode of a series. Cached by the episode ID;
 * code folded; the series' wishlist flag is stored as with VL_WS_getTitleListing.
 */
VL_WS_Status VL_WS_getTvEpisodeListing(VL_WS_Handle* handle, int episodeID, VL_WS_TitleListingResponse* details);

/*
 * VL_WS_getTvEpisodeListByTitleID - the episodes (ID, name, number) of a series. Cached by the
 * title ID; code folded.
 */
VL_WS_Status VL_WS_getTvEpisodeListByTitleID(VL_WS_Handle* handle, int titleID, VL_WS_TvEpisodeListResponse* episodes);

/*
 * VL_WS_getAllTvEpisodeListings - the details of every episode of a series, in the store's
 * order (read each one's ResponseCode). Cached by the title ID when the list is not empty, with
 * the wishlist flags of the listings; the status is the SOAP call's.
 */
VL_WS_Status VL_WS_getAllTvEpisodeListings(VL_WS_Handle* handle, int titleID, VL_WS_TitleListingResponseArray* listings);

/*
 * VL_WS_translateTivoExternalID - the title of a TiVo external ID. Cached by the ID's text; the
 * status is the SOAP call's. VL_WS_E_INVALID_ARGUMENT also for a null `tivoExternalID`.
 */
VL_WS_Status VL_WS_translateTivoExternalID(VL_WS_Handle* handle, const char* tivoExternalID,
                                           VL_WS_TranslateTivoExternalIDResponse* translation);

/*
 * VL_WS_translateSkuID - the title of a SKU. Cached by the SKU ID; the status is the SOAP call's.
 */
VL_WS_Status VL_WS_translateSkuID(VL_WS_Handle* handle, int skuID, VL_WS_TranslateSkuIDResponse* translation);

/*
 * VL_WS_searchForTitle - one page of the titles whose name matches `query`;
 * VL_WS_searchForTitleDetail also searches synopsis, actors and directors. Cached by all five
 * arguments (the whole query, whatever its length); the status is the SOAP call's.
 * VL_WS_E_INVALID_ARGUMENT also for a null or empty `query`.
 */
VL_WS_Status VL_WS_searchForTitle(VL_WS_Handle* handle, int currentPageNumber, int itemsPerPage, int purchaseType,
                                  int titleType, const char* query, VL_WS_TitlesResponse* titles);
VL_WS_Status VL_WS_searchForTitleDetail(VL_WS_Handle* handle, int currentPageNumber, int itemsPerPage,
                                        int purchaseType, int titleType, const char* query,
                                        VL_WS_TitlesResponse* titles);

/*
 * VL_WS_getRecommendedTitles - titles the store recommends with a title. Cached by the title ID;
 * code folded.
 */
VL_WS_Status VL_WS_getRecommendedTitles(VL_WS_Handle* handle, int titleID, VL_WS_RecommendedTitlesResponse* titles);

/* ---------------------------------------------------------------------------------------------
 * Cache
 * ------------------------------------------------------------------------------------------- */

/*
 * VL_WS_getLastCacheLoadTimeUTC - when the store last loaded its catalogue, as the store's text,
 * into a string record (release it).
 *
 * Returns VL_WS_OK or the status of the SOAP call; VL_WS_E_INVALID_ARGUMENT for no client state
 * or a null `utcTime`.
 */
VL_WS_Status VL_WS_getLastCacheLoadTimeUTC(VL_WS_Handle* handle, VL_WS_String* utcTime);

/*
 * VL_WS_shouldUpdateCache - ask the store whether a catalogue load time (a text as
 * VL_WS_getLastCacheLoadTimeUTC gives it) is out of date. `update` is set to false first, then
 * to true when the store says so. The handle's cache is not touched.
 *
 * Returns VL_WS_OK or the status of the SOAP call; VL_WS_E_INVALID_ARGUMENT for no client state,
 * a null or empty `utcTime` or a null `update`.
 */
VL_WS_Status VL_WS_shouldUpdateCache(VL_WS_Handle* handle, const char* utcTime, bool* update);

/*
 * VL_WS_updateLocalCache - refresh the kinds of cached data in `dataKinds` (bits of
 * VL_WS_CacheParam::CacheData) that the handle caches:
 *   CACHE_METADATA  asks the store for its last catalogue load time; when it differs from the
 *                   one stored, every cached answer is dropped (when the store cannot be asked,
 *                   nothing changes);
 *   CACHE_BOXART    every stored image is revalidated with the image host on its next use;
 *   CACHE_USERDATA  all user data, the wishlist flags included, are deleted.
 *
 * Returns VL_WS_OK (also when there is nothing to do), or VL_WS_E_INVALID_ARGUMENT for no
 * client state.
 */
VL_WS_Status VL_WS_updateLocalCache(VL_WS_Handle* handle, int dataKinds);

/*
 * VL_WS_clearLocalCache - remove the cache files in the folder `folder`: the box-art images
 * ("*.jpg"), the cache databases ("*.vl") and the temporary files ("vlws*"), in that order. It
 * needs no handle; a cache still open on a removed database keeps working on its open file.
 *
 * Returns VL_WS_OK, VL_WS_E_INVALID_ARGUMENT (null or empty `folder`) or VL_WS_E_FILE (the folder
 * cannot be listed or a file cannot be removed; the removal stops at the first failure).
 */
VL_WS_Status VL_WS_clearLocalCache(const char* folder);

/* ---------------------------------------------------------------------------------------------
 * Box art
 *
 * Images come from the store's image host over plain HTTP, never through the handle's proxy.
 * A cache that stores box art (CACHE_BOXART) keeps each image with its "Last-Modified" value;
 * after VL_WS_updateLocalCache(handle, CACHE_BOXART) the next use of an image asks the image
 * host once whether it changed.
 * ------------------------------------------------------------------------------------------- */

/*
 * VL_WS_getBoxArtImage - where the image of `prefix` in `size` can be loaded from, into a string
 * record (release it).
 *
 * With a file cache that stores box art, the image is downloaded (or revalidated) into the
 * cache folder as "<prefix><size>.jpg" and that file's name is returned (a prefix holding "/" is
 * never made a file). Otherwise, and when the download fails, the answer is the image's URL
 * "http://<image host>/images/boxart/<folder size>/<URL-encoded prefix><size>.jpg".
 *
 * Returns VL_WS_OK, or VL_WS_E_INVALID_ARGUMENT (no client state, a null or empty prefix, a size
 * that is not a VL_WS_BoxArtSize, a null `location`).
 */
VL_WS_Status VL_WS_getBoxArtImage(VL_WS_Handle* handle, VL_WS_BoxArtSize size, const char* prefix,
                                  VL_WS_String* location);

/*
 * VL_WS_getBoxArtImageData - the bytes of the image of `prefix` in `size`, into an image record
 * (release it).
 *
 * A cache that stores box art answers from its copy (revalidated when marked for it) and keeps
 * every image downloaded; without one the image is downloaded every time.
 *
 * Returns VL_WS_OK, or VL_WS_E_INVALID_ARGUMENT (as VL_WS_getBoxArtImage, or a null `image`), or
 * the download's failure: VL_WS_E_CONNECT (image host not reached), VL_WS_E_NETWORK (a transfer
 * failure or an answer of the wrong form, an image announced above 32 MiB included),
 * VL_WS_E_HTTP_NOT_FOUND (no such image) or VL_WS_E_FILE (the cache file could not be written).
 */
VL_WS_Status VL_WS_getBoxArtImageData(VL_WS_Handle* handle, VL_WS_BoxArtSize size, const char* prefix,
                                      VL_WS_Image* image);

/* ---------------------------------------------------------------------------------------------
 * Records
 * ------------------------------------------------------------------------------------------- */

/*
 * VL_WS_release - give back any record of this interface, a VL_WS_Handle included.
 *
 * `record` points at the record itself (its first word is the tag pointer). Everything the record
 * owns is freed by its type tag, nested records and arrays included; the tag pointer is then set
 * to null, so releasing the same record again does nothing and returns VL_WS_OK. Releasing a
 * handle closes its cache and frees its client state; its two words are null afterwards.
 *
 * Returns VL_WS_OK, or VL_WS_E_INVALID_ARGUMENT when `record` is null or carries an unknown tag
 * (above VL_WS_TAG_LAST, negative, or one of the reserved tags 45 to 48); nothing is freed then.
 */
VL_WS_Status VL_WS_release(void* record);

/* ---------------------------------------------------------------------------------------------
 * Device and network
 *
 * The network operations send one plain HTTP/1.1 request each, over the same connection
 * machinery as the SOAP calls (VLWS_CONNECT_TO and TLS apply).
 * ------------------------------------------------------------------------------------------- */

/*
 * VL_WS_checkBandwidth - measure the download bandwidth from the store, in bits per second.
 *
 * The probe URL is the handle's BandwithCheckURL; the first check fills it from the store's
 * configuration (VL_WS_getConfig: the last item "BandwithCheckURL", the key in any letter case).
 * The probe, "http://host[:port]/path" or "https://...", is fetched directly, never through
 * the handle's proxy; at most 204800 bytes of its body are read, and the time is taken from the
 * end of the answer's header. The result is the bytes read times 8000 divided by the
 * milliseconds taken (at least 1).
 *
 * `bitsPerSecond` is 0 unless the call succeeds. Returns VL_WS_OK, or:
 *   VL_WS_E_INVALID_ARGUMENT   null `bitsPerSecond`, no client state
 *   (status of VL_WS_getConfig) the configuration could not be read
 *   VL_WS_E_BANDWIDTH_NO_URL   the configuration names no probe URL
 *   VL_WS_E_BANDWIDTH_BAD_URL  the probe URL has no "//", no host, no path or a bad port
 *   VL_WS_E_CONNECT            the probe's host could not be connected to
 *   VL_WS_E_HTTP_NOT_FOUND     the probe's host answered "404 Not Found"
 *   VL_WS_E_NETWORK            sending failed, nothing was received, the answer is not "200 OK"
 *                              with a Content-Length above 0, or the body ended early
 */
VL_WS_Status VL_WS_checkBandwidth(VL_WS_Handle* handle, unsigned int* bitsPerSecond);

/*
 * VL_WS_getDestinationUniqueID - the device's identifier into a string record (release it):
 * the hardware address of its first network interface with one, as "XX-XX-XX-XX-XX-XX"
 * (upper-case hexadecimal); on a device without one a random identifier of the same form,
 * new at every call.
 *
 * Returns VL_WS_OK, or VL_WS_E_INVALID_ARGUMENT for a null `id`.
 */
VL_WS_Status VL_WS_getDestinationUniqueID(VL_WS_String* id);

/*
 * VL_WS_getUserAgent - the User-Agent text of the handle's SOAP requests into a string record
 * (release it); empty when the handle sends the default.
 *
 * Returns VL_WS_OK, or VL_WS_E_INVALID_ARGUMENT (no client state, null `userAgent`); the record
 * is then left untouched.
 */
VL_WS_Status VL_WS_getUserAgent(VL_WS_Handle* handle, VL_WS_String* userAgent);

/*
 * VL_WS_getLocalIPAddr - the device's IPv4 address in dotted form into a string record (release
 * it): the one non-loopback address the system resolver gives for the device, else the local
 * address of a connection to the handle's catalogue service (through its proxy, if any).
 *
 * Returns VL_WS_OK, or:
 *   VL_WS_E_INVALID_ARGUMENT  null `address`, no client state
 *   VL_WS_E_UNEXPECTED        the handle's service URL names no host
 *   VL_WS_E_CONNECT           the catalogue service could not be connected to
 *   VL_WS_E_NETWORK           the connection's local address could not be read
 */
VL_WS_Status VL_WS_getLocalIPAddr(VL_WS_Handle* handle, VL_WS_String* address);

/*
 * VL_WS_getServerTime - the store's clock, in seconds since 1970 UTC, from its time service
 * "http://store.ostrel.example/device/time/". It needs no handle.
 *
 * `serverTime` is -1 unless the call succeeds. Returns VL_WS_OK, or:
 *   VL_WS_E_INVALID_ARGUMENT  null `serverTime`
 *   VL_WS_E_CONNECT           the service could not be connected to
 *   VL_WS_E_NETWORK           sending failed, nothing was received, or the answer is not
 *                             "200 OK" with a Content-Length above 0
 *   VL_WS_E_UNEXPECTED        the body is shorter than announced or is not a time
 *                             "month/day/year hour:minute:second AM|PM"
 */
VL_WS_Status VL_WS_getServerTime(time_t* serverTime);

/* ---------------------------------------------------------------------------------------------
 * Settings files
 *
 * A settings file is a small XML file of key/value pairs (the configuration and settings files
 * of the configuration extension). Keys compare byte for byte. An encrypted value is stored with
 * its own random password and a check, so two writes of the same value store different texts.
 * ------------------------------------------------------------------------------------------- */

/*
 * VL_WS_readSetting - the value of `key` in the settings file `filename`, decrypted when
 * `encrypted` is true, into a string record (release it).
 *
 * Only the first setting with the key counts. An encrypted read of a value stored plain, or of
 * a value that was changed by hand, is VL_WS_E_SETTING_DAMAGED.
 *
 * Returns VL_WS_OK, or:
 *   VL_WS_E_INVALID_ARGUMENT  null `value`; null or empty `filename` or `key`
 *   VL_WS_E_FILE              the file cannot be opened or read
 *   VL_WS_E_SETTING_MISSING   the file is empty, holds no settings, or none with the key
 *   VL_WS_E_SETTING_DAMAGED   the encrypted value is damaged (also: an encrypted empty value)
 *   VL_WS_E_SETTING_UNREADABLE  the file does not parse as a settings file (cut short, garbage)
 * On failure the record is tagged and holds no text.
 */
VL_WS_Status VL_WS_readSetting(const char* filename, const char* key, VL_WS_String* value,
                               bool encrypted);

/*
 * VL_WS_writeSetting - set `key` to `value` in the settings file `filename`, encrypted when
 * `encrypted` is true.
 *
 * The first setting with the key is replaced in place, or a new one is appended; every other
 * setting keeps its place and text. A missing file, and the folder of `filename` when it is
 * missing, are created. The file is replaced whole, so a crash leaves the old or the new file.
 * A file that does not parse (VL_WS_E_SETTING_UNREADABLE for a read) is kept as
 * "<filename>.damaged", replacing an older one, before a new file with this one setting takes
 * its place. A file written with an encrypted value is readable by its owner only. An empty
 * value written encrypted reads back as VL_WS_E_SETTING_DAMAGED.
 *
 * Returns VL_WS_OK, VL_WS_E_INVALID_ARGUMENT (null or empty `filename` or `key`, null `value`)
 * or VL_WS_E_FILE (the folder or the file cannot be created or written, the file exists but
 * cannot be read, or a file that does not parse cannot be kept aside).
 */
VL_WS_Status VL_WS_writeSetting(const char* filename, const char* key, const char* value,
                                bool encrypted);

/*
 * VL_WS_createEnvXML - copy the file `source` to `destination` unless `destination` exists.
 *
 * An existing destination is left untouched. A copy that fails leaves no destination behind.
 * Returns VL_WS_OK, VL_WS_E_INVALID_ARGUMENT (a null argument) or VL_WS_E_FILE.
 */
VL_WS_Status VL_WS_createEnvXML(const char* source, const char* destination);

/*
 * VL_WS_deleteEnvXML - remove the file `filename` if it exists.
 *
 * Returns VL_WS_OK (also when there is no such file or it cannot be removed), or
 * VL_WS_E_INVALID_ARGUMENT for a null `filename`.
 */
VL_WS_Status VL_WS_deleteEnvXML(const char* filename);

/* ---------------------------------------------------------------------------------------------
 * Files and folders
 * ------------------------------------------------------------------------------------------- */

/*
 * VL_WS_checkVLSWFmd5sum - the output of the system's md5sum command for the file `filename`
 * into a string record (release it): normally 32 hexadecimal digits, two blanks, the file name
 * and a line end; empty when md5sum found no such file.
 *
 * The name reaches the command as one quoted word: no character of it is interpreted by the
 * shell. Returns VL_WS_OK, or:
 *   VL_WS_E_INVALID_ARGUMENT  null `md5sum` or `filename`; a name so long that the command
 *                             would exceed 1023 bytes
 *   VL_WS_E_UNEXPECTED        the command could not be started
 */
VL_WS_Status VL_WS_checkVLSWFmd5sum(const char* filename, VL_WS_String* md5sum);

/*
 * VL_WS_removeFile - remove the file `filename`.
 *
 * Returns VL_WS_OK (also when there is no such file), VL_WS_E_INVALID_ARGUMENT (null
 * `filename`) or VL_WS_E_FILE (the file exists and cannot be removed).
 */
VL_WS_Status VL_WS_removeFile(const char* filename);

/*
 * VL_WS_copyFile - copy the file `source` to `destination`, which is created or overwritten.
 *
 * A copy that fails leaves no destination behind unless one existed before. Copying a file
 * onto itself fails. Returns VL_WS_OK, VL_WS_E_INVALID_ARGUMENT (a null argument) or
 * VL_WS_E_FILE.
 */
VL_WS_Status VL_WS_copyFile(const char* source, const char* destination);

/*
 * VL_WS_getFolderName - the folder part of `path`, up to and including its last "/", into a
 * string record (release it). A path without "/" gives the path followed by "/", the empty
 * path "./".
 *
 * Returns VL_WS_OK, or VL_WS_E_INVALID_ARGUMENT for a null argument.
 */
VL_WS_Status VL_WS_getFolderName(const char* path, VL_WS_String* folder);

/*
 * VL_WS_folderExist - whether `path` names an existing folder.
 *
 * Returns VL_WS_OK, or VL_WS_E_INVALID_ARGUMENT for a null argument.
 */
VL_WS_Status VL_WS_folderExist(const char* path, bool* exist);

/*
 * VL_WS_createFolder - create the folder `path` with every missing parent.
 *
 * Returns VL_WS_OK (also when it exists), VL_WS_E_INVALID_ARGUMENT (null `path`) or
 * VL_WS_E_FILE (a part of the path is not a folder, or a folder cannot be made).
 */
VL_WS_Status VL_WS_createFolder(const char* path);

/*
 * VL_WS_fileExist - whether the file `path` exists and can be read.
 *
 * Returns VL_WS_OK, or VL_WS_E_INVALID_ARGUMENT for a null argument.
 */
VL_WS_Status VL_WS_fileExist(const char* path, bool* exist);

}  /* extern "C" */

#endif /* VL_WS_H */
