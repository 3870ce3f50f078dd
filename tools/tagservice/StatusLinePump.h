#pragma once

#include <atomic>
#include <thread>

#include "messagebus/amqp/AmqpConnectionManager.h"

namespace Korvane::Veldra::TagService {

// Copies the bus's status lines (connects, losses, reconnects) to standard
// error while it lives. Must go before the manager does.
class StatusLinePump {
public:
    explicit StatusLinePump(MessageBus::AmqpConnectionManager& manager);
    // Stops and joins its thread, within one take's time-out.
    ~StatusLinePump();
    StatusLinePump(const StatusLinePump&) = delete;
    StatusLinePump& operator=(const StatusLinePump&) = delete;

private:
    void Run();

    MessageBus::AmqpConnectionManager& manager_;
    std::atomic<bool> stopping_{false};
    std::thread thread_;
};

}  // namespace Korvane::Veldra::TagService
