#include "TagServiceEndpoint.h"

#include <iostream>
#include <utility>

#include "ServiceLog.h"
#include "messagebus/interfaces/FunctionBroadcastCallback.h"
#include "messagebus/service/MessageServiceSettings.h"
#include "messagebus/service/MessageSubscriberBuilder.h"
#include "messagebus/service/ServiceQueueName.h"
#include "messagelibrary/GenericResponse.h"
#include "messagelibrary/TagServices.h"
#include "messagelibrary/tagcurrentvalue/TagCvQueryCurrentValuesByPathResponse.h"
#include "messagelibrary/taginfo/TagInfoCreateOrUpdateTagsResponse.h"
#include "messagelibrary/taginfo/TagInfoQueryTagsResponse.h"

namespace Korvane::Veldra::TagService {

namespace {

using MessageBus::MessageError;

constexpr const char* kServiceName = "TagService";

// The subscriber of a durable queue: bound to its own name as an ordinary
// service queue is, kept by the broker across restarts of the node, so that
// requests sent while the service reconnects wait for it.
MessageBus::MessageSubscriberBuilder DurableBuilder(const std::string& durableQueue,
                                                    const std::string& queueType) {
    MessageBus::MessageSubscriberBuilder builder(
        MessageBus::ServiceQueueName(kServiceName, durableQueue));
    builder.BindAll = true;
    builder.AutoStart = false;
    builder.Durable = true;
    // "classic" is what the broker declares without the argument.
    if (queueType != "classic") builder.QueueType = queueType;
    return builder;
}

MessageBus::MessageServiceSettings SettingsOn(MessageBus::AmqpConnectionManager& manager,
                                              const std::string& durableQueue,
                                              const MessageBus::MessageSubscriberBuilder& durable) {
    MessageBus::MessageServiceSettings settings;
    settings.Name = kServiceName;
    settings.ConnectionManager = &manager;
    // Consuming starts once every handler is registered and bound.
    settings.AutoStart = false;
    if (!durableQueue.empty()) {
        settings.InstanceId = durableQueue;
        settings.SubscriberBuilder = &durable;
    }
    return settings;
}

}  // namespace

TagServiceEndpoint::TagServiceEndpoint(MessageBus::AmqpConnectionManager& manager,
                                       TagServiceLogic& logic, bool verbose,
                                       bool startConsuming, const std::string& durableQueue,
                                       const std::string& queueType)
    : logic_(logic),
      verbose_(verbose),
      service_(SettingsOn(manager, durableQueue, DurableBuilder(durableQueue, queueType))) {
    service_.SetTraceLogger(std::make_shared<ConsoleTraceLogger>());
    service_.SetDefaultResponseCallback(std::make_shared<MessageBus::Interfaces::FunctionBroadcastCallback>(
        [this](const Received& received) { Unhandled(received); }));
    RegisterHandlers();
    for (const std::string& target : {VeldraMessageLibrary::kTagInfoService,
                                      VeldraMessageLibrary::kTagCurrentValueService,
                                      VeldraMessageLibrary::kTagIngestionService}) {
        service_.Subscriber()->Bind({target, "#"});
    }
    if (startConsuming) service_.Subscriber()->StartConsuming();
}

TagServiceEndpoint::~TagServiceEndpoint() {
    try {
        service_.Subscriber()->StopConsuming();
    } catch (const std::exception& error) {
        WriteLogLine(std::cerr, std::string("stopping the consumers failed: ") + error.what());
    }
}

void TagServiceEndpoint::RegisterHandlers() {
    OnRouted<TagInfo::TagInfoCreateTagRoutedMessage>(
        [this](const auto& message) { return logic_.CreateTag(message); });
    OnRouted<TagInfo::TagInfoUpdateTagRoutedMessage>(
        [this](const auto& message) { return logic_.UpdateTag(message); });
    OnRouted<TagInfo::TagInfoDeleteTagsRoutedMessage>(
        [this](const auto& message) { return logic_.DeleteTags(message); });
    OnRouted<TagIngest::TagUpdateValuesRoutedMessage>(
        [this](const auto& message) { return logic_.UpdateValues(message); });
    OnRouted<TagCv::TagCvResetAggregatesRoutedMessage>(
        [this](const auto& message) { return logic_.ResetAggregates(message); });

    OnRequest<TagInfo::TagInfoQueryTagsRequest, TagInfo::TagInfoQueryTagsResponse>(
        [this](const Received& received, const auto& request, Broadcasts&) {
            TagPage page = logic_.QueryTags(request);
            return std::make_unique<TagInfo::TagInfoQueryTagsResponse>(
                received, std::move(page.tags), page.totalCount);
        });
    OnRequest<TagInfo::TagInfoCreateOrUpdateTagsRequest,
              TagInfo::TagInfoCreateOrUpdateTagsResponse>(
        [this](const Received& received, const auto& request, Broadcasts& broadcasts) {
            ChangeOutcome outcome = logic_.CreateOrUpdateTags(request);
            broadcasts = std::move(outcome.broadcasts);
            return std::make_unique<TagInfo::TagInfoCreateOrUpdateTagsResponse>(
                received, std::move(outcome.errors));
        });
    OnRequest<TagCv::TagCvQueryCurrentValuesByPathRequest,
              TagCv::TagCvQueryCurrentValuesByPathResponse>(
        [this](const Received& received, const auto& request, Broadcasts&) {
            return std::make_unique<TagCv::TagCvQueryCurrentValuesByPathResponse>(
                received, logic_.QueryCurrentValues(request));
        });
}

void TagServiceEndpoint::On(const std::string& messageName,
                            std::function<void(const Received&)> handle) {
    service_.Subscriber()->RegisterMessageCallback(
        messageName, std::make_shared<MessageBus::Interfaces::FunctionBroadcastCallback>(std::move(handle)), false);
}

template <typename Message>
std::optional<Message> TagServiceEndpoint::Parse(const Received& received,
                                                 std::optional<MessageError>& error) {
    std::optional<Message> message;
    try {
        message.emplace(received.Headers(), received.Body());
    } catch (const std::exception& failure) {
        error = Failure(received, failure, true);
    }
    return message;
}

template <typename Message>
void TagServiceEndpoint::OnRouted(std::function<Outcome(const Message&)> handle) {
    On(Message::kMessageName, [this, handle](const Received& received) {
        std::optional<MessageError> error;
        Broadcasts broadcasts;
        if (const auto message = Parse<Message>(received, error)) {
            try {
                std::lock_guard<std::mutex> lock(logicMutex_);
                Outcome outcome = handle(*message);
                error = std::move(outcome.error);
                broadcasts = std::move(outcome.broadcasts);
            } catch (const std::exception& failure) {
                error = Failure(received, failure, false);
            }
        }
        Answer(received, error);
        SendBroadcasts(broadcasts);
        Report(received, error);
    });
}

template <typename Message, typename Response>
void TagServiceEndpoint::OnRequest(
    std::function<std::unique_ptr<Response>(const Received&, const Message&, Broadcasts&)>
        answer) {
    On(Message::kMessageName, [this, answer](const Received& received) {
        std::optional<MessageError> error;
        Broadcasts broadcasts;
        std::unique_ptr<Response> response;
        if (const auto message = Parse<Message>(received, error)) {
            try {
                std::lock_guard<std::mutex> lock(logicMutex_);
                response = answer(received, *message, broadcasts);
            } catch (const std::exception& failure) {
                error = Failure(received, failure, false);
            }
        }
        if (!response) {
            response = std::make_unique<Response>(
                received, error.value_or(ServiceError("Veldra.InternalServiceError")));
        }
        Publish(*response);
        SendBroadcasts(broadcasts);
        Report(received, error);
    });
}

void TagServiceEndpoint::Unhandled(const Received& received) {
    const std::string& type = received.MessageType();
    const auto endsWith = [&](const std::string& suffix) {
        return type.size() >= suffix.size() &&
               type.compare(type.size() - suffix.size(), suffix.size(), suffix) == 0;
    };
    WriteLogLine(std::cerr, "no handler for " + type + " from " + received.Origin());
    // Requests and routed messages get an answer, so that their senders need
    // not wait for a time-out; anything else could answer an answer.
    if (!endsWith("Request") && !endsWith("RoutedMessage")) return;
    const std::optional<MessageError> error = ServiceError("Veldra.NotSupported");
    if (endsWith("Request")) {
        MessageBus::GenericResponse response(received, error);
        Publish(response);
    } else {
        Answer(received, error);
    }
    Report(received, error);
}

void TagServiceEndpoint::Publish(MessageBus::MessageBase& message) {
    try {
        // An answer to a request handled right after a broker restart waits
        // for the publisher to be back, rather than being lost.
        service_.AwaitPublisher(service_.DefaultTimeoutMs());
        service_.Publish(message);
    } catch (const std::exception& error) {
        WriteLogLine(std::cerr, "cannot publish " + message.MessageType() + ": " + error.what());
    }
}

void TagServiceEndpoint::Answer(const Received& received,
                                const std::optional<MessageError>& error) {
    try {
        service_.SendResponse(received, error);
    } catch (const std::exception& failure) {
        WriteLogLine(std::cerr, "cannot answer " + received.MessageType() + ": " + failure.what());
    }
}

void TagServiceEndpoint::SendBroadcasts(const Broadcasts& broadcasts) {
    for (const auto& broadcast : broadcasts) Publish(*broadcast);
}

void TagServiceEndpoint::Report(const Received& received,
                                const std::optional<MessageError>& error) {
    if (!verbose_) return;
    WriteLogLine(std::cout, received.MessageType() + " from " + received.Origin() + ": " +
                                (error ? error->FullName() : std::string("ok")));
}

MessageError TagServiceEndpoint::Failure(const Received& received, const std::exception& error,
                                         bool parsing) {
    WriteLogLine(std::cerr, std::string(parsing ? "cannot parse " : "failed on ") +
                                received.MessageType() + " from " + received.Origin() + ": " +
                                error.what());
    return ServiceError(parsing ? "Veldra.FailedToParse" : "Veldra.InternalServiceError");
}

}  // namespace Korvane::Veldra::TagService
