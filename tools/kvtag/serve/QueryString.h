#pragma once

#include <map>
#include <stdexcept>
#include <string>
#include <string_view>
#include <vector>

namespace kvtag::serve {

// A target that cannot be read: a bad %-escape.
class QueryError : public std::runtime_error {
public:
    using std::runtime_error::runtime_error;
};

// A request target split into its decoded path and its parameters; a name
// given more than once keeps every value, in order.
struct Target {
    std::string path;
    std::map<std::string, std::vector<std::string>> parameters;

    // The first value of a parameter, or `fallback` when it is absent.
    std::string First(const std::string& name, const std::string& fallback = "") const;
};

// Decodes %XX escapes, and '+' as a space when `plusIsSpace`. Throws
// QueryError.
std::string PercentDecode(std::string_view text, bool plusIsSpace);

// Splits "/api/list?pattern=a.*&skip=0" at '?', '&' and '='. Throws QueryError.
Target ParseTarget(std::string_view target);

}  // namespace kvtag::serve
