#include "BusTestSupport.h"

#include <dirent.h>
#include <unistd.h>

#include <atomic>
#include <stdexcept>
#include <thread>

#include "messagebus/config/VeldraConfiguration.h"
#include "support/BrokerEnvironment.h"

namespace Korvane::Veldra::Testing {

void RecordingCallback::MessageReceived(std::shared_ptr<GenericMessage> message) {
    bool fail = false;
    {
        std::lock_guard<std::mutex> lock(mutex_);
        fail = !throwFor_.empty() && message->CorrelationId() == throwFor_;
    }
    messages.Add(std::move(message));
    if (fail) throw std::runtime_error("handler failed on purpose");
}

void RecordingCallback::ThrowFor(const std::string& correlationId) {
    std::lock_guard<std::mutex> lock(mutex_);
    throwFor_ = correlationId;
}

std::shared_ptr<GenericMessage> RecordingCallback::WaitForMessage(const std::string& correlationId,
                                                                  milliseconds timeout) {
    const auto match = [&](const auto& message) {
        return message->CorrelationId() == correlationId;
    };
    return messages.WaitFor(match, timeout).value_or(nullptr);
}

std::unique_ptr<MessageBus::AmqpConnectionManager> MakeTestManager(int32_t connectTimeoutMs) {
    MessageBus::VeldraConfiguration configuration;
    configuration.Host = Broker().Host;
    configuration.Port = Broker().AmqpPort;
    configuration.User = Broker().User;
    configuration.Password = Broker().Password;
    configuration.ExchangeName = "kvveldra.amqpio.test";
    auto manager = std::make_unique<MessageBus::AmqpConnectionManager>(configuration);
    manager->SetConnectTimeout(connectTimeoutMs);
    return manager;
}

std::string UniqueQueueName(const std::string& stem) {
    static std::atomic<int> next{0};
    return stem + "_" + std::to_string(getpid()) + "_" + std::to_string(next++);
}

MessageBus::MessageHeaders HeadersTo(const std::string& queue, const std::string& type,
                                     const std::string& correlationId) {
    MessageBus::MessageHeaders headers;
    headers.messageType = type;
    headers.contentType = "application/json";
    headers.correlationId = correlationId;
    headers.routingKey = "Veldra." + queue + "." + type;
    return headers;
}

TestConsumer::TestConsumer(MessageBus::AmqpConnectionManager& manager, const std::string& queue) {
    MessageBus::AmqpConsumerBuilder builder;
    builder.QueueName = queue;
    builder.ReceiveCallback = callback;
    builder.ConnectionManager = &manager;
    consumer = std::make_unique<MessageBus::AmqpConsumer>(builder);
    consumer->Bind({queue, "#"});
    consumer->StartConsuming();
    consuming = true;
}

void TestConsumer::Stop() {
    if (consuming) consumer->StopConsuming();
    consuming = false;
}

::testing::AssertionResult ProbeArrives(MessageBus::AmqpConnectionManager& manager,
                                        const std::shared_ptr<MessageBus::AmqpChannel>& channel,
                                        TestConsumer& consumer, const std::string& queue,
                                        milliseconds within) {
    static std::atomic<int> next{0};
    const auto deadline = std::chrono::steady_clock::now() + within;
    std::string failure = "none";
    while (std::chrono::steady_clock::now() < deadline) {
        const std::string id = "probe-" + std::to_string(next++);
        try {
            manager.Publish(channel, HeadersTo(queue, "Probe", id), MessageBus::MessageBody(),
                            false);
        } catch (const std::exception& error) {
            failure = error.what();
        }
        if (consumer.callback->WaitForMessage(id, milliseconds(250))) {
            return ::testing::AssertionSuccess();
        }
    }
    return ::testing::AssertionFailure() << "no probe arrived within " << within.count()
                                         << " ms; last publish failure: " << failure;
}

int AwaitThreadCount(int expected, milliseconds timeout) {
    const auto count = [] {
        int threads = 0;
        if (DIR* tasks = opendir("/proc/self/task")) {
            while (const dirent* entry = readdir(tasks)) threads += entry->d_name[0] != '.';
            closedir(tasks);
        }
        return threads;
    };
    // A joined thread can stay listed for a moment while the kernel ends it;
    // there is nothing to wait on but the listing.
    const auto deadline = std::chrono::steady_clock::now() + timeout;
    int threads = count();
    while (threads != expected && std::chrono::steady_clock::now() < deadline) {
        std::this_thread::sleep_for(milliseconds(5));
        threads = count();
    }
    return threads;
}

}  // namespace Korvane::Veldra::Testing
