#include <gtest/gtest.h>

#include <atomic>
#include <memory>
#include <optional>
#include <string>
#include <thread>
#include <vector>

#include "errors/ErrorCodes.h"
#include "support/CatchVeldra.h"
#include "messagebus/concurrency/SharedQueue.h"
#include "support/SpinUntil.h"

namespace Korvane::Veldra::MessageBus {
namespace {

using ::Korvane::Veldra::Testing::SpinUntil;
using Testing::CatchVeldra;

TEST(SharedQueue, ItemsLeaveInArrivalOrderAndAnEmptyQueueGivesNothing) {
    SharedQueue<std::unique_ptr<int>> queue;
    for (int i = 0; i < 5; ++i) queue.Add(std::make_unique<int>(i));
    for (int i = 0; i < 5; ++i) {
        std::unique_ptr<int> out;
        ASSERT_TRUE(queue.TryTake(out, 0));
        EXPECT_EQ(*out, i);
    }
    std::unique_ptr<int> out;
    EXPECT_FALSE(queue.TryTake(out, 0));
    EXPECT_FALSE(queue.TryTake(out, 1));
    EXPECT_EQ(out, nullptr);
}

// Adds count items 0..count-1 and returns what comes back without waiting.
std::vector<int> FillAndDrain(SharedQueue<int>& queue, int count) {
    for (int i = 0; i < count; ++i) queue.Add(i);
    std::vector<int> taken;
    int out = 0;
    while (queue.TryTake(out, 0)) taken.push_back(out);
    return taken;
}

TEST(SharedQueue, BoundDropsSilentlyWhileUnboundedKeepsAll) {
    struct Case {
        int32_t bound;
        int added;
        size_t kept;
    };
    const Case cases[] = {{2, 3, 2}, {0, 3, 0}, {-1, 10000, 10000}};
    for (const auto& c : cases) {
        SharedQueue<int> queue(c.bound);
        const auto taken = FillAndDrain(queue, c.added);
        ASSERT_EQ(taken.size(), c.kept) << "bound " << c.bound;
        for (size_t i = 0; i < taken.size(); ++i) EXPECT_EQ(taken[i], static_cast<int>(i));
    }
}

TEST(SharedQueue, EvictingAddKeepsTheNewestWithinTheBound) {
    SharedQueue<int> ring(3);
    for (int i = 0; i < 10; ++i) ring.AddEvictingOldest(i);
    EXPECT_EQ(ring.Size(), 3u);
    std::vector<int> taken;
    for (int item = 0; ring.TryTake(item, 0);) taken.push_back(item);
    // One count per item kept: nothing more to take, nothing lost of the three.
    EXPECT_EQ(taken, (std::vector<int>{7, 8, 9}));
    EXPECT_EQ(ring.Size(), 0u);
}

TEST(SharedQueue, StoredErrorComesAfterTheItems) {
    SharedQueue<std::string> queue;
    queue.Add("first");
    queue.SetError("Publish failed");
    std::string out;
    ASSERT_TRUE(queue.TryTake(out, 0));
    EXPECT_EQ(out, "first");
    EXPECT_THROWS_VELDRA(queue.TryTake(out, 0), ErrorCodes::kQueueEmpty, "Publish failed");
    // The error used up its count.
    EXPECT_FALSE(queue.TryTake(out, 0));
    EXPECT_EQ(out, "first");
    queue.SetError("");
    EXPECT_THROWS_VELDRA(queue.TryTake(out, 0), ErrorCodes::kQueueEmpty, "");
}

TEST(SharedQueue, ClosedQueueDrainsThenEndsEveryTake) {
    SharedQueue<int> queue;
    queue.Add(1);
    queue.Close();
    queue.Add(2);  // after the close: dropped
    queue.Close();
    int out = 0;
    ASSERT_TRUE(queue.TryTake(out, 0));
    EXPECT_EQ(out, 1);
    for (int attempt = 0; attempt < 3; ++attempt) {
        EXPECT_THROWS_VELDRA(queue.TryTake(out, 0), ErrorCodes::kEndOfStream, "End Of Stream.");
    }
}

TEST(SharedQueue, BlockedTakersWakeOnErrorAndOnClose) {
    // Each taker is blocked before the error or the close arrives. A taker
    // that is not woken is ended by the close, so the joins always return.
    SharedQueue<int> queue;
    std::optional<VeldraException> errorSeen;
    std::atomic<int> ended{0};
    std::thread errorTaker([&] {
        int out = 0;
        errorSeen = CatchVeldra([&] { queue.TryTake(out, Semaphore::kInfinite); });
        ++ended;
    });
    EXPECT_TRUE(SpinUntil([&] { return queue.Takers() == 1; }));
    queue.SetError("gone");
    if (!SpinUntil([&] { return ended == 1; })) {
        ADD_FAILURE() << "the error did not wake the taker";
        queue.Close();
    }
    errorTaker.join();
    ASSERT_TRUE(errorSeen.has_value());
    EXPECT_EQ(errorSeen->Code(), ErrorCodes::kQueueEmpty);
    EXPECT_EQ(std::string(errorSeen->what()), "gone");

    std::vector<std::optional<VeldraException>> closeSeen(3);
    std::vector<std::thread> takers;
    for (auto& seen : closeSeen) {
        takers.emplace_back([&queue, &seen] {
            int out = 0;
            seen = CatchVeldra([&] { queue.TryTake(out, 600000); });
        });
    }
    EXPECT_TRUE(SpinUntil([&] { return queue.Takers() == 3; }));
    queue.Close();
    for (auto& taker : takers) taker.join();
    for (const auto& seen : closeSeen) {
        ASSERT_TRUE(seen.has_value());
        EXPECT_EQ(seen->Code(), ErrorCodes::kEndOfStream);
    }
}

TEST(SharedQueue, ConcurrentProducersAndConsumersLoseAndDuplicateNothing) {
    constexpr int kProducers = 4;
    constexpr int kConsumers = 3;
    constexpr int kPerProducer = 5000;
    constexpr int kEnd = -1;
    SharedQueue<int> queue;

    // Each consumer records what it took; an item is producer * kPerProducer + n.
    std::vector<std::vector<int>> taken(kConsumers);
    std::vector<std::thread> consumers;
    for (auto& mine : taken) {
        consumers.emplace_back([&queue, &mine] {
            for (;;) {
                int item = 0;
                if (!queue.TryTake(item, Semaphore::kInfinite)) continue;
                if (item == kEnd) return;
                mine.push_back(item);
            }
        });
    }
    std::vector<std::thread> producers;
    for (int p = 0; p < kProducers; ++p) {
        producers.emplace_back([&queue, p] {
            for (int n = 0; n < kPerProducer; ++n) queue.Add(p * kPerProducer + n);
        });
    }
    for (auto& producer : producers) producer.join();
    for (int c = 0; c < kConsumers; ++c) queue.Add(kEnd);
    for (auto& consumer : consumers) consumer.join();

    std::vector<int> seen(kProducers * kPerProducer, 0);
    for (const auto& mine : taken) {
        // One queue, first in first out: what one consumer got from one
        // producer is in that producer's order.
        std::vector<int> last(kProducers, -1);
        for (int item : mine) {
            ++seen[item];
            const int producer = item / kPerProducer;
            EXPECT_GT(item, last[producer]);
            last[producer] = item;
        }
    }
    for (size_t i = 0; i < seen.size(); ++i) ASSERT_EQ(seen[i], 1) << "item " << i;
}

}  // namespace
}  // namespace Korvane::Veldra::MessageBus
