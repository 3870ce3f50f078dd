#pragma once

#include <cstdint>
#include <memory>
#include <string>
#include <utility>

#include "messagebus/interfaces/IBroadcastCallback.h"
#include "messagebus/interfaces/IMessageSubscriberReceiveCallback.h"
#include "utilities/tracelogging/ITraceLogger.h"

namespace Korvane::Veldra::MessageBus {

class AmqpConnectionManager;

// The settings a MessageSubscriber is built from; public fields with their
// defaults.
struct MessageSubscriberBuilder {
    explicit MessageSubscriberBuilder(std::string queueName = std::string())
        : QueueName(std::move(queueName)) {}

    std::string QueueName;
    // AmqpConsumer objects on the one queue, each with its own channel.
    int32_t ConsumerCount = 1;
    // Kept for the handler queue's owners; the queue itself has no bound.
    int32_t QueueCapacity = 100;
    // With 2 or more, messages are handed to that many handler threads instead
    // of being handled on the consumers' threads.
    int32_t HandlerThreadCount = 1;
    std::string ConsumerName;
    uint16_t PrefetchCount = 100;
    // Not used: the subscriber gives each consumer its own.
    std::shared_ptr<Interfaces::IMessageSubscriberReceiveCallback> ReceiveCallback;
    // Start consuming at construction.
    bool AutoStart = true;
    // Bind [QueueName, "#"] at construction.
    bool BindAll = true;
    // Six hours: how often correlation callbacks are purged and how old they
    // may grow.
    int32_t CallbackMaxAgeMs = 21600000;
    bool Durable = false;
    // The queue's x-queue-type ("quorum" for a durable queue that lives on
    // in a cluster when a node goes); empty: the broker's default.
    std::string QueueType;
    bool ManualAck = false;
    std::shared_ptr<Interfaces::ITraceLogger> TraceLogger;
    // Receives what no other handler takes.
    std::shared_ptr<Interfaces::IBroadcastCallback> DefaultCallback;
    // Null means the process singleton.
    AmqpConnectionManager* ConnectionManager = nullptr;
};

}  // namespace Korvane::Veldra::MessageBus
