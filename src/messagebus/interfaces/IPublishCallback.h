#pragma once

#include "messagelibrary/MessageBase.h"

namespace Korvane::Veldra::MessageBus::Interfaces {

// Lets a component publish without knowing the service it publishes through.
// The message is stamped with the sender's "ReplyTo" and "Origin" on the way.
class IPublishCallback {
public:
    virtual void Publish(MessageBase& message, bool mandatory) = 0;
    virtual ~IPublishCallback() = default;
};

}  // namespace Korvane::Veldra::MessageBus::Interfaces
