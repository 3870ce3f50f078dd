#pragma once

#include <string>

namespace Korvane::Veldra::MessageBus {

// A new random version 4 UUID in its 36-character lower-case text form.
std::string NewMessageId();

}  // namespace Korvane::Veldra::MessageBus
