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

/* Requests and their finishes.
 *
 * A request function returns at once. It hands out a request id, the time in
 * milliseconds that the host should wait at most, and a host signal that is
 * fired when the answer arrives. Whether the signal fired or the wait ran
 * out, the host then calls the matching finish function with the request id:
 * the finish delivers the answer, or -251001 "Request timed out." when none
 * came. Every request is finished once; the signal is the library's until
 * then. Functions whose finish delivers nothing are finished with
 * TagWBFinishRequest (by instance) or TagWBFinishRequestSession (by tag).
 *
 * Data types are numbered 0 Double, 1 Int, 2 String, 3 Boolean, 4 UInt64,
 * 5 DateTime. Out-arrays are created when the handle is null and resized
 * otherwise; status 2 means the host was out of memory. A null required
 * out-pointer gives status 1. */

/* Opening a tag: look the path up, wait, then TagWBOpenOrCreate. When it
 * sets *found, *tagReference is valid; otherwise a create is under way with
 * the new id, time-out and signal, and after the wait TagWBFinishCreate
 * delivers the reference. *requestId goes into TagWBOpenOrCreate as the
 * lookup's id. */
KVVELDRA_API int32_t TagWBLookupTag(uint64_t instanceId, WBStrHandle* path, uint32_t* requestId,
                                    uint32_t* timeoutMs, uint32_t* signal, WBStrHandle* error);
KVVELDRA_API int32_t TagWBOpenOrCreate(uint64_t instanceId, WBStrHandle* path, int32_t dataType,
                                       bool* found, uint32_t* tagReference, uint32_t* requestId,
                                       uint32_t* timeoutMs, uint32_t* signal, WBStrHandle* error);
KVVELDRA_API int32_t TagWBFinishCreate(uint64_t instanceId, WBStrHandle* path, int32_t dataType,
                                       uint32_t requestId, uint32_t* tagReference,
                                       WBStrHandle* error);

/* Listing. An empty search-path array lists every path; property elements
 * with a null key or value are skipped. TagWBList takes the first 1000. The
 * references delivered are open, and each is closed with TagWBClose. */
KVVELDRA_API int32_t TagWBList(uint64_t instanceId, WBStrArrayHandle searchPaths,
                               WBPropertyArrayHandle properties, WBStrArrayHandle keywords,
                               uint32_t* requestId, uint32_t* timeoutMs, uint32_t* signal,
                               WBStrHandle* error);
KVVELDRA_API int32_t TagWBList2(uint64_t instanceId, WBStrArrayHandle searchPaths,
                                WBPropertyArrayHandle properties, WBStrArrayHandle keywords,
                                uint32_t skip, uint32_t take, uint32_t* requestId,
                                uint32_t* timeoutMs, uint32_t* signal, WBStrHandle* error);
KVVELDRA_API int32_t TagWBFinishList(uint64_t instanceId, uint32_t requestId,
                                     WBTypeArrayHandle* dataTypes, WBStrArrayHandle* paths,
                                     WBReferenceArrayHandle* tagReferences, WBStrHandle* error);
KVVELDRA_API int32_t TagWBFinishList2(uint64_t instanceId, uint32_t requestId,
                                      WBTypeArrayHandle* dataTypes, WBStrArrayHandle* paths,
                                      WBReferenceArrayHandle* tagReferences, uint32_t* total,
                                      WBStrHandle* error);

/* Reading current values. The single read delivers the value as a variant
 * (TagWBFinishRead) or as text (TagWBFinishRead2); a read that found no value
 * leaves the outputs as they were. The multi read's *anyInvalid tells that
 * some references were not valid: the finish then fills the array for the
 * others and returns -251900. */
KVVELDRA_API int32_t TagWBRead(uint32_t tagReference, uint32_t* requestId, uint32_t* timeoutMs,
                               uint32_t* signal, WBStrHandle* error);
KVVELDRA_API int32_t TagWBFinishRead(uint32_t tagReference, int32_t dataType, uint32_t requestId,
                                     WbVariant** value, WBTimestamp* timestamp,
                                     WBAggregates* aggregates, WBStrHandle* error);
KVVELDRA_API int32_t TagWBFinishRead2(uint32_t tagReference, int32_t dataType, uint32_t requestId,
                                      WBStrHandle* value, WBTimestamp* timestamp,
                                      WBAggregates2* aggregates, WBStrHandle* error);
KVVELDRA_API int32_t TagWBReadMulti(uint64_t instanceId, WBReferenceArrayHandle tagReferences,
                                    bool* anyInvalid, uint32_t* requestId, uint32_t* timeoutMs,
                                    uint32_t* signal, WBStrHandle* error);
KVVELDRA_API int32_t TagWBFinishReadMulti(uint64_t instanceId, uint32_t requestId,
                                          const bool* anyInvalid, WBValueArrayHandle* values,
                                          WBStrHandle* error);
KVVELDRA_API int32_t TagWBFinishReadMulti2(uint64_t instanceId, uint32_t requestId,
                                           const bool* anyInvalid, WBValueArray2Handle* values,
                                           WBStrHandle* error);

/* Writing values, finished with TagWBFinishRequestSession (by tag) or
 * TagWBFinishRequest (the Multi forms, by instance). A missing or all-zero
 * timestamp leaves the time to the service. Variants carry Double, Int,
 * String and Boolean; UInt64 and DateTime are written as text. */
KVVELDRA_API int32_t TagWBWrite(uint32_t tagReference, int32_t dataType, WBVariantArrayHandle values,
                                WBTimestampArrayHandle timestamps, uint32_t* requestId,
                                uint32_t* timeoutMs, uint32_t* signal, WBStrHandle* error);
KVVELDRA_API int32_t TagWBWrite2(uint32_t tagReference, int32_t dataType, WBStrArrayHandle values,
                                 WBTimestampArrayHandle timestamps, uint32_t* requestId,
                                 uint32_t* timeoutMs, uint32_t* signal, WBStrHandle* error);
KVVELDRA_API int32_t TagWBWriteMulti(uint64_t instanceId, WBValueArrayHandle values,
                                     uint32_t* requestId, uint32_t* timeoutMs, uint32_t* signal,
                                     WBStrHandle* error);
KVVELDRA_API int32_t TagWBWriteMulti2(uint64_t instanceId, WBValueArray2Handle values,
                                      uint32_t* requestId, uint32_t* timeoutMs, uint32_t* signal,
                                      WBStrHandle* error);

/* A tag's metadata. */
KVVELDRA_API int32_t TagWBGetKeywords(uint32_t tagReference, uint32_t* requestId,
                                      uint32_t* timeoutMs, uint32_t* signal, WBStrHandle* error);
KVVELDRA_API int32_t TagWBFinishGetKeywords(uint32_t tagReference, uint32_t requestId,
                                            WBStrArrayHandle* keywords, WBStrHandle* error);
KVVELDRA_API int32_t TagWBGetProperties(uint32_t tagReference, uint32_t* requestId,
                                        uint32_t* timeoutMs, uint32_t* signal, WBStrHandle* error);
KVVELDRA_API int32_t TagWBFinishGetProperties(uint32_t tagReference, uint32_t requestId,
                                              WBPropertyArrayHandle* properties,
                                              WBStrHandle* error);
KVVELDRA_API int32_t TagWBGetCollectAggregates(uint32_t tagReference, uint32_t* requestId,
                                               uint32_t* timeoutMs, uint32_t* signal,
                                               WBStrHandle* error);
KVVELDRA_API int32_t TagWBFinishGetCollectAggregates(uint32_t tagReference, uint32_t requestId,
                                                     bool* collectAggregates, WBStrHandle* error);

/* The sets hand out the tag's instance id for TagWBFinishRequest. Set
 * replaces, Update merges by key. */
KVVELDRA_API int32_t TagWBSetKeywords(uint32_t tagReference, WBStrArrayHandle keywords,
                                      uint64_t* instanceId, uint32_t* requestId,
                                      uint32_t* timeoutMs, uint32_t* signal, WBStrHandle* error);
KVVELDRA_API int32_t TagWBSetProperties(uint32_t tagReference, WBPropertyArrayHandle properties,
                                        uint64_t* instanceId, uint32_t* requestId,
                                        uint32_t* timeoutMs, uint32_t* signal, WBStrHandle* error);
KVVELDRA_API int32_t TagWBUpdateProperties(uint32_t tagReference, WBPropertyArrayHandle properties,
                                           uint64_t* instanceId, uint32_t* requestId,
                                           uint32_t* timeoutMs, uint32_t* signal,
                                           WBStrHandle* error);
KVVELDRA_API int32_t TagWBSetCollectAggregates(uint32_t tagReference, const bool* collectAggregates,
                                               uint64_t* instanceId, uint32_t* requestId,
                                               uint32_t* timeoutMs, uint32_t* signal,
                                               WBStrHandle* error);

/* Operations on several tags of one instance. When some references are not
 * valid, the rest go out and the finish reports -251900. */
KVVELDRA_API int32_t TagWBResetAggregates(uint64_t instanceId, WBReferenceArrayHandle tagReferences,
                                          uint32_t* requestId, uint32_t* timeoutMs,
                                          uint32_t* signal, WBStrHandle* error);
KVVELDRA_API int32_t TagWBDelete(uint64_t instanceId, WBReferenceArrayHandle tagReferences,
                                 uint32_t* requestId, uint32_t* timeoutMs, uint32_t* signal,
                                 WBStrHandle* error);
/* Deletes every tag of the service; the one call that waits for its answer. */
KVVELDRA_API int32_t TagWBDeleteAll(uint64_t instanceId, WBStrHandle* error);

KVVELDRA_API int32_t TagWBFinishRequest(uint64_t instanceId, uint32_t requestId,
                                        WBStrHandle* error);
KVVELDRA_API int32_t TagWBFinishRequestSession(uint32_t tagReference, uint32_t requestId,
                                               WBStrHandle* error);

#ifdef __cplusplus
}
#endif

#endif
