#pragma once

#include <atomic>
#include <condition_variable>
#include <cstdint>
#include <mutex>

namespace Korvane::Veldra::MessageBus {

// The lock that makes one rabbitmq-c connection usable from several threads,
// with precedence for control operations and publishes over the reader.
// A control operation counts itself as a waiter before it locks, so a reader
// about to poll again stands back until every waiter is through; a reader
// holds the gate for one poll at a time.
class AmqpGate {
public:
    AmqpGate() = default;
    AmqpGate(const AmqpGate&) = delete;
    AmqpGate& operator=(const AmqpGate&) = delete;

    // Held for the span of one control operation or publish. Nests on the
    // same thread.
    class Control {
    public:
        explicit Control(AmqpGate& gate);
        ~Control();
        Control(const Control&) = delete;
        Control& operator=(const Control&) = delete;

    private:
        AmqpGate& gate_;
    };

    // Held by a reader thread for one poll; waits while control operations
    // hold or want the gate.
    class Reader {
    public:
        explicit Reader(AmqpGate& gate);
        ~Reader();
        Reader(const Reader&) = delete;
        Reader& operator=(const Reader&) = delete;

    private:
        AmqpGate& gate_;
    };

    // Control operations that hold or want the gate.
    int32_t Waiters() const { return GateWaiters.load(); }

private:
    std::recursive_mutex GateMutex;
    std::atomic<int32_t> GateWaiters{0};
    std::mutex GateIdleMutex;
    std::condition_variable GateIdle;
};

}  // namespace Korvane::Veldra::MessageBus
