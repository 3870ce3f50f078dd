#pragma once

#include <chrono>
#include <string>

#include "kvveldra/TagConsole.h"

namespace Korvane::Veldra::Bench {

// count Double values for one console write ("0.5", "1.5", ...), a
// microsecond apart from now on.
inline TagConsoleSamples DoubleSamples(int count) {
    TagConsoleSamples samples;
    samples.reserve(static_cast<size_t>(count));
    const auto now =
        std::chrono::time_point_cast<std::chrono::microseconds>(std::chrono::system_clock::now());
    for (int i = 0; i < count; ++i) {
        samples.push_back({std::to_string(i) + ".5", now + std::chrono::microseconds(i)});
    }
    return samples;
}

}  // namespace Korvane::Veldra::Bench
