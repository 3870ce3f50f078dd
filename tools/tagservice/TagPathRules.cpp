#include "TagPathRules.h"

#include <algorithm>

namespace Korvane::Veldra::TagService {

namespace {

bool IsBlankOrDot(char c) {
    return c == '.' || c == ' ' || c == '\t' || c == '\n' || c == '\r' || c == '\v' || c == '\f';
}

}  // namespace

std::optional<std::string> NewTagPathError(const std::string& path) {
    if (path.empty()) return std::string("Tag.TagPathCannotBeEmpty");
    // A text of a body ends at a zero byte, so such a path could not be
    // given back as it was stored.
    if (path.find('\0') != std::string::npos) return std::string("Tag.InvalidTagPath");
    if (path.find('*') != std::string::npos) return std::string("Tag.TagPathCannotContainAWildcard");
    if (std::all_of(path.begin(), path.end(), IsBlankOrDot)) {
        return std::string("Tag.TagPathCannotContainOnlyWhiteSpaceAndDots");
    }
    return std::nullopt;
}

bool MatchesSearchPath(const std::string& pattern, const std::string& path) {
    // Greedy matching with one back-track point: the last '*' seen. Linear in
    // practice, and never worse than pattern length times path length.
    std::size_t p = 0;
    std::size_t s = 0;
    std::size_t starAt = std::string::npos;
    std::size_t resumeAt = 0;
    while (s < path.size()) {
        if (p < pattern.size() && pattern[p] == '*') {
            starAt = p++;
            resumeAt = s;
        } else if (p < pattern.size() && pattern[p] == path[s]) {
            ++p;
            ++s;
        } else if (starAt != std::string::npos) {
            p = starAt + 1;
            s = ++resumeAt;
        } else {
            return false;
        }
    }
    while (p < pattern.size() && pattern[p] == '*') ++p;
    return p == pattern.size();
}

bool MatchesAnySearchPath(const std::optional<VeldraMessageLibrary::JsonStringList>& patterns,
                          const std::string& path) {
    if (!patterns || patterns->empty()) return true;
    return std::any_of(patterns->begin(), patterns->end(),
                       [&](const std::string& pattern) { return MatchesSearchPath(pattern, path); });
}

bool IsLiteralSearchPath(const std::string& pattern) {
    return pattern.find('*') == std::string::npos;
}

}  // namespace Korvane::Veldra::TagService
