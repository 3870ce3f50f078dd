#include "messagelibrary/audit/AuditAddRoutedMessage.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/audit/AuditTrailService.h"

namespace Korvane::Veldra::VeldraMessageLibrary::AuditTrailMessages {

AuditAddRoutedMessage::AuditAddRoutedMessage(std::optional<std::vector<AuditEntry>> entries)
    : MessageBus::RoutedMessage(kMessageName, MessageBus::kJsonContentType, kAuditTrailService),
      entries_(std::move(entries)) {}

AuditAddRoutedMessage::AuditAddRoutedMessage(MessageBus::MessageHeaders headers,
                                             const MessageBus::MessageBody& body)
    : MessageBus::RoutedMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody AuditAddRoutedMessage::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::AuditTrailMessages
