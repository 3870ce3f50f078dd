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

// Starts queries that run in the background; their values come later as
// routed messages to the reply queue.
class TagHistorianAsyncQueryRequest : public MessageBus::RequestMessage {
public:
    inline static const std::string kMessageName = "TagHistorianAsyncQueryRequest";

    explicit TagHistorianAsyncQueryRequest(std::optional<std::vector<HistorianQuery>> queries);
    // Parses a received body.
    TagHistorianAsyncQueryRequest(MessageBus::MessageHeaders headers,
                                  const MessageBus::MessageBody& body);

    const std::optional<std::vector<HistorianQuery>>& Queries() const { return queries_; }

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("queries", self.queries_);
    }

    std::optional<std::vector<HistorianQuery>> queries_;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagHistorianMessages
