// kvveldra-tagservice under a service manager, and its standalone go-live.
#include <gtest/gtest.h>

#include <chrono>
#include <string>

#include "messagebus/BusTestSupport.h"
#include "messagelibrary/taginfo/TagInfoQueryTagsRequest.h"
#include "messagelibrary/taginfo/TagInfoQueryTagsResponse.h"
#include "support/TagServiceProcess.h"
#include "support/TestServiceManager.h"
#include "tagservice/TagServiceClient.h"

namespace Korvane::Veldra::Testing {
namespace {

using VeldraMessageLibrary::ServiceState;

constexpr std::chrono::milliseconds kWait{10000};
constexpr const char* kServiceName = "TagService";

TEST(TagServiceManagedTest, RegistersServesOnlyOnceLiveAndStopsOnTheManagersWord) {
    UseBrokerDataRoot();
    const auto manager = MakeTestManager(10000);
    TestServiceManager serviceManager(*manager);
    const std::string guid = UniqueQueueName("tagservice-guid");

    TagServiceProcess::Options options;
    options.extraArgs = {"--service-guid", guid};
    options.readyLine = "kvveldra-tagservice managed";
    TagServiceProcess service(options);

    const auto registration = serviceManager.AwaitRegistration(kServiceName, kWait);
    ASSERT_TRUE(registration) << service.Output();
    EXPECT_EQ(registration->serviceGuid, guid);
    EXPECT_EQ(registration->processId, service.Pid());
    EXPECT_NE(service.Output().find("control queue " + registration->controlQueue),
              std::string::npos)
        << service.Output();

    // A query sent now waits in the service's queue.
    TagServiceClient client;
    Tags::TagInfoMessages::TagInfoQueryTagsRequest query(std::nullopt, std::nullopt, std::nullopt,
                                                         0, 0, true);
    client.Service().SendRequestAsync(query, 1);
    serviceManager.RequestStatus();
    ASSERT_TRUE(serviceManager.AwaitRegistrationCount(kServiceName, 2, kWait));
    const std::string answer = Tags::TagInfoMessages::TagInfoQueryTagsResponse::kMessageName;
    EXPECT_EQ(client.collector->WaitFor(answer, [](const auto&) { return true; },
                                        std::chrono::milliseconds(0)),
              nullptr);
    EXPECT_EQ(service.Output().find("kvveldra-tagservice ready"), std::string::npos);

    serviceManager.SendConfiguration(registration->controlQueue, {});
    serviceManager.SendGoLive(registration->controlQueue, guid);
    ASSERT_TRUE(serviceManager.AwaitState(kServiceName, ServiceState::Live, kWait))
        << service.Output();
    EXPECT_TRUE(service.WaitForOutput("kvveldra-tagservice ready", kWait));
    EXPECT_TRUE(service.WaitForOutput(
        "Go Live " + std::to_string(service.Pid()) + " - TagService ServiceGuid=" + guid, kWait));
    const MessagePtr reply =
        client.collector->WaitFor(answer, [](const auto&) { return true; }, kWait);
    ASSERT_NE(reply, nullptr);
    EXPECT_EQ(ErrorName(*reply), "");

    serviceManager.SendShutdown(registration->controlQueue);
    EXPECT_TRUE(serviceManager.AwaitState(kServiceName, ServiceState::Stopped, kWait));
    ASSERT_TRUE(service.WaitForOutput("stopped\n", kWait)) << service.Output();
    EXPECT_EQ(service.Stop(), 0) << service.Output();
    EXPECT_NE(service.Output().find("stopping on the manager's shutdown"), std::string::npos);
}

TEST(TagServiceManagedTest, StandaloneItGoesLiveAtOnce) {
    TagServiceProcess service;
    EXPECT_TRUE(service.WaitForOutput(
        "Go Live " + std::to_string(service.Pid()) + " - TagService ServiceGuid=(Standalone)",
        kWait))
        << service.Output();
    EXPECT_EQ(service.Stop(), 0);
}

}  // namespace
}  // namespace Korvane::Veldra::Testing
