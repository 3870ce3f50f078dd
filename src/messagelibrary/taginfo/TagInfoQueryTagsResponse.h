#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <vector>

#include "messagebus/interfaces/IRoutingSource.h"
#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageError.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/ResponseMessage.h"
#include "messagelibrary/TagRecords.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagInfoMessages {

// One page of tags, and the count of all that matched.
class TagInfoQueryTagsResponse : public MessageBus::ResponseMessage {
public:
    inline static const std::string kMessageName = "TagInfoQueryTagsResponse";

    TagInfoQueryTagsResponse(const MessageBus::Interfaces::IRoutingSource& request,
                             std::optional<std::vector<TagRecord>> tags, int32_t totalCount);
    // An error response: the fields stay unset.
    TagInfoQueryTagsResponse(const MessageBus::Interfaces::IRoutingSource& request,
                             const MessageBus::MessageError& error);
    // Parses a received body.
    TagInfoQueryTagsResponse(MessageBus::MessageHeaders headers,
                             const MessageBus::MessageBody& body);

    const std::optional<std::vector<TagRecord>>& Tags() const { return tags_; }
    int32_t TotalCount() const { return totalCount_; }

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("tags", self.tags_).Field("totalCount", self.totalCount_);
    }

    std::optional<std::vector<TagRecord>> tags_;
    int32_t totalCount_ = 0;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagInfoMessages
