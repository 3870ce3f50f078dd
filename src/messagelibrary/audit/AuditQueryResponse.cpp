#include "messagelibrary/audit/AuditQueryResponse.h"

#include <optional>
#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"

namespace Korvane::Veldra::VeldraMessageLibrary::AuditTrailMessages {

AuditQueryResponse::AuditQueryResponse(const MessageBus::Interfaces::IRoutingSource& request,
                                       std::optional<std::vector<AuditEntry>> entries,
                                       int32_t fullCount)
    : MessageBus::ResponseMessage(kMessageName, MessageBus::kJsonContentType, request.ReplyTo()),
      entries_(std::move(entries)),
      fullCount_(fullCount) {
    AnswerTo(request, std::nullopt);
}

AuditQueryResponse::AuditQueryResponse(const MessageBus::Interfaces::IRoutingSource& request,
                                       const MessageBus::MessageError& error)
    : MessageBus::ResponseMessage(kMessageName, MessageBus::kJsonContentType, request.ReplyTo()) {
    AnswerTo(request, error);
}

AuditQueryResponse::AuditQueryResponse(MessageBus::MessageHeaders headers,
                                       const MessageBus::MessageBody& body)
    : MessageBus::ResponseMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody AuditQueryResponse::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::AuditTrailMessages
