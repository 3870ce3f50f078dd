#pragma once

#include <algorithm>

#include <gtest/gtest.h>

#include <chrono>
#include <condition_variable>
#include <memory>
#include <mutex>
#include <optional>
#include <string>
#include <vector>

#include "messagebus/amqp/AmqpConnectionManager.h"
#include "messagebus/amqp/AmqpConsumer.h"

namespace Korvane::Veldra::Testing {

using MessageBus::GenericMessage;
using MessageBus::ResetEvent;
using std::chrono::milliseconds;

// What a bus thread hands over, for a test thread to wait on.
template <typename T>
class Inbox {
public:
    void Add(T item) {
        {
            std::lock_guard<std::mutex> lock(mutex_);
            items_.push_back(std::move(item));
        }
        changed_.notify_all();
    }
    // How many items match, now.
    template <typename Match>
    std::size_t CountOf(Match match) {
        std::lock_guard<std::mutex> lock(mutex_);
        return static_cast<std::size_t>(std::count_if(items_.begin(), items_.end(), match));
    }
    // True once `count` items match, within the timeout.
    template <typename Match>
    bool WaitForCount(Match match, std::size_t count, milliseconds timeout) {
        std::unique_lock<std::mutex> lock(mutex_);
        return changed_.wait_for(lock, timeout, [&] {
            return static_cast<std::size_t>(std::count_if(items_.begin(), items_.end(), match)) >=
                   count;
        });
    }
    // The first item that matches, if one comes within the timeout.
    template <typename Match>
    std::optional<T> WaitFor(Match match, milliseconds timeout) {
        std::optional<T> found;
        std::unique_lock<std::mutex> lock(mutex_);
        changed_.wait_for(lock, timeout, [&] {
            for (const T& item : items_) {
                if (match(item)) found = item;
                if (found) return true;
            }
            return false;
        });
        return found;
    }

private:
    std::mutex mutex_;
    std::condition_variable changed_;
    std::vector<T> items_;
};

// Keeps what a consumer hands over. A message with the correlation id given
// to ThrowFor is kept, then the callback throws.
class RecordingCallback : public MessageBus::Interfaces::IMessageSubscriberReceiveCallback {
public:
    void MessageReceived(std::shared_ptr<GenericMessage> message) override;
    void PublishFailed(const ResetEvent& event) override { returns.Add(event); }
    void ThrowFor(const std::string& correlationId);
    // The message with the correlation id, or null after the timeout.
    std::shared_ptr<GenericMessage> WaitForMessage(const std::string& correlationId,
                                                   milliseconds timeout);

    Inbox<std::shared_ptr<GenericMessage>> messages;
    Inbox<ResetEvent> returns;

private:
    std::mutex mutex_;
    std::string throwFor_;
};

// A manager for the private broker, on a test exchange.
std::unique_ptr<MessageBus::AmqpConnectionManager> MakeTestManager(int32_t connectTimeoutMs);
// A queue name no other test run uses.
std::string UniqueQueueName(const std::string& stem);
// Headers of a JSON message of the type to "Veldra.<queue>.<type>".
MessageBus::MessageHeaders HeadersTo(const std::string& queue, const std::string& type,
                                     const std::string& correlationId);

// A consumer on the queue, bound with [queue, "#"] and consuming until Stop.
struct TestConsumer {
    TestConsumer(MessageBus::AmqpConnectionManager& manager, const std::string& queue);
    ~TestConsumer() { Stop(); }
    void Stop();

    std::shared_ptr<RecordingCallback> callback = std::make_shared<RecordingCallback>();
    std::unique_ptr<MessageBus::AmqpConsumer> consumer;
    bool consuming = false;
};

// Publishes probes to the consumer's queue until one arrives or the time is
// up. A probe that cannot be published (the publisher is reconnecting) is
// followed by the next.
::testing::AssertionResult ProbeArrives(MessageBus::AmqpConnectionManager& manager,
                                        const std::shared_ptr<MessageBus::AmqpChannel>& channel,
                                        TestConsumer& consumer, const std::string& queue,
                                        milliseconds within);

// The threads of this process listed in /proc/self/task, once the listing
// shows the expected count or the time is up.
int AwaitThreadCount(int expected, milliseconds timeout);

}  // namespace Korvane::Veldra::Testing
