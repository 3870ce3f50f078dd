#pragma once

#include "messagebus/interfaces/IPublishCallback.h"

namespace Korvane::Veldra::MessageBus {

class MessagePublisher;

// Publishes through a MessagePublisher, which must outlive it; handed to
// components that send on a service's behalf.
class PublishMessageCallback : public Interfaces::IPublishCallback {
public:
    explicit PublishMessageCallback(MessagePublisher* publisher) : Publisher(publisher) {}

    void Publish(MessageBase& message, bool mandatory) override;

private:
    MessagePublisher* const Publisher;
};

}  // namespace Korvane::Veldra::MessageBus
