#pragma once

#include <string>

namespace Korvane::Veldra::VeldraMessageLibrary::HttpMessages {

// The service that carries HTTP requests over the bus.
inline const std::string kHttpService = "Http";

}  // namespace Korvane::Veldra::VeldraMessageLibrary::HttpMessages
