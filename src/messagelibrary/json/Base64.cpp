#include "messagelibrary/json/Base64.h"

namespace Korvane::Veldra::VeldraMessageLibrary {
namespace {

constexpr char kAlphabet[] = "ABCDEFGHIJKLMNOPQRSTUVWXYZabcdefghijklmnopqrstuvwxyz0123456789+/";

int DecodeChar(char c) noexcept {
    if (c >= 'A' && c <= 'Z') return c - 'A';
    if (c >= 'a' && c <= 'z') return c - 'a' + 26;
    if (c >= '0' && c <= '9') return c - '0' + 52;
    if (c == '+') return 62;
    if (c == '/') return 63;
    return -1;
}

}  // namespace

std::size_t Base64EncodedLength(std::size_t size) noexcept {
    return (size + 2) / 3 * 4;
}

void AppendBase64(std::string& out, const void* data, std::size_t size) {
    const auto* bytes = static_cast<const unsigned char*>(data);
    const std::size_t start = out.size();
    out.resize(start + Base64EncodedLength(size));
    char* p = out.data() + start;
    std::size_t i = 0;
    for (; i + 3 <= size; i += 3) {
        const unsigned group = (bytes[i] << 16) | (bytes[i + 1] << 8) | bytes[i + 2];
        *p++ = kAlphabet[group >> 18];
        *p++ = kAlphabet[(group >> 12) & 63];
        *p++ = kAlphabet[(group >> 6) & 63];
        *p++ = kAlphabet[group & 63];
    }
    if (i < size) {
        const bool two = i + 1 < size;
        const unsigned group = (bytes[i] << 16) | (two ? bytes[i + 1] << 8 : 0);
        *p++ = kAlphabet[group >> 18];
        *p++ = kAlphabet[(group >> 12) & 63];
        *p++ = two ? kAlphabet[(group >> 6) & 63] : '=';
        *p++ = '=';
    }
}

std::string Base64Encode(const void* data, std::size_t size) {
    std::string text;
    AppendBase64(text, data, size);
    return text;
}

bool Base64Decode(std::string_view text, std::vector<uint8_t>& out) {
    out.clear();
    if (text.size() % 4 != 0) return false;
    out.reserve(text.size() / 4 * 3);
    for (std::size_t i = 0; i < text.size(); i += 4) {
        const bool last = i + 4 == text.size();
        int padding = 0;
        if (last && text[i + 3] == '=') padding = text[i + 2] == '=' ? 2 : 1;
        unsigned group = 0;
        for (int k = 0; k < 4; ++k) {
            int value = 0;
            if (k < 4 - padding) {
                value = DecodeChar(text[i + k]);
                if (value < 0) return false;
            }
            group = (group << 6) | static_cast<unsigned>(value);
        }
        out.push_back(static_cast<uint8_t>(group >> 16));
        if (padding < 2) out.push_back(static_cast<uint8_t>((group >> 8) & 0xFF));
        if (padding < 1) out.push_back(static_cast<uint8_t>(group & 0xFF));
    }
    return true;
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary
