#pragma once

#include <chrono>
#include <string>
#include <utility>
#include <vector>

namespace Korvane::Veldra::Testing {

// What one run of kvtag gave.
struct KvtagRun {
    int exitCode = -1;  // 124 when it ran out of time
    std::string out;    // standard output
    std::string err;    // standard error
    std::chrono::milliseconds elapsed{0};
};

// Runs the built kvtag with the arguments, `input` on its standard input,
// and the variables of `environment` set over the test's own. Bounded by
// `timeoutSeconds`, after which the child is terminated.
KvtagRun RunKvtag(const std::vector<std::string>& args, const std::string& input = "",
                  const std::vector<std::pair<std::string, std::string>>& environment = {},
                  int timeoutSeconds = 60);

}  // namespace Korvane::Veldra::Testing
