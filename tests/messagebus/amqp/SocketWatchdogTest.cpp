#include <amqp_tcp_socket.h>
#include <arpa/inet.h>
#include <gtest/gtest.h>
#include <poll.h>
#include <unistd.h>

#include <chrono>
#include <future>

#include "messagebus/amqp/AmqpConsumerConnection.h"
#include "messagebus/amqp/SocketWatchdog.h"

namespace Korvane::Veldra::MessageBus {
namespace {

using namespace std::chrono_literals;

// A thread held inside a "call" on a socket whose peer never says anything,
// the way rabbitmq-c waits for input without a deadline: only the watchdog's
// cut can end the join.
TEST(SocketWatchdog, JoinCutsTheCallThatHoldsTheThreadButOnlyPastTheLimit) {
    const int listener = socket(AF_INET, SOCK_STREAM, 0);
    sockaddr_in address{};
    address.sin_family = AF_INET;
    address.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
    socklen_t length = sizeof address;
    ASSERT_EQ(bind(listener, reinterpret_cast<sockaddr*>(&address), length), 0);
    ASSERT_EQ(getsockname(listener, reinterpret_cast<sockaddr*>(&address), &length), 0);
    ASSERT_EQ(listen(listener, 1), 0);
    const amqp_connection_state_t state = amqp_new_connection();
    timeval timeout{5, 0};
    ASSERT_EQ(amqp_socket_open_noblock(amqp_tcp_socket_new(state), "127.0.0.1",
                                       ntohs(address.sin_port), &timeout),
              AMQP_STATUS_OK);

    SocketWatchdog watchdog;
    EXPECT_FALSE(watchdog.CutIfStalled(0s));  // nothing in progress
    std::promise<void> inside;
    std::unique_ptr<std::thread> thread;
    WatchedThread watched;
    watched.Start(thread, [&] {
        SocketWatchdog::Scope watch(watchdog, state);
        inside.set_value();
        pollfd entry{amqp_get_sockfd(state), POLLIN, 0};
        poll(&entry, 1, -1);
    });
    inside.get_future().wait();
    EXPECT_FALSE(watchdog.CutIfStalled(1h));

    auto joined = std::async(std::launch::async, [&] { watched.Join(thread, watchdog); });
    ASSERT_EQ(joined.wait_for(10s), std::future_status::ready);
    EXPECT_EQ(thread, nullptr);
    EXPECT_FALSE(watchdog.CutIfStalled(0s));  // the scope has ended
    amqp_destroy_connection(state);
    close(listener);
}

TEST(BindingKey, IsVeldraAndTheKeysJoinedByDots) {
    EXPECT_EQ(BindingKey({}), "Veldra");
    EXPECT_EQ(BindingKey({"abc_1234", "#"}), "Veldra.abc_1234.#");
    EXPECT_EQ(BindingKey({"SomeBroadcast"}), "Veldra.SomeBroadcast");
    EXPECT_EQ(BindingKey({"", "x"}), "Veldra..x");
}

}  // namespace
}  // namespace Korvane::Veldra::MessageBus
