#pragma once

#include <memory>

#include "messagelibrary/GenericMessage.h"

namespace Korvane::Veldra::MessageBus::Interfaces {

// Receives the messages registered under a name: broadcasts, requests to a
// service, and whatever else nobody else took. Runs on a bus thread.
class IBroadcastCallback {
public:
    virtual void OnMessage(std::shared_ptr<GenericMessage> message) = 0;
    virtual ~IBroadcastCallback() = default;
};

}  // namespace Korvane::Veldra::MessageBus::Interfaces
