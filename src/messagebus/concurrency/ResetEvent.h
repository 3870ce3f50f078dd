#pragma once

#include <string>

namespace Korvane::Veldra::MessageBus {

// The notice of a message that the broker returned as undeliverable: the
// correlation id of the failed publish and the text to give its waiter.
struct ResetEvent {
    std::string CorrelationId;
    std::string Message;
};

}  // namespace Korvane::Veldra::MessageBus
