#pragma once

#include <memory>
#include <optional>
#include <string>

#include "utilities/tracelogging/ITraceLogger.h"

namespace Korvane::Veldra::MessageBus {
class AmqpConnectionManager;
}

namespace Korvane::Veldra::VeldraUtilities {

// What a service gives ManagedServiceBase::Run.
struct ManagedServiceOptions {
    // The stem of the service's queue names, its "Origin", and the name it
    // registers under.
    std::string serviceName;
    // The name people see; the default product name when not given.
    std::optional<std::string> displayName;
    // Run with no service manager: no registration, and the service goes
    // live as soon as it runs.
    bool standalone = false;
    // Takes the place of VELDRA_SERVICEGUID when given.
    std::optional<std::string> serviceGuid;
    // Null means the process singleton.
    MessageBus::AmqpConnectionManager* connectionManager = nullptr;
    // Also receives every entry of the service's logger, for a console or a
    // test; null for none.
    std::shared_ptr<MessageBus::Interfaces::ITraceLogger> echoLogger;
};

}  // namespace Korvane::Veldra::VeldraUtilities
