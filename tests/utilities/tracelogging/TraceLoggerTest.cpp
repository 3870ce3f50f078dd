#include <gtest/gtest.h>

#include <chrono>
#include <memory>
#include <regex>
#include <string>

#include "FakeServiceCallbacks.h"
#include "messagelibrary/MessageError.h"
#include "utilities/tracelogging/ConsoleLogger.h"
#include "utilities/tracelogging/ProcessLogger.h"
#include "utilities/tracelogging/TraceLogger.h"

namespace Korvane::Veldra::VeldraUtilities::TraceLogging::Testing {
namespace {

using MessageBus::MessageError;
using MessageBus::TracePoint;

class TraceLoggerTest : public ::testing::Test {
protected:
    // Stops the process logger, so that everything taken has gone out.
    std::vector<Messages::TraceEntry> Shipped() {
        process->Stop();
        return bus->StoredEntries();
    }

    std::shared_ptr<FakeServiceCallbacks> bus = std::make_shared<FakeServiceCallbacks>();
    std::shared_ptr<ProcessLogger> process = std::make_shared<ProcessLogger>("Process", bus, bus);
    TraceLogger logger{"Client", process};
};

TEST_F(TraceLoggerTest, ChildNamesAndPointNames) {
    EXPECT_EQ(TraceLogger(logger, "Bus").GetName(), "Client.Bus");
    EXPECT_EQ(TraceLogger(logger, "").GetName(), "Client.");
    EXPECT_EQ(TraceLogger(logger, "Bus").GetTracePoint("Send").name, "Client.Bus.Send");
}

TEST_F(TraceLoggerTest, EntriesCarryTypeModuleAndPoint) {
    TracePoint enabled("Client.Send");
    enabled.enabled = true;
    logger.Log(TracePoint("Client.Quiet"), "not written");
    logger.Log(enabled, "logged");
    logger.Info("informed");
    logger.Error("failed");
    logger.Assert(true, "holds");
    logger.Assert(false, "broken");
    logger.Error(static_cast<const MessageError*>(nullptr));
    const MessageError withInfo = MessageError::Named("Tag.InvalidState", {}, "late reply");
    const MessageError bare = MessageError::Named("Tag.InvalidState");
    logger.Error(&withInfo);
    logger.Error(&bare);

    const auto entries = Shipped();
    ASSERT_EQ(entries.size(), 6u);
    EXPECT_EQ(entries[0].text, "logged");
    EXPECT_EQ(entries[0].type, TraceEntryType::Log);
    EXPECT_EQ(entries[0].tracePointName, "Client.Send");
    EXPECT_EQ(entries[0].moduleName, "Client");
    EXPECT_EQ(entries[1].type, TraceEntryType::Info);
    EXPECT_EQ(entries[2].type, TraceEntryType::Error);
    EXPECT_EQ(entries[3].text, "broken");
    EXPECT_EQ(entries[3].type, TraceEntryType::Error);
    EXPECT_EQ(entries[4].text, "Tag.InvalidState: late reply");
    EXPECT_EQ(entries[5].text, "Tag.InvalidState");
    // The time is taken when the entry is, in UTC.
    const auto age = boost::posix_time::microsec_clock::universal_time() - entries[0].timestamp;
    EXPECT_LT(age.total_seconds(), 60);
}

TEST(ConsoleLoggerTest, PrintsOneLinePerEntry) {
    ConsoleLogger console("Tool");
    EXPECT_FALSE(console.GetTracePoint("Send").enabled);
    testing::internal::CaptureStdout();
    console.Log(TracePoint("Tool.Send"), "sent");
    console.Error("failed");
    console.Info("told");
    console.Error(static_cast<const MessageError*>(nullptr));
    console.Assert(true, "holds");
    const std::string out = testing::internal::GetCapturedStdout();
    const std::regex lines(
        "\\d{4}-\\d\\d-\\d\\dT\\d\\d:\\d\\d:\\d\\d(\\.\\d+)?Z \\| Tool \\| Tool.Send \\| sent\n"
        "[^|]+Z \\| Tool \\| ERROR - failed\n"
        "[^|]+Z \\| Tool \\| told\n");
    EXPECT_TRUE(std::regex_match(out, lines)) << out;
}

}  // namespace
}  // namespace Korvane::Veldra::VeldraUtilities::TraceLogging::Testing
