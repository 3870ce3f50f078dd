#pragma once

#include <semaphore.h>

#include <atomic>
#include <cstdint>

#include "errors/VeldraException.h"

namespace Korvane::Veldra::MessageBus {

// A counting semaphore over a process-private POSIX semaphore, starting at 0.
// Timed waits run against the realtime clock, so a clock step moves them.
// Destroying it while a thread waits on it is undefined: owners stop their
// threads first.
class Semaphore {
public:
    // Acquire's time-out that never expires.
    static constexpr uint32_t kInfinite = 0xFFFFFFFFu;

    Semaphore();
    ~Semaphore();
    Semaphore(const Semaphore&) = delete;
    Semaphore& operator=(const Semaphore&) = delete;

    // 0 tries without waiting, kInfinite waits without limit, anything else
    // waits until now + timeoutMs on the realtime clock (one deadline, kept
    // across EINTR retries). True when a count was taken.
    bool Acquire(uint32_t timeoutMs);
    // The plain blocking wait of the bus threads: retries EINTR and throws
    // "Acquire -- unexpected failure." on any other error.
    void Wait();
    void Release();
    // The threads inside a waiting Acquire or Wait: counted just before they
    // wait, so a thread counted here is blocked or about to be.
    int32_t Waiters() const { return waiters_.load(); }

private:
    // Counts the calling thread as a waiter for its lifetime.
    class WaiterMark {
    public:
        explicit WaiterMark(std::atomic<int32_t>& waiters) : waiters_(waiters) { ++waiters_; }
        ~WaiterMark() { --waiters_; }
        WaiterMark(const WaiterMark&) = delete;
        WaiterMark& operator=(const WaiterMark&) = delete;

    private:
        std::atomic<int32_t>& waiters_;
    };

    sem_t semaphore_;
    std::atomic<int32_t> waiters_{0};
};

// The exceptions for a failed sem_init and a failed wait, by errno.
VeldraException SemaphoreInitError(int errorNumber);
VeldraException SemaphoreAcquireError(int errorNumber);

}  // namespace Korvane::Veldra::MessageBus
