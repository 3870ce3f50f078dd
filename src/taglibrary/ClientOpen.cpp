// The open of a tag: a lookup, and a create when the lookup found none.
#include <cstdio>

#include "messagelibrary/taginfo/TagInfoCreateTagRoutedMessage.h"
#include "messagelibrary/taginfo/TagInfoQueryTagsRequest.h"
#include "messagelibrary/taginfo/TagInfoQueryTagsResponse.h"
#include "taglibrary/Client.h"
#include "taglibrary/TagTypes.h"
#include "taglibrary/ValueText.h"

namespace Korvane::Veldra::TagLibrary {

namespace TagInfo = VeldraMessageLibrary::TagInfoMessages;

int32_t Client::OpenTag(const std::string& path, const std::shared_ptr<AsyncRequest>& request,
                        uint32_t& requestId, uint32_t& timeoutMs, std::string& error) {
    Trace("Opening tag path: %s\n", path);
    if (!IsValidTagPath(path)) return ReportError("Tag.InvalidTagPath", error);
    TagInfo::TagInfoQueryTagsRequest lookup(VeldraMessageLibrary::JsonStringList{path},
                                            std::nullopt, std::nullopt, 0, 0, true);
    return SendTrackedRequest(lookup, request, requestId, timeoutMs, error);
}

int32_t Client::OpenOrCreateTag(uint64_t instanceId, const std::string& path,
                                std::optional<TagDataType> dataType,
                                const std::shared_ptr<AsyncRequest>& request, bool& found,
                                std::shared_ptr<TagData>& tag, uint32_t& requestId,
                                uint32_t& timeoutMs, std::string& error) {
    std::shared_ptr<AsyncRequest> lookup;
    const int32_t status = TakeFinishedRequest(requestId, lookup, error);
    if (status != 0) return status;

    const auto& reply = lookup->Response();
    const TagInfo::TagInfoQueryTagsResponse response(reply->Headers(), reply->Body());
    const auto& records = response.Tags();
    if (records && records->size() == 1) {
        found = true;
        const std::optional<TagDataType> serverType = MessageValueToType(records->front().type);
        if (serverType == dataType) {
            tag = MapTag(instanceId, path, dataType);
            return 0;
        }
        return ReportError("Tag.ConflictingTagTypes", error,
                           {path, TypeShortName(dataType), TypeShortName(serverType)});
    }

    // No record, or several: the path is created.
    found = false;
    VeldraMessageLibrary::TagRecord newTag;
    newTag.path = path;
    newTag.type = dataType;
    newTag.collectAggregates = false;
    TagInfo::TagInfoCreateTagRoutedMessage create(newTag);
    return SendTrackedRouted(create, request, requestId, timeoutMs, error);
}

int32_t Client::FinishCreateTag(uint64_t instanceId, const std::string& path,
                                std::optional<TagDataType> dataType, uint32_t requestId,
                                std::shared_ptr<TagData>& tag, std::string& error) {
    std::shared_ptr<AsyncRequest> create;
    const int32_t status = TakeFinishedRequest(requestId, create, error);
    if (status != 0) return status;
    tag = MapTag(instanceId, path, dataType);
    return 0;
}

}  // namespace Korvane::Veldra::TagLibrary
