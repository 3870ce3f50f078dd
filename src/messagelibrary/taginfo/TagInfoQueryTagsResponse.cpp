#include "messagelibrary/taginfo/TagInfoQueryTagsResponse.h"

#include <optional>
#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagInfoMessages {

TagInfoQueryTagsResponse::TagInfoQueryTagsResponse(
    const MessageBus::Interfaces::IRoutingSource& request,
    std::optional<std::vector<TagRecord>> tags, int32_t totalCount)
    : MessageBus::ResponseMessage(kMessageName, MessageBus::kJsonContentType, request.ReplyTo()),
      tags_(std::move(tags)),
      totalCount_(totalCount) {
    AnswerTo(request, std::nullopt);
}

TagInfoQueryTagsResponse::TagInfoQueryTagsResponse(
    const MessageBus::Interfaces::IRoutingSource& request, const MessageBus::MessageError& error)
    : MessageBus::ResponseMessage(kMessageName, MessageBus::kJsonContentType, request.ReplyTo()) {
    AnswerTo(request, error);
}

TagInfoQueryTagsResponse::TagInfoQueryTagsResponse(MessageBus::MessageHeaders headers,
                                                   const MessageBus::MessageBody& body)
    : MessageBus::ResponseMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody TagInfoQueryTagsResponse::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagInfoMessages
