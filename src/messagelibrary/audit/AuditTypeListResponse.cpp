#include "messagelibrary/audit/AuditTypeListResponse.h"

#include <optional>
#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"

namespace Korvane::Veldra::VeldraMessageLibrary::AuditTrailMessages {

AuditTypeListResponse::AuditTypeListResponse(const MessageBus::Interfaces::IRoutingSource& request,
                                             std::optional<std::vector<AuditTypeEntry>> entries)
    : MessageBus::ResponseMessage(kMessageName, MessageBus::kJsonContentType, request.ReplyTo()),
      entries_(std::move(entries)) {
    AnswerTo(request, std::nullopt);
}

AuditTypeListResponse::AuditTypeListResponse(const MessageBus::Interfaces::IRoutingSource& request,
                                             const MessageBus::MessageError& error)
    : MessageBus::ResponseMessage(kMessageName, MessageBus::kJsonContentType, request.ReplyTo()) {
    AnswerTo(request, error);
}

AuditTypeListResponse::AuditTypeListResponse(MessageBus::MessageHeaders headers,
                                             const MessageBus::MessageBody& body)
    : MessageBus::ResponseMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody AuditTypeListResponse::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::AuditTrailMessages
