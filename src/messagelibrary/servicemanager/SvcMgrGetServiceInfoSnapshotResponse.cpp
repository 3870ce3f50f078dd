#include "messagelibrary/servicemanager/SvcMgrGetServiceInfoSnapshotResponse.h"

#include <optional>
#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"

namespace Korvane::Veldra::VeldraMessageLibrary::ServiceManagerMessages {

SvcMgrGetServiceInfoSnapshotResponse::SvcMgrGetServiceInfoSnapshotResponse(
    const MessageBus::Interfaces::IRoutingSource& request,
    std::optional<std::vector<ServiceInfo>> services)
    : MessageBus::ResponseMessage(kMessageName, MessageBus::kJsonContentType, request.ReplyTo()),
      services_(std::move(services)) {
    AnswerTo(request, std::nullopt);
}

SvcMgrGetServiceInfoSnapshotResponse::SvcMgrGetServiceInfoSnapshotResponse(
    const MessageBus::Interfaces::IRoutingSource& request, const MessageBus::MessageError& error)
    : MessageBus::ResponseMessage(kMessageName, MessageBus::kJsonContentType, request.ReplyTo()) {
    AnswerTo(request, error);
}

SvcMgrGetServiceInfoSnapshotResponse::SvcMgrGetServiceInfoSnapshotResponse(
    MessageBus::MessageHeaders headers, const MessageBus::MessageBody& body)
    : MessageBus::ResponseMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody SvcMgrGetServiceInfoSnapshotResponse::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::ServiceManagerMessages
