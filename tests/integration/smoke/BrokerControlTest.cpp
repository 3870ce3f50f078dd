#include <amqp.h>
#include <gtest/gtest.h>

#include <algorithm>
#include <string>
#include <vector>

#include "support/BrokerEnvironment.h"
#include "support/RawAmqpConnection.h"

namespace Korvane::Veldra::Testing {
namespace {

// Whether the broker lists a connection whose client end is localPort.
::testing::AssertionResult BrokerListsConnectionFrom(int localPort) {
    std::vector<std::string> connections;
    auto listed = ListConnections(connections);
    if (!listed) {
        return listed;
    }
    const std::string prefix = "127.0.0.1:" + std::to_string(localPort) + " -> ";
    const bool found = std::any_of(connections.begin(), connections.end(),
                                   [&](const auto& line) { return line.rfind(prefix, 0) == 0; });
    if (found) {
        return ::testing::AssertionSuccess();
    }
    auto failure = ::testing::AssertionFailure() << "no connection from port " << localPort << ":";
    for (const auto& line : connections) {
        failure << "\n  " << line;
    }
    return failure;
}

TEST(BrokerControl, CloseAllConnectionsClosesTheClientsConnection) {
    RawAmqpConnection connection;
    ASSERT_EQ(connection.OpenTcp(Broker().Host, Broker().AmqpPort), AMQP_STATUS_OK);
    ASSERT_TRUE(connection.Login(Broker().User, Broker().Password));
    ASSERT_TRUE(connection.OpenChannel(1));
    ASSERT_TRUE(BrokerListsConnectionFrom(connection.LocalPort()));

    ASSERT_TRUE(CloseAllConnections());

    // The next call reads the broker's connection.close instead of its answer.
    amqp_channel_open(connection.Get(), 2);
    const amqp_rpc_reply_t reply = amqp_get_rpc_reply(connection.Get());
    ASSERT_EQ(reply.reply_type, AMQP_RESPONSE_SERVER_EXCEPTION) << ReplyText(reply);
    ASSERT_EQ(reply.reply.id, AMQP_CONNECTION_CLOSE_METHOD);
    const auto* close = static_cast<const amqp_connection_close_t*>(reply.reply.decoded);
    EXPECT_EQ(close->reply_code, AMQP_CONNECTION_FORCED);
}

// Starts the broker's application again if a test ends with it stopped.
class AppRestarter {
public:
    ~AppRestarter() {
        if (stopped_) {
            EXPECT_TRUE(StartApp());
        }
    }
    ::testing::AssertionResult Stop() {
        auto result = StopApp();
        stopped_ = true;
        return result;
    }
    ::testing::AssertionResult Start() {
        stopped_ = false;
        return StartApp();
    }

private:
    bool stopped_ = false;
};

TEST(BrokerControl, StopAppRefusesConnectionsUntilStartApp) {
    AppRestarter app;
    ASSERT_TRUE(app.Stop());
    {
        RawAmqpConnection refused;
        EXPECT_NE(refused.OpenTcp(Broker().Host, Broker().AmqpPort), AMQP_STATUS_OK);
    }
    ASSERT_TRUE(app.Start());

    RawAmqpConnection connection;
    ASSERT_EQ(connection.OpenTcp(Broker().Host, Broker().AmqpPort), AMQP_STATUS_OK);
    EXPECT_TRUE(connection.Login(Broker().User, Broker().Password));
}

}  // namespace
}  // namespace Korvane::Veldra::Testing
