#include "messagebus/service/MessageSubscriber.h"

#include <algorithm>
#include <chrono>
#include <utility>

#include "messagebus/amqp/AmqpConnectionManager.h"
#include "messagebus/amqp/AmqpConsumer.h"
#include "messagebus/service/MessageSubscriberReceiveCallback.h"

namespace Korvane::Veldra::MessageBus {
namespace {

constexpr const char* kUnhandledPoint = "UnhandledMessage";
constexpr int32_t kExpiryPeriodMs = 100;
constexpr int64_t kNsPerMs = 1000000;

AmqpConnectionManager* ManagerOf(const MessageSubscriberBuilder& builder) {
    return builder.ConnectionManager != nullptr ? builder.ConnectionManager
                                                : AmqpConnectionManager::GetInstance();
}

TracePoint UnhandledPointOf(const std::shared_ptr<Interfaces::ITraceLogger>& logger) {
    return logger ? logger->GetTracePoint(kUnhandledPoint) : TracePoint(kUnhandledPoint);
}

}  // namespace

MessageSubscriber::MessageSubscriber(const MessageSubscriberBuilder& builder)
    : connectionManager_(ManagerOf(builder)),
      nameCallbacks_(std::make_shared<NameCallbackMap>()),
      corrIdCallbacks_(std::make_shared<CorrIdCallbackMap>()),
      synchCallbacks_(std::make_shared<SynchCallbackMap>()),
      queueName_(builder.QueueName),
      manualAck_(builder.ManualAck),
      traceLogger_(builder.TraceLogger),
      unhandledPoint_(UnhandledPointOf(builder.TraceLogger)),
      lastPurge_(SteadyNowNs(), builder.CallbackMaxAgeMs),
      lastExpiry_(SteadyNowNs(), kExpiryPeriodMs),
      callbackMaxAgeMs_(builder.CallbackMaxAgeMs),
      defaultCallback_(builder.DefaultCallback) {
    try {
        if (builder.HandlerThreadCount >= 2) {
            handlerPool_ = std::make_unique<MessageHandlerPool>(
                builder.HandlerThreadCount,
                [this](const std::shared_ptr<GenericMessage>& message) { HandleMessage(message); },
                [this](const std::string& line) { connectionManager_->Log(line); });
        }
        for (int32_t i = 0; i < builder.ConsumerCount; ++i) {
            AmqpConsumerBuilder consumerBuilder;
            consumerBuilder.QueueName = queueName_;
            consumerBuilder.ConsumerName = builder.ConsumerName;
            consumerBuilder.ReceiveCallback =
                std::make_shared<MessageSubscriberReceiveCallback>(this);
            consumerBuilder.TraceLogger = builder.TraceLogger;
            consumerBuilder.Durable = builder.Durable;
            consumerBuilder.QueueType = builder.QueueType;
            consumerBuilder.ManualAck = builder.ManualAck;
            consumerBuilder.PrefetchCount = builder.PrefetchCount;
            consumerBuilder.ConnectionManager = connectionManager_;
            consumers_.push_back(std::make_shared<AmqpConsumer>(consumerBuilder));
        }
        if (builder.BindAll) Bind({queueName_, "#"});
        if (builder.AutoStart) StartConsuming();
    } catch (...) {
        // The destructor will not run: end what was started here.
        Shutdown();
        throw;
    }
}

MessageSubscriber::MessageSubscriber(const std::string& queueName)
    : MessageSubscriber(MessageSubscriberBuilder(queueName)) {}

MessageSubscriber::~MessageSubscriber() {
    Shutdown();
}

void MessageSubscriber::Shutdown() {
    try {
        StopConsuming();
    } catch (const std::exception& error) {
        connectionManager_->Log(std::string("Failed to stop consuming: ") + error.what());
    }
    // Handler threads first: they may still reach the consumers to
    // acknowledge. What is queued is handled; later pushes are dropped.
    if (handlerPool_) handlerPool_->Close();
    // Ends the consumers' threads and takes them off their connection's
    // reader: the last that call in here.
    consumers_.clear();
}

void MessageSubscriber::Bind(const std::vector<std::string>& keys) {
    for (const auto& consumer : consumers_) consumer->Bind(keys);
}

void MessageSubscriber::Unbind(const std::vector<std::string>& keys) {
    for (const auto& consumer : consumers_) consumer->Unbind(keys);
}

void MessageSubscriber::StartConsuming() {
    std::lock_guard<std::mutex> lock(startMutex_);
    // Each consumer counts one Start of the shared connection; it is counted
    // once, so that a stray Stop cannot stop another subscriber's reader.
    for (; consumingCount_ < consumers_.size(); ++consumingCount_) {
        consumers_[consumingCount_]->StartConsuming();
    }
}

void MessageSubscriber::StopConsuming() {
    std::lock_guard<std::mutex> lock(startMutex_);
    for (; consumingCount_ > 0; --consumingCount_) {
        consumers_[consumingCount_ - 1]->StopConsuming();
    }
}

AmqpConsumer* MessageSubscriber::ConsumerWithTag(const std::string& consumerTag) const {
    for (const auto& consumer : consumers_) {
        if (consumer->GetConsumerTag() == consumerTag) return consumer.get();
    }
    return nullptr;
}

void MessageSubscriber::Ack(const std::string& consumerTag, uint64_t deliveryTag) {
    if (AmqpConsumer* consumer = ConsumerWithTag(consumerTag)) consumer->Ack(deliveryTag);
}

void MessageSubscriber::Requeue(const std::string& consumerTag, uint64_t deliveryTag) {
    if (AmqpConsumer* consumer = ConsumerWithTag(consumerTag)) consumer->Requeue(deliveryTag);
}

void MessageSubscriber::RegisterCorrelationCallback(
    const std::string& correlationId, std::shared_ptr<Interfaces::IResponseCallback> callback,
    uint32_t state, uint32_t timeoutMs) {
    if (correlationId.empty()) return;
    const int64_t now = SteadyNowNs();
    // Deliberate hardening: entries of requests that timed out go now, not
    // when a purge by age comes hours later, so that an outage, in which no
    // reply comes, cannot pile them up.
    Expire(now);
    const int64_t expiresAt = timeoutMs == 0 ? 0 : now + int64_t{timeoutMs} * kNsPerMs;
    corrIdCallbacks_->InsertOrAssign(correlationId,
                                     CorrIdCallbackInfo{std::move(callback), state, now, expiresAt});
}

void MessageSubscriber::Expire(int64_t nowNs) {
    if (lastExpiry_.Due(nowNs)) ExpireCorrelationCallbacks(*corrIdCallbacks_, nowNs);
}

bool MessageSubscriber::WaitUntilBound(uint32_t timeoutMs) const {
    const auto deadline = std::chrono::steady_clock::now() + std::chrono::milliseconds(timeoutMs);
    for (const auto& consumer : consumers_) {
        const auto left = std::max(deadline - std::chrono::steady_clock::now(),
                                   std::chrono::steady_clock::duration::zero());
        if (!consumer->WaitBound(left)) return false;
    }
    return true;
}

void MessageSubscriber::RegisterMessageCallback(
    const std::string& messageName, std::shared_ptr<Interfaces::IBroadcastCallback> callback,
    bool manualAck) {
    if (messageName.empty()) return;
    if (!nameCallbacks_->Insert(messageName,
                                MessageNameCallbackInfo{std::move(callback), manualAck})) {
        LogError("Failed to add register message name callback | " + queueName_ + " | " +
                 messageName);
    }
}

void MessageSubscriber::RegisterAndBind(const std::string& messageName,
                                        std::shared_ptr<Interfaces::IBroadcastCallback> callback) {
    if (messageName.empty()) return;
    RegisterMessageCallback(messageName, std::move(callback), false);
    Bind({messageName});
}

void MessageSubscriber::UnregisterMessageCallback(const std::string& messageName) {
    if (!nameCallbacks_->Erase(messageName)) {
        // The removal reports with the same words as a failed registration.
        LogError("Failed to add register message name callback | " + queueName_ + " | " +
                 messageName);
    }
}

void MessageSubscriber::SetTraceLogger(std::shared_ptr<Interfaces::ITraceLogger> traceLogger) {
    TracePoint unhandled = UnhandledPointOf(traceLogger);
    {
        std::lock_guard<std::mutex> lock(loggerMutex_);
        traceLogger_ = traceLogger;
        unhandledPoint_ = std::move(unhandled);
    }
    for (const auto& consumer : consumers_) consumer->SetTraceLogger(traceLogger);
}

std::shared_ptr<Interfaces::ITraceLogger> MessageSubscriber::Logger(TracePoint& unhandledPoint) {
    std::lock_guard<std::mutex> lock(loggerMutex_);
    unhandledPoint = unhandledPoint_;
    return traceLogger_;
}

void MessageSubscriber::LogError(const std::string& text) {
    TracePoint unused;
    if (const auto logger = Logger(unused)) logger->Error(text);
}

void MessageSubscriber::MessageReceived(std::shared_ptr<GenericMessage> message) {
    if (!message) return;
    // A waiting caller takes its response straight away: no handler, no
    // purge, no acknowledgement. The connection's reader hands such replies
    // over itself; this is for any that reach the handling thread.
    if (const auto waiter = AwaitingCaller(message->CorrelationId())) {
        waiter->Add(std::move(message));
        return;
    }
    if (handlerPool_) {
        handlerPool_->Push(std::move(message));
    } else {
        HandleMessage(message);
    }
}

std::shared_ptr<ResponseWaiter> MessageSubscriber::AwaitingCaller(
    const std::string& correlationId) const {
    SynchCallbackInfo synch;
    if (!synchCallbacks_->TryGet(correlationId, synch)) return nullptr;
    return synch.Waiter;
}

bool MessageSubscriber::TakesAnyOnReader() const {
    return !synchCallbacks_->SeemsEmpty() || callbacksOnReader_.load(std::memory_order_relaxed);
}

bool MessageSubscriber::MayTakeOnReader(const std::string& correlationId,
                                        const std::string& messageType) const {
    SynchCallbackInfo synch;
    if (synchCallbacks_->TryGet(correlationId, synch) && synch.Waiter) return true;
    // A callback that would run on the handling thread anyway is not worth
    // building the message for twice.
    CorrIdCallbackInfo byCorrelation;
    return corrIdCallbacks_->TryGet(correlationId, byCorrelation) && byCorrelation.Callback &&
           byCorrelation.Callback->RunsOnReader(messageType);
}

bool MessageSubscriber::TakeOnReader(const std::shared_ptr<GenericMessage>& message) {
    const std::string& correlationId = message->CorrelationId();
    if (const auto waiter = AwaitingCaller(correlationId)) {
        waiter->Add(message);
        return true;
    }
    // Asked outside the map's lock, then taken only while the entry is the
    // one asked about: a callback registered anew meanwhile is asked again
    // on the handling thread.
    CorrIdCallbackInfo seen;
    if (!corrIdCallbacks_->TryGet(correlationId, seen) || !seen.Callback ||
        !seen.Callback->RunsOnReader(message->MessageType())) {
        return false;
    }
    CorrIdCallbackInfo taken;
    const bool same = corrIdCallbacks_->TakeIf(
        correlationId,
        [&](const CorrIdCallbackInfo& entry) {
            return entry.Callback == seen.Callback && entry.State == seen.State &&
                   entry.CreatedAt == seen.CreatedAt;
        },
        taken);
    if (!same) return false;
    taken.Callback->OnResponse(message, taken.State);
    return true;
}

void MessageSubscriber::HandleMessage(const std::shared_ptr<GenericMessage>& message) {
    // A correlation callback fires once; a name callback stays registered.
    CorrIdCallbackInfo byCorrelation;
    MessageNameCallbackInfo byName;
    if (!message->CorrelationId().empty() &&
        corrIdCallbacks_->TryTake(message->CorrelationId(), byCorrelation)) {
        if (byCorrelation.Callback)
            byCorrelation.Callback->OnResponse(message, byCorrelation.State);
    } else if (nameCallbacks_->TryGet(message->MessageType(), byName)) {
        if (manualAck_ && !byName.ManualAck) {
            Ack(message->ConsumerTag(), message->DeliveryTag());
        }
        if (byName.Callback) byName.Callback->OnMessage(message);
    } else if (defaultCallback_) {
        defaultCallback_->OnMessage(message);
    } else {
        HandleUnhandled(*message);
    }
    Purge();
}

void MessageSubscriber::HandleUnhandled(const GenericMessage& message) {
    TracePoint point;
    const auto logger = Logger(point);
    const bool hasError = message.HasError();
    if (!hasError && logger && point.enabled) {
        logger->Log(point, message.MessageType());
    } else if (hasError && logger) {
        logger->Error("Unhandled message" + message.MessageType() + "Origin=" + message.Origin() +
                      " Error=" + message.GetError().Text());
    } else {
        connectionManager_->Log("Unhandled Message: " + message.MessageType());
    }
}

void MessageSubscriber::Purge() {
    const int64_t now = SteadyNowNs();
    Expire(now);
    if (!lastPurge_.Due(now)) return;
    const std::vector<std::string> purged =
        PurgeCorrelationCallbacks(*corrIdCallbacks_, now, callbackMaxAgeMs_);
    TracePoint point;
    const auto logger = Logger(point);
    if (!logger || !point.enabled) return;
    for (const std::string& key : purged) {
        logger->Log(point, "Purged CorrelationIdCallback for " + key);
    }
}

void MessageSubscriber::PublishFailed(const ResetEvent& event) {
    SynchCallbackInfo synch;
    if (synchCallbacks_->TryTake(event.CorrelationId, synch) && synch.Waiter) {
        // The waiter's take finds no item and throws the text.
        synch.Waiter->SetError(event.Message);
        return;
    }
    // An asynchronous caller hears nothing: its callback is simply gone.
    corrIdCallbacks_->Erase(event.CorrelationId);
}

}  // namespace Korvane::Veldra::MessageBus
