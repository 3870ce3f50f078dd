#include "LibraryText.h"

#include <optional>

namespace kvtag {
namespace {

constexpr const char* kTooFewInserts = "Too few inserts passed to format the message: \"";

// The inserts of the text filled in, or nothing when one is missing.
std::optional<std::string> Fill(const std::string& pattern,
                                const std::vector<std::string>& inserts) {
    std::string out;
    std::size_t pos = 0;
    while (pos < pattern.size()) {
        const auto open = pattern.find('{', pos);
        const auto close = open == std::string::npos ? open : pattern.find('}', open);
        if (close == std::string::npos) break;
        const std::string number = pattern.substr(open + 1, close - open - 1);
        const bool digits = !number.empty() && number.size() <= 4 &&
                            number.find_first_not_of("0123456789") == std::string::npos;
        out += pattern.substr(pos, open - pos);
        if (!digits) {
            // Not an insert: the braces stay as they are.
            out += pattern.substr(open, close - open + 1);
        } else if (std::stoul(number) < inserts.size()) {
            out += inserts[std::stoul(number)];
        } else {
            return std::nullopt;
        }
        pos = close + 1;
    }
    return out + pattern.substr(pos);
}

}  // namespace

std::string FilledLibraryText(const std::string& text, const std::vector<std::string>& inserts) {
    const std::string prefix = kTooFewInserts;
    if (text.size() <= prefix.size() || text.compare(0, prefix.size(), prefix) != 0 ||
        text.back() != '"') {
        return text;
    }
    const std::string pattern = text.substr(prefix.size(), text.size() - prefix.size() - 1);
    return Fill(pattern, inserts).value_or(text);
}

}  // namespace kvtag
