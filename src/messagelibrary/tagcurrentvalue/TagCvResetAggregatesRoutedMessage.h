#pragma once

#include <optional>
#include <string>

#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/RoutedMessage.h"
#include "messagelibrary/json/JsonReaders.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagCurrentValueMessages {

// Names the tags whose aggregates are to be reset.
class TagCvResetAggregatesRoutedMessage : public MessageBus::RoutedMessage {
public:
    inline static const std::string kMessageName = "TagCvResetAggregatesRoutedMessage";

    explicit TagCvResetAggregatesRoutedMessage(std::optional<JsonStringList> paths);
    // Parses a received body.
    TagCvResetAggregatesRoutedMessage(MessageBus::MessageHeaders headers,
                                      const MessageBus::MessageBody& body);

    const std::optional<JsonStringList>& Paths() const { return paths_; }

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("paths", self.paths_);
    }

    std::optional<JsonStringList> paths_;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagCurrentValueMessages
