#include "support/BenchBroker.h"

#include <unistd.h>

#include <cstdio>
#include <cstdlib>
#include <fstream>
#include <map>

#include "messagebus/config/VeldraConfiguration.h"

namespace Korvane::Veldra::Bench {

namespace {

std::string DefaultEnvFile() {
    char exe[4096];
    const ssize_t length = readlink("/proc/self/exe", exe, sizeof(exe) - 1);
    if (length <= 0) return std::string();
    std::string path(exe, static_cast<size_t>(length));
    path = path.substr(0, path.rfind('/'));  // <build>/bench
    return path.substr(0, path.rfind('/')) + "/tests/integration/broker/broker.env";
}

}  // namespace

std::optional<BrokerAddress> LoadBroker(std::string& path) {
    const char* fromEnv = std::getenv("KVVELDRA_BROKER_ENV");
    path = fromEnv != nullptr && *fromEnv != '\0' ? fromEnv : DefaultEnvFile();
    std::ifstream file(path);
    if (!file) return std::nullopt;
    std::map<std::string, std::string> values;
    for (std::string line; std::getline(file, line);) {
        const auto equals = line.find('=');
        if (equals == std::string::npos) continue;
        std::string value = line.substr(equals + 1);
        if (value.size() >= 2 && value.front() == '\'') value = value.substr(1, value.size() - 2);
        values[line.substr(0, equals)] = value;
    }
    BrokerAddress broker{values["BROKER_HOST"], values["BROKER_USER"], values["BROKER_PASSWORD"],
                         std::atoi(values["BROKER_AMQP_PORT"].c_str())};
    if (broker.host.empty() || broker.port == 0) return std::nullopt;
    return broker;
}

std::optional<BrokerAddress> BrokerOrSkip(const std::string& benchmark) {
    std::string envFile;
    auto broker = LoadBroker(envFile);
    if (!broker) {
        std::printf(
            "%s: skipped, no test broker described in %s (start one with "
            "tests/integration/broker/broker.sh start FILE and set KVVELDRA_BROKER_ENV=FILE)\n",
            benchmark.c_str(), envFile.c_str());
    }
    return broker;
}

std::unique_ptr<MessageBus::AmqpConnectionManager> MakeManager(const BrokerAddress& broker,
                                                               const std::string& exchange) {
    MessageBus::VeldraConfiguration configuration;
    configuration.Host = broker.host;
    configuration.Port = broker.port;
    configuration.User = broker.user;
    configuration.Password = broker.password;
    configuration.ExchangeName = exchange;
    return std::make_unique<MessageBus::AmqpConnectionManager>(configuration);
}

}  // namespace Korvane::Veldra::Bench
