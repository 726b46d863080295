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
