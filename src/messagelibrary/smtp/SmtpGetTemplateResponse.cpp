#include "messagelibrary/smtp/SmtpGetTemplateResponse.h"

#include <optional>
#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"

namespace Korvane::Veldra::VeldraMessageLibrary::SmtpMessages {

SmtpGetTemplateResponse::SmtpGetTemplateResponse(
    const MessageBus::Interfaces::IRoutingSource& request,
    std::optional<SmtpTemplateEntry> templateEntry)
    : MessageBus::ResponseMessage(kMessageName, MessageBus::kJsonContentType, request.ReplyTo()),
      templateEntry_(std::move(templateEntry)) {
    AnswerTo(request, std::nullopt);
}

SmtpGetTemplateResponse::SmtpGetTemplateResponse(
    const MessageBus::Interfaces::IRoutingSource& request, const MessageBus::MessageError& error)
    : MessageBus::ResponseMessage(kMessageName, MessageBus::kJsonContentType, request.ReplyTo()) {
    AnswerTo(request, error);
}

SmtpGetTemplateResponse::SmtpGetTemplateResponse(MessageBus::MessageHeaders headers,
                                                 const MessageBus::MessageBody& body)
    : MessageBus::ResponseMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody SmtpGetTemplateResponse::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::SmtpMessages
