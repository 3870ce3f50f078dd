#pragma once

#include <optional>
#include <string>
#include <vector>

#include "messagebus/interfaces/IRoutingSource.h"
#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/RoutedMessage.h"
#include "messagelibrary/taghistorian/HistorianRecords.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagHistorianMessages {

// Stored values, to a subscriber of stored values.
// Sent to the reply queue of the request named at construction, with a
// correlation id of its own.
class TagHistorianAsyncValuesProcessedRoutedMessage : public MessageBus::RoutedMessage {
public:
    inline static const std::string kMessageName = "TagHistorianAsyncValuesProcessedRoutedMessage";

    TagHistorianAsyncValuesProcessedRoutedMessage(
        const MessageBus::Interfaces::IRoutingSource& request,
        std::optional<std::vector<HistorianValue>> values);
    // Parses a received body.
    TagHistorianAsyncValuesProcessedRoutedMessage(MessageBus::MessageHeaders headers,
                                                  const MessageBus::MessageBody& body);

    const std::optional<std::vector<HistorianValue>>& Values() const { return values_; }

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("values", self.values_);
    }

    std::optional<std::vector<HistorianValue>> values_;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagHistorianMessages
