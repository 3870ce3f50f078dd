// Whether a channel's queue is in place: what a request waits on after a
// reconnect, and the pauses of the retry loops.
#include <gtest/gtest.h>

#include <chrono>
#include <future>
#include <vector>

#include "messagebus/amqp/AmqpChannel.h"
#include "messagebus/concurrency/Backoff.h"

namespace Korvane::Veldra::MessageBus {
namespace {

using std::chrono::milliseconds;

TEST(AmqpChannelBound, OnlyTheRebindOfTheLatestLossMarksTheChannelBound) {
    AmqpChannel channel(1, std::make_shared<EnvelopeQueue>());
    EXPECT_TRUE(channel.IsBound()) << "a new channel has just declared and bound its queue";

    channel.MarkUnbound();                          // the connection is lost
    const uint64_t first = channel.Generation();    // a rebind starts on the old connection
    channel.RequestReset();                         // the new connection asks for another
    channel.MarkBound(first);                       // the first rebind ends: too old
    EXPECT_FALSE(channel.IsBound());
    EXPECT_TRUE(channel.ChannelReset.Acquire(0)) << "the reset was posted";

    channel.MarkBound(channel.Generation());
    EXPECT_TRUE(channel.IsBound());
}

TEST(AmqpChannelBound, AWaiterWakesWhenTheRebindIsThroughAndGivesUpAtItsTimeOut) {
    AmqpChannel channel(1, std::make_shared<EnvelopeQueue>());
    channel.MarkUnbound();
    EXPECT_FALSE(channel.WaitBound(milliseconds(1)));

    auto waiter = std::async(std::launch::async, [&] { return channel.WaitBound(std::chrono::minutes(1)); });
    channel.MarkBound(channel.Generation());
    EXPECT_TRUE(waiter.get());
}

TEST(Backoff, DoublesFromTheFirstPauseToTheCapAndStartsAgainAfterAReset) {
    Backoff backoff(100, 2000);
    std::vector<uint32_t> pauses;
    for (int i = 0; i < 7; ++i) pauses.push_back(backoff.NextMs());
    EXPECT_EQ(pauses, (std::vector<uint32_t>{100, 200, 400, 800, 1600, 2000, 2000}));
    backoff.Reset();
    EXPECT_EQ(backoff.NextMs(), 100u);
    Backoff odd(300, 1000);  // a cap that is no power of two times the first
    EXPECT_EQ((std::vector<uint32_t>{odd.NextMs(), odd.NextMs(), odd.NextMs()}),
              (std::vector<uint32_t>{300, 600, 1000}));
}

}  // namespace
}  // namespace Korvane::Veldra::MessageBus
