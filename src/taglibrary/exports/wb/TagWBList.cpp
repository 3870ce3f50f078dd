// Host functions that list tags. The references a list delivers are open and
// registered, valid for later calls until closed.
#include <algorithm>

#include "kvveldra/TagWB.h"
#include "taglibrary/exports/wb/HostArrays.h"
#include "taglibrary/exports/wb/HostCall.h"

using namespace Korvane::Veldra::TagLibrary;

namespace {

// The tags a list delivered into the host's three arrays. The reference array
// takes 8 bytes a tag and is filled 4 bytes apart, as the host has always
// sized it.
int32_t WriteListedTags(Client& client, const HostTags& tags, WBTypeArrayHandle* dataTypes,
                        WBStrArrayHandle* paths, WBReferenceArrayHandle* tagReferences) {
    if (const int32_t status = SizeHostArray(dataTypes, tags.size())) return status;
    if (const int32_t status = SizeHostArray(paths, tags.size())) return status;
    if (const int32_t status = SizeHostArray(tagReferences, tags.size(), 2 * sizeof(uint32_t)))
        return status;
    RegisterReferencesIfAbsent(tags);
    for (std::size_t i = 0; i < tags.size(); ++i) {
        (**dataTypes)->elt[i] = client.ExportedType(*tags[i]);
        (**tagReferences)->elt[i] = tags[i]->Reference();
        if (const int32_t status = CopyToHostString(&(**paths)->elt[i], tags[i]->path))
            return status;
    }
    return 0;
}

}  // namespace

int32_t TagWBList2(uint64_t instanceId, WBStrArrayHandle searchPaths,
                   WBPropertyArrayHandle properties, WBStrArrayHandle keywords, uint32_t skip,
                   uint32_t take, uint32_t* requestId, uint32_t* timeoutMs, uint32_t* signal,
                   WBStrHandle* error) {
    return RequestOnHostInstance(
        instanceId, requestId, timeoutMs, signal, error,
        [&](Client& client, const HostRequestMaker& makeRequest, uint32_t& id, uint32_t& timeout,
            std::string& text) {
            std::vector<std::string> paths = ReadHostStrings(searchPaths);
            if (paths.empty()) paths.push_back("*");
            // The host always takes what the service has, stale or not.
            return client.ListTags(paths, ReadHostProperties(properties),
                                   ReadHostStrings(keywords), skip, take, true, makeRequest(), id,
                                   timeout, text);
        });
}

int32_t TagWBList(uint64_t instanceId, WBStrArrayHandle searchPaths,
                  WBPropertyArrayHandle properties, WBStrArrayHandle keywords, uint32_t* requestId,
                  uint32_t* timeoutMs, uint32_t* signal, WBStrHandle* error) {
    return TagWBList2(instanceId, searchPaths, properties, keywords, 0, 1000, requestId, timeoutMs,
                      signal, error);
}

int32_t TagWBFinishList2(uint64_t instanceId, uint32_t requestId, WBTypeArrayHandle* dataTypes,
                         WBStrArrayHandle* paths, WBReferenceArrayHandle* tagReferences,
                         uint32_t* total, WBStrHandle* error) {
    if (AnyNull(dataTypes, paths, tagReferences, total, error)) return 1;
    return FinishOnHostInstance(instanceId, error, [&](Client& client, std::string& text) {
        HostTags tags;
        int32_t totalCount = 0;
        if (const int32_t status = client.FinishListTags(instanceId, requestId, tags, totalCount,
                                                         text))
            return status;
        const int32_t status = WriteListedTags(client, tags, dataTypes, paths, tagReferences);
        if (status != 0) {
            // The host never got these references: give back the sessions
            // the list opened.
            for (const auto& tag : tags) {
                bool last = false;
                std::string ignored;
                if (client.CloseTag(tag, last, ignored) == 0 && last) EraseReference(tag->Reference());
            }
            return status;
        }
        *total = static_cast<uint32_t>(std::max(totalCount, 0));
        return 0;
    });
}

int32_t TagWBFinishList(uint64_t instanceId, uint32_t requestId, WBTypeArrayHandle* dataTypes,
                        WBStrArrayHandle* paths, WBReferenceArrayHandle* tagReferences,
                        WBStrHandle* error) {
    uint32_t total = 0;
    return TagWBFinishList2(instanceId, requestId, dataTypes, paths, tagReferences, &total, error);
}
