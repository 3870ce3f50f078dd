#include <gtest/gtest.h>

#include <atomic>
#include <future>
#include <memory>
#include <string>
#include <thread>
#include <vector>

#include "ServiceTestSupport.h"

namespace Korvane::Veldra::Testing {
namespace {

constexpr milliseconds kArrival(20000);

using ServiceDispatch = ServiceFixture;

TEST_F(ServiceDispatch, CorrelationCallbackBeatsNameCallback) {
    responder->Open();
    InboxCallback byState;
    client.SetStateResponseCallback(&byState);
    const auto byName = std::make_shared<InboxCallback>();
    client.Subscriber()->RegisterMessageCallback("GenericResponse", byName, false);

    TestRequest tracked("EchoRequest", server.QueueName());
    client.SendRequestAsync(tracked, 5);
    TestRequest untracked("EchoRequest", server.QueueName());
    client.Publish(untracked);

    // The server answers in order, so the tracked response came first.
    ASSERT_TRUE(byName->WaitFor(untracked.CorrelationId(), kArrival));
    const auto response = byState.WaitFor(tracked.CorrelationId(), milliseconds(0));
    ASSERT_TRUE(response.has_value());
    EXPECT_EQ(response->second, 5u);
    EXPECT_FALSE(byName->WaitFor(tracked.CorrelationId(), milliseconds(0)));
    client.SetStateResponseCallback(nullptr);
}

TEST_F(ServiceDispatch, BroadcastReachesEveryRegisteredServiceUntilUnregistered) {
    const std::string name = UniqueQueueName("ServiceTestBroadcast");
    std::vector<std::unique_ptr<MessageService>> services;
    std::vector<std::shared_ptr<InboxCallback>> broadcasts, others;
    for (int i = 0; i < 3; ++i) {
        services.push_back(
            std::make_unique<MessageService>(ServiceSettings(*manager, "svc_listener")));
        broadcasts.push_back(std::make_shared<InboxCallback>());
        others.push_back(std::make_shared<InboxCallback>());
        services[i]->SetDefaultResponseCallback(others[i]);
        services[i]->RegisterBroadcast(name, broadcasts[i]);
    }
    TestBroadcast first(name, "");
    client.Publish(first);
    for (const auto& inbox : broadcasts)
        EXPECT_TRUE(inbox->WaitFor(first.CorrelationId(), kArrival));

    services[1]->UnregisterBroadcast(name);
    TestBroadcast second(name, "");
    client.Publish(second);
    // Sent after the broadcast on the same channel: had the broadcast reached
    // the queue, it would have arrived before the marker.
    TestRouted marker("Marker", services[1]->QueueName());
    client.Publish(marker);
    ASSERT_TRUE(others[1]->WaitFor(marker.CorrelationId(), kArrival));
    EXPECT_FALSE(broadcasts[1]->WaitFor(second.CorrelationId(), milliseconds(0)));
    EXPECT_FALSE(others[1]->WaitFor(second.CorrelationId(), milliseconds(0)));
    EXPECT_TRUE(broadcasts[0]->WaitFor(second.CorrelationId(), kArrival));
    EXPECT_TRUE(broadcasts[2]->WaitFor(second.CorrelationId(), kArrival));
}

// Counts responses by state; done once every state in 1..size came in.
class StateCounter : public MessageBus::Interfaces::IResponseCallback {
public:
    explicit StateCounter(uint32_t size) : counts(size + 1) {}
    void OnResponse(MessagePtr, uint32_t state) override {
        if (state < counts.size()) ++counts[state];
        if (++total == counts.size() - 1) done.set_value();
    }
    std::vector<std::atomic<int>> counts;
    std::atomic<size_t> total{0};
    std::promise<void> done;
};

TEST_F(ServiceDispatch, AsynchronousRequestsFromManyThreadsCompleteExactlyOnce) {
    constexpr uint32_t kThreads = 8, kPerThread = 1250;
    responder->Open();
    StateCounter counter(kThreads * kPerThread);
    client.SetStateResponseCallback(&counter);

    std::vector<std::thread> senders;
    std::atomic<int> failures{0};
    for (uint32_t t = 0; t < kThreads; ++t) {
        senders.emplace_back([&, t] {
            for (uint32_t i = 1; i <= kPerThread; ++i) {
                TestRequest request("EchoRequest", server.QueueName());
                try {
                    client.SendRequestAsync(request, t * kPerThread + i);
                } catch (const std::exception&) {
                    ++failures;
                }
            }
        });
    }
    for (std::thread& sender : senders) sender.join();
    ASSERT_EQ(failures, 0);
    ASSERT_EQ(counter.done.get_future().wait_for(std::chrono::minutes(2)),
              std::future_status::ready);

    for (uint32_t state = 1; state < counter.counts.size(); ++state) {
        EXPECT_EQ(counter.counts[state], 1) << state;
    }
    EXPECT_EQ(client.Subscriber()->CorrIdCallbacks()->Size(), 0u);
    EXPECT_EQ(client.Subscriber()->SynchCallbacks()->Size(), 0u);
    EXPECT_FALSE(unclaimed->messages.WaitFor([](const auto&) { return true; }, milliseconds(0)));
    client.SetStateResponseCallback(nullptr);
}

}  // namespace
}  // namespace Korvane::Veldra::Testing
