#pragma once

#include <string>

namespace Korvane::Veldra::MessageBus::Interfaces {

// What a response needs to know of the message it answers.
class IRoutingSource {
public:
    virtual const std::string& CorrelationId() const = 0;
    // The "ReplyTo" header, or an empty text when it is absent.
    virtual const std::string& ReplyTo() const = 0;
    virtual ~IRoutingSource() = default;
};

}  // namespace Korvane::Veldra::MessageBus::Interfaces
