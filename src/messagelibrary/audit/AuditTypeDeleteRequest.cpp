#include "messagelibrary/audit/AuditTypeDeleteRequest.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/audit/AuditTrailService.h"

namespace Korvane::Veldra::VeldraMessageLibrary::AuditTrailMessages {

AuditTypeDeleteRequest::AuditTypeDeleteRequest(std::optional<std::string> id)
    : MessageBus::RequestMessage(kMessageName, MessageBus::kJsonContentType, kAuditTrailService),
      id_(std::move(id)) {}

AuditTypeDeleteRequest::AuditTypeDeleteRequest(MessageBus::MessageHeaders headers,
                                               const MessageBus::MessageBody& body)
    : MessageBus::RequestMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody AuditTypeDeleteRequest::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::AuditTrailMessages
