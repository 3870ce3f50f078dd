// A console call while the tag service is away, and again once it is back.
#include <chrono>

#include "console/ConsoleTestSupport.h"

namespace Korvane::Veldra::Testing {
namespace {

TEST_F(ConsoleBrokerTest, ACallWithoutTheServiceTimesOutAndTheSameCallWorksOnceItIsBack) {
    const uint32_t reference = Open(UniquePath("away"), kDouble);
    const TagConsoleSamples samples{{"2.5", TagConsoleTime(std::chrono::seconds(7))}};
    StopService();

    std::string error;
    const auto start = std::chrono::steady_clock::now();
    EXPECT_EQ(TagConsoleWriteTag(reference, kDouble, &samples, false, &error), kRequestTimedOut);
    const auto waited = std::chrono::steady_clock::now() - start;
    EXPECT_EQ(error, "Request timed out.");
    EXPECT_GE(waited, std::chrono::milliseconds(10000));
    EXPECT_LT(waited, std::chrono::milliseconds(15000));

    StartService();
    error.clear();
    EXPECT_EQ(TagConsoleWriteTag(reference, kDouble, &samples, false, &error), 0) << error;
    EXPECT_EQ(ReadOne(reference).value, "2.5");
    Close(reference);
}

}  // namespace
}  // namespace Korvane::Veldra::Testing
