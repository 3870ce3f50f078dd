// What both families make of a peer that no one here wrote (a raw rabbitmq-c
// tag service of the test's own): a record without a type, a reply that does
// not parse, references of another instance, a refused write, an empty
// variant, and a string handed to the host.
#include <gtest/gtest.h>
#include <kvveldra/TagConsole.h>
#include <unistd.h>

#include <memory>
#include <string>
#include <vector>

#include "peer/RawTagPeer.h"
#include "support/BrokerEnvironment.h"
#include "support/ExportedNumbers.h"
#include "support/ScratchDirectory.h"
#include "support/TagServiceProcess.h"
#include "wb/WBTestSupport.h"

namespace Korvane::Veldra::Testing {
namespace {

constexpr int32_t kUnexpectedException = -251037;
constexpr int32_t kNoDataType = -1;
constexpr uint64_t kOtherInstance = 7;

const RawTagPeer::Script kTags = {
    {"peer.notype", R"({"path":"peer.notype","collectAggregates":false})"},
    {"peer.string", R"({"path":"peer.string","type":"STRING"})"},
    {"peer.malformed", "MALFORMED"},
};
const RawTagPeer::Script kValues = {
    {"peer.string",
     R"({"path":"peer.string","current":{"timestamp":"2026-11-23T13:32:04.931068Z","value":{"type":"STRING","value":"abc"}}})"},
};

class PeerTest : public ::testing::Test {
protected:
    static void SetUpTestSuite() {
        const std::string exchange = "kvveldra.peer." + std::to_string(getpid());
        root_ = new ScratchDirectory("kvveldra-peer-data");
        WriteBrokerDataRoot(Broker(), root_->Path(), "veldra_master", exchange);
        setenv("VELDRA_DATA_DIR", root_->Path().c_str(), 1);
        peer_ = new RawTagPeer(exchange, kTags, kValues);
    }
    static void TearDownTestSuite() {
        bool reserved = true;
        TagConsoleUnreserve(&reserved);
        delete peer_;
        delete root_;
    }
    void SetUp() override {
        ASSERT_TRUE(peer_->Ready()) << "the peer did not start";
        if (!initialized_) {
            bool reserved = false;
            ASSERT_EQ(TagConsoleReserve(&reserved), 0);
            std::string error;
            ASSERT_EQ(TagConsoleInitialize(0, nullptr, nullptr, nullptr, &error), 0) << error;
            initialized_ = true;
        }
    }

    static int32_t ConsoleOpen(const std::string& path, int32_t type, uint32_t& reference,
                               std::string& error) {
        return TagConsoleOpen(0, &path, type, false, &reference, &error);
    }
    // The lookup, the wait and the finish of a host open.
    static int32_t HostOpen(const std::string& path, int32_t type, uint32_t& reference, std::string& text) {
        HostString hostPath(path), error;
        Pending lookup;
        int32_t status = TagWBLookupTag(0, &hostPath.handle, &lookup.id, &lookup.timeoutMs, &lookup.signal,
                                        &error.handle);
        if (status == 0) {
            Await(lookup);
            bool found = false;
            status = TagWBOpenOrCreate(0, &hostPath.handle, type, &found, &reference, &lookup.id,
                                       &lookup.timeoutMs, &lookup.signal, &error.handle);
            if (status == 0 && !found) status = -1;
        }
        text = error.Text();
        return status;
    }

    static ScratchDirectory* root_;
    static RawTagPeer* peer_;
    static bool initialized_;
};

ScratchDirectory* PeerTest::root_ = nullptr;
RawTagPeer* PeerTest::peer_ = nullptr;
bool PeerTest::initialized_ = false;

TEST_F(PeerTest, ARecordWithoutATypeOpensWithNoDataTypeInBothFamilies) {
    uint32_t reference = 0;
    std::string error;
    ASSERT_EQ(ConsoleOpen("peer.notype", kNoDataType, reference, error), 0) << error;
    int32_t type = 0;
    EXPECT_EQ(TagConsoleGetDataType(reference, false, &type, &error), 0) << error;
    EXPECT_EQ(type, kNoDataType);
    uint32_t hostReference = 0;
    EXPECT_EQ(HostOpen("peer.notype", kNoDataType, hostReference, error), 0) << error;
    EXPECT_EQ(hostReference, reference);
}

TEST_F(PeerTest, AMalformedReplyAtAFinishIsAnUnexpectedExceptionInBothFamilies) {
    uint32_t reference = 0;
    std::string consoleError, hostError;
    EXPECT_EQ(ConsoleOpen("peer.malformed", kDouble, reference, consoleError), kUnexpectedException);
    EXPECT_EQ(HostOpen("peer.malformed", kDouble, reference, hostError), kUnexpectedException);
    EXPECT_EQ(consoleError.rfind("An unexpected exception occurred: ", 0), 0u) << consoleError;
    EXPECT_EQ(hostError, consoleError);
}

TEST_F(PeerTest, AReferenceOpenedOnAnotherInstanceIsReadNotSkipped) {
    uint32_t reference = 0;
    std::string error;
    ASSERT_EQ(ConsoleOpen("peer.string", kString, reference, error), 0) << error;
    ASSERT_EQ(TagConsoleInitialize(kOtherInstance, nullptr, nullptr, nullptr, &error), 0) << error;
    const std::vector<uint32_t> references{reference};
    std::vector<TagConsoleValue> values;
    EXPECT_EQ(TagConsoleReadValues(kOtherInstance, &references, false, 0, &values, &error), 0) << error;
    ASSERT_EQ(values.size(), 1u);
    EXPECT_EQ(values.front().value, "abc");
    TagConsoleCloseInstance(kOtherInstance, &error);
}

// A write of one empty variant to the string tag as `type`: its status, and
// the request's id and signal.
int32_t WriteEmptyVariant(uint32_t reference, int32_t type, Pending& write, std::string& text) {
    HostArray<WBVariantArray> values(std::vector<WbVariant*>{WbVariantNew()});
    HostArray<WBTimestampArray> timestamps({WBTimestamp{}});
    HostString hostError;
    const int32_t status = TagWBWrite(reference, type, values.Get(), timestamps.Get(), &write.id,
                                      &write.timeoutMs, &write.signal, &hostError.handle);
    text = hostError.Text();
    return status;
}

TEST_F(PeerTest, AnEmptyVariantIsTheEmptyTextAndARefusedWriteLeavesTheHostNoSignal) {
    uint32_t reference = 0;
    std::string error;
    ASSERT_EQ(HostOpen("peer.string", kString, reference, error), 0) << error;

    Pending refused;
    EXPECT_EQ(WriteEmptyVariant(reference, kDouble, refused, error), kInvalidTagDataType) << error;
    EXPECT_EQ(refused.signal, 0u) << "a signal number went out with the refusal";

    Pending sent;
    EXPECT_EQ(WriteEmptyVariant(reference, kString, sent, error), 0) << error;
    EXPECT_NE(sent.signal, 0u);
    // Nobody ingests here: the host gives the request up.
    HostString hostError;
    EXPECT_EQ(TagWBFinishRequestSession(reference, sent.id, &hostError.handle), kRequestTimedOut);
}

TEST_F(PeerTest, AStringReadReachesTheHostInAHandleOfItsOwnMemory) {
    uint32_t reference = 0;
    std::string error;
    ASSERT_EQ(HostOpen("peer.string", kString, reference, error), 0) << error;
    HostString hostError;
    Pending read;
    ASSERT_EQ(TagWBRead(reference, &read.id, &read.timeoutMs, &read.signal, &hostError.handle), 0);
    ASSERT_TRUE(Await(read));
    HostVariant value;
    WBTimestamp time{};
    WBAggregates aggregates{};
    ASSERT_EQ(TagWBFinishRead(reference, kString, read.id, &value.variant, &time, &aggregates,
                              &hostError.handle),
              0)
        << hostError.Text();
    ASSERT_EQ(WbVariantGetType(value.variant), WbVariantLStr);
    EXPECT_EQ(Text(*static_cast<WBStrHandle*>(WbVariantGetDataPtr(value.variant))), "abc");
}

}  // namespace
}  // namespace Korvane::Veldra::Testing
