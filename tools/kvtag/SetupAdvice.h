#pragma once

#include <chrono>
#include <cstdint>
#include <functional>
#include <optional>
#include <string>

#include "BrokerProbe.h"
#include "ConfigurationFiles.h"

namespace kvtag {

// The library reports a failed start with its registered text alone ("Veldra
// configurations directory not found.", "AMQP error: Failed to log in.").
// These say what kvtag finds behind such a status, to follow that text.

// Knocks on a broker's port (ProbeBroker, or a stand-in in tests).
using Prober = std::function<ProbeOutcome(const std::string& host, int port)>;

// What stands behind the status of a failed initialize with the
// configuration `id` (none: the default one): the directory and the
// variable that moves it, the file that does not parse or its wrong key,
// the Ids found, or the broker, the port and what answers there. Empty when
// kvtag has nothing to add.
std::string ConnectAdvice(int32_t status, const std::optional<std::string>& id,
                          const ConfigurationFolder& folder, const Prober& probe);

// What a request that got no answer waited for: a tag service on the
// exchange of the configuration in use.
std::string ServiceTimeoutAdvice(const std::optional<std::string>& id,
                                 const ConfigurationFolder& folder, uint32_t waitedMs);

}  // namespace kvtag
