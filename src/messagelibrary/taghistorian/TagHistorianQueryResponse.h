#pragma once

#include <optional>
#include <string>

#include "messagebus/interfaces/IRoutingSource.h"
#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageError.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/ResponseMessage.h"
#include "messagelibrary/taghistorian/HistorianRecords.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagHistorianMessages {

// The stored values a query found, by path.
class TagHistorianQueryResponse : public MessageBus::ResponseMessage {
public:
    inline static const std::string kMessageName = "TagHistorianQueryResponse";

    TagHistorianQueryResponse(const MessageBus::Interfaces::IRoutingSource& request,
                              std::optional<HistorianValues> tagHistorianValues);
    // An error response: the fields stay unset.
    TagHistorianQueryResponse(const MessageBus::Interfaces::IRoutingSource& request,
                              const MessageBus::MessageError& error);
    // Parses a received body.
    TagHistorianQueryResponse(MessageBus::MessageHeaders headers,
                              const MessageBus::MessageBody& body);

    const std::optional<HistorianValues>& TagHistorianValues() const { return tagHistorianValues_; }

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("tagHistorianValues", self.tagHistorianValues_);
    }

    std::optional<HistorianValues> tagHistorianValues_;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagHistorianMessages
