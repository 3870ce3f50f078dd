#pragma once

#include <optional>
#include <string>
#include <vector>

#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/RequestMessage.h"
#include "messagelibrary/taghistorian/HistorianRecords.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagHistorianMessages {

// Deletes the stored values of tags between two times.
class TagHistorianDeleteValuesByRangeRequest : public MessageBus::RequestMessage {
public:
    inline static const std::string kMessageName = "TagHistorianDeleteValuesByRangeRequest";

    explicit TagHistorianDeleteValuesByRangeRequest(
        std::optional<std::vector<HistorianDeleteRange>> ranges);
    // Parses a received body.
    TagHistorianDeleteValuesByRangeRequest(MessageBus::MessageHeaders headers,
                                           const MessageBus::MessageBody& body);

    const std::optional<std::vector<HistorianDeleteRange>>& Ranges() const { return ranges_; }

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("ranges", self.ranges_);
    }

    std::optional<std::vector<HistorianDeleteRange>> ranges_;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagHistorianMessages
