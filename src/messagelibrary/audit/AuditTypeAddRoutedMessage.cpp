#include "messagelibrary/audit/AuditTypeAddRoutedMessage.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/audit/AuditTrailService.h"

namespace Korvane::Veldra::VeldraMessageLibrary::AuditTrailMessages {

AuditTypeAddRoutedMessage::AuditTypeAddRoutedMessage(std::optional<AuditTypeEntry> entry)
    : MessageBus::RoutedMessage(kMessageName, MessageBus::kJsonContentType, kAuditTrailService),
      entry_(std::move(entry)) {}

AuditTypeAddRoutedMessage::AuditTypeAddRoutedMessage(MessageBus::MessageHeaders headers,
                                                     const MessageBus::MessageBody& body)
    : MessageBus::RoutedMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody AuditTypeAddRoutedMessage::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::AuditTrailMessages
