#pragma once

#include <optional>
#include <string>
#include <vector>

#include "messagebus/interfaces/IRoutingSource.h"
#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageError.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/ResponseMessage.h"
#include "messagelibrary/taghistorian/HistorianRecords.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagHistorianMessages {

// The jobs started for the queries of a background query.
class TagHistorianAsyncQueryResponse : public MessageBus::ResponseMessage {
public:
    inline static const std::string kMessageName = "TagHistorianAsyncQueryResponse";

    TagHistorianAsyncQueryResponse(const MessageBus::Interfaces::IRoutingSource& request,
                                   std::optional<std::vector<HistorianQueryJob>> queryJobs);
    // An error response: the fields stay unset.
    TagHistorianAsyncQueryResponse(const MessageBus::Interfaces::IRoutingSource& request,
                                   const MessageBus::MessageError& error);
    // Parses a received body.
    TagHistorianAsyncQueryResponse(MessageBus::MessageHeaders headers,
                                   const MessageBus::MessageBody& body);

    const std::optional<std::vector<HistorianQueryJob>>& QueryJobs() const { return queryJobs_; }

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("queryJobs", self.queryJobs_);
    }

    std::optional<std::vector<HistorianQueryJob>> queryJobs_;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagHistorianMessages
