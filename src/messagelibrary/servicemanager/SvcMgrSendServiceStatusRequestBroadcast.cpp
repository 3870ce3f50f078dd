#include "messagelibrary/servicemanager/SvcMgrSendServiceStatusRequestBroadcast.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"

namespace Korvane::Veldra::VeldraMessageLibrary::ServiceManagerMessages {

SvcMgrSendServiceStatusRequestBroadcast::SvcMgrSendServiceStatusRequestBroadcast()
    : MessageBus::BroadcastMessage(kMessageName, MessageBus::kJsonContentType) {}

SvcMgrSendServiceStatusRequestBroadcast::SvcMgrSendServiceStatusRequestBroadcast(
    MessageBus::MessageHeaders headers, const MessageBus::MessageBody& body)
    : MessageBus::BroadcastMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody SvcMgrSendServiceStatusRequestBroadcast::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::ServiceManagerMessages
