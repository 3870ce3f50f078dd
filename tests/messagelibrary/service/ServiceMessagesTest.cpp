#include <gtest/gtest.h>

#include <functional>
#include <optional>
#include <string>
#include <vector>

#include "messagelibrary/MessageBodyChecks.h"
#include "messagelibrary/ServiceEnums.h"
#include "messagelibrary/service/ServiceGoLiveRoutedMessage.h"
#include "messagelibrary/service/ServiceSamples.h"
#include "messagelibrary/service/ServiceStatusBroadcast.h"
#include "messagelibrary/servicemanager/SvcMgrGetActorTreeResponse.h"
#include "messagelibrary/servicemanager/SvcMgrGetServiceInfoSnapshotResponse.h"
#include "messagelibrary/servicemanager/SvcMgrRunningServiceManagersResponse.h"
#include "messagelibrary/servicemanager/SvcMgrStartServicesBroadcast.h"
#include "messagelibrary/servicemanager/SvcMgrStopOneServiceRoutedMessage.h"
#include "messagelibrary/servicemanager/SvcMgrUpdateServiceGroupRequest.h"
#include "support/CatchVeldra.h"

namespace Korvane::Veldra::VeldraMessageLibrary {
namespace {

using Testing::ExpectRefusals;
using Testing::Parse;
using namespace ServiceMessages;
using namespace ServiceManagerMessages;
using MessageBus::MessageBody;

TEST(ServiceMessages, ARunningServiceHasAnUnsetStopTime) {
    const auto services =
        *Parse<SvcMgrGetServiceInfoSnapshotResponse>(R"({"services":)" + Testing::kInfosJson + "}")
             .Services();
    ASSERT_EQ(services.size(), 2u);
    EXPECT_TRUE(services[0].HasStopped());
    EXPECT_EQ(services[0].stopTime, Testing::ServiceTime(2500));
    EXPECT_FALSE(services[1].HasStopped());
    EXPECT_TRUE(services[1].stopTime.is_not_a_date_time());
    EXPECT_EQ(services[1].serviceState, ServiceState::Live);
}

TEST(ServiceMessages, ServiceStateReadsItsTextsAndAnyNumber) {
    const auto state = [](const std::string& json) {
        return Parse<ServiceStatusBroadcast>(R"({"serviceState":)" + json + "}").ServiceState();
    };
    EXPECT_EQ(state(R"("LIVE")"), ServiceState::Live);
    EXPECT_EQ(static_cast<int32_t>(*state(R"("LIVE")")), 7);
    EXPECT_EQ(state("12"), ServiceState::Stopped);
    EXPECT_EQ(state(R"("AWAITING_DEPS")"), ServiceState::AwaitingDeps);
    EXPECT_EQ(state("null"), std::nullopt);
}

TEST(ServiceMessages, RefusedFieldsNameTheKeyWithTheCodeOfItsType) {
    const auto status = Parse<ServiceStatusBroadcast>;
    const auto start = Parse<SvcMgrStartServicesBroadcast>;
    const auto stop = Parse<SvcMgrStopOneServiceRoutedMessage>;
    const auto update = Parse<SvcMgrUpdateServiceGroupRequest>;
    const auto snapshot = Parse<SvcMgrGetServiceInfoSnapshotResponse>;
    ExpectRefusals({
        {status, R"({"serviceState":"RUNNING"})", -251004, "serviceState"},
        {status, R"({"serviceState":"live"})", -251004, "serviceState"},
        {status, R"({"serviceState":true})", -251004, "serviceState"},
        {status, R"({"nodeName":1})", -251005, "nodeName"},
        {Parse<ServiceGoLiveRoutedMessage>, R"({"serviceGuid":{}})", -251005, "serviceGuid"},
        {start, R"({"allNodes":"true"})", -251005, "allNodes"},
        {start, R"({"nodeNames":"n1"})", -251005, "nodeNames"},
        {start, R"({"instanceCount":1e10})", -251005, "instanceCount"},
        {stop, R"({"processId":null})", -251005, "processId"},
        {stop, R"({"kill":1})", -251005, "kill"},
        {update, R"({"group":[]})", -251004, "group"},
        {update, R"({"group":{"startMode":"SOMETIMES"}})", -251004, "group"},
        {update, R"({"group":{"environmentVariables":{"a":1}}})", -251004, "group"},
        {Parse<SvcMgrGetActorTreeResponse>, R"({"actorList":[1]})", -251005, "actorList"},
        {snapshot, R"({"services":[{"stopTime":"yesterday"}]})", -251005, "services"},
        {snapshot, R"({"services":[{"serviceDescriptor":{"dependsOn":[{"onSameNode":0}]}}]})",
         -251005, "services"},
        {Parse<SvcMgrRunningServiceManagersResponse>, R"({"nodes":[{"status":"UP"}]})", -251005,
         "nodes"},
    });
}

TEST(ServiceMessages, EnumerationsHaveTheirTextsInOrder) {
    struct Case {
        JsonEnumTexts texts;
        std::vector<const char*> expected;
    };
    const std::vector<Case> cases = {
        {JsonEnumTextsOf(ServiceManagerStatus{}), {"UP_NORMAL", "MISSED_HEARTBEAT", "DEAD"}},
        {JsonEnumTextsOf(ServiceState{}),
         {"UNKNOWN", "DISABLED", "MANUAL", "AWAITING_DEPS", "STARTING", "REGISTERED", "IDLE",
          "LIVE", "ERROR", "UNRESPONSIVE", "DEAD", "SHUTTING_DOWN", "STOPPED"}},
        {JsonEnumTextsOf(ServiceLaunchState{}),
         {"DISABLED", "AWAIT_REGISTRATION", "AWAITING_DEPENDENCIES", "READY_TO_LAUNCH",
          "REGISTERED", "LAUNCHING", "ATTACHING", "RUNNING", "FAILED"}},
        {JsonEnumTextsOf(ServiceLaunchInput{}), {"PATH", "ARGUMENTS"}},
        {JsonEnumTextsOf(ServiceStartMode{}), {"UNKNOWN", "DISABLED", "AUTO", "MANUAL"}},
        {JsonEnumTextsOf(ServiceStartType{}), {"VELDRA_SERVICE", "EXECUTABLE"}},
    };
    for (const Case& c : cases) {
        const int32_t count = static_cast<int32_t>(c.expected.size());
        for (int32_t value = 0; value < count; ++value) {
            SCOPED_TRACE(c.expected[value]);
            EXPECT_STREQ(c.texts.TextOf(value), c.expected[value]);
        }
        EXPECT_EQ(c.texts.TextOf(count), nullptr);
    }
}

}  // namespace
}  // namespace Korvane::Veldra::VeldraMessageLibrary
