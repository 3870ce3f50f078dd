#pragma once

#include <optional>
#include <string>

#include "CommandLine.h"

namespace kvtag {

// The help of the tool (no command) or of one subcommand.
std::string HelpText(std::optional<Command> command);

}  // namespace kvtag
