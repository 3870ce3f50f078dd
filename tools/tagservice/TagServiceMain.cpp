// kvveldra-tagservice: options, signals, and the order of start and stop.
#include <csignal>
#include <iostream>
#include <memory>
#include <pthread.h>
#include <stdexcept>
#include <string>
#include <vector>

#include "MemoryTagStore.h"
#include "ServiceLog.h"
#include "ServiceOptions.h"
#include "SqliteTagStore.h"
#include "StatusLinePump.h"
#include "TagServiceEndpoint.h"
#include "errors/VeldraException.h"
#include "messagebus/config/BusConfigurations.h"

namespace {

using namespace Korvane::Veldra;
using TagService::WriteLogLine;

constexpr int kBadArguments = 1;
constexpr int kNoBroker = 2;
constexpr int kNoStore = 3;

// SIGINT and SIGTERM, blocked in every thread (the bus threads inherit the
// mask), so that only the main thread's sigwait sees them.
sigset_t BlockStopSignals() {
    sigset_t signals;
    sigemptyset(&signals);
    sigaddset(&signals, SIGINT);
    sigaddset(&signals, SIGTERM);
    pthread_sigmask(SIG_BLOCK, &signals, nullptr);
    std::signal(SIGPIPE, SIG_IGN);
    return signals;
}

std::unique_ptr<TagService::TagStore> OpenStore(const std::string& file) {
    if (file.empty()) return std::make_unique<TagService::MemoryTagStore>();
    return std::make_unique<TagService::SqliteTagStore>(file);
}

// Where the configuration points, for the message of a failed start.
std::string BrokerOf(const MessageBus::VeldraConfiguration& configuration) {
    return configuration.Host.value_or("") + ":" + std::to_string(configuration.Port.value_or(0));
}

std::unique_ptr<MessageBus::AmqpConnectionManager> ManagerFor(
    const TagService::ServiceOptions& options, std::string& broker) {
    const auto entry = MessageBus::BusConfigurations::GetNamed(options.configurationId, true);
    broker = BrokerOf(entry.Configuration) + " (configuration " + entry.Path + ")";
    auto manager = std::make_unique<MessageBus::AmqpConnectionManager>(entry.Configuration);
    manager->SetConnectTimeout(options.connectTimeoutMs);
    return manager;
}

int Run(const TagService::ServiceOptions& options) {
    const sigset_t stopSignals = BlockStopSignals();

    std::unique_ptr<TagService::TagStore> store;
    try {
        store = OpenStore(options.storeFile);
    } catch (const std::exception& error) {
        WriteLogLine(std::cerr, "cannot open the store " + options.storeFile + ": " + error.what());
        return kNoStore;
    }
    TagService::TagServiceLogic logic(*store);

    std::unique_ptr<MessageBus::AmqpConnectionManager> manager;
    std::unique_ptr<TagService::StatusLinePump> statusLines;
    std::unique_ptr<TagService::TagServiceEndpoint> endpoint;
    std::string broker;
    try {
        manager = ManagerFor(options, broker);
        statusLines = std::make_unique<TagService::StatusLinePump>(*manager);
        endpoint = std::make_unique<TagService::TagServiceEndpoint>(*manager, logic,
                                                                    options.verbose);
    } catch (const MessageBus::VeldraException* error) {
        const std::unique_ptr<const MessageBus::VeldraException> owned(error);
        WriteLogLine(std::cerr, std::string("no broker configuration: ") + error->what());
        return kNoBroker;
    } catch (const std::exception& error) {
        WriteLogLine(std::cerr, broker.empty()
                                    ? std::string("no broker configuration: ") + error.what()
                                    : "cannot reach the broker " + broker + ": " + error.what());
        return kNoBroker;
    }

    std::cout << TagService::kReadyLine << " (queue " << endpoint->QueueName() << ", store "
              << (options.storeFile.empty() ? std::string("memory") : options.storeFile) << ")"
              << std::endl;

    int signal = 0;
    while (sigwait(&stopSignals, &signal) != 0) {
    }
    WriteLogLine(std::cerr, std::string("stopping on ") + (signal == SIGINT ? "SIGINT" : "SIGTERM"));
    endpoint.reset();
    statusLines.reset();
    manager.reset();
    store.reset();
    WriteLogLine(std::cerr, "stopped");
    return 0;
}

}  // namespace

int main(int argc, char** argv) {
    TagService::ServiceOptions options;
    try {
        options = TagService::ParseServiceOptions(std::vector<std::string>(argv + 1, argv + argc));
    } catch (const std::invalid_argument& error) {
        std::cerr << "kvveldra-tagservice: " << error.what() << "\n\n" << TagService::UsageText();
        return kBadArguments;
    }
    if (options.help) {
        std::cout << TagService::UsageText();
        return 0;
    }
    return Run(options);
}
