#include "messagelibrary/audit/AuditTypeDeleteResponse.h"

#include <optional>
#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"

namespace Korvane::Veldra::VeldraMessageLibrary::AuditTrailMessages {

AuditTypeDeleteResponse::AuditTypeDeleteResponse(
    const MessageBus::Interfaces::IRoutingSource& request)
    : MessageBus::ResponseMessage(kMessageName, MessageBus::kJsonContentType, request.ReplyTo()) {
    AnswerTo(request, std::nullopt);
}

AuditTypeDeleteResponse::AuditTypeDeleteResponse(
    const MessageBus::Interfaces::IRoutingSource& request, const MessageBus::MessageError& error)
    : MessageBus::ResponseMessage(kMessageName, MessageBus::kJsonContentType, request.ReplyTo()) {
    AnswerTo(request, error);
}

AuditTypeDeleteResponse::AuditTypeDeleteResponse(MessageBus::MessageHeaders headers,
                                                 const MessageBus::MessageBody& body)
    : MessageBus::ResponseMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody AuditTypeDeleteResponse::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::AuditTrailMessages
