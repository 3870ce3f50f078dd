#include "messagebus/concurrency/Semaphore.h"

#include <cerrno>
#include <ctime>
#include <string>

#include "errors/ErrorCodes.h"

namespace Korvane::Veldra::MessageBus {
namespace {

constexpr long kNanosecondsPerSecond = 1000000000L;

timespec DeadlineAfter(uint32_t timeoutMs) {
    timespec deadline{};
    clock_gettime(CLOCK_REALTIME, &deadline);
    deadline.tv_sec += static_cast<time_t>(timeoutMs / 1000u);
    deadline.tv_nsec += static_cast<long>(timeoutMs % 1000u) * 1000000L;
    if (deadline.tv_nsec >= kNanosecondsPerSecond) {
        deadline.tv_sec += 1;
        deadline.tv_nsec -= kNanosecondsPerSecond;
    }
    return deadline;
}

// Runs one kind of wait until it ends with something other than EINTR.
// Returns 0 or the errno of the failure.
template <typename WaitCall>
int WaitRetryingInterrupts(WaitCall wait) {
    while (wait() != 0) {
        if (errno != EINTR) return errno;
    }
    return 0;
}

}  // namespace

VeldraException SemaphoreInitError(int errorNumber) {
    using namespace ErrorCodes;
    switch (errorNumber) {
        case EINVAL:
            return VeldraException(
                kInvalidSemaphoreInitialization,
                "Construct failed: EINVAL -- initialCount exceeds SEM_VALUE_MAX.\n");
        case ENOSPC:
            return VeldraException(kInsufficientResources,
                                   "Construct failed: ENOSPC -- Insufficient resources or "
                                   "semaphore limit (SEM_NSEMS_MAX) reached.\n");
        case ENOSYS:
            return VeldraException(kNotSupported,
                                   "Construct failed: ENOSYS -- sem_init() unsupported.\n");
        case EPERM:
            // The text names EDEADLK although the cause is EPERM; callers match on it.
            return VeldraException(kInsufficientPrivileges,
                                   "Construct failed: EDEADLK -- insufficient privileges.\n");
        default:
            return VeldraException(
                kException, "Construct failed: unexpected failure: " + std::to_string(errorNumber));
    }
}

VeldraException SemaphoreAcquireError(int errorNumber) {
    using namespace ErrorCodes;
    switch (errorNumber) {
        case EDEADLK:
            return VeldraException(
                kException, "Acquire with timeout failed: EDEADLK -- Deadlock condition detected.");
        case EINVAL:
            return VeldraException(
                kInvalidSemaphoreInitialization,
                "Acquire with timeout failed: EINVAL -- Invalid semaphore reference.");
        case ENOSYS:
            return VeldraException(
                kNotSupported,
                "Acquire with timeout failed: ENOSYS -- sem_wait()/sem_trywait() unsupported.");
        default:
            return VeldraException(kException,
                                   "Acquire with timeout failed: unexpected failure: errorno = " +
                                       std::to_string(errorNumber));
    }
}

Semaphore::Semaphore() {
    if (sem_init(&semaphore_, 0, 0) != 0) throw SemaphoreInitError(errno);
}

Semaphore::~Semaphore() {
    sem_destroy(&semaphore_);
}

bool Semaphore::Acquire(uint32_t timeoutMs) {
    int failure = 0;
    if (timeoutMs == 0) {
        failure = WaitRetryingInterrupts([this] { return sem_trywait(&semaphore_); });
    } else if (timeoutMs == kInfinite) {
        const WaiterMark waiting(waiters_);
        failure = WaitRetryingInterrupts([this] { return sem_wait(&semaphore_); });
    } else {
        const timespec deadline = DeadlineAfter(timeoutMs);
        const WaiterMark waiting(waiters_);
        failure = WaitRetryingInterrupts([&] { return sem_timedwait(&semaphore_, &deadline); });
    }
    if (failure == 0) return true;
    if (failure == EAGAIN || failure == ETIMEDOUT) return false;
    throw SemaphoreAcquireError(failure);
}

void Semaphore::Wait() {
    const WaiterMark waiting(waiters_);
    if (WaitRetryingInterrupts([this] { return sem_wait(&semaphore_); }) != 0) {
        throw VeldraException(ErrorCodes::kException, "Acquire -- unexpected failure.");
    }
}

void Semaphore::Release() {
    sem_post(&semaphore_);
}

}  // namespace Korvane::Veldra::MessageBus
