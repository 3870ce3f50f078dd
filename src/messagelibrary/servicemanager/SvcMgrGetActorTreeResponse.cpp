#include "messagelibrary/servicemanager/SvcMgrGetActorTreeResponse.h"

#include <optional>
#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"

namespace Korvane::Veldra::VeldraMessageLibrary::ServiceManagerMessages {

SvcMgrGetActorTreeResponse::SvcMgrGetActorTreeResponse(
    const MessageBus::Interfaces::IRoutingSource& request, std::optional<std::string> nodeName,
    std::optional<JsonStringList> actorList)
    : MessageBus::ResponseMessage(kMessageName, MessageBus::kJsonContentType, request.ReplyTo()),
      nodeName_(std::move(nodeName)),
      actorList_(std::move(actorList)) {
    AnswerTo(request, std::nullopt);
}

SvcMgrGetActorTreeResponse::SvcMgrGetActorTreeResponse(
    const MessageBus::Interfaces::IRoutingSource& request, const MessageBus::MessageError& error)
    : MessageBus::ResponseMessage(kMessageName, MessageBus::kJsonContentType, request.ReplyTo()) {
    AnswerTo(request, error);
}

SvcMgrGetActorTreeResponse::SvcMgrGetActorTreeResponse(MessageBus::MessageHeaders headers,
                                                       const MessageBus::MessageBody& body)
    : MessageBus::ResponseMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody SvcMgrGetActorTreeResponse::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::ServiceManagerMessages
