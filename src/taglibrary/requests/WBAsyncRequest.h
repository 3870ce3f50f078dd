#pragma once

#include "taglibrary/requests/AsyncRequest.h"
#include "taglibrary/requests/WBDynamicSignal.h"

namespace Korvane::Veldra::TagLibrary {

// The request of the host family: the reply fires a host signal, on which
// the host waits by its own means.
class WBAsyncRequest : public AsyncRequest {
public:
    // Allocates the signal.
    WBAsyncRequest();

    // False when the host no longer takes the signal.
    bool Complete(std::shared_ptr<GenericMessage> reply) override;
    // The number that the host waits on.
    uint32_t SignalNumber() const { return signal_->Number(); }

private:
    const kvsup::wb::WBDynamicSignalPtr signal_;
};

}  // namespace Korvane::Veldra::TagLibrary
