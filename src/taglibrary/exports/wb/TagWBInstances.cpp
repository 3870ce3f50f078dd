// Reservation and instance functions of the host family.
#include "errors/ErrorCodes.h"
#include "kvveldra/TagWB.h"
#include "taglibrary/exports/ErrorOut.h"
#include "taglibrary/exports/wb/HostStrings.h"
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
    return InitializeHostInstance(instanceId, configurationId, timeoutMs, allowFallback, created,
                                  error, DefaultClientFactory());
}

int32_t TagWBCloseInstance(uint64_t instanceId, WBStrHandle* error) {
    HostErrorOut out(error);
    return RunInFrame(out, [&] { return CloseInstance(instanceId, out); });
}

int32_t TagWBImplicitClose(uint32_t tagReference) {
    return ImplicitCloseReference(tagReference);
}
