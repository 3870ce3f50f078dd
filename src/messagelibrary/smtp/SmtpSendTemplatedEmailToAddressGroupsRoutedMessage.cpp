#include "messagelibrary/smtp/SmtpSendTemplatedEmailToAddressGroupsRoutedMessage.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/smtp/SmtpService.h"

namespace Korvane::Veldra::VeldraMessageLibrary::SmtpMessages {

SmtpSendTemplatedEmailToAddressGroupsRoutedMessage::
    SmtpSendTemplatedEmailToAddressGroupsRoutedMessage(std::optional<std::string> templateId,
                                                       std::optional<std::string> addressGroupId,
                                                       std::optional<JsonStringMap> fields)
    : MessageBus::RoutedMessage(kMessageName, MessageBus::kJsonContentType, kSmtpService),
      templateId_(std::move(templateId)),
      addressGroupId_(std::move(addressGroupId)),
      fields_(std::move(fields)) {}

SmtpSendTemplatedEmailToAddressGroupsRoutedMessage::
    SmtpSendTemplatedEmailToAddressGroupsRoutedMessage(MessageBus::MessageHeaders headers,
                                                       const MessageBus::MessageBody& body)
    : MessageBus::RoutedMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody SmtpSendTemplatedEmailToAddressGroupsRoutedMessage::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::SmtpMessages
