#pragma once

#include <algorithm>
#include <cstdint>

namespace Korvane::Veldra::MessageBus {

// The pauses of a retry loop: the first pause, then twice the last one, up to
// a cap. A loop that succeeds calls Reset, so that the next failure is tried
// again soon. Without it a failure that comes at once (a refused connection,
// a name that does not resolve, a broker that closes a channel) would turn
// its loop into a busy one.
class Backoff {
public:
    static constexpr uint32_t kFirstMs = 100;
    static constexpr uint32_t kLongestMs = 5000;

    explicit Backoff(uint32_t firstMs = kFirstMs, uint32_t longestMs = kLongestMs)
        : firstMs_(std::max<uint32_t>(firstMs, 1)),
          longestMs_(std::max(longestMs, firstMs_)),
          nextMs_(firstMs_) {}

    // The pause to make now; the next one doubles, up to the cap.
    uint32_t NextMs() {
        const uint32_t pause = nextMs_;
        nextMs_ = nextMs_ >= longestMs_ / 2 ? longestMs_ : nextMs_ * 2;
        return pause;
    }

    void Reset() { nextMs_ = firstMs_; }

private:
    const uint32_t firstMs_;
    const uint32_t longestMs_;
    uint32_t nextMs_;
};

}  // namespace Korvane::Veldra::MessageBus
