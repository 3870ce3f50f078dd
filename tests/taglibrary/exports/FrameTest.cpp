#include <gtest/gtest.h>

#include <atomic>
#include <thread>

#include "FrameTestSupport.h"
#include "errors/VeldraException.h"
#include "kvveldra/TagConsole.h"
#include "kvveldra/TagWB.h"
#include "taglibrary/exports/ErrorOut.h"
#include "taglibrary/exports/Frame.h"
#include "taglibrary/exports/Instances.h"

using namespace Korvane::Veldra::TagLibrary;
using FrameTestSupport::ReservedProcess;

namespace {

class Frame : public ReservedProcess {
protected:
    // Opens a local record on an instance and registers its reference, as an
    // open function does after its lookup.
    uint32_t OpenLocal(uint64_t instanceId, const std::string& path, TagDataType type) {
        const auto tag = ClientOf(instanceId)->MapTag(instanceId, path, type);
        RegisterReference(tag);
        return tag->Reference();
    }

    int32_t Initialize(uint64_t id, const ClientFactory& factory, std::string& error) {
        ConsoleErrorOut out(&error);
        return InitializeInstance(id, std::string("cfg"), 5u, false, nullptr, out, factory);
    }
};

}  // namespace

TEST(Reservation, CountsCallersAndTearsDownAtTheLast) {
    bool first = false, second = false;
    EXPECT_EQ(TagConsoleReserve(&first), 0);
    EXPECT_EQ(TagConsoleReserve(&first), 0);  // same flag: no second count
    EXPECT_EQ(TagConsoleReserve(&second), 0);
    EXPECT_EQ(ProcessState::Get().ReserveCount.load(), 2);
    const auto errors = ProcessState::Get().SharedErrors();
    ASSERT_NE(errors, nullptr);
    EXPECT_EQ(InitializeConsoleInstance(4, nullptr, nullptr, nullptr, nullptr, LocalClientFactory()), 0);

    EXPECT_EQ(TagConsoleUnreserve(&first), 0);
    EXPECT_EQ(TagConsoleUnreserve(&first), 0);  // cleared flag: no-op
    EXPECT_FALSE(first);
    EXPECT_EQ(ProcessState::Get().SharedErrors(), errors);
    EXPECT_EQ(ProcessState::Get().ClientTable.size(), 1u);

    EXPECT_EQ(TagConsoleUnreserve(&second), 0);
    EXPECT_EQ(ProcessState::Get().SharedErrors(), nullptr);
    EXPECT_TRUE(ProcessState::Get().ClientTable.empty());

    // A new cycle gets a new registry.
    EXPECT_EQ(TagConsoleReserve(&first), 0);
    EXPECT_NE(ProcessState::Get().SharedErrors(), errors);
    EXPECT_EQ(TagConsoleUnreserve(&first), 0);
    EXPECT_EQ(TagConsoleReserve(nullptr), 1);
    EXPECT_EQ(TagConsoleUnreserve(nullptr), 1);
}

TEST_F(Frame, InitializeChoosesSettings) {
    const std::string configuration = "site_a";
    const uint32_t timeout = 2500;
    const bool noFallback = false;
    std::string error;
    ASSERT_EQ(InitializeLocal(0, &configuration, &timeout, &noFallback, &error), 0);
    auto client = ClientOf(0);
    EXPECT_EQ(client->ConfigurationId(), "veldra_master");
    EXPECT_EQ(client->ConnectTimeoutMs(), 180000u);
    EXPECT_TRUE(client->AllowFallback());

    ASSERT_EQ(InitializeLocal(7, nullptr, &timeout, &noFallback, &error), 0);
    client = ClientOf(7);
    EXPECT_EQ(client->ConfigurationId(), "veldra_master");
    EXPECT_EQ(client->ConnectTimeoutMs(), 2500u);
    EXPECT_TRUE(client->AllowFallback());

    ASSERT_EQ(InitializeLocal(8, &configuration, nullptr, &noFallback, &error), 0);
    client = ClientOf(8);
    EXPECT_EQ(client->ConfigurationId(), "site_a");
    EXPECT_EQ(client->ConnectTimeoutMs(), 180000u);
    EXPECT_FALSE(client->AllowFallback());

    // A live instance ignores a second initialize.
    const std::string other = "site_b";
    ASSERT_EQ(InitializeLocal(8, &other, &timeout, nullptr, &error), 0);
    EXPECT_EQ(ClientOf(8), client);
    EXPECT_EQ(ClientOf(8)->ConfigurationId(), "site_a");
    EXPECT_EQ(error, "");
}

TEST_F(Frame, FailedConstructionLeavesTheDefinedState) {
    std::string error;
    const ClientFactory veldraFailure = [](auto&&...) -> std::shared_ptr<Client> {
        throw Korvane::Veldra::MessageBus::VeldraException(-251011, "no configurations here");
    };
    EXPECT_EQ(Initialize(5, veldraFailure, error), -251011);
    EXPECT_EQ(error, "No Veldra configurations available.");
    bool present = true;
    ClientOf(5, &present);
    EXPECT_FALSE(present);

    const ClientFactory otherFailure = [](auto&&...) -> std::shared_ptr<Client> {
        throw std::runtime_error("socket trouble");
    };
    EXPECT_EQ(Initialize(5, otherFailure, error), -251037);
    EXPECT_EQ(error, "An unexpected exception occurred: socket trouble");
    EXPECT_EQ(ClientOf(5, &present), nullptr);
    EXPECT_TRUE(present);

    // The null entry counts as absent, and the next initialize tries afresh.
    int32_t type = 0;
    EXPECT_EQ(TagConsoleCloseInstance(6, &error), -251900);
    EXPECT_EQ(Initialize(5, LocalClientFactory(), error), 0);
    EXPECT_NE(ClientOf(5), nullptr);
    EXPECT_EQ(ClientOf(5)->ConfigurationId(), "cfg");
    EXPECT_EQ(ClientOf(5)->ConnectTimeoutMs(), 5u);
    (void)type;
}

TEST_F(Frame, CloseInstanceAndTagCallsOnItsReferences) {
    std::string error;
    ASSERT_EQ(InitializeLocal(0, nullptr, nullptr, nullptr, &error), 0);
    ASSERT_EQ(InitializeLocal(7, nullptr, nullptr, nullptr, &error), 0);
    EXPECT_EQ(TagConsoleCloseInstance(0, &error), 1);
    EXPECT_EQ(error, "");
    EXPECT_NE(ClientOf(0), nullptr);

    const uint32_t reference = OpenLocal(7, "line/speed", TagDataType::Double);
    int32_t type = -1;
    EXPECT_EQ(TagConsoleGetDataType(reference, false, &type, &error), 0);
    EXPECT_EQ(type, 0);

    EXPECT_EQ(TagConsoleCloseInstance(7, &error), 0);
    EXPECT_EQ(TagConsoleCloseInstance(7, &error), -251900);
    EXPECT_EQ(error, "Invalid tag reference.");

    // The reference outlives its instance until a close, which fails on it.
    error.clear();
    EXPECT_EQ(TagConsoleGetDataType(reference, false, &type, &error), -251900);
    EXPECT_EQ(error, "Invalid tag reference.");
    EXPECT_TRUE(HasReference(reference));
    EXPECT_EQ(TagConsoleClose(reference, false, &error), -251900);

    EXPECT_EQ(TagConsoleGetDataType(0, false, &type, &error), -251900);
    EXPECT_EQ(TagConsoleGetPath(12345, false, nullptr, &error), -251900);
}

TEST_F(Frame, ConsoleCloseCountsSessionsAndKeepsVerbose) {
    std::string error;
    ASSERT_EQ(InitializeLocal(0, nullptr, nullptr, nullptr, &error), 0);
    const uint32_t reference = OpenLocal(0, "a", TagDataType::String);
    ASSERT_EQ(OpenLocal(0, "a", TagDataType::String), reference);

    std::string path;
    EXPECT_EQ(TagConsoleGetPath(reference, false, &path, &error), 0);
    EXPECT_EQ(path, "a");
    EXPECT_EQ(TagConsoleClose(reference, false, &error), 0);
    EXPECT_TRUE(HasReference(reference));
    testing::internal::CaptureStdout();
    EXPECT_EQ(TagConsoleClose(reference, true, &error), 0);
    EXPECT_EQ(testing::internal::GetCapturedStdout(), "Closing tag session for tag: a\n");
    EXPECT_FALSE(HasReference(reference));
    EXPECT_TRUE(ClientOf(0)->Verbose());  // the flag stays for later calls
    EXPECT_EQ(TagConsoleClose(reference, false, &error), -251900);
}

TEST_F(Frame, ImplicitClose) {
    std::string error;
    ASSERT_EQ(InitializeLocal(0, nullptr, nullptr, nullptr, &error), 0);
    ASSERT_EQ(InitializeLocal(7, nullptr, nullptr, nullptr, &error), 0);
    const uint32_t ofSeven = OpenLocal(7, "x", TagDataType::Int);
    const uint32_t alsoOfSeven = OpenLocal(7, "y", TagDataType::Int);
    const uint32_t ofDefault = OpenLocal(0, "z", TagDataType::Int);
    OpenLocal(0, "z", TagDataType::Int);

    EXPECT_EQ(TagWBImplicitClose(0), 0);
    EXPECT_EQ(TagWBImplicitClose(99999), 0);
    EXPECT_EQ(TagWBImplicitClose(ofSeven), 0);
    bool present = true;
    ClientOf(7, &present);
    EXPECT_FALSE(present);  // the whole instance went with one of its references
    EXPECT_FALSE(HasReference(ofSeven));
    EXPECT_TRUE(HasReference(alsoOfSeven));

    EXPECT_EQ(TagWBImplicitClose(ofDefault), 0);
    EXPECT_TRUE(HasReference(ofDefault));  // one of two sessions
    EXPECT_EQ(TagWBImplicitClose(ofDefault), 0);
    EXPECT_FALSE(HasReference(ofDefault));
    EXPECT_EQ(ClientOf(0)->OpenTagCount(), 0u);
}

TEST_F(Frame, UnexpectedExceptionsBecomeStatusAndText) {
    std::string error;
    ConsoleErrorOut out(&error);
    EXPECT_EQ(RunInFrame(out,
                         []() -> int32_t {
                             throw Korvane::Veldra::MessageBus::VeldraException(
                                 -251005, "Failed to parse: x");
                         }),
              -251037);
    EXPECT_EQ(error, "An unexpected exception occurred: Failed to parse: x");
}

TEST_F(Frame, ConcurrentCallersOnTheTables) {
    std::string error;
    ASSERT_EQ(InitializeLocal(0, nullptr, nullptr, nullptr, &error), 0);
    constexpr int kThreads = 4;
    constexpr int kRounds = 300;
    std::atomic<int> failures{0};
    std::vector<std::thread> threads;
    for (int t = 0; t < kThreads; ++t) {
        threads.emplace_back([&, t] {
            const uint64_t instance = 100 + static_cast<uint64_t>(t);
            std::string text;
            for (int i = 0; i < kRounds; ++i) {
                if (InitializeLocal(instance, nullptr, nullptr, nullptr, &text) != 0)
                    ++failures;
                const auto tag = ClientOf(instance)->MapTag(instance, "p", TagDataType::Double);
                RegisterReference(tag);
                int32_t type = -1;
                if (TagConsoleGetDataType(tag->Reference(), false, &type, &text) != 0) ++failures;
                // Another thread's instance may be mid-way; any answer but a crash is fine.
                TagConsoleGetDataType(tag->Reference() + 1, false, &type, &text);
                if (TagConsoleClose(tag->Reference(), false, &text) != 0) ++failures;
                if (TagConsoleCloseInstance(instance, &text) != 0) ++failures;
            }
        });
    }
    for (auto& thread : threads) thread.join();
    EXPECT_EQ(failures.load(), 0);
    EXPECT_TRUE(ProcessState::Get().TagReferenceTable.empty());
}
