#pragma once

#include <kvveldra/TagConsole.h>

#include <cstddef>
#include <istream>
#include <optional>
#include <stdexcept>
#include <string>
#include <vector>

namespace kvtag {

// One line of "write --stdin": PATH VALUE [TIME]. Words are separated by
// blanks or tabs; a word may be written in double quotes, in which \" and
// \\ stand for a quote and a backslash, so that a value may hold blanks or
// be empty. Empty lines and lines whose first non-blank is '#' are skipped.
struct StdinLine {
    std::size_t lineNumber = 0;
    std::string path;
    std::string value;
    std::optional<TagConsoleTime> time;  // none: the current time at sending
};

// The samples of one tag in the order of their lines.
struct TagBatch {
    std::string path;
    std::vector<StdinLine> lines;
};

// A line that does not follow the grammar.
class LineError : public std::runtime_error {
public:
    LineError(std::size_t lineNumber, const std::string& message)
        : std::runtime_error("line " + std::to_string(lineNumber) + ": " + message),
          lineNumber_(lineNumber) {}
    std::size_t LineNumber() const { return lineNumber_; }

private:
    std::size_t lineNumber_;
};

// Parses one line; nothing for a line to skip. Throws LineError.
std::optional<StdinLine> ParseStdinLine(const std::string& text, std::size_t lineNumber);

// Reads every line of the stream and groups them by path, the tags in the
// order of their first line. Throws LineError on the first bad line, or when
// there is no line at all.
std::vector<TagBatch> ReadStdinBatches(std::istream& in);

}  // namespace kvtag
