#include "messagelibrary/servicemanager/SvcMgrUpdateServiceGroupRequest.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"

namespace Korvane::Veldra::VeldraMessageLibrary::ServiceManagerMessages {

SvcMgrUpdateServiceGroupRequest::SvcMgrUpdateServiceGroupRequest(
    const std::string& target, std::optional<std::string> serviceName,
    std::optional<ServiceGroup> group)
    : MessageBus::RequestMessage(kMessageName, MessageBus::kJsonContentType, target),
      serviceName_(std::move(serviceName)),
      group_(std::move(group)) {}

SvcMgrUpdateServiceGroupRequest::SvcMgrUpdateServiceGroupRequest(
    MessageBus::MessageHeaders headers, const MessageBus::MessageBody& body)
    : MessageBus::RequestMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody SvcMgrUpdateServiceGroupRequest::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::ServiceManagerMessages
