#ifndef KVVELDRA_TAGCONSOLE_H
#define KVVELDRA_TAGCONSOLE_H

// The TagConsole* function family: blocking calls with standard C++ types.
// Plain (C linkage) names; the error out-parameter is assigned only on
// failure. Status 0 is success, a negative status an error code, 1 a call
// that had nothing to act on.

#include <cstdint>
#include <string>

#include "kvveldra/Export.h"

// Data types at this interface: 0 Double, 1 Int, 2 String, 3 Boolean,
// 4 UInt64, 5 DateTime; any other value means none.

KVVELDRA_EXTERN_C KVVELDRA_API int32_t TagConsoleReserve(bool* reserved);
KVVELDRA_EXTERN_C KVVELDRA_API int32_t TagConsoleUnreserve(bool* reserved);

KVVELDRA_EXTERN_C KVVELDRA_API int32_t TagConsoleInitialize(uint64_t instanceId,
                                                            const std::string* configurationId,
                                                            const uint32_t* timeoutMs,
                                                            const bool* allowFallback,
                                                            std::string* error);
KVVELDRA_EXTERN_C KVVELDRA_API int32_t TagConsoleCloseInstance(uint64_t instanceId,
                                                               std::string* error);

KVVELDRA_EXTERN_C KVVELDRA_API int32_t TagConsoleClose(uint32_t tagReference, bool verbose,
                                                       std::string* error);
KVVELDRA_EXTERN_C KVVELDRA_API int32_t TagConsoleGetDataType(uint32_t tagReference, bool verbose,
                                                             int32_t* dataType, std::string* error);
KVVELDRA_EXTERN_C KVVELDRA_API int32_t TagConsoleGetPath(uint32_t tagReference, bool verbose,
                                                         std::string* path, std::string* error);

#endif
