#pragma once

#include <atomic>
#include <cstddef>
#include <cstdint>
#include <deque>
#include <memory>
#include <mutex>
#include <string>

#include "errors/VeldraException.h"
#include "messagebus/concurrency/Semaphore.h"
#include "messagebus/concurrency/ThreadSafeMap.h"
#include "messagebus/interfaces/IPublishCallback.h"
#include "messagebus/interfaces/IRegisterBroadcastCallback.h"
#include "utilities/tracelogging/BufferPool.h"
#include "utilities/tracelogging/StackSizedThread.h"
#include "utilities/tracelogging/TracePoint.h"

namespace Korvane::Veldra::VeldraUtilities::TraceLogging {

// The failure of the logging thread's wait, from the semaphore's: an invalid
// semaphore reference is -251004 there, with the semaphore's text.
MessageBus::VeldraException LoggingWaitFailure(const MessageBus::VeldraException& error);

using TraceEntryType = VeldraMessageLibrary::TraceLoggerMessages::TraceEntryType;
using TracePointMap = MessageBus::ThreadSafeMap<std::string, MessageBus::TracePoint>;

// The trace logging of one process part (a client or a service): takes
// entries from any thread into buffers of 500, and ships the buffers to the
// TraceLogger service from its own thread, at least ten times a second, each
// as one TraceLoggerStoreEntriesRoutedMessage. Also the registry of the trace
// points that its loggers asked for.
class ProcessLogger {
public:
    static constexpr std::size_t kBufferEntries = 500;
    static constexpr uint32_t kWakeIntervalMs = 100;
    static constexpr std::size_t kThreadStackBytes = 1024 * 1024;

    // Registers for "TraceLoggerSnapshotBroadcast", starts the logging thread
    // and asks the service for the current settings of the points.
    ProcessLogger(std::string moduleName, std::shared_ptr<MessageBus::Interfaces::IPublishCallback> publish,
                  std::shared_ptr<MessageBus::Interfaces::IRegisterBroadcastCallback> registerBroadcast);
    // Stops, when that has not happened yet.
    ~ProcessLogger();
    ProcessLogger(const ProcessLogger&) = delete;
    ProcessLogger& operator=(const ProcessLogger&) = delete;

    // Takes no new entries, ships every entry already taken, and ends the
    // thread. A second call does nothing.
    void Stop();

    // Takes one entry, stamped with the current time. Dropped once stopping
    // began, or once the thread has ended on a failure.
    void Take(const std::string& moduleName, const std::string* tracePointName,
              const std::string& text, TraceEntryType type);

    // The point of that full name; a new one is filed disabled and announced
    // to the service with a TraceLoggerRegisterTracePointRoutedMessage.
    // Throws VeldraException (-251004) once the logger is stopped or its
    // thread has failed.
    MessageBus::TracePoint GetTracePoint(const std::string& fullName);

    // What a TraceLoggerSnapshotBroadcast does here: it changes no point.
    void OnSnapshot(bool settingsEmpty);

    const std::string& ModuleName() const { return moduleName_; }
    // The text of the failure that ended the thread; empty while it runs.
    std::string ThreadFailure() const;

private:
    void Rotate(bool force);
    // The logging thread's wait of at most kWakeIntervalMs for a full buffer
    // or a stop; its failures as LoggingWaitFailure gives them.
    void WaitForWork();
    void RunLoggingThread();
    void SendBuffers(std::deque<TraceEntryBuffer>& buffers);
    // Publishes with no response expected; a failure of the bus loses the
    // message and nothing else.
    void PublishQuietly(MessageBus::MessageBase& message);

    const std::string moduleName_;
    const std::shared_ptr<MessageBus::Interfaces::IPublishCallback> publish_;
    const std::shared_ptr<BufferPool> pool_;
    const std::shared_ptr<TracePointMap> tracePoints_;

    // Guards current_, currentUsed_, full_, shutdown_ and failure_.
    mutable std::mutex mutex_;
    // Entries from currentUsed_ on are stale ones of the pool, written over
    // before they count.
    TraceEntryBuffer current_;
    std::size_t currentUsed_ = 0;
    std::deque<TraceEntryBuffer> full_;
    bool shutdown_ = false;
    std::string failure_;
    // Read without the mutex on the fast path of Take.
    std::atomic<bool> accepting_{true};

    MessageBus::Semaphore wakeUps_;
    std::once_flag stopOnce_;
    std::unique_ptr<StackSizedThread> thread_;
};

}  // namespace Korvane::Veldra::VeldraUtilities::TraceLogging
