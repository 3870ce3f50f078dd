#pragma once

#include <string>

namespace Korvane::Veldra::VeldraMessageLibrary::TraceLoggerMessages {

// The service that takes the trace logger's requests and routed messages.
inline const std::string kTraceLoggerService = "TraceLogger";

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TraceLoggerMessages
