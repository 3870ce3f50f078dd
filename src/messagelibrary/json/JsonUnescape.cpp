#include "messagelibrary/json/JsonUnescape.h"

namespace Korvane::Veldra::VeldraMessageLibrary::Jsonz {
namespace {

int HexValue(char c) noexcept {
    if (c >= '0' && c <= '9') return c - '0';
    if (c >= 'a' && c <= 'f') return c - 'a' + 10;
    if (c >= 'A' && c <= 'F') return c - 'A' + 10;
    return -1;
}

}  // namespace

void JsonUnescaper::Fail() noexcept {
    failed_ = true;
    ended_ = true;
    pendingCount_ = pendingNext_ = 0;
}

bool JsonUnescaper::ReadHex4(unsigned& value) noexcept {
    if (end_ - next_ < 4) return false;
    value = 0;
    for (int i = 0; i < 4; ++i) {
        const int digit = HexValue(next_[i]);
        if (digit < 0) return false;
        value = value * 16 + static_cast<unsigned>(digit);
    }
    next_ += 4;
    return true;
}

// Decodes the escape behind a backslash: its first byte into first, the rest
// of a UTF-8 sequence into the pending queue.
bool JsonUnescaper::DecodeEscape(char& first) noexcept {
    if (next_ == end_) return false;
    const char e = *next_++;
    char simple = 0;
    switch (e) {
        case '"':
        case '/':
        case '\\':
            simple = e;
            break;
        case 'b':
            simple = '\b';
            break;
        case 'f':
            simple = '\f';
            break;
        case 'n':
            simple = '\n';
            break;
        case 'r':
            simple = '\r';
            break;
        case 't':
            simple = '\t';
            break;
        case 'u':
            break;
        default:
            return false;
    }
    if (e != 'u') {
        first = simple;
        return true;
    }
    unsigned code = 0;
    if (!ReadHex4(code)) return false;
    if (code >= 0xD800 && code <= 0xDFFF) {
        unsigned low = 0;
        if (end_ - next_ < 2 || next_[0] != '\\' || next_[1] != 'u') return false;
        next_ += 2;
        if (!ReadHex4(low)) return false;
        const long combined = 0x10000L + ((static_cast<long>(code) - 0xD800L) << 10) +
                              (static_cast<long>(low) - 0xDC00L);
        if (combined >= 0x200000L) return false;
        code = static_cast<unsigned>(combined);
    }
    char bytes[4];
    int count;
    if (code < 0x80) {
        bytes[0] = static_cast<char>(code);
        count = 1;
    } else if (code < 0x800) {
        bytes[0] = static_cast<char>(0xC0 | (code >> 6));
        bytes[1] = static_cast<char>(0x80 | (code & 0x3F));
        count = 2;
    } else if (code < 0x10000) {
        bytes[0] = static_cast<char>(0xE0 | (code >> 12));
        bytes[1] = static_cast<char>(0x80 | ((code >> 6) & 0x3F));
        bytes[2] = static_cast<char>(0x80 | (code & 0x3F));
        count = 3;
    } else {
        bytes[0] = static_cast<char>(0xF0 | (code >> 18));
        bytes[1] = static_cast<char>(0x80 | ((code >> 12) & 0x3F));
        bytes[2] = static_cast<char>(0x80 | ((code >> 6) & 0x3F));
        bytes[3] = static_cast<char>(0x80 | (code & 0x3F));
        count = 4;
    }
    first = bytes[0];
    for (int i = 1; i < count; ++i) pending_[i - 1] = bytes[i];
    pendingCount_ = count - 1;
    pendingNext_ = 0;
    return true;
}

char JsonUnescaper::Next() noexcept {
    if (pendingNext_ < pendingCount_) return pending_[pendingNext_++];
    pendingCount_ = pendingNext_ = 0;
    if (ended_) return '\0';
    if (next_ == end_) {
        ended_ = true;
        return '\0';
    }
    char c = *next_++;
    if (c == '\\' && !DecodeEscape(c)) {
        Fail();
        return '\0';
    }
    // A zero byte (from \u0000) ends the sequence like the end of the input.
    if (c == '\0') ended_ = true;
    return c;
}

bool UnescapeJsonString(const char* raw, std::size_t length, char* out,
                        std::size_t& count) noexcept {
    JsonUnescaper bytes(raw, length);
    count = 0;
    for (char c = bytes.Next(); c != '\0'; c = bytes.Next()) out[count++] = c;
    if (bytes.Complete()) return true;
    count = 0;
    return false;
}

bool UnescapeJsonString(const char* raw, std::size_t length, std::string& out) {
    out.resize(length);
    std::size_t count = 0;
    const bool complete = UnescapeJsonString(raw, length, out.data(), count);
    out.resize(count);
    return complete;
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::Jsonz
