#pragma once

#include <optional>
#include <string>
#include <vector>

#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/RequestMessage.h"
#include "messagelibrary/TagRecords.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagInfoMessages {

// Creates or changes tags: each entry pairs a tag with the parts of its
// metadata to change; merge holds for the whole request.
class TagInfoCreateOrUpdateTagsRequest : public MessageBus::RequestMessage {
public:
    inline static const std::string kMessageName = "TagInfoCreateOrUpdateTagsRequest";

    TagInfoCreateOrUpdateTagsRequest(std::optional<std::vector<TagChange>> tags, bool merge);
    // Parses a received body.
    TagInfoCreateOrUpdateTagsRequest(MessageBus::MessageHeaders headers,
                                     const MessageBus::MessageBody& body);

    const std::optional<std::vector<TagChange>>& Tags() const { return tags_; }
    bool Merge() const { return merge_; }

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("tags", self.tags_).Field("merge", self.merge_);
    }

    std::optional<std::vector<TagChange>> tags_;
    bool merge_ = false;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagInfoMessages
