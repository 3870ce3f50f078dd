// The parsing constructors of the JSON messages. The first
// byte picks the class, the rest is the body. A body either parses or is
// refused with VeldraException (or the conversion failure of a numeric text);
// what parses is written, and when that text parses again it must be written
// with the same bytes.

#include <boost/lexical_cast.hpp>
#include <cstddef>
#include <cstdint>
#include <memory>
#include <string>
#include <utility>

#include "errors/VeldraException.h"
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
#include "messagelibrary/service/ServiceGoLiveRoutedMessage.h"
#include "messagelibrary/service/ServiceMakeIdleRoutedMessage.h"
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
#include "messagelibrary/tagcurrentvalue/TagCvAggregatesResetBroadcast.h"
#include "messagelibrary/tagcurrentvalue/TagCvQueryCurrentValuesByPathRequest.h"
#include "messagelibrary/tagcurrentvalue/TagCvQueryCurrentValuesByPathResponse.h"
#include "messagelibrary/tagcurrentvalue/TagCvResetAggregatesRoutedMessage.h"
#include "messagelibrary/taghistorian/TagHistorianAsyncQueryCompleteRoutedMessage.h"
#include "messagelibrary/taghistorian/TagHistorianAsyncQueryDataRoutedMessage.h"
#include "messagelibrary/taghistorian/TagHistorianAsyncQueryRequest.h"
#include "messagelibrary/taghistorian/TagHistorianAsyncQueryResponse.h"
#include "messagelibrary/taghistorian/TagHistorianAsyncSubscribeRequest.h"
#include "messagelibrary/taghistorian/TagHistorianAsyncSubscribeResponse.h"
#include "messagelibrary/taghistorian/TagHistorianAsyncUnsubscribeRequest.h"
#include "messagelibrary/taghistorian/TagHistorianAsyncUnsubscribeResponse.h"
#include "messagelibrary/taghistorian/TagHistorianAsyncValuesProcessedRoutedMessage.h"
#include "messagelibrary/taghistorian/TagHistorianDeleteValuesByIdRequest.h"
#include "messagelibrary/taghistorian/TagHistorianDeleteValuesByIdResponse.h"
#include "messagelibrary/taghistorian/TagHistorianDeleteValuesByRangeRequest.h"
#include "messagelibrary/taghistorian/TagHistorianDeleteValuesByRangeResponse.h"
#include "messagelibrary/taghistorian/TagHistorianFlushValuesRequest.h"
#include "messagelibrary/taghistorian/TagHistorianFlushValuesResponse.h"
#include "messagelibrary/taghistorian/TagHistorianQueryRequest.h"
#include "messagelibrary/taghistorian/TagHistorianQueryResponse.h"
#include "messagelibrary/taghistorian/TagHistorianUpdateValuesRequest.h"
#include "messagelibrary/taghistorian/TagHistorianUpdateValuesResponse.h"
#include "messagelibrary/taghistorian/TagHistorianValuesProcessedBroadcast.h"
#include "messagelibrary/taghttp/TagHttpCreateSelectionRequest.h"
#include "messagelibrary/taghttp/TagHttpCreateSelectionResponse.h"
#include "messagelibrary/taghttp/TagHttpDeleteSelectionRoutedMessage.h"
#include "messagelibrary/taghttp/TagHttpGetSelectionRequest.h"
#include "messagelibrary/taghttp/TagHttpGetSelectionResponse.h"
#include "messagelibrary/taghttp/TagHttpGetSelectionsRequest.h"
#include "messagelibrary/taghttp/TagHttpGetSelectionsResponse.h"
#include "messagelibrary/taghttp/TagHttpUpdateSelectionRoutedMessage.h"
#include "messagelibrary/taginfo/TagInfoCreateOrUpdateTagsRequest.h"
#include "messagelibrary/taginfo/TagInfoCreateOrUpdateTagsResponse.h"
#include "messagelibrary/taginfo/TagInfoCreateTagRoutedMessage.h"
#include "messagelibrary/taginfo/TagInfoDeleteTagsRoutedMessage.h"
#include "messagelibrary/taginfo/TagInfoDeletedTagsBroadcast.h"
#include "messagelibrary/taginfo/TagInfoQueryTagsRequest.h"
#include "messagelibrary/taginfo/TagInfoQueryTagsResponse.h"
#include "messagelibrary/taginfo/TagInfoTagMetadataUpdatedBroadcast.h"
#include "messagelibrary/taginfo/TagInfoUpdateTagRoutedMessage.h"
#include "messagelibrary/tagingestion/TagNewJournalsWrittenBroadcast.h"
#include "messagelibrary/tagingestion/TagNewTagsIngestedBroadcast.h"
#include "messagelibrary/tagingestion/TagUpdateValuesRoutedMessage.h"
#include "messagelibrary/tagsubscription/TagSubscriptionCommunicatorGetSubscriptionRequest.h"
#include "messagelibrary/tagsubscription/TagSubscriptionCommunicatorGetSubscriptionResponse.h"
#include "messagelibrary/tagsubscription/TagSubscriptionCommunicatorGetSubscriptionsRequest.h"
#include "messagelibrary/tagsubscription/TagSubscriptionCommunicatorGetSubscriptionsResponse.h"
#include "messagelibrary/tagsubscription/TagSubscriptionCommunicatorGetUpdatesRequest.h"
#include "messagelibrary/tagsubscription/TagSubscriptionCommunicatorGetUpdatesResponse.h"
#include "messagelibrary/tagsubscription/TagSubscriptionCommunicatorMessageWrapperRequest.h"
#include "messagelibrary/tagsubscription/TagSubscriptionCommunicatorMessageWrapperResponse.h"
#include "messagelibrary/tagsubscription/TagSubscriptionCommunicatorPushedUpdateRoutedMessage.h"
#include "messagelibrary/tagsubscription/TagSubscriptionCommunicatorSubscribeRequest.h"
#include "messagelibrary/tagsubscription/TagSubscriptionCommunicatorSubscribeResponse.h"
#include "messagelibrary/tagsubscription/TagSubscriptionCommunicatorSubscriptionHeartbeatRequest.h"
#include "messagelibrary/tagsubscription/TagSubscriptionCommunicatorSubscriptionHeartbeatResponse.h"
#include "messagelibrary/tagsubscription/TagSubscriptionCommunicatorUnsubscribeRequest.h"
#include "messagelibrary/tagsubscription/TagSubscriptionCommunicatorUnsubscribeResponse.h"
#include "messagelibrary/timer/TimerCallbackResponseRoutedMessage.h"
#include "messagelibrary/timer/TimerRegisterCallbackRoutedMessage.h"
#include "messagelibrary/timer/TimerUnregisterCallbackRoutedMessage.h"
#include "messagelibrary/tracelogger/TraceLoggerBroadcastTracePointsRoutedMessage.h"
#include "messagelibrary/tracelogger/TraceLoggerCommandRequest.h"
#include "messagelibrary/tracelogger/TraceLoggerCommandResponse.h"
#include "messagelibrary/tracelogger/TraceLoggerRegisterTracePointRoutedMessage.h"
#include "messagelibrary/tracelogger/TraceLoggerSnapshotBroadcast.h"
#include "messagelibrary/tracelogger/TraceLoggerStoreEntriesRoutedMessage.h"
#include "messagelibrary/tracelogger/TraceLoggerTracePointListRequest.h"
#include "messagelibrary/tracelogger/TraceLoggerTracePointListResponse.h"
#include "messagelibrary/workflow/WorkflowDecisionMadeRequest.h"
#include "messagelibrary/workflow/WorkflowDecisionMadeResponse.h"
#include "messagelibrary/workflow/WorkflowOfferToDecideRequest.h"
#include "messagelibrary/workflow/WorkflowOfferToDecideResponse.h"
#include "messagelibrary/workflow/WorkflowOfferToWorkRequest.h"
#include "messagelibrary/workflow/WorkflowOfferToWorkResponse.h"
#include "messagelibrary/workflow/WorkflowWorkCompleteRequest.h"
#include "messagelibrary/workflow/WorkflowWorkCompleteResponse.h"

namespace {

using namespace Korvane::Veldra::VeldraMessageLibrary;
using namespace Korvane::Veldra::MessageBus;

using Parser = std::unique_ptr<MessageBase> (*)(const MessageBody&);

template <typename M>
std::unique_ptr<MessageBase> ParseAs(const MessageBody& body) {
    MessageHeaders headers;
    headers.messageType = M::kMessageName;
    return std::make_unique<M>(std::move(headers), body);
}

// Indexed by the first byte, modulo the count; the seed corpus depends on
// this order.
constexpr Parser kParsers[] = {
    ParseAs<TagIngestionMessages::TagNewJournalsWrittenBroadcast>,
    ParseAs<TagIngestionMessages::TagNewTagsIngestedBroadcast>,
    ParseAs<TagIngestionMessages::TagUpdateValuesRoutedMessage>,
    ParseAs<TagCurrentValueMessages::TagCvAggregatesResetBroadcast>,
    ParseAs<TagCurrentValueMessages::TagCvQueryCurrentValuesByPathRequest>,
    ParseAs<TagCurrentValueMessages::TagCvQueryCurrentValuesByPathResponse>,
    ParseAs<TagCurrentValueMessages::TagCvResetAggregatesRoutedMessage>,
    ParseAs<TagInfoMessages::TagInfoCreateOrUpdateTagsRequest>,
    ParseAs<TagInfoMessages::TagInfoCreateOrUpdateTagsResponse>,
    ParseAs<TagInfoMessages::TagInfoCreateTagRoutedMessage>,
    ParseAs<TagInfoMessages::TagInfoDeleteTagsRoutedMessage>,
    ParseAs<TagInfoMessages::TagInfoDeletedTagsBroadcast>,
    ParseAs<TagInfoMessages::TagInfoQueryTagsRequest>,
    ParseAs<TagInfoMessages::TagInfoQueryTagsResponse>,
    ParseAs<TagInfoMessages::TagInfoTagMetadataUpdatedBroadcast>,
    ParseAs<TagInfoMessages::TagInfoUpdateTagRoutedMessage>,
    ParseAs<TraceLoggerMessages::TraceLoggerBroadcastTracePointsRoutedMessage>,
    ParseAs<TraceLoggerMessages::TraceLoggerCommandRequest>,
    ParseAs<TraceLoggerMessages::TraceLoggerCommandResponse>,
    ParseAs<TraceLoggerMessages::TraceLoggerRegisterTracePointRoutedMessage>,
    ParseAs<TraceLoggerMessages::TraceLoggerSnapshotBroadcast>,
    ParseAs<TraceLoggerMessages::TraceLoggerStoreEntriesRoutedMessage>,
    ParseAs<TraceLoggerMessages::TraceLoggerTracePointListRequest>,
    ParseAs<TraceLoggerMessages::TraceLoggerTracePointListResponse>,
    ParseAs<TagHistorianMessages::TagHistorianAsyncQueryCompleteRoutedMessage>,
    ParseAs<TagHistorianMessages::TagHistorianAsyncQueryDataRoutedMessage>,
    ParseAs<TagHistorianMessages::TagHistorianAsyncQueryRequest>,
    ParseAs<TagHistorianMessages::TagHistorianAsyncQueryResponse>,
    ParseAs<TagHistorianMessages::TagHistorianAsyncSubscribeRequest>,
    ParseAs<TagHistorianMessages::TagHistorianAsyncSubscribeResponse>,
    ParseAs<TagHistorianMessages::TagHistorianAsyncUnsubscribeRequest>,
    ParseAs<TagHistorianMessages::TagHistorianAsyncUnsubscribeResponse>,
    ParseAs<TagHistorianMessages::TagHistorianAsyncValuesProcessedRoutedMessage>,
    ParseAs<TagHistorianMessages::TagHistorianDeleteValuesByIdRequest>,
    ParseAs<TagHistorianMessages::TagHistorianDeleteValuesByIdResponse>,
    ParseAs<TagHistorianMessages::TagHistorianDeleteValuesByRangeRequest>,
    ParseAs<TagHistorianMessages::TagHistorianDeleteValuesByRangeResponse>,
    ParseAs<TagHistorianMessages::TagHistorianFlushValuesRequest>,
    ParseAs<TagHistorianMessages::TagHistorianFlushValuesResponse>,
    ParseAs<TagHistorianMessages::TagHistorianQueryRequest>,
    ParseAs<TagHistorianMessages::TagHistorianQueryResponse>,
    ParseAs<TagHistorianMessages::TagHistorianUpdateValuesRequest>,
    ParseAs<TagHistorianMessages::TagHistorianUpdateValuesResponse>,
    ParseAs<TagHistorianMessages::TagHistorianValuesProcessedBroadcast>,
    ParseAs<TagSubscriptionCommunicatorMessages::TagSubscriptionCommunicatorGetSubscriptionRequest>,
    ParseAs<
        TagSubscriptionCommunicatorMessages::TagSubscriptionCommunicatorGetSubscriptionResponse>,
    ParseAs<
        TagSubscriptionCommunicatorMessages::TagSubscriptionCommunicatorGetSubscriptionsRequest>,
    ParseAs<
        TagSubscriptionCommunicatorMessages::TagSubscriptionCommunicatorGetSubscriptionsResponse>,
    ParseAs<TagSubscriptionCommunicatorMessages::TagSubscriptionCommunicatorGetUpdatesRequest>,
    ParseAs<TagSubscriptionCommunicatorMessages::TagSubscriptionCommunicatorGetUpdatesResponse>,
    ParseAs<TagSubscriptionCommunicatorMessages::TagSubscriptionCommunicatorMessageWrapperRequest>,
    ParseAs<TagSubscriptionCommunicatorMessages::TagSubscriptionCommunicatorMessageWrapperResponse>,
    ParseAs<
        TagSubscriptionCommunicatorMessages::TagSubscriptionCommunicatorPushedUpdateRoutedMessage>,
    ParseAs<TagSubscriptionCommunicatorMessages::TagSubscriptionCommunicatorSubscribeRequest>,
    ParseAs<TagSubscriptionCommunicatorMessages::TagSubscriptionCommunicatorSubscribeResponse>,
    ParseAs<TagSubscriptionCommunicatorMessages::
                TagSubscriptionCommunicatorSubscriptionHeartbeatRequest>,
    ParseAs<TagSubscriptionCommunicatorMessages::
                TagSubscriptionCommunicatorSubscriptionHeartbeatResponse>,
    ParseAs<TagSubscriptionCommunicatorMessages::TagSubscriptionCommunicatorUnsubscribeRequest>,
    ParseAs<TagSubscriptionCommunicatorMessages::TagSubscriptionCommunicatorUnsubscribeResponse>,
    ParseAs<TagHttpMessages::TagHttpCreateSelectionRequest>,
    ParseAs<TagHttpMessages::TagHttpCreateSelectionResponse>,
    ParseAs<TagHttpMessages::TagHttpDeleteSelectionRoutedMessage>,
    ParseAs<TagHttpMessages::TagHttpGetSelectionRequest>,
    ParseAs<TagHttpMessages::TagHttpGetSelectionResponse>,
    ParseAs<TagHttpMessages::TagHttpGetSelectionsRequest>,
    ParseAs<TagHttpMessages::TagHttpGetSelectionsResponse>,
    ParseAs<TagHttpMessages::TagHttpUpdateSelectionRoutedMessage>,
    ParseAs<ServiceMessages::ServiceGoLiveRoutedMessage>,
    ParseAs<ServiceMessages::ServiceMakeIdleRoutedMessage>,
    ParseAs<ServiceMessages::ServiceShutdownRoutedMessage>,
    ParseAs<ServiceMessages::ServiceStartedBroadcast>,
    ParseAs<ServiceMessages::ServiceStatusBroadcast>,
    ParseAs<ServiceManagerMessages::SvcMgrConsoleWriteLineBroadcast>,
    ParseAs<ServiceManagerMessages::SvcMgrGetActorTreeRequest>,
    ParseAs<ServiceManagerMessages::SvcMgrGetActorTreeResponse>,
    ParseAs<ServiceManagerMessages::SvcMgrGetServiceGroupsRequest>,
    ParseAs<ServiceManagerMessages::SvcMgrGetServiceGroupsResponse>,
    ParseAs<ServiceManagerMessages::SvcMgrGetServiceInfoSnapshotRequest>,
    ParseAs<ServiceManagerMessages::SvcMgrGetServiceInfoSnapshotResponse>,
    ParseAs<ServiceManagerMessages::SvcMgrHeartbeatBroadcast>,
    ParseAs<ServiceManagerMessages::SvcMgrPurgeStoppedServicesRequestBroadcast>,
    ParseAs<ServiceManagerMessages::SvcMgrRegisterLocalServiceRoutedMessage>,
    ParseAs<ServiceManagerMessages::SvcMgrReportServicesRequestBroadcast>,
    ParseAs<ServiceManagerMessages::SvcMgrReportServicesResponseBroadcast>,
    ParseAs<ServiceManagerMessages::SvcMgrRunningServiceManagersRequest>,
    ParseAs<ServiceManagerMessages::SvcMgrRunningServiceManagersResponse>,
    ParseAs<ServiceManagerMessages::SvcMgrSendServiceStatusRequestBroadcast>,
    ParseAs<ServiceManagerMessages::SvcMgrServiceHasShutdownBroadcast>,
    ParseAs<ServiceManagerMessages::SvcMgrStartServicesBroadcast>,
    ParseAs<ServiceManagerMessages::SvcMgrStopMultipleServicesBroadcast>,
    ParseAs<ServiceManagerMessages::SvcMgrStopOneServiceRoutedMessage>,
    ParseAs<ServiceManagerMessages::SvcMgrUnavailableLocalServiceRequest>,
    ParseAs<ServiceManagerMessages::SvcMgrUnavailableLocalServiceResponse>,
    ParseAs<ServiceManagerMessages::SvcMgrUpdateServiceGroupRequest>,
    ParseAs<ServiceManagerMessages::SvcMgrUpdateServiceGroupResponse>,
    ParseAs<AuditTrailMessages::AuditAddRoutedMessage>,
    ParseAs<AuditTrailMessages::AuditDeleteRoutedMessage>,
    ParseAs<AuditTrailMessages::AuditQueryRequest>,
    ParseAs<AuditTrailMessages::AuditQueryResponse>,
    ParseAs<AuditTrailMessages::AuditTypeAddRoutedMessage>,
    ParseAs<AuditTrailMessages::AuditTypeDeleteRequest>,
    ParseAs<AuditTrailMessages::AuditTypeDeleteResponse>,
    ParseAs<AuditTrailMessages::AuditTypeListRequest>,
    ParseAs<AuditTrailMessages::AuditTypeListResponse>,
    ParseAs<ConfigurationMessages::ConfigurationGetKeysRequest>,
    ParseAs<ConfigurationMessages::ConfigurationGetKeysResponse>,
    ParseAs<ConfigurationMessages::ConfigurationGetSectionKeyValuesRequest>,
    ParseAs<ConfigurationMessages::ConfigurationGetSectionKeyValuesResponse>,
    ParseAs<ConfigurationMessages::ConfigurationGetSectionsRequest>,
    ParseAs<ConfigurationMessages::ConfigurationGetSectionsResponse>,
    ParseAs<ConfigurationMessages::ConfigurationGetValueRequest>,
    ParseAs<ConfigurationMessages::ConfigurationGetValueResponse>,
    ParseAs<ConfigurationMessages::ConfigurationSetKeysRequest>,
    ParseAs<ConfigurationMessages::ConfigurationSetKeysResponse>,
    ParseAs<ConfigurationMessages::ConfigurationSetValueRequest>,
    ParseAs<ConfigurationMessages::ConfigurationSetValueResponse>,
    ParseAs<SmtpMessages::SmtpDeleteAddressGroupRequest>,
    ParseAs<SmtpMessages::SmtpDeleteAddressGroupResponse>,
    ParseAs<SmtpMessages::SmtpDeleteTemplateRequest>,
    ParseAs<SmtpMessages::SmtpDeleteTemplateResponse>,
    ParseAs<SmtpMessages::SmtpGetAddressGroupRequest>,
    ParseAs<SmtpMessages::SmtpGetAddressGroupResponse>,
    ParseAs<SmtpMessages::SmtpGetAddressGroupsRequest>,
    ParseAs<SmtpMessages::SmtpGetAddressGroupsResponse>,
    ParseAs<SmtpMessages::SmtpGetTemplateListItemsRequest>,
    ParseAs<SmtpMessages::SmtpGetTemplateListItemsResponse>,
    ParseAs<SmtpMessages::SmtpGetTemplateRequest>,
    ParseAs<SmtpMessages::SmtpGetTemplateResponse>,
    ParseAs<SmtpMessages::SmtpPublishedEmailBroadcast>,
    ParseAs<SmtpMessages::SmtpSendEmailToAddressGroupRoutedMessage>,
    ParseAs<SmtpMessages::SmtpSendTemplatedEmailToAddressGroupsRoutedMessage>,
    ParseAs<SmtpMessages::SmtpUpdateOrCreateAddressGroupRequest>,
    ParseAs<SmtpMessages::SmtpUpdateOrCreateAddressGroupResponse>,
    ParseAs<SmtpMessages::SmtpUpdateOrCreateTemplateRequest>,
    ParseAs<SmtpMessages::SmtpUpdateOrCreateTemplateResponse>,
    ParseAs<TimerMessages::TimerCallbackResponseRoutedMessage>,
    ParseAs<TimerMessages::TimerRegisterCallbackRoutedMessage>,
    ParseAs<TimerMessages::TimerUnregisterCallbackRoutedMessage>,
    ParseAs<WorkflowMessages::WorkflowDecisionMadeRequest>,
    ParseAs<WorkflowMessages::WorkflowDecisionMadeResponse>,
    ParseAs<WorkflowMessages::WorkflowOfferToDecideRequest>,
    ParseAs<WorkflowMessages::WorkflowOfferToDecideResponse>,
    ParseAs<WorkflowMessages::WorkflowOfferToWorkRequest>,
    ParseAs<WorkflowMessages::WorkflowOfferToWorkResponse>,
    ParseAs<WorkflowMessages::WorkflowWorkCompleteRequest>,
    ParseAs<WorkflowMessages::WorkflowWorkCompleteResponse>,
};
constexpr std::size_t kParserCount = sizeof(kParsers) / sizeof(kParsers[0]);

// The body written by the parsed message, or nothing when it is refused.
bool ParseAndWrite(Parser parse, const MessageBody& body, std::string& written) {
    try {
        written = parse(body)->Serialize().ToString();
        return true;
    } catch (const VeldraException&) {
    } catch (const boost::bad_lexical_cast&) {
    }
    return false;
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, std::size_t size) {
    if (size == 0) return 0;
    const Parser parse = kParsers[data[0] % kParserCount];
    const MessageBody body(reinterpret_cast<const char*>(data + 1), size - 1);

    std::string first;
    if (!ParseAndWrite(parse, body, first)) return 0;
    std::string second;
    if (ParseAndWrite(parse, MessageBody(first), second) && second != first) __builtin_trap();
    return 0;
}
