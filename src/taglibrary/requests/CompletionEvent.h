#pragma once

#include <condition_variable>
#include <cstdint>
#include <mutex>

namespace Korvane::Veldra::TagLibrary {

// An event that a bus thread sets and a caller waits on, timed on the
// monotonic clock. A manual-reset event stays set; an auto-reset one is
// cleared by the wait that sees it.
class CompletionEvent {
public:
    static constexpr uint32_t kInfinite = 0xFFFFFFFFu;

    CompletionEvent(bool manualReset, bool signaled)
        : manualReset_(manualReset), signaled_(signaled) {}

    void Set();
    // 0 tests without blocking; kInfinite waits without limit. True when the
    // event was set.
    bool Wait(uint32_t timeoutMs);

private:
    std::mutex mutex_;
    std::condition_variable changed_;
    const bool manualReset_;
    bool signaled_;
};

}  // namespace Korvane::Veldra::TagLibrary
