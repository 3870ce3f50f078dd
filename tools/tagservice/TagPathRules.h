#pragma once

#include <optional>
#include <string>

#include "messagelibrary/json/JsonReaders.h"

namespace Korvane::Veldra::TagService {

// The error name that refuses a path for a new tag, or nothing when the path
// may be created: empty, holding a '*', made of blanks and dots only, or
// holding a zero byte ("Tag.InvalidTagPath").
std::optional<std::string> NewTagPathError(const std::string& path);

// True when a search pattern matches a whole path. '*' matches any run of
// characters, dots included, and every other character matches itself, case
// included.
bool MatchesSearchPath(const std::string& pattern, const std::string& path);

// True when any pattern matches; an absent or empty list matches every path.
bool MatchesAnySearchPath(const std::optional<VeldraMessageLibrary::JsonStringList>& patterns,
                          const std::string& path);

// True when the pattern names exactly one path: it holds no '*'.
bool IsLiteralSearchPath(const std::string& pattern);

}  // namespace Korvane::Veldra::TagService
