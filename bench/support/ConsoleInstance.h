#pragma once

#include <cstdint>
#include <string>

namespace Korvane::Veldra::Bench {

// The console family reserved and one instance initialized; the instance is
// closed and the reservation given back when the object goes. Instance 0
// takes the fixed settings; another id the configuration given (the
// library's default when empty).
class ConsoleInstance {
public:
    explicit ConsoleInstance(uint64_t id, const std::string& configuration = std::string());
    ~ConsoleInstance();
    ConsoleInstance(const ConsoleInstance&) = delete;
    ConsoleInstance& operator=(const ConsoleInstance&) = delete;

    uint64_t Id() const { return id_; }
    // Why the set-up failed; empty when it did not.
    const std::string& Error() const { return error_; }

private:
    const uint64_t id_;
    bool reserved_ = false;
    std::string error_;
};

}  // namespace Korvane::Veldra::Bench
