#include "messagelibrary/servicemanager/SvcMgrRunningServiceManagersRequest.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"

namespace Korvane::Veldra::VeldraMessageLibrary::ServiceManagerMessages {

SvcMgrRunningServiceManagersRequest::SvcMgrRunningServiceManagersRequest(const std::string& target)
    : MessageBus::RequestMessage(kMessageName, MessageBus::kJsonContentType, target) {}

SvcMgrRunningServiceManagersRequest::SvcMgrRunningServiceManagersRequest(
    MessageBus::MessageHeaders headers, const MessageBus::MessageBody& body)
    : MessageBus::RequestMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody SvcMgrRunningServiceManagersRequest::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::ServiceManagerMessages
