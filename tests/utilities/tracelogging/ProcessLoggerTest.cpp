#include <gtest/gtest.h>

#include <chrono>
#include <memory>
#include <string>

#include "FakeServiceCallbacks.h"
#include "messagelibrary/GenericMessage.h"
#include "messagelibrary/tracelogger/TraceLoggerBroadcastTracePointsRoutedMessage.h"
#include "messagelibrary/tracelogger/TraceLoggerSnapshotBroadcast.h"
#include "errors/ErrorCodes.h"
#include "utilities/tracelogging/ProcessLogger.h"
#include "utilities/tracelogging/TraceLogger.h"

namespace Korvane::Veldra::VeldraUtilities::TraceLogging::Testing {
namespace {

using std::chrono::milliseconds;
constexpr milliseconds kPatience{5000};

class ProcessLoggerTest : public ::testing::Test {
protected:
    void Write(const std::string& text) {
        logger->Take("Module", nullptr, text, TraceEntryType::Info);
    }

    std::shared_ptr<FakeServiceCallbacks> bus = std::make_shared<FakeServiceCallbacks>();
    std::shared_ptr<ProcessLogger> logger = std::make_shared<ProcessLogger>("Module", bus, bus);
};

TEST_F(ProcessLoggerTest, StartsByRegisteringForSnapshotsAndAskingForSettings) {
    EXPECT_NE(bus->Broadcast("TraceLoggerSnapshotBroadcast"), nullptr);
    const auto asked = bus->PublishedOf("TraceLoggerBroadcastTracePointsRoutedMessage");
    ASSERT_EQ(asked.size(), 1u);
    EXPECT_FALSE(asked[0].mandatory);
    EXPECT_TRUE(asked[0].ignoreResponse);
}

TEST_F(ProcessLoggerTest, ABurstOfOneMoreThanABufferLosesNothingAndKeepsOrder) {
    constexpr std::size_t kBurst = ProcessLogger::kBufferEntries + 1;
    for (std::size_t i = 0; i < kBurst; ++i) Write(std::to_string(i));
    ASSERT_TRUE(bus->WaitForStoredEntries(kBurst, kPatience));

    const auto batches = bus->PublishedOf("TraceLoggerStoreEntriesRoutedMessage");
    ASSERT_EQ(batches.size(), 2u);
    EXPECT_EQ(batches[0].entries.size(), ProcessLogger::kBufferEntries);
    EXPECT_FALSE(batches[0].mandatory);
    const auto entries = bus->StoredEntries();
    for (std::size_t i = 0; i < kBurst; ++i) {
        ASSERT_EQ(entries[i].text, std::to_string(i));
    }
    EXPECT_EQ(entries[0].moduleName, "Module");
    EXPECT_EQ(entries[0].type, TraceEntryType::Info);
    EXPECT_FALSE(entries[0].tracePointName.has_value());
}

TEST_F(ProcessLoggerTest, ReusedBuffersShipNothingStale) {
    const std::string point = "Module.Point";
    for (std::size_t i = 0; i < ProcessLogger::kBufferEntries; ++i) {
        logger->Take("Module", &point, "first " + std::to_string(i), TraceEntryType::Log);
    }
    ASSERT_TRUE(bus->WaitForStoredEntries(ProcessLogger::kBufferEntries, kPatience));
    // The rotation that ships this one takes the full buffer back from the
    // pool, and the next entry is written over its first.
    Write("between");
    ASSERT_TRUE(bus->WaitForStoredEntries(ProcessLogger::kBufferEntries + 1, kPatience));
    Write("second");
    logger->Stop();
    const auto entries = bus->StoredEntries();
    ASSERT_EQ(entries.size(), ProcessLogger::kBufferEntries + 2);
    EXPECT_EQ(entries.back().text, "second");
    EXPECT_FALSE(entries.back().tracePointName.has_value());
    EXPECT_EQ(entries.back().type, TraceEntryType::Info);
}

TEST_F(ProcessLoggerTest, ASingleEntryLeavesWithinATick) {
    const auto start = std::chrono::steady_clock::now();
    Write("alone");
    ASSERT_TRUE(bus->WaitForStoredEntries(1, kPatience));
    // One tick is 100 ms; the bound leaves room for a loaded machine.
    EXPECT_LT(std::chrono::steady_clock::now() - start, milliseconds(1000));
}

TEST_F(ProcessLoggerTest, StopShipsWhatWasTakenAndDropsWhatComesAfter) {
    for (int i = 0; i < 3; ++i) Write("before " + std::to_string(i));
    logger->Stop();
    EXPECT_EQ(bus->StoredEntries().size(), 3u);
    Write("after");
    logger->Stop();  // a second stop does nothing
    EXPECT_EQ(bus->StoredEntries().size(), 3u);
}

TEST_F(ProcessLoggerTest, ABusFailureLosesOneBatchAndTheThreadGoesOn) {
    bus->FailNext(1, true);
    Write("lost");
    ASSERT_TRUE(bus->WaitForFailures(1, kPatience));
    Write("kept");
    ASSERT_TRUE(bus->WaitForStoredEntries(1, kPatience));
    EXPECT_EQ(bus->StoredEntries()[0].text, "kept");
    EXPECT_EQ(logger->ThreadFailure(), "");
}

TEST_F(ProcessLoggerTest, AnyOtherFailureEndsTheThreadSaysSoOnceAndLaterEntriesAreDropped) {
    ::testing::internal::CaptureStdout();
    bus->FailNext(1, false);
    Write("ends the thread");
    ASSERT_TRUE(bus->WaitForFailures(1, kPatience));
    logger->Stop();  // joins the ended thread
    const std::string console = ::testing::internal::GetCapturedStdout();
    EXPECT_EQ(logger->ThreadFailure(), "not a bus failure");
    EXPECT_NE(console.find(" | Module | ERROR - The trace logging thread ended: not a bus failure\n"),
              std::string::npos)
        << console;
    Write("dropped");
    EXPECT_TRUE(bus->StoredEntries().empty());
}

TEST_F(ProcessLoggerTest, AStoppedLoggerHandsOutNoTracePoint) {
    logger->GetTracePoint("Module.Before");
    logger->Stop();
    EXPECT_THROW(logger->GetTracePoint("Module.After"), MessageBus::VeldraException);
    EXPECT_THROW(logger->GetTracePoint("Module.Before"), MessageBus::VeldraException);
    EXPECT_EQ(bus->PublishedOf("TraceLoggerRegisterTracePointRoutedMessage").size(), 1u);
}

TEST(LoggingWaitFailure, AnInvalidSemaphoreIsAnExceptionWithTheSemaphoresText) {
    const MessageBus::VeldraException invalid(
        ErrorCodes::kInvalidSemaphoreInitialization,
        "Acquire with timeout failed: EINVAL -- Invalid semaphore reference.");
    const auto reported = LoggingWaitFailure(invalid);
    EXPECT_EQ(reported.Code(), -251004);
    EXPECT_STREQ(reported.what(), "Acquire with timeout failed: EINVAL -- Invalid semaphore reference.");
    const MessageBus::VeldraException unsupported(ErrorCodes::kNotSupported, "ENOSYS");
    EXPECT_EQ(LoggingWaitFailure(unsupported).Code(), ErrorCodes::kNotSupported);
}

TEST_F(ProcessLoggerTest, PointsAreAnnouncedOnceAndSnapshotsChangeNone) {
    const auto point = logger->GetTracePoint("Module.Send");
    EXPECT_FALSE(point.enabled);
    EXPECT_EQ(point.name, "Module.Send");
    EXPECT_EQ(point.exceptions, "<unset>");
    EXPECT_EQ(point.times, "<unset>");
    logger->GetTracePoint("Module.Send");
    const auto announced = bus->PublishedOf("TraceLoggerRegisterTracePointRoutedMessage");
    ASSERT_EQ(announced.size(), 1u);
    EXPECT_EQ(announced[0].tracePointName, "Module.Send");

    Messages::TracePointSetting on;
    on.name = "Module.Send";
    on.enabled = true;
    on.times = "always";
    for (auto settings : {std::vector<Messages::TracePointSetting>{on},
                          std::vector<Messages::TracePointSetting>{}}) {
        Messages::TraceLoggerSnapshotBroadcast snapshot(settings);
        bus->Broadcast("TraceLoggerSnapshotBroadcast")
            ->OnMessage(std::make_shared<MessageBus::GenericMessage>(snapshot.Headers(),
                                                                     snapshot.Serialize()));
    }
    const auto after = logger->GetTracePoint("Module.Send");
    EXPECT_FALSE(after.enabled);
    EXPECT_EQ(after.times, "<unset>");
}

}  // namespace
}  // namespace Korvane::Veldra::VeldraUtilities::TraceLogging::Testing
