#include "messagelibrary/servicemanager/SvcMgrGetServiceGroupsRequest.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"

namespace Korvane::Veldra::VeldraMessageLibrary::ServiceManagerMessages {

SvcMgrGetServiceGroupsRequest::SvcMgrGetServiceGroupsRequest(const std::string& target,
                                                             std::optional<std::string> serviceName)
    : MessageBus::RequestMessage(kMessageName, MessageBus::kJsonContentType, target),
      serviceName_(std::move(serviceName)) {}

SvcMgrGetServiceGroupsRequest::SvcMgrGetServiceGroupsRequest(MessageBus::MessageHeaders headers,
                                                             const MessageBus::MessageBody& body)
    : MessageBus::RequestMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody SvcMgrGetServiceGroupsRequest::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::ServiceManagerMessages
