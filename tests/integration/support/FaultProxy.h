#pragma once

#include <chrono>
#include <condition_variable>
#include <memory>
#include <mutex>
#include <thread>

namespace Korvane::Veldra::Testing {

// A TCP proxy on 127.0.0.1 in front of one target port, with a thread of its
// own, that passes, delays or swallows the traffic on command and resets its
// connections. Every wait of its thread is bounded; the destructor joins it.
class FaultProxy {
public:
    enum class Mode { Pass, Delay, BlackHole };

    // Listens on a free loopback port; throws std::runtime_error when it cannot.
    explicit FaultProxy(int targetPort);
    ~FaultProxy();
    FaultProxy(const FaultProxy&) = delete;
    FaultProxy& operator=(const FaultProxy&) = delete;

    int Port() const { return port_; }

    // Pass: forward both ways. Delay: forward each chunk `delay` after it came.
    // BlackHole: accept and read, never forward nor answer, on the open
    // connections and on new ones; leaving it closes the connections whose
    // traffic it swallowed, since their streams lost bytes.
    void SetMode(Mode mode, std::chrono::milliseconds delay = std::chrono::milliseconds(0));
    // Closes every connection with a reset (SO_LINGER 0), both sides; returns
    // once the proxy's thread did it, or false after a bounded wait.
    bool ResetAll();
    // Connections the proxy holds at the moment.
    int Connections() const;

private:
    struct Pair;
    void Run();
    void Wake() const;

    int port_ = 0;
    int listenFd_ = -1;
    int wakeFd_ = -1;
    const int targetPort_;
    mutable std::mutex mutex_;
    std::condition_variable resetDone_;
    Mode mode_ = Mode::Pass;
    std::chrono::milliseconds delay_{0};
    unsigned resetsAsked_ = 0;
    unsigned resetsDone_ = 0;
    int connections_ = 0;
    bool stop_ = false;
    std::thread thread_;
};

}  // namespace Korvane::Veldra::Testing
