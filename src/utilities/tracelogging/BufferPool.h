#pragma once

#include <cstddef>
#include <mutex>
#include <vector>

#include "messagelibrary/tracelogger/TraceLoggerRecords.h"

namespace Korvane::Veldra::VeldraUtilities::TraceLogging {

using TraceEntry = VeldraMessageLibrary::TraceLoggerMessages::TraceEntry;
using TraceEntryBuffer = std::vector<TraceEntry>;

// Free entry vectors kept for reuse: a vector that comes back keeps its
// capacity, so a rotation of the current buffer does not allocate.
class BufferPool {
public:
    explicit BufferPool(std::size_t bufferCapacity) : capacity_(bufferCapacity) {}
    BufferPool(const BufferPool&) = delete;
    BufferPool& operator=(const BufferPool&) = delete;

    // An empty vector with room for the capacity.
    TraceEntryBuffer Take();
    // Clears the vector and keeps it for the next Take.
    void Return(TraceEntryBuffer buffer);
    std::size_t FreeCount() const;

private:
    const std::size_t capacity_;
    mutable std::mutex mutex_;
    std::vector<TraceEntryBuffer> free_;
};

}  // namespace Korvane::Veldra::VeldraUtilities::TraceLogging
