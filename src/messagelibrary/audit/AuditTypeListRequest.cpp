#include "messagelibrary/audit/AuditTypeListRequest.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/audit/AuditTrailService.h"

namespace Korvane::Veldra::VeldraMessageLibrary::AuditTrailMessages {

AuditTypeListRequest::AuditTypeListRequest()
    : MessageBus::RequestMessage(kMessageName, MessageBus::kJsonContentType, kAuditTrailService) {}

AuditTypeListRequest::AuditTypeListRequest(MessageBus::MessageHeaders headers,
                                           const MessageBus::MessageBody& body)
    : MessageBus::RequestMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody AuditTypeListRequest::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::AuditTrailMessages
