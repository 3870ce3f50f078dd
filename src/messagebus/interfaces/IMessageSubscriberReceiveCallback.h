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
    // A look without locks before each delivery: false when no reply can
    // have a taker on the reader now, so the reader looks no further.
    virtual bool TakesAnyOnReader() { return false; }
    // True when a reply with this correlation id and message type may have a
    // taker that the reader can serve itself: a caller waiting for it, or a
    // response callback that only completes a request.
    virtual bool MayTakeOnReader(const std::string& correlationId, const std::string& messageType) {
        (void)correlationId;
        (void)messageType;
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
