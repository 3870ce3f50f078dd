#include "support/BrokerEnvironment.h"

#include <cstdio>
#include <cstdlib>
#include <optional>
#include <sstream>
#include <utility>

namespace Korvane::Veldra::Testing {
namespace {

std::optional<BrokerSettings>& LoadedSettings() {
    static std::optional<BrokerSettings> settings;
    return settings;
}

bool BrokerRequired() {
    const char* value = std::getenv("KVVELDRA_BROKER_REQUIRED");
    return value != nullptr && std::string(value) == "1";
}

::testing::AssertionResult CtlFailure(const std::vector<std::string>& args,
                                      const CommandResult& result) {
    std::string command = "rabbitmqctl";
    for (const auto& arg : args) {
        command += " " + arg;
    }
    return ::testing::AssertionFailure() << command << " exited with " << result.ExitCode << ":\n"
                                         << result.Output;
}

::testing::AssertionResult CtlSucceeds(const std::vector<std::string>& args) {
    const CommandResult result = RunCtl(args);
    return result.Ok() ? ::testing::AssertionSuccess() : CtlFailure(args, result);
}

// Registered before main runs, by linking this file into a test executable.
[[maybe_unused]] const ::testing::Environment* const registered =
    ::testing::AddGlobalTestEnvironment(new BrokerEnvironment);

}  // namespace

std::string BrokerEnvironment::EnvFilePath() {
    const char* path = std::getenv("KVVELDRA_BROKER_ENV");
    return path != nullptr && *path != '\0' ? path : KVVELDRA_BROKER_ENV_FILE;
}

void BrokerEnvironment::SetUp() {
    const std::string path = EnvFilePath();
    BrokerSettings settings;
    std::string error;
    if (LoadBrokerSettings(path, settings, error)) {
        LoadedSettings() = std::move(settings);
        return;
    }
    const std::string reason = "no private broker (" + error +
                               "). Run the tests through ctest (ctest -L broker), or start one "
                               "with tests/integration/broker/broker.sh start " +
                               path;
    if (BrokerRequired()) {
        // GoogleTest reports the tests of a failed global set-up as skipped,
        // which ctest would count as skipped too: end the run instead.
        std::fprintf(stderr, "FATAL: the broker tests cannot run: %s\n", reason.c_str());
        std::exit(1);
    }
    GTEST_SKIP() << reason;
}

const BrokerSettings& Broker() {
    const auto& settings = LoadedSettings();
    if (!settings) {
        // Only reachable from code that runs outside a test.
        std::fprintf(stderr, "FATAL: Broker() used before the broker environment was set up\n");
        std::abort();
    }
    return *settings;
}

CommandResult RunCtl(const std::vector<std::string>& args, int timeoutSeconds) {
    std::vector<std::string> argv = {Broker().CtlPath};
    argv.insert(argv.end(), args.begin(), args.end());
    return RunCommand(argv, timeoutSeconds);
}

::testing::AssertionResult CloseAllConnections() {
    return CtlSucceeds({"close_all_connections", "closed by the test"});
}

::testing::AssertionResult StopApp() {
    return CtlSucceeds({"stop_app"});
}

::testing::AssertionResult StartApp() {
    auto started = CtlSucceeds({"start_app"});
    return started ? CtlSucceeds({"await_startup"}) : started;
}

::testing::AssertionResult ListConnections(std::vector<std::string>& connections) {
    const std::vector<std::string> args = {"list_connections", "--silent", "name", "state"};
    const CommandResult result = RunCtl(args);
    if (!result.Ok()) {
        return CtlFailure(args, result);
    }
    connections.clear();
    std::istringstream lines(result.Output);
    std::string line;
    while (std::getline(lines, line)) {
        if (!line.empty()) {
            connections.push_back(line);
        }
    }
    return ::testing::AssertionSuccess();
}

}  // namespace Korvane::Veldra::Testing
