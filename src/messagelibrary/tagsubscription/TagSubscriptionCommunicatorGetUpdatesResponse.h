#pragma once

#include <optional>
#include <string>
#include <vector>

#include "messagebus/interfaces/IRoutingSource.h"
#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageError.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/ResponseMessage.h"
#include "messagelibrary/json/JsonReaders.h"
#include "messagelibrary/tagsubscription/SubscriptionRecords.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagSubscriptionCommunicatorMessages {

// The updates of the subscriptions polled, and the ids that named none.
class TagSubscriptionCommunicatorGetUpdatesResponse : public MessageBus::ResponseMessage {
public:
    inline static const std::string kMessageName = "TagSubscriptionCommunicatorGetUpdatesResponse";

    TagSubscriptionCommunicatorGetUpdatesResponse(
        const MessageBus::Interfaces::IRoutingSource& request,
        std::optional<std::vector<SubscriptionUpdate>> updates,
        std::optional<JsonStringList> invalidSubscriptionIds);
    // An error response: the fields stay unset.
    TagSubscriptionCommunicatorGetUpdatesResponse(
        const MessageBus::Interfaces::IRoutingSource& request,
        const MessageBus::MessageError& error);
    // Parses a received body.
    TagSubscriptionCommunicatorGetUpdatesResponse(MessageBus::MessageHeaders headers,
                                                  const MessageBus::MessageBody& body);

    const std::optional<std::vector<SubscriptionUpdate>>& Updates() const { return updates_; }
    const std::optional<JsonStringList>& InvalidSubscriptionIds() const {
        return invalidSubscriptionIds_;
    }

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("updates", self.updates_)
            .Field("invalidSubscriptionIds", self.invalidSubscriptionIds_);
    }

    std::optional<std::vector<SubscriptionUpdate>> updates_;
    std::optional<JsonStringList> invalidSubscriptionIds_;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagSubscriptionCommunicatorMessages
