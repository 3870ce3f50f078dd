// One instance under a long load from eight threads while the proxy resets
// its connections every few seconds: memory and threads stay flat, and the
// run ends with one line of counts. KVVELDRA_SOAK_REQUESTS sets the number
// of requests (default a million).
#include <atomic>
#include <condition_variable>
#include <cstdio>
#include <cstdlib>
#include <fstream>
#include <mutex>
#include <thread>
#include <vector>

#include <dirent.h>
#include <unistd.h>

#include "faults/FaultTestSupport.h"

namespace Korvane::Veldra::Testing {
namespace {

constexpr int kThreads = 8;
constexpr Millis kFaultPeriod{3000};
constexpr Millis kRetryPace{100};

long RequestsToRun() {
    const char* text = std::getenv("KVVELDRA_SOAK_REQUESTS");
    const long count = text != nullptr ? std::atol(text) : 0;
    return count > 0 ? count : 1000000;
}

// Resident memory in kB and threads, of this process.
struct Usage {
    long residentKb = 0;
    int threads = 0;
};

Usage Sample() {
    Usage usage;
    long size = 0;
    long resident = 0;
    std::ifstream("/proc/self/statm") >> size >> resident;
    usage.residentKb = resident * (sysconf(_SC_PAGESIZE) / 1024);
    if (DIR* dir = opendir("/proc/self/task")) {
        while (const dirent* entry = readdir(dir)) usage.threads += entry->d_name[0] != '.';
        closedir(dir);
    }
    return usage;
}

using SoakTest = FaultBrokerTest;

TEST_F(SoakTest, ALongLoadUnderFaultsKeepsMemoryAndThreadsFlat) {
    const long total = RequestsToRun();
    const long warmUp = std::min<long>(total / 10, 20000);
    std::vector<std::string> paths;
    std::vector<uint32_t> references;
    for (int i = 0; i < kThreads; ++i) {
        paths.push_back(UniquePath("soak" + std::to_string(i)));
        references.push_back(Open(paths.back()));
        ASSERT_NE(references.back(), 0u);
    }
    std::atomic<long> issued{0};
    std::atomic<long> successes{0}, timeouts{0}, errors{0}, overruns{0}, strangers{0};
    std::mutex mutex;
    std::condition_variable changed;
    Usage warm;
    bool warmTaken = false;
    int running = kThreads;

    const auto worker = [&](int i) {
        const std::string own = std::to_string(i) + ".";
        long n = 0;
        for (long k; (k = issued.fetch_add(1)) < total; ++n) {
            CallResult result;
            if (n % 2 == 0) {
                result = Write(references[i], own + std::to_string(n) + "1");
            } else {
                TagConsoleValue value;
                result = Read(references[i], value);
                if (result.status == 0 && (value.path != paths[i] || value.value.rfind(own, 0) != 0)) ++strangers;
            }
            if (result.took > kRequestTimeout + kCallMargin) ++overruns;
            if (result.status == 0) ++successes;
            else if (result.status == kRequestTimedOut) ++timeouts;
            else ++errors;
            // A caller retries at a pace: a broken connection fails at once.
            if (result.status != 0) std::this_thread::sleep_for(kRetryPace);
            if (k == warmUp) {
                std::lock_guard<std::mutex> lock(mutex);
                warm = Sample();
                warmTaken = true;
            }
        }
        std::lock_guard<std::mutex> lock(mutex);
        --running;
        changed.notify_all();
    };
    const auto start = std::chrono::steady_clock::now();
    std::vector<std::thread> threads;
    for (int i = 0; i < kThreads; ++i) threads.emplace_back(worker, i);
    int faults = 0;
    {
        std::unique_lock<std::mutex> lock(mutex);
        while (!changed.wait_for(lock, kFaultPeriod, [&] { return running == 0; })) {
            lock.unlock();
            EXPECT_TRUE(Proxy().ResetAll());
            ++faults;
            lock.lock();
        }
    }
    for (auto& thread : threads) thread.join();
    const auto seconds = std::chrono::duration_cast<std::chrono::seconds>(std::chrono::steady_clock::now() - start);

    // The threads of the last dropped connections may still be on their way out.
    Usage end = Sample();
    for (int i = 0; i < 100 && end.threads > warm.threads; ++i) {
        std::this_thread::sleep_for(Millis(100));  // no event to await: /proc is polled
        end = Sample();
    }
    std::printf("soak: %ld requests in %lld s, %d resets: successes %ld, time-outs %ld, errors %ld; "
                "resident %ld -> %ld kB, threads %d -> %d\n",
                total, static_cast<long long>(seconds.count()), faults, successes.load(), timeouts.load(),
                errors.load(), warm.residentKb, end.residentKb, warm.threads, end.threads);
    std::fflush(stdout);
    ASSERT_TRUE(warmTaken);
    EXPECT_EQ(overruns.load(), 0) << "calls that overran their time-out";
    EXPECT_EQ(strangers.load(), 0) << "reads that got another tag's value";
    EXPECT_GT(successes.load(), total / 2);
    // Allocator and broker buffers wobble; a leak grows with the count.
    EXPECT_LE(end.residentKb, warm.residentKb + 16384 + warm.residentKb / 10);
    EXPECT_LE(end.threads, warm.threads);
    for (const uint32_t reference : references) {
        std::string error;
        EXPECT_EQ(TagConsoleClose(reference, false, &error), 0) << error;
    }
}

}  // namespace
}  // namespace Korvane::Veldra::Testing
