#pragma once

#include <boost/asio/io_context.hpp>
#include <boost/asio/ip/tcp.hpp>
#include <chrono>
#include <cstddef>
#include <memory>

#include "HttpMessages.h"

namespace kvtag::serve {

struct HttpLimits {
    std::size_t bodyBytes = 64 * 1024;  // larger bodies get 413
    std::size_t headerBytes = 16 * 1024;
    // A connection that takes longer to send a request (or to be idle
    // between two) or to take an answer is closed.
    std::chrono::seconds readTimeout{15};
    std::chrono::seconds writeTimeout{15};
};

// An HTTP/1.1 server on one address: every connection is asynchronous with
// its own time-outs, so a slow or vanished client holds up no other. Each
// request goes to the handler, whose reply may come from any thread. Every
// answer carries the page's security headers.
class HttpServer {
public:
    // Throws boost::system::system_error when the address cannot be bound.
    HttpServer(boost::asio::io_context& io, const boost::asio::ip::tcp::endpoint& endpoint,
               RequestHandler handler, HttpLimits limits = {});

    boost::asio::ip::tcp::endpoint LocalEndpoint() const { return acceptor_.local_endpoint(); }
    void Start();
    // Accepts no more connections.
    void Stop();

private:
    void Accept();

    boost::asio::io_context& io_;
    boost::asio::ip::tcp::acceptor acceptor_;
    std::shared_ptr<const RequestHandler> handler_;
    HttpLimits limits_;
};

}  // namespace kvtag::serve
