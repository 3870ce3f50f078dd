// The state rules of a managed service, and what it refuses before any bus.
#include <gtest/gtest.h>
#include <stdlib.h>

#include <optional>
#include <string>

#include "errors/VeldraException.h"
#include "utilities/ServiceEnvironment.h"
#include "utilities/managedservice/ManagedServiceBase.h"
#include "utilities/managedservice/ServiceStateRules.h"

namespace Korvane::Veldra::VeldraUtilities {
namespace {

using VeldraMessageLibrary::ServiceState;

::testing::AssertionResult Leads(std::optional<ServiceState> held, ServiceState requested,
                                 bool store, bool broadcast) {
    const StateChange change = DecideStateChange(held, requested);
    if (change.store == store && change.broadcast == broadcast) {
        return ::testing::AssertionSuccess();
    }
    return ::testing::AssertionFailure()
           << "store " << change.store << ", broadcast " << change.broadcast;
}

TEST(ServiceStateRulesTest, AChangeIsStoredAndBroadcast) {
    EXPECT_TRUE(Leads(std::nullopt, ServiceState::Starting, true, true));
    EXPECT_TRUE(Leads(ServiceState::Registered, ServiceState::Live, true, true));
    EXPECT_TRUE(Leads(ServiceState::Live, ServiceState::Idle, true, true));
    EXPECT_TRUE(Leads(ServiceState::Idle, ServiceState::Error, true, true));
}

TEST(ServiceStateRulesTest, TheSameStateAgainSendsNothing) {
    for (const ServiceState state : {ServiceState::Starting, ServiceState::Live,
                                     ServiceState::Error, ServiceState::Stopped}) {
        EXPECT_TRUE(Leads(state, state, false, false)) << static_cast<int>(state);
    }
}

TEST(ServiceStateRulesTest, ErrorGivesWayOnlyToStopped) {
    for (const ServiceState state : {ServiceState::Live, ServiceState::Idle,
                                     ServiceState::Registered, ServiceState::Starting}) {
        EXPECT_TRUE(Leads(ServiceState::Error, state, false, false)) << static_cast<int>(state);
    }
    EXPECT_TRUE(Leads(ServiceState::Error, ServiceState::Stopped, true, true));
}

TEST(ServiceStateRulesTest, RegisteredIsStoredButNotBroadcast) {
    EXPECT_TRUE(Leads(ServiceState::Starting, ServiceState::Registered, true, false));
    EXPECT_TRUE(Leads(std::nullopt, ServiceState::Registered, true, false));
}

class BareService : public ManagedServiceBase {
public:
    using ManagedServiceBase::ManagedServiceBase;
};

TEST(ManagedServiceBaseTest, SetStateFollowsTheRulesWithoutABus) {
    MessageBus::Semaphore shutdown;
    BareService service(&shutdown);
    EXPECT_EQ(service.State(), std::nullopt);
    EXPECT_EQ(service.GetControlQueueName(), "");
    service.SetState(ServiceState::Registered);
    EXPECT_EQ(service.State(), ServiceState::Registered);
    service.SetState(ServiceState::Error);
    service.SetState(ServiceState::Live);
    EXPECT_EQ(service.State(), ServiceState::Error);
    service.SetState(ServiceState::Stopped);
    EXPECT_EQ(service.State(), ServiceState::Stopped);
}

TEST(ManagedServiceBaseTest, ShutdownPostsTheEventAndStops) {
    MessageBus::Semaphore shutdown;
    BareService service(&shutdown);
    service.SetState(ServiceState::Error);
    service.Shutdown();
    EXPECT_TRUE(shutdown.Acquire(0));
    EXPECT_EQ(service.State(), ServiceState::Stopped);
}

TEST(ManagedServiceBaseTest, RunRefusesANullShutdownEventAndAnEmptyName) {
    BareService withoutEvent(nullptr);
    ManagedServiceOptions options;
    options.serviceName = "Bare";
    try {
        withoutEvent.Run(options);
        ADD_FAILURE() << "Run took a null shutdown event";
    } catch (const MessageBus::VeldraException& error) {
        EXPECT_EQ(error.Code(), -251004);
        EXPECT_STREQ(error.what(), "Shutdown event cannot be null.");
    }
    EXPECT_EQ(withoutEvent.State(), std::nullopt);

    MessageBus::Semaphore shutdown;
    BareService unnamed(&shutdown);
    options.serviceName.clear();
    EXPECT_THROW(unnamed.Run(options), MessageBus::VeldraException);
}

// Sets a variable for the life of the object, and restores it.
class ScopedVariable {
public:
    ScopedVariable(const char* name, const char* value) : name_(name) {
        if (const char* old = getenv(name)) old_ = old;
        if (value != nullptr) {
            setenv(name, value, 1);
        } else {
            unsetenv(name);
        }
    }
    ~ScopedVariable() {
        if (old_) {
            setenv(name_, old_->c_str(), 1);
        } else {
            unsetenv(name_);
        }
    }

private:
    const char* name_;
    std::optional<std::string> old_;
};

TEST(ServiceEnvironmentTest, GuidAndGroupFromTheEnvironmentWithTheirDefaults) {
    {
        ScopedVariable guid("VELDRA_SERVICEGUID", nullptr);
        ScopedVariable group("VELDRA_SERVICE_GROUP_NAME", nullptr);
        EXPECT_EQ(GetServiceGuid(), "");
        EXPECT_EQ(GetServiceGroupName(), "Default");
    }
    ScopedVariable guid("VELDRA_SERVICEGUID", "7f3c");
    ScopedVariable group("VELDRA_SERVICE_GROUP_NAME", "Pumps");
    EXPECT_EQ(GetServiceGuid(), "7f3c");
    EXPECT_EQ(GetServiceGroupName(), "Pumps");
}

}  // namespace
}  // namespace Korvane::Veldra::VeldraUtilities
