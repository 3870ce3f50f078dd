#include <gtest/gtest.h>

#include "../FrameTestSupport.h"
#include "WBHostRuntime.h"
#include "kvveldra/TagWB.h"
#include "taglibrary/exports/Frame.h"
#include "taglibrary/exports/wb/HostStrings.h"

using namespace Korvane::Veldra::TagLibrary;
using FrameTestSupport::ReservedProcess;

namespace {

// A host string handle that the test owns.
struct HostString {
    WBStrHandle handle = nullptr;
    explicit HostString(const std::string& text = "") {
        if (!text.empty()) {
            EXPECT_EQ(CopyToHostString(&handle, text), 0);
        }
    }
    ~HostString() { WBDisposeHandle(reinterpret_cast<WBHandle>(handle)); }
    std::string Text() const { return ReadHostString(handle); }
};

class HostFrame : public ReservedProcess {};

}  // namespace

TEST_F(HostFrame, InitializeAndCloseWithHostStrings) {
    HostString configuration("site_a"), empty, error;
    bool created = false;
    const bool fallback = false;
    EXPECT_EQ(InitializeHostLocal(3, &configuration.handle, 0, &fallback, &created, &error.handle), 0);
    EXPECT_TRUE(created);
    EXPECT_EQ(ClientOf(3)->ConfigurationId(), "site_a");
    EXPECT_EQ(ClientOf(3)->ConnectTimeoutMs(), 180000u);
    EXPECT_FALSE(ClientOf(3)->AllowFallback());

    created = false;
    EXPECT_EQ(InitializeHostLocal(3, &configuration.handle, 10, &fallback, &created, &error.handle), 0);
    EXPECT_FALSE(created);  // already live: nothing changes

    // An empty string counts as no configuration; a non-zero byte is true.
    const unsigned char two = 2;
    EXPECT_EQ(InitializeHostLocal(4, &empty.handle, 10, reinterpret_cast<const bool*>(&two), &created,
                              &error.handle),
              0);
    EXPECT_EQ(ClientOf(4)->ConfigurationId(), "veldra_master");
    EXPECT_EQ(ClientOf(4)->ConnectTimeoutMs(), 10u);
    EXPECT_EQ(error.handle, nullptr);  // success leaves the error untouched

    EXPECT_EQ(TagWBCloseInstance(0, &error.handle), 1);
    EXPECT_EQ(TagWBCloseInstance(3, &error.handle), 0);
    EXPECT_EQ(TagWBCloseInstance(3, &error.handle), -251900);
    EXPECT_EQ(error.Text(), "Invalid tag reference.");
}

TEST_F(HostFrame, TagCallsReportIntoTheHostString) {
    HostString error("a much longer text that was here before");
    bool created = false;
    ASSERT_EQ(InitializeHostLocal(0, nullptr, 0, nullptr, &created, &error.handle), 0);
    const auto tag = ClientOf(0)->MapTag(0, "t", TagDataType::DateTime);
    RegisterReference(tag);

    int32_t type = -1;
    EXPECT_EQ(TagWBGetDataType(tag->Reference(), &type, &error.handle), 0);
    EXPECT_EQ(type, 5);
    EXPECT_EQ(TagWBGetDataType(tag->Reference(), nullptr, &error.handle), 1);
    EXPECT_EQ(TagWBGetDataType(0, &type, &error.handle), -251900);
    EXPECT_EQ(error.Text(), "Invalid tag reference.");

    EXPECT_EQ(TagWBClose(tag->Reference(), &error.handle), 0);
    EXPECT_EQ(TagWBClose(tag->Reference(), &error.handle), -251900);
}

TEST_F(HostFrame, HostOutOfMemoryReplacesTheStatus) {
    HostString error;
    WBFailNextAllocations(1);
    EXPECT_EQ(TagWBClose(4242, &error.handle), 2);
    EXPECT_EQ(error.handle, nullptr);

    HostString existing("x");
    WBFailNextAllocations(1);
    EXPECT_EQ(TagWBClose(4242, &existing.handle), 2);  // the resize's status
    WBFailNextAllocations(0);
    EXPECT_EQ(TagWBClose(4242, nullptr), -251900);  // no place for the text
}

TEST(HostStrings, SizingFollowsTheElementRule) {
    WBHandle handle = nullptr;
    ASSERT_EQ(SizeHostHandle(&handle, 4, 8, 0), 0);
    EXPECT_EQ(WBHandleSize(handle), 12u);
    ASSERT_EQ(SizeHostHandle(&handle, 4, 8, 3), 0);
    EXPECT_EQ(WBHandleSize(handle), 28u);
    WBDisposeHandle(handle);

    WBStrHandle text = nullptr;
    ASSERT_EQ(CopyToHostString(&text, std::string("a\0b", 3)), 0);
    EXPECT_EQ(ReadHostString(text), std::string("a\0b", 3));
    ASSERT_EQ(CopyToHostString(&text, ""), 0);
    EXPECT_EQ((*text)->cnt, 0);
    EXPECT_EQ(ReadHostString(static_cast<const WBStrHandle*>(nullptr)), "");
    WBDisposeHandle(reinterpret_cast<WBHandle>(text));
}
