#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "messagelibrary/MessageClassCases.h"
#include "messagelibrary/service/ServiceGoLiveRoutedMessage.h"
#include "messagelibrary/service/ServiceMakeIdleRoutedMessage.h"
#include "messagelibrary/service/ServiceSamples.h"
#include "messagelibrary/service/ServiceShutdownRoutedMessage.h"
#include "messagelibrary/service/ServiceStartedBroadcast.h"
#include "messagelibrary/service/ServiceStatusBroadcast.h"
#include "messagelibrary/servicemanager/SvcMgrConsoleWriteLineBroadcast.h"
#include "messagelibrary/servicemanager/SvcMgrGetActorTreeRequest.h"
#include "messagelibrary/servicemanager/SvcMgrGetActorTreeResponse.h"
#include "messagelibrary/servicemanager/SvcMgrGetServiceGroupsRequest.h"
#include "messagelibrary/servicemanager/SvcMgrGetServiceGroupsResponse.h"
#include "messagelibrary/servicemanager/SvcMgrGetServiceInfoSnapshotRequest.h"
#include "messagelibrary/servicemanager/SvcMgrGetServiceInfoSnapshotResponse.h"
#include "messagelibrary/servicemanager/SvcMgrHeartbeatBroadcast.h"
#include "messagelibrary/servicemanager/SvcMgrPurgeStoppedServicesRequestBroadcast.h"
#include "messagelibrary/servicemanager/SvcMgrRegisterLocalServiceRoutedMessage.h"
#include "messagelibrary/servicemanager/SvcMgrReportServicesRequestBroadcast.h"
#include "messagelibrary/servicemanager/SvcMgrReportServicesResponseBroadcast.h"
#include "messagelibrary/servicemanager/SvcMgrRunningServiceManagersRequest.h"
#include "messagelibrary/servicemanager/SvcMgrRunningServiceManagersResponse.h"
#include "messagelibrary/servicemanager/SvcMgrSendServiceStatusRequestBroadcast.h"
#include "messagelibrary/servicemanager/SvcMgrServiceHasShutdownBroadcast.h"
#include "messagelibrary/servicemanager/SvcMgrStartServicesBroadcast.h"
#include "messagelibrary/servicemanager/SvcMgrStopMultipleServicesBroadcast.h"
#include "messagelibrary/servicemanager/SvcMgrStopOneServiceRoutedMessage.h"
#include "messagelibrary/servicemanager/SvcMgrUnavailableLocalServiceRequest.h"
#include "messagelibrary/servicemanager/SvcMgrUnavailableLocalServiceResponse.h"
#include "messagelibrary/servicemanager/SvcMgrUpdateServiceGroupRequest.h"
#include "messagelibrary/servicemanager/SvcMgrUpdateServiceGroupResponse.h"

namespace Korvane::Veldra::MessageBus::Testing {
namespace {

using namespace VeldraMessageLibrary;
using namespace VeldraMessageLibrary::Testing;
using namespace VeldraMessageLibrary::ServiceMessages;
using namespace VeldraMessageLibrary::ServiceManagerMessages;
using Request = const Interfaces::IRoutingSource&;

// The targets a caller names: a service's queue and a node's manager.
const std::string kServiceQueue = "svc_q";
const std::string kManager = "SvcMgr_node1";

std::vector<MessageCase> ServiceCases() {
    const JsonStringList names{"a", ""};
    const std::string namesJson = R"(["a",""])";
    return {
        MessageCaseOf<ServiceGoLiveRoutedMessage>(
            "Veldra.svc_q.ServiceGoLiveRoutedMessage", R"({"serviceGuid":"6f1c"})",
            [] { return ServiceGoLiveRoutedMessage(kServiceQueue, std::string("6f1c")); }),
        MessageCaseOf<ServiceMakeIdleRoutedMessage>(
            "Veldra.svc_q.ServiceMakeIdleRoutedMessage", "{}",
            [] { return ServiceMakeIdleRoutedMessage(kServiceQueue); }),
        MessageCaseOf<ServiceShutdownRoutedMessage>(
            "Veldra.svc_q.ServiceShutdownRoutedMessage", "{}",
            [] { return ServiceShutdownRoutedMessage(kServiceQueue); }),
        MessageCaseOf<ServiceStartedBroadcast>(
            "Veldra.ServiceStartedBroadcast", R"({"service":"Historian","serviceReplyTo":""})",
            [] { return ServiceStartedBroadcast(std::string("Historian"), std::string()); }),
        MessageCaseOf<ServiceStatusBroadcast>(
            "Veldra.ServiceStatusBroadcast",
            R"({"nodeName":"node1","serviceGuid":"6f1c","serviceName":"Historian",)"
            R"("serviceGroupName":"g1","serviceReplyTo":"hist_q","serviceState":"SHUTTING_DOWN"})",
            [] {
                return ServiceStatusBroadcast(std::string("node1"), std::string("6f1c"),
                                              std::string("Historian"), std::string("g1"),
                                              std::string("hist_q"), ServiceState::ShuttingDown);
            }),
        MessageCaseOf<SvcMgrConsoleWriteLineBroadcast>(
            "Veldra.SvcMgrConsoleWriteLineBroadcast", R"({"consoleWrite":"up\n"})",
            [] { return SvcMgrConsoleWriteLineBroadcast(std::string("up\n")); }),
        MessageCaseOf<SvcMgrGetActorTreeRequest>(
            "Veldra.SvcMgr_node1.SvcMgrGetActorTreeRequest", "{}",
            [] { return SvcMgrGetActorTreeRequest(kManager); }),
        MessageCaseOf<SvcMgrGetActorTreeResponse>(
            "Veldra.client_q.SvcMgrGetActorTreeResponse",
            R"({"nodeName":"node1","actorList":)" + namesJson + "}",
            [=](Request r) { return SvcMgrGetActorTreeResponse(r, std::string("node1"), names); }),
        MessageCaseOf<SvcMgrGetServiceGroupsRequest>(
            "Veldra.SvcMgr_node1.SvcMgrGetServiceGroupsRequest", R"({"serviceName":"Historian"})",
            [] { return SvcMgrGetServiceGroupsRequest(kManager, std::string("Historian")); }),
        MessageCaseOf<SvcMgrGetServiceGroupsResponse>(
            "Veldra.client_q.SvcMgrGetServiceGroupsResponse", R"({"groups":[)" + kGroupJson + "]}",
            [](Request r) {
                return SvcMgrGetServiceGroupsResponse(r, std::vector{SampleGroup()});
            }),
        MessageCaseOf<SvcMgrGetServiceInfoSnapshotRequest>(
            "Veldra.SvcMgr_node1.SvcMgrGetServiceInfoSnapshotRequest", "{}",
            [] { return SvcMgrGetServiceInfoSnapshotRequest(kManager); }),
        MessageCaseOf<SvcMgrGetServiceInfoSnapshotResponse>(
            "Veldra.client_q.SvcMgrGetServiceInfoSnapshotResponse",
            R"({"services":)" + kInfosJson + "}",
            [](Request r) { return SvcMgrGetServiceInfoSnapshotResponse(r, SampleInfos()); }),
        MessageCaseOf<SvcMgrHeartbeatBroadcast>(
            "Veldra.SvcMgrHeartbeatBroadcast", R"({"nodeName":"node1"})",
            [] { return SvcMgrHeartbeatBroadcast(std::string("node1")); }),
        MessageCaseOf<SvcMgrPurgeStoppedServicesRequestBroadcast>(
            "Veldra.SvcMgrPurgeStoppedServicesRequestBroadcast", "{}",
            [] { return SvcMgrPurgeStoppedServicesRequestBroadcast(); }),
        MessageCaseOf<SvcMgrRegisterLocalServiceRoutedMessage>(
            "Veldra.SvcMgr_node1.SvcMgrRegisterLocalServiceRoutedMessage",
            R"({"serviceGuid":"6f1c","nodeName":"node1","serviceName":"Historian",)"
            R"("serviceGroupName":null,"replyToQueue":"hist_q","processId":4242})",
            [] {
                return SvcMgrRegisterLocalServiceRoutedMessage(
                    kManager, std::string("6f1c"), std::string("node1"), std::string("Historian"),
                    std::nullopt, std::string("hist_q"), 4242);
            }),
        MessageCaseOf<SvcMgrReportServicesRequestBroadcast>(
            "Veldra.SvcMgrReportServicesRequestBroadcast", R"({"requestingNodeName":"node2"})",
            [] { return SvcMgrReportServicesRequestBroadcast(std::string("node2")); }),
        MessageCaseOf<SvcMgrReportServicesResponseBroadcast>(
            "Veldra.SvcMgrReportServicesResponseBroadcast",
            R"({"nodeName":"node1","services":)" + kInfosJson + "}",
            [] {
                return SvcMgrReportServicesResponseBroadcast(std::string("node1"), SampleInfos());
            }),
        MessageCaseOf<SvcMgrRunningServiceManagersRequest>(
            "Veldra.SvcMgr_node1.SvcMgrRunningServiceManagersRequest", "{}",
            [] { return SvcMgrRunningServiceManagersRequest(kManager); }),
        MessageCaseOf<SvcMgrRunningServiceManagersResponse>(
            "Veldra.client_q.SvcMgrRunningServiceManagersResponse",
            R"({"nodes":[)" + kNodeJson + "]}",
            [](Request r) {
                return SvcMgrRunningServiceManagersResponse(r, std::vector{SampleNode()});
            }),
        MessageCaseOf<SvcMgrSendServiceStatusRequestBroadcast>(
            "Veldra.SvcMgrSendServiceStatusRequestBroadcast", "{}",
            [] { return SvcMgrSendServiceStatusRequestBroadcast(); }),
        MessageCaseOf<SvcMgrServiceHasShutdownBroadcast>(
            "Veldra.SvcMgrServiceHasShutdownBroadcast",
            R"({"service":"Historian","serviceReplyTo":"hist_q"})",
            [] {
                return SvcMgrServiceHasShutdownBroadcast(std::string("Historian"),
                                                         std::string("hist_q"));
            }),
        MessageCaseOf<SvcMgrStartServicesBroadcast>(
            "Veldra.SvcMgrStartServicesBroadcast",
            R"({"allNodes":true,"nodeNames":)" + namesJson +
                R"(,"allServices":false,"serviceNames":[],"instanceCount":2147483647})",
            [=] {
                return SvcMgrStartServicesBroadcast(true, names, false, JsonStringList{},
                                                    2147483647);
            }),
        MessageCaseOf<SvcMgrStopMultipleServicesBroadcast>(
            "Veldra.SvcMgrStopMultipleServicesBroadcast",
            R"({"serviceName":"Historian","nodeName":"node1","kill":true})",
            [] {
                return SvcMgrStopMultipleServicesBroadcast(std::string("Historian"),
                                                           std::string("node1"), true);
            }),
        MessageCaseOf<SvcMgrStopOneServiceRoutedMessage>(
            "Veldra.SvcMgr_node1.SvcMgrStopOneServiceRoutedMessage",
            R"({"processId":-4242,"serviceGuid":"6f1c","kill":true})",
            [] {
                return SvcMgrStopOneServiceRoutedMessage(kManager, -4242, std::string("6f1c"),
                                                         true);
            }),
        MessageCaseOf<SvcMgrUnavailableLocalServiceRequest>(
            "Veldra.SvcMgr_node1.SvcMgrUnavailableLocalServiceRequest",
            R"({"serviceGuid":"6f1c","nodeName":"node1","serviceName":"Historian",)"
            R"("serviceGroupName":"g1","processId":0})",
            [] {
                return SvcMgrUnavailableLocalServiceRequest(
                    kManager, std::string("6f1c"), std::string("node1"), std::string("Historian"),
                    std::string("g1"), 0);
            }),
        MessageCaseOf<SvcMgrUnavailableLocalServiceResponse>(
            "Veldra.client_q.SvcMgrUnavailableLocalServiceResponse", "{}",
            [](Request r) { return SvcMgrUnavailableLocalServiceResponse(r); }),
        MessageCaseOf<SvcMgrUpdateServiceGroupRequest>(
            "Veldra.SvcMgr_node1.SvcMgrUpdateServiceGroupRequest",
            R"({"serviceName":"Historian","group":)" + kGroupJson + "}",
            [] {
                return SvcMgrUpdateServiceGroupRequest(kManager, std::string("Historian"),
                                                       SampleGroup());
            }),
        MessageCaseOf<SvcMgrUpdateServiceGroupResponse>(
            "Veldra.client_q.SvcMgrUpdateServiceGroupResponse", "{}",
            [](Request r) { return SvcMgrUpdateServiceGroupResponse(r); }),
    };
}

INSTANTIATE_TEST_SUITE_P(ServiceMessages, MessageClassTest, ::testing::ValuesIn(ServiceCases()),
                         [](const auto& info) { return info.param.name; });
INSTANTIATE_TEST_SUITE_P(ServiceMessages, MessageResponseTest,
                         ::testing::ValuesIn(ResponsesOf(ServiceCases())),
                         [](const auto& info) { return info.param.name; });

}  // namespace
}  // namespace Korvane::Veldra::MessageBus::Testing
