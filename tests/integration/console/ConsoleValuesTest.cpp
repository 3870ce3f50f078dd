// Writing and reading values through the exported console functions.
#include <chrono>
#include <thread>

#include "console/ConsoleTestSupport.h"

namespace Korvane::Veldra::Testing {
namespace {

using std::chrono::microseconds;

TagConsoleTime At(int64_t micros) {
    return TagConsoleTime(microseconds(micros));
}

TEST_F(ConsoleBrokerTest, EachTypeKeepsItsValueTextAndTimestamp) {
    struct Case {
        int32_t type;
        std::string value;
    };
    const Case cases[] = {
        {kDouble, "0.10000000000000001"},
        {kDouble, "NaN"},
        {kDouble, "Infinity"},
        {kDouble, "-Infinity"},
        {kInt, "2147483647"},
        {kInt, "-2147483648"},
        {kUInt64, "18446744073709551615"},
        {kBoolean, "True"},
        {kBoolean, "False"},
        {kString, "say \"hi\" to C:\\tags\\ \xC3\xA5 \xE2\x82\xAC \xF0\x9F\x8C\xA1"},
        {kDateTime, "2026-11-23T12:34:56.123456Z"},
    };
    int64_t micros = 1795000000123456;  // microseconds that a second count cannot hold
    for (const Case& c : cases) {
        const std::string path = UniquePath("type" + std::to_string(c.type));
        const uint32_t reference = Open(path, c.type);
        Write(reference, c.type, c.value, At(++micros));
        const TagConsoleValue read = ReadOne(reference);
        EXPECT_EQ(read.path, path);
        EXPECT_EQ(read.dataType, c.type) << c.value;
        EXPECT_EQ(read.value, c.value);
        EXPECT_EQ(read.timestamp, At(micros)) << c.value;
        Close(reference);
    }
}

TEST_F(ConsoleBrokerTest, ManySamplesInOneWriteLeaveTheLastAsTheCurrentValue) {
    const uint32_t reference = Open(UniquePath("many"), kInt);
    TagConsoleSamples samples;
    for (int i = 0; i < 100; ++i) samples.push_back({std::to_string(i), At(1000000 + i)});
    std::string error;
    ASSERT_EQ(TagConsoleWriteTag(reference, kInt, &samples, false, &error), 0) << error;
    const TagConsoleValue read = ReadOne(reference);
    EXPECT_EQ(read.value, "99");
    EXPECT_EQ(read.timestamp, At(1000099));
    Close(reference);
}

TEST_F(ConsoleBrokerTest, AReadDeliversTheValidPartAndReportsTheInvalidReference) {
    const uint32_t reference = Open(UniquePath("partial"), kDouble);
    Write(reference, kDouble, "1.5", At(42));
    std::vector<TagConsoleValue> results;
    std::string error;
    const std::vector<uint32_t> mixed{reference, 0xFFFFFFF0u};
    EXPECT_EQ(TagConsoleReadValues(0, &mixed, false, 0, &results, &error), kInvalidTagReference);
    EXPECT_EQ(error, "Invalid tag reference.");
    ASSERT_EQ(results.size(), 1u);
    EXPECT_EQ(results.front().value, "1.5");

    // Only invalid references: nothing is read.
    results.clear();
    const std::vector<uint32_t> invalid{0xFFFFFFF0u};
    EXPECT_EQ(TagConsoleReadValues(0, &invalid, false, 0, &results, &error), kInvalidTagReference);
    EXPECT_TRUE(results.empty());
    Close(reference);
}

TEST_F(ConsoleBrokerTest, EightThreadsShareOneInstanceAndEachGetsItsOwnReplies) {
    constexpr int kThreads = 8;
    constexpr int kRounds = 25;
    std::vector<uint32_t> references;
    for (int t = 0; t < kThreads; ++t) references.push_back(Open(UniquePath("thread"), kInt));

    std::vector<int> mismatches(kThreads, 0);
    std::vector<std::thread> threads;
    for (int t = 0; t < kThreads; ++t) {
        threads.emplace_back([&, t] {
            for (int round = 0; round < kRounds; ++round) {
                const std::string value = std::to_string(t * 1000 + round);
                const TagConsoleSamples samples{{value, At(round + 1)}};
                const std::vector<uint32_t> mine{references[t]};
                std::vector<TagConsoleValue> results;
                std::string error;
                if (TagConsoleWriteTag(references[t], kInt, &samples, false, &error) != 0 ||
                    TagConsoleReadValues(0, &mine, false, 0, &results, &error) != 0 ||
                    results.size() != 1 || results.front().value != value) {
                    ++mismatches[t];
                }
            }
        });
    }
    for (auto& thread : threads) thread.join();
    for (int t = 0; t < kThreads; ++t) EXPECT_EQ(mismatches[t], 0) << "thread " << t;
    for (const uint32_t reference : references) Close(reference);
}

}  // namespace
}  // namespace Korvane::Veldra::Testing
