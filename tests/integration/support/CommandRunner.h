#pragma once

#include <string>
#include <vector>

namespace Korvane::Veldra::Testing {

struct CommandResult {
    int ExitCode = -1;   // the program's exit status; 124 when it ran out of time
    std::string Output;  // standard output and standard error, interleaved

    bool Ok() const { return ExitCode == 0; }
};

// Runs argv (argv[0] looked up in PATH) with standard input from /dev/null and
// returns its exit status and output. The run is bounded: after timeoutSeconds
// the program is terminated, and killed five seconds later if still there.
CommandResult RunCommand(const std::vector<std::string>& argv, int timeoutSeconds);

}  // namespace Korvane::Veldra::Testing
