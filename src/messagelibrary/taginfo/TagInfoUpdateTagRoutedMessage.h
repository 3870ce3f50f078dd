#pragma once

#include <optional>
#include <string>

#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/RoutedMessage.h"
#include "messagelibrary/TagEnums.h"
#include "messagelibrary/json/JsonReaders.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagInfoMessages {

// Changes one tag's metadata. An unset collectAggregates leaves the flag as
// it is; replace is a plain flag beside the new keywords and properties.
class TagInfoUpdateTagRoutedMessage : public MessageBus::RoutedMessage {
public:
    inline static const std::string kMessageName = "TagInfoUpdateTagRoutedMessage";

    TagInfoUpdateTagRoutedMessage(std::optional<std::string> path,
                                  std::optional<JsonStringList> keywords,
                                  std::optional<JsonStringMap> properties,
                                  std::optional<CollectAggregatesChange> collectAggregates,
                                  bool replace);
    // Parses a received body.
    TagInfoUpdateTagRoutedMessage(MessageBus::MessageHeaders headers,
                                  const MessageBus::MessageBody& body);

    const std::optional<std::string>& Path() const { return path_; }
    const std::optional<JsonStringList>& Keywords() const { return keywords_; }
    const std::optional<JsonStringMap>& Properties() const { return properties_; }
    const std::optional<CollectAggregatesChange>& CollectAggregates() const {
        return collectAggregates_;
    }
    bool Replace() const { return replace_; }

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("path", self.path_)
            .Field("keywords", self.keywords_)
            .Field("properties", self.properties_)
            .Field("collectAggregates", self.collectAggregates_)
            .Field("replace", self.replace_);
    }

    std::optional<std::string> path_;
    std::optional<JsonStringList> keywords_;
    std::optional<JsonStringMap> properties_;
    std::optional<CollectAggregatesChange> collectAggregates_;
    bool replace_ = false;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagInfoMessages
