#pragma once

#include <string>

namespace Korvane::Veldra::VeldraMessageLibrary::ConfigurationMessages {

// The service that holds configuration sections and their keys.
inline const std::string kConfigurationService = "Configuration";

}  // namespace Korvane::Veldra::VeldraMessageLibrary::ConfigurationMessages
