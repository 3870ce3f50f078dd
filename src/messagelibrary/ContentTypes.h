#pragma once

#include <string>

namespace Korvane::Veldra::MessageBus {

// The content type of JSON message bodies.
inline const std::string kJsonContentType = "application/json";

// The content type of opaque bodies, which carry their metadata in the headers.
inline const std::string kOctetStreamContentType = "application/octet-stream";

}  // namespace Korvane::Veldra::MessageBus
