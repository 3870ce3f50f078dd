// The argument forms of the two initialize functions, ahead of the steps
// that both share.
#include "taglibrary/exports/ErrorOut.h"
#include "taglibrary/exports/wb/HostStrings.h"
#include "taglibrary/exports/Instances.h"

namespace Korvane::Veldra::TagLibrary {

int32_t InitializeConsoleInstance(uint64_t instanceId, const std::string* configurationId,
                                  const uint32_t* timeoutMs, const bool* allowFallback,
                                  std::string* error, const ClientFactory& factory) {
    ConsoleErrorOut out(error);
    return RunInFrame(out, [&] {
        std::optional<std::string> configuration;
        if (configurationId != nullptr) configuration = *configurationId;
        std::optional<uint32_t> timeout;
        if (timeoutMs != nullptr) timeout = *timeoutMs;
        const bool fallback = allowFallback == nullptr || *allowFallback;
        return InitializeInstance(instanceId, configuration, timeout, fallback, nullptr, out,
                                  factory);
    });
}

int32_t InitializeHostInstance(uint64_t instanceId, WBStrHandle* configurationId,
                               uint32_t timeoutMs, const bool* allowFallback, bool* created,
                               WBStrHandle* error, const ClientFactory& factory) {
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
                                  factory);
    });
}

}  // namespace Korvane::Veldra::TagLibrary
