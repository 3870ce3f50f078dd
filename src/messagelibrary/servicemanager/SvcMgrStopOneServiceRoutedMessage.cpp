#include "messagelibrary/servicemanager/SvcMgrStopOneServiceRoutedMessage.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"

namespace Korvane::Veldra::VeldraMessageLibrary::ServiceManagerMessages {

SvcMgrStopOneServiceRoutedMessage::SvcMgrStopOneServiceRoutedMessage(
    const std::string& target, int32_t processId, std::optional<std::string> serviceGuid, bool kill)
    : MessageBus::RoutedMessage(kMessageName, MessageBus::kJsonContentType, target),
      processId_(processId),
      serviceGuid_(std::move(serviceGuid)),
      kill_(kill) {}

SvcMgrStopOneServiceRoutedMessage::SvcMgrStopOneServiceRoutedMessage(
    MessageBus::MessageHeaders headers, const MessageBus::MessageBody& body)
    : MessageBus::RoutedMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody SvcMgrStopOneServiceRoutedMessage::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::ServiceManagerMessages
