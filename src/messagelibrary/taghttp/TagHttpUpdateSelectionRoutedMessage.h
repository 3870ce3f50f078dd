#pragma once

#include <optional>
#include <string>

#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/RoutedMessage.h"
#include "messagelibrary/taghttp/TagSelection.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagHttpMessages {

// Replaces a selection, named by its id.
class TagHttpUpdateSelectionRoutedMessage : public MessageBus::RoutedMessage {
public:
    inline static const std::string kMessageName = "TagHttpUpdateSelectionRoutedMessage";

    explicit TagHttpUpdateSelectionRoutedMessage(std::optional<TagSelection> selection);
    // Parses a received body.
    TagHttpUpdateSelectionRoutedMessage(MessageBus::MessageHeaders headers,
                                        const MessageBus::MessageBody& body);

    const std::optional<TagSelection>& Selection() const { return selection_; }

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("selection", self.selection_);
    }

    std::optional<TagSelection> selection_;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagHttpMessages
