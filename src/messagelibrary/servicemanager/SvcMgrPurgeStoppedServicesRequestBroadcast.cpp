#include "messagelibrary/servicemanager/SvcMgrPurgeStoppedServicesRequestBroadcast.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"

namespace Korvane::Veldra::VeldraMessageLibrary::ServiceManagerMessages {

SvcMgrPurgeStoppedServicesRequestBroadcast::SvcMgrPurgeStoppedServicesRequestBroadcast()
    : MessageBus::BroadcastMessage(kMessageName, MessageBus::kJsonContentType) {}

SvcMgrPurgeStoppedServicesRequestBroadcast::SvcMgrPurgeStoppedServicesRequestBroadcast(
    MessageBus::MessageHeaders headers, const MessageBus::MessageBody& body)
    : MessageBus::BroadcastMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody SvcMgrPurgeStoppedServicesRequestBroadcast::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::ServiceManagerMessages
