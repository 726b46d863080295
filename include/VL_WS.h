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
 * cache folder as "<prefix><size>.jpg" and that file's name is returned. Otherwise, and when
 * the download fails, the answer is the image's URL
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
 * An empty value written encrypted reads back as VL_WS_E_SETTING_DAMAGED.
 *
 * Returns VL_WS_OK, VL_WS_E_INVALID_ARGUMENT (null or empty `filename` or `key`, null `value`)
 * or VL_WS_E_FILE (the folder or the file cannot be created or written).
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
