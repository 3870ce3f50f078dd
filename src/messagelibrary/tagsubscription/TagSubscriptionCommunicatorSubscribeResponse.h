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

// The id of a new subscription and the tags that don't exist.
class TagSubscriptionCommunicatorSubscribeResponse : public MessageBus::ResponseMessage {
public:
    inline static const std::string kMessageName = "TagSubscriptionCommunicatorSubscribeResponse";

    TagSubscriptionCommunicatorSubscribeResponse(
        const MessageBus::Interfaces::IRoutingSource& request,
        std::optional<std::string> subscriptionId, std::optional<std::string> alias,
        std::optional<JsonStringList> nonexistentTags);
    // An error response: the fields stay unset.
    TagSubscriptionCommunicatorSubscribeResponse(
        const MessageBus::Interfaces::IRoutingSource& request,
        const MessageBus::MessageError& error);
    // Parses a received body.
    TagSubscriptionCommunicatorSubscribeResponse(MessageBus::MessageHeaders headers,
                                                 const MessageBus::MessageBody& body);

    const std::optional<std::string>& SubscriptionId() const { return subscriptionId_; }
    const std::optional<std::string>& Alias() const { return alias_; }
    const std::optional<JsonStringList>& NonexistentTags() const { return nonexistentTags_; }

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("subscriptionId", self.subscriptionId_)
            .Field("alias", self.alias_)
            .Field("nonexistentTags", self.nonexistentTags_);
    }

    std::optional<std::string> subscriptionId_;
    std::optional<std::string> alias_;
    std::optional<JsonStringList> nonexistentTags_;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagSubscriptionCommunicatorMessages
