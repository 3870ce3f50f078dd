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

// The ids of an unsubscribe that named no subscription.
class TagSubscriptionCommunicatorUnsubscribeResponse : public MessageBus::ResponseMessage {
public:
    inline static const std::string kMessageName = "TagSubscriptionCommunicatorUnsubscribeResponse";

    TagSubscriptionCommunicatorUnsubscribeResponse(
        const MessageBus::Interfaces::IRoutingSource& request,
        std::optional<JsonStringList> invalidSubscriptionIds);
    // An error response: the fields stay unset.
    TagSubscriptionCommunicatorUnsubscribeResponse(
        const MessageBus::Interfaces::IRoutingSource& request,
        const MessageBus::MessageError& error);
    // Parses a received body.
    TagSubscriptionCommunicatorUnsubscribeResponse(MessageBus::MessageHeaders headers,
                                                   const MessageBus::MessageBody& body);

    const std::optional<JsonStringList>& InvalidSubscriptionIds() const {
        return invalidSubscriptionIds_;
    }

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("invalidSubscriptionIds", self.invalidSubscriptionIds_);
    }

    std::optional<JsonStringList> invalidSubscriptionIds_;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagSubscriptionCommunicatorMessages
