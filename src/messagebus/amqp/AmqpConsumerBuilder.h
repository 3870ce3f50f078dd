#pragma once

#include <cstdint>
#include <functional>
#include <memory>
#include <string>

#include "messagebus/amqp/AmqpChannel.h"
#include "messagebus/interfaces/IMessageSubscriberReceiveCallback.h"
#include "utilities/tracelogging/ITraceLogger.h"

namespace Korvane::Veldra::MessageBus {

class AmqpConnectionManager;

// Takes each delivery as it stands, in place of the message callbacks.
using RawEnvelopeCallback = std::function<void(const EnvelopePtr& envelope)>;

// The settings an AmqpConsumer is built from.
struct AmqpConsumerBuilder {
    std::string QueueName;
    std::string ConsumerName;
    std::shared_ptr<Interfaces::IMessageSubscriberReceiveCallback> ReceiveCallback;
    RawEnvelopeCallback RawCallback;
    std::shared_ptr<Interfaces::ITraceLogger> TraceLogger;
    bool Durable = false;
    std::string QueueType;  // x-queue-type; empty: the broker's default
    bool ManualAck = false;
    uint16_t PrefetchCount = 100;
    // Null means the process singleton.
    AmqpConnectionManager* ConnectionManager = nullptr;
};

}  // namespace Korvane::Veldra::MessageBus
