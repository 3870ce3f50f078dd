#include "messagelibrary/smtp/SmtpGetAddressGroupResponse.h"

#include <optional>
#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"

namespace Korvane::Veldra::VeldraMessageLibrary::SmtpMessages {

SmtpGetAddressGroupResponse::SmtpGetAddressGroupResponse(
    const MessageBus::Interfaces::IRoutingSource& request,
    std::optional<SmtpAddressGroup> addressGroups)
    : MessageBus::ResponseMessage(kMessageName, MessageBus::kJsonContentType, request.ReplyTo()),
      addressGroups_(std::move(addressGroups)) {
    AnswerTo(request, std::nullopt);
}

SmtpGetAddressGroupResponse::SmtpGetAddressGroupResponse(
    const MessageBus::Interfaces::IRoutingSource& request, const MessageBus::MessageError& error)
    : MessageBus::ResponseMessage(kMessageName, MessageBus::kJsonContentType, request.ReplyTo()) {
    AnswerTo(request, error);
}

SmtpGetAddressGroupResponse::SmtpGetAddressGroupResponse(MessageBus::MessageHeaders headers,
                                                         const MessageBus::MessageBody& body)
    : MessageBus::ResponseMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody SmtpGetAddressGroupResponse::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::SmtpMessages
