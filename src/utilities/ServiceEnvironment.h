#pragma once

#include <string>

namespace Korvane::Veldra::VeldraUtilities {

// The GUID a service manager gave this service in VELDRA_SERVICEGUID; empty
// when the variable is not set.
std::string GetServiceGuid();

// The group in VELDRA_SERVICE_GROUP_NAME, or "Default" when it is not set.
std::string GetServiceGroupName();

}  // namespace Korvane::Veldra::VeldraUtilities
