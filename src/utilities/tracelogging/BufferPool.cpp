#include "utilities/tracelogging/BufferPool.h"

#include <utility>

namespace Korvane::Veldra::VeldraUtilities::TraceLogging {

TraceEntryBuffer BufferPool::Take() {
    {
        std::lock_guard<std::mutex> lock(mutex_);
        if (!free_.empty()) {
            TraceEntryBuffer buffer = std::move(free_.back());
            free_.pop_back();
            return buffer;
        }
    }
    TraceEntryBuffer buffer;
    buffer.reserve(capacity_);
    return buffer;
}

void BufferPool::Return(TraceEntryBuffer buffer) {
    // A vector whose storage was lost on the way gets it back here, on the
    // returning thread, so that Take never allocates for the caller.
    buffer.reserve(capacity_);
    std::lock_guard<std::mutex> lock(mutex_);
    free_.push_back(std::move(buffer));
}

std::size_t BufferPool::FreeCount() const {
    std::lock_guard<std::mutex> lock(mutex_);
    return free_.size();
}

}  // namespace Korvane::Veldra::VeldraUtilities::TraceLogging
