#pragma once

#include <string>

#include "messagebus/interfaces/IRoutingSource.h"
#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageError.h"
#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/ResponseMessage.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagSubscriptionCommunicatorMessages {

// Tunnels the body of another message's answer back. The body is sent as it
// stands and kept as it came, without being looked into.
class TagSubscriptionCommunicatorMessageWrapperResponse : public MessageBus::ResponseMessage {
public:
    inline static const std::string kMessageName =
        "TagSubscriptionCommunicatorMessageWrapperResponse";

    TagSubscriptionCommunicatorMessageWrapperResponse(
        const MessageBus::Interfaces::IRoutingSource& request, MessageBus::MessageBody body);
    // An error response: the body stays empty.
    TagSubscriptionCommunicatorMessageWrapperResponse(
        const MessageBus::Interfaces::IRoutingSource& request,
        const MessageBus::MessageError& error);
    // Keeps a received body.
    TagSubscriptionCommunicatorMessageWrapperResponse(MessageBus::MessageHeaders headers,
                                                      const MessageBus::MessageBody& body);

    const MessageBus::MessageBody& Body() const { return body_; }

    MessageBus::MessageBody Serialize() const override { return body_; }

private:
    MessageBus::MessageBody body_;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagSubscriptionCommunicatorMessages
