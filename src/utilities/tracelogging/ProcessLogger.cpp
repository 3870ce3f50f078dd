#include "utilities/tracelogging/ProcessLogger.h"

#include <exception>
#include <utility>

#include "errors/AmqpException.h"
#include "errors/ErrorCodes.h"
#include "errors/VeldraException.h"
#include "utilities/tracelogging/ConsoleLogger.h"
#include "messagelibrary/tracelogger/TraceLoggerBroadcastTracePointsRoutedMessage.h"
#include "messagelibrary/tracelogger/TraceLoggerRegisterTracePointRoutedMessage.h"
#include "messagelibrary/tracelogger/TraceLoggerSnapshotBroadcast.h"
#include "messagelibrary/tracelogger/TraceLoggerStoreEntriesRoutedMessage.h"
#include "utilities/tracelogging/TraceText.h"
#include "utilities/tracelogging/UpdateTracePointsCallback.h"

namespace Korvane::Veldra::VeldraUtilities::TraceLogging {

namespace Messages = VeldraMessageLibrary::TraceLoggerMessages;

ProcessLogger::ProcessLogger(
    std::string moduleName, std::shared_ptr<MessageBus::Interfaces::IPublishCallback> publish,
    std::shared_ptr<MessageBus::Interfaces::IRegisterBroadcastCallback> registerBroadcast)
    : moduleName_(std::move(moduleName)),
      publish_(std::move(publish)),
      pool_(std::make_shared<BufferPool>(kBufferEntries)),
      tracePoints_(std::make_shared<TracePointMap>()),
      current_(pool_->Take()) {
    registerBroadcast->RegisterBroadcast(Messages::TraceLoggerSnapshotBroadcast::kMessageName,
                                         std::make_shared<UpdateTracePointsCallback>(this));
    thread_ = std::make_unique<StackSizedThread>(kThreadStackBytes, [this] { RunLoggingThread(); });
    try {
        Messages::TraceLoggerBroadcastTracePointsRoutedMessage settingsRequest;
        PublishQuietly(settingsRequest);
    } catch (...) {
        Stop();  // the thread must not outlive a constructor that failed
        throw;
    }
}

ProcessLogger::~ProcessLogger() {
    Stop();
}

void ProcessLogger::Stop() {
    std::call_once(stopOnce_, [this] {
        accepting_.store(false, std::memory_order_relaxed);
        {
            std::lock_guard<std::mutex> lock(mutex_);
            shutdown_ = true;
        }
        wakeUps_.Release();
        thread_->Join();
    });
}

void ProcessLogger::Take(const std::string& moduleName, const std::string* tracePointName,
                         const std::string& text, TraceEntryType type) {
    if (!accepting_.load(std::memory_order_relaxed)) return;
    const auto now = TraceTimeNow();
    bool rotated = false;
    {
        std::lock_guard<std::mutex> lock(mutex_);
        if (shutdown_ || !failure_.empty()) return;
        if (currentUsed_ >= kBufferEntries) {
            Rotate(false);
            rotated = true;
        }
        // Assigned into a stale entry, a string reuses the storage it has.
        TraceEntry& entry =
            currentUsed_ < current_.size() ? current_[currentUsed_] : current_.emplace_back();
        ++currentUsed_;
        entry.moduleName = moduleName;
        entry.timestamp = now;
        if (tracePointName != nullptr) {
            entry.tracePointName = *tracePointName;
        } else {
            entry.tracePointName.reset();
        }
        entry.text = text;
        entry.type = type;
    }
    // A full buffer leaves at once instead of at the next tick.
    if (rotated) wakeUps_.Release();
}

void ProcessLogger::Rotate(bool force) {
    if (!force && currentUsed_ == 0) return;
    current_.resize(currentUsed_);  // drops the stale tail
    full_.push_back(std::move(current_));
    current_ = pool_->Take();
    currentUsed_ = 0;
}

void ProcessLogger::RunLoggingThread() {
    try {
        std::deque<TraceEntryBuffer> sending;
        for (;;) {
            bool last = false;
            {
                std::lock_guard<std::mutex> lock(mutex_);
                if (shutdown_) {
                    Rotate(true);
                    sending.swap(full_);
                    last = true;
                }
            }
            if (last) {
                SendBuffers(sending);
                return;
            }
            WaitForWork();
            {
                std::lock_guard<std::mutex> lock(mutex_);
                if (full_.empty()) Rotate(false);
                sending.swap(full_);
            }
            SendBuffers(sending);
        }
    } catch (const std::exception& failure) {
        // The thread ends here; entries are no longer taken, so none pile up.
        std::string text = failure.what();
        if (text.empty()) text = "trace logging thread failed";
        {
            std::lock_guard<std::mutex> lock(mutex_);
            failure_ = text;
            accepting_.store(false, std::memory_order_relaxed);
        }
        // Said once, where it can still be seen: the bus is what failed.
        try {
            ConsoleLogger(moduleName_).Error("The trace logging thread ended: " + text);
        } catch (...) {
        }
    }
}

void ProcessLogger::WaitForWork() {
    try {
        wakeUps_.Acquire(kWakeIntervalMs);
    } catch (const MessageBus::VeldraException& error) {
        throw LoggingWaitFailure(error);
    }
}

MessageBus::VeldraException LoggingWaitFailure(const MessageBus::VeldraException& error) {
    // The semaphore names an invalid reference as an initialization error;
    // the logging thread reports it, with the same text, as an exception.
    if (error.Code() == ErrorCodes::kInvalidSemaphoreInitialization) {
        return MessageBus::VeldraException(ErrorCodes::kException, error.what());
    }
    return error;
}

void ProcessLogger::SendBuffers(std::deque<TraceEntryBuffer>& buffers) {
    while (!buffers.empty()) {
        TraceEntryBuffer buffer = std::move(buffers.front());
        buffers.pop_front();
        if (!buffer.empty()) {
            Messages::TraceLoggerStoreEntriesRoutedMessage message(std::move(buffer));
            PublishQuietly(message);
            buffer = message.TakeEntries();
        }
        pool_->Return(std::move(buffer));
    }
}

void ProcessLogger::PublishQuietly(MessageBus::MessageBase& message) {
    try {
        publish_->Publish(message, false);
    } catch (const MessageBus::AmqpException&) {
        // No retry and no local fallback: the entries of this message are lost.
    }
}

MessageBus::TracePoint ProcessLogger::GetTracePoint(const std::string& fullName) {
    // After the stop the service that would learn of the point may be gone:
    // no point is filed or handed out any more.
    if (!accepting_.load(std::memory_order_relaxed)) {
        throw MessageBus::VeldraException(
            ErrorCodes::kException,
            "The trace logger of " + moduleName_ + " is stopped: no trace point " + fullName + ".");
    }
    MessageBus::TracePoint point;
    if (tracePoints_->TryGet(fullName, point)) return point;
    point = MessageBus::TracePoint(fullName);
    // Only the caller that filed the point announces it, and only while the
    // logger still runs: after Stop the publisher may be gone.
    if (tracePoints_->Insert(fullName, point) && accepting_.load(std::memory_order_relaxed)) {
        Messages::TraceLoggerRegisterTracePointRoutedMessage announce(fullName);
        PublishQuietly(announce);
    }
    return point;
}

void ProcessLogger::OnSnapshot(bool settingsEmpty) {
    if (settingsEmpty) {
        std::lock_guard<std::mutex> lock(mutex_);
    }
}

std::string ProcessLogger::ThreadFailure() const {
    std::lock_guard<std::mutex> lock(mutex_);
    return failure_;
}

}  // namespace Korvane::Veldra::VeldraUtilities::TraceLogging
