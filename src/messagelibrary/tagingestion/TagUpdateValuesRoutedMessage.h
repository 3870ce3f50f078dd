#pragma once

#include <optional>
#include <string>
#include <vector>

#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/RoutedMessage.h"
#include "messagelibrary/TagRecords.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagIngestionMessages {

// The write path: new samples of tags, by path. Routed, so it asks for no
// response until the sender clears "IgnoreResponse"; the answer is then a
// GenericResponse.
class TagUpdateValuesRoutedMessage : public MessageBus::RoutedMessage {
public:
    inline static const std::string kMessageName = "TagUpdateValuesRoutedMessage";

    explicit TagUpdateValuesRoutedMessage(std::optional<std::vector<TagPathUpdates>> updates);
    // Parses a received body.
    TagUpdateValuesRoutedMessage(MessageBus::MessageHeaders headers,
                                 const MessageBus::MessageBody& body);

    const std::optional<std::vector<TagPathUpdates>>& Updates() const { return updates_; }

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("updates", self.updates_);
    }

    std::optional<std::vector<TagPathUpdates>> updates_;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagIngestionMessages
