#include <dirent.h>
#include <gtest/gtest.h>

#include <string>
#include <thread>
#include <vector>

#include "errors/AmqpException.h"
#include "messagebus/amqp/AmqpConnectionManager.h"
#include "messagebus/amqp/AmqpConsumerConnection.h"
#include "errors/ErrorCodes.h"
#include "messagebus/amqp/AmqpPublisherConnection.h"
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

int ThreadCount() {
    int count = 0;
    if (DIR* tasks = opendir("/proc/self/task")) {
        while (const dirent* entry = readdir(tasks)) count += entry->d_name[0] != '.';
        closedir(tasks);
    }
    return count;
}

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
    const int threadsBefore = ThreadCount();
    const std::string queue = "kvveldra.amqpconn.manager.queue";
    {
        AmqpConnectionManager manager(BrokerRecord("kvveldra.amqpconn.manager", Broker().Password));
        const auto publisher = manager.GetPublisherConnection();
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
    }
    EXPECT_EQ(ThreadCount(), threadsBefore);  // no thread outlives the manager
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
