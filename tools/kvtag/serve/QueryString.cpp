#include "QueryString.h"

namespace kvtag::serve {
namespace {

int HexDigit(char c) {
    if (c >= '0' && c <= '9') return c - '0';
    if (c >= 'a' && c <= 'f') return c - 'a' + 10;
    if (c >= 'A' && c <= 'F') return c - 'A' + 10;
    return -1;
}

}  // namespace

std::string Target::First(const std::string& name, const std::string& fallback) const {
    const auto found = parameters.find(name);
    return found == parameters.end() || found->second.empty() ? fallback : found->second.front();
}

std::string PercentDecode(std::string_view text, bool plusIsSpace) {
    std::string out;
    for (std::size_t i = 0; i < text.size(); ++i) {
        const char c = text[i];
        if (c == '+' && plusIsSpace) {
            out += ' ';
        } else if (c != '%') {
            out += c;
        } else {
            const int high = i + 2 < text.size() ? HexDigit(text[i + 1]) : -1;
            const int low = i + 2 < text.size() ? HexDigit(text[i + 2]) : -1;
            if (high < 0 || low < 0) {
                throw QueryError("a '%' in the address is not followed by two hexadecimal digits");
            }
            out += static_cast<char>(high * 16 + low);
            i += 2;
        }
    }
    return out;
}

Target ParseTarget(std::string_view target) {
    Target parsed;
    const auto question = target.find('?');
    parsed.path = PercentDecode(target.substr(0, question), false);
    if (question == std::string_view::npos) return parsed;
    std::string_view query = target.substr(question + 1);
    while (!query.empty()) {
        const auto amp = query.find('&');
        const std::string_view pair = query.substr(0, amp);
        query = amp == std::string_view::npos ? std::string_view() : query.substr(amp + 1);
        if (pair.empty()) continue;
        const auto equals = pair.find('=');
        const std::string name = PercentDecode(pair.substr(0, equals), true);
        const std::string value =
            equals == std::string_view::npos ? "" : PercentDecode(pair.substr(equals + 1), true);
        parsed.parameters[name].push_back(value);
    }
    return parsed;
}

}  // namespace kvtag::serve
