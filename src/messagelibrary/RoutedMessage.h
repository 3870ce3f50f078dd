#pragma once

#include <string>
#include <utility>

#include "messagelibrary/MessageBase.h"

namespace Korvane::Veldra::MessageBus {

// A one-way message to a service, or to a queue the caller names. It asks for
// no response: "IgnoreResponse" is set until the sender clears it.
class RoutedMessage : public MessageBase {
public:
    RoutedMessage(const std::string& messageType, const std::string& contentType,
                  const std::string& target)
        : MessageBase(messageType, contentType, target) {
        SetIgnoreResponse(true);
    }
    explicit RoutedMessage(MessageHeaders headers) : MessageBase(std::move(headers)) {}
};

}  // namespace Korvane::Veldra::MessageBus
