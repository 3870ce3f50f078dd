#include "support/TestServiceManager.h"

#include <functional>
#include <utility>

#include "messagebus/interfaces/FunctionBroadcastCallback.h"
#include "messagebus/service/MessageServiceSettings.h"
#include "messagelibrary/audit/AuditAddRoutedMessage.h"
#include "messagelibrary/audit/AuditTrailService.h"
#include "messagelibrary/configuration/ConfigurationGetSectionKeyValuesResponse.h"
#include "messagelibrary/service/ServiceGoLiveRoutedMessage.h"
#include "messagelibrary/service/ServiceMakeIdleRoutedMessage.h"
#include "messagelibrary/service/ServiceShutdownRoutedMessage.h"
#include "messagelibrary/service/ServiceStatusBroadcast.h"
#include "messagelibrary/servicemanager/SvcMgrRegisterLocalServiceRoutedMessage.h"
#include "messagelibrary/servicemanager/SvcMgrSendServiceStatusRequestBroadcast.h"
#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/RoutedMessage.h"
#include "utilities/NodeIdentity.h"

namespace Korvane::Veldra::Testing {

namespace {

namespace Library = VeldraMessageLibrary;
using Library::ServiceState;

// Where a configuration answer goes: the control queue, as if the service
// had asked from there.
class ControlRoute : public MessageBus::Interfaces::IRoutingSource {
public:
    explicit ControlRoute(std::string controlQueue) : replyTo_(std::move(controlQueue)) {}
    const std::string& CorrelationId() const override { return correlationId_; }
    const std::string& ReplyTo() const override { return replyTo_; }

private:
    const std::string correlationId_;
    const std::string replyTo_;
};

// A routed message with an empty body, of any name.
class BareRoutedMessage : public MessageBus::RoutedMessage {
public:
    BareRoutedMessage(const std::string& type, const std::string& target)
        : RoutedMessage(type, MessageBus::kJsonContentType, target) {}
    MessageBus::MessageBody Serialize() const override { return MessageBus::MessageBody("{}"); }
};

}  // namespace

TestServiceManager::TestServiceManager(MessageBus::AmqpConnectionManager& manager) {
    MessageBus::MessageServiceSettings settings;
    // Its queue is ServiceManager_<node>, where services register.
    settings.Name = "ServiceManager";
    settings.InstanceId = VeldraUtilities::GetNodeName();
    settings.ConnectionManager = &manager;
    settings.AutoStart = false;
    service_ = std::make_unique<MessageBus::MessageService>(settings);

    const auto on = [this](void (TestServiceManager::*record)(const MessageBus::GenericMessage&)) {
        auto handler = std::make_shared<MessageBus::Interfaces::FunctionBroadcastCallback>(
            [this, record](const MessageBus::GenericMessage& message) { (this->*record)(message); });
        handlers_.push_back(handler);
        return handler;
    };
    service_->Subscriber()->RegisterMessageCallback(
        Library::ServiceManagerMessages::SvcMgrRegisterLocalServiceRoutedMessage::kMessageName,
        on(&TestServiceManager::OnRegistration), false);
    service_->RegisterBroadcast(Library::ServiceMessages::ServiceStatusBroadcast::kMessageName,
                                on(&TestServiceManager::OnStatus));
    service_->Subscriber()->Bind({Library::AuditTrailMessages::kAuditTrailService, "#"});
    service_->Subscriber()->RegisterMessageCallback(
        Library::AuditTrailMessages::AuditAddRoutedMessage::kMessageName,
        on(&TestServiceManager::OnAudit), false);
    service_->Subscriber()->StartConsuming();
}

TestServiceManager::~TestServiceManager() {
    service_.reset();
}

void TestServiceManager::AnswerRegistrationsWith(KeyValues keyValues) {
    std::lock_guard<std::mutex> lock(mutex_);
    answer_ = std::move(keyValues);
}

// ---- Commands ----

void TestServiceManager::SendConfiguration(const std::string& controlQueue, KeyValues keyValues) {
    Library::ConfigurationMessages::ConfigurationGetSectionKeyValuesResponse answer(
        ControlRoute(controlQueue), std::move(keyValues));
    service_->Publish(answer);
}

void TestServiceManager::SendConfigurationError(const std::string& controlQueue,
                                                const MessageBus::MessageError& error) {
    Library::ConfigurationMessages::ConfigurationGetSectionKeyValuesResponse answer(
        ControlRoute(controlQueue), error);
    service_->Publish(answer);
}

void TestServiceManager::SendGoLive(const std::string& controlQueue,
                                    std::optional<std::string> serviceGuid) {
    Library::ServiceMessages::ServiceGoLiveRoutedMessage message(controlQueue,
                                                                 std::move(serviceGuid));
    service_->Publish(message);
}

void TestServiceManager::SendMakeIdle(const std::string& controlQueue) {
    Library::ServiceMessages::ServiceMakeIdleRoutedMessage message(controlQueue);
    service_->Publish(message);
}

void TestServiceManager::SendShutdown(const std::string& controlQueue) {
    Library::ServiceMessages::ServiceShutdownRoutedMessage message(controlQueue);
    service_->Publish(message);
}

void TestServiceManager::SendBareMessage(const std::string& target,
                                         const std::string& messageType,
                                         const std::string& correlationId) {
    BareRoutedMessage message(messageType, target);
    message.SetCorrelationId(correlationId);
    service_->Publish(message);
}

void TestServiceManager::RequestStatus() {
    Library::ServiceManagerMessages::SvcMgrSendServiceStatusRequestBroadcast message;
    service_->Publish(message);
}

// ---- Records ----

void TestServiceManager::OnRegistration(const MessageBus::GenericMessage& received) {
    const Library::ServiceManagerMessages::SvcMgrRegisterLocalServiceRoutedMessage message(
        received.Headers(), received.Body());
    Registration registration{message.ServiceGuid().value_or(""),
                              message.NodeName().value_or(""),
                              message.ServiceName().value_or(""),
                              message.ServiceGroupName().value_or(""),
                              message.ReplyToQueue().value_or(""),
                              message.ProcessId()};
    std::optional<KeyValues> answer;
    {
        std::lock_guard<std::mutex> lock(mutex_);
        registrations_.push_back(registration);
        answer = answer_;
    }
    changed_.notify_all();
    if (answer) SendConfiguration(registration.controlQueue, std::move(*answer));
}

void TestServiceManager::OnStatus(const MessageBus::GenericMessage& received) {
    const Library::ServiceMessages::ServiceStatusBroadcast message(received.Headers(),
                                                                   received.Body());
    Status status{message.ServiceName().value_or(""),    message.ServiceGuid().value_or(""),
                  message.NodeName().value_or(""),       message.ServiceGroupName().value_or(""),
                  message.ServiceReplyTo().value_or(""), message.ServiceState().value_or(
                                                             ServiceState::Unknown)};
    {
        std::lock_guard<std::mutex> lock(mutex_);
        statuses_.push_back(std::move(status));
    }
    changed_.notify_all();
}

void TestServiceManager::OnAudit(const MessageBus::GenericMessage& received) {
    const Library::AuditTrailMessages::AuditAddRoutedMessage message(received.Headers(),
                                                                     received.Body());
    {
        std::lock_guard<std::mutex> lock(mutex_);
        for (const auto& entry : message.Entries().value_or(
                 std::vector<Library::AuditTrailMessages::AuditEntry>{})) {
            audits_.push_back({entry.originator.value_or(""), entry.recordType.value_or(""),
                               entry.detail.value_or("")});
        }
    }
    changed_.notify_all();
}

template <typename Match, typename Item>
std::optional<Item> TestServiceManager::Await(const std::vector<Item>& items, Match match,
                                              std::chrono::milliseconds timeout) {
    std::optional<Item> found;
    std::unique_lock<std::mutex> lock(mutex_);
    changed_.wait_for(lock, timeout, [&] {
        for (const Item& item : items) {
            if (match(item)) {
                found = item;
                return true;
            }
        }
        return false;
    });
    return found;
}

std::optional<TestServiceManager::Registration> TestServiceManager::AwaitRegistration(
    const std::string& serviceName, std::chrono::milliseconds timeout) {
    return Await(
        registrations_, [&](const Registration& item) { return item.serviceName == serviceName; },
        timeout);
}

std::optional<TestServiceManager::Status> TestServiceManager::AwaitState(
    const std::string& serviceName, ServiceState state, std::chrono::milliseconds timeout) {
    return Await(
        statuses_,
        [&](const Status& item) { return item.serviceName == serviceName && item.state == state; },
        timeout);
}

std::optional<TestServiceManager::Audit> TestServiceManager::AwaitAudit(
    const std::string& serviceName, const std::string& detail, std::chrono::milliseconds timeout) {
    return Await(
        audits_,
        [&](const Audit& item) { return item.originator == serviceName && item.detail == detail; },
        timeout);
}

std::vector<ServiceState> TestServiceManager::States(const std::string& serviceName) const {
    std::lock_guard<std::mutex> lock(mutex_);
    std::vector<ServiceState> states;
    for (const Status& status : statuses_) {
        if (status.serviceName == serviceName) states.push_back(status.state);
    }
    return states;
}

std::size_t TestServiceManager::CountLocked(const std::string& serviceName) const {
    std::size_t count = 0;
    for (const Registration& registration : registrations_) {
        if (registration.serviceName == serviceName) ++count;
    }
    return count;
}

std::size_t TestServiceManager::RegistrationCount(const std::string& serviceName) const {
    std::lock_guard<std::mutex> lock(mutex_);
    return CountLocked(serviceName);
}

bool TestServiceManager::AwaitRegistrationCount(const std::string& serviceName, std::size_t count,
                                                std::chrono::milliseconds timeout) {
    std::unique_lock<std::mutex> lock(mutex_);
    return changed_.wait_for(lock, timeout, [&] { return CountLocked(serviceName) >= count; });
}

}  // namespace Korvane::Veldra::Testing
