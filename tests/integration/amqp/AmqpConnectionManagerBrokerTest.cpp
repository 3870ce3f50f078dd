#include <gtest/gtest.h>
#include <netinet/in.h>
#include <sys/socket.h>
#include <unistd.h>

#include <chrono>
#include <future>
#include <string>
#include <thread>
#include <vector>

#include "errors/AmqpException.h"
#include "messagebus/amqp/AmqpConnectionManager.h"
#include "messagebus/amqp/AmqpConsumerConnection.h"
#include "errors/ErrorCodes.h"
#include "messagebus/amqp/AmqpPublisherConnection.h"
#include "messagebus/BusTestSupport.h"
#include "support/BrokerEnvironment.h"

namespace Korvane::Veldra::MessageBus {
namespace {

namespace Harness = ::Korvane::Veldra::Testing;
using Harness::Broker;

VeldraConfiguration BrokerRecord(const std::string& exchange, const std::string& password) {
    VeldraConfiguration record;
    record.Host = Broker().Host;
    record.Port = Broker().AmqpPort;
    record.User = Broker().User;
    record.Password = password;
    record.ExchangeName = exchange;
    return record;
}

using namespace std::chrono_literals;
using Harness::AwaitThreadCount;

// A loopback port that listens and never accepts: the kernel completes the
// TCP handshake, then nothing ever speaks AMQP.
class SilentListener {
public:
    SilentListener() : fd_(socket(AF_INET, SOCK_STREAM, 0)) {
        sockaddr_in address{};
        address.sin_family = AF_INET;
        address.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
        socklen_t length = sizeof address;
        if (fd_ >= 0 && bind(fd_, reinterpret_cast<sockaddr*>(&address), length) == 0 &&
            listen(fd_, 4) == 0 &&
            getsockname(fd_, reinterpret_cast<sockaddr*>(&address), &length) == 0) {
            port_ = ntohs(address.sin_port);
        }
    }
    ~SilentListener() {
        if (fd_ >= 0) close(fd_);
    }
    int32_t Port() const { return port_; }

private:
    int fd_;
    int32_t port_ = 0;
};

// How many bindings the broker lists with the routing key.
int BindingsWithKey(const std::string& key) {
    const auto listed = Harness::RunCtl({"list_bindings", "-q", "routing_key"});
    EXPECT_TRUE(listed.Ok()) << listed.Output;
    int count = 0;
    for (std::size_t at = listed.Output.find(key); at != std::string::npos;
         at = listed.Output.find(key, at + 1)) {
        count += listed.Output.compare(at, key.size() + 1, key + "\n") == 0;
    }
    return count;
}

TEST(AmqpConnectionManagerBroker, MakesEachConnectionOnceAndBindsOnlyOnChange) {
    // A first thread makes any helper thread of the runtime (a sanitizer's).
    std::thread([] {}).join();
    const int threadsBefore = AwaitThreadCount(-1, 0ms);
    const std::string queue = "kvveldra.amqpconn.manager.queue";
    {
        AmqpConnectionManager manager(BrokerRecord("kvveldra.amqpconn.manager", Broker().Password));
        // Two first uses at once: both connect, one connection is kept.
        auto racing =
            std::async(std::launch::async, [&] { return manager.GetPublisherConnection(); });
        const auto publisher = manager.GetPublisherConnection();
        ASSERT_EQ(racing.wait_for(60s), std::future_status::ready);
        EXPECT_EQ(racing.get(), publisher);
        EXPECT_EQ(manager.GetPublisherConnection(), publisher);
        const auto channel = manager.CreateConsumerChannel();
        EXPECT_EQ(manager.GetConsumerConnection()->FindChannel(channel->Id), channel);

        manager.DeclareQueue(channel, queue, false, false, true);
        manager.AddBinding(channel, queue, {"amqpconn_1234", "#"}, true);
        manager.AddBinding(channel, queue, {"amqpconn_1234", "#"}, true);
        EXPECT_EQ(BindingsWithKey("Veldra.amqpconn_1234.#"), 1);
        manager.RemoveBinding(channel, queue, {"unknown"});
        manager.RemoveBinding(channel, queue, {"amqpconn_1234", "#"});
        EXPECT_EQ(BindingsWithKey("Veldra.amqpconn_1234.#"), 0);
        manager.Start();
        // Publisher and consumer, reader and reconnect thread each; a second
        // publisher connection made by the race is gone.
        EXPECT_EQ(AwaitThreadCount(threadsBefore + 4, 5000ms), threadsBefore + 4);
    }
    // No thread outlives the manager; a joined thread may stay listed a moment.
    EXPECT_EQ(AwaitThreadCount(threadsBefore, 5000ms), threadsBefore);
}

TEST(AmqpConnectionManagerBroker, ASilentBrokerDoesNotHoldUpAnotherManager) {
    SilentListener silent;
    ASSERT_NE(silent.Port(), 0);
    VeldraConfiguration silentRecord = BrokerRecord("kvveldra.amqpconn.silent", Broker().Password);
    silentRecord.Host = "127.0.0.1";
    silentRecord.Port = silent.Port();
    AmqpConnectionManager stuck(silentRecord);
    const auto stuckTimeout = 10s;
    stuck.SetConnectTimeout(std::chrono::milliseconds(stuckTimeout).count());
    auto stalled = std::async(std::launch::async, [&] {
        try {
            stuck.GetPublisherConnection();
        } catch (const AmqpException& error) {
            return error.Code();
        }
        return 0;
    });
    std::string line;
    ASSERT_TRUE(stuck.TakeLog(line, 5000)) << "the first manager never began to connect";

    AmqpConnectionManager other(BrokerRecord("kvveldra.amqpconn.manager", Broker().Password));
    const auto start = std::chrono::steady_clock::now();
    other.GetPublisherConnection();
    const auto waited = std::chrono::steady_clock::now() - start;
    EXPECT_LT(std::chrono::duration_cast<std::chrono::milliseconds>(waited).count(), 5000);
    EXPECT_EQ(stalled.wait_for(0s), std::future_status::timeout)
        << "the first manager was no longer connecting";
    // Its login gives up at its connect time-out.
    ASSERT_EQ(stalled.wait_for(stuckTimeout * 2), std::future_status::ready);
    EXPECT_EQ(stalled.get(), ErrorCodes::kFailedToLogIn);
}

TEST(AmqpConnectionManagerBroker, FailedFirstUseLeavesNoConnectionAndTriesAgain) {
    AmqpConnectionManager manager(BrokerRecord("kvveldra.amqpconn.login", "not-the-password"));
    manager.SetConnectTimeout(1000);
    for (int attempt = 0; attempt < 2; ++attempt) {
        try {
            manager.GetPublisherConnection();
            ADD_FAILURE() << "logged in with a wrong password";
        } catch (const AmqpException& error) {
            EXPECT_EQ(error.Code(), ErrorCodes::kFailedToLogIn);
            EXPECT_EQ(std::string(error.what()).rfind("Error logging in to RabbitMQ. ", 0), 0u);
        }
        std::string line;
        ASSERT_TRUE(manager.TakeLog(line, 0));
        EXPECT_EQ(line, "Connecting to AMQP with 1000ms timeout...");
    }
}

}  // namespace
}  // namespace Korvane::Veldra::MessageBus
