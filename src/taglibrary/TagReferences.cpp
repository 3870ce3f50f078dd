#include "taglibrary/TagReferences.h"

#include <mutex>
#include <stdexcept>
#include <unordered_set>

#include "utilities/NoDestructor.h"

namespace Korvane::Veldra::TagLibrary {
namespace {

// The set of live numbers, and the next number to try. A wrapping counter
// keeps a number that was just released from being reused at once.
struct ReferencePool {
    std::mutex mutex;
    std::unordered_set<uint32_t> live;
    uint32_t next = 1;
};

ReferencePool& Pool() {
    static VeldraUtilities::NoDestructor<ReferencePool> pool;  // outlives every TagData
    return pool.Get();
}

}  // namespace

uint32_t TagReferences::Acquire() {
    auto& pool = Pool();
    std::lock_guard<std::mutex> lock(pool.mutex);
    if (pool.live.size() >= 0xFFFFFFFEu) throw std::length_error("no free tag reference");
    for (;;) {
        const uint32_t candidate = pool.next++;
        if (pool.next == 0) pool.next = 1;
        if (candidate != 0 && pool.live.insert(candidate).second) return candidate;
    }
}

void TagReferences::Release(uint32_t reference) {
    auto& pool = Pool();
    std::lock_guard<std::mutex> lock(pool.mutex);
    pool.live.erase(reference);
}

}  // namespace Korvane::Veldra::TagLibrary
