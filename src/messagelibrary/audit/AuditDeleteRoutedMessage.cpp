#include "messagelibrary/audit/AuditDeleteRoutedMessage.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/audit/AuditTrailService.h"

namespace Korvane::Veldra::VeldraMessageLibrary::AuditTrailMessages {

AuditDeleteRoutedMessage::AuditDeleteRoutedMessage(std::optional<std::string> id)
    : MessageBus::RoutedMessage(kMessageName, MessageBus::kJsonContentType, kAuditTrailService),
      id_(std::move(id)) {}

AuditDeleteRoutedMessage::AuditDeleteRoutedMessage(MessageBus::MessageHeaders headers,
                                                   const MessageBus::MessageBody& body)
    : MessageBus::RoutedMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody AuditDeleteRoutedMessage::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::AuditTrailMessages
