#include "messagelibrary/smtp/SmtpGetTemplateListItemsResponse.h"

#include <optional>
#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"

namespace Korvane::Veldra::VeldraMessageLibrary::SmtpMessages {

SmtpGetTemplateListItemsResponse::SmtpGetTemplateListItemsResponse(
    const MessageBus::Interfaces::IRoutingSource& request,
    std::optional<std::vector<SmtpTemplateListItem>> templates)
    : MessageBus::ResponseMessage(kMessageName, MessageBus::kJsonContentType, request.ReplyTo()),
      templates_(std::move(templates)) {
    AnswerTo(request, std::nullopt);
}

SmtpGetTemplateListItemsResponse::SmtpGetTemplateListItemsResponse(
    const MessageBus::Interfaces::IRoutingSource& request, const MessageBus::MessageError& error)
    : MessageBus::ResponseMessage(kMessageName, MessageBus::kJsonContentType, request.ReplyTo()) {
    AnswerTo(request, error);
}

SmtpGetTemplateListItemsResponse::SmtpGetTemplateListItemsResponse(
    MessageBus::MessageHeaders headers, const MessageBus::MessageBody& body)
    : MessageBus::ResponseMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody SmtpGetTemplateListItemsResponse::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::SmtpMessages
