#include "messagelibrary/smtp/SmtpUpdateOrCreateAddressGroupResponse.h"

#include <optional>
#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"

namespace Korvane::Veldra::VeldraMessageLibrary::SmtpMessages {

SmtpUpdateOrCreateAddressGroupResponse::SmtpUpdateOrCreateAddressGroupResponse(
    const MessageBus::Interfaces::IRoutingSource& request, std::optional<std::string> id)
    : MessageBus::ResponseMessage(kMessageName, MessageBus::kJsonContentType, request.ReplyTo()),
      id_(std::move(id)) {
    AnswerTo(request, std::nullopt);
}

SmtpUpdateOrCreateAddressGroupResponse::SmtpUpdateOrCreateAddressGroupResponse(
    const MessageBus::Interfaces::IRoutingSource& request, const MessageBus::MessageError& error)
    : MessageBus::ResponseMessage(kMessageName, MessageBus::kJsonContentType, request.ReplyTo()) {
    AnswerTo(request, error);
}

SmtpUpdateOrCreateAddressGroupResponse::SmtpUpdateOrCreateAddressGroupResponse(
    MessageBus::MessageHeaders headers, const MessageBus::MessageBody& body)
    : MessageBus::ResponseMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody SmtpUpdateOrCreateAddressGroupResponse::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::SmtpMessages
