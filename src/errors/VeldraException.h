#pragma once

#include <cstdint>
#include <stdexcept>
#include <string>

namespace Korvane::Veldra::MessageBus {

// The one exception class of the system: an English text made at the throw
// site and a code of the error registry.
class VeldraException : public std::runtime_error {
public:
    VeldraException(int32_t code, const std::string& message)
        : std::runtime_error(message), code_(code) {}
    ~VeldraException() override = default;

    int32_t Code() const noexcept { return code_; }

private:
    int32_t code_;
};

}  // namespace Korvane::Veldra::MessageBus
