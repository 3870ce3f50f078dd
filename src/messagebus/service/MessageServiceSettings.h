#pragma once

#include <cstdint>
#include <string>

namespace Korvane::Veldra::MessageBus {

class AmqpConnectionManager;
struct MessageSubscriberBuilder;

// What a MessageService is built from.
struct MessageServiceSettings {
    // The service's name: the stem of its queue name and its "Origin".
    std::string Name;
    // The time-out of the operations that take none.
    uint32_t DefaultTimeoutMs = 10000;
    // The queue name's suffix; empty means a new random one at each start.
    std::string InstanceId;
    uint32_t Reserved = 0;
    // Null means the process singleton.
    AmqpConnectionManager* ConnectionManager = nullptr;
    // Null: the service builds one for its queue. Not changed by the service.
    const MessageSubscriberBuilder* SubscriberBuilder = nullptr;
    // Start consuming at construction.
    bool AutoStart = true;
};

}  // namespace Korvane::Veldra::MessageBus
