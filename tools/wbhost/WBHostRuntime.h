#ifndef KVVELDRA_WBHOSTRUNTIME_H
#define KVVELDRA_WBHOSTRUNTIME_H

/* A stand-in for the graphical host's runtime, for tests and tools: memory
 * handles, signals and variants with the functions the TagWB* family looks up
 * by name. The functions marked "emulator only" exist for tests and tools to
 * inspect and free what the library handed out. */

#include <stddef.h>
#include <stdint.h>

#include "kvveldra/WBTypes.h"

#ifdef __cplusplus
extern "C" {
#endif

/* Handles: a pointer to a pointer to a zeroed block. */
WBHandle WBNewHandleClr(size_t size);
int32_t WBResizeHandleClr(WBHandle handle, size_t size);
void WBDisposeHandle(WBHandle handle);     /* emulator only */
size_t WBHandleSize(WBHandle handle);      /* emulator only */
void WBFailNextAllocations(int32_t count); /* emulator only: next N allocations fail */

/* Signals: numbers that can be fired from any thread and waited on. */
uint32_t WBAllocSignal(void);
int32_t WBFreeSignal(uint32_t signal);
int32_t WBFireSignal(uint32_t signal);
/* Emulator only: 1 when the signal was fired within the time, else 0; also 0
 * as soon as the signal is freed. */
int32_t WBWaitSignal(uint32_t signal, uint32_t timeoutMs);
/* Emulator only: 1 as soon as WBFireSignal was called with this number at
 * least once since it was allocated, also while it was freed or never
 * allocated (those calls still return non-zero); 0 when none came within the
 * time. */
int32_t WBWaitFireAttempt(uint32_t signal, uint32_t timeoutMs);

/* Variants. */
enum WbVariantType {
    WbVariantEmpty = 0,
    WbVariantDouble = 1,
    WbVariantI32 = 2,
    WbVariantUI32 = 3,
    WbVariantBool = 4,
    WbVariantLStr = 5
};
void* WbVariantGetDataPtr(WbVariant* variant);
int32_t WbVariantNestInVariant(WbVariant** slot);
int32_t WbVariantSetDBL(WbVariant* variant, double value);
int32_t WbVariantSetI32(WbVariant* variant, int32_t value);
int32_t WbVariantSetUI32(WbVariant* variant, uint32_t value);
int32_t WbVariantSetBool(WbVariant* variant, uint8_t value);
int32_t WbVariantSetLStr(WbVariant* variant, WBStrHandle value);
WbVariant* WbVariantNew(void);                      /* emulator only */
void WbVariantFree(WbVariant* variant);             /* emulator only */
int32_t WbVariantGetType(const WbVariant* variant); /* emulator only */
/* Emulator only: the next `count` calls of WbVariantNestInVariant and the
 * WbVariantSet* functions return `status` and change nothing. A count of 0 or
 * less, or a status of 0, switches the failures off. */
void WbVariantFailNextCalls(int32_t count, int32_t status);

#ifdef __cplusplus
}
#endif

#endif
