#pragma once

#include <memory>
#include <optional>
#include <string>

#include "messagebus/amqp/AmqpConnectionManager.h"

namespace Korvane::Veldra::Bench {

// Where the private test broker listens, as broker.sh describes it.
struct BrokerAddress {
    std::string host, user, password;
    int port = 0;
};

// Reads the KEY='value' file that "broker.sh start" writes: KVVELDRA_BROKER_ENV,
// else the one the test harness writes beside the build's benchmarks
// (<build>/tests/integration/broker/broker.env). path is the file read; the
// result is empty when it describes no broker.
std::optional<BrokerAddress> LoadBroker(std::string& path);

// The broker as LoadBroker finds it, or empty after a line on standard
// output saying that the benchmark of that name is skipped, and why.
std::optional<BrokerAddress> BrokerOrSkip(const std::string& benchmark);

// A manager of its own on the broker and exchange.
std::unique_ptr<MessageBus::AmqpConnectionManager> MakeManager(const BrokerAddress& broker,
                                                               const std::string& exchange);

}  // namespace Korvane::Veldra::Bench
