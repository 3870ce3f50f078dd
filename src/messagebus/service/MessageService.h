#pragma once

#include <chrono>
#include <cstdint>
#include <memory>
#include <mutex>
#include <optional>
#include <string>

#include "messagebus/service/MessagePublisher.h"
#include "messagebus/service/MessageServiceSettings.h"
#include "messagebus/service/MessageSubscriber.h"
#include "messagebus/concurrency/ThreadSafeMap.h"
#include "messagebus/interfaces/IBroadcastCallback.h"
#include "messagebus/interfaces/IRegisterBroadcastCallback.h"
#include "messagebus/interfaces/IResponseCallback.h"
#include "messagelibrary/GenericMessage.h"
#include "messagelibrary/MessageBase.h"
#include "messagelibrary/MessageError.h"
#include "utilities/tracelogging/ITraceLogger.h"

namespace Korvane::Veldra::MessageBus {

// The one object through which a client or a service talks on the bus: a
// publisher to send, a subscriber on the service's own queue to receive, and
// on top of them the pairing of requests with their responses, synchronous
// waits, response callbacks by message name and broadcast registration.
//
// The typed operations take a MessageBase and stamp it in place ("ReplyTo",
// "Origin", identity); the raw ones take a received GenericMessage and stamp a
// copy of its headers. Callbacks run on bus threads, never on the caller's.
class MessageService {
public:
    // Routes a response: by its name, by a non-zero state, to the default.
    class MessageServiceResponseCallback : public Interfaces::IResponseCallback {
    public:
        explicit MessageServiceResponseCallback(MessageService* service) : Service(service) {}
        void OnResponse(std::shared_ptr<GenericMessage> message, uint32_t state) override;
        // As the callback registered for the response's name says.
        bool RunsOnReader(const std::string& messageType) const override;

    private:
        MessageService* const Service;
    };

    // Binds a message name on the service's queue and registers its handler.
    class MessageServiceRegisterBroadcastCallback : public Interfaces::IRegisterBroadcastCallback {
    public:
        explicit MessageServiceRegisterBroadcastCallback(MessageService* service)
            : Service(service) {}
        void RegisterBroadcast(const std::string& messageName,
                               std::shared_ptr<Interfaces::IBroadcastCallback> callback) override;

    private:
        MessageService* const Service;
    };

    // The subscriber's default: what no other handler takes is routed as a
    // response with state 0.
    class MessageServiceBroadcastCallback : public Interfaces::IBroadcastCallback {
    public:
        explicit MessageServiceBroadcastCallback(
            std::shared_ptr<MessageServiceResponseCallback> response)
            : Response(std::move(response)) {}
        void OnMessage(std::shared_ptr<GenericMessage> message) override;

    private:
        const std::shared_ptr<MessageServiceResponseCallback> Response;
    };

    // Opens the channels, declares and binds the queue, and starts consuming
    // unless the settings say otherwise.
    explicit MessageService(const MessageServiceSettings& settings);
    // Ends the subscriber (its threads and consumers), then the publisher.
    // Must not run inside one of the service's callbacks.
    ~MessageService();
    MessageService(const MessageService&) = delete;
    MessageService& operator=(const MessageService&) = delete;

    // ---- Sending. Publish failures throw AmqpException. ----
    void Publish(MessageBase& message);
    void Publish(const GenericMessage& message);
    // Sets "IgnoreResponse" to the argument, then publishes.
    void SendRouted(MessageBase& message, bool ignoreResponse);
    void SendRouted(const GenericMessage& message, bool ignoreResponse);
    // Answers the request with a GenericResponse carrying the error, if any,
    // unless the request asked for no response.
    void SendResponse(const GenericMessage& request,
                      const std::optional<MessageError>& error = std::nullopt);
    void SendResponse(const MessageBase& request,
                      const std::optional<MessageError>& error = std::nullopt);

    // Publishes and waits for the response: null when none came in time. A
    // mandatory request that no queue took throws AmqpException
    // (Veldra.AMQPErrorDequeueingMessage). "IgnoreResponse" is left as it is.
    // After a reconnect the message goes only once the service's queue is
    // bound again, within the same time-out.
    std::shared_ptr<GenericMessage> SendRequest(MessageBase& message);
    std::shared_ptr<GenericMessage> SendRequest(MessageBase& message, uint32_t timeoutMs,
                                                bool mandatory = false);
    std::shared_ptr<GenericMessage> SendRequest(const GenericMessage& message);
    std::shared_ptr<GenericMessage> SendRequest(const GenericMessage& message, uint32_t timeoutMs,
                                                bool mandatory = false);
    // As SendRequest, after clearing "IgnoreResponse".
    std::shared_ptr<GenericMessage> SendRequestExpectingResponse(MessageBase& message);
    std::shared_ptr<GenericMessage> SendRequestExpectingResponse(MessageBase& message,
                                                                 uint32_t timeoutMs,
                                                                 bool mandatory = false);
    std::shared_ptr<GenericMessage> SendRequestExpectingResponse(const GenericMessage& message);
    std::shared_ptr<GenericMessage> SendRequestExpectingResponse(const GenericMessage& message,
                                                                 uint32_t timeoutMs,
                                                                 bool mandatory = false);
    // Registers a one-shot callback for the correlation id, then publishes.
    // The response is routed with the state: by name, to the state callback
    // when the state is not 0, else to the default callback. The callback is
    // dropped when no response came within DefaultTimeoutMs.
    void SendRequestAsync(MessageBase& message, uint32_t state, bool mandatory = false);
    void SendRequestAsync(const GenericMessage& message, uint32_t state, bool mandatory = false);

    // Before a request whose reply must come back: waits up to waitMs until
    // the service's queue and bindings are in place again after a reconnect
    // or a channel reset. True when they are. False at once while the
    // publisher connection is lost, since a send then fails at once anyway.
    bool AwaitReplyRoute(uint32_t waitMs) const;
    // True while the publisher connection is lost.
    bool IsPublisherLost() const;
    // Waits up to waitMs while the publisher connection is lost; true when it
    // is connected. For a service's answers, which are made on bus threads:
    // after a broker restart its consumer can be back before its publisher.
    bool AwaitPublisher(uint32_t waitMs) const;

    // ---- Where responses go ----
    void SetDefaultResponseCallback(std::shared_ptr<Interfaces::IBroadcastCallback> callback);
    // Not owned: must outlive the service or be replaced first.
    void SetStateResponseCallback(Interfaces::IResponseCallback* callback);
    // Not owned. An existing name keeps its entry; the attempt is logged.
    void RegisterResponseCallback(const std::string& messageName,
                                  Interfaces::IResponseCallback* callback);
    void UnregisterResponseCallback(const std::string& messageName);

    // Binds [messageName] on the queue, then registers the handler.
    void RegisterBroadcast(const std::string& messageName,
                           std::shared_ptr<Interfaces::IBroadcastCallback> callback);
    // Removes the handler, then unbinds [messageName].
    void UnregisterBroadcast(const std::string& messageName);

    // Keeps the logger and hands it to the subscriber and its consumers.
    void SetTraceLogger(std::shared_ptr<Interfaces::ITraceLogger> traceLogger);
    // Throws VeldraException (Veldra.Exception) when none was set.
    std::shared_ptr<Interfaces::ITraceLogger> GetTraceLogger() const;

    const std::string& Name() const { return name_; }
    const std::string& InstanceId() const { return instanceId_; }
    // Name + "_" + InstanceId: where responses to this service go.
    const std::string& QueueName() const { return publisher_->ReplyTo(); }
    uint32_t DefaultTimeoutMs() const { return defaultTimeoutMs_; }
    MessagePublisher* Publisher() const { return publisher_.get(); }
    MessageSubscriber* Subscriber() const { return subscriber_.get(); }
    // For the components that subscribe and publish on the service's behalf.
    std::shared_ptr<Interfaces::IRegisterBroadcastCallback> GetRegisterCallback() const {
        return registerCallback_;
    }
    std::shared_ptr<Interfaces::IPublishCallback> GetPublishCallback() const {
        return publisher_->GetPublishCallback();
    }

private:
    // The three steps on headers and body, shared by the typed and raw forms.
    void PublishHeaders(MessageHeaders& headers, const MessageBody& body, bool mandatory);
    std::shared_ptr<GenericMessage> Request(MessageHeaders& headers, const MessageBody& body,
                                            uint32_t timeoutMs, bool mandatory);
    void RequestAsync(MessageHeaders& headers, const MessageBody& body, uint32_t state,
                      bool mandatory);
    // What is left of timeoutMs since `started`, at least 0.
    static uint32_t RemainingMs(std::chrono::steady_clock::time_point started, uint32_t timeoutMs);
    std::shared_ptr<GenericMessage> WaitForResponse(const std::string& correlationId,
                                                    ResponseWaiter& waiter, uint32_t timeoutMs,
                                                    const std::string& routingKey);
    template <typename Incoming>
    void Answer(const Incoming& request, const std::optional<MessageError>& error);
    void RouteResponse(const std::shared_ptr<GenericMessage>& message, uint32_t state);
    // True when a response of the name goes to a registered callback that
    // may run on the connection's reader.
    bool RoutesOnReader(const std::string& messageType) const;
    void LogError(const std::string& text) const;
    std::shared_ptr<Interfaces::ITraceLogger> Logger() const;

    // ---- State ----
    std::shared_ptr<Interfaces::IRegisterBroadcastCallback> registerCallback_;
    std::shared_ptr<Interfaces::IBroadcastCallback> defaultResponseCallback_;
    Interfaces::IResponseCallback* stateResponseCallback_ = nullptr;
    std::string name_;
    std::string instanceId_;
    uint32_t defaultTimeoutMs_;
    std::unique_ptr<MessagePublisher> publisher_;
    std::unique_ptr<MessageSubscriber> subscriber_;
    std::shared_ptr<Interfaces::ITraceLogger> traceLogger_;
    std::shared_ptr<ThreadSafeMap<std::string, Interfaces::IResponseCallback*>> responseCallbacks_;

    // The router every correlation callback and the default callback share.
    std::shared_ptr<MessageServiceResponseCallback> responseRouter_;
    AmqpConnectionManager* connectionManager_;
    // Guards the two response callbacks and the logger, which callers may
    // set while bus threads read them.
    mutable std::mutex callbackMutex_;
};

}  // namespace Korvane::Veldra::MessageBus
