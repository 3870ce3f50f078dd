#pragma once

#include <cstdint>
#include <string>

namespace kvveldra_python {

// Raises the kvveldra.Error (or subclass, kvveldra/_errors.py) of a status
// that is not 0, with the library's text; a status of 1, which has no text,
// reads "nothing to act on". Call with the GIL held.
[[noreturn]] void RaiseStatus(int32_t status, const std::string& text);
inline void CheckStatus(int32_t status, const std::string& text) {
    if (status != 0) RaiseStatus(status, text);
}

// Raises kvveldra.ClosedError with the text.
[[noreturn]] void RaiseClosed(const std::string& text);

// The library's code for a tag the service does not have.
constexpr int32_t kNoSuchTag = -251909;

}  // namespace kvveldra_python
