#pragma once

#include <cstddef>
#include <mutex>
#include <vector>

#include "messagelibrary/tracelogger/TraceLoggerRecords.h"

namespace Korvane::Veldra::VeldraUtilities::TraceLogging {

using TraceEntry = VeldraMessageLibrary::TraceLoggerMessages::TraceEntry;
using TraceEntryBuffer = std::vector<TraceEntry>;

// Entry vectors kept for reuse, entries included: a vector comes back with
// its capacity and with the entries it shipped, which the next writer
// overwrites, so that neither a rotation nor the strings of an entry
// allocate once the pool is warm.
class BufferPool {
public:
    explicit BufferPool(std::size_t bufferCapacity) : capacity_(bufferCapacity) {}
    BufferPool(const BufferPool&) = delete;
    BufferPool& operator=(const BufferPool&) = delete;

    // A vector with room for the capacity; its entries are stale, to be
    // written over.
    TraceEntryBuffer Take();
    // Keeps the vector, entries and all, for the next Take.
    void Return(TraceEntryBuffer buffer);
    std::size_t FreeCount() const;

private:
    const std::size_t capacity_;
    mutable std::mutex mutex_;
    std::vector<TraceEntryBuffer> free_;
};

}  // namespace Korvane::Veldra::VeldraUtilities::TraceLogging
