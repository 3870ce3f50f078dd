#include "messagelibrary/audit/AuditQueryRequest.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/audit/AuditTrailService.h"

namespace Korvane::Veldra::VeldraMessageLibrary::AuditTrailMessages {

AuditQueryRequest::AuditQueryRequest(std::optional<AuditQueryParameters> parameters,
                                     int32_t takeCount, int32_t skipCount)
    : MessageBus::RequestMessage(kMessageName, MessageBus::kJsonContentType, kAuditTrailService),
      parameters_(std::move(parameters)),
      takeCount_(takeCount),
      skipCount_(skipCount) {}

AuditQueryRequest::AuditQueryRequest(MessageBus::MessageHeaders headers,
                                     const MessageBus::MessageBody& body)
    : MessageBus::RequestMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody AuditQueryRequest::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::AuditTrailMessages
