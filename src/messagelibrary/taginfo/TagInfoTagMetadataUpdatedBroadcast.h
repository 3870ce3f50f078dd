#pragma once

#include <optional>
#include <string>

#include "messagelibrary/BroadcastMessage.h"
#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/TagRecords.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagInfoMessages {

// Tells that a tag's metadata changed.
class TagInfoTagMetadataUpdatedBroadcast : public MessageBus::BroadcastMessage {
public:
    inline static const std::string kMessageName = "TagInfoTagMetadataUpdatedBroadcast";

    explicit TagInfoTagMetadataUpdatedBroadcast(std::optional<TagRecord> updatedTag);
    // Parses a received body.
    TagInfoTagMetadataUpdatedBroadcast(MessageBus::MessageHeaders headers,
                                       const MessageBus::MessageBody& body);

    const std::optional<TagRecord>& UpdatedTag() const { return updatedTag_; }

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("updatedTag", self.updatedTag_);
    }

    std::optional<TagRecord> updatedTag_;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagInfoMessages
