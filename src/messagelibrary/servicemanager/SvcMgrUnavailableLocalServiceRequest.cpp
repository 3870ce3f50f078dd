#include "messagelibrary/servicemanager/SvcMgrUnavailableLocalServiceRequest.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"

namespace Korvane::Veldra::VeldraMessageLibrary::ServiceManagerMessages {

SvcMgrUnavailableLocalServiceRequest::SvcMgrUnavailableLocalServiceRequest(
    const std::string& target, std::optional<std::string> serviceGuid,
    std::optional<std::string> nodeName, std::optional<std::string> serviceName,
    std::optional<std::string> serviceGroupName, int32_t processId)
    : MessageBus::RequestMessage(kMessageName, MessageBus::kJsonContentType, target),
      serviceGuid_(std::move(serviceGuid)),
      nodeName_(std::move(nodeName)),
      serviceName_(std::move(serviceName)),
      serviceGroupName_(std::move(serviceGroupName)),
      processId_(processId) {}

SvcMgrUnavailableLocalServiceRequest::SvcMgrUnavailableLocalServiceRequest(
    MessageBus::MessageHeaders headers, const MessageBus::MessageBody& body)
    : MessageBus::RequestMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody SvcMgrUnavailableLocalServiceRequest::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::ServiceManagerMessages
