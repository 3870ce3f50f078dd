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
#include "messagelibrary/tagsubscription/SubscriptionRecords.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagSubscriptionCommunicatorMessages {

// One subscription: whether the id was valid, its alias, options and tags.
class TagSubscriptionCommunicatorGetSubscriptionResponse : public MessageBus::ResponseMessage {
public:
    inline static const std::string kMessageName =
        "TagSubscriptionCommunicatorGetSubscriptionResponse";

    TagSubscriptionCommunicatorGetSubscriptionResponse(
        const MessageBus::Interfaces::IRoutingSource& request, bool validSubscription,
        std::optional<std::string> alias, std::optional<SubscriptionOptions> options,
        std::optional<JsonStringList> tags);
    // An error response: the fields stay unset.
    TagSubscriptionCommunicatorGetSubscriptionResponse(
        const MessageBus::Interfaces::IRoutingSource& request,
        const MessageBus::MessageError& error);
    // Parses a received body.
    TagSubscriptionCommunicatorGetSubscriptionResponse(MessageBus::MessageHeaders headers,
                                                       const MessageBus::MessageBody& body);

    bool ValidSubscription() const { return validSubscription_; }
    const std::optional<std::string>& Alias() const { return alias_; }
    const std::optional<SubscriptionOptions>& Options() const { return options_; }
    const std::optional<JsonStringList>& Tags() const { return tags_; }

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("validSubscription", self.validSubscription_)
            .Field("alias", self.alias_)
            .Field("options", self.options_)
            .Field("tags", self.tags_);
    }

    bool validSubscription_ = false;
    std::optional<std::string> alias_;
    std::optional<SubscriptionOptions> options_;
    std::optional<JsonStringList> tags_;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagSubscriptionCommunicatorMessages
