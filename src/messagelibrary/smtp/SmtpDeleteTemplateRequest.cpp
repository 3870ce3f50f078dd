#include "messagelibrary/smtp/SmtpDeleteTemplateRequest.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/smtp/SmtpService.h"

namespace Korvane::Veldra::VeldraMessageLibrary::SmtpMessages {

SmtpDeleteTemplateRequest::SmtpDeleteTemplateRequest(std::optional<std::string> id)
    : MessageBus::RequestMessage(kMessageName, MessageBus::kJsonContentType, kSmtpService),
      id_(std::move(id)) {}

SmtpDeleteTemplateRequest::SmtpDeleteTemplateRequest(MessageBus::MessageHeaders headers,
                                                     const MessageBus::MessageBody& body)
    : MessageBus::RequestMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody SmtpDeleteTemplateRequest::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::SmtpMessages
