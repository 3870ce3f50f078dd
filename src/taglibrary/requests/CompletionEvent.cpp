#include "taglibrary/requests/CompletionEvent.h"

#include <chrono>

namespace Korvane::Veldra::TagLibrary {

void CompletionEvent::Set() {
    std::lock_guard<std::mutex> lock(mutex_);
    signaled_ = true;
    if (manualReset_) {
        changed_.notify_all();
    } else {
        changed_.notify_one();
    }
}

bool CompletionEvent::Wait(uint32_t timeoutMs) {
    std::unique_lock<std::mutex> lock(mutex_);
    bool set = signaled_;
    if (!set && timeoutMs == kInfinite) {
        changed_.wait(lock, [this] { return signaled_; });
        set = true;
    } else if (!set && timeoutMs != 0) {
        // steady_clock is the monotonic clock.
        const auto deadline =
            std::chrono::steady_clock::now() + std::chrono::milliseconds(timeoutMs);
        set = changed_.wait_until(lock, deadline, [this] { return signaled_; });
    }
    if (set && !manualReset_) signaled_ = false;
    return set;
}

}  // namespace Korvane::Veldra::TagLibrary
