#pragma once

#include <string>

namespace Korvane::Veldra::MessageBus {

// The content type of JSON message bodies.
inline const std::string kJsonContentType = "application/json";

}  // namespace Korvane::Veldra::MessageBus
