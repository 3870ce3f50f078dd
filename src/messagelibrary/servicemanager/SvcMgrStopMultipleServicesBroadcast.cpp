#include "messagelibrary/servicemanager/SvcMgrStopMultipleServicesBroadcast.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"

namespace Korvane::Veldra::VeldraMessageLibrary::ServiceManagerMessages {

SvcMgrStopMultipleServicesBroadcast::SvcMgrStopMultipleServicesBroadcast(
    std::optional<std::string> serviceName, std::optional<std::string> nodeName, bool kill)
    : MessageBus::BroadcastMessage(kMessageName, MessageBus::kJsonContentType),
      serviceName_(std::move(serviceName)),
      nodeName_(std::move(nodeName)),
      kill_(kill) {}

SvcMgrStopMultipleServicesBroadcast::SvcMgrStopMultipleServicesBroadcast(
    MessageBus::MessageHeaders headers, const MessageBus::MessageBody& body)
    : MessageBus::BroadcastMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody SvcMgrStopMultipleServicesBroadcast::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::ServiceManagerMessages
