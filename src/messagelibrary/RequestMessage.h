#pragma once

#include <string>
#include <utility>

#include "messagelibrary/MessageBase.h"

namespace Korvane::Veldra::MessageBus {

// A message that expects a response, sent to a service or to a queue the caller
// names.
class RequestMessage : public MessageBase {
public:
    RequestMessage(const std::string& messageType, const std::string& contentType,
                   const std::string& target)
        : MessageBase(messageType, contentType, target) {}
    explicit RequestMessage(MessageHeaders headers) : MessageBase(std::move(headers)) {}
};

}  // namespace Korvane::Veldra::MessageBus
