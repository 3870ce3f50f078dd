#include <gtest/gtest.h>

#include <future>
#include <memory>
#include <string>
#include <thread>

#include "ServiceTestSupport.h"
#include "errors/AmqpException.h"
#include "errors/ErrorTable.h"
#include "support/CatchVeldra.h"
#include "messagebus/interfaces/FunctionBroadcastCallback.h"
#include "messagelibrary/GenericResponse.h"

namespace Korvane::Veldra::Testing {
namespace {

constexpr milliseconds kArrival(20000);
constexpr uint32_t kAnswerMs = 20000;

using ServiceRequest = ServiceFixture;

TEST_F(ServiceRequest, SynchronousRequestIsAnsweredUnlessItAsksForNoResponse) {
    struct Case {
        const char* what;
        bool routed, expecting, fail, answered;
    };
    const Case cases[] = {
        {"request", false, false, false, true},
        {"failing request", false, false, true, true},
        {"routed, expecting a response", true, true, false, true},
        {"routed", true, false, false, false},
    };
    responder->Open();
    for (const Case& c : cases) {
        SCOPED_TRACE(c.what);
        TestRouted routed("EchoRouted", server.QueueName());
        TestRequest request("EchoRequest", server.QueueName());
        MessageBus::MessageBase& message =
            c.routed ? static_cast<MessageBus::MessageBase&>(routed) : request;
        if (c.fail) message.SetHeader("Fail", "yes");

        const MessagePtr response = c.expecting
                                        ? client.SendRequestExpectingResponse(message, kAnswerMs)
                                        : client.SendRequest(message, c.answered ? kAnswerMs : 300);

        const auto received = responder->received.WaitFor(message.CorrelationId(), kArrival);
        ASSERT_TRUE(received.has_value());
        EXPECT_EQ(received->first->ReplyTo(), client.QueueName());
        EXPECT_EQ(received->first->Origin(), client.Name());
        EXPECT_EQ(client.Subscriber()->SynchCallbacks()->Size(), 0u);
        if (!c.answered) {
            EXPECT_EQ(response, nullptr);
            EXPECT_TRUE(clientLog->WaitFor(
                "ERROR Service did not respond | " + message.RoutingKey(), kArrival));
            continue;
        }
        ASSERT_NE(response, nullptr);
        EXPECT_EQ(response->CorrelationId(), message.CorrelationId());
        const MessageBus::GenericResponse decoded(response->Headers(), response->Body());
        EXPECT_EQ(decoded.RequestName(), message.MessageType());
        EXPECT_EQ(response->GetError().info, c.fail ? "failed on request" : "");
    }
}

TEST_F(ServiceRequest, LateReplyGoesOnAsAnOrdinaryMessage) {
    TestRequest request("EchoRequest", server.QueueName());
    EXPECT_EQ(client.SendRequest(request, 300), nullptr);
    EXPECT_TRUE(
        clientLog->WaitFor("ERROR Service did not respond | " + request.RoutingKey(), kArrival));
    responder->Open();
    EXPECT_TRUE(unclaimed->WaitFor(request.CorrelationId(), kArrival));
}

TEST_F(ServiceRequest, SecondRequestWithTheSameCorrelationIdWaitsInVainAndEndsTheFirstWait) {
    TestRequest first("EchoRequest", server.QueueName());
    auto firstResult =
        std::async(std::launch::async, [&] { return client.SendRequest(first, 3000); });
    // Once the server holds the first request, its waiter is registered.
    const std::string id = first.CorrelationId();
    ASSERT_TRUE(responder->received.WaitFor(id, kArrival));

    TestRequest second("EchoRequest", server.QueueName());
    second.SetCorrelationId(id);
    second.SetHeader("Fail", "yes");  // tells the two answers apart
    EXPECT_EQ(client.SendRequest(second, 300), nullptr);
    // The second's clean-up took the first's entry with it.
    EXPECT_EQ(client.Subscriber()->SynchCallbacks()->Size(), 0u);

    responder->Open();
    EXPECT_EQ(firstResult.get(), nullptr);
    // Both answers went on as ordinary messages.
    for (const bool failed : {false, true}) {
        EXPECT_TRUE(unclaimed->messages.WaitFor(
            [&](const auto& e) {
                return e.first->CorrelationId() == id && e.first->HasError() == failed;
            },
            kArrival));
    }
}

// A handler that asks another service and waits for the answer: the answer
// must not queue behind the handler on its own handling thread.
TEST_F(ServiceRequest, RequestFromInsideAHandlerIsAnswered) {
    std::promise<MessagePtr> answer;
    const auto asker = std::make_shared<MessageBus::Interfaces::FunctionBroadcastCallback>(
        [&](const GenericMessage&) {
            TestRequest inner("EchoRequest", server.QueueName());
            answer.set_value(client.SendRequest(inner, 5000));
        });
    client.Subscriber()->RegisterMessageCallback("Ask", asker, false);
    responder->Open();
    TestRequest ask("Ask", client.QueueName());
    server.Publish(ask);
    auto result = answer.get_future();
    ASSERT_EQ(result.wait_for(kArrival), std::future_status::ready);
    EXPECT_NE(result.get(), nullptr);
}

// A response callback that only completes a request is run by the
// connection's reader, even while the handling thread is busy; any other
// callback still runs on the handling thread.
TEST_F(ServiceRequest, OnlyCallbacksThatCompleteARequestRunOnTheReader) {
    struct Recorder : InboxCallback {
        explicit Recorder(bool onReader) : onReader(onReader) {}
        bool RunsOnReader(const std::string&) const override { return onReader; }
        void OnResponse(MessagePtr message, uint32_t state) override {
            thread = std::this_thread::get_id();
            InboxCallback::OnResponse(std::move(message), state);
        }
        const bool onReader;
        std::thread::id thread;
    };
    std::promise<std::thread::id> handling;
    std::promise<void> release;
    const auto released = release.get_future().share();
    const auto hold = std::make_shared<MessageBus::Interfaces::FunctionBroadcastCallback>(
        [&](const GenericMessage&) {
            handling.set_value(std::this_thread::get_id());
            released.wait_for(kArrival);
        });
    client.Subscriber()->RegisterMessageCallback("Hold", hold, false);
    responder->Open();
    TestRequest holdIt("Hold", client.QueueName());
    server.Publish(holdIt);
    auto handlingThread = handling.get_future();
    ASSERT_EQ(handlingThread.wait_for(kArrival), std::future_status::ready);

    Recorder completing(true), plain(false);
    client.RegisterResponseCallback("GenericResponse", &completing);
    TestRequest first("EchoRequest", server.QueueName());
    client.SendRequestAsync(first, 7);
    const bool firstCame = completing.WaitFor(first.CorrelationId(), kArrival).has_value();
    client.UnregisterResponseCallback("GenericResponse");
    client.RegisterResponseCallback("GenericResponse", &plain);
    TestRequest second("EchoRequest", server.QueueName());
    client.SendRequestAsync(second, 8);
    release.set_value();
    const bool secondCame = plain.WaitFor(second.CorrelationId(), kArrival).has_value();
    client.UnregisterResponseCallback("GenericResponse");

    const std::thread::id handler = handlingThread.get();
    ASSERT_TRUE(firstCame);
    EXPECT_NE(completing.thread, handler);
    ASSERT_TRUE(secondCame);
    EXPECT_EQ(plain.thread, handler);
}

TEST_F(ServiceRequest, MandatoryRequestToAMissingServiceFailsWithTheReturnNotice) {
    TestRequest request("EchoRequest", UniqueQueueName("svc_missing"));
    const auto error =
        MessageBus::Testing::CatchVeldra([&] { client.SendRequest(request, kAnswerMs, true); });
    ASSERT_TRUE(error.has_value());
    EXPECT_EQ(error->Code(), MessageBus::FindErrorRow("Veldra.AMQPErrorDequeueingMessage")->code);
    EXPECT_EQ(std::string(error->what()),
              "Publish failed:  The message with mandatory routing could not be delivered. "
              "Message type: EchoRequest, correlation id: " +
                  request.CorrelationId());
    EXPECT_EQ(client.Subscriber()->SynchCallbacks()->Size(), 0u);
}

TEST_F(ServiceRequest, ServiceReportsWhatItCannotDo) {
    EXPECT_THROWS_VELDRA(server.GetTraceLogger(), -251004,
                         "InvalidOperationException: No TraceLogger Set");
    InboxCallback named;
    client.RegisterResponseCallback("SomeResponse", &named);
    client.RegisterResponseCallback("SomeResponse", &named);
    client.UnregisterResponseCallback("Missing");
    // A response with no correlation callback, no name callback and no default.
    responder->Open();
    client.SetDefaultResponseCallback(nullptr);
    TestRequest request("EchoRequest", server.QueueName());
    client.Publish(request);
    for (const char* line : {"ERROR Failed to add register message name callback | SomeResponse",
                             "ERROR Failed to remove register message name callback | Missing",
                             "ERROR No callback registered for response | GenericResponse"}) {
        EXPECT_TRUE(clientLog->WaitFor(line, kArrival)) << line;
    }

    // A failed routed message that wants no response is only logged.
    const auto serverLog = std::make_shared<MessageBus::Testing::RecordingTraceLogger>();
    server.SetTraceLogger(serverLog);
    TestRouted routed("EchoRouted", server.QueueName());
    routed.SetHeader("Fail", "yes");
    client.SendRouted(routed, true);
    EXPECT_TRUE(
        serverLog->WaitFor("ERROR Routed Message had error but response was ignored | "
                           "EchoRouted from " +
                               client.Name() + " | Error: Veldra.Exception: failed on request",
                           kArrival));
}

}  // namespace
}  // namespace Korvane::Veldra::Testing
