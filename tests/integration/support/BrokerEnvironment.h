#pragma once

#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "support/BrokerSettings.h"
#include "support/CommandRunner.h"

namespace Korvane::Veldra::Testing {

// The GoogleTest environment of every broker-backed test executable; linking
// the support library registers it. Its SetUp reads the environment file that
// "broker.sh start" wrote (KVVELDRA_BROKER_ENV, else the build tree's file).
// Without the file every test is skipped with the reason, unless
// KVVELDRA_BROKER_REQUIRED=1 (set by ctest): then the process exits with
// status 1 and the reason.
class BrokerEnvironment : public ::testing::Environment {
public:
    void SetUp() override;

    // The environment file this process reads.
    static std::string EnvFilePath();
};

// The running broker's settings; only valid in tests, after SetUp found them.
const BrokerSettings& Broker();

// rabbitmqctl with args on the private node, bounded by timeoutSeconds.
CommandResult RunCtl(const std::vector<std::string>& args, int timeoutSeconds = 60);

// Control of the private node for tests; each fails with rabbitmqctl's output.
// CloseAllConnections has the broker close every client connection (with a
// connection.close 320 to the clients). StopApp stops the AMQP application, so
// that the listeners close and connects are refused; StartApp brings it back
// and returns once the listeners accept connections again.
::testing::AssertionResult CloseAllConnections();
::testing::AssertionResult StopApp();
::testing::AssertionResult StartApp();

// The open client connections, one entry each: the connection's name, which
// holds both ends ("127.0.0.1:41234 -> 127.0.0.1:25672"), a tab, its state.
::testing::AssertionResult ListConnections(std::vector<std::string>& connections);

}  // namespace Korvane::Veldra::Testing
