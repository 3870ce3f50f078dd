#include <gtest/gtest.h>

#include <string>
#include <utility>
#include <vector>

#include "messagelibrary/MessageClassCases.h"
#include "messagelibrary/audit/AuditAddRoutedMessage.h"
#include "messagelibrary/audit/AuditDeleteRoutedMessage.h"
#include "messagelibrary/audit/AuditQueryRequest.h"
#include "messagelibrary/audit/AuditQueryResponse.h"
#include "messagelibrary/audit/AuditTypeAddRoutedMessage.h"
#include "messagelibrary/audit/AuditTypeDeleteRequest.h"
#include "messagelibrary/audit/AuditTypeDeleteResponse.h"
#include "messagelibrary/audit/AuditTypeListRequest.h"
#include "messagelibrary/audit/AuditTypeListResponse.h"
#include "messagelibrary/configuration/ConfigurationGetKeysRequest.h"
#include "messagelibrary/configuration/ConfigurationGetKeysResponse.h"
#include "messagelibrary/configuration/ConfigurationGetSectionKeyValuesRequest.h"
#include "messagelibrary/configuration/ConfigurationGetSectionKeyValuesResponse.h"
#include "messagelibrary/configuration/ConfigurationGetSectionsRequest.h"
#include "messagelibrary/configuration/ConfigurationGetSectionsResponse.h"
#include "messagelibrary/configuration/ConfigurationGetValueRequest.h"
#include "messagelibrary/configuration/ConfigurationGetValueResponse.h"
#include "messagelibrary/configuration/ConfigurationSetKeysRequest.h"
#include "messagelibrary/configuration/ConfigurationSetKeysResponse.h"
#include "messagelibrary/configuration/ConfigurationSetValueRequest.h"
#include "messagelibrary/configuration/ConfigurationSetValueResponse.h"
#include "messagelibrary/other/OtherSamples.h"
#include "messagelibrary/smtp/SmtpDeleteAddressGroupRequest.h"
#include "messagelibrary/smtp/SmtpDeleteAddressGroupResponse.h"
#include "messagelibrary/smtp/SmtpDeleteTemplateRequest.h"
#include "messagelibrary/smtp/SmtpDeleteTemplateResponse.h"
#include "messagelibrary/smtp/SmtpGetAddressGroupRequest.h"
#include "messagelibrary/smtp/SmtpGetAddressGroupResponse.h"
#include "messagelibrary/smtp/SmtpGetAddressGroupsRequest.h"
#include "messagelibrary/smtp/SmtpGetAddressGroupsResponse.h"
#include "messagelibrary/smtp/SmtpGetTemplateListItemsRequest.h"
#include "messagelibrary/smtp/SmtpGetTemplateListItemsResponse.h"
#include "messagelibrary/smtp/SmtpGetTemplateRequest.h"
#include "messagelibrary/smtp/SmtpGetTemplateResponse.h"
#include "messagelibrary/smtp/SmtpPublishedEmailBroadcast.h"
#include "messagelibrary/smtp/SmtpSendEmailToAddressGroupRoutedMessage.h"
#include "messagelibrary/smtp/SmtpSendTemplatedEmailToAddressGroupsRoutedMessage.h"
#include "messagelibrary/smtp/SmtpUpdateOrCreateAddressGroupRequest.h"
#include "messagelibrary/smtp/SmtpUpdateOrCreateAddressGroupResponse.h"
#include "messagelibrary/smtp/SmtpUpdateOrCreateTemplateRequest.h"
#include "messagelibrary/smtp/SmtpUpdateOrCreateTemplateResponse.h"
#include "messagelibrary/timer/TimerCallbackResponseRoutedMessage.h"
#include "messagelibrary/timer/TimerRegisterCallbackRoutedMessage.h"
#include "messagelibrary/timer/TimerUnregisterCallbackRoutedMessage.h"
#include "messagelibrary/workflow/WorkflowDecisionMadeRequest.h"
#include "messagelibrary/workflow/WorkflowDecisionMadeResponse.h"
#include "messagelibrary/workflow/WorkflowOfferToDecideRequest.h"
#include "messagelibrary/workflow/WorkflowOfferToDecideResponse.h"
#include "messagelibrary/workflow/WorkflowOfferToWorkRequest.h"
#include "messagelibrary/workflow/WorkflowOfferToWorkResponse.h"
#include "messagelibrary/workflow/WorkflowWorkCompleteRequest.h"
#include "messagelibrary/workflow/WorkflowWorkCompleteResponse.h"

namespace Korvane::Veldra::MessageBus::Testing {
namespace {

using namespace VeldraMessageLibrary;
using namespace VeldraMessageLibrary::Testing;
using namespace VeldraMessageLibrary::AuditTrailMessages;
using namespace VeldraMessageLibrary::ConfigurationMessages;
using namespace VeldraMessageLibrary::SmtpMessages;
using namespace VeldraMessageLibrary::TimerMessages;
using namespace VeldraMessageLibrary::WorkflowMessages;
using Request = const Interfaces::IRoutingSource&;

// A request or routed message to service.
template <typename M, typename Make>
MessageCase To(const std::string& service, std::string body, Make make) {
    return MessageCaseOf<M>("Veldra." + service + "." + M::kMessageName, std::move(body), make);
}
// A response to the request of the table, which listens on "client_q".
template <typename M, typename Make>
MessageCase Answer(std::string body, Make make) {
    return To<M>("client_q", std::move(body), make);
}

const JsonStringMap kMap{{"a", "1"}, {"b\"", ""}};
const std::string kMapJson = R"({"a":"1","b\"":""})";
const JsonStringList kCapabilities{"weld", ""};
const std::string kCapabilitiesJson = R"(["weld",""])";

std::vector<MessageCase> AuditCases() {
    const std::string trail = "AuditTrail";
    return {
        To<AuditAddRoutedMessage>(
            trail, R"({"entries":[)" + kAuditEntryJson + "]}",
            [] { return AuditAddRoutedMessage(std::vector{SampleAuditEntry()}); }),
        To<AuditDeleteRoutedMessage>(trail, R"({"id":""})",
                                     [] { return AuditDeleteRoutedMessage(std::string()); }),
        To<AuditQueryRequest>(
            trail, R"({"parameters":)" + kAuditQueryJson + R"(,"takeCount":10,"skipCount":-1})",
            [] { return AuditQueryRequest(SampleAuditQuery(), 10, -1); }),
        Answer<AuditQueryResponse>(
            R"({"entries":[)" + kAuditEntryJson + R"(],"fullCount":7})",
            [](Request r) { return AuditQueryResponse(r, std::vector{SampleAuditEntry()}, 7); }),
        To<AuditTypeAddRoutedMessage>(trail,
                                      R"({"entry":{"shortName":"LOGIN","description":null}})",
                                      [] {
                                          return AuditTypeAddRoutedMessage(
                                              AuditTypeEntry{std::string("LOGIN"), std::nullopt});
                                      }),
        To<AuditTypeDeleteRequest>(trail, R"({"id":"LOGIN"})",
                                   [] { return AuditTypeDeleteRequest(std::string("LOGIN")); }),
        Answer<AuditTypeDeleteResponse>("{}", [](Request r) { return AuditTypeDeleteResponse(r); }),
        To<AuditTypeListRequest>(trail, "{}", [] { return AuditTypeListRequest(); }),
        Answer<AuditTypeListResponse>(
            R"({"entries":[{"shortName":"A","description":"d"}]})",
            [](Request r) {
                return AuditTypeListResponse(
                    r, std::vector{AuditTypeEntry{std::string("A"), std::string("d")}});
            }),
    };
}

std::vector<MessageCase> ConfigurationCases() {
    const std::string configuration = "Configuration";
    return {
        To<ConfigurationGetKeysRequest>(
            configuration, R"({"section":"Bus"})",
            [] { return ConfigurationGetKeysRequest(std::string("Bus")); }),
        Answer<ConfigurationGetKeysResponse>(
            R"({"keys":)" + kMapJson + "}",
            [](Request r) { return ConfigurationGetKeysResponse(r, kMap); }),
        To<ConfigurationGetSectionKeyValuesRequest>(
            configuration, "{}", [] { return ConfigurationGetSectionKeyValuesRequest(); }),
        Answer<ConfigurationGetSectionKeyValuesResponse>(
            R"({"keyValues":[{"section":"Bus","keyValues":)" + kMapJson +
                R"(},{"section":null,"keyValues":{}}]})",
            [](Request r) {
                return ConfigurationGetSectionKeyValuesResponse(
                    r, std::vector<ConfigurationSectionKeyValues>{{std::string("Bus"), kMap},
                                                                  {std::nullopt, JsonStringMap{}}});
            }),
        To<ConfigurationGetSectionsRequest>(configuration, "{}",
                                            [] { return ConfigurationGetSectionsRequest(); }),
        Answer<ConfigurationGetSectionsResponse>(
            R"({"sections":["Bus","Log"]})",
            [](Request r) {
                return ConfigurationGetSectionsResponse(r, JsonStringList{"Bus", "Log"});
            }),
        To<ConfigurationGetValueRequest>(
            configuration, R"({"section":"Bus","key":"Host"})",
            [] { return ConfigurationGetValueRequest(std::string("Bus"), std::string("Host")); }),
        Answer<ConfigurationGetValueResponse>(
            R"({"value":"h1"})",
            [](Request r) { return ConfigurationGetValueResponse(r, std::string("h1")); }),
        To<ConfigurationSetKeysRequest>(
            configuration, R"({"user":"op","section":"Bus","keys":)" + kMapJson + "}",
            [] {
                return ConfigurationSetKeysRequest(std::string("op"), std::string("Bus"), kMap);
            }),
        Answer<ConfigurationSetKeysResponse>(
            "{}", [](Request r) { return ConfigurationSetKeysResponse(r); }),
        To<ConfigurationSetValueRequest>(
            configuration, R"({"user":null,"section":"Bus","key":"Host","value":""})",
            [] {
                return ConfigurationSetValueRequest(std::nullopt, std::string("Bus"),
                                                    std::string("Host"), std::string());
            }),
        Answer<ConfigurationSetValueResponse>(
            "{}", [](Request r) { return ConfigurationSetValueResponse(r); }),
    };
}

std::vector<MessageCase> SmtpCases() {
    const std::string smtp = "Smtp";
    return {
        To<SmtpDeleteAddressGroupRequest>(
            smtp, R"({"id":"g1"})",
            [] { return SmtpDeleteAddressGroupRequest(std::string("g1")); }),
        Answer<SmtpDeleteAddressGroupResponse>(
            "{}", [](Request r) { return SmtpDeleteAddressGroupResponse(r); }),
        To<SmtpDeleteTemplateRequest>(smtp, R"({"id":"t1"})",
                                      [] { return SmtpDeleteTemplateRequest(std::string("t1")); }),
        Answer<SmtpDeleteTemplateResponse>("{}",
                                           [](Request r) { return SmtpDeleteTemplateResponse(r); }),
        To<SmtpGetAddressGroupRequest>(
            smtp, R"({"id":"g1"})", [] { return SmtpGetAddressGroupRequest(std::string("g1")); }),
        Answer<SmtpGetAddressGroupResponse>(
            R"({"addressGroups":)" + kAddressGroupJson + "}",
            [](Request r) { return SmtpGetAddressGroupResponse(r, SampleAddressGroup()); }),
        To<SmtpGetAddressGroupsRequest>(smtp, "{}", [] { return SmtpGetAddressGroupsRequest(); }),
        Answer<SmtpGetAddressGroupsResponse>(R"({"addressGroups":[)" + kAddressGroupJson +
                                                 ",{\"id\":null,\"name\":null,\"toAddresses\":null,"
                                                 "\"ccAddresses\":null,\"bccAddresses\":null}]}",
                                             [](Request r) {
                                                 return SmtpGetAddressGroupsResponse(
                                                     r, std::vector{SampleAddressGroup(),
                                                                    SmtpAddressGroup{}});
                                             }),
        To<SmtpGetTemplateListItemsRequest>(smtp, "{}",
                                            [] { return SmtpGetTemplateListItemsRequest(); }),
        Answer<SmtpGetTemplateListItemsResponse>(
            R"({"templates":[{"id":"t1","name":"alarm","description":""}]})",
            [](Request r) {
                return SmtpGetTemplateListItemsResponse(
                    r, std::vector{SmtpTemplateListItem{std::string("t1"), std::string("alarm"),
                                                        std::string()}});
            }),
        To<SmtpGetTemplateRequest>(smtp, R"({"id":"t1"})",
                                   [] { return SmtpGetTemplateRequest(std::string("t1")); }),
        Answer<SmtpGetTemplateResponse>(
            R"({"templateEntry":)" + kTemplateJson + "}",
            [](Request r) { return SmtpGetTemplateResponse(r, SampleTemplate()); }),
        MessageCaseOf<SmtpPublishedEmailBroadcast>(
            "Veldra.SmtpPublishedEmailBroadcast",
            R"({"addressGroup":)" + kAddressGroupJson + R"(,"subject":"Alarm","contents":"x > 3"})",
            [] {
                return SmtpPublishedEmailBroadcast(SampleAddressGroup(), std::string("Alarm"),
                                                   std::string("x > 3"));
            }),
        To<SmtpSendEmailToAddressGroupRoutedMessage>(
            smtp,
            R"({"templateEntry":)" + kTemplateJson + R"(,"addressGroup":)" + kAddressGroupJson +
                R"(,"fields":)" + kMapJson + "}",
            [] {
                return SmtpSendEmailToAddressGroupRoutedMessage(SampleTemplate(),
                                                                SampleAddressGroup(), kMap);
            }),
        To<SmtpSendTemplatedEmailToAddressGroupsRoutedMessage>(
            smtp, R"({"templateId":"t1","addressGroupId":"g1","fields":{}})",
            [] {
                return SmtpSendTemplatedEmailToAddressGroupsRoutedMessage(
                    std::string("t1"), std::string("g1"), JsonStringMap{});
            }),
        To<SmtpUpdateOrCreateAddressGroupRequest>(
            smtp, R"({"addressGroup":)" + kAddressGroupJson + "}",
            [] { return SmtpUpdateOrCreateAddressGroupRequest(SampleAddressGroup()); }),
        Answer<SmtpUpdateOrCreateAddressGroupResponse>(
            R"({"id":"g1"})",
            [](Request r) { return SmtpUpdateOrCreateAddressGroupResponse(r, std::string("g1")); }),
        To<SmtpUpdateOrCreateTemplateRequest>(
            smtp, R"({"templateEntry":)" + kTemplateJson + "}",
            [] { return SmtpUpdateOrCreateTemplateRequest(SampleTemplate()); }),
        Answer<SmtpUpdateOrCreateTemplateResponse>(
            R"({"id":"t1"})",
            [](Request r) { return SmtpUpdateOrCreateTemplateResponse(r, std::string("t1")); }),
    };
}

std::vector<MessageCase> TimerCases() {
    const std::string timer = "Timer";
    return {
        To<TimerCallbackResponseRoutedMessage>(
            timer, R"({"token":"tk"})",
            [] { return TimerCallbackResponseRoutedMessage(std::string("tk")); }),
        To<TimerRegisterCallbackRoutedMessage>(
            timer, R"({"callbackType":"REPEAT","elapsedMinutes":0.10000000000000001,"token":"tk"})",
            [] {
                return TimerRegisterCallbackRoutedMessage(TimerCallbackType::Repeat, 0.1,
                                                          std::string("tk"));
            }),
        To<TimerUnregisterCallbackRoutedMessage>(
            timer, R"({"token":"tk"})",
            [] { return TimerUnregisterCallbackRoutedMessage(std::string("tk")); }),
    };
}

std::vector<MessageCase> WorkflowCases() {
    const std::string workflow = "Workflow";
    return {
        To<WorkflowDecisionMadeRequest>(
            workflow,
            R"({"workflowName":"wf","nodeName":"n1","jobId":"j1","jobStatus":"OUT_FOR_DECISION","jobProperties":)" +
                kMapJson + R"(,"nextStepName":"s2"})",
            [] {
                return WorkflowDecisionMadeRequest(
                    std::string("wf"), std::string("n1"), std::string("j1"),
                    WorkflowJobStatus::OutForDecision, kMap, std::string("s2"));
            }),
        Answer<WorkflowDecisionMadeResponse>(
            "{}", [](Request r) { return WorkflowDecisionMadeResponse(r); }),
        To<WorkflowOfferToDecideRequest>(
            workflow, R"({"workflowName":"wf","nodeName":"n1","timeoutSeconds":30})",
            [] { return WorkflowOfferToDecideRequest(std::string("wf"), std::string("n1"), 30); }),
        Answer<WorkflowOfferToDecideResponse>(
            R"({"workflowName":"wf","jobId":"j1","jobProperties":)" + kMapJson +
                R"(,"currentStepName":"s1"})",
            [](Request r) {
                return WorkflowOfferToDecideResponse(r, std::string("wf"), std::string("j1"), kMap,
                                                     std::string("s1"));
            }),
        To<WorkflowOfferToWorkRequest>(workflow,
                                       R"({"workflowName":"wf","nodeName":"n1","capabilities":)" +
                                           kCapabilitiesJson + R"(,"timeoutSeconds":-1})",
                                       [] {
                                           return WorkflowOfferToWorkRequest(std::string("wf"),
                                                                             std::string("n1"),
                                                                             kCapabilities, -1);
                                       }),
        Answer<WorkflowOfferToWorkResponse>(
            R"({"workflowName":"wf","jobId":"j1","workStepName":"weld","properties":)" + kMapJson +
                "}",
            [](Request r) {
                return WorkflowOfferToWorkResponse(r, std::string("wf"), std::string("j1"),
                                                   std::string("weld"), kMap);
            }),
        To<WorkflowWorkCompleteRequest>(
            workflow,
            R"({"workflowName":"wf","nodeName":"n1","jobId":"j1","workStepName":"weld","workResult":"TIMEOUT",)"
            R"("completionCode":-7,"outputProperties":)" +
                kMapJson + R"(,"wantMoreWork":true,"capabilities":)" + kCapabilitiesJson +
                R"(,"timeoutSeconds":60})",
            [] {
                return WorkflowWorkCompleteRequest(
                    std::string("wf"), std::string("n1"), std::string("j1"), std::string("weld"),
                    WorkflowWorkResult::Timeout, -7, kMap, true, kCapabilities, 60);
            }),
        Answer<WorkflowWorkCompleteResponse>(
            R"({"workflowName":"wf","jobId":null,"workStepName":"paint","properties":null})",
            [](Request r) {
                return WorkflowWorkCompleteResponse(r, std::string("wf"), std::nullopt,
                                                    std::string("paint"), std::nullopt);
            }),
    };
}

std::vector<MessageCase> OtherCases() {
    std::vector<MessageCase> cases;
    for (auto family : {AuditCases, ConfigurationCases, SmtpCases, TimerCases, WorkflowCases}) {
        for (MessageCase& c : family()) cases.push_back(std::move(c));
    }
    return cases;
}

INSTANTIATE_TEST_SUITE_P(OtherMessages, MessageClassTest, ::testing::ValuesIn(OtherCases()),
                         [](const auto& info) { return info.param.name; });
INSTANTIATE_TEST_SUITE_P(OtherMessages, MessageResponseTest,
                         ::testing::ValuesIn(ResponsesOf(OtherCases())),
                         [](const auto& info) { return info.param.name; });

}  // namespace
}  // namespace Korvane::Veldra::MessageBus::Testing
