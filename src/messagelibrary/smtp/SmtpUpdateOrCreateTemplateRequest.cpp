#include "messagelibrary/smtp/SmtpUpdateOrCreateTemplateRequest.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/smtp/SmtpService.h"

namespace Korvane::Veldra::VeldraMessageLibrary::SmtpMessages {

SmtpUpdateOrCreateTemplateRequest::SmtpUpdateOrCreateTemplateRequest(
    std::optional<SmtpTemplateEntry> templateEntry)
    : MessageBus::RequestMessage(kMessageName, MessageBus::kJsonContentType, kSmtpService),
      templateEntry_(std::move(templateEntry)) {}

SmtpUpdateOrCreateTemplateRequest::SmtpUpdateOrCreateTemplateRequest(
    MessageBus::MessageHeaders headers, const MessageBus::MessageBody& body)
    : MessageBus::RequestMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody SmtpUpdateOrCreateTemplateRequest::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::SmtpMessages
