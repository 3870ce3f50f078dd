#include "console/ConsoleTestSupport.h"

#include <unistd.h>

#include <atomic>

namespace Korvane::Veldra::Testing {

SuiteTagService& ConsoleBrokerTest::Suite() {
    static SuiteTagService suite{"kvveldra-console"};
    return suite;
}

void ConsoleBrokerTest::SetUp() {
    ASSERT_TRUE(Suite().EnsureSuite(StartSuite)) << "the tag service or the instance did not start (see above)";
}

void ConsoleBrokerTest::StartSuite() {
    // Before the first initialize: the library reads the data root once.
    UseBrokerDataRoot();
    StartService();
    bool reserved = false;
    ASSERT_EQ(TagConsoleReserve(&reserved), 0);
    std::string error;
    ASSERT_EQ(TagConsoleInitialize(0, nullptr, nullptr, nullptr, &error), 0) << error;
}

void ConsoleBrokerTest::TearDownTestSuite() {
    bool reserved = true;
    TagConsoleUnreserve(&reserved);
    StopService();
}

void ConsoleBrokerTest::StartService() {
    Suite().Start();
}

void ConsoleBrokerTest::StopService() {
    Suite().Stop();
}

std::string ConsoleBrokerTest::UniquePath(const std::string& stem) {
    static std::atomic<int> counter{0};
    return "console." + std::to_string(getpid()) + "." + std::to_string(++counter) + "." + stem;
}

uint32_t ConsoleBrokerTest::Open(const std::string& path, int32_t type) {
    uint32_t reference = 0;
    std::string error;
    EXPECT_EQ(TagConsoleOpen(0, &path, type, false, &reference, &error), 0) << path << ": " << error;
    EXPECT_NE(reference, 0u);
    return reference;
}

void ConsoleBrokerTest::Write(uint32_t reference, int32_t type, const std::string& value,
                              TagConsoleTime timestamp) {
    const TagConsoleSamples samples{{value, timestamp}};
    std::string error;
    EXPECT_EQ(TagConsoleWriteTag(reference, type, &samples, false, &error), 0) << error;
}

TagConsoleValue ConsoleBrokerTest::ReadOne(uint32_t reference) {
    const std::vector<uint32_t> references{reference};
    std::vector<TagConsoleValue> results;
    std::string error;
    EXPECT_EQ(TagConsoleReadValues(0, &references, false, 0, &results, &error), 0) << error;
    EXPECT_EQ(results.size(), 1u);
    return results.empty() ? TagConsoleValue{} : results.front();
}

void ConsoleBrokerTest::Close(uint32_t reference, int count) {
    for (int i = 0; i < count; ++i) {
        std::string error;
        EXPECT_EQ(TagConsoleClose(reference, false, &error), 0) << "close " << i + 1 << ": " << error;
    }
}

}  // namespace Korvane::Veldra::Testing
