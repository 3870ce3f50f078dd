#pragma once

#include <memory>
#include <string>

#include "messagebus/concurrency/ResetEvent.h"
#include "messagelibrary/GenericMessage.h"

namespace Korvane::Veldra::MessageBus::Interfaces {

// What a consumer hands its messages and the notices of returned publishes
// to. The first two run on the consumer's handling thread, one call at a time.
class IMessageSubscriberReceiveCallback {
public:
    virtual void MessageReceived(std::shared_ptr<GenericMessage> message) = 0;
    virtual void PublishFailed(const ResetEvent& event) = 0;

    // ---- On the connection's reader thread ----
    // True when a reply with this correlation id may have a taker that the
    // reader can serve itself: a caller waiting for it, or a response
    // callback that only completes a request.
    virtual bool MayTakeOnReader(const std::string& correlationId) {
        (void)correlationId;
        return false;
    }
    // Hands the message to such a taker; false when it has none (then the
    // message goes the handling thread's way).
    virtual bool TakeOnReader(const std::shared_ptr<GenericMessage>& message) {
        (void)message;
        return false;
    }
    virtual ~IMessageSubscriberReceiveCallback() = default;
};

}  // namespace Korvane::Veldra::MessageBus::Interfaces
