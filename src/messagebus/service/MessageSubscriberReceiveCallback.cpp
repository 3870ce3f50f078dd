#include "messagebus/service/MessageSubscriberReceiveCallback.h"

#include <utility>

#include "messagebus/service/MessageSubscriber.h"

namespace Korvane::Veldra::MessageBus {

void MessageSubscriberReceiveCallback::MessageReceived(std::shared_ptr<GenericMessage> message) {
    Subscriber->MessageReceived(std::move(message));
}

bool MessageSubscriberReceiveCallback::TakesAnyOnReader() {
    return Subscriber->TakesAnyOnReader();
}

bool MessageSubscriberReceiveCallback::MayTakeOnReader(const std::string& correlationId,
                                                       const std::string& messageType) {
    return Subscriber->MayTakeOnReader(correlationId, messageType);
}

bool MessageSubscriberReceiveCallback::TakeOnReader(const std::shared_ptr<GenericMessage>& message) {
    return Subscriber->TakeOnReader(message);
}

void MessageSubscriberReceiveCallback::PublishFailed(const ResetEvent& event) {
    Subscriber->PublishFailed(event);
}

}  // namespace Korvane::Veldra::MessageBus
