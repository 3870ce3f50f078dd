#pragma once

#include <string>

#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/RequestMessage.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagSubscriptionCommunicatorMessages {

// Tunnels another message's body to the subscription service. The body is
// sent as it stands and kept as it came, without being looked into.
class TagSubscriptionCommunicatorMessageWrapperRequest : public MessageBus::RequestMessage {
public:
    inline static const std::string kMessageName =
        "TagSubscriptionCommunicatorMessageWrapperRequest";

    explicit TagSubscriptionCommunicatorMessageWrapperRequest(MessageBus::MessageBody body);
    // Keeps a received body.
    TagSubscriptionCommunicatorMessageWrapperRequest(MessageBus::MessageHeaders headers,
                                                     const MessageBus::MessageBody& body);

    const MessageBus::MessageBody& Body() const { return body_; }

    MessageBus::MessageBody Serialize() const override { return body_; }

private:
    MessageBus::MessageBody body_;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagSubscriptionCommunicatorMessages
