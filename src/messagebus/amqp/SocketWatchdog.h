#pragma once

#include <amqp.h>

#include <chrono>
#include <functional>
#include <future>
#include <memory>
#include <mutex>
#include <thread>

namespace Korvane::Veldra::MessageBus {

// Bounds the time one rabbitmq-c call may spend on a connection's socket.
// rabbitmq-c 0.11 can wait without limit inside a call: amqp_basic_publish
// polls for input with no deadline once nothing has arrived for two heartbeat
// intervals, and every send waits without deadline for a full socket buffer
// to drain. A broker that stops answering without closing the socket would
// then hold the call, and the connection's gate, for good. The thread that
// makes such a call marks it with a Scope; another thread calls CutIfStalled,
// which shuts the socket down when a call has run too long, so that the call
// returns with a socket error and the reader's next poll starts a reconnect.
class SocketWatchdog {
public:
    using Clock = std::chrono::steady_clock;

    // Marks one call on the connection's socket; made with the gate held, so
    // at most one thread is inside a scope at a time. Scopes nest.
    class Scope {
    public:
        Scope(SocketWatchdog& watchdog, amqp_connection_state_t connection);
        ~Scope();
        Scope(const Scope&) = delete;
        Scope& operator=(const Scope&) = delete;

    private:
        SocketWatchdog& watchdog_;
    };

    // Shuts the watched socket down (both directions) when a call has been in
    // progress for at least limit. True when it did.
    bool CutIfStalled(Clock::duration limit);

private:
    std::mutex mutex_;
    int depth_ = 0;
    int socket_ = -1;
    Clock::time_point since_;
};

// A thread together with the signal of its end, so that a join can keep an
// eye on the socket while it waits.
class WatchedThread {
public:
    WatchedThread() = default;
    WatchedThread(const WatchedThread&) = delete;
    WatchedThread& operator=(const WatchedThread&) = delete;

    // Starts body on a new thread into slot; slot must be empty.
    void Start(std::unique_ptr<std::thread>& slot, std::function<void()> body);
    // Joins and clears slot (nothing when it is empty). The thread is being
    // told to end, but a call on the socket may hold it: while it runs, a
    // call that has been in progress for a second, far longer than any poll,
    // is cut.
    void Join(std::unique_ptr<std::thread>& slot, SocketWatchdog& watchdog);

private:
    std::future<void> done_;
};

}  // namespace Korvane::Veldra::MessageBus
