#include "messagelibrary/servicemanager/SvcMgrStartServicesBroadcast.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"

namespace Korvane::Veldra::VeldraMessageLibrary::ServiceManagerMessages {

SvcMgrStartServicesBroadcast::SvcMgrStartServicesBroadcast(
    bool allNodes, std::optional<JsonStringList> nodeNames, bool allServices,
    std::optional<JsonStringList> serviceNames, int32_t instanceCount)
    : MessageBus::BroadcastMessage(kMessageName, MessageBus::kJsonContentType),
      allNodes_(allNodes),
      nodeNames_(std::move(nodeNames)),
      allServices_(allServices),
      serviceNames_(std::move(serviceNames)),
      instanceCount_(instanceCount) {}

SvcMgrStartServicesBroadcast::SvcMgrStartServicesBroadcast(MessageBus::MessageHeaders headers,
                                                           const MessageBus::MessageBody& body)
    : MessageBus::BroadcastMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody SvcMgrStartServicesBroadcast::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::ServiceManagerMessages
