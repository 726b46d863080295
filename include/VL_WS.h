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
 * (CachePath "" is the current folder); a file that is no usable database is deleted and made
 * anew.
 *
 * Returns VL_WS_OK, or:
 *   VL_WS_E_INVALID_ARGUMENT  a null argument; APIKey, DestinationUniqueID, UserName or Password
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
 * Returns VL_WS_OK, VL_WS_E_INVALID_ARGUMENT (null `copy`, `copy` equal to `source`, or a
 * source without client state), VL_WS_E_TLS_SETUP or VL_WS_E_CACHE_OPEN. On a failure the copy
 * may hold a partial handle: release it.
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

}  /* extern "C" */

#endif /* VL_WS_H */
