#pragma once

#include <string>

namespace Korvane::Veldra::VeldraMessageLibrary::SmtpMessages {

// The service that sends e-mail and keeps its templates and address groups.
inline const std::string kSmtpService = "Smtp";

}  // namespace Korvane::Veldra::VeldraMessageLibrary::SmtpMessages
