#pragma once

#include <cstdint>
#include <functional>
#include <memory>
#include <optional>
#include <string>

#include "errors/VeldraException.h"
#include "kvveldra/WBTypes.h"
#include "taglibrary/Client.h"
#include "taglibrary/exports/Frame.h"

namespace Korvane::Veldra::TagLibrary {

// The reservation that brings the process-wide state up and takes it down.
// Both return 0, or 1 for a null flag; an exception goes to the caller.
int32_t ReserveProcess(bool* reserved);
// `discardConfigurations`: the host family also drops the parsed broker
// configurations at the last unreserve; the console family keeps them.
int32_t UnreserveProcess(bool* reserved, bool discardConfigurations);

// Settings of the default instance, and of an instance that names none.
constexpr uint32_t kDefaultConnectTimeoutMs = 180000;
inline const char* const kDefaultConfigurationId = "veldra_master";

// Makes the Client of a new instance; replaced in tests.
using ClientFactory = std::function<std::shared_ptr<Client>(
    const std::string& configurationId, uint32_t timeoutMs, bool allowFallback,
    std::shared_ptr<TagIngestion::Errors> errors)>;
ClientFactory DefaultClientFactory();
// Clients of the local half alone, for tests of the frame without a broker.
ClientFactory LocalClientFactory();

// The steps of initialize common to both families, under the table mutex
// for the whole call. `created` may be null.
template <typename ErrorOut>
int32_t InitializeInstance(uint64_t instanceId, const std::optional<std::string>& configurationId,
                           std::optional<uint32_t> timeoutMs, bool allowFallback, bool* created,
                           ErrorOut& out, const ClientFactory& factory) {
    auto& state = ProcessState::Get();
    std::unique_lock<std::mutex> lock(state.TableMutex);
    auto entry = state.ClientTable.find(instanceId);
    if (entry != state.ClientTable.end() && entry->second) return 0;
    if (entry == state.ClientTable.end())
        entry = state.ClientTable.emplace(instanceId, nullptr).first;

    std::string configuration = kDefaultConfigurationId;
    if (instanceId != 0 && configurationId && !configurationId->empty()) {
        configuration = *configurationId;
    } else {
        allowFallback = true;
    }
    const uint32_t timeout =
        (instanceId == 0 || !timeoutMs) ? kDefaultConnectTimeoutMs : *timeoutMs;

    try {
        entry->second = factory(configuration, timeout, allowFallback, state.SharedErrors());
    } catch (const MessageBus::VeldraException& exception) {
        state.ClientTable.erase(instanceId);
        lock.unlock();
        std::string text;
        if (const auto errors = state.SharedErrors())
            text = errors->messageForCode(exception.Code());
        return out.Report(exception.Code(), text);
    } catch (const std::exception& exception) {
        lock.unlock();  // the entry keeps its null Client; a later initialize tries again
        return ReportUnexpected(exception, out);
    }
    if (created != nullptr) *created = true;
    return 0;
}

// The two initialize functions, with their arguments in each family's form.
int32_t InitializeConsoleInstance(uint64_t instanceId, const std::string* configurationId,
                                  const uint32_t* timeoutMs, const bool* allowFallback,
                                  std::string* error, const ClientFactory& factory);
int32_t InitializeHostInstance(uint64_t instanceId, WBStrHandle* configurationId,
                               uint32_t timeoutMs, const bool* allowFallback, bool* created,
                               WBStrHandle* error, const ClientFactory& factory);

// Removes a non-default instance from the table. Instance 0 gives 1.
template <typename ErrorOut>
int32_t CloseInstance(uint64_t instanceId, ErrorOut& out) {
    if (instanceId == 0) return 1;
    std::shared_ptr<Client> released;  // the Client may die here, outside the lock
    {
        auto& state = ProcessState::Get();
        std::lock_guard<std::mutex> lock(state.TableMutex);
        const auto found = state.ClientTable.find(instanceId);
        if (found != state.ClientTable.end()) {
            released = std::move(found->second);
            state.ClientTable.erase(found);
            return 0;
        }
    }
    return ReportNamedError("Tag.InvalidTagReference", out);
}

// The host's clean-up of a reference its program left open. Never fails.
int32_t ImplicitCloseReference(uint32_t tagReference);

}  // namespace Korvane::Veldra::TagLibrary
