#include "messagelibrary/tagsubscription/TagSubscriptionCommunicatorMessageWrapperRequest.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/TagServices.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagSubscriptionCommunicatorMessages {

TagSubscriptionCommunicatorMessageWrapperRequest::TagSubscriptionCommunicatorMessageWrapperRequest(
    MessageBus::MessageBody body)
    : MessageBus::RequestMessage(kMessageName, MessageBus::kJsonContentType,
                                 kTagSubscriptionCommunicatorService),
      body_(std::move(body)) {}

TagSubscriptionCommunicatorMessageWrapperRequest::TagSubscriptionCommunicatorMessageWrapperRequest(
    MessageBus::MessageHeaders headers, const MessageBus::MessageBody& body)
    : MessageBus::RequestMessage(std::move(headers)), body_(body) {}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagSubscriptionCommunicatorMessages
