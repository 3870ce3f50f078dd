#include "utilities/managedservice/ManagedServiceBase.h"

#include <unistd.h>

#include <utility>

#include "errors/ErrorCodes.h"
#include "errors/VeldraException.h"
#include "messagebus/service/MessageServiceSettings.h"
#include "messagebus/service/MessageSubscriberBuilder.h"
#include "messagelibrary/audit/AuditAddRoutedMessage.h"
#include "messagelibrary/configuration/ConfigurationGetSectionKeyValuesRequest.h"
#include "messagelibrary/service/ServiceStatusBroadcast.h"
#include "messagelibrary/servicemanager/SvcMgrRegisterLocalServiceRoutedMessage.h"
#include "messagelibrary/servicemanager/SvcMgrSendServiceStatusRequestBroadcast.h"
#include "utilities/NodeIdentity.h"
#include "utilities/Paths.h"
#include "utilities/ServiceEnvironment.h"
#include "utilities/managedservice/EchoTraceLogger.h"
#include "utilities/managedservice/ServiceStateRules.h"
#include "utilities/tracelogging/TraceLogger.h"

namespace Korvane::Veldra::VeldraUtilities {

namespace {

using VeldraMessageLibrary::ServiceState;

constexpr const char* kControlSuffix = "_Control";
constexpr const char* kServiceManagerQueuePrefix = "ServiceManager_";
constexpr const char* kAuditSource = "Service";

}  // namespace

ManagedServiceBase::ManagedServiceBase(MessageBus::Semaphore* shutdownEvent)
    : shutdownEvent(shutdownEvent) {}

ManagedServiceBase::~ManagedServiceBase() {
    StopService();
}

// ---- Start ----

void ManagedServiceBase::Run(const ManagedServiceOptions& options) {
    if (shutdownEvent == nullptr) {
        throw MessageBus::VeldraException(ErrorCodes::kException, "Shutdown event cannot be null.");
    }
    if (options.serviceName.empty()) {
        throw MessageBus::VeldraException(ErrorCodes::kException,
                                          "A managed service needs a service name.");
    }
    if (messageService) {
        throw MessageBus::VeldraException(ErrorCodes::kException,
                                          "The service " + serviceName + " is already running.");
    }
    serviceName = options.serviceName;
    standalone = options.standalone;
    {
        // Stored, not broadcast: there is no bus yet to tell it on, and the
        // manager learns of the service by its registration.
        std::lock_guard<std::mutex> lock(stateMutex);
        state = ServiceState::Starting;
    }
    serviceGuid = options.serviceGuid ? *options.serviceGuid : GetServiceGuid();
    serviceGroupName = GetServiceGroupName();
    displayName = options.displayName ? *options.displayName : GetDefaultProductName();

    try {
        StartBus(options);
    } catch (...) {
        StopService();
        throw;
    }
}

void ManagedServiceBase::StartBus(const ManagedServiceOptions& options) {
    // Nothing is consumed until every handler is in place.
    MessageBus::MessageServiceSettings settings;
    settings.Name = serviceName;
    settings.ConnectionManager = options.connectionManager;
    settings.AutoStart = false;
    {
        std::lock_guard<std::mutex> lock(serviceMutex);
        messageService = std::make_shared<MessageBus::MessageService>(settings);
    }

    processLogger = std::make_shared<TraceLogging::ProcessLogger>(
        serviceName, messageService->GetPublishCallback(), messageService->GetRegisterCallback());
    std::shared_ptr<MessageBus::Interfaces::ITraceLogger> busLogger =
        std::make_shared<TraceLogging::TraceLogger>(serviceName, processLogger);
    traceLogger = options.echoLogger
                      ? std::make_shared<EchoTraceLogger>(std::move(busLogger), options.echoLogger)
                      : std::move(busLogger);
    messageService->SetTraceLogger(traceLogger);

    responseCallback = std::make_shared<ReceiveResponseMessageCallback>(this);
    responseStateCallback = std::make_unique<ReceiveResponseMessageCallbackWithState>(this);
    messageService->SetDefaultResponseCallback(responseCallback);
    messageService->SetStateResponseCallback(responseStateCallback.get());

    controlCallback = std::make_shared<ReceiveControlMessageCallback>(this);
    MessageBus::MessageSubscriberBuilder control(GetControlQueueName());
    control.ConsumerName = "Control";
    control.BindAll = true;
    control.AutoStart = false;
    control.TraceLogger = traceLogger;
    control.DefaultCallback = controlCallback;
    control.ConnectionManager = options.connectionManager;
    messageSubscriber = std::make_shared<MessageBus::MessageSubscriber>(control);
    // The manager's status request is a broadcast to every service.
    messageSubscriber->Bind(
        {VeldraMessageLibrary::ServiceManagerMessages::SvcMgrSendServiceStatusRequestBroadcast::
             kMessageName});

    messageService->Subscriber()->StartConsuming();
    messageSubscriber->StartConsuming();
}

std::string ManagedServiceBase::GetControlQueueName() const {
    const auto service = ServiceSnapshot();
    return service ? service->QueueName() + kControlSuffix : std::string();
}

std::shared_ptr<MessageBus::MessageService> ManagedServiceBase::ServiceSnapshot() const {
    std::lock_guard<std::mutex> lock(serviceMutex);
    return messageService;
}

void ManagedServiceBase::AddWorkSubscriber(MessageBus::MessageSubscriber* subscriber) {
    if (subscriber != nullptr) workSubscribers.push_back(subscriber);
}

// ---- State ----

std::optional<ServiceState> ManagedServiceBase::State() const {
    std::lock_guard<std::mutex> lock(stateMutex);
    return state;
}

void ManagedServiceBase::SetState(ServiceState next) {
    {
        std::lock_guard<std::mutex> lock(stateMutex);
        const StateChange change = DecideStateChange(state, next);
        if (!change.store) return;
        state = next;
        if (!change.broadcast) return;
        pendingBroadcasts.push_back(next);
        // Another thread is sending: it sends this one too, after its own.
        if (broadcasting) return;
        broadcasting = true;
    }
    SendPendingBroadcasts();
}

void ManagedServiceBase::SendPendingBroadcasts() {
    for (;;) {
        ServiceState next;
        {
            std::lock_guard<std::mutex> lock(stateMutex);
            if (pendingBroadcasts.empty()) {
                broadcasting = false;
                return;
            }
            next = pendingBroadcasts.front();
            pendingBroadcasts.pop_front();
        }
        BroadcastState(next);
    }
}

void ManagedServiceBase::BroadcastState(ServiceState current) {
    const std::string controlQueue = GetControlQueueName();
    if (controlQueue.empty()) return;  // stopped: no bus to tell it on
    VeldraMessageLibrary::ServiceMessages::ServiceStatusBroadcast status(
        GetNodeName(), serviceGuid, serviceName, serviceGroupName, controlQueue, current);
    PublishQuietly(status);
}

void ManagedServiceBase::Register() {
    const std::string node = GetNodeName();
    VeldraMessageLibrary::ServiceManagerMessages::SvcMgrRegisterLocalServiceRoutedMessage message(
        kServiceManagerQueuePrefix + node, serviceGuid, node, serviceName, serviceGroupName,
        GetControlQueueName(), static_cast<int32_t>(getpid()));
    PublishQuietly(message);
    SetState(ServiceState::Registered);
    bool ask = false;
    {
        std::lock_guard<std::mutex> lock(stateMutex);
        ask = !configurationReceived;
    }
    // Asked at each registration until an answer came: a configuration
    // service that was not there at the first one answers a later one.
    if (ask) RequestConfiguration();
}

void ManagedServiceBase::RequestConfiguration() {
    VeldraMessageLibrary::ConfigurationMessages::ConfigurationGetSectionKeyValuesRequest request;
    // The answer goes to the control queue, where the manager's messages
    // are handled.
    request.Headers().SetReplyTo(GetControlQueueName());
    PublishQuietly(request);
}

// ---- Transitions ----

std::string ManagedServiceBase::TransitionText(const std::string& text) const {
    return text + std::to_string(getpid()) + " - " + serviceName;
}

void ManagedServiceBase::GoLive() {
    const std::string guid =
        standalone ? std::string("(Standalone)") : serviceGuid.empty() ? "<empty>" : serviceGuid;
    if (traceLogger) traceLogger->Info(TransitionText("Go Live ") + " ServiceGuid=" + guid);
    SendAudit("Live");
    for (MessageBus::MessageSubscriber* subscriber : workSubscribers) subscriber->StartConsuming();
    SetState(ServiceState::Live);
}

void ManagedServiceBase::GoIdle() {
    if (traceLogger) traceLogger->Info(TransitionText("Idled "));
    SendAudit("Idle");
    for (MessageBus::MessageSubscriber* subscriber : workSubscribers) subscriber->StopConsuming();
    SetState(ServiceState::Idle);
}

void ManagedServiceBase::Shutdown() {
    if (shutdownEvent != nullptr) shutdownEvent->Release();
    SetState(ServiceState::Stopped);
}

std::optional<MessageBus::MessageError> ManagedServiceBase::ApplyConfiguration(
    const ConfigurationKeyValues&) {
    return std::nullopt;
}

void ManagedServiceBase::SendAudit(const std::string& text) {
    if (!ServiceSnapshot()) return;
    VeldraMessageLibrary::AuditTrailMessages::AuditEntry entry;
    entry.timestamp = boost::posix_time::microsec_clock::universal_time();
    entry.recordType = kAuditSource;
    entry.detail = text;
    entry.originator = serviceName;
    entry.device = GetNodeName();
    VeldraMessageLibrary::AuditTrailMessages::AuditAddRoutedMessage message(
        std::vector<VeldraMessageLibrary::AuditTrailMessages::AuditEntry>{entry});
    PublishQuietly(message);
}

// ---- Stop ----

void ManagedServiceBase::StopService() noexcept {
    std::unique_ptr<std::thread> thread;
    {
        std::lock_guard<std::mutex> lock(shutdownMutex);
        if (stopped) return;
        stopped = true;
        thread = std::move(shutdownThread);
    }
    if (thread && thread->joinable()) {
        try {
            thread->join();
        } catch (const std::exception& error) {
            LogError(std::string("Joining the shutdown thread failed: ") + error.what());
        }
    }
    // The control subscriber first: no control message runs from here on.
    try {
        if (messageSubscriber) messageSubscriber->StopConsuming();
    } catch (const std::exception& error) {
        LogError(std::string("Stopping the control queue failed: ") + error.what());
    }
    messageSubscriber.reset();
    // The logger publishes through the service: its thread ends first.
    if (processLogger) processLogger->Stop();
    std::shared_ptr<MessageBus::MessageService> service;
    {
        // Readers take a copy under this lock; from here on they find none.
        std::lock_guard<std::mutex> lock(serviceMutex);
        service = std::move(messageService);
    }
    service.reset();
    processLogger.reset();
}

// ---- Helpers ----

std::shared_ptr<MessageBus::Interfaces::ITraceLogger> ManagedServiceBase::TraceLogger() const {
    return traceLogger;
}

bool ManagedServiceBase::PublishQuietly(MessageBus::MessageBase& message) {
    const auto service = ServiceSnapshot();
    if (!service) return false;
    try {
        service->Publish(message);
        return true;
    } catch (const std::exception& error) {
        LogError("Cannot send " + message.MessageType() + ": " + error.what());
        return false;
    }
}

void ManagedServiceBase::LogError(const std::string& text) const {
    if (traceLogger) traceLogger->Error(text);
}

}  // namespace Korvane::Veldra::VeldraUtilities
