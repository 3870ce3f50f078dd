#pragma once

#include <optional>
#include <string>

#include "messagelibrary/BroadcastMessage.h"
#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/json/JsonReaders.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagInfoMessages {

// Tells which tags were deleted, by path.
class TagInfoDeletedTagsBroadcast : public MessageBus::BroadcastMessage {
public:
    inline static const std::string kMessageName = "TagInfoDeletedTagsBroadcast";

    explicit TagInfoDeletedTagsBroadcast(std::optional<JsonStringList> tags);
    // Parses a received body.
    TagInfoDeletedTagsBroadcast(MessageBus::MessageHeaders headers,
                                const MessageBus::MessageBody& body);

    const std::optional<JsonStringList>& Tags() const { return tags_; }

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("tags", self.tags_);
    }

    std::optional<JsonStringList> tags_;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagInfoMessages
