// The managed service base on the broker: its states as the manager sees them
// on the wire, and its answers to each control message.
#include <gtest/gtest.h>
#include <unistd.h>

#include <algorithm>
#include <chrono>
#include <memory>
#include <string>

#include "managedservice/ManagedTestService.h"
#include "messagebus/BusTestSupport.h"
#include "support/BrokerEnvironment.h"
#include "support/RawAmqpConnection.h"
#include "support/TagServiceProcess.h"
#include "support/TestServiceManager.h"

namespace Korvane::Veldra::Testing {
namespace {

using VeldraMessageLibrary::ServiceState;
using std::chrono::milliseconds;

constexpr milliseconds kWait{10000};

// The messages in the queue on the broker, by a passive declaration from a
// connection of the test's own; -1 when it cannot tell.
int64_t QueueDepth(const std::string& queue) {
    RawAmqpConnection raw;
    if (raw.OpenTcp(Broker().Host, Broker().AmqpPort) != 0 ||
        !raw.Login(Broker().User, Broker().Password) || !raw.OpenChannel(1)) {
        return -1;
    }
    const amqp_queue_declare_ok_t* declared = amqp_queue_declare(
        raw.Get(), 1, amqp_cstring_bytes(queue.c_str()), 1, 0, 0, 0, amqp_empty_table);
    return declared == nullptr ? -1 : static_cast<int64_t>(declared->message_count);
}

// Deletes a queue through a connection of the test's own.
void DeleteQueue(const std::string& queue) {
    RawAmqpConnection raw;
    if (raw.OpenTcp(Broker().Host, Broker().AmqpPort) != 0 ||
        !raw.Login(Broker().User, Broker().Password) || !raw.OpenChannel(1)) {
        return;
    }
    amqp_queue_delete(raw.Get(), 1, amqp_cstring_bytes(queue.c_str()), 0, 0);
}

class ManagedServiceTest : public ::testing::Test {
protected:
    void SetUp() override {
        // The node name comes from the same data root as in a service child.
        UseBrokerDataRoot();
        manager_ = MakeTestManager(10000);
        serviceManager_ = std::make_unique<TestServiceManager>(*manager_);
        service_ = std::make_unique<ManagedTestService>(&shutdown_, *manager_);
        options_.serviceName = UniqueQueueName("ManagedTest");
        options_.serviceGuid = "guid-" + options_.serviceName;
        options_.connectionManager = manager_.get();
        options_.echoLogger = service_->Log();
    }

    // The work queue is durable: it would outlive the test.
    void TearDown() override {
        const std::string workQueue = service_ ? service_->WorkQueue() : std::string();
        service_.reset();
        if (!workQueue.empty()) DeleteQueue(workQueue);
    }

    // Runs the service, asks for the status as a manager does, and waits for
    // the registration that answers it.
    void RunManaged() {
        service_->Run(options_);
        serviceManager_->RequestStatus();
        ASSERT_TRUE(serviceManager_->AwaitRegistration(Name(), kWait));
    }

    // Every control message sent before this one has been handled once it
    // returns: the status request is answered by a registration, in order.
    void Barrier() {
        const std::size_t before = serviceManager_->RegistrationCount(Name());
        serviceManager_->RequestStatus();
        ASSERT_TRUE(serviceManager_->AwaitRegistrationCount(Name(), before + 1, kWait));
    }

    void Configure() {
        serviceManager_->SendConfiguration(Control(), {});
        ASSERT_TRUE(service_->AwaitConfiguration(kWait));
    }

    bool Broadcast(ServiceState state) {
        return serviceManager_->AwaitState(Name(), state, kWait).has_value();
    }

    std::vector<ServiceState> States() { return serviceManager_->States(Name()); }
    const std::string& Name() const { return options_.serviceName; }
    std::string Control() const { return service_->GetControlQueueName(); }
    std::string Pid() const { return std::to_string(getpid()); }

    std::unique_ptr<MessageBus::AmqpConnectionManager> manager_;
    std::unique_ptr<TestServiceManager> serviceManager_;
    MessageBus::Semaphore shutdown_;
    std::unique_ptr<ManagedTestService> service_;
    VeldraUtilities::ManagedServiceOptions options_;
};

TEST_F(ManagedServiceTest, TheStatesOfALifeOnTheWire) {
    RunManaged();
    const auto registration = serviceManager_->AwaitRegistration(Name(), kWait);
    EXPECT_EQ(registration->serviceGuid, *options_.serviceGuid);
    EXPECT_EQ(registration->controlQueue, Control());
    EXPECT_EQ(registration->serviceGroupName, "Default");
    EXPECT_EQ(registration->processId, getpid());
    EXPECT_EQ(Control(), service_->Service()->QueueName() + "_Control");
    EXPECT_EQ(service_->State(), ServiceState::Registered);

    // Work waits in its queue until the service is live.
    serviceManager_->SendBareMessage(service_->WorkQueue(), "WorkRoutedMessage", "work-1");
    VeldraMessageLibrary::ConfigurationMessages::ConfigurationSectionKeyValues section;
    section.section = "Limits";
    section.keyValues = VeldraMessageLibrary::JsonStringMap{{"Max", "3"}};
    serviceManager_->SendConfiguration(Control(), {section});
    const auto applied = service_->AwaitConfiguration(kWait);
    ASSERT_TRUE(applied);
    ASSERT_EQ(applied->size(), 1u);
    EXPECT_EQ(applied->front().keyValues->at("Max"), "3");
    EXPECT_FALSE(service_->AwaitWork("work-1", milliseconds(0)));

    serviceManager_->SendGoLive(Control(), options_.serviceGuid);
    ASSERT_TRUE(Broadcast(ServiceState::Live));
    EXPECT_TRUE(service_->Log()->AwaitLine(
        "INFO", "Go Live " + Pid() + " - " + Name() + " ServiceGuid=" + *options_.serviceGuid,
        kWait));
    EXPECT_TRUE(serviceManager_->AwaitAudit(Name(), "Live", kWait));
    EXPECT_TRUE(service_->AwaitWork("work-1", kWait));

    serviceManager_->SendMakeIdle(Control());
    ASSERT_TRUE(Broadcast(ServiceState::Idle));
    EXPECT_TRUE(service_->Log()->AwaitLine("INFO", "Idled " + Pid() + " - " + Name(), kWait));
    const auto idleAudit = serviceManager_->AwaitAudit(Name(), "Idle", kWait);
    ASSERT_TRUE(idleAudit);
    EXPECT_EQ(idleAudit->recordType, "Service");

    serviceManager_->SendShutdown(Control());
    ASSERT_TRUE(shutdown_.Acquire(10000));
    ASSERT_TRUE(Broadcast(ServiceState::Stopped));
    // The owner's wait is over: the service goes, its shutdown thread with it.
    service_.reset();

    // STARTING is only stored and REGISTERED is told by the registration:
    // neither is broadcast.
    EXPECT_EQ(States(), (std::vector<ServiceState>{ServiceState::Live, ServiceState::Idle,
                                                   ServiceState::Stopped}));
}

TEST_F(ManagedServiceTest, WorkWaitsInTheBrokersQueueBeforeGoingLiveAndWhileIdle) {
    RunManaged();
    Configure();
    serviceManager_->SendBareMessage(service_->WorkQueue(), "WorkRoutedMessage", "early");
    Barrier();
    // Not delivered to the process before it goes live: the broker keeps it.
    EXPECT_EQ(QueueDepth(service_->WorkQueue()), 1);
    serviceManager_->SendGoLive(Control(), options_.serviceGuid);
    EXPECT_TRUE(service_->AwaitWork("early", kWait));

    serviceManager_->SendMakeIdle(Control());
    ASSERT_TRUE(Broadcast(ServiceState::Idle));
    serviceManager_->SendBareMessage(service_->WorkQueue(), "WorkRoutedMessage", "while-idle");
    Barrier();
    EXPECT_FALSE(service_->AwaitWork("while-idle", milliseconds(0)));
    EXPECT_EQ(QueueDepth(service_->WorkQueue()), 1);
    serviceManager_->SendGoLive(Control(), options_.serviceGuid);
    EXPECT_TRUE(service_->AwaitWork("while-idle", kWait));
}

TEST_F(ManagedServiceTest, TheServiceAsksForItsConfigurationAtEachRegistrationUntilAnswered) {
    // Where a configuration service would listen.
    TestConsumer configurationService(*manager_, "Configuration");
    auto& inbox = configurationService.callback->messages;
    const auto isRequest = [](const std::shared_ptr<GenericMessage>& message) {
        return message->MessageType() == "ConfigurationGetSectionKeyValuesRequest";
    };
    RunManaged();
    const auto first = inbox.WaitFor(isRequest, kWait);
    ASSERT_TRUE(first);
    // The answer is to come to the control queue.
    EXPECT_EQ((*first)->ReplyTo(), Control());

    Barrier();  // registered again with no answer yet: asked again
    EXPECT_TRUE(inbox.WaitForCount(isRequest, 2, kWait));
    Configure();
    Barrier();
    Barrier();
    EXPECT_EQ(inbox.CountOf(isRequest), 2u) << "asked again after the answer came";
}

TEST_F(ManagedServiceTest, AnErrorInTheConfigurationAnswerHoldsUntilStopped) {
    RunManaged();
    serviceManager_->SendConfigurationError(
        Control(),
        MessageBus::MessageError::Named("Veldra.ConfigDirectoryNotFound", {}, "no such section"));
    ASSERT_TRUE(Broadcast(ServiceState::Error));
    EXPECT_TRUE(service_->Log()->AwaitLine("ERROR", "Veldra.ConfigDirectoryNotFound: no such section",
                                           kWait))
        << ::testing::PrintToString(service_->Log()->Lines());

    serviceManager_->SendGoLive(Control(), options_.serviceGuid);
    serviceManager_->SendMakeIdle(Control());
    Barrier();
    EXPECT_EQ(service_->State(), ServiceState::Error);
    service_->SetState(ServiceState::Live);
    EXPECT_EQ(service_->State(), ServiceState::Error);

    serviceManager_->SendShutdown(Control());
    ASSERT_TRUE(Broadcast(ServiceState::Stopped));
    EXPECT_EQ(States(), (std::vector<ServiceState>{ServiceState::Error,
                                                   ServiceState::Stopped}));
}

TEST_F(ManagedServiceTest, AConfigurationTheServiceRefusesIsAnError) {
    service_->RefuseConfigurationWith(
        MessageBus::MessageError::Named("Tag.InvalidConfiguraion", {}, "Max too large"));
    RunManaged();
    serviceManager_->SendConfiguration(Control(), {});
    ASSERT_TRUE(Broadcast(ServiceState::Error));
    EXPECT_TRUE(service_->Log()->AwaitLine("ERROR", "Max too large", kWait));
}

TEST_F(ManagedServiceTest, AGoLiveWithAForeignGuidChangesNothing) {
    RunManaged();
    Configure();
    serviceManager_->SendBareMessage(service_->WorkQueue(), "WorkRoutedMessage", "work-2");
    serviceManager_->SendGoLive(Control(), std::string("someone-else"));
    EXPECT_TRUE(service_->Log()->AwaitLine(
        "ERROR", "Go live request with mis-matched GUID: " + *options_.serviceGuid + " someone-else",
        kWait));
    Barrier();
    EXPECT_EQ(service_->State(), ServiceState::Registered);
    EXPECT_FALSE(service_->AwaitWork("work-2", milliseconds(0)));
    EXPECT_TRUE(States().empty());
}

TEST_F(ManagedServiceTest, AGoLiveBeforeTheConfigurationTakesEffectOnceItIsApplied) {
    RunManaged();
    serviceManager_->SendGoLive(Control(), options_.serviceGuid);
    Barrier();
    EXPECT_EQ(service_->State(), ServiceState::Registered);

    serviceManager_->SendConfiguration(Control(), {});
    EXPECT_TRUE(Broadcast(ServiceState::Live));
}

TEST_F(ManagedServiceTest, AMakeIdleCancelsAGoLiveThatWaitsForTheConfiguration) {
    RunManaged();
    serviceManager_->SendGoLive(Control(), options_.serviceGuid);
    serviceManager_->SendMakeIdle(Control());
    ASSERT_TRUE(Broadcast(ServiceState::Idle));
    Configure();
    Barrier();
    // The status request registers again; the go-live never came through.
    EXPECT_EQ(States(), (std::vector<ServiceState>{ServiceState::Idle}));
}

TEST_F(ManagedServiceTest, WithAnEmptyOwnGuidAnyGoLiveIsTaken) {
    options_.serviceGuid = std::string();
    // This time the manager answers the registration with the configuration.
    serviceManager_->AnswerRegistrationsWith({});
    RunManaged();
    ASSERT_TRUE(service_->AwaitConfiguration(kWait));
    serviceManager_->SendGoLive(Control(), std::string("whatever-guid"));
    ASSERT_TRUE(Broadcast(ServiceState::Live));
    EXPECT_TRUE(service_->Log()->AwaitLine("INFO", " ServiceGuid=<empty>", kWait));
}

TEST_F(ManagedServiceTest, RunStartsTheBusAloneAndAStandaloneServiceGoesLiveWhenItSaysSo) {
    options_.standalone = true;
    serviceManager_->SendBareMessage(service_->WorkQueue(), "WorkRoutedMessage", "early");
    service_->Run(options_);
    // Run neither registers nor goes live: the work waits in its queue.
    EXPECT_EQ(service_->State(), ServiceState::Starting);
    EXPECT_FALSE(service_->AwaitWork("early", milliseconds(0)));
    service_->GoLive();
    ASSERT_TRUE(Broadcast(ServiceState::Live));
    EXPECT_TRUE(service_->AwaitWork("early", kWait));
    EXPECT_TRUE(service_->Log()->AwaitLine(
        "INFO", "Go Live " + Pid() + " - " + Name() + " ServiceGuid=(Standalone)", kWait));
    EXPECT_EQ(serviceManager_->RegistrationCount(Name()), 0u);
}

TEST_F(ManagedServiceTest, OtherMessagesAreLoggedByName) {
    RunManaged();
    serviceManager_->SendBareMessage(Control(), "SomethingElseRoutedMessage", "c-1");
    EXPECT_TRUE(service_->Log()->AwaitLine(
        "ERROR", "Unhandled Control Message | SomethingElseRoutedMessage", kWait));
    // On the service's own queue, a message nobody asked for is traced.
    serviceManager_->SendBareMessage(service_->Service()->QueueName(), "StrayRoutedMessage", "s-1");
    EXPECT_TRUE(service_->Log()->AwaitLine("LOG", "StrayRoutedMessage: Origin=ServiceManager", kWait));
}

TEST_F(ManagedServiceTest, AShutdownRequestedTwiceStopsOnceAndTheOwnerIsNotHeld) {
    RunManaged();
    serviceManager_->SendShutdown(Control());
    serviceManager_->SendShutdown(Control());
    ASSERT_TRUE(shutdown_.Acquire(10000));
    ASSERT_TRUE(Broadcast(ServiceState::Stopped));
    service_.reset();
    const auto states = States();
    EXPECT_EQ(std::count(states.begin(), states.end(), ServiceState::Stopped), 1);
}

}  // namespace
}  // namespace Korvane::Veldra::Testing
