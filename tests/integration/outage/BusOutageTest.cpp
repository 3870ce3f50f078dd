// The bus under faults that a proxy or a second connection makes: the
// exchange deleted under a running publisher, a hundred outages in a row, and
// a broker host name that does not resolve.
#include <amqp.h>
#include <dirent.h>
#include <gtest/gtest.h>

#include <cstdio>
#include <memory>
#include <string>

#include "errors/VeldraException.h"
#include "messagebus/amqp/AmqpConnectionManager.h"
#include "outage/OutageSupport.h"
#include "service/ServiceTestSupport.h"
#include "support/BrokerEnvironment.h"
#include "support/FaultProxy.h"
#include "support/RawAmqpConnection.h"

namespace Korvane::Veldra::Testing {
namespace {

constexpr char kExchange[] = "kvveldra.amqpio.test";

int CountEntries(const char* directory) {
    int count = 0;
    if (DIR* dir = opendir(directory)) {
        while (const dirent* entry = readdir(dir)) count += entry->d_name[0] != '.';
        closedir(dir);
    }
    return count;
}

std::unique_ptr<MessageBus::AmqpConnectionManager> ManagerOnPort(int port, const std::string& host) {
    MessageBus::VeldraConfiguration configuration;
    configuration.Host = host;
    configuration.Port = port;
    configuration.User = Broker().User;
    configuration.Password = Broker().Password;
    configuration.ExchangeName = kExchange;
    auto manager = std::make_unique<MessageBus::AmqpConnectionManager>(configuration);
    manager->SetConnectTimeout(30000);
    return manager;
}

// A request to the responder; null when no answer came in time or the send
// failed.
MessagePtr Ask(MessageService& client, MessageService& server, uint32_t timeoutMs) {
    TestRequest request("EchoRequest", server.QueueName());
    try {
        return client.SendRequest(request, timeoutMs);
    } catch (const MessageBus::VeldraException&) {
        return nullptr;
    }
}

// Asks until an answer comes, within `limit`; true when one did.
bool AnsweredWithin(MessageService& client, MessageService& server, milliseconds limit) {
    const auto start = OutageClock::now();
    while (OutageClock::now() - start < limit) {
        if (Ask(client, server, 1000)) return true;
        std::this_thread::sleep_for(milliseconds(50));  // a failed send comes back at once
    }
    return false;
}

void DeleteExchange() {
    RawAmqpConnection raw;
    ASSERT_EQ(raw.OpenTcp(Broker().Host, Broker().AmqpPort), 0);
    ASSERT_TRUE(raw.Login(Broker().User, Broker().Password));
    ASSERT_TRUE(raw.OpenChannel(1));
    amqp_exchange_delete(raw.Get(), 1, amqp_cstring_bytes(kExchange), 0);
    const amqp_rpc_reply_t reply = amqp_get_rpc_reply(raw.Get());
    ASSERT_EQ(reply.reply_type, AMQP_RESPONSE_NORMAL) << ReplyText(reply);
}

TEST(BusOutage, ADeletedExchangeIsDeclaredAgainAndRequestsAreAnsweredAgain) {
    auto manager = ManagerOnPort(Broker().AmqpPort, Broker().Host);
    MessageService client{ServiceSettings(*manager, "exchange_client")};
    MessageService server{ServiceSettings(*manager, "exchange_server")};
    const auto responder = Responder::On(server);
    responder->Open();
    ASSERT_TRUE(Ask(client, server, 10000)) << "no answer before the fault";

    DeleteExchange();
    const auto deleted = OutageClock::now();
    ASSERT_TRUE(AnsweredWithin(client, server, milliseconds(15000)))
        << "the publisher never came back after the exchange was deleted";
    const long long recoveredMs = MillisBetween(deleted, OutageClock::now());
    int answered = 0;
    for (int i = 0; i < 20; ++i) answered += Ask(client, server, 10000) != nullptr;
    EXPECT_EQ(answered, 20);
    std::printf("exchange deleted: answered again after %lld ms, then %d of 20\n", recoveredMs, answered);
    std::fflush(stdout);
}

// What a hundred outages could leave behind.
struct Counts {
    int threads = 0;
    int descriptors = 0;
    std::size_t correlationEntries = 0;
    std::size_t waiters = 0;
    std::string Text() const {
        return "threads " + std::to_string(threads) + ", descriptors " + std::to_string(descriptors) +
               ", correlation entries " + std::to_string(correlationEntries) + ", waiters " +
               std::to_string(waiters);
    }
    bool NoMoreThan(const Counts& other) const {
        return threads <= other.threads && descriptors <= other.descriptors &&
               correlationEntries <= other.correlationEntries && waiters <= other.waiters;
    }
};

Counts Take(MessageService& client) {
    return Counts{CountEntries("/proc/self/task"), CountEntries("/proc/self/fd"),
                  client.Subscriber()->CorrIdCallbacks()->Size(),
                  client.Subscriber()->SynchCallbacks()->Size()};
}

std::size_t DrainStatusLines(MessageBus::AmqpConnectionManager& manager) {
    std::size_t drained = 0;
    std::string line;
    while (manager.TakeLog(line, 0)) ++drained;
    return drained;
}

TEST(BusOutage, AHundredOutagesLeaveNoThreadDescriptorEntryOrStatusLineBehind) {
    FaultProxy proxy(Broker().AmqpPort);
    auto serverManager = ManagerOnPort(Broker().AmqpPort, Broker().Host);
    auto clientManager = ManagerOnPort(proxy.Port(), Broker().Host);
    MessageBus::MessageServiceSettings clientSettings = ServiceSettings(*clientManager, "cycles_client");
    clientSettings.DefaultTimeoutMs = 1000;  // the time-out of the asynchronous requests
    MessageService client{clientSettings};
    MessageService server{ServiceSettings(*serverManager, "cycles_server")};
    const auto responder = Responder::On(server);
    responder->Open();
    ASSERT_TRUE(AnsweredWithin(client, server, milliseconds(10000)));
    DrainStatusLines(*clientManager);
    const Counts before = Take(client);

    int sendFailures = 0;
    for (int cycle = 0; cycle < 100; ++cycle) {
        ASSERT_TRUE(proxy.ResetAll());
        TestRequest async("EchoRequest", server.QueueName());
        try {
            client.SendRequestAsync(async, 1 + cycle);
        } catch (const MessageBus::VeldraException&) {
            ++sendFailures;
        }
        Ask(client, server, 200);
        // Now and then the whole way back: reconnect, rebind, answer.
        if (cycle % 10 == 9) {
            ASSERT_TRUE(AnsweredWithin(client, server, milliseconds(10000))) << "cycle " << cycle;
        }
    }
    ASSERT_TRUE(AnsweredWithin(client, server, milliseconds(15000))) << "no recovery after the cycles";
    // Entries of requests that timed out go with the next registration after
    // their time-out; threads and sockets of dropped connections may still be
    // on their way out. Nothing signals either, so both are looked at again.
    Counts after = Take(client);
    for (int i = 0; i < 100 && !after.NoMoreThan(before); ++i) {
        TestRequest async("EchoRequest", server.QueueName());
        client.SendRequestAsync(async, 1);
        std::this_thread::sleep_for(milliseconds(100));
        after = Take(client);
    }
    const std::size_t kept = clientManager->StatusLineCount();
    const std::size_t drained = DrainStatusLines(*clientManager);
    std::printf("outage cycles: 100 resets, %d sends failed; before: %s; after: %s; status lines kept %zu, "
                "drained %zu\n",
                sendFailures, before.Text().c_str(), after.Text().c_str(), kept, drained);
    std::fflush(stdout);
    EXPECT_TRUE(after.NoMoreThan(before)) << "before: " << before.Text() << "; after: " << after.Text();
    EXPECT_LE(kept, static_cast<std::size_t>(MessageBus::AmqpConnectionManager::kStatusLineLimit));
    EXPECT_EQ(drained, kept);
    EXPECT_EQ(clientManager->StatusLineCount(), 0u);
}

TEST(BusOutage, AHostNameThatDoesNotResolveCostsNoCpuWhileConnecting) {
    auto manager = ManagerOnPort(Broker().AmqpPort, "no-such-host.invalid");
    manager->SetConnectTimeout(10000);
    const double cpuBefore = ProcessCpuSeconds();
    const auto start = OutageClock::now();
    EXPECT_THROW(manager->CreatePublisherChannel(), MessageBus::VeldraException);
    const double seconds = std::chrono::duration<double>(OutageClock::now() - start).count();
    const double share = (ProcessCpuSeconds() - cpuBefore) / seconds;
    std::printf("unresolvable host: gave up after %.1f s, %.2f %% of a core\n", seconds, share * 100);
    std::fflush(stdout);
    EXPECT_GE(seconds, 9.0);
    EXPECT_LT(share, 0.05);
}

}  // namespace
}  // namespace Korvane::Veldra::Testing
