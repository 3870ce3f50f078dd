#pragma once

#include <optional>
#include <string>
#include <vector>

#include "messagelibrary/BroadcastMessage.h"
#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/taghistorian/HistorianRecords.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagHistorianMessages {

// Tells that values were stored.
class TagHistorianValuesProcessedBroadcast : public MessageBus::BroadcastMessage {
public:
    inline static const std::string kMessageName = "TagHistorianValuesProcessedBroadcast";

    explicit TagHistorianValuesProcessedBroadcast(
        std::optional<std::vector<HistorianValue>> values);
    // Parses a received body.
    TagHistorianValuesProcessedBroadcast(MessageBus::MessageHeaders headers,
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
