#pragma once

#include <memory>
#include <string>

#include "messagebus/interfaces/IMessageSubscriberReceiveCallback.h"

namespace Korvane::Veldra::MessageBus {

class MessageSubscriber;

// What each consumer of a subscriber hands its messages and return notices
// to; it passes them on to the subscriber, which outlives its consumers.
class MessageSubscriberReceiveCallback : public Interfaces::IMessageSubscriberReceiveCallback {
public:
    explicit MessageSubscriberReceiveCallback(MessageSubscriber* subscriber)
        : Subscriber(subscriber) {}

    void MessageReceived(std::shared_ptr<GenericMessage> message) override;
    void PublishFailed(const ResetEvent& event) override;
    bool TakesAnyOnReader() override;
    bool MayTakeOnReader(const std::string& correlationId,
                         const std::string& messageType) override;
    bool TakeOnReader(const std::shared_ptr<GenericMessage>& message) override;

private:
    MessageSubscriber* const Subscriber;
};

}  // namespace Korvane::Veldra::MessageBus
