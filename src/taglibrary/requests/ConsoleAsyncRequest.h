#pragma once

#include "taglibrary/requests/AsyncRequest.h"
#include "taglibrary/requests/CompletionEvent.h"

namespace Korvane::Veldra::TagLibrary {

// The request of the blocking console family: the caller waits on an event.
class ConsoleAsyncRequest : public AsyncRequest {
public:
    ConsoleAsyncRequest() : completed_(true, false) {}

    bool Complete(std::shared_ptr<GenericMessage> reply) override;
    bool CallerWaits() const override { return true; }
    // Waits for the reply. The outcome is of no use to the caller: the finish
    // half sees whether a reply came.
    void Wait(uint32_t timeoutMs) { completed_.Wait(timeoutMs); }

private:
    CompletionEvent completed_;
};

}  // namespace Korvane::Veldra::TagLibrary
