#include "messagelibrary/smtp/SmtpGetAddressGroupRequest.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/smtp/SmtpService.h"

namespace Korvane::Veldra::VeldraMessageLibrary::SmtpMessages {

SmtpGetAddressGroupRequest::SmtpGetAddressGroupRequest(std::optional<std::string> id)
    : MessageBus::RequestMessage(kMessageName, MessageBus::kJsonContentType, kSmtpService),
      id_(std::move(id)) {}

SmtpGetAddressGroupRequest::SmtpGetAddressGroupRequest(MessageBus::MessageHeaders headers,
                                                       const MessageBus::MessageBody& body)
    : MessageBus::RequestMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody SmtpGetAddressGroupRequest::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::SmtpMessages
