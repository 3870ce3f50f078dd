#pragma once

#include <string>

namespace Korvane::Veldra::MessageBus {

// What a take does when it acquired a count but found no item: "End Of
// Stream." (Veldra.EndOfStream) on a closed queue, else the stored error text,
// which may be empty (Veldra.QueueEmpty). Every queue of the bus uses this.
[[noreturn]] void ThrowEmptyTake(bool closed, const std::string& errorText);

}  // namespace Korvane::Veldra::MessageBus
