// Reservation and instance functions of the host family.
#include "errors/ErrorCodes.h"
#include "kvveldra/TagWB.h"
#include "taglibrary/exports/ErrorOut.h"
#include "taglibrary/exports/HostStrings.h"
#include "taglibrary/exports/Instances.h"

using namespace Korvane::Veldra::TagLibrary;

namespace {

using Korvane::Veldra::ErrorCodes::kUnexpectedException;

}  // namespace

int32_t TagWBReserve(bool* reserved) {
    try {
        return ReserveProcess(reserved);
    } catch (const std::exception&) {
        return kUnexpectedException;
    }
}

int32_t TagWBUnreserve(bool* reserved) {
    try {
        return UnreserveProcess(reserved, true);
    } catch (const std::exception&) {
        return kUnexpectedException;
    }
}

int32_t TagWBInitialize(uint64_t instanceId, WBStrHandle* configurationId, uint32_t timeoutMs,
                        const bool* allowFallback, bool* created, WBStrHandle* error) {
    HostErrorOut out(error);
    return RunInFrame(out, [&] {
        std::optional<std::string> configuration;
        if (configurationId != nullptr) configuration = ReadHostString(configurationId);
        std::optional<uint32_t> timeout;
        if (timeoutMs != 0) timeout = timeoutMs;
        // The host passes a byte; any non-zero value is true.
        bool fallback = true;
        if (allowFallback != nullptr) {
            fallback = *reinterpret_cast<const unsigned char*>(allowFallback) != 0;
        }
        return InitializeInstance(instanceId, configuration, timeout, fallback, created, out,
                                  DefaultClientFactory());
    });
}

int32_t TagWBCloseInstance(uint64_t instanceId, WBStrHandle* error) {
    HostErrorOut out(error);
    return RunInFrame(out, [&] { return CloseInstance(instanceId, out); });
}

int32_t TagWBImplicitClose(uint32_t tagReference) {
    return ImplicitCloseReference(tagReference);
}
