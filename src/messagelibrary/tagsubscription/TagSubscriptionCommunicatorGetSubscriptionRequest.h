#pragma once

#include <optional>
#include <string>

#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/RequestMessage.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagSubscriptionCommunicatorMessages {

// Asks for one subscription by its id.
class TagSubscriptionCommunicatorGetSubscriptionRequest : public MessageBus::RequestMessage {
public:
    inline static const std::string kMessageName =
        "TagSubscriptionCommunicatorGetSubscriptionRequest";

    explicit TagSubscriptionCommunicatorGetSubscriptionRequest(
        std::optional<std::string> subscriptionId);
    // Parses a received body.
    TagSubscriptionCommunicatorGetSubscriptionRequest(MessageBus::MessageHeaders headers,
                                                      const MessageBus::MessageBody& body);

    const std::optional<std::string>& SubscriptionId() const { return subscriptionId_; }

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("subscriptionId", self.subscriptionId_);
    }

    std::optional<std::string> subscriptionId_;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagSubscriptionCommunicatorMessages
