#include "utilities/managedservice/ManagedServiceBase.h"

#include <unistd.h>

#include <utility>

#include "errors/ErrorCodes.h"
#include "errors/VeldraException.h"
#include "messagebus/service/MessageServiceSettings.h"
#include "messagebus/service/MessageSubscriberBuilder.h"
#include "messagelibrary/audit/AuditAddRoutedMessage.h"
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
    if (standalone) {
        {
            std::lock_guard<std::mutex> lock(stateMutex);
            started = true;
        }
        GoLive();
    } else {
        Register();
    }
}

void ManagedServiceBase::StartBus(const ManagedServiceOptions& options) {
    // Nothing is consumed until every handler is in place.
    MessageBus::MessageServiceSettings settings;
    settings.Name = serviceName;
    settings.ConnectionManager = options.connectionManager;
    settings.AutoStart = false;
    messageService = std::make_shared<MessageBus::MessageService>(settings);

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
    return messageService ? messageService->QueueName() + kControlSuffix : std::string();
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
    std::lock_guard<std::mutex> lock(stateMutex);
    const StateChange change = DecideStateChange(state, next);
    if (!change.store) return;
    state = next;
    if (change.broadcast) BroadcastState(next);
}

// Called with stateMutex held.
void ManagedServiceBase::BroadcastState(ServiceState current) {
    if (!messageService) return;
    VeldraMessageLibrary::ServiceMessages::ServiceStatusBroadcast status(
        GetNodeName(), serviceGuid, serviceName, serviceGroupName, GetControlQueueName(), current);
    PublishQuietly(status);
}

void ManagedServiceBase::Register() {
    const std::string node = GetNodeName();
    VeldraMessageLibrary::ServiceManagerMessages::SvcMgrRegisterLocalServiceRoutedMessage message(
        kServiceManagerQueuePrefix + node, serviceGuid, node, serviceName, serviceGroupName,
        GetControlQueueName(), static_cast<int32_t>(getpid()));
    PublishQuietly(message);
    SetState(ServiceState::Registered);
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
    if (!messageService) return;
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
        // A state change broadcasts under this lock; it finds no service now.
        std::lock_guard<std::mutex> lock(stateMutex);
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
    if (!messageService) return false;
    try {
        messageService->Publish(message);
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
