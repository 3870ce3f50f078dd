#pragma once

#include <atomic>
#include <chrono>
#include <cstdint>
#include <memory>
#include <mutex>
#include <string>
#include <thread>
#include <vector>

#include "messagebus/amqp/AmqpChannel.h"
#include "messagebus/amqp/AmqpConsumerBuilder.h"
#include "messagebus/concurrency/Semaphore.h"
#include "utilities/tracelogging/TracePoint.h"

namespace Korvane::Veldra::MessageBus {

// One channel of the consumer connection with a queue on it. Its handling
// thread turns the envelopes the reader sorted into the channel into
// GenericMessage objects and hands them, and the notices of returned
// publishes, to the receive callback, one at a time and in arrival order. Its
// rebind thread declares the queue and binds it again whenever the channel is
// reset: after a reconnect, a channel close, or a failed callback.
class AmqpConsumer {
public:
    // Opens the channel, declares the queue (auto-deleted unless durable),
    // sets the prefetch count, then starts the two threads. Consuming starts
    // with StartConsuming.
    explicit AmqpConsumer(const AmqpConsumerBuilder& builder);
    // Ends both threads. The AMQP channel stays open.
    ~AmqpConsumer();
    AmqpConsumer(const AmqpConsumer&) = delete;
    AmqpConsumer& operator=(const AmqpConsumer&) = delete;

    // Records the binding with the manager, which binds only when it is new,
    // and consumes too while the consumer is started.
    void Bind(const std::vector<std::string>& keys);
    // Unbinds only a recorded binding.
    void Unbind(const std::vector<std::string>& keys);
    // Starts the broker's deliveries (a consumer for each binding), lets the
    // handling thread run and counts a Start of the connection.
    void StartConsuming();
    // Cancels the broker's deliveries and counts a Stop of the connection;
    // what was delivered already is still handled. A durable queue keeps
    // what arrives meanwhile; an auto-delete queue goes with its consumers,
    // and the next start declares and binds it again.
    void StopConsuming();
    void Ack(uint64_t deliveryTag);
    void Requeue(uint64_t deliveryTag);
    // Keeps the logger and reads its "RawMessages" point; null is allowed.
    void SetTraceLogger(std::shared_ptr<Interfaces::ITraceLogger> traceLogger);

    // Waits up to `timeout` until the queue and its bindings are in place:
    // after a reconnect or a channel reset, until the rebind succeeded.
    bool WaitBound(std::chrono::steady_clock::duration timeout) const;

    // The longest pause between two failed rebinds.
    static constexpr uint32_t kLongestRebindPauseMs = 2000;

    const std::string& GetConsumerTag() const { return ConsumerTag; }
    const std::string& GetQueueName() const { return QueueName; }
    const std::shared_ptr<AmqpChannel>& GetChannel() const { return Channel; }

private:
    void RebindLoop();
    void HandlingLoop();
    // Steps 3 and 4 of the handling loop: one envelope, one returned notice.
    void HandleOnce();
    void Dispatch(const EnvelopePtr& envelope);
    // On the connection's reader thread: hands a reply that a caller waits
    // for, or that a request's own callback completes, straight over. False
    // leaves the envelope to the handling thread.
    bool TakeOnReader(const amqp_envelope_t& envelope);
    // Logs the received message at the "RawMessages" point when it is on.
    void LogReceived(const GenericMessage& message);
    // After a failed step: log, ask for a new declaration. True to end.
    bool Recover(const std::string& line);
    void ReportLine(const std::string& line);
    // ReportLine, else the manager's log; never throws.
    void ReportLineSafely(const std::string& line);
    // The logger and its point, as one consistent pair.
    std::shared_ptr<Interfaces::ITraceLogger> Logger(TracePoint* rawMessages = nullptr);
    void DeclareQueue();

    // ---- State ----
    const std::string ConsumerTag;
    const std::string QueueName;
    std::string ExchangeName;
    const std::string ConsumerName;
    const bool Durable;
    const std::string QueueType;
    const bool ManualAck;
    std::shared_ptr<AmqpChannel> Channel;
    const std::shared_ptr<Interfaces::IMessageSubscriberReceiveCallback> ReceiveCallback;
    const RawEnvelopeCallback RawCallback;
    std::shared_ptr<Interfaces::ITraceLogger> TraceLogger;
    TracePoint RawMessagesPoint;
    AmqpConnectionManager* Manager;
    Semaphore StopSignal;
    std::atomic<bool> StopHandling{false};
    std::atomic<bool> StopRebinding{false};
    std::atomic<bool> Consuming{false};
    bool Started = false;  // handling thread only
    std::unique_ptr<std::thread> RebindThread;
    std::unique_ptr<std::thread> HandlingThread;

    const uint16_t PrefetchCount;
    // Guards TraceLogger and RawMessagesPoint.
    std::mutex LoggerMutex;
    // Held across the binds, consumes and cancels, so that the broker has a
    // consumer for each binding exactly while the consumer is started.
    std::mutex ConsumeMutex;
    bool BrokerConsuming = false;  // guarded by ConsumeMutex
    // An auto-delete queue whose consumers were cancelled: the broker has
    // deleted it. Guarded by ConsumeMutex.
    bool QueueCancelled = false;
};

}  // namespace Korvane::Veldra::MessageBus
