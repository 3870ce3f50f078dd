#pragma once

#include <cstddef>
#include <cstdlib>
#include <cstring>
#include <memory>
#include <new>
#include <string>
#include <utility>

namespace Korvane::Veldra::VeldraMessageLibrary {

// The text a JSON writer writes into: a buffer of its own that grows
// geometrically and is written through a cursor, so that a field costs one
// check of the room left rather than one per character or piece. Take() hands
// the text out as a string.
class JsonOutput {
public:
    JsonOutput() = default;
    explicit JsonOutput(std::size_t reserve) { Grow(reserve); }
    JsonOutput(const JsonOutput&) = delete;
    JsonOutput& operator=(const JsonOutput&) = delete;

    // Where the next byte goes, with room for at least n bytes from there.
    // Write at most n bytes, then Advance to the end of what was written.
    char* Room(std::size_t n) {
        if (static_cast<std::size_t>(end_ - next_) < n) Grow(n);
        return next_;
    }
    void Advance(char* to) { next_ = to; }

    void Put(char c) {
        *Room(1) = c;
        ++next_;
    }
    void Append(const char* data, std::size_t size) {
        char* at = Room(size);
        if (size != 0) std::memcpy(at, data, size);
        next_ = at + size;
    }
    void Append(const char* text) { Append(text, std::strlen(text)); }

    std::size_t Size() const { return static_cast<std::size_t>(next_ - data_.get()); }
    // The text written so far; the output is empty afterwards.
    std::string Take() {
        std::string text(data_.get(), Size());
        data_.reset();
        next_ = end_ = nullptr;
        return text;
    }

private:
    struct Free {
        void operator()(char* data) const { std::free(data); }
    };

    // Not zero-filled, and moved in place by realloc where it can be.
    void Grow(std::size_t n) {
        const std::size_t used = Size();
        const std::size_t capacity = static_cast<std::size_t>(end_ - data_.get());
        std::size_t size = capacity < 256 ? 256 : capacity * 2;
        if (size < used + n) size = used + n;
        char* grown = static_cast<char*>(std::realloc(data_.get(), size));
        if (grown == nullptr) throw std::bad_alloc();
        data_.release();
        data_.reset(grown);
        next_ = grown + used;
        end_ = grown + size;
    }

    std::unique_ptr<char, Free> data_;
    char* next_ = nullptr;
    char* end_ = nullptr;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary
