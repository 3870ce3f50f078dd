#pragma once

#include <chrono>
#include <condition_variable>
#include <cstddef>
#include <map>
#include <memory>
#include <mutex>
#include <string>
#include <vector>

#include "errors/AmqpException.h"
#include "messagebus/interfaces/IPublishCallback.h"
#include "messagebus/interfaces/IRegisterBroadcastCallback.h"
#include "messagelibrary/tracelogger/TraceLoggerRegisterTracePointRoutedMessage.h"
#include "messagelibrary/tracelogger/TraceLoggerStoreEntriesRoutedMessage.h"

namespace Korvane::Veldra::VeldraUtilities::TraceLogging::Testing {

namespace Messages = VeldraMessageLibrary::TraceLoggerMessages;

// Stands in for a message service: keeps what is published, in order, and
// the broadcast handlers that are registered. Can be told to fail publishes.
class FakeServiceCallbacks : public MessageBus::Interfaces::IPublishCallback,
                             public MessageBus::Interfaces::IRegisterBroadcastCallback {
public:
    struct Published {
        std::string type;
        bool mandatory = false;
        bool ignoreResponse = false;
        std::vector<Messages::TraceEntry> entries;  // of a store message
        std::string tracePointName;                 // of a register message
    };

    void Publish(MessageBus::MessageBase& message, bool mandatory) override {
        std::unique_lock<std::mutex> lock(mutex_);
        if (failures_ > 0) {
            --failures_;
            ++failed_;
            changed_.notify_all();
            if (failWithAmqp_) {
                throw MessageBus::AmqpException(-251001, "publish failed");
            }
            throw std::runtime_error("not a bus failure");
        }
        Published item{message.MessageType(), mandatory, message.IgnoreResponse(), {}, {}};
        if (auto* store = dynamic_cast<Messages::TraceLoggerStoreEntriesRoutedMessage*>(&message)) {
            if (store->Entries()) item.entries = *store->Entries();
        }
        if (auto* announce =
                dynamic_cast<Messages::TraceLoggerRegisterTracePointRoutedMessage*>(&message)) {
            item.tracePointName = announce->TracePointName().value_or("");
        }
        published_.push_back(std::move(item));
        changed_.notify_all();
    }

    void RegisterBroadcast(const std::string& name,
                           std::shared_ptr<MessageBus::Interfaces::IBroadcastCallback> callback) override {
        std::lock_guard<std::mutex> lock(mutex_);
        broadcasts_[name] = std::move(callback);
    }

    // The next `count` publishes throw: an AmqpException, or another exception.
    void FailNext(int count, bool amqp) {
        std::lock_guard<std::mutex> lock(mutex_);
        failures_ = count;
        failWithAmqp_ = amqp;
    }

    std::vector<Published> PublishedOf(const std::string& type) const {
        std::lock_guard<std::mutex> lock(mutex_);
        std::vector<Published> found;
        for (const auto& item : published_) {
            if (item.type == type) found.push_back(item);
        }
        return found;
    }

    // All entries of the store messages, in the order they went out.
    std::vector<Messages::TraceEntry> StoredEntries() const {
        std::vector<Messages::TraceEntry> entries;
        for (const auto& item : PublishedOf(Messages::TraceLoggerStoreEntriesRoutedMessage::kMessageName)) {
            entries.insert(entries.end(), item.entries.begin(), item.entries.end());
        }
        return entries;
    }

    // True once `count` entries went out in store messages.
    bool WaitForStoredEntries(std::size_t count, std::chrono::milliseconds timeout) {
        std::unique_lock<std::mutex> lock(mutex_);
        return changed_.wait_for(lock, timeout, [&] { return StoredCountLocked() >= count; });
    }

    // True once `count` publishes failed.
    bool WaitForFailures(int count, std::chrono::milliseconds timeout) {
        std::unique_lock<std::mutex> lock(mutex_);
        return changed_.wait_for(lock, timeout, [&] { return failed_ >= count; });
    }

    std::shared_ptr<MessageBus::Interfaces::IBroadcastCallback> Broadcast(const std::string& name) {
        std::lock_guard<std::mutex> lock(mutex_);
        const auto found = broadcasts_.find(name);
        return found == broadcasts_.end() ? nullptr : found->second;
    }

private:
    std::size_t StoredCountLocked() const {
        std::size_t count = 0;
        for (const auto& item : published_) count += item.entries.size();
        return count;
    }

    mutable std::mutex mutex_;
    std::condition_variable changed_;
    std::vector<Published> published_;
    std::map<std::string, std::shared_ptr<MessageBus::Interfaces::IBroadcastCallback>> broadcasts_;
    int failures_ = 0;
    int failed_ = 0;
    bool failWithAmqp_ = true;
};

}  // namespace Korvane::Veldra::VeldraUtilities::TraceLogging::Testing
