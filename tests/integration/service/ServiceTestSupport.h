#pragma once

#include <chrono>
#include <future>
#include <memory>
#include <mutex>
#include <optional>
#include <string>
#include <utility>

#include "messagebus/BusTestSupport.h"
#include "messagebus/service/MessageService.h"
#include "messagebus/service/RecordingTraceLogger.h"
#include "messagelibrary/BroadcastMessage.h"
#include "messagelibrary/RequestMessage.h"
#include "messagelibrary/RoutedMessage.h"

namespace Korvane::Veldra::Testing {

using MessageBus::GenericMessage;
using MessageBus::MessageService;
using MessagePtr = std::shared_ptr<GenericMessage>;

// A message of one of the four kinds with an empty JSON body.
template <typename Kind>
class TestMessage : public Kind {
public:
    TestMessage(const std::string& type, const std::string& target)
        : Kind(type, "application/json", target) {}
    MessageBus::MessageBody Serialize() const override {
        return MessageBus::MessageBody(std::string("{}"));
    }
};
using TestRequest = TestMessage<MessageBus::RequestMessage>;
using TestRouted = TestMessage<MessageBus::RoutedMessage>;
using TestBroadcast = TestMessage<MessageBus::BroadcastMessage>;

// Keeps every message it is handed, with its state (0 for a broadcast).
class InboxCallback : public MessageBus::Interfaces::IBroadcastCallback,
                      public MessageBus::Interfaces::IResponseCallback {
public:
    using Entry = std::pair<MessagePtr, uint32_t>;
    void OnMessage(MessagePtr message) override { OnResponse(std::move(message), 0); }
    void OnResponse(MessagePtr message, uint32_t state) override {
        messages.Add({std::move(message), state});
    }
    // The first message with the correlation id, once it is there.
    std::optional<Entry> WaitFor(const std::string& correlationId, milliseconds timeout) {
        return messages.WaitFor(
            [&](const Entry& e) { return e.first->CorrelationId() == correlationId; }, timeout);
    }
    Inbox<Entry> messages;
};

// A minimal service answering with SendResponse: with the error
// "Veldra.Exception" when the message has the header "Fail". While closed it
// holds every answer until Open (for at most a minute).
class Responder : public MessageBus::Interfaces::IBroadcastCallback {
public:
    // Answers "EchoRequest" and "EchoRouted" on the service's queue.
    static std::shared_ptr<Responder> On(MessageService& service) {
        auto responder = std::shared_ptr<Responder>(new Responder(service));
        for (const char* name : {"EchoRequest", "EchoRouted"}) {
            service.Subscriber()->RegisterMessageCallback(name, responder, false);
        }
        return responder;
    }
    void OnMessage(MessagePtr message) override {
        received.OnMessage(message);
        gate_.wait_for(std::chrono::minutes(1));
        std::optional<MessageBus::MessageError> error;
        if (message->GetHeader("Fail") != nullptr) {
            error = MessageBus::MessageError::Named("Veldra.Exception", {}, "failed on request");
        }
        service_.SendResponse(*message, error);
    }
    void Open() {
        std::call_once(opened_, [this] { opener_.set_value(); });
    }

    InboxCallback received;

private:
    explicit Responder(MessageService& service) : service_(service) {}

    MessageService& service_;
    std::once_flag opened_;
    std::promise<void> opener_;
    std::shared_future<void> gate_ = opener_.get_future().share();
};

// Settings of a service named after the stem on the test manager.
inline MessageBus::MessageServiceSettings ServiceSettings(
    MessageBus::AmqpConnectionManager& manager, const std::string& stem) {
    MessageBus::MessageServiceSettings settings;
    settings.Name = UniqueQueueName(stem);
    settings.ConnectionManager = &manager;
    return settings;
}

// A client and a server service with a responder, which starts closed;
// TearDown opens it, so that no handler is left waiting.
class ServiceFixture : public ::testing::Test {
protected:
    void SetUp() override {
        client.SetTraceLogger(clientLog);
        client.SetDefaultResponseCallback(unclaimed);
    }
    void TearDown() override { responder->Open(); }

    std::unique_ptr<MessageBus::AmqpConnectionManager> manager = MakeTestManager(30000);
    std::shared_ptr<MessageBus::Testing::RecordingTraceLogger> clientLog =
        std::make_shared<MessageBus::Testing::RecordingTraceLogger>();
    MessageService client{ServiceSettings(*manager, "svc_client")};
    MessageService server{ServiceSettings(*manager, "svc_server")};
    std::shared_ptr<Responder> responder = Responder::On(server);
    std::shared_ptr<InboxCallback> unclaimed = std::make_shared<InboxCallback>();
};

}  // namespace Korvane::Veldra::Testing
