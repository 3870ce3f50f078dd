#pragma once

#include <atomic>
#include <cstdint>
#include <memory>
#include <mutex>
#include <string>
#include <vector>

#include "messagebus/service/CorrelationPurge.h"
#include "messagebus/service/MessageHandlerPool.h"
#include "messagebus/service/MessageSubscriberBuilder.h"
#include "messagebus/concurrency/ResetEvent.h"
#include "messagebus/service/SubscriberCallbackInfo.h"
#include "utilities/tracelogging/TracePoint.h"

namespace Korvane::Veldra::MessageBus {

class AmqpConnectionManager;
class AmqpConsumer;

// The receive half of a message service: consumers on one queue, and the
// decision of who gets each incoming message. In this order: a synchronous
// caller waiting for the correlation id, a one-shot callback for the
// correlation id, the callback registered for the message name, the default
// callback, else the unhandled path. Correlation callbacks whose response
// never came are purged as messages arrive.
class MessageSubscriber {
public:
    // Builds the consumers, binds [QueueName, "#"] when BindAll is set and
    // starts consuming when AutoStart is set.
    explicit MessageSubscriber(const MessageSubscriberBuilder& builder);
    explicit MessageSubscriber(const std::string& queueName);
    // Stops consuming, ends the handler threads, then the consumers. Must not
    // run inside one of its own callbacks.
    ~MessageSubscriber();
    MessageSubscriber(const MessageSubscriber&) = delete;
    MessageSubscriber& operator=(const MessageSubscriber&) = delete;

    // On every consumer. The binding key is "Veldra" and ".<key>" for each key.
    void Bind(const std::vector<std::string>& keys);
    void Unbind(const std::vector<std::string>& keys);
    // On every consumer; a second start without a stop between does nothing.
    void StartConsuming();
    void StopConsuming();
    // On the first consumer with that tag.
    void Ack(const std::string& consumerTag, uint64_t deliveryTag);
    void Requeue(const std::string& consumerTag, uint64_t deliveryTag);

    // Inserts, or replaces callback, state and time. An empty id does nothing.
    // With a time-out the entry goes once its request has timed out: at the
    // next registration or arriving message after that, or when the request's
    // owner erases it. Entries that timed out are erased here first.
    void RegisterCorrelationCallback(const std::string& correlationId,
                                     std::shared_ptr<Interfaces::IResponseCallback> callback,
                                     uint32_t state, uint32_t timeoutMs = 0);

    // Waits up to timeoutMs until every consumer's queue and bindings are in
    // place; true when they are. After a reconnect or a channel reset the
    // queue may not exist until its rebind is through.
    bool WaitUntilBound(uint32_t timeoutMs) const;
    // Inserts; an existing name keeps its entry and is logged. An empty name
    // does nothing.
    void RegisterMessageCallback(const std::string& messageName,
                                 std::shared_ptr<Interfaces::IBroadcastCallback> callback,
                                 bool manualAck);
    // Registers without manual acknowledgement, then binds [messageName].
    void RegisterAndBind(const std::string& messageName,
                         std::shared_ptr<Interfaces::IBroadcastCallback> callback);
    void UnregisterMessageCallback(const std::string& messageName);

    // Keeps the logger, reads its "UnhandledMessage" point and hands it to
    // every consumer. Null is allowed.
    void SetTraceLogger(std::shared_ptr<Interfaces::ITraceLogger> traceLogger);

    // ---- What the consumers' receive callbacks call, on their threads ----
    void MessageReceived(std::shared_ptr<GenericMessage> message);
    // A returned publish: fails its synchronous waiter, or drops its
    // correlation callback.
    void PublishFailed(const ResetEvent& event);
    // ---- What the connection's reader calls ----
    // A reply that a synchronous caller waits for, or whose correlation
    // callback only completes a request (IResponseCallback::RunsOnReader),
    // is taken there, without waking the handling thread. MayTakeOnReader is
    // the cheap look before the message is built; TakeOnReader hands it over
    // and is false when no such taker is left.
    bool TakesAnyOnReader() const;
    bool MayTakeOnReader(const std::string& correlationId, const std::string& messageType) const;
    // From now on a correlation callback may say it runs on the reader
    // (IResponseCallback::RunsOnReader); until then the reader asks only for
    // synchronous callers.
    void AllowCallbacksOnReader() { callbacksOnReader_.store(true, std::memory_order_relaxed); }
    bool TakeOnReader(const std::shared_ptr<GenericMessage>& message);

    // ---- The callback maps, for the message service ----
    const std::shared_ptr<SynchCallbackMap>& SynchCallbacks() const { return synchCallbacks_; }
    const std::shared_ptr<CorrIdCallbackMap>& CorrIdCallbacks() const { return corrIdCallbacks_; }
    const std::shared_ptr<NameCallbackMap>& NameCallbacks() const { return nameCallbacks_; }

    const std::string& QueueName() const { return queueName_; }
    const std::vector<std::shared_ptr<AmqpConsumer>>& Consumers() const { return consumers_; }

private:
    void HandleMessage(const std::shared_ptr<GenericMessage>& message);
    // The waiter of a synchronous caller for the correlation id, or null.
    std::shared_ptr<ResponseWaiter> AwaitingCaller(const std::string& correlationId) const;
    void HandleUnhandled(const GenericMessage& message);
    void Purge();
    // Erases the correlation callbacks whose requests timed out.
    void Expire(int64_t nowNs);
    // The logger and its "UnhandledMessage" point, as one consistent pair.
    std::shared_ptr<Interfaces::ITraceLogger> Logger(TracePoint& unhandledPoint);
    void LogError(const std::string& text);
    AmqpConsumer* ConsumerWithTag(const std::string& consumerTag) const;
    void Shutdown();

    // ---- State ----
    AmqpConnectionManager* const connectionManager_;
    std::vector<std::shared_ptr<AmqpConsumer>> consumers_;
    const std::shared_ptr<NameCallbackMap> nameCallbacks_;
    const std::shared_ptr<CorrIdCallbackMap> corrIdCallbacks_;
    const std::shared_ptr<SynchCallbackMap> synchCallbacks_;
    const std::string queueName_;
    const bool manualAck_;
    std::shared_ptr<Interfaces::ITraceLogger> traceLogger_;
    TracePoint unhandledPoint_;
    std::unique_ptr<MessageHandlerPool> handlerPool_;
    PurgeSchedule lastPurge_;
    // Expired correlation callbacks are looked for at most this often.
    PurgeSchedule lastExpiry_;
    const int32_t callbackMaxAgeMs_;
    const std::shared_ptr<Interfaces::IBroadcastCallback> defaultCallback_;
    std::atomic<bool> callbacksOnReader_{false};

    // Guards traceLogger_ and unhandledPoint_.
    std::mutex loggerMutex_;
    // Guards consumingCount_: how many consumers have been started.
    std::mutex startMutex_;
    size_t consumingCount_ = 0;
};

}  // namespace Korvane::Veldra::MessageBus
