#pragma once

#include <optional>
#include <string>

#include "messagebus/interfaces/IRoutingSource.h"
#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageError.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/ResponseMessage.h"
#include "messagelibrary/json/JsonReaders.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagSubscriptionCommunicatorMessages {

// The ids of all subscriptions.
class TagSubscriptionCommunicatorGetSubscriptionsResponse : public MessageBus::ResponseMessage {
public:
    inline static const std::string kMessageName =
        "TagSubscriptionCommunicatorGetSubscriptionsResponse";

    TagSubscriptionCommunicatorGetSubscriptionsResponse(
        const MessageBus::Interfaces::IRoutingSource& request,
        std::optional<JsonStringList> subscriptionIds);
    // An error response: the fields stay unset.
    TagSubscriptionCommunicatorGetSubscriptionsResponse(
        const MessageBus::Interfaces::IRoutingSource& request,
        const MessageBus::MessageError& error);
    // Parses a received body.
    TagSubscriptionCommunicatorGetSubscriptionsResponse(MessageBus::MessageHeaders headers,
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
