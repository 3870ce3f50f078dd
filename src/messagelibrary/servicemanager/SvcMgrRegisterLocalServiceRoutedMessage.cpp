#include "messagelibrary/servicemanager/SvcMgrRegisterLocalServiceRoutedMessage.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"

namespace Korvane::Veldra::VeldraMessageLibrary::ServiceManagerMessages {

SvcMgrRegisterLocalServiceRoutedMessage::SvcMgrRegisterLocalServiceRoutedMessage(
    const std::string& target, std::optional<std::string> serviceGuid,
    std::optional<std::string> nodeName, std::optional<std::string> serviceName,
    std::optional<std::string> serviceGroupName, std::optional<std::string> replyToQueue,
    int32_t processId)
    : MessageBus::RoutedMessage(kMessageName, MessageBus::kJsonContentType, target),
      serviceGuid_(std::move(serviceGuid)),
      nodeName_(std::move(nodeName)),
      serviceName_(std::move(serviceName)),
      serviceGroupName_(std::move(serviceGroupName)),
      replyToQueue_(std::move(replyToQueue)),
      processId_(processId) {}

SvcMgrRegisterLocalServiceRoutedMessage::SvcMgrRegisterLocalServiceRoutedMessage(
    MessageBus::MessageHeaders headers, const MessageBus::MessageBody& body)
    : MessageBus::RoutedMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody SvcMgrRegisterLocalServiceRoutedMessage::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::ServiceManagerMessages
