#pragma once

#include <memory>
#include <string>

#include "messagebus/interfaces/IBroadcastCallback.h"

namespace Korvane::Veldra::MessageBus::Interfaces {

// Lets a component subscribe to a message name without knowing the service
// that receives for it: binds the name on the service's queue and registers
// the handler.
class IRegisterBroadcastCallback {
public:
    virtual void RegisterBroadcast(const std::string& messageName,
                                   std::shared_ptr<IBroadcastCallback> callback) = 0;
    virtual ~IRegisterBroadcastCallback() = default;
};

}  // namespace Korvane::Veldra::MessageBus::Interfaces
