#include "TextEscape.h"

namespace kvtag {

std::string EscapeText(std::string_view text) {
    // Each character of the first set is written as a backslash and the
    // letter at its place in the second.
    static constexpr std::string_view kNamed = "\\\t\n\r";
    static constexpr std::string_view kLetters = "\\tnr";
    static constexpr char kHex[] = "0123456789abcdef";
    std::string out;
    out.reserve(text.size());
    for (const char c : text) {
        const auto byte = static_cast<unsigned char>(c);
        if (const auto at = kNamed.find(c); at != std::string_view::npos) {
            out += '\\';
            out += kLetters[at];
        } else if (byte < 0x20 || byte == 0x7f) {
            out += "\\x";
            out += kHex[byte >> 4];
            out += kHex[byte & 0x0f];
        } else {
            out += c;
        }
    }
    return out;
}

}  // namespace kvtag
