#include <gtest/gtest.h>

#include <boost/date_time/posix_time/posix_time.hpp>
#include <string>
#include <vector>

#include "messagelibrary/MessageClassCases.h"
#include "messagelibrary/tracelogger/TraceLoggerBroadcastTracePointsRoutedMessage.h"
#include "messagelibrary/tracelogger/TraceLoggerCommandRequest.h"
#include "messagelibrary/tracelogger/TraceLoggerCommandResponse.h"
#include "messagelibrary/tracelogger/TraceLoggerRegisterTracePointRoutedMessage.h"
#include "messagelibrary/tracelogger/TraceLoggerSnapshotBroadcast.h"
#include "messagelibrary/tracelogger/TraceLoggerStoreEntriesRoutedMessage.h"
#include "messagelibrary/tracelogger/TraceLoggerTracePointListRequest.h"
#include "messagelibrary/tracelogger/TraceLoggerTracePointListResponse.h"
#include "support/CatchVeldra.h"

namespace Korvane::Veldra::MessageBus::Testing {
namespace {

using namespace VeldraMessageLibrary;
using namespace VeldraMessageLibrary::TraceLoggerMessages;
using Request = const Interfaces::IRoutingSource&;

const std::vector<TracePointSetting> kSettings{
    {std::string("Client.Rx"), true, JsonStringList{"a", "b"}, std::string("")},
    {std::nullopt, false, std::nullopt, std::nullopt}};
const std::string kSettingsJson =
    R"([{"name":"Client.Rx","enabled":true,"exceptions":["a","b"],"times":""},)"
    R"({"name":null,"enabled":false,"exceptions":null,"times":null}])";

TraceEntry Entry(std::optional<std::string> point, TraceEntryType type) {
    const Timestamp time(boost::gregorian::date(2024, 2, 29), boost::posix_time::seconds(1));
    return {std::string("Client"), time, std::move(point), std::string("line\t1"), type};
}

std::vector<MessageCase> TraceLoggerCases() {
    return {
        MessageCaseOf<TraceLoggerBroadcastTracePointsRoutedMessage>(
            "Veldra.TraceLogger.TraceLoggerBroadcastTracePointsRoutedMessage", "{}",
            [] { return TraceLoggerBroadcastTracePointsRoutedMessage(); }),
        MessageCaseOf<TraceLoggerCommandRequest>(
            "Veldra.TraceLogger.TraceLoggerCommandRequest", R"({"arguments":["list","-v"]})",
            [] {
                return TraceLoggerCommandRequest(JsonStringList{"list", "-v"});
            }),
        MessageCaseOf<TraceLoggerCommandResponse>(
            "Veldra.client_q.TraceLoggerCommandResponse", R"({"responseText":[]})",
            [](Request r) { return TraceLoggerCommandResponse(r, JsonStringList{}); }),
        MessageCaseOf<TraceLoggerRegisterTracePointRoutedMessage>(
            "Veldra.TraceLogger.TraceLoggerRegisterTracePointRoutedMessage",
            R"({"tracePointName":"Client.Rx"})",
            [] { return TraceLoggerRegisterTracePointRoutedMessage(std::string("Client.Rx")); }),
        MessageCaseOf<TraceLoggerSnapshotBroadcast>(
            "Veldra.TraceLoggerSnapshotBroadcast", R"({"settings":)" + kSettingsJson + "}",
            [] { return TraceLoggerSnapshotBroadcast(kSettings); }),
        MessageCaseOf<TraceLoggerStoreEntriesRoutedMessage>(
            "Veldra.TraceLogger.TraceLoggerStoreEntriesRoutedMessage",
            R"({"entries":[{"moduleName":"Client","timestamp":"2024-02-29T00:00:01Z",)"
            R"("tracePointName":null,"text":"line\t1","type":"ERROR"},{"moduleName":"Client",)"
            R"("timestamp":"2024-02-29T00:00:01Z","tracePointName":"Rx","text":"line\t1",)"
            R"("type":"INFO"}]})",
            [] {
                return TraceLoggerStoreEntriesRoutedMessage(
                    std::vector<TraceEntry>{Entry(std::nullopt, TraceEntryType::Error),
                                            Entry(std::string("Rx"), TraceEntryType::Info)});
            }),
        MessageCaseOf<TraceLoggerTracePointListRequest>(
            "Veldra.TraceLogger.TraceLoggerTracePointListRequest", "{}",
            [] { return TraceLoggerTracePointListRequest(); }),
        MessageCaseOf<TraceLoggerTracePointListResponse>(
            "Veldra.client_q.TraceLoggerTracePointListResponse",
            R"({"settings":)" + kSettingsJson + "}",
            [](Request r) { return TraceLoggerTracePointListResponse(r, kSettings); }),
    };
}

INSTANTIATE_TEST_SUITE_P(TraceLoggerMessages, MessageClassTest,
                         ::testing::ValuesIn(TraceLoggerCases()),
                         [](const auto& info) { return info.param.name; });
INSTANTIATE_TEST_SUITE_P(TraceLoggerMessages, MessageResponseTest,
                         ::testing::ValuesIn(ResponsesOf(TraceLoggerCases())),
                         [](const auto& info) { return info.param.name; });

TEST(TraceLoggerMessages, EntryTypesReadTheirTextsAndRefuseOthers) {
    MessageHeaders headers;
    headers.messageType = TraceLoggerStoreEntriesRoutedMessage::kMessageName;
    const auto type = [&](const std::string& json) {
        const std::string body = R"({"entries":[{"type":)" + json + "}]}";
        return TraceLoggerStoreEntriesRoutedMessage(headers, MessageBody(body))
            .Entries()
            ->at(0)
            .type;
    };
    EXPECT_EQ(type(R"("LOG")"), TraceEntryType::Log);
    EXPECT_EQ(type("2"), TraceEntryType::Info);
    EXPECT_EQ(type("null"), std::nullopt);
    for (const char* refused : {R"("WARN")", R"("log")", "[]", "true"}) {
        EXPECT_THROWS_VELDRA(type(refused), -251005, "Failed to parse: entries");
    }
    headers.messageType = TraceLoggerRegisterTracePointRoutedMessage::kMessageName;
    EXPECT_THROWS_VELDRA(TraceLoggerRegisterTracePointRoutedMessage(
                             headers, MessageBody(R"({"tracePointName":[]})")),
                         -251005, "Failed to parse: tracePointName");
}

}  // namespace
}  // namespace Korvane::Veldra::MessageBus::Testing
