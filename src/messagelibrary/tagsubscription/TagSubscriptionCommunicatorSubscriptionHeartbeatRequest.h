#pragma once

#include <optional>
#include <string>

#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/RequestMessage.h"
#include "messagelibrary/json/JsonReaders.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagSubscriptionCommunicatorMessages {

// Keeps subscriptions alive.
class TagSubscriptionCommunicatorSubscriptionHeartbeatRequest : public MessageBus::RequestMessage {
public:
    inline static const std::string kMessageName =
        "TagSubscriptionCommunicatorSubscriptionHeartbeatRequest";

    explicit TagSubscriptionCommunicatorSubscriptionHeartbeatRequest(
        std::optional<JsonStringList> subscriptionIds);
    // Parses a received body.
    TagSubscriptionCommunicatorSubscriptionHeartbeatRequest(MessageBus::MessageHeaders headers,
                                                            const MessageBus::MessageBody& body);

    const std::optional<JsonStringList>& SubscriptionIds() const { return subscriptionIds_; }

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("subscriptionIds", self.subscriptionIds_);
    }

    std::optional<JsonStringList> subscriptionIds_;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagSubscriptionCommunicatorMessages
