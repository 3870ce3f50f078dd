#pragma once

#include <stdexcept>
#include <string>
#include <string_view>
#include <vector>

namespace kvtag::serve {

// A request body that cannot be used, with what is wrong in it.
class BodyError : public std::runtime_error {
public:
    using std::runtime_error::runtime_error;
};

// The most paths one read may ask for.
inline constexpr std::size_t kMaxReadPaths = 200;

// {"paths": ["a", "b"]}: one path or more, none with '*'. Throws BodyError.
std::vector<std::string> ParseReadBody(std::string_view body);

struct WriteBody {
    std::string path;
    std::string value;  // a number or boolean as written in the JSON
};

// {"path": "a", "value": "12.5"}; the value may also be a JSON number or
// boolean. Throws BodyError.
WriteBody ParseWriteBody(std::string_view body);

// Why a list of paths cannot be read: none, too many, or one with '*'.
// Throws BodyError.
void CheckReadPaths(const std::vector<std::string>& paths);

}  // namespace kvtag::serve
