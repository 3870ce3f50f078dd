#pragma once

#include <string>

namespace Korvane::Veldra::VeldraMessageLibrary::TimerMessages {

// The service that calls back registered timers.
inline const std::string kTimerService = "Timer";

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TimerMessages
