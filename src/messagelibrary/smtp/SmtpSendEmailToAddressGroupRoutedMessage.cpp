#include "messagelibrary/smtp/SmtpSendEmailToAddressGroupRoutedMessage.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/smtp/SmtpService.h"

namespace Korvane::Veldra::VeldraMessageLibrary::SmtpMessages {

SmtpSendEmailToAddressGroupRoutedMessage::SmtpSendEmailToAddressGroupRoutedMessage(
    std::optional<SmtpTemplateEntry> templateEntry, std::optional<SmtpAddressGroup> addressGroup,
    std::optional<JsonStringMap> fields)
    : MessageBus::RoutedMessage(kMessageName, MessageBus::kJsonContentType, kSmtpService),
      templateEntry_(std::move(templateEntry)),
      addressGroup_(std::move(addressGroup)),
      fields_(std::move(fields)) {}

SmtpSendEmailToAddressGroupRoutedMessage::SmtpSendEmailToAddressGroupRoutedMessage(
    MessageBus::MessageHeaders headers, const MessageBus::MessageBody& body)
    : MessageBus::RoutedMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody SmtpSendEmailToAddressGroupRoutedMessage::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::SmtpMessages
