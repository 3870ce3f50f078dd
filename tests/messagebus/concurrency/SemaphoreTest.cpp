#include <gtest/gtest.h>

#include <atomic>
#include <cerrno>
#include <chrono>
#include <string>
#include <thread>

#include "errors/ErrorCodes.h"
#include "messagebus/concurrency/Semaphore.h"
#include "support/SpinUntil.h"

namespace Korvane::Veldra::MessageBus {
namespace {

TEST(Semaphore, CountsReleasesAndTryDoesNotWait) {
    Semaphore semaphore;
    EXPECT_FALSE(semaphore.Acquire(0));
    semaphore.Release();
    semaphore.Release();
    EXPECT_TRUE(semaphore.Acquire(0));
    EXPECT_TRUE(semaphore.Acquire(Semaphore::kInfinite));
    EXPECT_FALSE(semaphore.Acquire(0));
}

TEST(Semaphore, TimedAcquireExpiresNoEarlierThanItsTimeout) {
    Semaphore semaphore;
    const auto start = std::chrono::steady_clock::now();
    EXPECT_FALSE(semaphore.Acquire(1));
    EXPECT_GE(std::chrono::steady_clock::now() - start, std::chrono::milliseconds(1));
}

TEST(Semaphore, TimedAcquireAcrossSecondBoundaryIsAValidDeadline) {
    // 1999 ms pushes the nanosecond part over a whole second for most start
    // times; a badly normalised deadline makes sem_timedwait fail with EINVAL.
    Semaphore semaphore;
    semaphore.Release();
    EXPECT_TRUE(semaphore.Acquire(1999));
}

TEST(Semaphore, WaitersAreWokenByReleaseFromAnotherThread) {
    using ::Korvane::Veldra::Testing::SpinUntil;
    Semaphore semaphore;
    std::atomic<int> acquired{0};
    std::thread infinite([&] { acquired += semaphore.Acquire(Semaphore::kInfinite); });
    std::thread timed([&] { acquired += semaphore.Acquire(600000); });
    std::thread plain([&] {
        semaphore.Wait();
        ++acquired;
    });
    // All three wait before the first release, so each count wakes one.
    EXPECT_TRUE(SpinUntil([&] { return semaphore.Waiters() == 3; }));
    for (int i = 0; i < 3; ++i) semaphore.Release();
    const bool woken = SpinUntil([&] { return acquired == 3; });
    EXPECT_TRUE(woken) << acquired << " of 3 woken";
    // Ends a waiter that stayed blocked, so that the joins return.
    for (int i = 0; !woken && i < 3; ++i) semaphore.Release();
    infinite.join();
    timed.join();
    plain.join();
    EXPECT_EQ(semaphore.Waiters(), 0);
    if (woken) {
        EXPECT_FALSE(semaphore.Acquire(0));
    }
}

struct ErrnoCase {
    int errorNumber;
    int32_t code;
    const char* text;
};

TEST(Semaphore, InitFailureTextsAndCodes) {
    using namespace ErrorCodes;
    const ErrnoCase cases[] = {
        {EINVAL, kInvalidSemaphoreInitialization,
         "Construct failed: EINVAL -- initialCount exceeds SEM_VALUE_MAX.\n"},
        {ENOSPC, kInsufficientResources,
         "Construct failed: ENOSPC -- Insufficient resources or semaphore limit "
         "(SEM_NSEMS_MAX) reached.\n"},
        {ENOSYS, kNotSupported, "Construct failed: ENOSYS -- sem_init() unsupported.\n"},
        {EPERM, kInsufficientPrivileges, "Construct failed: EDEADLK -- insufficient privileges.\n"},
        {ENOMEM, kException, "Construct failed: unexpected failure: 12"},
    };
    for (const auto& c : cases) {
        const VeldraException e = SemaphoreInitError(c.errorNumber);
        EXPECT_EQ(e.Code(), c.code) << c.errorNumber;
        EXPECT_EQ(std::string(e.what()), c.text);
    }
}

TEST(Semaphore, AcquireFailureTextsAndCodes) {
    using namespace ErrorCodes;
    const ErrnoCase cases[] = {
        {EDEADLK, kException,
         "Acquire with timeout failed: EDEADLK -- Deadlock condition detected."},
        {EINVAL, kInvalidSemaphoreInitialization,
         "Acquire with timeout failed: EINVAL -- Invalid semaphore reference."},
        {ENOSYS, kNotSupported,
         "Acquire with timeout failed: ENOSYS -- sem_wait()/sem_trywait() unsupported."},
        {EFAULT, kException, "Acquire with timeout failed: unexpected failure: errorno = 14"},
    };
    for (const auto& c : cases) {
        const VeldraException e = SemaphoreAcquireError(c.errorNumber);
        EXPECT_EQ(e.Code(), c.code) << c.errorNumber;
        EXPECT_EQ(std::string(e.what()), c.text);
    }
}

}  // namespace
}  // namespace Korvane::Veldra::MessageBus
