#pragma once

#include <optional>

#include "messagelibrary/ServiceEnums.h"

namespace Korvane::Veldra::VeldraUtilities {

// What a request to change a managed service's state leads to.
struct StateChange {
    // The new state replaces the held one.
    bool store = false;
    // A ServiceStatusBroadcast announces it.
    bool broadcast = false;
};

// The rules of ManagedServiceBase::SetState: the same state again changes
// nothing; ERROR gives way only to STOPPED; REGISTERED is stored but not
// broadcast, as the registration message itself tells the manager.
StateChange DecideStateChange(const std::optional<VeldraMessageLibrary::ServiceState>& held,
                              VeldraMessageLibrary::ServiceState requested);

}  // namespace Korvane::Veldra::VeldraUtilities
