// The service as a process: its store across a restart and a kill -9, its
// stop on SIGTERM, and its refusal to start without a broker.
#include <gtest/gtest.h>
#include <netinet/in.h>
#include <sys/socket.h>
#include <unistd.h>

#include <filesystem>
#include <mutex>
#include <set>
#include <thread>

#include "messagelibrary/taginfo/TagInfoCreateOrUpdateTagsRequest.h"
#include "messagelibrary/taginfo/TagInfoDeleteTagsRoutedMessage.h"
#include "messagelibrary/taginfo/TagInfoQueryTagsRequest.h"
#include "support/BrokerEnvironment.h"
#include "support/CommandRunner.h"
#include "support/ScratchDirectory.h"
#include "tagservice/TagServiceClient.h"

namespace Korvane::Veldra::Testing {
namespace {

using Tags::TagDataType;

// Counts the replies to writes that came back without an error, by state.
class AckCounter : public MessageBus::Interfaces::IResponseCallback {
public:
    void OnResponse(MessagePtr message, uint32_t state) override {
        std::lock_guard<std::mutex> lock(mutex_);
        if (ErrorName(*message).empty()) acked_.insert(state);
        changed_.notify_all();
    }
    bool WaitForAcks(std::size_t count, std::chrono::milliseconds timeout) {
        std::unique_lock<std::mutex> lock(mutex_);
        return changed_.wait_for(lock, timeout, [&] { return acked_.size() >= count; });
    }
    // For the sender: true once count writes are acknowledged, false once
    // Stop was called.
    bool AwaitAcksUnlessStopped(std::size_t count) {
        std::unique_lock<std::mutex> lock(mutex_);
        changed_.wait(lock, [&] { return acked_.size() >= count || stopped_; });
        return !stopped_;
    }
    void Stop() {
        std::lock_guard<std::mutex> lock(mutex_);
        stopped_ = true;
        changed_.notify_all();
    }
    std::set<uint32_t> Acked() {
        std::lock_guard<std::mutex> lock(mutex_);
        return acked_;
    }

private:
    std::mutex mutex_;
    std::condition_variable changed_;
    std::set<uint32_t> acked_;
    bool stopped_ = false;
};

TEST(TagServiceProcessTest, ARestartOnTheSameStoreServesTheSameTags) {
    ScratchDirectory scratch;
    TagServiceProcess::Options options;
    options.store = scratch.Path() + "/tags.db";
    TagServiceClient client;
    const auto at = Tags::Timestamp(boost::gregorian::date(2020, 1, 2),
                                    boost::posix_time::seconds(3));
    {
        TagServiceProcess service(options);
        client.Create("restart.d", TagDataType::Double, true);
        client.Create("restart.u", TagDataType::UInt64);
        client.Create("restart.gone", TagDataType::Int);
        Tags::TagRecord meta{std::string("restart.u"), TagDataType::UInt64,
                             Tags::JsonStringMap{{"unit", "m"}}, Tags::JsonStringList{"a", "b"},
                             false};
        Tags::TagInfoMessages::TagInfoCreateOrUpdateTagsRequest change(
            std::vector<Tags::TagChange>{
                {meta, Tags::TagChangeFlags::Keywords | Tags::TagChangeFlags::Properties}},
            false);
        ASSERT_NE(client.Request(change), nullptr);
        ASSERT_EQ(client.Write("restart.d", {Sample(TagDataType::Double, "4", at),
                                             Sample(TagDataType::Double, "-2", at)}),
                  "");
        ASSERT_EQ(client.Write("restart.u", {Sample(TagDataType::UInt64, "18446744073709551615", at)}),
                  "");
        Tags::TagInfoMessages::TagInfoDeleteTagsRoutedMessage remove(
            Tags::JsonStringList{"restart.gone"});
        ASSERT_NE(client.Routed(remove), nullptr);
        EXPECT_EQ(service.Stop(), 0) << service.Output();
    }
    TagServiceProcess restarted(options);
    const auto page = client.Query(Tags::JsonStringList{"restart.*"});
    ASSERT_EQ(page.TotalCount(), 2) << restarted.Output();
    const Tags::TagRecord& u = page.Tags()->at(1);
    EXPECT_EQ(u.path, "restart.u");
    EXPECT_EQ(u.type, TagDataType::UInt64);
    EXPECT_EQ(u.keywords, (Tags::JsonStringList{"a", "b"}));
    EXPECT_EQ(u.properties, (Tags::JsonStringMap{{"unit", "m"}}));
    EXPECT_TRUE(page.Tags()->at(0).collectAggregates);

    const auto values = client.Read({"restart.d", "restart.u"});
    ASSERT_EQ(values.size(), 2u);
    EXPECT_EQ(values[0].current->value->value, "-2");
    EXPECT_EQ(values[0].current->timestamp, at);
    ASSERT_TRUE(values[0].aggregates);
    EXPECT_EQ(values[0].aggregates->count, 2);
    EXPECT_DOUBLE_EQ(values[0].aggregates->avg, 1.0);
    EXPECT_EQ(values[0].aggregates->min, "-2");
    EXPECT_EQ(values[0].aggregates->max, "4");
    EXPECT_EQ(values[1].current->value->value, "18446744073709551615");
}

TEST(TagServiceProcessTest, AKillInTheMiddleOfWritesLosesNoAcknowledgedOne) {
    ScratchDirectory scratch;
    TagServiceProcess::Options options;
    options.store = scratch.Path() + "/tags.db";
    TagServiceClient client;
    auto service = std::make_unique<TagServiceProcess>(options);
    client.Create("kill.seq", TagDataType::Int, true);

    // A stream of writes with up to kWindow of them unacknowledged at a time.
    constexpr uint32_t kWindow = 50;
    AckCounter acks;
    client.Service().SetStateResponseCallback(&acks);
    std::thread sender([&] {
        for (uint32_t i = 1; i < 1000000; ++i) {
            if (i > kWindow && !acks.AwaitAcksUnlessStopped(i - kWindow)) return;
            Tags::TagIngestionMessages::TagUpdateValuesRoutedMessage write(
                std::vector<Tags::TagPathUpdates>{
                    {std::string("kill.seq"),
                     std::vector<Tags::TagValueSample>{
                         Sample(TagDataType::Int, std::to_string(i))}}});
            write.SetIgnoreResponse(false);
            try {
                client.Service().SendRequestAsync(write, i);
            } catch (const std::exception&) {
            }
        }
    });
    const bool enough = acks.WaitForAcks(300, std::chrono::seconds(60));
    service->Kill();
    acks.Stop();
    sender.join();
    ASSERT_TRUE(enough) << service->Output();
    const std::set<uint32_t> acked = acks.Acked();
    client.Service().SetStateResponseCallback(client.collector.get());

    service = std::make_unique<TagServiceProcess>(options);
    const auto values = client.Read({"kill.seq"});
    ASSERT_EQ(values.size(), 1u) << service->Output();
    ASSERT_TRUE(values[0].current && values[0].aggregates);
    // The writes are handled in order, each after the one before: the
    // service holds at least every acknowledged write, and the newest value
    // is at least the newest acknowledged one.
    EXPECT_GE(static_cast<std::size_t>(values[0].aggregates->count), acked.size());
    EXPECT_GE(std::stoul(*values[0].current->value->value), *acked.rbegin());
}

TEST(TagServiceProcessTest, ItServesAgainAfterTheBrokerDropsItsConnections) {
    TagServiceProcess service;
    TagServiceClient client;
    client.Create("reconnect.a", TagDataType::Int);
    ASSERT_TRUE(CloseAllConnections());
    // Both sides reconnect by themselves: ask, each time with a bounded wait,
    // until an answer comes.
    MessagePtr reply;
    const auto deadline = std::chrono::steady_clock::now() + std::chrono::seconds(90);
    while (reply == nullptr && std::chrono::steady_clock::now() < deadline) {
        Tags::TagInfoMessages::TagInfoQueryTagsRequest query(
            Tags::JsonStringList{"reconnect.a"}, std::nullopt, std::nullopt, 0, 0, true);
        try {
            reply = client.Service().SendRequest(query, 2000);
        } catch (const std::exception&) {
            // The client's publisher is still reconnecting.
        }
    }
    ASSERT_NE(reply, nullptr) << service.Output();
    Tags::TagInfoMessages::TagInfoQueryTagsResponse page(reply->Headers(), reply->Body());
    EXPECT_EQ(page.TotalCount(), 1);
    EXPECT_NE(service.Output().find("bus: "), std::string::npos) << service.Output();
}

TEST(TagServiceProcessTest, SigtermStopsItCleanly) {
    TagServiceProcess service;
    EXPECT_EQ(service.Stop(), 0);
    EXPECT_NE(service.Output().find("stopped"), std::string::npos) << service.Output();
}

// A loopback port that nothing listens on: bound, then closed.
int ClosedPort() {
    const int fd = socket(AF_INET, SOCK_STREAM, 0);
    sockaddr_in address{};
    address.sin_family = AF_INET;
    address.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
    socklen_t length = sizeof address;
    bind(fd, reinterpret_cast<sockaddr*>(&address), sizeof address);
    getsockname(fd, reinterpret_cast<sockaddr*>(&address), &length);
    close(fd);
    return ntohs(address.sin_port);
}

TEST(TagServiceProcessTest, ABrokerItCannotReachEndsItWithStatusTwo) {
    ScratchDirectory scratch;
    BrokerSettings nowhere = Broker();
    nowhere.AmqpPort = ClosedPort();
    WriteBrokerDataRoot(nowhere, scratch.Path());
    const auto started = std::chrono::steady_clock::now();
    const CommandResult result =
        RunCommand({"env", "VELDRA_DATA_DIR=" + scratch.Path(), KVVELDRA_TAGSERVICE_PATH,
                    "--connect-timeout", "2000"},
                   60);
    EXPECT_EQ(result.ExitCode, 2) << result.Output;
    EXPECT_NE(result.Output.find("cannot reach the broker"), std::string::npos) << result.Output;
    EXPECT_LT(std::chrono::steady_clock::now() - started, std::chrono::seconds(20));
}

TEST(TagServiceProcessTest, AStoreThatCannotBeOpenedEndsItWithStatusThree) {
    ScratchDirectory scratch;
    const CommandResult result = RunCommand(
        {"env", "VELDRA_DATA_DIR=" + UseBrokerDataRoot(), KVVELDRA_TAGSERVICE_PATH, "--store",
         scratch.Path() + "/no/such/dir/tags.db"},
        60);
    EXPECT_EQ(result.ExitCode, 3) << result.Output;
}

}  // namespace
}  // namespace Korvane::Veldra::Testing
