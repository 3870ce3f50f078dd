#pragma once

#include <memory>

#include "messagebus/concurrency/ResetEvent.h"
#include "messagelibrary/GenericMessage.h"

namespace Korvane::Veldra::MessageBus::Interfaces {

// What a consumer hands its messages and the notices of returned publishes
// to. Both run on the consumer's handling thread, one call at a time.
class IMessageSubscriberReceiveCallback {
public:
    virtual void MessageReceived(std::shared_ptr<GenericMessage> message) = 0;
    virtual void PublishFailed(const ResetEvent& event) = 0;
    virtual ~IMessageSubscriberReceiveCallback() = default;
};

}  // namespace Korvane::Veldra::MessageBus::Interfaces
