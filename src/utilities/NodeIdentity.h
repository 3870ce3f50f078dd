#pragma once

#include <string>

namespace Korvane::Veldra::VeldraUtilities {

// The host name from the system; throws VeldraException(-251004, "Failed to
// get hostname") when there is none.
std::string GetHostName();

// This node's name, lower-case: VELDRA_NODENAME when set, else the host name,
// unless "NodeName.txt" in the configuration directory names another (not
// "localhost"). The first non-empty result stays for the life of the process.
std::string GetNodeName();

// The same rules without the process-wide cache, reading the name file from
// the given configuration directory.
std::string ComputeNodeName(const std::string& configDirectory);

}  // namespace Korvane::Veldra::VeldraUtilities
