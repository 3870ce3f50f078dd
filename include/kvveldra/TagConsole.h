#ifndef KVVELDRA_TAGCONSOLE_H
#define KVVELDRA_TAGCONSOLE_H

// The TagConsole* function family: blocking calls with standard C++ types.
// Plain (C linkage) names; the error out-parameter is assigned only on
// failure. Status 0 is success, a negative status an error code, 1 a call
// that had nothing to act on.

#include <chrono>
#include <cstdint>
#include <string>
#include <unordered_map>
#include <vector>

#include "kvveldra/Export.h"

// Data types at this interface: 0 Double, 1 Int, 2 String, 3 Boolean,
// 4 UInt64, 5 DateTime; any other value means none.

// A UTC point in microseconds since 1970. min() and max() stand for the two
// boundless times; a value that was never given a time reads as min().
using TagConsoleTime =
    std::chrono::time_point<std::chrono::system_clock, std::chrono::microseconds>;

// One value to write: its text form and its time. Texts go out as they
// stand; the service judges them by the data type.
struct TagConsoleSample {
    std::string value;
    TagConsoleTime timestamp;
};
// The samples of one write, in the order of writing.
using TagConsoleSamples = std::vector<TagConsoleSample>;

using TagConsoleProperties = std::unordered_map<std::string, std::string>;

// The current value of one tag, as a read gives it, with its aggregates
// (count 0 and empty texts while the tag collects none).
struct TagConsoleValue {
    std::string path;
    int32_t dataType = -1;
    std::string value;
    TagConsoleTime timestamp;
    int32_t aggregateCount = 0;
    double aggregateAverage = 0.0;
    std::string aggregateMinimum;
    std::string aggregateMaximum;
};

KVVELDRA_EXTERN_C KVVELDRA_API int32_t TagConsoleReserve(bool* reserved);
KVVELDRA_EXTERN_C KVVELDRA_API int32_t TagConsoleUnreserve(bool* reserved);

KVVELDRA_EXTERN_C KVVELDRA_API int32_t TagConsoleInitialize(uint64_t instanceId,
                                                            const std::string* configurationId,
                                                            const uint32_t* timeoutMs,
                                                            const bool* allowFallback,
                                                            std::string* error);
KVVELDRA_EXTERN_C KVVELDRA_API int32_t TagConsoleCloseInstance(uint64_t instanceId,
                                                               std::string* error);

// Opens the tag of a path, creating it with the data type when the service
// knows none; a path that is already open gives the same reference, which
// then owes one more close.
KVVELDRA_EXTERN_C KVVELDRA_API int32_t TagConsoleOpen(uint64_t instanceId, const std::string* path,
                                                      int32_t dataType, bool verbose,
                                                      uint32_t* tagReference, std::string* error);
// Lists a page of the matching tags and opens each one it gives: every
// reference owes one close. `total` counts all matches.
KVVELDRA_EXTERN_C KVVELDRA_API int32_t TagConsoleListTag(
    uint64_t instanceId, const std::vector<std::string>* searchPaths,
    const TagConsoleProperties* properties, const std::vector<std::string>* keywords,
    uint32_t skip, uint32_t take, bool allowStale, bool verbose, std::vector<int32_t>* dataTypes,
    std::vector<std::string>* paths, std::vector<uint32_t>* tagReferences, uint32_t* total,
    std::string* error);

KVVELDRA_EXTERN_C KVVELDRA_API int32_t TagConsoleWriteTag(uint32_t tagReference, int32_t dataType,
                                                          const TagConsoleSamples* values,
                                                          bool verbose, std::string* error);
// One record per tag in the service's answer, in its order. The fourth
// argument is not used.
KVVELDRA_EXTERN_C KVVELDRA_API int32_t TagConsoleReadValues(
    uint64_t instanceId, const std::vector<uint32_t>* tagReferences, bool verbose, int32_t unused,
    std::vector<TagConsoleValue>* results, std::string* error);

// Keywords are appended to the list, properties assigned into the map.
KVVELDRA_EXTERN_C KVVELDRA_API int32_t TagConsoleGetKeywords(uint32_t tagReference, bool verbose,
                                                             std::vector<std::string>* keywords,
                                                             std::string* error);
KVVELDRA_EXTERN_C KVVELDRA_API int32_t TagConsoleGetProperties(uint32_t tagReference,
                                                               bool verbose,
                                                               TagConsoleProperties* properties,
                                                               std::string* error);
KVVELDRA_EXTERN_C KVVELDRA_API int32_t TagConsoleGetCollectAggregates(uint32_t tagReference,
                                                                      bool verbose,
                                                                      bool* collectAggregates,
                                                                      std::string* error);
// The two sets replace what the tag had.
KVVELDRA_EXTERN_C KVVELDRA_API int32_t TagConsoleSetKeywords(
    uint32_t tagReference, const std::vector<std::string>* keywords, bool verbose,
    std::string* error);
KVVELDRA_EXTERN_C KVVELDRA_API int32_t TagConsoleSetProperties(
    uint32_t tagReference, const TagConsoleProperties* properties, bool verbose,
    std::string* error);
KVVELDRA_EXTERN_C KVVELDRA_API int32_t TagConsoleSetCollectAggregates(uint32_t tagReference,
                                                                      bool collectAggregates,
                                                                      bool verbose,
                                                                      std::string* error);

// Read, reset and delete act on the references that are valid and report
// an invalid reference (-251900) when some were not. A deleted tag stays
// open here: its references still owe their closes.
KVVELDRA_EXTERN_C KVVELDRA_API int32_t TagConsoleResetAggregates(
    uint64_t instanceId, const std::vector<uint32_t>* tagReferences, bool verbose,
    std::string* error);
KVVELDRA_EXTERN_C KVVELDRA_API int32_t TagConsoleDeleteTag(
    uint64_t instanceId, const std::vector<uint32_t>* tagReferences, bool verbose,
    std::string* error);

KVVELDRA_EXTERN_C KVVELDRA_API int32_t TagConsoleClose(uint32_t tagReference, bool verbose,
                                                       std::string* error);
KVVELDRA_EXTERN_C KVVELDRA_API int32_t TagConsoleGetDataType(uint32_t tagReference, bool verbose,
                                                             int32_t* dataType, std::string* error);
KVVELDRA_EXTERN_C KVVELDRA_API int32_t TagConsoleGetPath(uint32_t tagReference, bool verbose,
                                                         std::string* path, std::string* error);

#endif
