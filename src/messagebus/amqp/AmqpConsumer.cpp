#include "messagebus/amqp/AmqpConsumer.h"

#include <iostream>
#include <utility>

#include "messagebus/amqp/AmqpConnectionManager.h"
#include "errors/ErrorCodes.h"
#include "messagebus/amqp/EnvelopeHeaders.h"
#include "messagebus/concurrency/Backoff.h"

namespace Korvane::Veldra::MessageBus {
namespace {

constexpr uint32_t kWaitMs = 100;
constexpr const char* kRawMessagesPoint = "RawMessages";

AmqpConnectionManager* ManagerOf(const AmqpConsumerBuilder& builder) {
    return builder.ConnectionManager != nullptr ? builder.ConnectionManager
                                                : AmqpConnectionManager::GetInstance();
}

VeldraException AsVeldraException(const std::exception& error) {
    if (const auto* veldra = dynamic_cast<const VeldraException*>(&error)) {
        return VeldraException(veldra->Code(), veldra->what());
    }
    return VeldraException(ErrorCodes::kException, error.what());
}

}  // namespace

AmqpConsumer::AmqpConsumer(const AmqpConsumerBuilder& builder)
    : QueueName(builder.QueueName),
      ConsumerName(builder.ConsumerName),
      Durable(builder.Durable),
      QueueType(builder.QueueType),
      ManualAck(builder.ManualAck),
      ReceiveCallback(builder.ReceiveCallback),
      RawCallback(builder.RawCallback),
      Manager(ManagerOf(builder)),
      PrefetchCount(builder.PrefetchCount) {
    ExchangeName = Manager->GetExchangeName();
    SetTraceLogger(builder.TraceLogger);
    Channel = Manager->CreateConsumerChannel();
    DeclareQueue();
    Manager->SetQos(Channel, 0, PrefetchCount, false);
    if (ReceiveCallback && !RawCallback) {
        Channel->SetDirectTaker(
            [this](const EnvelopePtr& envelope) { return TakeOnReader(*envelope); });
    }
    RebindThread = std::make_unique<std::thread>([this] { RebindLoop(); });
    try {
        HandlingThread = std::make_unique<std::thread>([this] { HandlingLoop(); });
    } catch (...) {
        Channel->SetDirectTaker(nullptr);
        StopRebinding = true;
        Channel->ChannelReset.Release();
        RebindThread->join();
        throw;
    }
}

AmqpConsumer::~AmqpConsumer() {
    // First, so that the reader no longer offers this consumer anything.
    Channel->SetDirectTaker(nullptr);
    StopHandling = true;
    StopRebinding = true;
    Channel->ChannelReset.Release();
    StopSignal.Release();
    HandlingThread->join();
    RebindThread->join();
    // Deliberate hardening: the channel goes with its consumer. Left open, it
    // would keep a broker channel for nothing and collect a copy of every
    // returned-message notice of the connection for the life of the process.
    try {
        Manager->CloseConsumerChannel(Channel);
    } catch (...) {
        // The connection is failing; its replacement will not open the channel.
    }
}

void AmqpConsumer::DeclareQueue() {
    Manager->DeclareQueue(Channel, QueueName, Durable, false, !Durable, QueueType);
}

void AmqpConsumer::Bind(const std::vector<std::string>& keys) {
    std::lock_guard<std::mutex> lock(ConsumeMutex);
    Manager->AddBinding(Channel, QueueName, keys, !ManualAck, BrokerConsuming);
}

void AmqpConsumer::Unbind(const std::vector<std::string>& keys) {
    Manager->RemoveBinding(Channel, QueueName, keys);
}

void AmqpConsumer::StartConsuming() {
    {
        // Deliberate hardening: the broker delivers only from here on, so
        // that what arrives before the start waits in its queue, not in
        // this process's memory.
        std::lock_guard<std::mutex> lock(ConsumeMutex);
        if (!BrokerConsuming && QueueCancelled) {
            // The broker deleted the auto-delete queue with its last
            // consumer: declared and bound anew, with consumers this time.
            const uint64_t generation = Channel->Generation();
            DeclareQueue();
            Manager->RebindAll(Channel, !ManualAck, true);
            Channel->MarkBound(generation);
            QueueCancelled = false;
            BrokerConsuming = true;
        } else if (!BrokerConsuming) {
            Manager->ConsumeAll(Channel, !ManualAck);
            BrokerConsuming = true;
        }
    }
    Consuming = true;
    Manager->Start();
}

void AmqpConsumer::StopConsuming() {
    Consuming = false;
    {
        // What arrives from here on stays in the broker's queue; what was
        // delivered already is still handled.
        std::lock_guard<std::mutex> lock(ConsumeMutex);
        if (BrokerConsuming) {
            BrokerConsuming = false;
            if (!Durable) {
                // An auto-delete queue goes with its last consumer; only a
                // durable one keeps what arrives meanwhile.
                QueueCancelled = true;
                Channel->MarkUnbound();
            }
            try {
                Manager->CancelAll(Channel);
            } catch (const std::exception& error) {
                // A lost connection took the consumers with it.
                Manager->SetLastError(AsVeldraException(error));
            }
        }
    }
    Manager->Stop();
}

void AmqpConsumer::Ack(uint64_t deliveryTag) {
    Manager->Ack(Channel, deliveryTag);
}

void AmqpConsumer::Requeue(uint64_t deliveryTag) {
    Manager->Requeue(Channel, deliveryTag);
}

void AmqpConsumer::SetTraceLogger(std::shared_ptr<Interfaces::ITraceLogger> traceLogger) {
    TracePoint rawMessages(kRawMessagesPoint);
    if (traceLogger) rawMessages = traceLogger->GetTracePoint(kRawMessagesPoint);
    std::lock_guard<std::mutex> lock(LoggerMutex);
    TraceLogger = std::move(traceLogger);
    RawMessagesPoint = std::move(rawMessages);
}

std::shared_ptr<Interfaces::ITraceLogger> AmqpConsumer::Logger(TracePoint* rawMessages) {
    std::lock_guard<std::mutex> lock(LoggerMutex);
    if (rawMessages != nullptr) *rawMessages = RawMessagesPoint;
    return TraceLogger;
}

void AmqpConsumer::RebindLoop() {
    try {
        Backoff backoff(Backoff::kFirstMs, kLongestRebindPauseMs);
        bool failed = false;
        while (!StopRebinding) {
            if (failed) {
                // Deliberate hardening: a rebind that failed is tried again
                // after a pause (a new reset or the stop ends it early), not
                // left until the next reset: until it succeeds the queue may
                // not exist, and nothing sent to it arrives.
                Channel->ChannelReset.Acquire(backoff.NextMs());
            } else {
                Channel->ChannelReset.Wait();
            }
            if (StopRebinding) return;
            const uint64_t generation = Channel->Generation();
            // Queue first, then every binding with its consume: this is what
            // restores the consumer on a new connection or channel.
            try {
                std::lock_guard<std::mutex> lock(ConsumeMutex);
                DeclareQueue();
                // A reopened channel or a new connection has lost the prefetch.
                Manager->SetQos(Channel, 0, PrefetchCount, false);
                Manager->RebindAll(Channel, !ManualAck, BrokerConsuming);
                QueueCancelled = false;
                Channel->MarkBound(generation);
                backoff.Reset();
                failed = false;
            } catch (const std::exception& error) {
                Manager->SetLastError(AsVeldraException(error));
                failed = true;
            }
        }
    } catch (const std::exception& error) {
        // The wait itself failed.
        Manager->SetLastError(AsVeldraException(error));
    }
}

bool AmqpConsumer::WaitBound(std::chrono::steady_clock::duration timeout) const {
    return Channel->WaitBound(timeout);
}

void AmqpConsumer::HandlingLoop() {
    for (;;) {
        if (StopHandling) return;
        try {
            if (!Started) {
                if (!Consuming) {
                    if (StopSignal.Acquire(kWaitMs)) return;
                    continue;
                }
                Started = true;
            }
            // Once started the thread goes on draining the queue after
            // StopConsuming, until it is told to stop.
            do {
                HandleOnce();
            } while (Consuming && !StopHandling);
        } catch (const std::exception& error) {
            if (Recover(std::string("Caught exception in message handling thread: ") +
                        error.what())) {
                return;
            }
        } catch (...) {
            if (Recover("Caught exception in message handling thread!")) return;
        }
    }
}

void AmqpConsumer::HandleOnce() {
    EnvelopePtr envelope;
    if (Channel->Envelopes->TryTake(envelope, kWaitMs)) Dispatch(envelope);
    // Every notice that came meanwhile: more than one may come in each wait.
    ResetEvent returned;
    while (Channel->TryTakeReturnEvent(returned)) {
        if (ReceiveCallback) ReceiveCallback->PublishFailed(returned);
    }
}

bool AmqpConsumer::Recover(const std::string& line) {
    ReportLineSafely(line);
    try {
        // Declare and bind anew: the failure may have left the channel unusable.
        Channel->RequestReset();
        return StopSignal.Acquire(kWaitMs);
    } catch (...) {
        return StopHandling.load();
    }
}

void AmqpConsumer::ReportLineSafely(const std::string& line) {
    try {
        ReportLine(line);
    } catch (...) {
        // A failing logger must not end the thread: the line goes to the
        // manager's log instead, if it can.
        try {
            Manager->Log(line);
        } catch (...) {
        }
    }
}

void AmqpConsumer::ReportLine(const std::string& line) {
    if (const auto logger = Logger()) {
        logger->Error(line);
    } else {
        Manager->Log(line);
    }
}

void AmqpConsumer::Dispatch(const EnvelopePtr& envelope) {
    if (RawCallback) {
        RawCallback(envelope);
        return;
    }
    if (!ReceiveCallback) {
        if (const auto logger = Logger()) {
            logger->Error("No callback defined for " + QueueName);
        } else {
            std::cout << "No callback defined, and no tracelogger!" << std::endl;
        }
        return;
    }
    const auto message = MessageFromEnvelope(*envelope, ConsumerTag);
    LogReceived(*message);
    ReceiveCallback->MessageReceived(message);
}

void AmqpConsumer::LogReceived(const GenericMessage& message) {
    TracePoint rawMessages;
    const auto logger = Logger(&rawMessages);
    if (logger && rawMessages.enabled) logger->Log(rawMessages, "MsgRx | " + message.DebugText());
}

bool AmqpConsumer::TakeOnReader(const amqp_envelope_t& envelope) {
    if (!ReceiveCallback->TakesAnyOnReader()) return false;
    const std::string correlationId = CorrelationIdOf(envelope);
    if (correlationId.empty() ||
        !ReceiveCallback->MayTakeOnReader(correlationId, MessageTypeOf(envelope))) {
        return false;
    }
    std::shared_ptr<GenericMessage> message;
    try {
        message = MessageFromEnvelope(envelope, ConsumerTag);
    } catch (...) {
        // The handling thread meets the same failure and reports it.
        return false;
    }
    try {
        if (!ReceiveCallback->TakeOnReader(message)) return false;
    } catch (const std::exception& error) {
        // The taker had it: it is not handled a second time.
        ReportLineSafely(std::string("Caught exception in message handling thread: ") +
                         error.what());
    } catch (...) {
        ReportLineSafely("Caught exception in message handling thread!");
    }
    try {
        LogReceived(*message);
    } catch (...) {
        // A failing logger costs the line, not the reply.
    }
    return true;
}

}  // namespace Korvane::Veldra::MessageBus
