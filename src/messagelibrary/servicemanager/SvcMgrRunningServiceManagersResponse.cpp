#include "messagelibrary/servicemanager/SvcMgrRunningServiceManagersResponse.h"

#include <optional>
#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"

namespace Korvane::Veldra::VeldraMessageLibrary::ServiceManagerMessages {

SvcMgrRunningServiceManagersResponse::SvcMgrRunningServiceManagersResponse(
    const MessageBus::Interfaces::IRoutingSource& request,
    std::optional<std::vector<ServiceManagerNode>> nodes)
    : MessageBus::ResponseMessage(kMessageName, MessageBus::kJsonContentType, request.ReplyTo()),
      nodes_(std::move(nodes)) {
    AnswerTo(request, std::nullopt);
}

SvcMgrRunningServiceManagersResponse::SvcMgrRunningServiceManagersResponse(
    const MessageBus::Interfaces::IRoutingSource& request, const MessageBus::MessageError& error)
    : MessageBus::ResponseMessage(kMessageName, MessageBus::kJsonContentType, request.ReplyTo()) {
    AnswerTo(request, error);
}

SvcMgrRunningServiceManagersResponse::SvcMgrRunningServiceManagersResponse(
    MessageBus::MessageHeaders headers, const MessageBus::MessageBody& body)
    : MessageBus::ResponseMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody SvcMgrRunningServiceManagersResponse::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::ServiceManagerMessages
