#include <gtest/gtest.h>

#include <mutex>
#include <optional>
#include <string>
#include <thread>
#include <vector>

#include "messagebus/amqp/AmqpGate.h"

namespace Korvane::Veldra::MessageBus {
namespace {

TEST(AmqpGate, ControlOperationGoesBeforeTheReadersNextPoll) {
    AmqpGate gate;
    std::mutex orderMutex;
    std::vector<std::string> order;
    auto record = [&](const char* step) {
        std::lock_guard<std::mutex> lock(orderMutex);
        order.push_back(step);
    };

    std::optional<AmqpGate::Reader> poll(std::in_place, gate);
    std::thread control([&] {
        AmqpGate::Control operation(gate);
        AmqpGate::Control nested(gate);  // the same thread may nest
        record("control");
    });
    // The control operation has announced itself and is blocked on the gate.
    while (gate.Waiters() == 0) std::this_thread::yield();
    poll.reset();
    {
        // The next poll stands back although the gate is free for an instant.
        AmqpGate::Reader nextPoll(gate);
        record("reader");
    }
    control.join();
    EXPECT_EQ(order, (std::vector<std::string>{"control", "reader"}));
    EXPECT_EQ(gate.Waiters(), 0);
}

}  // namespace
}  // namespace Korvane::Veldra::MessageBus
