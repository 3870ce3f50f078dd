#pragma once

#include <functional>
#include <memory>
#include <mutex>
#include <optional>
#include <string>

#include "TagServiceLogic.h"
#include "messagebus/amqp/AmqpConnectionManager.h"
#include "messagebus/service/MessageService.h"

namespace Korvane::Veldra::TagService {

// The service on the bus: one queue bound to the routing keys of TagInfo,
// TagCurrentValue and TagIngestion, one handler a message name. Each
// message is parsed, handed to the rules, answered, and its broadcasts sent;
// a body that does not parse is answered with "Veldra.FailedToParse" and
// logged, a message of an unknown name with "Veldra.NotSupported". Messages are handled one at a time, on the bus's handling thread.
class TagServiceEndpoint {
public:
    // Connects, declares and binds the queue and, with startConsuming, starts
    // consuming; throws when the broker cannot be reached. Without it the
    // queue fills until someone starts Subscriber(). With a durable queue
    // name the queue is "TagService_" + that name, durable and kept when the
    // service ends, and of the kind queueType (empty: the broker's default).
    TagServiceEndpoint(MessageBus::AmqpConnectionManager& manager, TagServiceLogic& logic,
                       bool verbose, bool startConsuming = true,
                       const std::string& durableQueue = std::string(),
                       const std::string& queueType = std::string());
    // Stops consuming, then closes the service's channels.
    ~TagServiceEndpoint();
    TagServiceEndpoint(const TagServiceEndpoint&) = delete;
    TagServiceEndpoint& operator=(const TagServiceEndpoint&) = delete;

    const std::string& QueueName() const { return service_.QueueName(); }
    MessageBus::MessageSubscriber* Subscriber() const { return service_.Subscriber(); }

private:
    using Received = MessageBus::GenericMessage;

    void RegisterHandlers();
    void On(const std::string& messageName, std::function<void(const Received&)> handle);
    // A routed message: answered with a GenericResponse unless it carries
    // "IgnoreResponse".
    template <typename Message>
    void OnRouted(std::function<Outcome(const Message&)> handle);
    // A request: answered with its response class, built by answer; on a
    // failure the response carries the error in its headers.
    template <typename Message, typename Response>
    void OnRequest(
        std::function<std::unique_ptr<Response>(const Received&, const Message&, Broadcasts&)>
            answer);
    template <typename Message>
    std::optional<Message> Parse(const Received& received,
                                 std::optional<MessageBus::MessageError>& error);

    // A message of a name without a handler: logged, and a request or a
    // routed message answered with "Veldra.NotSupported".
    void Unhandled(const Received& received);
    void Publish(MessageBus::MessageBase& message);
    void Answer(const Received& received, const std::optional<MessageBus::MessageError>& error);
    void SendBroadcasts(const Broadcasts& broadcasts);
    void Report(const Received& received, const std::optional<MessageBus::MessageError>& error);
    MessageBus::MessageError Failure(const Received& received, const std::exception& error,
                                     bool parsing);

    TagServiceLogic& logic_;
    std::mutex logicMutex_;  // the rules and their store are not thread-safe
    const bool verbose_;
    MessageBus::MessageService service_;
};

}  // namespace Korvane::Veldra::TagService
