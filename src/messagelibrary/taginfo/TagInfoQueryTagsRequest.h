#pragma once

#include <cstdint>
#include <optional>
#include <string>

#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/RequestMessage.h"
#include "messagelibrary/json/JsonReaders.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagInfoMessages {

// Asks for tags. searchPaths, properties and keywords filter; skip and take
// page the result.
class TagInfoQueryTagsRequest : public MessageBus::RequestMessage {
public:
    inline static const std::string kMessageName = "TagInfoQueryTagsRequest";

    TagInfoQueryTagsRequest(std::optional<JsonStringList> searchPaths,
                            std::optional<JsonStringMap> properties,
                            std::optional<JsonStringList> keywords, int32_t skip, int32_t take,
                            bool allowStale);
    // Parses a received body.
    TagInfoQueryTagsRequest(MessageBus::MessageHeaders headers,
                            const MessageBus::MessageBody& body);

    const std::optional<JsonStringList>& SearchPaths() const { return searchPaths_; }
    const std::optional<JsonStringMap>& Properties() const { return properties_; }
    const std::optional<JsonStringList>& Keywords() const { return keywords_; }
    int32_t Skip() const { return skip_; }
    int32_t Take() const { return take_; }
    bool AllowStale() const { return allowStale_; }

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("searchPaths", self.searchPaths_)
            .Field("properties", self.properties_)
            .Field("keywords", self.keywords_)
            .Field("skip", self.skip_)
            .Field("take", self.take_)
            .Field("allowStale", self.allowStale_);
    }

    std::optional<JsonStringList> searchPaths_;
    std::optional<JsonStringMap> properties_;
    std::optional<JsonStringList> keywords_;
    int32_t skip_ = 0;
    int32_t take_ = 0;
    bool allowStale_ = false;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagInfoMessages
