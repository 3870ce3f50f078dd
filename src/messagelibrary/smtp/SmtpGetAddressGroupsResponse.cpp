#include "messagelibrary/smtp/SmtpGetAddressGroupsResponse.h"

#include <optional>
#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"

namespace Korvane::Veldra::VeldraMessageLibrary::SmtpMessages {

SmtpGetAddressGroupsResponse::SmtpGetAddressGroupsResponse(
    const MessageBus::Interfaces::IRoutingSource& request,
    std::optional<std::vector<SmtpAddressGroup>> addressGroups)
    : MessageBus::ResponseMessage(kMessageName, MessageBus::kJsonContentType, request.ReplyTo()),
      addressGroups_(std::move(addressGroups)) {
    AnswerTo(request, std::nullopt);
}

SmtpGetAddressGroupsResponse::SmtpGetAddressGroupsResponse(
    const MessageBus::Interfaces::IRoutingSource& request, const MessageBus::MessageError& error)
    : MessageBus::ResponseMessage(kMessageName, MessageBus::kJsonContentType, request.ReplyTo()) {
    AnswerTo(request, error);
}

SmtpGetAddressGroupsResponse::SmtpGetAddressGroupsResponse(MessageBus::MessageHeaders headers,
                                                           const MessageBus::MessageBody& body)
    : MessageBus::ResponseMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody SmtpGetAddressGroupsResponse::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::SmtpMessages
