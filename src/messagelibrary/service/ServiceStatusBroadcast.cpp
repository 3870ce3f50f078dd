#include "messagelibrary/service/ServiceStatusBroadcast.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"

namespace Korvane::Veldra::VeldraMessageLibrary::ServiceMessages {

ServiceStatusBroadcast::ServiceStatusBroadcast(
    std::optional<std::string> nodeName, std::optional<std::string> serviceGuid,
    std::optional<std::string> serviceName, std::optional<std::string> serviceGroupName,
    std::optional<std::string> serviceReplyTo,
    std::optional<VeldraMessageLibrary::ServiceState> serviceState)
    : MessageBus::BroadcastMessage(kMessageName, MessageBus::kJsonContentType),
      nodeName_(std::move(nodeName)),
      serviceGuid_(std::move(serviceGuid)),
      serviceName_(std::move(serviceName)),
      serviceGroupName_(std::move(serviceGroupName)),
      serviceReplyTo_(std::move(serviceReplyTo)),
      serviceState_(std::move(serviceState)) {}

ServiceStatusBroadcast::ServiceStatusBroadcast(MessageBus::MessageHeaders headers,
                                               const MessageBus::MessageBody& body)
    : MessageBus::BroadcastMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody ServiceStatusBroadcast::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::ServiceMessages
