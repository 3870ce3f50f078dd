#pragma once

#include <string>

#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/RequestMessage.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagSubscriptionCommunicatorMessages {

// Asks for the ids of all subscriptions.
class TagSubscriptionCommunicatorGetSubscriptionsRequest : public MessageBus::RequestMessage {
public:
    inline static const std::string kMessageName =
        "TagSubscriptionCommunicatorGetSubscriptionsRequest";

    TagSubscriptionCommunicatorGetSubscriptionsRequest();
    // Parses a received body.
    TagSubscriptionCommunicatorGetSubscriptionsRequest(MessageBus::MessageHeaders headers,
                                                       const MessageBus::MessageBody& body);

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self&, Fields&) {}
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagSubscriptionCommunicatorMessages
