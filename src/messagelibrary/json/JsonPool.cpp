#include "messagelibrary/json/JsonPool.h"

#include <algorithm>
#include <new>

namespace Korvane::Veldra::VeldraMessageLibrary {
namespace {

constexpr std::size_t kSmallestChunk = 512;
// Chunks stay below the size at which the C library maps memory of its own,
// so that a chunk given back is at hand for the next document.
constexpr std::size_t kLargestChunk = 64 * 1024;

}  // namespace

JsonPool::JsonPool(std::size_t expectedBytes)
    : nextChunk_(std::clamp(expectedBytes * 2, kSmallestChunk, kLargestChunk)) {}

JsonPool::~JsonPool() {
    while (last_ != nullptr) {
        Chunk* previous = last_->previous;
        ::operator delete(last_);
        last_ = previous;
    }
}

void JsonPool::Grow(std::size_t size) {
    const std::size_t bytes = std::max(size, nextChunk_);
    auto* chunk = static_cast<Chunk*>(::operator new(sizeof(Chunk) + bytes));
    chunk->previous = last_;
    last_ = chunk;
    next_ = reinterpret_cast<char*>(chunk + 1);
    end_ = next_ + bytes;
    nextChunk_ = kLargestChunk;
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary
