#pragma once

#include <optional>
#include <string>
#include <vector>

#include "messagebus/interfaces/IRoutingSource.h"
#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/RoutedMessage.h"
#include "messagelibrary/taghistorian/HistorianRecords.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagHistorianMessages {

// Tells the sender of a background query that its jobs are done.
// Sent to the reply queue of the request named at construction, with a
// correlation id of its own.
class TagHistorianAsyncQueryCompleteRoutedMessage : public MessageBus::RoutedMessage {
public:
    inline static const std::string kMessageName = "TagHistorianAsyncQueryCompleteRoutedMessage";

    TagHistorianAsyncQueryCompleteRoutedMessage(
        const MessageBus::Interfaces::IRoutingSource& request,
        std::optional<std::vector<HistorianQueryJob>> queryJobs);
    // Parses a received body.
    TagHistorianAsyncQueryCompleteRoutedMessage(MessageBus::MessageHeaders headers,
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
