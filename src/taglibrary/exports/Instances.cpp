#include "taglibrary/exports/Instances.h"

#include "messagebus/amqp/AmqpConnectionManager.h"
#include "messagebus/config/BusConfigurations.h"
#include "taglibrary/exports/ErrorOut.h"

namespace Korvane::Veldra::TagLibrary {

ClientFactory DefaultClientFactory() {
    return [](const std::string& configurationId, uint32_t timeoutMs, bool allowFallback,
              std::shared_ptr<TagIngestion::Errors> errors) {
        return std::make_shared<Client>(configurationId, timeoutMs, allowFallback, false,
                                        std::move(errors));
    };
}

ClientFactory LocalClientFactory() {
    return [](const std::string& configurationId, uint32_t timeoutMs, bool allowFallback,
              std::shared_ptr<TagIngestion::Errors> errors) {
        return std::make_shared<Client>(Client::LocalOnly{}, configurationId, timeoutMs,
                                        allowFallback, false, std::move(errors));
    };
}

int32_t ReserveProcess(bool* reserved) {
    if (reserved == nullptr) return 1;
    if (*reserved) return 0;
    *reserved = true;
    auto& state = ProcessState::Get();
    if (state.ReserveCount.fetch_add(1) + 1 != 1) return 0;
    if (!state.SharedErrors()) {
        auto errors = std::make_shared<TagIngestion::Errors>();
        errors->initialize();
        state.SetSharedErrors(std::move(errors));
    }
    return 0;
}

int32_t UnreserveProcess(bool* reserved, bool discardConfigurations) {
    if (reserved == nullptr) return 1;
    if (!*reserved) return 0;
    *reserved = false;
    auto& state = ProcessState::Get();
    if (state.ReserveCount.fetch_sub(1) - 1 > 0) return 0;

    // Clients and records die after the table mutex is let go.
    std::map<uint64_t, std::shared_ptr<Client>> clients;
    std::map<uint32_t, std::shared_ptr<TagData>> references;
    {
        std::lock_guard<std::mutex> lock(state.TableMutex);
        clients.swap(state.ClientTable);
        references.swap(state.TagReferenceTable);
        state.SetSharedErrors(nullptr);
    }
    clients.clear();
    references.clear();
    MessageBus::AmqpConnectionManager::ReleaseInstance();
    if (discardConfigurations) MessageBus::BusConfigurations::Discard();
    return 0;
}

int32_t ImplicitCloseReference(uint32_t tagReference) {
    if (tagReference == 0) return 0;
    try {
        auto& state = ProcessState::Get();
        std::shared_ptr<TagData> tag;
        std::shared_ptr<Client> client;
        {
            std::lock_guard<std::mutex> lock(state.TableMutex);
            const auto found = state.TagReferenceTable.find(tagReference);
            if (found == state.TagReferenceTable.end()) return 0;
            tag = found->second;
            const uint64_t instanceId = tag ? tag->instanceId : 0;
            if (instanceId != 0) {
                // The host owns a non-default instance through its references:
                // dropping one drops the whole instance.
                const auto instance = state.ClientTable.find(instanceId);
                if (instance != state.ClientTable.end()) {
                    client = std::move(instance->second);
                    state.ClientTable.erase(instance);
                }
                state.TagReferenceTable.erase(found);
                return 0;
            }
            const auto instance = state.ClientTable.find(0);
            if (instance == state.ClientTable.end() || !instance->second) {
                state.TagReferenceTable.erase(found);
                return 0;
            }
            client = instance->second;
        }
        ConsoleErrorOut discarded(nullptr);
        CloseTagReference(tagReference, client, tag, discarded);
    } catch (const std::exception&) {
        // The host's clean-up has nobody to report to.
    }
    return 0;
}

}  // namespace Korvane::Veldra::TagLibrary
