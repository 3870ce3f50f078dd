#include "messagebus/amqp/AmqpGate.h"

namespace Korvane::Veldra::MessageBus {

AmqpGate::Control::Control(AmqpGate& gate) : gate_(gate) {
    gate_.GateWaiters.fetch_add(1);
    gate_.GateMutex.lock();
}

AmqpGate::Control::~Control() {
    gate_.GateMutex.unlock();
    if (gate_.GateWaiters.fetch_sub(1) == 1) {
        // The last waiter is through: let a reader poll again. Taking the
        // idle mutex orders this with a reader that is about to wait.
        std::lock_guard<std::mutex> idle(gate_.GateIdleMutex);
        gate_.GateIdle.notify_all();
    }
}

AmqpGate::Reader::Reader(AmqpGate& gate) : gate_(gate) {
    gate_.GateMutex.lock();
    while (gate_.GateWaiters.load() > 0) {
        // Stand back: the waiters take the gate as soon as it is free.
        gate_.GateMutex.unlock();
        {
            std::unique_lock<std::mutex> idle(gate_.GateIdleMutex);
            gate_.GateIdle.wait(idle, [this] { return gate_.GateWaiters.load() <= 0; });
        }
        gate_.GateMutex.lock();
    }
}

AmqpGate::Reader::~Reader() {
    gate_.GateMutex.unlock();
}

}  // namespace Korvane::Veldra::MessageBus
