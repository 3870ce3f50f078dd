#include "messagelibrary/taginfo/TagInfoCreateOrUpdateTagsResponse.h"

#include <optional>
#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/json/JsonReaders.h"
#include "messagelibrary/json/JsonWriters.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagInfoMessages {

TagInfoCreateOrUpdateTagsResponse::TagInfoCreateOrUpdateTagsResponse(
    const MessageBus::Interfaces::IRoutingSource& request, std::optional<ErrorRecord> errors)
    : MessageBus::ResponseMessage(kMessageName, MessageBus::kJsonContentType, request.ReplyTo()),
      errors_(std::move(errors)) {
    AnswerTo(request, std::nullopt);
}

TagInfoCreateOrUpdateTagsResponse::TagInfoCreateOrUpdateTagsResponse(
    const MessageBus::Interfaces::IRoutingSource& request, const MessageBus::MessageError& error)
    : MessageBus::ResponseMessage(kMessageName, MessageBus::kJsonContentType, request.ReplyTo()) {
    AnswerTo(request, error);
}

TagInfoCreateOrUpdateTagsResponse::TagInfoCreateOrUpdateTagsResponse(
    MessageBus::MessageHeaders headers, const MessageBus::MessageBody& body)
    : MessageBus::ResponseMessage(std::move(headers)) {
    const JsonVariant json = ParseJsonBody(body.ToString(), MessageType());
    JsonBodyReader(json).Field("errors", errors_);
}

MessageBus::MessageBody TagInfoCreateOrUpdateTagsResponse::Serialize() const {
    return MessageBus::MessageBody(JsonBodyWriter().Field("errors", errors_).Finish());
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagInfoMessages
