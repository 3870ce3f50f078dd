#pragma once

#include <optional>
#include <string>
#include <vector>

#include "messagelibrary/BroadcastMessage.h"
#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/TagRecords.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagCurrentValueMessages {

// Reports the new samples and aggregates of tags whose aggregates were reset,
// by path.
class TagCvAggregatesResetBroadcast : public MessageBus::BroadcastMessage {
public:
    inline static const std::string kMessageName = "TagCvAggregatesResetBroadcast";

    explicit TagCvAggregatesResetBroadcast(
        std::optional<std::vector<TagAggregatedUpdates>> updates);
    // Parses a received body.
    TagCvAggregatesResetBroadcast(MessageBus::MessageHeaders headers,
                                  const MessageBus::MessageBody& body);

    const std::optional<std::vector<TagAggregatedUpdates>>& Updates() const { return updates_; }

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("updates", self.updates_);
    }

    std::optional<std::vector<TagAggregatedUpdates>> updates_;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagCurrentValueMessages
