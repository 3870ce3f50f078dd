#include "messagelibrary/json/JsonEscape.h"

#include <array>
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
    for (const char c : text) {
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
