#include "messagelibrary/json/JsonEscape.h"

#include <array>
#include <cstdint>
#include <cstring>

namespace Korvane::Veldra::VeldraMessageLibrary {
namespace {

// For each byte: 0 when it passes as it stands, 'u' for a \u00XX escape,
// else the letter of its two-character escape.
constexpr std::array<char, 256> MakeEscapeTable() {
    std::array<char, 256> table{};
    for (int c = 0; c < 32; ++c) table[c] = 'u';
    table[127] = 'u';
    table['\b'] = 'b';
    table['\t'] = 't';
    table['\n'] = 'n';
    table['\f'] = 'f';
    table['\r'] = 'r';
    table['"'] = '"';
    table['\\'] = '\\';
    return table;
}

constexpr std::array<char, 256> kEscape = MakeEscapeTable();

char Escape(char c) noexcept {
    return kEscape[static_cast<unsigned char>(c)];
}

// The text up to its first zero byte.
std::string_view UpToZero(std::string_view text) noexcept {
    const void* zero = std::memchr(text.data(), '\0', text.size());
    if (zero == nullptr) return text;
    return text.substr(0, static_cast<std::size_t>(static_cast<const char*>(zero) - text.data()));
}

constexpr uint64_t kOnes = 0x0101010101010101ULL;
constexpr uint64_t kHighs = 0x8080808080808080ULL;

// Whether any of the eight bytes is below n (n at most 128).
constexpr uint64_t AnyBelow(uint64_t bytes, uint64_t n) noexcept {
    return (bytes - kOnes * n) & ~bytes & kHighs;
}
constexpr uint64_t AnyEqual(uint64_t bytes, unsigned char c) noexcept {
    return AnyBelow(bytes ^ (kOnes * c), 1);
}

// Whether none of the eight bytes needs an escape or ends the text.
inline __attribute__((always_inline)) bool AllPlain(uint64_t bytes) noexcept {
    // Below 32 covers the zero byte and every control character.
    return (AnyBelow(bytes, 32) | AnyEqual(bytes, '"') | AnyEqual(bytes, '\\') |
            AnyEqual(bytes, 127)) == 0;
}

}  // namespace

std::size_t JsonEscapedLength(std::string_view text) noexcept {
    std::size_t length = 0;
    for (const char c : text) {
        if (c == '\0') break;
        const char e = Escape(c);
        length += e == 0 ? 1 : (e == 'u' ? 6 : 2);
    }
    return length;
}

char* WriteJsonEscaped(char* out, std::string_view text) noexcept {
    static constexpr char kHex[] = "0123456789abcdef";
    // Eight plain bytes at a time, as they stand; the first piece with a
    // byte to escape, and the tail, byte by byte.
    const char* data = text.data();
    const std::size_t size = text.size();
    if (size >= 4 && size < 8) {
        // A short text (a key, mostly) as two overlapping halves.
        uint32_t first, last;
        std::memcpy(&first, data, sizeof(first));
        std::memcpy(&last, data + size - 4, sizeof(last));
        if (AllPlain(uint64_t{first} | uint64_t{last} << 32)) {
            std::memcpy(out, &first, sizeof(first));
            std::memcpy(out + size - 4, &last, sizeof(last));
            return out + size;
        }
    }
    std::size_t i = 0;
    for (; i + 8 <= size; i += 8) {
        uint64_t bytes;
        std::memcpy(&bytes, data + i, sizeof(bytes));
        if (!AllPlain(bytes)) break;
        std::memcpy(out, &bytes, sizeof(bytes));
        out += sizeof(bytes);
    }
    if (i + 8 > text.size() && i != text.size() && text.size() >= 8) {
        // A tail after nothing but plain pieces: its last eight bytes,
        // overlapping what was written, in one piece when they are plain.
        uint64_t bytes;
        std::memcpy(&bytes, data + text.size() - 8, sizeof(bytes));
        if (AllPlain(bytes)) {
            const std::size_t tail = text.size() - i;
            std::memcpy(out - (8 - tail), &bytes, sizeof(bytes));
            return out + tail;
        }
    }
    for (const char c : text.substr(i)) {
        if (c == '\0') break;
        const char e = Escape(c);
        if (e == 0) {
            *out++ = c;
        } else if (e == 'u') {
            const auto byte = static_cast<unsigned char>(c);
            *out++ = '\\';
            *out++ = 'u';
            *out++ = '0';
            *out++ = '0';
            *out++ = kHex[byte >> 4];
            *out++ = kHex[byte & 0xF];
        } else {
            *out++ = '\\';
            *out++ = e;
        }
    }
    return out;
}

std::string_view EscapeJsonText(std::string_view text, std::string& storage) {
    const std::size_t length = JsonEscapedLength(text);
    if (length == text.size()) return text;
    const std::string_view content = UpToZero(text);
    if (length == content.size()) return content;
    storage.resize(length);
    WriteJsonEscaped(storage.data(), content);
    return storage;
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary
