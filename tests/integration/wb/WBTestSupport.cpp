#include "wb/WBTestSupport.h"

#include <unistd.h>

#include <atomic>
#include <cmath>

namespace Korvane::Veldra::Testing {
namespace {

constexpr int64_t kHostEpochOffsetSeconds = 2082844800;

}  // namespace

WBStrHandle NewHostString(const std::string& text) {
    auto handle = reinterpret_cast<WBStrHandle>(WBNewHandleClr(offsetof(WBStr, str) + text.size() + 1));
    (*handle)->cnt = static_cast<int32_t>(text.size());
    std::memcpy((*handle)->str, text.data(), text.size());
    return handle;
}

std::vector<WBStrHandle> NewHostStrings(const std::vector<std::string>& texts) {
    std::vector<WBStrHandle> handles;
    for (const auto& text : texts) handles.push_back(NewHostString(text));
    return handles;
}

std::string Text(WBStrHandle handle) {
    if (handle == nullptr || *handle == nullptr || (*handle)->cnt <= 0) return "";
    return std::string(reinterpret_cast<const char*>((*handle)->str), static_cast<std::size_t>((*handle)->cnt));
}

WBTimestamp HostTime(int64_t unixMicros) {
    WBTimestamp time{};
    int64_t seconds = unixMicros / 1000000;
    int64_t micros = unixMicros % 1000000;
    if (micros < 0) {
        micros += 1000000;
        seconds -= 1;
    }
    time.seconds = seconds + kHostEpochOffsetSeconds;
    // The fraction of whole microseconds, as the library's way back makes it.
    time.fraction = static_cast<uint64_t>(static_cast<double>(micros) / 1e6 * 18446744073709551616.0);
    return time;
}

int64_t UnixMicros(const WBTimestamp& time) {
    const auto micros = static_cast<int64_t>(std::llround(static_cast<double>(time.fraction) / 18446744073709551616.0 * 1e6));
    return (time.seconds - kHostEpochOffsetSeconds) * 1000000 + micros;
}

SuiteTagService& WBBrokerTest::Suite() {
    static SuiteTagService suite{"kvveldra-wb"};
    return suite;
}

void WBBrokerTest::SetUp() {
    ASSERT_TRUE(Suite().EnsureSuite(StartSuite)) << "the tag service or the instance did not start (see above)";
}

void WBBrokerTest::StartSuite() {
    UseBrokerDataRoot();  // before the library reads the data root
    StartService();
    bool reserved = false;
    ASSERT_EQ(TagWBReserve(&reserved), 0);
    HostString error;
    bool created = false;
    ASSERT_EQ(TagWBInitialize(0, nullptr, 0, nullptr, &created, &error.handle), 0) << error.Text();
}

void WBBrokerTest::TearDownTestSuite() {
    bool reserved = true;
    TagWBUnreserve(&reserved);
    StopService();
}

void WBBrokerTest::StartService() {
    Suite().Start();
}

void WBBrokerTest::StopService() {
    Suite().Stop();
}

std::string WBBrokerTest::UniquePath(const std::string& stem) {
    static std::atomic<int> counter{0};
    return "wb." + std::to_string(getpid()) + "." + std::to_string(++counter) + "." + stem;
}

uint32_t WBBrokerTest::Open(const std::string& path, int32_t type) {
    HostString text(path), error;
    Pending lookup;
    EXPECT_EQ(TagWBLookupTag(0, &text.handle, &lookup.id, &lookup.timeoutMs, &lookup.signal, &error.handle), 0)
        << error.Text();
    EXPECT_TRUE(Await(lookup));
    bool found = false;
    uint32_t reference = 0;
    Pending create = lookup;
    EXPECT_EQ(TagWBOpenOrCreate(0, &text.handle, type, &found, &reference, &create.id, &create.timeoutMs,
                                &create.signal, &error.handle),
              0)
        << path << ": " << error.Text();
    if (!found) {
        EXPECT_TRUE(Await(create));
        EXPECT_EQ(TagWBFinishCreate(0, &text.handle, type, create.id, &reference, &error.handle), 0)
            << path << ": " << error.Text();
    }
    EXPECT_NE(reference, 0u);
    return reference;
}

int32_t WBBrokerTest::AwaitAndFinish(const Pending& pending, std::string* error) {
    HostString text;
    EXPECT_TRUE(Await(pending));
    const int32_t status = TagWBFinishRequest(0, pending.id, &text.handle);
    if (error != nullptr) *error = text.Text();
    return status;
}

void WBBrokerTest::Write(uint32_t reference, int32_t type, const std::string& value, int64_t unixMicros) {
    HostArray<WBStrArray> values(NewHostStrings({value}));
    HostArray<WBTimestampArray> timestamps({unixMicros == 0 ? WBTimestamp{} : HostTime(unixMicros)});
    HostString error;
    Pending write;
    ASSERT_EQ(TagWBWrite2(reference, type, values.Get(), timestamps.Get(), &write.id, &write.timeoutMs,
                          &write.signal, &error.handle),
              0)
        << error.Text();
    EXPECT_TRUE(Await(write));
    EXPECT_EQ(TagWBFinishRequestSession(reference, write.id, &error.handle), 0) << error.Text();
}

std::string WBBrokerTest::ReadText(uint32_t reference, int32_t type, WBTimestamp* timestamp) {
    HostString value, error;
    Pending read;
    EXPECT_EQ(TagWBRead(reference, &read.id, &read.timeoutMs, &read.signal, &error.handle), 0) << error.Text();
    EXPECT_TRUE(Await(read));
    WBTimestamp time{};
    WBAggregates2 aggregates{};
    EXPECT_EQ(TagWBFinishRead2(reference, type, read.id, &value.handle, &time, &aggregates, &error.handle), 0)
        << error.Text();
    DisposeElement(aggregates.max);
    DisposeElement(aggregates.min);
    if (timestamp != nullptr) *timestamp = time;
    return value.Text();
}

void WBBrokerTest::Close(uint32_t reference) {
    HostString error;
    EXPECT_EQ(TagWBClose(reference, &error.handle), 0) << error.Text();
}

}  // namespace Korvane::Veldra::Testing
