#pragma once

#include <string>

namespace Korvane::Veldra::MessageBus {

// "Veldra." + target + "." + messageType, or "Veldra." + messageType when the
// target is empty (every broadcast, and a response to a request without a
// reply queue).
std::string MakeRoutingKey(const std::string& target, const std::string& messageType);

}  // namespace Korvane::Veldra::MessageBus
