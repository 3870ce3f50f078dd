#pragma once

#include <cstdint>
#include <memory>
#include <string>

#include "errors/Errors.h"
#include "messagelibrary/GenericMessage.h"

namespace Korvane::Veldra::TagLibrary {

using MessageBus::GenericMessage;

// What stands between the start half and the finish half of a Client
// operation: a bus thread stores the reply and wakes the caller (Complete),
// the caller's finish reads what the reply means (CheckResult).
//
// `response` is written only under the mutex of the AsyncRequestMap while the
// request is filed, and read only after the finish took it out, so it needs
// no lock of its own.
class AsyncRequest {
public:
    virtual ~AsyncRequest() = default;

    // 0 for a reply without error. No reply: "Veldra.RequestTimedOut". An
    // error reply: the registered text of its name with its arguments.
    virtual int32_t CheckResult(const TagIngestion::Errors& errors, std::string& error);
    // Stores the reply and wakes whoever waits. Runs on a bus thread (the
    // consumer connection's reader, else the handling thread) with the map's
    // mutex held: must not block. False when nobody can be woken
    // any more, and the request is then dropped from the map.
    virtual bool Complete(std::shared_ptr<GenericMessage> reply) = 0;

    // True when the caller blocks until the reply or its time-out (the
    // console family): such a request may wait, within its time-out, for the
    // reply queue to be bound again before it is sent. A caller that must
    // never block gets an error at once instead.
    virtual bool CallerWaits() const { return false; }

    // The correlation id of the message sent, set before the request is
    // filed, so that its finish can drop a correlation entry left behind.
    void SetCorrelationId(std::string id) { correlationId_ = std::move(id); }
    const std::string& CorrelationId() const { return correlationId_; }

    void SetResponse(std::shared_ptr<GenericMessage> reply) { response_ = std::move(reply); }
    const std::shared_ptr<GenericMessage>& Response() const { return response_; }

private:
    std::shared_ptr<GenericMessage> response_;
    std::string correlationId_;
};

}  // namespace Korvane::Veldra::TagLibrary
