#pragma once

#include <pthread.h>
#include <signal.h>

#include <atomic>
#include <thread>

#include "messagebus/concurrency/Semaphore.h"

namespace Korvane::Veldra::TagService {

// Waits on its own thread for one of the stop signals, which every thread
// keeps blocked, and posts the shutdown event when one comes.
class StopSignalWaiter {
public:
    StopSignalWaiter(const sigset_t& signals, MessageBus::Semaphore& shutdownEvent);
    // Wakes the thread when no signal came, and joins it.
    ~StopSignalWaiter();
    StopSignalWaiter(const StopSignalWaiter&) = delete;
    StopSignalWaiter& operator=(const StopSignalWaiter&) = delete;

    // The signal that came, or 0.
    int Received() const { return received_.load(); }

private:
    const sigset_t signals_;
    MessageBus::Semaphore& shutdownEvent_;
    std::atomic<bool> closing_{false};
    std::atomic<int> received_{0};
    std::thread thread_;
};

}  // namespace Korvane::Veldra::TagService
