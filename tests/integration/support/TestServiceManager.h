#pragma once

#include <chrono>
#include <condition_variable>
#include <memory>
#include <mutex>
#include <optional>
#include <string>
#include <vector>

#include "messagebus/amqp/AmqpConnectionManager.h"
#include "messagebus/service/MessageService.h"
#include "messagelibrary/MessageError.h"
#include "messagelibrary/ServiceEnums.h"
#include "messagelibrary/configuration/ConfigurationRecords.h"

namespace Korvane::Veldra::Testing {

// The service manager of this node, as far as tests of managed services need
// one: it consumes "ServiceManager_" + node name, records registrations, the
// ServiceStatusBroadcasts and the audit entries it sees, and sends a
// service's control queue the configuration answer, go-live, make-idle and
// shutdown on command.
class TestServiceManager {
public:
    using KeyValues =
        std::vector<VeldraMessageLibrary::ConfigurationMessages::ConfigurationSectionKeyValues>;

    struct Registration {
        std::string serviceGuid;
        std::string nodeName;
        std::string serviceName;
        std::string serviceGroupName;
        std::string controlQueue;
        int32_t processId = 0;
    };
    struct Status {
        std::string serviceName;
        std::string serviceGuid;
        std::string nodeName;
        std::string serviceGroupName;
        std::string replyTo;
        VeldraMessageLibrary::ServiceState state = VeldraMessageLibrary::ServiceState::Unknown;
    };
    struct Audit {
        std::string originator;
        std::string recordType;
        std::string detail;
    };

    // Declares and binds its queue and starts consuming.
    explicit TestServiceManager(MessageBus::AmqpConnectionManager& manager);
    ~TestServiceManager();
    TestServiceManager(const TestServiceManager&) = delete;
    TestServiceManager& operator=(const TestServiceManager&) = delete;

    // From now on each registration is answered with this configuration.
    void AnswerRegistrationsWith(KeyValues keyValues);

    // ---- Commands to a service's control queue ----
    void SendConfiguration(const std::string& controlQueue, KeyValues keyValues);
    void SendConfigurationError(const std::string& controlQueue,
                                const MessageBus::MessageError& error);
    void SendGoLive(const std::string& controlQueue, std::optional<std::string> serviceGuid);
    void SendMakeIdle(const std::string& controlQueue);
    void SendShutdown(const std::string& controlQueue);
    // A routed message of any name with an empty body and the correlation
    // id, to any queue.
    void SendBareMessage(const std::string& target, const std::string& messageType,
                         const std::string& correlationId);
    // The broadcast that asks every service to register again.
    void RequestStatus();

    // ---- What came, each awaited with a deadline ----
    std::optional<Registration> AwaitRegistration(const std::string& serviceName,
                                                  std::chrono::milliseconds timeout);
    // The first broadcast of that state from the service.
    std::optional<Status> AwaitState(const std::string& serviceName,
                                     VeldraMessageLibrary::ServiceState state,
                                     std::chrono::milliseconds timeout);
    std::optional<Audit> AwaitAudit(const std::string& serviceName, const std::string& detail,
                                    std::chrono::milliseconds timeout);
    // Every state the service broadcast so far, in order.
    std::vector<VeldraMessageLibrary::ServiceState> States(const std::string& serviceName) const;
    std::size_t RegistrationCount(const std::string& serviceName) const;
    // True once the service has registered count times in all.
    bool AwaitRegistrationCount(const std::string& serviceName, std::size_t count,
                                std::chrono::milliseconds timeout);

private:
    void OnRegistration(const MessageBus::GenericMessage& message);
    void OnStatus(const MessageBus::GenericMessage& message);
    void OnAudit(const MessageBus::GenericMessage& message);
    std::size_t CountLocked(const std::string& serviceName) const;
    template <typename Match, typename Item>
    std::optional<Item> Await(const std::vector<Item>& items, Match match,
                              std::chrono::milliseconds timeout);

    mutable std::mutex mutex_;
    std::condition_variable changed_;
    std::vector<Registration> registrations_;
    std::vector<Status> statuses_;
    std::vector<Audit> audits_;
    std::optional<KeyValues> answer_;
    std::vector<std::shared_ptr<MessageBus::Interfaces::IBroadcastCallback>> handlers_;
    // Last, so that it goes first: no handler runs once the members are gone.
    std::unique_ptr<MessageBus::MessageService> service_;
};

}  // namespace Korvane::Veldra::Testing
