#include "messagelibrary/service/ServiceStartedBroadcast.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"

namespace Korvane::Veldra::VeldraMessageLibrary::ServiceMessages {

ServiceStartedBroadcast::ServiceStartedBroadcast(std::optional<std::string> service,
                                                 std::optional<std::string> serviceReplyTo)
    : MessageBus::BroadcastMessage(kMessageName, MessageBus::kJsonContentType),
      service_(std::move(service)),
      serviceReplyTo_(std::move(serviceReplyTo)) {}

ServiceStartedBroadcast::ServiceStartedBroadcast(MessageBus::MessageHeaders headers,
                                                 const MessageBus::MessageBody& body)
    : MessageBus::BroadcastMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody ServiceStartedBroadcast::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::ServiceMessages
