#include "messagelibrary/tagsubscription/TagSubscriptionCommunicatorMessageWrapperResponse.h"

#include <optional>
#include <utility>

#include "messagelibrary/ContentTypes.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagSubscriptionCommunicatorMessages {

TagSubscriptionCommunicatorMessageWrapperResponse::
    TagSubscriptionCommunicatorMessageWrapperResponse(
        const MessageBus::Interfaces::IRoutingSource& request, MessageBus::MessageBody body)
    : MessageBus::ResponseMessage(kMessageName, MessageBus::kJsonContentType, request.ReplyTo()),
      body_(std::move(body)) {
    AnswerTo(request, std::nullopt);
}

TagSubscriptionCommunicatorMessageWrapperResponse::
    TagSubscriptionCommunicatorMessageWrapperResponse(
        const MessageBus::Interfaces::IRoutingSource& request,
        const MessageBus::MessageError& error)
    : MessageBus::ResponseMessage(kMessageName, MessageBus::kJsonContentType, request.ReplyTo()) {
    AnswerTo(request, error);
}

TagSubscriptionCommunicatorMessageWrapperResponse::
    TagSubscriptionCommunicatorMessageWrapperResponse(MessageBus::MessageHeaders headers,
                                                      const MessageBus::MessageBody& body)
    : MessageBus::ResponseMessage(std::move(headers)), body_(body) {}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagSubscriptionCommunicatorMessages
