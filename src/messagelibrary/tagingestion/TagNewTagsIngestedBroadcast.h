#pragma once

#include <optional>
#include <string>
#include <vector>

#include "messagelibrary/BroadcastMessage.h"
#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/TagRecords.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagIngestionMessages {

// Tells of tags that came in with their first values: each tag record with its updates.
class TagNewTagsIngestedBroadcast : public MessageBus::BroadcastMessage {
public:
    inline static const std::string kMessageName = "TagNewTagsIngestedBroadcast";

    explicit TagNewTagsIngestedBroadcast(std::optional<std::vector<TagUpdateSet>> updates);
    // Parses a received body.
    TagNewTagsIngestedBroadcast(MessageBus::MessageHeaders headers,
                                const MessageBus::MessageBody& body);

    const std::optional<std::vector<TagUpdateSet>>& Updates() const { return updates_; }

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("updates", self.updates_);
    }

    std::optional<std::vector<TagUpdateSet>> updates_;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagIngestionMessages
