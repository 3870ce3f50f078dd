#pragma once

#include <optional>
#include <string>

#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/RequestMessage.h"
#include "messagelibrary/json/JsonReaders.h"
#include "messagelibrary/tagsubscription/SubscriptionRecords.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagSubscriptionCommunicatorMessages {

// Subscribes to tags under an alias.
class TagSubscriptionCommunicatorSubscribeRequest : public MessageBus::RequestMessage {
public:
    inline static const std::string kMessageName = "TagSubscriptionCommunicatorSubscribeRequest";

    TagSubscriptionCommunicatorSubscribeRequest(std::optional<std::string> alias,
                                                std::optional<SubscriptionOptions> options,
                                                std::optional<JsonStringList> tags);
    // Parses a received body.
    TagSubscriptionCommunicatorSubscribeRequest(MessageBus::MessageHeaders headers,
                                                const MessageBus::MessageBody& body);

    const std::optional<std::string>& Alias() const { return alias_; }
    const std::optional<SubscriptionOptions>& Options() const { return options_; }
    const std::optional<JsonStringList>& Tags() const { return tags_; }

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("alias", self.alias_)
            .Field("options", self.options_)
            .Field("tags", self.tags_);
    }

    std::optional<std::string> alias_;
    std::optional<SubscriptionOptions> options_;
    std::optional<JsonStringList> tags_;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagSubscriptionCommunicatorMessages
