#include "messagelibrary/taghistorian/TagHistorianQueryRequest.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/TagServices.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagHistorianMessages {

TagHistorianQueryRequest::TagHistorianQueryRequest(std::optional<JsonStringList> paths,
                                                   Timestamp startTime, Timestamp endTime,
                                                   int32_t skip, int32_t take, int32_t decimation,
                                                   std::optional<HistorianSortOrder> sortOrder)
    : MessageBus::RequestMessage(kMessageName, MessageBus::kJsonContentType, kTagHistorianService),
      paths_(std::move(paths)),
      startTime_(startTime),
      endTime_(endTime),
      skip_(skip),
      take_(take),
      decimation_(decimation),
      sortOrder_(std::move(sortOrder)) {}

TagHistorianQueryRequest::TagHistorianQueryRequest(MessageBus::MessageHeaders headers,
                                                   const MessageBus::MessageBody& body)
    : MessageBus::RequestMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody TagHistorianQueryRequest::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagHistorianMessages
