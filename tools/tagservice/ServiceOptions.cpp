#include "ServiceOptions.h"

#include <stdexcept>

namespace Korvane::Veldra::TagService {

namespace {

int32_t ParseTimeout(const std::string& text) {
    std::size_t used = 0;
    long value = 0;
    try {
        value = std::stol(text, &used);
    } catch (const std::exception&) {
        used = 0;
    }
    if (used != text.size() || value <= 0 || value > 3600000) {
        throw std::invalid_argument("--connect-timeout needs milliseconds from 1 to 3600000, not '" +
                                    text + "'");
    }
    return static_cast<int32_t>(value);
}

}  // namespace

ServiceOptions ParseServiceOptions(const std::vector<std::string>& args) {
    ServiceOptions options;
    for (std::size_t i = 0; i < args.size(); ++i) {
        const std::string& arg = args[i];
        const auto value = [&]() -> const std::string& {
            if (i + 1 >= args.size() || args[i + 1].empty()) {
                throw std::invalid_argument(arg + " needs a value");
            }
            return args[++i];
        };
        if (arg == "--help" || arg == "-h") {
            options.help = true;
        } else if (arg == "--verbose") {
            options.verbose = true;
        } else if (arg == "--config") {
            options.configurationId = value();
        } else if (arg == "--store") {
            options.storeFile = value();
        } else if (arg == "--service-guid") {
            options.serviceGuid = value();
        } else if (arg == "--durable-queue") {
            options.durableQueue = value();
        } else if (arg == "--queue-type") {
            options.queueType = value();
            if (options.queueType != "classic" && options.queueType != "quorum") {
                throw std::invalid_argument("--queue-type needs classic or quorum, not '" +
                                            options.queueType + "'");
            }
        } else if (arg == "--connect-timeout") {
            options.connectTimeoutMs = ParseTimeout(value());
        } else {
            throw std::invalid_argument("unknown argument '" + arg + "'");
        }
    }
    if (!options.queueType.empty() && options.durableQueue.empty()) {
        throw std::invalid_argument("--queue-type needs --durable-queue NAME: only a durable "
                                    "queue has a kind to choose");
    }
    return options;
}

std::string UsageText() {
    return std::string(
               "Usage: kvveldra-tagservice [--config ID] [--store FILE] [--verbose]\n"
               "                           [--connect-timeout MS] [--service-guid GUID]\n"
               "                           [--durable-queue NAME [--queue-type KIND]] [--help]\n"
               "\n"
               "Serves the TagInfo, TagCurrentValue and TagIngestion messages on the bus.\n"
               "\n"
               "  --config ID           broker configuration id in VeldraConfigurations under\n"
               "                        the data root ($VELDRA_DATA_DIR, else /etc/korvane/kvveldra);\n"
               "                        default veldra_master, falling back to veldra_localhost\n"
               "                        and veldra_master when the id is not there\n"
               "  --store FILE          keep tags, values and aggregates in this SQLite file;\n"
               "                        without it they live in memory only\n"
               "  --verbose             one line on standard output per message handled\n"
               "  --connect-timeout MS  how long the first connection may take (default 10000)\n"
               "  --service-guid GUID   run under the service manager of this node with this\n"
               "                        GUID (as does a non-empty VELDRA_SERVICEGUID): register\n"
               "                        on ServiceManager_<node>, take the configuration, and\n"
               "                        serve only once told to go live\n"
               "  --durable-queue NAME  serve from the durable queue TagService_NAME, which\n"
               "                        keeps the requests sent while the service reconnects\n"
               "                        after a restart of the broker node; the default queue\n"
               "                        is deleted with its last consumer\n"
               "  --queue-type KIND     the durable queue's kind: classic (the default) lives\n"
               "                        on one node of a cluster and is refused while that\n"
               "                        node is down; quorum is kept on a majority of the\n"
               "                        nodes and goes on when any one of them is lost\n"
               "  --help                this text\n"
               "\n"
               "Once its consumers are started it prints the line\n"
               "  ") +
           kReadyLine +
           " (queue NAME, store memory|FILE)\n"
           "on standard output; under a manager it first prints\n"
           "  " + std::string(kManagedLine) + " (control queue NAME, service guid GUID)\n"
           "and the ready line each time it goes live. SIGINT or SIGTERM, or the\n"
           "manager's shutdown, stop it cleanly with status 0. VELDRA_SERVICE_GROUP_NAME\n"
           "names its service group (default Default).\n"
           "Exit status: 0 stopped by a signal or the manager, 1 bad arguments, 2 no\n"
           "broker or no configuration, 3 the store cannot be opened.\n";
}

}  // namespace Korvane::Veldra::TagService
