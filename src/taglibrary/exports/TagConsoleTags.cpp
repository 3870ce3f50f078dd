// Console functions that open tags: the open of one path and the list.
#include <algorithm>

#include "kvveldra/TagConsole.h"
#include "taglibrary/exports/ConsoleCall.h"

using namespace Korvane::Veldra::TagLibrary;

int32_t TagConsoleOpen(uint64_t instanceId, const std::string* path, int32_t dataType,
                       bool verbose, uint32_t* tagReference, std::string* error) {
    return RunOnConsoleInstance(instanceId, verbose, error, [&](Client& client, std::string& text) {
        if (path == nullptr || tagReference == nullptr) return 1;
        const auto lookup = std::make_shared<ConsoleAsyncRequest>();
        uint32_t requestId = 0;
        uint32_t timeoutMs = 0;
        if (const int32_t status = client.OpenTag(*path, lookup, requestId, timeoutMs, text))
            return status;
        lookup->Wait(timeoutMs);

        const auto type = ExportedToType(dataType);
        const auto create = std::make_shared<ConsoleAsyncRequest>();
        bool found = false;
        std::shared_ptr<TagData> tag;
        if (const int32_t status = client.OpenOrCreateTag(instanceId, *path, type, create, found,
                                                          tag, requestId, timeoutMs, text))
            return status;
        if (!found) {
            create->Wait(timeoutMs);
            if (const int32_t status =
                    client.FinishCreateTag(instanceId, *path, type, requestId, tag, text))
                return status;
        }
        *tagReference = tag->Reference();
        RegisterReference(tag);
        return 0;
    });
}

int32_t TagConsoleListTag(uint64_t instanceId, const std::vector<std::string>* searchPaths,
                          const TagConsoleProperties* properties,
                          const std::vector<std::string>* keywords, uint32_t skip, uint32_t take,
                          bool allowStale, bool verbose, std::vector<int32_t>* dataTypes,
                          std::vector<std::string>* paths, std::vector<uint32_t>* tagReferences,
                          uint32_t* total, std::string* error) {
    return RunOnConsoleInstance(instanceId, verbose, error, [&](Client& client, std::string& text) {
        if (searchPaths == nullptr || properties == nullptr || keywords == nullptr ||
            dataTypes == nullptr || paths == nullptr || tagReferences == nullptr ||
            total == nullptr)
            return 1;
        std::vector<std::shared_ptr<TagData>> tags;
        int32_t totalCount = 0;
        const int32_t status = RunBlocking(
            [&](const std::shared_ptr<ConsoleAsyncRequest>& request, uint32_t& requestId,
                uint32_t& timeoutMs, std::string& out) {
                return client.ListTags(*searchPaths, *properties, *keywords, skip, take,
                                       allowStale, request, requestId, timeoutMs, out);
            },
            [&](uint32_t requestId, std::string& out) {
                return client.FinishListTags(instanceId, requestId, tags, totalCount, out);
            },
            text);
        if (status != 0) return status;

        RegisterReferencesIfAbsent(tags);
        dataTypes->clear();
        paths->clear();
        tagReferences->clear();
        dataTypes->reserve(tags.size());
        paths->reserve(tags.size());
        tagReferences->reserve(tags.size());
        for (const auto& tag : tags) {
            dataTypes->push_back(client.ExportedType(*tag));
            paths->push_back(tag->path);
            tagReferences->push_back(tag->Reference());
        }
        *total = static_cast<uint32_t>(std::max(totalCount, 0));
        return 0;
    });
}
