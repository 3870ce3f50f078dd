#pragma once

#include <cstddef>

namespace Korvane::Veldra::VeldraMessageLibrary {

// The storage of one parsed tree: memory handed out in order from chunks and
// given back all at once when the pool goes. The parser builds every node of a
// document in one pool, so that a message body costs a few allocations rather
// than one for each container and long text, and its release costs no walk
// over the tree.
class JsonPool {
public:
    // The first chunk is sized for a document of about this many bytes.
    explicit JsonPool(std::size_t expectedBytes);
    ~JsonPool();
    JsonPool(const JsonPool&) = delete;
    JsonPool& operator=(const JsonPool&) = delete;

    // size bytes, aligned to 8; throws std::bad_alloc.
    void* Allocate(std::size_t size) {
        size = (size + 7) & ~static_cast<std::size_t>(7);
        if (size > static_cast<std::size_t>(end_ - next_)) Grow(size);
        void* memory = next_;
        next_ += size;
        return memory;
    }

private:
    struct Chunk {
        Chunk* previous;
    };

    void Grow(std::size_t size);

    Chunk* last_ = nullptr;
    char* next_ = nullptr;
    char* end_ = nullptr;
    std::size_t nextChunk_;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary
