// Keywords, properties and the collect-aggregates flag of "TagInfo", the
// aggregates of "TagCurrentValue", and the deletion of tags.
#include "messagebus/service/MessageService.h"
#include "messagelibrary/tagcurrentvalue/TagCvResetAggregatesRoutedMessage.h"
#include "messagelibrary/taginfo/TagInfoCreateOrUpdateTagsRequest.h"
#include "messagelibrary/taginfo/TagInfoDeleteTagsRoutedMessage.h"
#include "messagelibrary/taginfo/TagInfoQueryTagsRequest.h"
#include "messagelibrary/taginfo/TagInfoQueryTagsResponse.h"
#include "taglibrary/Client.h"
#include "taglibrary/requests/AsyncUpdateRequest.h"

namespace Korvane::Veldra::TagLibrary {

namespace TagInfo = VeldraMessageLibrary::TagInfoMessages;
namespace TagCv = VeldraMessageLibrary::TagCurrentValueMessages;
using VeldraMessageLibrary::JsonStringList;
using VeldraMessageLibrary::JsonStringMap;
using VeldraMessageLibrary::TagChange;
using VeldraMessageLibrary::TagChangeFlags;
using VeldraMessageLibrary::TagRecord;

// ---- The gets ----

int32_t Client::SendTagLookup(const char* traceFormat, const std::shared_ptr<TagData>& tag,
                              const std::shared_ptr<AsyncRequest>& request, uint32_t& requestId,
                              uint32_t& timeoutMs, std::string& error) {
    if (!tag) return ReportError("Tag.InvalidTagReference", error);
    std::lock_guard<std::mutex> lock(mutex_);
    Trace(traceFormat, tag->path);
    TagInfo::TagInfoQueryTagsRequest lookup(JsonStringList{tag->path}, std::nullopt, std::nullopt,
                                            0, 0, true);
    return SendTrackedRequest(lookup, request, requestId, timeoutMs, error);
}

int32_t Client::FinishTagLookup(uint32_t requestId, TagRecord& record, std::string& error) {
    std::shared_ptr<AsyncRequest> finished;
    if (const int32_t status = TakeFinishedRequest(requestId, finished, error)) return status;
    const auto& reply = finished->Response();
    const TagInfo::TagInfoQueryTagsResponse response(reply->Headers(), reply->Body());
    // Several records are as wrong as none: the lookup names one exact path.
    if (!response.Tags() || response.Tags()->size() != 1)
        return ReportError("Tag.NoSuchTag", error);
    record = response.Tags()->front();
    return 0;
}

int32_t Client::GetKeywords(const std::shared_ptr<TagData>& tag,
                            const std::shared_ptr<AsyncRequest>& request, uint32_t& requestId,
                            uint32_t& timeoutMs, std::string& error) {
    return SendTagLookup("Getting Keywords for tag: %s\n", tag, request, requestId, timeoutMs,
                         error);
}

int32_t Client::GetProperties(const std::shared_ptr<TagData>& tag,
                              const std::shared_ptr<AsyncRequest>& request, uint32_t& requestId,
                              uint32_t& timeoutMs, std::string& error) {
    return SendTagLookup("Getting Properties for tag: %s\n", tag, request, requestId, timeoutMs,
                         error);
}

int32_t Client::GetCollectAggregates(const std::shared_ptr<TagData>& tag,
                                     const std::shared_ptr<AsyncRequest>& request,
                                     uint32_t& requestId, uint32_t& timeoutMs,
                                     std::string& error) {
    return SendTagLookup("Getting CollectAggregates for tag: %s\n", tag, request, requestId,
                         timeoutMs, error);
}

int32_t Client::FinishGetKeywords(uint32_t requestId, std::vector<std::string>& keywords,
                                  std::string& error) {
    TagRecord record;
    if (const int32_t status = FinishTagLookup(requestId, record, error)) return status;
    if (record.keywords)
        keywords.insert(keywords.end(), record.keywords->begin(), record.keywords->end());
    return 0;
}

int32_t Client::FinishGetProperties(uint32_t requestId,
                                    std::unordered_map<std::string, std::string>& properties,
                                    std::string& error) {
    TagRecord record;
    if (const int32_t status = FinishTagLookup(requestId, record, error)) return status;
    if (record.properties) {
        for (const auto& [key, value] : *record.properties) properties[key] = value;
    }
    return 0;
}

int32_t Client::FinishGetCollectAggregates(uint32_t requestId, bool& collectAggregates,
                                           std::string& error) {
    TagRecord record;
    if (const int32_t status = FinishTagLookup(requestId, record, error)) return status;
    collectAggregates = record.collectAggregates;
    return 0;
}

// ---- The sets ----

int32_t Client::SendTagChange(const char* traceFormat, const std::shared_ptr<TagData>& tag,
                              TagRecord record, TagChangeFlags change, bool merge,
                              const std::shared_ptr<AsyncRequest>& request, uint32_t& requestId,
                              uint32_t& timeoutMs, std::string& error) {
    std::lock_guard<std::mutex> lock(mutex_);
    Trace(traceFormat, tag->path);
    record.path = tag->path;
    record.type = tag->dataType;
    TagInfo::TagInfoCreateOrUpdateTagsRequest update(
        std::vector<TagChange>{TagChange{std::move(record), change}}, merge);
    // The service reports a refused change in the body of a clean reply.
    return SendTrackedRequest(update, std::make_shared<AsyncUpdateRequest>(request), requestId,
                              timeoutMs, error);
}

int32_t Client::SetKeywords(const std::shared_ptr<TagData>& tag,
                            const std::vector<std::string>& keywords, bool merge,
                            const std::shared_ptr<AsyncRequest>& request, uint32_t& requestId,
                            uint32_t& timeoutMs, std::string& error) {
    if (!tag) return ReportError("Tag.InvalidTagReference", error);
    TagRecord record;
    record.keywords = keywords;
    return SendTagChange("Setting Keywords for tag: %s\n", tag, std::move(record),
                         TagChangeFlags::Keywords, merge, request, requestId, timeoutMs, error);
}

int32_t Client::SetProperties(const std::shared_ptr<TagData>& tag,
                              const std::unordered_map<std::string, std::string>& properties,
                              bool merge, const std::shared_ptr<AsyncRequest>& request,
                              uint32_t& requestId, uint32_t& timeoutMs, std::string& error) {
    if (!tag) return ReportError("Tag.InvalidTagReference", error);
    TagRecord record;
    record.properties = JsonStringMap(properties.begin(), properties.end());
    return SendTagChange("Setting Properties for tag: %s\n", tag, std::move(record),
                         TagChangeFlags::Properties, merge, request, requestId, timeoutMs, error);
}

int32_t Client::SetCollectAggregates(const std::shared_ptr<TagData>& tag, bool collectAggregates,
                                     const std::shared_ptr<AsyncRequest>& request,
                                     uint32_t& requestId, uint32_t& timeoutMs,
                                     std::string& error) {
    if (!tag) return ReportError("Tag.InvalidTagReference", error);
    TagRecord record;
    record.collectAggregates = collectAggregates;
    return SendTagChange("Setting Collect Aggregates for tag: %s\n", tag, std::move(record),
                         TagChangeFlags::CollectAggregates, true, request, requestId, timeoutMs,
                         error);
}

// ---- Aggregates and deletion ----

int32_t Client::ResetAggregates(const std::vector<std::shared_ptr<TagData>>& tags,
                                const std::shared_ptr<AsyncRequest>& request,
                                uint32_t& requestId, uint32_t& timeoutMs, std::string& error) {
    TraceLine("Resetting Aggregates");
    TagCv::TagCvResetAggregatesRoutedMessage message(CopyPaths(tags));
    return SendTrackedRouted(message, request, requestId, timeoutMs, error);
}

int32_t Client::DeleteTags(const std::vector<std::shared_ptr<TagData>>& tags,
                           const std::shared_ptr<AsyncRequest>& request, uint32_t& requestId,
                           uint32_t& timeoutMs, std::string& error) {
    TraceLine("Deleting tags");
    TagInfo::TagInfoDeleteTagsRoutedMessage message(CopyPaths(tags));
    return SendTrackedRouted(message, request, requestId, timeoutMs, error);
}

int32_t Client::DeleteAllTags(std::string& error) {
    TraceLine("Deleting all tags");
    if (!messageService_) return ReportError("Tag.InvalidState", error);
    TagInfo::TagInfoDeleteTagsRoutedMessage message(JsonStringList{"***"});
    try {
        const auto reply = messageService_->SendRequestExpectingResponse(
            message, messageService_->DefaultTimeoutMs(), true);
        if (!reply) return ReportError("Veldra.RequestTimedOut", error);
        if (!reply->HasError()) return 0;
        const MessageBus::MessageError replyError = reply->GetError();
        return ReportResponseError(replyError.FullName(), replyError.args, error);
    } catch (const MessageBus::VeldraException& exception) {
        return ReportException(exception, error);
    }
}

}  // namespace Korvane::Veldra::TagLibrary
