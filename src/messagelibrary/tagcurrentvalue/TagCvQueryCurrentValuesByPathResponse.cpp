#include "messagelibrary/tagcurrentvalue/TagCvQueryCurrentValuesByPathResponse.h"

#include <optional>
#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagCurrentValueMessages {

TagCvQueryCurrentValuesByPathResponse::TagCvQueryCurrentValuesByPathResponse(
    const MessageBus::Interfaces::IRoutingSource& request,
    std::optional<std::vector<TagCurrentValue>> values)
    : MessageBus::ResponseMessage(kMessageName, MessageBus::kJsonContentType, request.ReplyTo()),
      values_(std::move(values)) {
    AnswerTo(request, std::nullopt);
}

TagCvQueryCurrentValuesByPathResponse::TagCvQueryCurrentValuesByPathResponse(
    const MessageBus::Interfaces::IRoutingSource& request, const MessageBus::MessageError& error)
    : MessageBus::ResponseMessage(kMessageName, MessageBus::kJsonContentType, request.ReplyTo()) {
    AnswerTo(request, error);
}

TagCvQueryCurrentValuesByPathResponse::TagCvQueryCurrentValuesByPathResponse(
    MessageBus::MessageHeaders headers, const MessageBus::MessageBody& body)
    : MessageBus::ResponseMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody TagCvQueryCurrentValuesByPathResponse::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagCurrentValueMessages
