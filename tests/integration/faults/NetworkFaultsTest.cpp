// Faults on the way to the broker, made by the proxy: slow traffic, traffic
// that vanishes, and connections reset under the instance.
#include <atomic>
#include <thread>
#include <vector>

#include "faults/FaultTestSupport.h"

namespace Korvane::Veldra::Testing {
namespace {

TEST_F(FaultBrokerTest, SlowTrafficSlowsCallsWithinTheirTimeOut) {
    const uint32_t reference = Open(UniquePath("slow"));
    ASSERT_NE(reference, 0u);
    Proxy().SetMode(FaultProxy::Mode::Delay, Millis(1500));
    const auto figures = MeasureFault(
        "delay 1500 ms/chunk", [&] { return Write(reference, "1.5"); }, Millis(8000),
        [] { Proxy().SetMode(FaultProxy::Mode::Pass); });
    // Both ways slowed, the round trip takes at least two delays, yet fits.
    EXPECT_FALSE(figures.firstError);
    TagConsoleValue value;
    EXPECT_EQ(Read(reference, value).status, 0);
    EXPECT_EQ(value.value, "1.5");
}

TEST_F(FaultBrokerTest, ABlackHoleTimesCallsOutAndTheInstanceWorksOnceItIsGone) {
    const uint32_t reference = Open(UniquePath("hole"));
    ASSERT_NE(reference, 0u);
    Proxy().SetMode(FaultProxy::Mode::BlackHole);
    const auto figures = MeasureFault(
        "black hole", [&] { return Write(reference, "2.5"); }, kRequestTimeout + kCallMargin,
        [] { Proxy().SetMode(FaultProxy::Mode::Pass); });
    EXPECT_EQ(figures.errorStatus, kRequestTimedOut);
    EXPECT_GE(figures.firstError.value_or(Millis(0)), kRequestTimeout - Millis(500));
}

TEST_F(FaultBrokerTest, AResetOfEveryConnectionIsOvercome) {
    const uint32_t reference = Open(UniquePath("reset"));
    ASSERT_NE(reference, 0u);
    ASSERT_TRUE(Proxy().ResetAll());
    MeasureFault(
        "reset", [&] { return Write(reference, "3.5"); }, Millis(3000), [] {});
}

// Threads on tags of their own read back across resets: a reply that
// reached the wrong caller shows as another tag's path or value.
TEST_F(FaultBrokerTest, RepliesReachTheirOwnCallersAcrossResets) {
    constexpr int kThreads = 4;
    std::vector<std::string> paths;
    std::vector<uint32_t> references;
    for (int i = 0; i < kThreads; ++i) {
        paths.push_back(UniquePath("caller" + std::to_string(i)));
        references.push_back(Open(paths.back()));
    }
    std::atomic<bool> stop{false};
    std::atomic<int> checked{0};
    std::vector<std::thread> threads;
    for (int i = 0; i < kThreads; ++i) {
        threads.emplace_back([&, i] {
            const std::string own = std::to_string(i) + ".";
            for (int n = 0; !stop; ++n) {
                // Never a trailing zero, which the service might drop from a double.
                const CallResult written = Write(references[i], own + std::to_string(n) + "1");
                EXPECT_LE(written.took, kRequestTimeout + kCallMargin);
                TagConsoleValue value;
                const CallResult read = Read(references[i], value);
                EXPECT_LE(read.took, kRequestTimeout + kCallMargin);
                if (read.status != 0) continue;
                EXPECT_EQ(value.path, paths[i]);
                EXPECT_EQ(value.value.rfind(own, 0), 0u) << "thread " << i << " read " << value.value;
                ++checked;
            }
        });
    }
    for (int round = 0; round < 10; ++round) {
        std::this_thread::sleep_for(Millis(300));  // the pace of the faults, not a wait
        EXPECT_TRUE(Proxy().ResetAll());
    }
    stop = true;
    for (auto& thread : threads) thread.join();
    EXPECT_GT(checked.load(), kThreads);
}

}  // namespace
}  // namespace Korvane::Veldra::Testing
