// Host functions that open a tag: the lookup, the evaluation that may start a
// create, and the create's finish. Each waits for nothing.
#include "kvveldra/TagWB.h"
#include "taglibrary/exports/wb/HostCall.h"
#include "taglibrary/exports/wb/HostStrings.h"

using namespace Korvane::Veldra::TagLibrary;

int32_t TagWBLookupTag(uint64_t instanceId, WBStrHandle* path, uint32_t* requestId,
                       uint32_t* timeoutMs, uint32_t* signal, WBStrHandle* error) {
    return RequestOnHostInstance(
        instanceId, requestId, timeoutMs, signal, error,
        [&](Client& client, const HostRequestMaker& makeRequest, uint32_t& id, uint32_t& timeout,
            std::string& text) {
            return client.OpenTag(ReadHostString(path), makeRequest(), id, timeout, text);
        });
}

int32_t TagWBOpenOrCreate(uint64_t instanceId, WBStrHandle* path, int32_t dataType, bool* found,
                          uint32_t* tagReference, uint32_t* requestId, uint32_t* timeoutMs,
                          uint32_t* signal, WBStrHandle* error) {
    if (AnyNull(found, tagReference, requestId, timeoutMs, signal, error)) return 1;
    return RunHost(error, [&](std::string& text) {
        std::shared_ptr<Client> client;
        if (const int32_t status = FindHostClient(instanceId, client, text)) return status;
        // The create's signal goes out only when a create starts.
        uint32_t createSignal = 0;
        const HostRequest create = MakeWBAsyncRequest(createSignal);
        bool exists = false;
        std::shared_ptr<TagData> tag;
        if (const int32_t status =
                client->OpenOrCreateTag(instanceId, ReadHostString(path), ExportedToType(dataType),
                                        create, exists, tag, *requestId, *timeoutMs, text))
            return status;
        *found = exists;
        if (exists) {
            *tagReference = tag->Reference();
            RegisterReference(tag);
        } else {
            *signal = createSignal;
        }
        return 0;
    });
}

int32_t TagWBFinishCreate(uint64_t instanceId, WBStrHandle* path, int32_t dataType,
                          uint32_t requestId, uint32_t* tagReference, WBStrHandle* error) {
    if (AnyNull(tagReference, error)) return 1;
    return FinishOnHostInstance(instanceId, error, [&](Client& client, std::string& text) {
        std::shared_ptr<TagData> tag;
        if (const int32_t status = client.FinishCreateTag(instanceId, ReadHostString(path),
                                                          ExportedToType(dataType), requestId,
                                                          tag, text))
            return status;
        *tagReference = tag->Reference();
        RegisterReference(tag);
        return 0;
    });
}
