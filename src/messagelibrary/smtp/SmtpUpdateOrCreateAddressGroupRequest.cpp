#include "messagelibrary/smtp/SmtpUpdateOrCreateAddressGroupRequest.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/smtp/SmtpService.h"

namespace Korvane::Veldra::VeldraMessageLibrary::SmtpMessages {

SmtpUpdateOrCreateAddressGroupRequest::SmtpUpdateOrCreateAddressGroupRequest(
    std::optional<SmtpAddressGroup> addressGroup)
    : MessageBus::RequestMessage(kMessageName, MessageBus::kJsonContentType, kSmtpService),
      addressGroup_(std::move(addressGroup)) {}

SmtpUpdateOrCreateAddressGroupRequest::SmtpUpdateOrCreateAddressGroupRequest(
    MessageBus::MessageHeaders headers, const MessageBus::MessageBody& body)
    : MessageBus::RequestMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody SmtpUpdateOrCreateAddressGroupRequest::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::SmtpMessages
