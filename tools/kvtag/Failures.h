#pragma once

#include <cstdint>
#include <stdexcept>
#include <string>

namespace kvtag {

// A call of the library that returned an error status, with its text and,
// after it, what kvtag found behind it.
class LibraryError : public std::runtime_error {
public:
    LibraryError(const std::string& operation, int32_t status, const std::string& text,
                 const std::string& advice = "")
        : std::runtime_error(operation + ": status " + std::to_string(status) + ": " +
                             (text.empty() ? "(no text)" : text) +
                             (advice.empty() ? "" : " " + advice)),
          status_(status) {}
    int32_t Status() const { return status_; }

private:
    int32_t status_;
};

// A request the service's tags do not allow, found by the tool itself: a
// missing tag, a tag of another type, a tag that exists already.
class ToolError : public std::runtime_error {
public:
    using std::runtime_error::runtime_error;
};

}  // namespace kvtag
