#pragma once

#include <cstddef>
#include <string>

namespace Korvane::Veldra::VeldraMessageLibrary::Jsonz {

// Resolves the escapes of a string token (the raw characters between the
// quotes) one byte at a time. \uXXXX gives UTF-8, a surrogate pair one code
// point. A broken escape or a lone surrogate ends the sequence, as does
// \u0000: Next() then gives zero, like at the end of the input.
class JsonUnescaper {
public:
    JsonUnescaper(const char* raw, std::size_t length) noexcept : next_(raw), end_(raw + length) {}

    // The next byte, or zero when the sequence has ended.
    char Next() noexcept;
    // Whether the sequence has ended with the input consumed: not at a
    // failure, nor at an escaped zero with more input behind it.
    bool Complete() const noexcept { return ended_ && !failed_ && next_ == end_; }

private:
    void Fail() noexcept;
    bool DecodeEscape(char& first) noexcept;
    bool ReadHex4(unsigned& value) noexcept;

    const char* next_;
    const char* end_;
    char pending_[3] = {};
    int pendingCount_ = 0;
    int pendingNext_ = 0;
    bool ended_ = false;
    bool failed_ = false;
};

// Decodes a whole string token into out (replacing its content). When the
// sequence ends before the input does, the text is empty. Returns false only
// in that case.
bool UnescapeJsonString(const char* raw, std::size_t length, std::string& out);

// The same into a buffer of at least length bytes (decoding never makes the
// text longer), with the decoded length in count (0 when it ended early).
bool UnescapeJsonString(const char* raw, std::size_t length, char* out,
                        std::size_t& count) noexcept;

}  // namespace Korvane::Veldra::VeldraMessageLibrary::Jsonz
