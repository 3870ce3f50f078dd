#pragma once

#include <string>

namespace kvtag {

// While it lives, whatever the process prints to standard output goes to
// standard error instead, so that the library's own lines never mix with
// the tool's output; Write sends the tool's output to the real standard
// output. Restored on destruction.
class OutputChannel {
public:
    OutputChannel();
    ~OutputChannel();
    OutputChannel(const OutputChannel&) = delete;
    OutputChannel& operator=(const OutputChannel&) = delete;

    // False when the text could not all be written (a closed pipe).
    bool Write(const std::string& text);

private:
    int realStdout_ = -1;
};

}  // namespace kvtag
