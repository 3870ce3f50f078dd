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
#include "StopSignalWaiter.h"
#include "TagServiceEndpoint.h"
#include "TagServiceHost.h"
#include "errors/VeldraException.h"
#include "messagebus/concurrency/Semaphore.h"
#include "messagebus/config/BusConfigurations.h"
#include "utilities/ServiceEnvironment.h"

namespace {

using namespace Korvane::Veldra;
using TagService::WriteLogLine;

constexpr int kBadArguments = 1;
constexpr int kNoBroker = 2;
constexpr int kNoStore = 3;

constexpr const char* kServiceName = "TagService";

// SIGINT and SIGTERM, blocked in every thread (the bus threads inherit the
// mask), so that only the StopSignalWaiter's sigwait sees them.
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

// Standalone unless a service GUID is given, by option or by environment.
VeldraUtilities::ManagedServiceOptions HostOptions(const TagService::ServiceOptions& options,
                                                   MessageBus::AmqpConnectionManager& manager) {
    VeldraUtilities::ManagedServiceOptions host;
    host.serviceName = kServiceName;
    host.connectionManager = &manager;
    host.serviceGuid = options.serviceGuid;
    host.standalone = options.serviceGuid.value_or(VeldraUtilities::GetServiceGuid()).empty();
    host.echoLogger = std::make_shared<TagService::ConsoleTraceLogger>();
    return host;
}

int Run(const TagService::ServiceOptions& options) {
    const sigset_t stopSignals = BlockStopSignals();
    MessageBus::Semaphore shutdownEvent;
    TagService::StopSignalWaiter signals(stopSignals, shutdownEvent);

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
    std::unique_ptr<TagService::TagServiceHost> host;
    std::string broker;
    try {
        manager = ManagerFor(options, broker);
        statusLines = std::make_unique<TagService::StatusLinePump>(*manager);
        // The host starts the consumers when it goes live.
        endpoint = std::make_unique<TagService::TagServiceEndpoint>(
            *manager, logic, options.verbose, false, options.durableQueue, options.queueType);
        host = std::make_unique<TagService::TagServiceHost>(
            &shutdownEvent, *endpoint,
            std::string(TagService::kReadyLine) + " (queue " + endpoint->QueueName() +
                ", store " +
                (options.storeFile.empty() ? std::string("memory") : options.storeFile) + ")");
        const VeldraUtilities::ManagedServiceOptions hostOptions = HostOptions(options, *manager);
        host->Start(hostOptions);
        if (!hostOptions.standalone) {
            std::cout << TagService::kManagedLine << " (control queue "
                      << host->GetControlQueueName() << ", service guid " << host->ServiceGuid()
                      << ")" << std::endl;
        }
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

    shutdownEvent.Wait();
    if (const int signal = signals.Received()) {
        WriteLogLine(std::cerr,
                     std::string("stopping on ") + (signal == SIGINT ? "SIGINT" : "SIGTERM"));
        host->SetState(VeldraMessageLibrary::ServiceState::Stopped);
    } else {
        WriteLogLine(std::cerr, "stopping on the manager's shutdown");
    }
    host.reset();
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
