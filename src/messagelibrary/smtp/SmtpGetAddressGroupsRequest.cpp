#include "messagelibrary/smtp/SmtpGetAddressGroupsRequest.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/smtp/SmtpService.h"

namespace Korvane::Veldra::VeldraMessageLibrary::SmtpMessages {

SmtpGetAddressGroupsRequest::SmtpGetAddressGroupsRequest()
    : MessageBus::RequestMessage(kMessageName, MessageBus::kJsonContentType, kSmtpService) {}

SmtpGetAddressGroupsRequest::SmtpGetAddressGroupsRequest(MessageBus::MessageHeaders headers,
                                                         const MessageBus::MessageBody& body)
    : MessageBus::RequestMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody SmtpGetAddressGroupsRequest::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::SmtpMessages
