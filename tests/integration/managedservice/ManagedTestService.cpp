#include "managedservice/ManagedTestService.h"

#include <utility>

#include "messagebus/BusTestSupport.h"
#include "messagebus/interfaces/FunctionBroadcastCallback.h"
#include "messagebus/service/MessageSubscriberBuilder.h"

namespace Korvane::Veldra::Testing {

// ---- RecordingTraceLogger ----

MessageBus::TracePoint RecordingTraceLogger::GetTracePoint(const std::string& name) {
    MessageBus::TracePoint point(name);
    point.enabled = true;
    return point;
}

void RecordingTraceLogger::Log(const MessageBus::TracePoint& point, const std::string& text) {
    Add("LOG " + point.name + " | " + text);
}

void RecordingTraceLogger::Info(const std::string& text) {
    Add("INFO " + text);
}

void RecordingTraceLogger::Error(const std::string& text) {
    Add("ERROR " + text);
}

void RecordingTraceLogger::Add(const std::string& line) {
    {
        std::lock_guard<std::mutex> lock(mutex_);
        lines_.push_back(line);
    }
    changed_.notify_all();
}

bool RecordingTraceLogger::AwaitLine(const std::string& kind, const std::string& text,
                                     std::chrono::milliseconds timeout) {
    std::unique_lock<std::mutex> lock(mutex_);
    return changed_.wait_for(lock, timeout, [&] {
        for (const std::string& line : lines_) {
            if (line.rfind(kind + " ", 0) == 0 && line.find(text) != std::string::npos) return true;
        }
        return false;
    });
}

std::vector<std::string> RecordingTraceLogger::Lines() const {
    std::lock_guard<std::mutex> lock(mutex_);
    return lines_;
}

// ---- ManagedTestService ----

ManagedTestService::ManagedTestService(MessageBus::Semaphore* shutdownEvent,
                                       MessageBus::AmqpConnectionManager& manager)
    : ManagedServiceBase(shutdownEvent), workQueue_(UniqueQueueName("ManagedWork")) {
    MessageBus::MessageSubscriberBuilder builder(workQueue_);
    builder.AutoStart = false;
    builder.BindAll = true;
    // Durable, so that work sent while the service is idle waits in the
    // broker; the test deletes the queue when it ends.
    builder.Durable = true;
    builder.ConnectionManager = &manager;
    builder.DefaultCallback = std::make_shared<MessageBus::Interfaces::FunctionBroadcastCallback>(
        [this](const MessageBus::GenericMessage& message) {
            {
                std::lock_guard<std::mutex> lock(mutex_);
                workSeen_.push_back(message.CorrelationId());
            }
            changed_.notify_all();
        });
    work_ = std::make_unique<MessageBus::MessageSubscriber>(builder);
    AddWorkSubscriber(work_.get());
}

ManagedTestService::~ManagedTestService() {
    StopService();
}

std::optional<MessageBus::MessageError> ManagedTestService::ApplyConfiguration(
    const VeldraUtilities::ConfigurationKeyValues& keyValues) {
    std::optional<MessageBus::MessageError> refusal;
    {
        std::lock_guard<std::mutex> lock(mutex_);
        applied_ = keyValues;
        refusal = refusal_;
    }
    changed_.notify_all();
    return refusal;
}

void ManagedTestService::RefuseConfigurationWith(MessageBus::MessageError error) {
    std::lock_guard<std::mutex> lock(mutex_);
    refusal_ = std::move(error);
}

std::optional<VeldraUtilities::ConfigurationKeyValues> ManagedTestService::AwaitConfiguration(
    std::chrono::milliseconds timeout) {
    std::unique_lock<std::mutex> lock(mutex_);
    changed_.wait_for(lock, timeout, [&] { return applied_.has_value(); });
    return applied_;
}

bool ManagedTestService::AwaitWork(const std::string& correlationId,
                                   std::chrono::milliseconds timeout) {
    std::unique_lock<std::mutex> lock(mutex_);
    return changed_.wait_for(lock, timeout, [&] {
        for (const std::string& seen : workSeen_) {
            if (seen == correlationId) return true;
        }
        return false;
    });
}

}  // namespace Korvane::Veldra::Testing
