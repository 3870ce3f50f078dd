// What a Client starts and stops on the bus: its trace entries, its threads,
// and Initialize against a broker that cannot be reached.
#include <gtest/gtest.h>

#include <chrono>
#include <set>
#include <thread>

#include "client/ClientBrokerSupport.h"
#include "kvveldra/TagConsole.h"
#include "kvveldra/TagWB.h"
#include "messagebus/BusTestSupport.h"
#include "messagebus/amqp/AmqpConsumer.h"
#include "messagebus/service/MessageService.h"
#include "messagelibrary/tracelogger/TraceLoggerStoreEntriesRoutedMessage.h"
#include "taglibrary/exports/ProcessState.h"

namespace Korvane::Veldra::Testing {
namespace {

namespace Trace = VeldraMessageLibrary::TraceLoggerMessages;
using std::chrono::milliseconds;
using TagLibrary::ProcessState;

// What the TraceLogger service would receive: everything routed to it.
struct TraceLoggerQueue {
    TraceLoggerQueue() : manager(MakeTestManager(5000)) {
        MessageBus::AmqpConsumerBuilder builder;
        builder.QueueName = UniqueQueueName("traces");
        builder.ReceiveCallback = callback;
        builder.ConnectionManager = manager.get();
        consumer = std::make_unique<MessageBus::AmqpConsumer>(builder);
        consumer->Bind({"TraceLogger", "#"});
        consumer->StartConsuming();
    }
    ~TraceLoggerQueue() { consumer->StopConsuming(); }

    // The store messages from the module, once they hold `count` entries.
    std::vector<Trace::TraceLoggerStoreEntriesRoutedMessage> StoredBy(const std::string& module,
                                                                      std::size_t count) {
        std::vector<Trace::TraceLoggerStoreEntriesRoutedMessage> batches;
        // Each pass of the wait sees every message again; each counts once.
        std::set<const GenericMessage*> seen;
        callback->messages.WaitFor(
            [&](const std::shared_ptr<GenericMessage>& message) {
                if (message->MessageType() != Trace::TraceLoggerStoreEntriesRoutedMessage::kMessageName ||
                    !seen.insert(message.get()).second)
                    return false;
                Trace::TraceLoggerStoreEntriesRoutedMessage batch(message->Headers(),
                                                                  message->Body());
                if (batch.Entries() && !batch.Entries()->empty() &&
                    batch.Entries()->front().moduleName == module) {
                    batches.push_back(batch);
                }
                std::size_t entries = 0;
                for (const auto& stored : batches) entries += stored.Entries()->size();
                return entries >= count;
            },
            milliseconds(15000));
        return batches;
    }

    std::unique_ptr<MessageBus::AmqpConnectionManager> manager;
    std::shared_ptr<RecordingCallback> callback = std::make_shared<RecordingCallback>();
    std::unique_ptr<MessageBus::AmqpConsumer> consumer;
};

TEST_F(ClientBrokerTest, TraceEntriesLeaveInBatchesAndABurstLosesNone) {
    TraceLoggerQueue traces;
    const auto client = NewClient();
    EXPECT_TRUE(traces.callback->messages
                    .WaitFor([](const auto& message) {
                        return message->MessageType() ==
                                   "TraceLoggerBroadcastTracePointsRoutedMessage" &&
                               message->Origin() == "TagClient";
                    },
                             milliseconds(10000))
                    .has_value());

    const auto logger = client->Service()->GetTraceLogger();
    EXPECT_EQ(logger->GetName(), "TagClient");
    constexpr std::size_t kBurst = 501;
    for (std::size_t i = 0; i < kBurst; ++i) logger->Info("burst " + std::to_string(i));

    const auto batches = traces.StoredBy("TagClient", kBurst);
    std::vector<std::string> texts;
    for (const auto& batch : batches) {
        EXPECT_LE(batch.Entries()->size(), 500u);
        for (const auto& entry : *batch.Entries()) {
            if (entry.text && entry.text->rfind("burst ", 0) == 0) texts.push_back(*entry.text);
        }
    }
    EXPECT_GE(batches.size(), 2u);
    ASSERT_EQ(texts.size(), kBurst);
    for (std::size_t i = 0; i < kBurst; ++i) ASSERT_EQ(texts[i], "burst " + std::to_string(i));
}

TEST_F(ClientBrokerTest, ADestroyedClientLeavesNoThreadBehindEvenWithRequestsInFlight) {
    const int before = AwaitThreadCount(-1, milliseconds(0));
    auto lookup = std::make_shared<ConsoleAsyncRequest>();
    PausedService paused(-1);
    {
        auto client = NewClient();
        std::string error;
        std::shared_ptr<TagData> tag;
        ASSERT_EQ(Open(*client, UniquePath("threads"), TagDataType::String, tag, error), 0)
            << error;
        // Six bus threads of the manager and the subscriber, one logging thread.
        EXPECT_EQ(AwaitThreadCount(before + 7, milliseconds(5000)), before + 7);

        // Kept still until the Client is gone, so the lookup stays in flight.
        paused.Pause(service->Pid());
        uint32_t id = 0, timeoutMs = 0;
        ASSERT_EQ(client->OpenTag(UniquePath("in.flight"), lookup, id, timeoutMs, error), 0);
    }
    EXPECT_EQ(AwaitThreadCount(before, milliseconds(5000)), before);
    // A caller still waiting runs into its own time-out.
    std::thread caller([lookup] { lookup->Wait(200); });
    caller.join();
    EXPECT_EQ(lookup->Response(), nullptr);
}

TEST_F(ClientBrokerTest, InitializeConnectsAndAnUnreachableBrokerFailsWithinTheTimeOut) {
    bool reserved = false;
    ASSERT_EQ(TagConsoleReserve(&reserved), 0);
    std::string error;
    EXPECT_EQ(TagConsoleInitialize(0, nullptr, nullptr, nullptr, &error), 0) << error;

    const std::string unreachable = kUnreachableId;
    const uint32_t timeoutMs = 3000;
    const bool noFallback = false;
    const auto start = std::chrono::steady_clock::now();
    const int32_t status =
        TagConsoleInitialize(9, &unreachable, &timeoutMs, &noFallback, &error);
    EXPECT_LT(std::chrono::steady_clock::now() - start, milliseconds(timeoutMs + 2000));
    EXPECT_LT(status, 0);
    EXPECT_FALSE(error.empty());
    EXPECT_EQ(error, ProcessState::Get().SharedErrors()->messageForCode(status));
    {
        auto& state = ProcessState::Get();
        std::lock_guard<std::mutex> lock(state.TableMutex);
        EXPECT_EQ(state.ClientTable.count(9), 0u);
        EXPECT_NE(state.ClientTable.at(0), nullptr);
    }
    EXPECT_EQ(TagConsoleUnreserve(&reserved), 0);
}

TEST_F(ClientBrokerTest, TheHostFamilyInitializesAConnectedClient) {
    bool reserved = false;
    ASSERT_EQ(TagWBReserve(&reserved), 0);
    bool created = false;
    WBStrHandle error = nullptr;
    EXPECT_EQ(TagWBInitialize(3, nullptr, 5000, nullptr, &created, &error), 0);
    EXPECT_TRUE(created);
    EXPECT_EQ(error, nullptr);
    EXPECT_EQ(TagWBCloseInstance(3, &error), 0);
    EXPECT_EQ(TagWBUnreserve(&reserved), 0);
}

}  // namespace
}  // namespace Korvane::Veldra::Testing
