#pragma once

namespace Korvane::Veldra::MessageBus {

// Thrown by a body operation that a message class does not support:
// VeldraException(-251004, "Not implemented").
[[noreturn]] void ThrowNotImplemented();

}  // namespace Korvane::Veldra::MessageBus
