#include "messagelibrary/servicemanager/SvcMgrGetServiceInfoSnapshotRequest.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"

namespace Korvane::Veldra::VeldraMessageLibrary::ServiceManagerMessages {

SvcMgrGetServiceInfoSnapshotRequest::SvcMgrGetServiceInfoSnapshotRequest(const std::string& target)
    : MessageBus::RequestMessage(kMessageName, MessageBus::kJsonContentType, target) {}

SvcMgrGetServiceInfoSnapshotRequest::SvcMgrGetServiceInfoSnapshotRequest(
    MessageBus::MessageHeaders headers, const MessageBus::MessageBody& body)
    : MessageBus::RequestMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody SvcMgrGetServiceInfoSnapshotRequest::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::ServiceManagerMessages
