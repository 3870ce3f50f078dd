#ifndef KVVELDRA_TAGWB_H
#define KVVELDRA_TAGWB_H

/* The TagWB* function family: the interface for the graphical dataflow host.
 * No function blocks; the error out-parameter is a host string handle that a
 * failing call resizes and fills, and that a successful call leaves as it is.
 * Status 0 is success, a negative status an error code, 1 a call that had
 * nothing to act on. */

#include <stdbool.h>
#include <stdint.h>

#include "kvveldra/Export.h"
#include "kvveldra/WBTypes.h"

#ifdef __cplusplus
extern "C" {
#endif

KVVELDRA_API int32_t TagWBReserve(bool* reserved);
KVVELDRA_API int32_t TagWBUnreserve(bool* reserved);

KVVELDRA_API int32_t TagWBInitialize(uint64_t instanceId, WBStrHandle* configurationId,
                                     uint32_t timeoutMs, const bool* allowFallback, bool* created,
                                     WBStrHandle* error);
KVVELDRA_API int32_t TagWBCloseInstance(uint64_t instanceId, WBStrHandle* error);
KVVELDRA_API int32_t TagWBImplicitClose(uint32_t tagReference);

KVVELDRA_API int32_t TagWBClose(uint32_t tagReference, WBStrHandle* error);
KVVELDRA_API int32_t TagWBGetDataType(uint32_t tagReference, int32_t* dataType, WBStrHandle* error);

#ifdef __cplusplus
}
#endif

#endif
