#include "messagelibrary/servicemanager/SvcMgrHeartbeatBroadcast.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"

namespace Korvane::Veldra::VeldraMessageLibrary::ServiceManagerMessages {

SvcMgrHeartbeatBroadcast::SvcMgrHeartbeatBroadcast(std::optional<std::string> nodeName)
    : MessageBus::BroadcastMessage(kMessageName, MessageBus::kJsonContentType),
      nodeName_(std::move(nodeName)) {}

SvcMgrHeartbeatBroadcast::SvcMgrHeartbeatBroadcast(MessageBus::MessageHeaders headers,
                                                   const MessageBus::MessageBody& body)
    : MessageBus::BroadcastMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody SvcMgrHeartbeatBroadcast::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::ServiceManagerMessages
