#include "utilities/ServiceEnvironment.h"

#include <cstdlib>

namespace Korvane::Veldra::VeldraUtilities {

namespace {

constexpr const char* kServiceGuidVariable = "VELDRA_SERVICEGUID";
constexpr const char* kServiceGroupVariable = "VELDRA_SERVICE_GROUP_NAME";
constexpr const char* kDefaultServiceGroup = "Default";

}  // namespace

std::string GetServiceGuid() {
    const char* value = std::getenv(kServiceGuidVariable);
    return value != nullptr ? std::string(value) : std::string();
}

std::string GetServiceGroupName() {
    const char* value = std::getenv(kServiceGroupVariable);
    return value != nullptr ? std::string(value) : std::string(kDefaultServiceGroup);
}

}  // namespace Korvane::Veldra::VeldraUtilities
