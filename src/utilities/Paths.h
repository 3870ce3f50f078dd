#pragma once

#include <string>

namespace Korvane::Veldra::VeldraUtilities {

// The data root: "/etc/korvane/kvveldra", or the value of VELDRA_DATA_DIR when
// that is set and not empty. Read once, at the first call.
const std::string& GetDataDirectory();
// The root joined with "Config".
std::string GetConfigDirectory();
// The root joined with "Logs".
std::string GetLogDirectory();
// Nothing fills this on Linux: always throws a VeldraException pointer.
const std::string& GetApplicationDirectory();

// The name of the product family, for services that report it.
std::string GetDefaultProductName();
void GetDefaultProductName(std::string& name);

}  // namespace Korvane::Veldra::VeldraUtilities
