#include <gtest/gtest.h>

#include <atomic>
#include <memory>
#include <thread>
#include <vector>

#include "messagebus/concurrency/BlockingCollection.h"
#include "errors/ErrorCodes.h"
#include "support/CatchVeldra.h"

namespace Korvane::Veldra::MessageBus {
namespace {

using Testing::CatchVeldra;

TEST(BlockingCollection, ItemsLeaveFirstInFirstOut) {
    BlockingCollection<std::unique_ptr<int>> collection;
    for (int i = 0; i < 4; ++i) collection.Push(std::make_unique<int>(i));
    for (int i = 0; i < 4; ++i) EXPECT_EQ(*collection.Take(), i);
}

TEST(BlockingCollection, CloseDrainsThenEndsEveryConsumer) {
    BlockingCollection<int> collection;
    collection.Push(1);
    collection.Close();
    collection.Push(2);
    EXPECT_EQ(collection.Take(), 1);
    EXPECT_THROWS_VELDRA(collection.Take(), ErrorCodes::kEndOfStream, "End Of Stream.");
    EXPECT_THROWS_VELDRA(collection.Take(), ErrorCodes::kEndOfStream, "End Of Stream.");
}

TEST(BlockingCollection, HandlerThreadsShareTheWorkAndStopAtClose) {
    constexpr int kHandlers = 3;
    constexpr int kItems = 20000;
    BlockingCollection<int> collection;
    std::atomic<long long> sum{0};
    std::atomic<int> count{0};
    std::atomic<int> ended{0};
    std::vector<std::thread> handlers;
    for (int h = 0; h < kHandlers; ++h) {
        handlers.emplace_back([&] {
            const auto end = CatchVeldra([&] {
                for (;;) {
                    sum += collection.Take();
                    ++count;
                }
            });
            if (end && end->Code() == ErrorCodes::kEndOfStream) ++ended;
        });
    }
    std::thread producerA([&] {
        for (int i = 1; i <= kItems / 2; ++i) collection.Push(i);
    });
    std::thread producerB([&] {
        for (int i = kItems / 2 + 1; i <= kItems; ++i) collection.Push(i);
    });
    producerA.join();
    producerB.join();
    collection.Close();
    for (auto& handler : handlers) handler.join();
    EXPECT_EQ(count.load(), kItems);
    EXPECT_EQ(sum.load(), static_cast<long long>(kItems) * (kItems + 1) / 2);
    EXPECT_EQ(ended.load(), kHandlers);
}

}  // namespace
}  // namespace Korvane::Veldra::MessageBus
