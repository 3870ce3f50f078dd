#include "messagelibrary/servicemanager/SvcMgrGetServiceGroupsResponse.h"

#include <optional>
#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"

namespace Korvane::Veldra::VeldraMessageLibrary::ServiceManagerMessages {

SvcMgrGetServiceGroupsResponse::SvcMgrGetServiceGroupsResponse(
    const MessageBus::Interfaces::IRoutingSource& request,
    std::optional<std::vector<ServiceGroup>> groups)
    : MessageBus::ResponseMessage(kMessageName, MessageBus::kJsonContentType, request.ReplyTo()),
      groups_(std::move(groups)) {
    AnswerTo(request, std::nullopt);
}

SvcMgrGetServiceGroupsResponse::SvcMgrGetServiceGroupsResponse(
    const MessageBus::Interfaces::IRoutingSource& request, const MessageBus::MessageError& error)
    : MessageBus::ResponseMessage(kMessageName, MessageBus::kJsonContentType, request.ReplyTo()) {
    AnswerTo(request, error);
}

SvcMgrGetServiceGroupsResponse::SvcMgrGetServiceGroupsResponse(MessageBus::MessageHeaders headers,
                                                               const MessageBus::MessageBody& body)
    : MessageBus::ResponseMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody SvcMgrGetServiceGroupsResponse::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::ServiceManagerMessages
