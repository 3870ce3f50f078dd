// Reading current values from "TagCurrentValue" and listing tags of "TagInfo".
#include <algorithm>
#include <limits>

#include "messagelibrary/tagcurrentvalue/TagCvQueryCurrentValuesByPathRequest.h"
#include "messagelibrary/tagcurrentvalue/TagCvQueryCurrentValuesByPathResponse.h"
#include "messagelibrary/taginfo/TagInfoQueryTagsRequest.h"
#include "messagelibrary/taginfo/TagInfoQueryTagsResponse.h"
#include "taglibrary/Client.h"
#include "taglibrary/TagTypes.h"

namespace Korvane::Veldra::TagLibrary {

namespace TagInfo = VeldraMessageLibrary::TagInfoMessages;
namespace TagCv = VeldraMessageLibrary::TagCurrentValueMessages;

namespace {

// The message counts in signed 32 bits; a larger count means "all of them".
int32_t ClampToInt32(uint32_t value) {
    return static_cast<int32_t>(std::min<uint32_t>(value, std::numeric_limits<int32_t>::max()));
}

}  // namespace

int32_t Client::ListTags(const std::vector<std::string>& searchPaths,
                         const std::unordered_map<std::string, std::string>& properties,
                         const std::vector<std::string>& keywords, uint32_t skip, uint32_t take,
                         bool allowStale, const std::shared_ptr<AsyncRequest>& request,
                         uint32_t& requestId, uint32_t& timeoutMs, std::string& error) {
    TraceLine("Generating Tag List");
    // Every field goes out, empty ones too: the meaning of the filters and
    // of paging is the service's.
    TagInfo::TagInfoQueryTagsRequest query(
        searchPaths, VeldraMessageLibrary::JsonStringMap(properties.begin(), properties.end()),
        keywords, ClampToInt32(skip), ClampToInt32(take), allowStale);
    return SendTrackedRequest(query, request, requestId, timeoutMs, error);
}

int32_t Client::FinishListTags(uint64_t instanceId, uint32_t requestId,
                               std::vector<std::shared_ptr<TagData>>& tags, int32_t& totalCount,
                               std::string& error) {
    std::shared_ptr<AsyncRequest> finished;
    if (const int32_t status = TakeFinishedRequest(requestId, finished, error)) return status;
    const auto& reply = finished->Response();
    const TagInfo::TagInfoQueryTagsResponse response(reply->Headers(), reply->Body());
    totalCount = response.TotalCount();
    if (!response.Tags()) return 0;
    const auto& records = *response.Tags();
    tags.reserve(tags.size() + records.size());
    // A list opens what it returns: one more session per record.
    std::lock_guard<std::mutex> lock(mutex_);
    for (const auto& record : records) {
        tags.push_back(
            MapTagLocked(instanceId, record.path.value_or(""), MessageValueToType(record.type)));
    }
    return 0;
}

int32_t Client::ReadValues(const std::vector<std::shared_ptr<TagData>>& tags, bool allowStale,
                           const std::shared_ptr<AsyncRequest>& request, uint32_t& requestId,
                           uint32_t& timeoutMs, std::string& error) {
    TraceLine("Reading Tag values");
    TagCv::TagCvQueryCurrentValuesByPathRequest query(CopyPaths(tags), allowStale);
    return SendTrackedRequest(query, request, requestId, timeoutMs, error);
}

int32_t Client::FinishReadValues(uint32_t requestId,
                                 std::vector<VeldraMessageLibrary::TagCurrentValue>& values,
                                 std::string& error) {
    std::shared_ptr<AsyncRequest> finished;
    if (const int32_t status = TakeFinishedRequest(requestId, finished, error)) return status;
    const auto& reply = finished->Response();
    const TagCv::TagCvQueryCurrentValuesByPathResponse response(reply->Headers(), reply->Body());
    values = response.Values().value_or(std::vector<VeldraMessageLibrary::TagCurrentValue>{});
    return 0;
}

}  // namespace Korvane::Veldra::TagLibrary
