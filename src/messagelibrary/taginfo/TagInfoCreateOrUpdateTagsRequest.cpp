#include "messagelibrary/taginfo/TagInfoCreateOrUpdateTagsRequest.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/TagServices.h"
#include "messagelibrary/json/JsonReaders.h"
#include "messagelibrary/json/JsonWriters.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagInfoMessages {

TagInfoCreateOrUpdateTagsRequest::TagInfoCreateOrUpdateTagsRequest(
    std::optional<std::vector<TagChange>> tags, bool merge)
    : MessageBus::RequestMessage(kMessageName, MessageBus::kJsonContentType, kTagInfoService),
      tags_(std::move(tags)),
      merge_(merge) {}

TagInfoCreateOrUpdateTagsRequest::TagInfoCreateOrUpdateTagsRequest(
    MessageBus::MessageHeaders headers, const MessageBus::MessageBody& body)
    : MessageBus::RequestMessage(std::move(headers)) {
    const JsonVariant json = ParseJsonBody(body.ToString(), MessageType());
    JsonBodyReader(json).Field("tags", tags_).Field("merge", merge_);
}

MessageBus::MessageBody TagInfoCreateOrUpdateTagsRequest::Serialize() const {
    return MessageBus::MessageBody(
        JsonBodyWriter().Field("tags", tags_).Field("merge", merge_).Finish());
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagInfoMessages
