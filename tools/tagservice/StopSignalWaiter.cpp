#include "StopSignalWaiter.h"

namespace Korvane::Veldra::TagService {

StopSignalWaiter::StopSignalWaiter(const sigset_t& signals, MessageBus::Semaphore& shutdownEvent)
    : signals_(signals), shutdownEvent_(shutdownEvent) {
    thread_ = std::thread([this] {
        int signal = 0;
        while (sigwait(&signals_, &signal) != 0) {
        }
        if (closing_.load()) return;
        received_.store(signal);
        shutdownEvent_.Release();
    });
}

StopSignalWaiter::~StopSignalWaiter() {
    closing_.store(true);
    // A signal aimed at the thread is one that its sigwait takes; one that
    // came already leaves it ended, and the extra signal pending on a
    // finished thread goes nowhere.
    if (received_.load() == 0) pthread_kill(thread_.native_handle(), SIGTERM);
    thread_.join();
}

}  // namespace Korvane::Veldra::TagService
