#pragma once

#include <optional>
#include <string>
#include <vector>

#include "messagebus/interfaces/IRoutingSource.h"
#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/RoutedMessage.h"
#include "messagelibrary/tagsubscription/SubscriptionRecords.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagSubscriptionCommunicatorMessages {

// Updates pushed to the subscriber.
// Sent to the reply queue of the request named at construction, with a
// correlation id of its own.
class TagSubscriptionCommunicatorPushedUpdateRoutedMessage : public MessageBus::RoutedMessage {
public:
    inline static const std::string kMessageName =
        "TagSubscriptionCommunicatorPushedUpdateRoutedMessage";

    TagSubscriptionCommunicatorPushedUpdateRoutedMessage(
        const MessageBus::Interfaces::IRoutingSource& request,
        std::optional<std::vector<SubscriptionUpdate>> updates);
    // Parses a received body.
    TagSubscriptionCommunicatorPushedUpdateRoutedMessage(MessageBus::MessageHeaders headers,
                                                         const MessageBus::MessageBody& body);

    const std::optional<std::vector<SubscriptionUpdate>>& Updates() const { return updates_; }

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("updates", self.updates_);
    }

    std::optional<std::vector<SubscriptionUpdate>> updates_;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagSubscriptionCommunicatorMessages
