#include <gtest/gtest.h>

#include <cmath>
#include <functional>
#include <limits>
#include <optional>
#include <string>
#include <vector>

#include "messagelibrary/MessageBodyChecks.h"
#include "messagelibrary/audit/AuditAddRoutedMessage.h"
#include "messagelibrary/audit/AuditQueryRequest.h"
#include "messagelibrary/audit/AuditTypeAddRoutedMessage.h"
#include "messagelibrary/configuration/ConfigurationGetSectionKeyValuesResponse.h"
#include "messagelibrary/configuration/ConfigurationSetKeysRequest.h"
#include "messagelibrary/smtp/SmtpGetAddressGroupResponse.h"
#include "messagelibrary/smtp/SmtpGetAddressGroupsResponse.h"
#include "messagelibrary/smtp/SmtpPublishedEmailBroadcast.h"
#include "messagelibrary/timer/TimerCallbackResponseRoutedMessage.h"
#include "messagelibrary/timer/TimerRegisterCallbackRoutedMessage.h"
#include "messagelibrary/timer/TimerUnregisterCallbackRoutedMessage.h"
#include "messagelibrary/workflow/WorkflowDecisionMadeRequest.h"
#include "messagelibrary/workflow/WorkflowOfferToWorkRequest.h"
#include "messagelibrary/workflow/WorkflowWorkCompleteRequest.h"
#include "support/CatchVeldra.h"

namespace Korvane::Veldra::VeldraMessageLibrary {
namespace {

using Testing::ExpectRefusals;
using Testing::Parse;
using Testing::Written;
using namespace AuditTrailMessages;
using namespace ConfigurationMessages;
using namespace SmtpMessages;
using namespace TimerMessages;
using namespace WorkflowMessages;
using MessageBus::MessageBody;

TEST(TimerMessages, ElapsedMinutesIsWrittenBareWithUpTo17Digits) {
    const double inf = std::numeric_limits<double>::infinity();
    const struct {
        double minutes;
        const char* text;
    } cases[] = {
        {1.5, "1.5"},          {0.1, "0.10000000000000001"},
        {-0.0, "-0"},          {1e300, "1.0000000000000001e+300"},
        {std::nan(""), "NaN"}, {inf, "Infinity"},
        {-inf, "-Infinity"},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(c.text);
        EXPECT_EQ(Written(TimerRegisterCallbackRoutedMessage(TimerCallbackType::Single, c.minutes,
                                                             std::nullopt)),
                  std::string(R"({"callbackType":"SINGLE","elapsedMinutes":)") + c.text +
                      R"(,"token":null})");
    }
    // The bare forms are no JSON: a body written with them cannot be read back.
    EXPECT_THROWS_VELDRA(
        Parse<TimerRegisterCallbackRoutedMessage>(R"({"elapsedMinutes":Infinity})"), -251005,
        "Failed to parse: TimerRegisterCallbackRoutedMessage");
    const auto minutes = [](const char* json) {
        return Parse<TimerRegisterCallbackRoutedMessage>(std::string(R"({"elapsedMinutes":)") +
                                                         json + "}")
            .ElapsedMinutes();
    };
    EXPECT_TRUE(std::isnan(minutes(R"("NaN")")));
    EXPECT_EQ(minutes(R"("-Infinity")"), -inf);
    EXPECT_EQ(minutes("0.10000000000000001"), 0.1);
}

TEST(TimerMessages, ANullTokenReadsUnsetAndIsWrittenNull) {
    const auto unregister = Parse<TimerUnregisterCallbackRoutedMessage>(R"({"token":null})");
    EXPECT_FALSE(unregister.Token().has_value());
    EXPECT_EQ(Written(unregister), R"({"token":null})");
    // The call back returns the token as it was registered, empty included.
    const auto registered = Parse<TimerRegisterCallbackRoutedMessage>(R"({"token":""})");
    EXPECT_EQ(Written(TimerCallbackResponseRoutedMessage(registered.Token())), R"({"token":""})");
}

TEST(SmtpMessages, OneAddressGroupAndAListShareThePluralKey) {
    const std::string group = R"({"id":"g","name":null,"toAddresses":["a@x"],)"
                              R"("ccAddresses":null,"bccAddresses":null})";
    const auto one = Parse<SmtpGetAddressGroupResponse>(R"({"addressGroups":)" + group + "}");
    EXPECT_EQ(one.AddressGroups()->toAddresses, (JsonStringList{"a@x"}));
    const auto all =
        Parse<SmtpGetAddressGroupsResponse>(R"({"addressGroups":[)" + group + "," + group + "]}");
    EXPECT_EQ(all.AddressGroups()->size(), 2u);
    EXPECT_EQ(Written(all), R"({"addressGroups":[)" + group + "," + group + "]}");
}

TEST(WorkflowMessages, EnumerationsWriteTheirTexts) {
    const std::vector<const char*> statuses = {
        "UNKNOWN",       "JUST_SUBMITTED", "NEEDS_DECISION",     "OUT_FOR_DECISION", "NEEDS_WORK",
        "OUT_FOR_WORK",  "STEP_TIMED_OUT", "DECISION_TIMED_OUT", "WORK_TIMED_OUT",   "JOB_CANCELED",
        "JOB_COMPLETED", "JOB_TIMED_OUT",  "JOB_FAILED"};
    for (int32_t value = 0; value < static_cast<int32_t>(statuses.size()); ++value) {
        const WorkflowDecisionMadeRequest request(std::nullopt, std::nullopt, std::nullopt,
                                                  static_cast<WorkflowJobStatus>(value),
                                                  std::nullopt, std::nullopt);
        const std::string text = std::string("\"") + statuses[value] + "\"";
        EXPECT_NE(Written(request).find(R"("jobStatus":)" + text), std::string::npos) << text;
        EXPECT_EQ(Parse<WorkflowDecisionMadeRequest>(R"({"jobStatus":)" + text + "}").JobStatus(),
                  static_cast<WorkflowJobStatus>(value));
    }
    const std::vector<const char*> results = {"UNKNOWN", "SUCCESS", "FAILURE", "TIMEOUT"};
    for (int32_t value = 0; value < 4; ++value) {
        const auto parsed = Parse<WorkflowWorkCompleteRequest>(std::string(R"({"workResult":")") +
                                                               results[value] + "\"}");
        EXPECT_EQ(parsed.WorkResult(), static_cast<WorkflowWorkResult>(value));
    }
    const JsonEnumTexts kinds = JsonEnumTextsOf(WorkflowStepKind{});
    EXPECT_STREQ(kinds.TextOf(0), "UNKNOWN");
    EXPECT_STREQ(kinds.TextOf(1), "WORK");
    EXPECT_STREQ(kinds.TextOf(2), "DECIDE");
    EXPECT_EQ(
        Parse<TimerRegisterCallbackRoutedMessage>(R"({"callbackType":"REPEAT"})").CallbackType(),
        TimerCallbackType::Repeat);
}

TEST(OtherMessages, RefusedFieldsNameTheKeyWithTheCodeOfItsType) {
    const auto timer = Parse<TimerRegisterCallbackRoutedMessage>;
    const auto decision = Parse<WorkflowDecisionMadeRequest>;
    const auto complete = Parse<WorkflowWorkCompleteRequest>;
    const auto query = Parse<AuditQueryRequest>;
    const auto one = Parse<SmtpGetAddressGroupResponse>;
    ExpectRefusals({
        {timer, R"({"callbackType":"ONCE"})", -251004, "callbackType"},
        {timer, R"({"callbackType":"repeat"})", -251004, "callbackType"},
        {timer, R"({"elapsedMinutes":null})", -251005, "elapsedMinutes"},
        {timer, R"({"elapsedMinutes":[]})", -251005, "elapsedMinutes"},
        {timer, R"({"token":1})", -251005, "token"},
        {decision, R"({"jobStatus":"DONE"})", -251004, "jobStatus"},
        {decision, R"({"jobProperties":{"a":1}})", -251005, "jobProperties"},
        {complete, R"({"workResult":true})", -251004, "workResult"},
        {complete, R"({"wantMoreWork":null})", -251005, "wantMoreWork"},
        {complete, R"({"capabilities":[1]})", -251005, "capabilities"},
        {complete, R"({"completionCode":1e10})", -251005, "completionCode"},
        {Parse<WorkflowOfferToWorkRequest>, R"({"timeoutSeconds":true})", -251005,
         "timeoutSeconds"},
        {query, R"({"parameters":[]})", -251004, "parameters"},
        {query, R"({"parameters":{"queryUsingInts":[true]}})", -251004, "parameters"},
        {query, R"({"parameters":{"orderByDescending":true}})", -251004, "parameters"},
        {query, R"({"parameters":{"timestampTo":"yesterday"}})", -251004, "parameters"},
        {query, R"({"takeCount":[]})", -251005, "takeCount"},
        {Parse<AuditAddRoutedMessage>, R"({"entries":{}})", -251005, "entries"},
        {Parse<AuditAddRoutedMessage>, R"({"entries":[{"int1":null}]})", -251005, "entries"},
        {Parse<AuditTypeAddRoutedMessage>, R"({"entry":{"shortName":1}})", -251004, "entry"},
        {Parse<ConfigurationSetKeysRequest>, R"({"keys":["a"]})", -251005, "keys"},
        {Parse<ConfigurationGetSectionKeyValuesResponse>, R"({"keyValues":[{"keyValues":[]}]})",
         -251005, "keyValues"},
        {one, R"({"addressGroups":[]})", -251004, "addressGroups"},
        {one, R"({"addressGroups":{"ccAddresses":"a@x"}})", -251004, "addressGroups"},
        {Parse<SmtpGetAddressGroupsResponse>, R"({"addressGroups":{}})", -251005, "addressGroups"},
        {Parse<SmtpPublishedEmailBroadcast>, R"({"subject":false})", -251005, "subject"},
    });
}

}  // namespace
}  // namespace Korvane::Veldra::VeldraMessageLibrary
