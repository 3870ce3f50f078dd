#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <map>
#include <mutex>
#include <set>
#include <stdexcept>
#include <string>
#include <vector>

#include "messagebus/amqp/AmqpConnectionManager.h"
#include "messagebus/service/MessageSubscriber.h"
#include "messagebus/service/MessageSubscriberReceiveCallback.h"
#include "messagebus/service/RecordingTraceLogger.h"

// The subscriber is built with no consumers, so no broker is needed: the
// tests hand it messages through its receive callback as a consumer would.
namespace Korvane::Veldra::MessageBus::Testing {
namespace {

using ::testing::ElementsAre;

// Writes "<label>:<correlation id>[:<state>]" for each message it gets;
// throws for the correlation id "boom".
class Recorder : public Interfaces::IResponseCallback, public Interfaces::IBroadcastCallback {
public:
    explicit Recorder(std::string label) : label_(std::move(label)) {}
    void OnResponse(std::shared_ptr<GenericMessage> m, uint32_t state) override {
        Add(m->CorrelationId() + ":" + std::to_string(state));
    }
    void OnMessage(std::shared_ptr<GenericMessage> m) override {
        if (m->CorrelationId() == "boom") throw std::runtime_error("handler failed");
        Add(m->CorrelationId());
    }
    std::vector<std::string> Seen() {
        std::lock_guard<std::mutex> lock(mutex_);
        return seen_;
    }

private:
    void Add(const std::string& what) {
        std::lock_guard<std::mutex> lock(mutex_);
        seen_.push_back(label_ + ":" + what);
    }
    const std::string label_;
    std::mutex mutex_;
    std::vector<std::string> seen_;
};

std::shared_ptr<GenericMessage> Message(const std::string& name, const std::string& correlationId,
                                        const std::map<std::string, std::string>& headers = {}) {
    MessageHeaders h;
    h.messageType = name;
    h.correlationId = correlationId;
    for (const auto& [key, value] : headers) h.SetHeader(key, value);
    return std::make_shared<GenericMessage>(h, MessageBody());
}

class SubscriberTest : public ::testing::Test {
protected:
    MessageSubscriberBuilder Builder() {
        MessageSubscriberBuilder builder("unit_queue");
        builder.ConsumerCount = 0;
        builder.ConnectionManager = &manager;
        return builder;
    }
    std::vector<std::string> ManagerLines() {
        std::vector<std::string> lines;
        for (std::string line; manager.TakeLog(line, 0);) lines.push_back(line);
        return lines;
    }
    static void Deliver(MessageSubscriber& subscriber, std::shared_ptr<GenericMessage> message) {
        MessageSubscriberReceiveCallback(&subscriber).MessageReceived(std::move(message));
    }

    AmqpConnectionManager manager{VeldraConfiguration{}};
    std::shared_ptr<Recorder> recorder = std::make_shared<Recorder>("");
};

// Each row registers some of the four receivers for "Ping" with correlation
// id "c1", then delivers it twice. Only the first in the order waiter,
// correlation callback (once), name callback, default gets each delivery.
TEST_F(SubscriberTest, FirstReceiverInOrderTakesTheMessage) {
    struct Case {
        bool waiter, correlation, name, fallback;
        std::vector<std::string> expected;
    };
    const std::vector<Case> cases = {
        {true, true, true, true, {}},
        {false, true, true, true, {"corr:c1:7", "name:c1"}},
        {false, true, false, false, {"corr:c1:7"}},
        {false, false, true, true, {"name:c1", "name:c1"}},
        {false, false, false, true, {"default:c1", "default:c1"}},
    };
    for (const Case& c : cases) {
        SCOPED_TRACE(::testing::Message() << c.waiter << c.correlation << c.name << c.fallback);
        auto corr = std::make_shared<Recorder>("corr"), name = std::make_shared<Recorder>("name"),
             fallback = std::make_shared<Recorder>("default");
        MessageSubscriberBuilder builder = Builder();
        if (c.fallback) builder.DefaultCallback = fallback;
        MessageSubscriber subscriber(builder);
        const auto waiter = std::make_shared<ResponseWaiter>();
        if (c.waiter) subscriber.SynchCallbacks()->Insert("c1", SynchCallbackInfo{waiter});
        if (c.correlation) subscriber.RegisterCorrelationCallback("c1", corr, 7);
        if (c.name) subscriber.RegisterMessageCallback("Ping", name, false);

        Deliver(subscriber, Message("Ping", "c1"));
        Deliver(subscriber, Message("Ping", "c1"));

        std::vector<std::string> seen = corr->Seen();
        for (const auto& other : {name->Seen(), fallback->Seen()}) {
            seen.insert(seen.end(), other.begin(), other.end());
        }
        EXPECT_EQ(seen, c.expected);
        // The waiter leaves the correlation callback in place, and takes both.
        std::shared_ptr<GenericMessage> waited;
        EXPECT_EQ(waiter->TryTake(waited, 0) && waiter->TryTake(waited, 0), c.waiter);
        EXPECT_EQ(subscriber.CorrIdCallbacks()->Size(), c.waiter ? 1u : 0u);
        // The last row's second delivery found only the unhandled path.
        EXPECT_EQ(ManagerLines(), c.expected.size() == 1
                                      ? std::vector<std::string>{"Unhandled Message: Ping"}
                                      : std::vector<std::string>{});
    }
}

TEST_F(SubscriberTest, UnhandledMessageIsReportedByErrorLoggerAndPoint) {
    struct Case {
        bool hasError, logger, pointEnabled;
        std::vector<std::string> traced, managerLines;
    };
    const std::vector<Case> cases = {
        {false, true, true, {"LOG UnhandledMessage | Ping"}, {}},
        {false, true, false, {}, {"Unhandled Message: Ping"}},
        {false, false, false, {}, {"Unhandled Message: Ping"}},
        {true, true, false, {"ERROR Unhandled messagePingOrigin=svc Error=<error>"}, {}},
        {true, false, false, {}, {"Unhandled Message: Ping"}},
    };
    for (const Case& c : cases) {
        SCOPED_TRACE(::testing::Message() << c.hasError << c.logger << c.pointEnabled);
        auto logger = std::make_shared<RecordingTraceLogger>(
            c.pointEnabled ? std::set<std::string>{"UnhandledMessage"} : std::set<std::string>{});
        MessageSubscriber subscriber(Builder());
        if (c.logger) subscriber.SetTraceLogger(logger);
        std::map<std::string, std::string> headers{{"Origin", "svc"}};
        if (c.hasError) headers.insert({{"ErrorCode", "Veldra.Exception"}, {"ErrorInfo", "boom"}});
        const auto message = Message("Ping", "c1", headers);

        Deliver(subscriber, message);

        // The error's text form comes from the registry, which is not under test.
        std::vector<std::string> traced = c.traced;
        for (std::string& line : traced) {
            const auto at = line.find("<error>");
            if (at != std::string::npos) line.replace(at, 7, message->GetError().Text());
        }
        EXPECT_EQ(logger->Entries(), traced);
        EXPECT_EQ(ManagerLines(), c.managerLines);
    }
}

TEST_F(SubscriberTest, ArrivingMessagePurgesCallbacksOfTheMaximumAge) {
    auto logger = std::make_shared<RecordingTraceLogger>(std::set<std::string>{"UnhandledMessage"});
    MessageSubscriberBuilder builder = Builder();
    builder.CallbackMaxAgeMs = 0;  // every callback is old enough at once
    builder.TraceLogger = logger;
    builder.DefaultCallback = recorder;
    MessageSubscriber subscriber(builder);
    subscriber.RegisterCorrelationCallback("a", recorder, 1);
    subscriber.RegisterCorrelationCallback("b", recorder, 2);

    Deliver(subscriber, Message("Other", "x"));
    EXPECT_EQ(subscriber.CorrIdCallbacks()->Size(), 0u);
    EXPECT_THAT(logger->Entries(),
                ElementsAre("LOG UnhandledMessage | Purged CorrelationIdCallback for a",
                            "LOG UnhandledMessage | Purged CorrelationIdCallback for b"));
    // The response after the purge goes on as an ordinary message.
    Deliver(subscriber, Message("Reply", "a"));
    EXPECT_THAT(recorder->Seen(), ElementsAre(":x", ":a"));
}

TEST_F(SubscriberTest, HandlerThreadsHandleEveryQueuedMessageOnceBeforeTheyEnd) {
    constexpr int kMessages = 2000;
    {
        MessageSubscriberBuilder builder = Builder();
        builder.HandlerThreadCount = 3;
        MessageSubscriber subscriber(builder);
        subscriber.RegisterMessageCallback("Ping", recorder, false);
        Deliver(subscriber, Message("Ping", "boom"));
        for (int i = 0; i < kMessages; ++i) Deliver(subscriber, Message("Ping", std::to_string(i)));
        // The destructor closes the queue: the threads drain it, then end.
    }
    const std::vector<std::string> seen = recorder->Seen();
    EXPECT_EQ(std::set<std::string>(seen.begin(), seen.end()).size(), seen.size());
    EXPECT_EQ(seen.size(), static_cast<size_t>(kMessages));
    EXPECT_THAT(ManagerLines(),
                ElementsAre("Caught exception in message handler thread: handler failed"));
}

}  // namespace
}  // namespace Korvane::Veldra::MessageBus::Testing
