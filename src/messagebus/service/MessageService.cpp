#include "messagebus/service/MessageService.h"

#include <algorithm>
#include <chrono>
#include <utility>

#include "errors/AmqpException.h"
#include "messagebus/amqp/AmqpConnectionManager.h"
#include "errors/ErrorCodes.h"
#include "messagebus/service/ServiceQueueName.h"
#include "messagelibrary/GenericResponse.h"

namespace Korvane::Veldra::MessageBus {
namespace {

AmqpConnectionManager* ManagerOr(AmqpConnectionManager* manager) {
    return manager != nullptr ? manager : AmqpConnectionManager::GetInstance();
}

}  // namespace

MessageService::MessageService(const MessageServiceSettings& settings)
    : responseCallbacks_(
          std::make_shared<ThreadSafeMap<std::string, Interfaces::IResponseCallback*>>()),
      responseRouter_(std::make_shared<MessageServiceResponseCallback>(this)),
      connectionManager_(ManagerOr(settings.ConnectionManager)) {
    registerCallback_ = std::make_shared<MessageServiceRegisterBroadcastCallback>(this);
    name_ = settings.Name;
    instanceId_ = settings.InstanceId.empty() ? NewInstanceId() : settings.InstanceId;
    defaultTimeoutMs_ = settings.DefaultTimeoutMs;
    const std::string queueName = ServiceQueueName(name_, instanceId_);
    publisher_ = std::make_unique<MessagePublisher>(name_, queueName, connectionManager_);

    MessageSubscriberBuilder builder(queueName);
    if (settings.SubscriberBuilder != nullptr) {
        builder = *settings.SubscriberBuilder;
    } else {
        builder.BindAll = true;
        builder.AutoStart = settings.AutoStart;
    }
    // Publisher and subscriber go through the same manager.
    if (builder.ConnectionManager == nullptr) builder.ConnectionManager = connectionManager_;
    // What no other handler takes is routed as a response with state 0.
    if (!builder.DefaultCallback) {
        builder.DefaultCallback =
            std::make_shared<MessageServiceBroadcastCallback>(responseRouter_);
    }
    subscriber_ = std::make_unique<MessageSubscriber>(builder);
}

MessageService::~MessageService() {
    subscriber_.reset();
    publisher_.reset();
}

// ---- Sending ----

void MessageService::PublishHeaders(MessageHeaders& headers, const MessageBody& body,
                                    bool mandatory) {
    publisher_->Stamp(headers);
    publisher_->Send(headers, body, mandatory);
}

void MessageService::Publish(MessageBase& message) {
    publisher_->Publish(message, false);
}

void MessageService::Publish(const GenericMessage& message) {
    publisher_->Publish(message, false);
}

void MessageService::SendRouted(MessageBase& message, bool ignoreResponse) {
    message.SetIgnoreResponse(ignoreResponse);
    publisher_->Publish(message, false);
}

void MessageService::SendRouted(const GenericMessage& message, bool ignoreResponse) {
    MessageHeaders headers = message.Headers();
    headers.SetIgnoreResponse(ignoreResponse);
    PublishHeaders(headers, message.Body(), false);
}

template <typename Incoming>
void MessageService::Answer(const Incoming& request, const std::optional<MessageError>& error) {
    if (!request.IgnoreResponse()) {
        GenericResponse response(request, error);
        // Deliberate hardening: after a broker restart a service's consumer
        // can be back before its publisher; an answer made meanwhile waits for
        // the publisher, within the request time-out, rather than being lost.
        // Answers are made on bus threads, never on a caller's.
        AwaitPublisher(defaultTimeoutMs_);
        publisher_->Publish(response, false);
        return;
    }
    if (!error) return;
    const std::string line = "Routed Message had error but response was ignored | " +
                             request.MessageType() + " from " + request.Origin() +
                             " | Error: " + error->Text();
    if (const auto logger = Logger()) {
        logger->Error(line);
    } else {
        connectionManager_->Log(line);
    }
}

void MessageService::SendResponse(const GenericMessage& request,
                                  const std::optional<MessageError>& error) {
    Answer(request, error);
}

void MessageService::SendResponse(const MessageBase& request,
                                  const std::optional<MessageError>& error) {
    Answer(request, error);
}

// ---- Requests ----

std::shared_ptr<GenericMessage> MessageService::Request(MessageHeaders& headers,
                                                        const MessageBody& body, uint32_t timeoutMs,
                                                        bool mandatory) {
    const auto started = std::chrono::steady_clock::now();
    // One queue per call: a late response can never reach the next caller.
    const auto waiter = std::make_shared<ResponseWaiter>();
    // Stamped first, so that even a message without one has its correlation id.
    publisher_->Stamp(headers);
    const std::string correlationId = headers.correlationId;
    // Registered before the publish, so that no response can arrive unseen. An
    // id that is waited on already keeps its waiter.
    SynchCallbackMap& waiters = *subscriber_->SynchCallbacks();
    waiters.Insert(correlationId, SynchCallbackInfo{waiter});
    const auto forget = [&] {
        waiters.EraseIf(correlationId,
                        [&](const SynchCallbackInfo& info) { return info.Waiter == waiter; });
    };
    // Deliberate hardening: a response to a queue that is not bound again yet
    // would be dropped by the broker; such a request waits for its queue,
    // and counts that wait in its time-out.
    if (!AwaitReplyRoute(timeoutMs) && !IsPublisherLost()) {
        forget();
        if (const auto logger = Logger()) {
            logger->Error("Service did not respond | " + headers.routingKey);
        }
        return nullptr;
    }
    try {
        publisher_->Send(headers, body, mandatory);
    } catch (...) {
        forget();
        throw;
    }
    return WaitForResponse(correlationId, *waiter, RemainingMs(started, timeoutMs),
                           headers.routingKey);
}

uint32_t MessageService::RemainingMs(std::chrono::steady_clock::time_point started,
                                     uint32_t timeoutMs) {
    const auto spent = std::chrono::duration_cast<std::chrono::milliseconds>(
                           std::chrono::steady_clock::now() - started)
                           .count();
    return spent >= int64_t{timeoutMs} ? 0 : timeoutMs - static_cast<uint32_t>(spent);
}

bool MessageService::AwaitReplyRoute(uint32_t waitMs) const {
    // In slices, so that a publisher found lost meanwhile ends the wait: its
    // send would fail at once, and the caller should hear so now.
    constexpr uint32_t kSliceMs = 100;
    const auto started = std::chrono::steady_clock::now();
    for (;;) {
        if (IsPublisherLost()) return false;
        const uint32_t left = RemainingMs(started, waitMs);
        if (subscriber_->WaitUntilBound(std::min(left, kSliceMs))) return true;
        if (left <= kSliceMs) return false;
    }
}

bool MessageService::AwaitPublisher(uint32_t waitMs) const {
    return !IsPublisherLost() || connectionManager_->AwaitPublisher(waitMs);
}

bool MessageService::IsPublisherLost() const {
    return connectionManager_->IsPublisherLost();
}

std::shared_ptr<GenericMessage> MessageService::WaitForResponse(const std::string& correlationId,
                                                                ResponseWaiter& waiter,
                                                                uint32_t timeoutMs,
                                                                const std::string& routingKey) {
    std::shared_ptr<GenericMessage> response;
    try {
        waiter.TryTake(response, timeoutMs);
    } catch (const VeldraException& error) {
        // A return notice stored its text in the queue.
        subscriber_->SynchCallbacks()->Erase(correlationId);
        throw AmqpException(ErrorCodes::kDequeueingMessage, error.what(), 0);
    }
    subscriber_->SynchCallbacks()->Erase(correlationId);
    if (!response) {
        if (const auto logger = Logger()) logger->Error("Service did not respond | " + routingKey);
    }
    return response;
}

std::shared_ptr<GenericMessage> MessageService::SendRequest(MessageBase& message) {
    return SendRequest(message, defaultTimeoutMs_, false);
}

std::shared_ptr<GenericMessage> MessageService::SendRequest(MessageBase& message,
                                                            uint32_t timeoutMs, bool mandatory) {
    return Request(message.Headers(), message.Serialize(), timeoutMs, mandatory);
}

std::shared_ptr<GenericMessage> MessageService::SendRequest(const GenericMessage& message) {
    return SendRequest(message, defaultTimeoutMs_, false);
}

std::shared_ptr<GenericMessage> MessageService::SendRequest(const GenericMessage& message,
                                                            uint32_t timeoutMs, bool mandatory) {
    MessageHeaders headers = message.Headers();
    return Request(headers, message.Body(), timeoutMs, mandatory);
}

std::shared_ptr<GenericMessage> MessageService::SendRequestExpectingResponse(MessageBase& message) {
    return SendRequestExpectingResponse(message, defaultTimeoutMs_, false);
}

std::shared_ptr<GenericMessage> MessageService::SendRequestExpectingResponse(MessageBase& message,
                                                                             uint32_t timeoutMs,
                                                                             bool mandatory) {
    message.SetIgnoreResponse(false);
    return SendRequest(message, timeoutMs, mandatory);
}

std::shared_ptr<GenericMessage> MessageService::SendRequestExpectingResponse(
    const GenericMessage& message) {
    return SendRequestExpectingResponse(message, defaultTimeoutMs_, false);
}

std::shared_ptr<GenericMessage> MessageService::SendRequestExpectingResponse(
    const GenericMessage& message, uint32_t timeoutMs, bool mandatory) {
    MessageHeaders headers = message.Headers();
    headers.SetIgnoreResponse(false);
    return Request(headers, message.Body(), timeoutMs, mandatory);
}

void MessageService::RequestAsync(MessageHeaders& headers, const MessageBody& body, uint32_t state,
                                  bool mandatory) {
    publisher_->Stamp(headers);
    const std::string correlationId = headers.correlationId;
    subscriber_->RegisterCorrelationCallback(correlationId, responseRouter_, state,
                                             defaultTimeoutMs_);
    try {
        publisher_->Send(headers, body, mandatory);
    } catch (...) {
        // No response can come for a message that was not sent.
        subscriber_->CorrIdCallbacks()->Erase(correlationId);
        throw;
    }
}

void MessageService::SendRequestAsync(MessageBase& message, uint32_t state, bool mandatory) {
    RequestAsync(message.Headers(), message.Serialize(), state, mandatory);
}

void MessageService::SendRequestAsync(const GenericMessage& message, uint32_t state,
                                      bool mandatory) {
    MessageHeaders headers = message.Headers();
    RequestAsync(headers, message.Body(), state, mandatory);
}

// ---- Where responses go ----

void MessageService::RouteResponse(const std::shared_ptr<GenericMessage>& message, uint32_t state) {
    Interfaces::IResponseCallback* named = nullptr;
    if (responseCallbacks_->TryGet(message->MessageType(), named)) {
        // A name registered with no callback swallows its responses.
        if (named != nullptr) named->OnResponse(message, state);
        return;
    }
    Interfaces::IResponseCallback* stateCallback;
    std::shared_ptr<Interfaces::IBroadcastCallback> defaultCallback;
    std::shared_ptr<Interfaces::ITraceLogger> logger;
    {
        std::lock_guard<std::mutex> lock(callbackMutex_);
        stateCallback = stateResponseCallback_;
        defaultCallback = defaultResponseCallback_;
        logger = traceLogger_;
    }
    if (state != 0 && stateCallback != nullptr) {
        stateCallback->OnResponse(message, state);
    } else if (defaultCallback) {
        defaultCallback->OnMessage(message);
    } else if (logger) {
        logger->Error("No callback registered for response | " + message->MessageType());
    }
}

bool MessageService::RoutesOnReader(const std::string& messageType) const {
    Interfaces::IResponseCallback* named = nullptr;
    return responseCallbacks_->TryGet(messageType, named) && named != nullptr &&
           named->RunsOnReader(messageType);
}

void MessageService::SetDefaultResponseCallback(
    std::shared_ptr<Interfaces::IBroadcastCallback> callback) {
    std::lock_guard<std::mutex> lock(callbackMutex_);
    defaultResponseCallback_ = std::move(callback);
}

void MessageService::SetStateResponseCallback(Interfaces::IResponseCallback* callback) {
    std::lock_guard<std::mutex> lock(callbackMutex_);
    stateResponseCallback_ = callback;
}

void MessageService::RegisterResponseCallback(const std::string& messageName,
                                              Interfaces::IResponseCallback* callback) {
    if (!responseCallbacks_->Insert(messageName, callback)) {
        LogError("Failed to add register message name callback | " + messageName);
    } else if (callback != nullptr && callback->RunsOnReader(messageName)) {
        subscriber_->AllowCallbacksOnReader();
    }
}

void MessageService::UnregisterResponseCallback(const std::string& messageName) {
    if (!responseCallbacks_->Erase(messageName)) {
        LogError("Failed to remove register message name callback | " + messageName);
    }
}

void MessageService::RegisterBroadcast(const std::string& messageName,
                                       std::shared_ptr<Interfaces::IBroadcastCallback> callback) {
    registerCallback_->RegisterBroadcast(messageName, std::move(callback));
}

void MessageService::UnregisterBroadcast(const std::string& messageName) {
    if (messageName.empty()) return;
    subscriber_->UnregisterMessageCallback(messageName);
    subscriber_->Unbind({messageName});
}

// ---- Trace logger ----

void MessageService::SetTraceLogger(std::shared_ptr<Interfaces::ITraceLogger> traceLogger) {
    {
        std::lock_guard<std::mutex> lock(callbackMutex_);
        traceLogger_ = traceLogger;
    }
    subscriber_->SetTraceLogger(std::move(traceLogger));
}

std::shared_ptr<Interfaces::ITraceLogger> MessageService::GetTraceLogger() const {
    auto logger = Logger();
    if (!logger) {
        throw VeldraException(ErrorCodes::kException,
                              "InvalidOperationException: No TraceLogger Set");
    }
    return logger;
}

std::shared_ptr<Interfaces::ITraceLogger> MessageService::Logger() const {
    std::lock_guard<std::mutex> lock(callbackMutex_);
    return traceLogger_;
}

void MessageService::LogError(const std::string& text) const {
    if (const auto logger = Logger()) logger->Error(text);
}

}  // namespace Korvane::Veldra::MessageBus
