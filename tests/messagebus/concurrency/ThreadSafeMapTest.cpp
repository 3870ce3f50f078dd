#include <gtest/gtest.h>

#include <string>
#include <thread>
#include <vector>

#include "messagebus/concurrency/ThreadSafeMap.h"

namespace Korvane::Veldra::MessageBus {
namespace {

using Map = ThreadSafeMap<std::string, int>;

TEST(ThreadSafeMap, InsertKeepsAnExistingValueWhileInsertOrAssignReplacesIt) {
    Map map;
    EXPECT_TRUE(map.Insert("a", 1));
    EXPECT_FALSE(map.Insert("a", 2));
    int value = 0;
    ASSERT_TRUE(map.TryGet("a", value));
    EXPECT_EQ(value, 1);
    EXPECT_FALSE(map.InsertOrAssign("a", 3));
    EXPECT_TRUE(map.InsertOrAssign("b", 4));
    ASSERT_TRUE(map.TryGet("a", value));
    EXPECT_EQ(value, 3);
    EXPECT_EQ(map.Size(), 2u);
}

TEST(ThreadSafeMap, TakeAndEraseRemoveOnlyWhatIsThere) {
    Map map;
    map.Insert("x", 5);
    map.Insert("y", 6);
    int value = -1;
    EXPECT_FALSE(map.TryGet("z", value));
    EXPECT_FALSE(map.TryTake("z", value));
    EXPECT_EQ(value, -1);
    EXPECT_TRUE(map.TryTake("x", value));
    EXPECT_EQ(value, 5);
    EXPECT_FALSE(map.TryGet("x", value));
    EXPECT_FALSE(map.Erase("x"));
    EXPECT_FALSE(map.EraseIf("y", [](int v) { return v > 6; }));
    EXPECT_TRUE(map.EraseIf("y", [](int v) { return v == 6; }));
    EXPECT_FALSE(map.EraseIf("y", [](int) { return true; }));
    EXPECT_EQ(map.Size(), 0u);
}

TEST(ThreadSafeMap, ConcurrentWritersAndReaders) {
    constexpr int kWriters = 4;
    constexpr int kPerWriter = 2000;
    Map map;
    std::vector<std::thread> threads;
    for (int w = 0; w < kWriters; ++w) {
        threads.emplace_back([&map, w] {
            for (int i = 0; i < kPerWriter; ++i) {
                const std::string key = std::to_string(w) + "/" + std::to_string(i);
                map.Insert(key, i);
                // Every other entry is taken out again by its writer.
                int value = 0;
                if (i % 2 == 0) {
                    EXPECT_TRUE(map.TryTake(key, value));
                }
            }
        });
    }
    threads.emplace_back([&map] {
        for (int i = 0; i < 200; ++i) (void)map.Keys();
    });
    for (auto& thread : threads) thread.join();
    EXPECT_EQ(map.Size(), static_cast<size_t>(kWriters * kPerWriter / 2));
}

}  // namespace
}  // namespace Korvane::Veldra::MessageBus
