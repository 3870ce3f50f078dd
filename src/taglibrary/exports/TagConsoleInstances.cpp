// Reservation and instance functions of the console family.
#include "kvveldra/TagConsole.h"
#include "taglibrary/exports/ErrorOut.h"
#include "taglibrary/exports/Instances.h"

using namespace Korvane::Veldra::TagLibrary;

namespace {

int32_t UnexpectedExceptionCode() {
    std::string unused;
    return FormatNamedError("Veldra.UnexpectedException", {""}, unused);
}

}  // namespace

int32_t TagConsoleReserve(bool* reserved) {
    try {
        return ReserveProcess(reserved);
    } catch (const std::exception&) {
        return UnexpectedExceptionCode();
    }
}

int32_t TagConsoleUnreserve(bool* reserved) {
    try {
        return UnreserveProcess(reserved, false);
    } catch (const std::exception&) {
        return UnexpectedExceptionCode();
    }
}

int32_t TagConsoleInitialize(uint64_t instanceId, const std::string* configurationId,
                             const uint32_t* timeoutMs, const bool* allowFallback,
                             std::string* error) {
    return InitializeConsoleInstance(instanceId, configurationId, timeoutMs, allowFallback, error,
                                     DefaultClientFactory());
}

int32_t TagConsoleCloseInstance(uint64_t instanceId, std::string* error) {
    ConsoleErrorOut out(error);
    return RunInFrame(out, [&] { return CloseInstance(instanceId, out); });
}
