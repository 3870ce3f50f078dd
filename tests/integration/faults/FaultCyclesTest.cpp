// Many faults in a row leave nothing behind: the process's threads and
// descriptors come back to their counts.
#include <dirent.h>

#include <cstdio>
#include <thread>

#include "faults/FaultTestSupport.h"

namespace Korvane::Veldra::Testing {
namespace {

int CountEntries(const char* directory) {
    DIR* dir = opendir(directory);
    if (dir == nullptr) return -1;
    int count = 0;
    while (const dirent* entry = readdir(dir)) {
        if (entry->d_name[0] != '.') ++count;
    }
    closedir(dir);
    return count;
}

struct Counts {
    int threads = 0;
    int descriptors = 0;
    bool operator<=(const Counts& other) const {
        return threads <= other.threads && descriptors <= other.descriptors;
    }
};

Counts Take() {
    // The descriptor that reads /proc/self/fd counts itself, each time alike.
    return Counts{CountEntries("/proc/self/task"), CountEntries("/proc/self/fd")};
}

// A reset may land in the middle of a reconnect's handshake; the failed
// attempt is then tried again.
TEST_F(FaultBrokerTest, AHundredResetsLeaveNoThreadOrDescriptorBehind) {
    const uint32_t reference = Open(UniquePath("cycles"));
    ASSERT_NE(reference, 0u);
    ASSERT_EQ(Write(reference, "1.5").status, 0);
    const Counts before = Take();
    // A cycle is a reset and one call, which fails fast or succeeds: the
    // library takes about a second to reconnect, so most resets hit it while
    // it reconnects, some in the middle of a handshake.
    int failures = 0;
    for (int cycle = 0; cycle < 100; ++cycle) {
        ASSERT_TRUE(Proxy().ResetAll());
        const CallResult result = Write(reference, "2.5");
        EXPECT_LE(result.took, kRequestTimeout + kCallMargin);
        if (result.status != 0) {
            ++failures;
            EXPECT_TRUE(IsBusFailure(result.status)) << result.status << " " << result.error;
        }
        std::this_thread::sleep_for(Millis(200));  // the pace of the faults, not a wait
    }
    const auto lifted = std::chrono::steady_clock::now();
    CallResult result;
    while ((result = Write(reference, "3.5")).status != 0 &&
           std::chrono::steady_clock::now() - lifted < kRequestTimeout + kCallMargin) {
        std::this_thread::sleep_for(Millis(20));  // the pace of the retries
    }
    ASSERT_EQ(result.status, 0) << "no recovery after the cycles: " << result.error;
    const auto recovered = std::chrono::duration_cast<Millis>(std::chrono::steady_clock::now() - lifted);
    // Threads and sockets of the dropped connections may still be on their way out.
    Counts after = Take();
    for (int i = 0; i < 100 && !(after <= before); ++i) {
        std::this_thread::sleep_for(Millis(100));  // no event to await: /proc is polled
        after = Take();
    }
    std::printf("fault cycles: 100 resets, %d calls failed, recovered in %lld ms; threads %d -> %d, fds %d -> %d\n",
                failures, static_cast<long long>(recovered.count()), before.threads, after.threads, before.descriptors, after.descriptors);
    EXPECT_LE(after.threads, before.threads);
    EXPECT_LE(after.descriptors, before.descriptors);
}

}  // namespace
}  // namespace Korvane::Veldra::Testing
