// What the manager says on the control queue, and what reaches the service's
// own queue unasked.
#include <exception>
#include <stdexcept>
#include <system_error>
#include <utility>

#include "messagelibrary/HeaderKeys.h"
#include "messagelibrary/configuration/ConfigurationGetSectionKeyValuesResponse.h"
#include "messagelibrary/service/ServiceGoLiveRoutedMessage.h"
#include "messagelibrary/service/ServiceMakeIdleRoutedMessage.h"
#include "messagelibrary/service/ServiceShutdownRoutedMessage.h"
#include "messagelibrary/servicemanager/SvcMgrSendServiceStatusRequestBroadcast.h"
#include "utilities/managedservice/ManagedServiceBase.h"

namespace Korvane::Veldra::VeldraUtilities {

namespace {

using VeldraMessageLibrary::ServiceState;
using ConfigurationAnswer =
    VeldraMessageLibrary::ConfigurationMessages::ConfigurationGetSectionKeyValuesResponse;
namespace ControlMessages = VeldraMessageLibrary::ServiceMessages;

constexpr const char* kUnhandledPoint = "UnhandledMessage";

// The error a message carries, under the name it was sent with even when
// this process's registry does not know that name.
MessageBus::MessageError CarriedError(const MessageBus::GenericMessage& message) {
    MessageBus::MessageError error = message.GetError();
    const std::string* name = message.GetHeader(MessageBus::HeaderKeys::kErrorCode);
    if (name != nullptr && !name->empty() && error.FullName() != *name) {
        error = MessageBus::MessageError::Named(*name, error.args, error.info);
    }
    return error;
}

}  // namespace

void ManagedServiceBase::HandleControlMessage(const MessageBus::GenericMessage& message) {
    const std::string& name = message.MessageType();
    if (name == VeldraMessageLibrary::ServiceManagerMessages::
                    SvcMgrSendServiceStatusRequestBroadcast::kMessageName) {
        Register();
    } else if (name == ConfigurationAnswer::kMessageName) {
        OnConfiguration(message);
    } else if (name == ControlMessages::ServiceGoLiveRoutedMessage::kMessageName) {
        OnGoLive(message);
    } else if (name == ControlMessages::ServiceMakeIdleRoutedMessage::kMessageName) {
        OnMakeIdle();
    } else if (name == ControlMessages::ServiceShutdownRoutedMessage::kMessageName) {
        OnShutdown();
    } else {
        LogError("Unhandled Control Message | " + name);
    }
}

void ManagedServiceBase::HandleResponseMessage(std::shared_ptr<MessageBus::GenericMessage> message) {
    // The configuration answer to a request of the service's own comes here,
    // to its queue, rather than to the control queue.
    if (message->MessageType() == ConfigurationAnswer::kMessageName) {
        HandleControlMessage(*message);
        return;
    }
    ReceiveUnhandledMessage(std::move(message));
}

void ManagedServiceBase::OnConfiguration(const MessageBus::GenericMessage& message) {
    std::optional<MessageBus::MessageError> error;
    if (message.HasError()) {
        error = CarriedError(message);
    } else {
        ConfigurationKeyValues keyValues;
        try {
            const ConfigurationAnswer answer(message.Headers(), message.Body());
            if (answer.KeyValues()) keyValues = *answer.KeyValues();
        } catch (const std::exception& failure) {
            LogError(std::string("Cannot read the configuration: ") + failure.what());
            SetState(ServiceState::Error);
            return;
        }
        error = ApplyConfiguration(keyValues);
    }
    if (error) {
        if (traceLogger) traceLogger->Error(&*error);
        SetState(ServiceState::Error);
        return;
    }
    bool goLive = false;
    {
        std::lock_guard<std::mutex> lock(stateMutex);
        configurationReceived = true;
        started = true;
        goLive = goLiveWhenReady;
    }
    if (goLive) GoLive();
}

void ManagedServiceBase::OnGoLive(const MessageBus::GenericMessage& message) {
    std::string theirs;
    try {
        const ControlMessages::ServiceGoLiveRoutedMessage request(message.Headers(), message.Body());
        theirs = request.ServiceGuid().value_or(std::string());
    } catch (const std::exception& failure) {
        LogError(std::string("Cannot read the go live request: ") + failure.what());
        return;
    }
    if (!serviceGuid.empty() && serviceGuid != theirs) {
        LogError("Go live request with mis-matched GUID: " + serviceGuid + " " + theirs);
        return;
    }
    bool now = false;
    {
        std::lock_guard<std::mutex> lock(stateMutex);
        if (state == ServiceState::Error) return;
        if (started) {
            now = true;
        } else {
            goLiveWhenReady = true;
        }
    }
    if (now) GoLive();
}

void ManagedServiceBase::OnMakeIdle() {
    {
        std::lock_guard<std::mutex> lock(stateMutex);
        if (state == ServiceState::Error) return;
        goLiveWhenReady = false;
    }
    GoIdle();
}

void ManagedServiceBase::OnShutdown() {
    // On a thread of its own: the shutdown ends the bus this callback runs on.
    std::lock_guard<std::mutex> lock(shutdownMutex);
    if (stopped || shutdownThread) return;
    try {
        shutdownThread = std::make_unique<std::thread>([this] {
            try {
                Shutdown();
            } catch (const std::exception& error) {
                LogError(std::string("The shutdown failed: ") + error.what());
            }
        });
    } catch (const std::system_error&) {
        // No thread to be had: the callback fails, and the bus logs it.
        throw std::runtime_error("boost::thread_resource_error");
    }
}

void ManagedServiceBase::ReceiveUnhandledMessage(std::shared_ptr<MessageBus::GenericMessage> message) {
    if (!traceLogger) return;
    const std::string& name = message->MessageType();
    if (!message->HasError()) {
        MessageBus::TracePoint point;
        try {
            point = traceLogger->GetTracePoint(kUnhandledPoint);
        } catch (const MessageBus::VeldraException&) {
            return;  // the logger is stopped: the service is on its way out
        }
        traceLogger->Log(point, name + ": Origin=" + message->Origin());
        return;
    }
    traceLogger->Error("Unhandled message " + name + ": Origin = " + message->Origin() +
                       " Error = " + CarriedError(*message).Text());
}

}  // namespace Korvane::Veldra::VeldraUtilities
