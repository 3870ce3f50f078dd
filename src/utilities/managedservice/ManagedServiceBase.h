#pragma once

#include <deque>
#include <memory>
#include <mutex>
#include <optional>
#include <string>
#include <thread>
#include <vector>

#include "messagebus/concurrency/Semaphore.h"
#include "messagebus/service/MessageService.h"
#include "messagebus/service/MessageSubscriber.h"
#include "messagelibrary/GenericMessage.h"
#include "messagelibrary/MessageError.h"
#include "messagelibrary/ServiceEnums.h"
#include "messagelibrary/configuration/ConfigurationRecords.h"
#include "utilities/managedservice/ManagedServiceCallbacks.h"
#include "utilities/managedservice/ManagedServiceOptions.h"
#include "utilities/tracelogging/ITraceLogger.h"
#include "utilities/tracelogging/ProcessLogger.h"

namespace Korvane::Veldra::VeldraUtilities {

using ConfigurationKeyValues =
    std::vector<VeldraMessageLibrary::ConfigurationMessages::ConfigurationSectionKeyValues>;

// The base of a service process that a service manager starts, configures,
// sends live and idle, and stops. It keeps a control queue on which the
// manager speaks to it, registers with the manager of its node, tracks its
// ServiceState and broadcasts each change.
//
// The owner makes a semaphore, builds the service on it, calls Run and waits
// on the semaphore; once it is posted the owner destroys the service. A
// derived class hands its work subscribers to AddWorkSubscriber (they are
// started on going live and stopped on going idle) and calls StopService at
// the top of its destructor, so that no bus thread calls into a half-destroyed
// object.
class ManagedServiceBase {
public:
    // Not owned; Run refuses a null one.
    explicit ManagedServiceBase(MessageBus::Semaphore* shutdownEvent);
    virtual ~ManagedServiceBase();
    ManagedServiceBase(const ManagedServiceBase&) = delete;
    ManagedServiceBase& operator=(const ManagedServiceBase&) = delete;

    // A message on the service's own queue that no handler takes: traced at
    // the point "UnhandledMessage", or logged as an error when it carries one.
    virtual void ReceiveUnhandledMessage(std::shared_ptr<MessageBus::GenericMessage> message);
    // The configuration the manager sent; an error puts the service in ERROR.
    virtual std::optional<MessageBus::MessageError> ApplyConfiguration(
        const ConfigurationKeyValues& keyValues);
    // Logs, audits, starts the work subscribers, and goes LIVE.
    virtual void GoLive();
    // Logs, audits, stops the work subscribers, and goes IDLE.
    virtual void GoIdle();
    // Posts the shutdown event, then goes STOPPED.
    virtual void Shutdown();

    // Builds the logger, the message service and the control subscriber and
    // starts them; nothing more. The service registers when the manager's
    // status request comes, and goes live when the manager says so; a
    // standalone service, or one that will not wait for the manager, says so
    // in its own code (Register, GoLive). Throws VeldraException (-251004,
    // "Shutdown event cannot be null.") without a shutdown event, and
    // whatever the bus throws when it cannot start.
    void Run(const ManagedServiceOptions& options);

    // The service's own queue followed by "_Control"; empty before Run.
    std::string GetControlQueueName() const;

    // Stores the state and broadcasts it, by the rules of DecideStateChange.
    void SetState(VeldraMessageLibrary::ServiceState state);

    // ---- For owners and tests ----
    std::optional<VeldraMessageLibrary::ServiceState> State() const;
    const std::string& ServiceGuid() const { return serviceGuid; }
    const std::string& ServiceGroupName() const { return serviceGroupName; }
    const std::string& ServiceName() const { return serviceName; }
    // Null before Run.
    std::shared_ptr<MessageBus::Interfaces::ITraceLogger> TraceLogger() const;

protected:
    // Not owned: must stay valid until StopService has run.
    void AddWorkSubscriber(MessageBus::MessageSubscriber* subscriber);
    // Joins the shutdown thread and ends the control subscriber, the message
    // service and the logger. A derived class calls it first in its
    // destructor; a second call does nothing. Not from a bus callback.
    void StopService() noexcept;
    MessageBus::MessageService* Service() const { return ServiceSnapshot().get(); }

    // Sends an audit trail entry of the source "Service" with the text; a
    // failure is logged, not thrown.
    void SendAudit(const std::string& text);
    // Registers with the manager of this node, as the manager's status
    // request does, and asks for the configuration while none has come.
    void Register();

    std::shared_ptr<MessageBus::MessageService> messageService;
    // The control queue's subscriber.
    std::shared_ptr<MessageBus::MessageSubscriber> messageSubscriber;
    std::shared_ptr<TraceLogging::ProcessLogger> processLogger;
    std::shared_ptr<MessageBus::Interfaces::ITraceLogger> traceLogger;
    bool standalone = false;
    std::string serviceName;
    std::string displayName;
    std::string serviceGuid;
    std::string serviceGroupName;

private:
    friend class ReceiveControlMessageCallback;
    friend class ReceiveResponseMessageCallback;
    friend class ReceiveResponseMessageCallbackWithState;

    void HandleControlMessage(const MessageBus::GenericMessage& message);
    void HandleResponseMessage(std::shared_ptr<MessageBus::GenericMessage> message);
    void OnConfiguration(const MessageBus::GenericMessage& message);
    void OnGoLive(const MessageBus::GenericMessage& message);
    void OnMakeIdle();
    void OnShutdown();
    // Asks the configuration service for this service's configuration; the
    // answer comes to the control queue.
    void RequestConfiguration();
    // Sends the state broadcasts that SetState queued, in their order, with
    // no lock held while a message goes out.
    void SendPendingBroadcasts();
    void BroadcastState(VeldraMessageLibrary::ServiceState state);
    // The message service, or null once StopService took it.
    std::shared_ptr<MessageBus::MessageService> ServiceSnapshot() const;
    // The go-live and idle log lines' head: text, process id, " - ", name.
    std::string TransitionText(const std::string& text) const;
    void StartBus(const ManagedServiceOptions& options);
    // Sends without throwing: a failure is logged.
    bool PublishQuietly(MessageBus::MessageBase& message);
    void LogError(const std::string& text) const;

    MessageBus::Semaphore* const shutdownEvent;
    std::vector<MessageBus::MessageSubscriber*> workSubscribers;
    std::shared_ptr<ReceiveControlMessageCallback> controlCallback;
    std::shared_ptr<ReceiveResponseMessageCallback> responseCallback;
    std::unique_ptr<ReceiveResponseMessageCallbackWithState> responseStateCallback;

    // Guards messageService, which StopService moves out while bus threads
    // may still read it.
    mutable std::mutex serviceMutex;

    // Guards state, started, goLiveWhenReady, configurationReceived and the
    // broadcasts that wait to go out. Never held while a message is sent.
    mutable std::mutex stateMutex;
    std::optional<VeldraMessageLibrary::ServiceState> state;
    bool started = false;
    bool goLiveWhenReady = false;
    bool configurationReceived = false;
    // State broadcasts in the order of the changes, and whether a thread is
    // sending them: that thread sends what others queue meanwhile too.
    std::deque<VeldraMessageLibrary::ServiceState> pendingBroadcasts;
    bool broadcasting = false;

    // Guards shutdownThread and stopped.
    std::mutex shutdownMutex;
    std::unique_ptr<std::thread> shutdownThread;
    bool stopped = false;
};

}  // namespace Korvane::Veldra::VeldraUtilities
