#pragma once

#include <optional>
#include <string>

#include "messagebus/interfaces/IRoutingSource.h"
#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/RoutedMessage.h"
#include "messagelibrary/taghistorian/HistorianRecords.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagHistorianMessages {

// One part of the values a background query found, to the sender of the query.
// Sent to the reply queue of the request named at construction, with a
// correlation id of its own.
class TagHistorianAsyncQueryDataRoutedMessage : public MessageBus::RoutedMessage {
public:
    inline static const std::string kMessageName = "TagHistorianAsyncQueryDataRoutedMessage";

    TagHistorianAsyncQueryDataRoutedMessage(
        const MessageBus::Interfaces::IRoutingSource& request,
        std::optional<HistorianAsyncValues> tagHistorianAsyncValues);
    // Parses a received body.
    TagHistorianAsyncQueryDataRoutedMessage(MessageBus::MessageHeaders headers,
                                            const MessageBus::MessageBody& body);

    const std::optional<HistorianAsyncValues>& TagHistorianAsyncValues() const {
        return tagHistorianAsyncValues_;
    }

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("tagHistorianAsyncValues", self.tagHistorianAsyncValues_);
    }

    std::optional<HistorianAsyncValues> tagHistorianAsyncValues_;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagHistorianMessages
