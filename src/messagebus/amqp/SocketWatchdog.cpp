#include "messagebus/amqp/SocketWatchdog.h"

#include <sys/socket.h>

#include <utility>

namespace Korvane::Veldra::MessageBus {

SocketWatchdog::Scope::Scope(SocketWatchdog& watchdog, amqp_connection_state_t connection)
    : watchdog_(watchdog) {
    const int socket = connection != nullptr ? amqp_get_sockfd(connection) : -1;
    std::lock_guard<std::mutex> lock(watchdog_.mutex_);
    if (watchdog_.depth_++ == 0) {
        watchdog_.socket_ = socket;
        watchdog_.since_ = Clock::now();
    }
}

SocketWatchdog::Scope::~Scope() {
    std::lock_guard<std::mutex> lock(watchdog_.mutex_);
    if (--watchdog_.depth_ == 0) watchdog_.socket_ = -1;
}

bool SocketWatchdog::CutIfStalled(Clock::duration limit) {
    // The lock keeps the call inside its scope while the shutdown is made, so
    // the socket is still the call's: rabbitmq-c closes a socket itself only
    // on its way out of a failed call.
    std::lock_guard<std::mutex> lock(mutex_);
    if (depth_ == 0 || socket_ < 0 || Clock::now() - since_ < limit) return false;
    ::shutdown(socket_, SHUT_RDWR);
    return true;
}

void WatchedThread::Start(std::unique_ptr<std::thread>& slot, std::function<void()> body) {
    std::promise<void> done;
    done_ = done.get_future();
    slot =
        std::make_unique<std::thread>([body = std::move(body), done = std::move(done)]() mutable {
            body();
            done.set_value();
        });
}

void WatchedThread::Join(std::unique_ptr<std::thread>& slot, SocketWatchdog& watchdog) {
    if (!slot) return;
    if (done_.valid()) {
        while (done_.wait_for(std::chrono::milliseconds(100)) != std::future_status::ready) {
            watchdog.CutIfStalled(std::chrono::seconds(1));
        }
    }
    slot->join();
    slot.reset();
}

}  // namespace Korvane::Veldra::MessageBus
