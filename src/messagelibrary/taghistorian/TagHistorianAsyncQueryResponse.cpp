#include "messagelibrary/taghistorian/TagHistorianAsyncQueryResponse.h"

#include <optional>
#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagHistorianMessages {

TagHistorianAsyncQueryResponse::TagHistorianAsyncQueryResponse(
    const MessageBus::Interfaces::IRoutingSource& request,
    std::optional<std::vector<HistorianQueryJob>> queryJobs)
    : MessageBus::ResponseMessage(kMessageName, MessageBus::kJsonContentType, request.ReplyTo()),
      queryJobs_(std::move(queryJobs)) {
    AnswerTo(request, std::nullopt);
}

TagHistorianAsyncQueryResponse::TagHistorianAsyncQueryResponse(
    const MessageBus::Interfaces::IRoutingSource& request, const MessageBus::MessageError& error)
    : MessageBus::ResponseMessage(kMessageName, MessageBus::kJsonContentType, request.ReplyTo()) {
    AnswerTo(request, error);
}

TagHistorianAsyncQueryResponse::TagHistorianAsyncQueryResponse(MessageBus::MessageHeaders headers,
                                                               const MessageBus::MessageBody& body)
    : MessageBus::ResponseMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody TagHistorianAsyncQueryResponse::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagHistorianMessages
