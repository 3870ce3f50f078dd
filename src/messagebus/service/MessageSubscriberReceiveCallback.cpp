#include "messagebus/service/MessageSubscriberReceiveCallback.h"

#include <utility>

#include "messagebus/service/MessageSubscriber.h"

namespace Korvane::Veldra::MessageBus {

void MessageSubscriberReceiveCallback::MessageReceived(std::shared_ptr<GenericMessage> message) {
    Subscriber->MessageReceived(std::move(message));
}

void MessageSubscriberReceiveCallback::PublishFailed(const ResetEvent& event) {
    Subscriber->PublishFailed(event);
}

}  // namespace Korvane::Veldra::MessageBus
