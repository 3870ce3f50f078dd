#pragma once

#include <chrono>
#include <thread>

namespace Korvane::Veldra::Testing {

// Yields until condition() holds or bound has passed, and says which. For
// state that offers nothing to wait on (a count of blocked threads, say);
// the bound makes a fault fail the test instead of hanging it.
template <typename Condition>
bool SpinUntil(Condition condition,
               std::chrono::milliseconds bound = std::chrono::milliseconds(10000)) {
    const auto deadline = std::chrono::steady_clock::now() + bound;
    while (!condition()) {
        if (std::chrono::steady_clock::now() >= deadline) return false;
        std::this_thread::yield();
    }
    return true;
}

}  // namespace Korvane::Veldra::Testing
