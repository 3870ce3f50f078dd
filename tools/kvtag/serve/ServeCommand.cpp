#include "ServeCommand.h"

#include <boost/asio/io_context.hpp>
#include <boost/asio/ip/address.hpp>
#include <boost/asio/signal_set.hpp>
#include <csignal>
#include <cstdio>
#include <random>
#include <thread>
#include <vector>

#include "ApiRoutes.h"
#include "ConsoleSession.h"
#include "Failures.h"
#include "HttpServer.h"
#include "OutputChannel.h"
#include "TagGateway.h"
#include "TrendHistory.h"

namespace kvtag {
namespace {

namespace asio = boost::asio;
using tcp = asio::ip::tcp;

// The threads that serve connections; none of them calls the library.
constexpr unsigned kHttpThreads = 2;

// 128 random bits in hexadecimal, new for each run of the server.
std::string NewToken() {
    std::random_device random;
    std::string token;
    for (int i = 0; i < 4; ++i) {
        char part[9];
        std::snprintf(part, sizeof part, "%08x", static_cast<unsigned>(random()));
        token += part;
    }
    return token;
}

tcp::endpoint ListenEndpoint(const Invocation& call) {
    boost::system::error_code error;
    const auto address = asio::ip::make_address(call.listenHost, error);
    if (error) {
        throw UsageError("--listen needs an IP address such as 127.0.0.1 or [::1], not '" +
                             call.listenHost + "'",
                         Command::Serve);
    }
    return {address, call.listenPort};
}

std::string Url(const tcp::endpoint& endpoint) {
    const std::string host = endpoint.address().to_string();
    return "http://" + (endpoint.address().is_v6() ? "[" + host + "]" : host) + ":" +
           std::to_string(endpoint.port()) + "/";
}

}  // namespace

int RunServe(const Invocation& call) {
    const tcp::endpoint endpoint = ListenEndpoint(call);
    // The library's own lines go to standard error; the ready line to
    // standard output.
    OutputChannel output;
    Reservation reservation;
    ConsoleInstance instance(call.global,
                             call.instance.value_or(ConsoleInstance::kDefaultInstanceId));
    asio::io_context io;
    serve::TagGateway gateway(instance);
    serve::TrendHistory history;
    serve::TrendPoller poller(gateway, history);
    const serve::ApiRoutes routes(gateway, history,
                                  {call.allowWrite, NewToken(), endpoint.address().is_loopback()});
    std::unique_ptr<serve::HttpServer> server;
    try {
        server = std::make_unique<serve::HttpServer>(
            io, endpoint, [&routes](serve::HttpRequest request, serve::Reply reply) {
                routes.Handle(std::move(request), reply);
            });
    } catch (const boost::system::system_error& failure) {
        throw ToolError("cannot listen on " + Url(endpoint) + ": " + failure.code().message());
    }
    asio::signal_set signals(io, SIGINT, SIGTERM);
    signals.async_wait([&](const boost::system::error_code&, int) {
        server->Stop();
        io.stop();
    });
    server->Start();
    poller.Start();
    const std::string url = Url(server->LocalEndpoint());
    if (!output.Write("kvtag serve: listening on " + url + "\n")) return 2;
    std::fprintf(stderr, "kvtag serve: %s; Ctrl-C stops it\n",
                 call.allowWrite ? "writes allowed (--allow-write)" : "read-only");

    std::vector<std::thread> threads;
    for (unsigned i = 1; i < kHttpThreads; ++i) threads.emplace_back([&io] { io.run(); });
    io.run();
    for (auto& thread : threads) thread.join();
    // No job of the library's thread may outlive the connections it answers.
    gateway.Stop();
    std::fprintf(stderr, "kvtag serve: stopped\n");
    return 0;
}

}  // namespace kvtag
