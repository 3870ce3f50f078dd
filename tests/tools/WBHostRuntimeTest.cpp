#include <gtest/gtest.h>

#include <atomic>
#include <chrono>
#include <cstring>
#include <thread>
#include <vector>

#include "WBHostRuntime.h"

namespace {

// Long enough never to run out on a loaded machine; a wait that ends early
// never takes it.
constexpr uint32_t kLongWaitMs = 30000;

WBStrHandle NewText(const char* text) {
    const auto length = static_cast<int32_t>(std::strlen(text));
    auto handle = reinterpret_cast<WBStrHandle>(WBNewHandleClr(sizeof(int32_t) + static_cast<size_t>(length)));
    (*handle)->cnt = length;
    std::memcpy((*handle)->str, text, static_cast<size_t>(length));
    return handle;
}

class WBHostVariantFailures : public ::testing::Test {
protected:
    void TearDown() override { WbVariantFailNextCalls(0, 0); }
};

TEST_F(WBHostVariantFailures, FailingCallsReturnTheStatusAndLeaveTheVariant) {
    WbVariant* variant = WbVariantNew();
    ASSERT_EQ(WbVariantSetDBL(variant, 1.5), 0);
    WBStrHandle text = NewText("abc");

    WbVariantFailNextCalls(6, 42);
    EXPECT_EQ(WbVariantSetDBL(variant, 2.5), 42);
    EXPECT_EQ(WbVariantSetI32(variant, 7), 42);
    EXPECT_EQ(WbVariantSetUI32(variant, 7u), 42);
    EXPECT_EQ(WbVariantSetBool(variant, 1), 42);
    EXPECT_EQ(WbVariantSetLStr(variant, text), 42);
    WbVariant* nested = variant;
    EXPECT_EQ(WbVariantNestInVariant(&nested), 42);
    EXPECT_EQ(nested, variant);
    EXPECT_EQ(WbVariantGetType(variant), WbVariantDouble);
    EXPECT_EQ(*static_cast<double*>(WbVariantGetDataPtr(variant)), 1.5);

    // The seventh call acts again, and the variant takes the handle over.
    ASSERT_EQ(WbVariantSetLStr(variant, text), 0);
    EXPECT_EQ(WbVariantGetType(variant), WbVariantLStr);
    // A failing call on a string variant keeps its copy of the text.
    WbVariantFailNextCalls(1, -3);
    EXPECT_EQ(WbVariantSetI32(variant, 1), -3);
    const WBStrHandle kept = *static_cast<WBStrHandle*>(WbVariantGetDataPtr(variant));
    ASSERT_NE(kept, nullptr);
    EXPECT_EQ((*kept)->cnt, 3);
    WbVariantFree(variant);
}

TEST(WBHostVariants, AStringVariantTakesOnlyAHandleOfTheHostsMemoryOver) {
    WbVariant* variant = WbVariantNew();
    // A handle built in the caller's own memory, as a host would never free it.
    std::vector<unsigned char> block(sizeof(int32_t) + 3);
    auto* foreign = reinterpret_cast<WBStr*>(block.data());
    foreign->cnt = 3;
    std::memcpy(foreign->str, "abc", 3);
    EXPECT_EQ(WbVariantSetLStr(variant, &foreign), 1);
    EXPECT_EQ(WbVariantGetType(variant), WbVariantEmpty);

    // A host handle is taken over: the variant frees it with itself.
    const WBStrHandle text = NewText("abc");
    ASSERT_EQ(WbVariantSetLStr(variant, text), 0);
    EXPECT_EQ(*static_cast<WBStrHandle*>(WbVariantGetDataPtr(variant)), text);
    ASSERT_EQ(WbVariantSetLStr(variant, nullptr), 0);  // the empty string
    EXPECT_EQ((**static_cast<WBStrHandle*>(WbVariantGetDataPtr(variant)))->cnt, 0);
    WbVariantFree(variant);
}

TEST_F(WBHostVariantFailures, AStatusOfZeroSwitchesFailuresOff) {
    WbVariant* variant = WbVariantNew();
    WbVariantFailNextCalls(5, 9);
    WbVariantFailNextCalls(5, 0);
    EXPECT_EQ(WbVariantSetI32(variant, 4), 0);
    EXPECT_EQ(WbVariantGetType(variant), WbVariantI32);
    WbVariantFree(variant);
}

TEST_F(WBHostVariantFailures, ConcurrentCallsTakeExactlyTheCount) {
    constexpr int kFailures = 500;
    constexpr int kCallsPerThread = 1000;
    WbVariantFailNextCalls(kFailures, 5);
    std::atomic<int> failed{0};
    std::vector<std::thread> threads;
    for (int t = 0; t < 2; ++t) {
        threads.emplace_back([&failed] {
            WbVariant* own = WbVariantNew();
            for (int i = 0; i < kCallsPerThread; ++i) {
                if (WbVariantSetI32(own, i) == 5) ++failed;
            }
            WbVariantFree(own);
        });
    }
    for (auto& thread : threads) thread.join();
    EXPECT_EQ(failed.load(), kFailures);
}

TEST(WBHostSignals, FireAttemptIsSeenOnAFreedSignal) {
    const uint32_t signal = WBAllocSignal();
    ASSERT_EQ(WBFreeSignal(signal), 0);
    // Nothing tried yet: the wait runs out.
    EXPECT_EQ(WBWaitFireAttempt(signal, 20), 0);

    std::atomic<int32_t> fireStatus{0};
    std::thread firer([&] { fireStatus = WBFireSignal(signal); });
    EXPECT_EQ(WBWaitFireAttempt(signal, kLongWaitMs), 1);
    firer.join();
    EXPECT_NE(fireStatus.load(), 0);
    // A freed signal that was tried is still not fired.
    EXPECT_EQ(WBWaitSignal(signal, 0), 0);
}

TEST(WBHostSignals, FireAttemptsStartAgainWithANewSignal) {
    const uint32_t first = WBAllocSignal();
    ASSERT_EQ(WBFireSignal(first), 0);
    EXPECT_EQ(WBWaitFireAttempt(first, 0), 1);
    const uint32_t second = WBAllocSignal();
    EXPECT_EQ(WBWaitFireAttempt(second, 0), 0);
    WBFreeSignal(first);
    WBFreeSignal(second);
}

TEST(WBHostSignals, WaitSeesAFireFromAnotherThread) {
    const uint32_t signal = WBAllocSignal();
    EXPECT_EQ(WBWaitSignal(signal, 0), 0);
    std::thread firer([signal] { WBFireSignal(signal); });
    EXPECT_EQ(WBWaitSignal(signal, kLongWaitMs), 1);
    firer.join();
    WBFreeSignal(signal);
}

TEST(WBHostSignals, FreeingASignalEndsItsWaitWithZero) {
    const uint32_t signal = WBAllocSignal();
    std::thread freer([signal] { WBFreeSignal(signal); });
    const auto start = std::chrono::steady_clock::now();
    EXPECT_EQ(WBWaitSignal(signal, kLongWaitMs), 0);
    // The free ends the wait; it does not run out.
    EXPECT_LT(std::chrono::steady_clock::now() - start, std::chrono::milliseconds(kLongWaitMs / 2));
    freer.join();
}

}  // namespace
