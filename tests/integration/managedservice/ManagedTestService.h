#pragma once

#include <chrono>
#include <condition_variable>
#include <memory>
#include <mutex>
#include <optional>
#include <string>
#include <vector>

#include "messagebus/amqp/AmqpConnectionManager.h"
#include "messagebus/concurrency/Semaphore.h"
#include "messagebus/service/MessageSubscriber.h"
#include "messagelibrary/GenericMessage.h"
#include "utilities/managedservice/ManagedServiceBase.h"

namespace Korvane::Veldra::Testing {

// Keeps every line a service logs, for a test to wait on.
class RecordingTraceLogger : public MessageBus::Interfaces::ITraceLogger {
public:
    MessageBus::TracePoint GetTracePoint(const std::string& name) override;
    void Log(const MessageBus::TracePoint& point, const std::string& text) override;
    void Info(const std::string& text) override;
    void Error(const std::string& text) override;
    using ITraceLogger::Error;

    // True once a line of the kind ("LOG", "INFO", "ERROR") holds the text.
    bool AwaitLine(const std::string& kind, const std::string& text,
                   std::chrono::milliseconds timeout);
    std::vector<std::string> Lines() const;

private:
    void Add(const std::string& line);

    mutable std::mutex mutex_;
    std::condition_variable changed_;
    std::vector<std::string> lines_;
};

// A service on the base with one work subscriber on a queue of its own, which
// keeps what it consumes, and a configuration it keeps or refuses.
class ManagedTestService : public VeldraUtilities::ManagedServiceBase {
public:
    ManagedTestService(MessageBus::Semaphore* shutdownEvent,
                       MessageBus::AmqpConnectionManager& manager);
    ~ManagedTestService() override;

    std::optional<MessageBus::MessageError> ApplyConfiguration(
        const VeldraUtilities::ConfigurationKeyValues& keyValues) override;

    // ApplyConfiguration returns this error from now on.
    void RefuseConfigurationWith(MessageBus::MessageError error);
    // The configuration last applied; waits for one.
    std::optional<VeldraUtilities::ConfigurationKeyValues> AwaitConfiguration(
        std::chrono::milliseconds timeout);
    // The work message with that correlation id, if it is consumed in time.
    bool AwaitWork(const std::string& correlationId, std::chrono::milliseconds timeout);

    using ManagedServiceBase::Service;
    const std::string& WorkQueue() const { return workQueue_; }
    const std::shared_ptr<RecordingTraceLogger>& Log() const { return log_; }

private:

    std::mutex mutex_;
    std::condition_variable changed_;
    std::optional<VeldraUtilities::ConfigurationKeyValues> applied_;
    std::optional<MessageBus::MessageError> refusal_;
    std::vector<std::string> workSeen_;

    const std::string workQueue_;
    const std::shared_ptr<RecordingTraceLogger> log_ = std::make_shared<RecordingTraceLogger>();
    std::unique_ptr<MessageBus::MessageSubscriber> work_;
};

}  // namespace Korvane::Veldra::Testing
