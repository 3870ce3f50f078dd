#include "messagelibrary/smtp/SmtpUpdateOrCreateTemplateResponse.h"

#include <optional>
#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"

namespace Korvane::Veldra::VeldraMessageLibrary::SmtpMessages {

SmtpUpdateOrCreateTemplateResponse::SmtpUpdateOrCreateTemplateResponse(
    const MessageBus::Interfaces::IRoutingSource& request, std::optional<std::string> id)
    : MessageBus::ResponseMessage(kMessageName, MessageBus::kJsonContentType, request.ReplyTo()),
      id_(std::move(id)) {
    AnswerTo(request, std::nullopt);
}

SmtpUpdateOrCreateTemplateResponse::SmtpUpdateOrCreateTemplateResponse(
    const MessageBus::Interfaces::IRoutingSource& request, const MessageBus::MessageError& error)
    : MessageBus::ResponseMessage(kMessageName, MessageBus::kJsonContentType, request.ReplyTo()) {
    AnswerTo(request, error);
}

SmtpUpdateOrCreateTemplateResponse::SmtpUpdateOrCreateTemplateResponse(
    MessageBus::MessageHeaders headers, const MessageBus::MessageBody& body)
    : MessageBus::ResponseMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody SmtpUpdateOrCreateTemplateResponse::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::SmtpMessages
