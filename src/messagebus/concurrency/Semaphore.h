#pragma once

#include <semaphore.h>

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

private:
    sem_t semaphore_;
};

// The exceptions for a failed sem_init and a failed wait, by errno.
VeldraException SemaphoreInitError(int errorNumber);
VeldraException SemaphoreAcquireError(int errorNumber);

}  // namespace Korvane::Veldra::MessageBus
