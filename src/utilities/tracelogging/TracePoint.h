#pragma once

#include <string>
#include <utility>

namespace Korvane::Veldra::MessageBus {

// A named switch for trace entries. The TraceLogger service sets the two
// texts; until it does they read "<unset>".
struct TracePoint {
    static constexpr const char* kUnset = "<unset>";

    TracePoint() = default;
    // A disabled point of that full name.
    explicit TracePoint(std::string fullName) : name(std::move(fullName)) {}

    bool enabled = false;
    // Module name, ".", point name.
    std::string name;
    std::string exceptions = kUnset;
    std::string times = kUnset;
};

}  // namespace Korvane::Veldra::MessageBus
