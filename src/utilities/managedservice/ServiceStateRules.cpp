#include "utilities/managedservice/ServiceStateRules.h"

namespace Korvane::Veldra::VeldraUtilities {

using VeldraMessageLibrary::ServiceState;

StateChange DecideStateChange(const std::optional<ServiceState>& held, ServiceState requested) {
    if (held && *held == requested) return {};
    if (held && *held == ServiceState::Error && requested != ServiceState::Stopped) return {};
    return {true, requested != ServiceState::Registered};
}

}  // namespace Korvane::Veldra::VeldraUtilities
