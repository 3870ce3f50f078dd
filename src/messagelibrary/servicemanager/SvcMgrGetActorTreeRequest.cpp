#include "messagelibrary/servicemanager/SvcMgrGetActorTreeRequest.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"

namespace Korvane::Veldra::VeldraMessageLibrary::ServiceManagerMessages {

SvcMgrGetActorTreeRequest::SvcMgrGetActorTreeRequest(const std::string& target)
    : MessageBus::RequestMessage(kMessageName, MessageBus::kJsonContentType, target) {}

SvcMgrGetActorTreeRequest::SvcMgrGetActorTreeRequest(MessageBus::MessageHeaders headers,
                                                     const MessageBus::MessageBody& body)
    : MessageBus::RequestMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody SvcMgrGetActorTreeRequest::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::ServiceManagerMessages
