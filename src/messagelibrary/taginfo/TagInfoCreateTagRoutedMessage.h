#pragma once

#include <optional>
#include <string>

#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/RoutedMessage.h"
#include "messagelibrary/TagRecords.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagInfoMessages {

// Creates one tag.
class TagInfoCreateTagRoutedMessage : public MessageBus::RoutedMessage {
public:
    inline static const std::string kMessageName = "TagInfoCreateTagRoutedMessage";

    explicit TagInfoCreateTagRoutedMessage(std::optional<TagRecord> newTag);
    // Parses a received body.
    TagInfoCreateTagRoutedMessage(MessageBus::MessageHeaders headers,
                                  const MessageBus::MessageBody& body);

    const std::optional<TagRecord>& NewTag() const { return newTag_; }

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("newTag", self.newTag_);
    }

    std::optional<TagRecord> newTag_;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagInfoMessages
