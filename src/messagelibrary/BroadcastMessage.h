#pragma once

#include <string>
#include <utility>

#include "messagelibrary/MessageBase.h"

namespace Korvane::Veldra::MessageBus {

// A message to all who subscribe to its name; its routing key has no target.
class BroadcastMessage : public MessageBase {
public:
    BroadcastMessage(const std::string& messageType, const std::string& contentType,
                     const std::string& target = std::string())
        : MessageBase(messageType, contentType, target) {}
    explicit BroadcastMessage(MessageHeaders headers) : MessageBase(std::move(headers)) {}
};

}  // namespace Korvane::Veldra::MessageBus
