#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <vector>

namespace Korvane::Veldra::TagService {

// The command line of kvveldra-tagservice.
struct ServiceOptions {
    std::string configurationId = "veldra_master";  // --config ID
    std::string storeFile;                           // --store FILE; empty: in memory
    bool verbose = false;                            // --verbose
    bool help = false;                               // --help
    int32_t connectTimeoutMs = 10000;                // --connect-timeout MS
    // --service-guid GUID: run under a service manager with this GUID, in
    // place of VELDRA_SERVICEGUID.
    std::optional<std::string> serviceGuid;
    // --durable-queue NAME: serve from the durable queue TagService_NAME,
    // which outlives the service and a restart of the broker node; empty: an
    // auto-deleted queue of a new name each run.
    std::string durableQueue;
    // --queue-type classic|quorum: the kind of the durable queue; empty (or
    // classic): the broker's default. A quorum queue is kept on a majority of
    // a cluster's nodes and so outlives the loss of any one of them.
    std::string queueType;
};

// The line printed on standard output once a managed service has registered.
inline constexpr const char* kManagedLine = "kvveldra-tagservice managed";

// The line printed on standard output once the service serves.
inline constexpr const char* kReadyLine = "kvveldra-tagservice ready";

// Reads the arguments after the program name; throws std::invalid_argument
// with a message naming the bad argument.
ServiceOptions ParseServiceOptions(const std::vector<std::string>& args);

// The text of --help.
std::string UsageText();

}  // namespace Korvane::Veldra::TagService
